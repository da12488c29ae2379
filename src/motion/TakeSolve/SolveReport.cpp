#include "TakeSolve/SolveReport.h"

#include "TakeSolve/Stands.h"
#include "TakeSolve/Vectors.h"

#include "ComputeSubjectFK/ComputeSegmentFK.h"
#include "ComputeSubjectFK/ConstructionException.h"
#include "CoreOrlexTypes/Subject.h"
#include "SetupProposal/Partner.h"

#include <optional>

namespace TakeSolve
{
namespace
{

using namespace SetupProposal;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;

/// Below this a knee has no axis to speak of.
constexpr double c_Bent = 20.0 / c_Degrees;
/// A jump turns a segment by this, beyond three times what the performer turns by.
constexpr double c_Jump = 15.0 / c_Degrees;
constexpr double c_JumpFactor = 3.0;
/// Sides are unequal if one is met worse by this factor, and by so much: mm, and radians.
constexpr double c_UnequalFactor = 2.0;
constexpr double c_UnequalMm = 10.0;
constexpr double c_UnequalAngle = 5.0 / c_Degrees;

using VPoses = std::vector<VWorldPose>;

/// The value that no more than a part of them exceed.
template <typename TNumber>
double Percentile(std::vector<TNumber> i_Values, double i_Part)
{
	if (i_Values.empty())
		return 0.0;
	const auto index = std::size_t(std::ceil(i_Part * double(i_Values.size())));
	const auto place = i_Values.begin() + std::ptrdiff_t(std::max<std::size_t>(index, 1) - 1);
	std::ranges::nth_element(i_Values, place);
	return double(*place);
}

VTargetQuality QualityOf(const VSolvedTake& i_rSolved, std::size_t i_Target)
{
	VTargetQuality quality;
	std::vector<double> values;
	double squares = 0.0;
	for (std::size_t i = 0; i < i_rSolved.m_Frames; ++i)
	{
		const double residual = i_rSolved.Residuals(i)[i_Target];
		if (!std::isfinite(residual))
			continue;
		values.push_back(residual);
		squares += residual * residual;
		if (values.size() == 1 || residual > quality.m_Max)
		{
			quality.m_Max = residual;
			quality.m_MaxFrame = i_rSolved.m_First + i;
		}
	}
	quality.m_Frames = values.size();
	if (!values.empty())
		quality.m_Rms = std::sqrt(squares / double(values.size()));
	quality.m_P95 = Percentile(std::move(values), 0.95);
	return quality;
}

/// A part of the body on one side, in both skeletons.
using VPart = std::optional<VProposedPair>;

VPart FindPart(const VProposal& i_rProposal, EBodyPart i_Part, ESide i_Side)
{
	for (const VProposedPair& rPair : i_rProposal.m_Pairs)
	{
		const VJointReading& rJoint = i_rProposal.m_Source.m_Joints[rPair.m_Source];
		if (rJoint.m_Part == i_Part && rJoint.m_Side == i_Side)
			return rPair;
	}
	return std::nullopt;
}

/// What is followed of a foot through the frames.
class VFoot
{
public:
	VFoot(const VProposedPair& i_rAnkle, const VPart& i_rToe, ESide i_Side, const VPoses& i_rSourceBind,
	    const VPoses& i_rTargetBind)
	    : m_Ankle(i_rAnkle), m_Toe(i_rToe.value_or(i_rAnkle)), m_SourceBind{i_rSourceBind[m_Ankle.m_Source].t[2],
	                                                               i_rSourceBind[m_Toe.m_Source].t[2]},
	      m_TargetBind{i_rTargetBind[m_Ankle.m_Target].t[2], i_rTargetBind[m_Toe.m_Target].t[2]}
	{
		m_Quality.m_Side = i_Side;
		m_Quality.m_Source = i_rAnkle.m_Source;
		m_FromBind = Rotation::Transposed(i_rSourceBind[m_Ankle.m_Source].R);
		m_Ahead = Difference(i_rSourceBind[m_Toe.m_Source].t, i_rSourceBind[m_Ankle.m_Source].t);
		m_Ahead[2] = 0.0;
		m_Quality.m_Target = i_rAnkle.m_Target;
	}

	void Add(const VPoses& i_rSource, const VPoses& i_rTarget)
	{
		m_SourcePlaces.push_back(i_rSource[m_Toe.m_Source].t);
		m_TargetPlaces.push_back(i_rTarget[m_Toe.m_Target].t);
		m_SourceLeans.push_back(LeanOf(i_rSource[m_Ankle.m_Source].R));
		m_SourceHeights.push_back(std::min(i_rSource[m_Ankle.m_Source].t[2] - m_SourceBind.m_Ankle,
		    i_rSource[m_Toe.m_Source].t[2] - m_SourceBind.m_Toe));
		m_Heights.push_back(std::min(i_rTarget[m_Ankle.m_Target].t[2] - m_TargetBind.m_Ankle,
		    i_rTarget[m_Toe.m_Target].t[2] - m_TargetBind.m_Toe));
	}

	/// Finds when it stands, and adds how high the performer's does.
	void FindStanding(double i_Rate, std::vector<double>& io_rHeights)
	{
		m_Stands = FindStands(m_SourcePlaces, i_Rate);
		for (const VStand& rStand : m_Stands)
			io_rHeights.insert(io_rHeights.end(), m_SourceHeights.begin() + std::ptrdiff_t(rStand.m_First),
			    m_SourceHeights.begin() + std::ptrdiff_t(rStand.m_Last));
	}

	VFootQuality Quality(std::size_t i_First, double i_Floor)
	{
		for (double& rHeight : m_Heights)
			rHeight -= i_Floor;
		const auto lowest = std::ranges::min_element(m_Heights);
		m_Quality.m_Lowest = *lowest;
		m_Quality.m_LowestFrame = i_First + std::size_t(lowest - m_Heights.begin());
		const auto slide = [](const std::vector<VVector3>& i_rPlaces, std::size_t i_From, std::size_t i_To)
		{ return std::hypot(i_rPlaces[i_To][0] - i_rPlaces[i_From][0], i_rPlaces[i_To][1] - i_rPlaces[i_From][1]); };
		bool bFirst = true;
		std::vector<double> leans;
		for (const VStand& rStand : m_Stands)
			for (std::size_t i = rStand.m_First; i < rStand.m_Last; ++i)
			{
				++m_Quality.m_StandingFrames;
				leans.push_back(m_SourceLeans[i]);
				if (bFirst || m_Heights[i] > m_Quality.m_Highest)
				{
					m_Quality.m_Highest = m_Heights[i];
					m_Quality.m_HighestFrame = i_First + i;
				}
				if (bFirst || m_Heights[i] < m_Quality.m_LowestStanding)
					m_Quality.m_LowestStanding = m_Heights[i];
				bFirst = false;
				const double way = slide(m_TargetPlaces, rStand.m_First, i);
				if (way > m_Quality.m_Slide)
				{
					m_Quality.m_Slide = way;
					m_Quality.m_SourceSlide = slide(m_SourcePlaces, rStand.m_First, i);
					m_Quality.m_SlideFrame = i_First + i;
				}
			}
		m_Quality.m_SourceLean = Percentile(std::move(leans), 0.5);
		return m_Quality;
	}

private:
	/// 0 where the foot points up or down.
	double LeanOf(const Rotation::VMatrix3& i_rFoot) const
	{
		const Rotation::VMatrix3 turn = Rotation::Product(i_rFoot, m_FromBind);
		const VVector3 up = Rotation::Product(turn, VVector3{0.0, 0.0, 1.0});
		const VVector3 ahead = Rotation::Product(turn, m_Ahead);
		const double length = std::hypot(ahead[0], ahead[1]);
		if (!(length > 0.0))
			return 0.0;
		const double left = (up[1] * ahead[0] - up[0] * ahead[1]) / length;
		return (m_Quality.m_Side == ESide::Left ? 1.0 : -1.0) * std::atan2(left, up[2]);
	}

	/// In the bind pose.
	struct VHeights
	{
		double m_Ankle;
		double m_Toe;
	};

	VProposedPair m_Ankle;
	VProposedPair m_Toe;
	VHeights m_SourceBind;
	VHeights m_TargetBind;
	std::vector<VStand> m_Stands;
	std::vector<double> m_SourceHeights;
	std::vector<VVector3> m_SourcePlaces;
	std::vector<VVector3> m_TargetPlaces;
	Rotation::VMatrix3 m_FromBind = Rotation::c_Identity3;
	/// From ankle to toe along the floor, in the bind pose.
	VVector3 m_Ahead{};
	std::vector<double> m_SourceLeans;
	std::vector<double> m_Heights;
	VFootQuality m_Quality;
};

/// What is followed of a knee or an elbow.
class VBend
{
public:
	VBend(const char* i_pName, ESide i_Side, VProposedPair i_Upper, VProposedPair i_Middle, VProposedPair i_Lower)
	    : m_pName(i_pName), m_Side(i_Side), m_Joints{std::move(i_Upper), std::move(i_Middle), std::move(i_Lower)}
	{
	}

	void Add(const VPoses& i_rSource, const VPoses& i_rTarget)
	{
		const auto bones = [&](const VPoses& i_rPoses, std::size_t VProposedPair::*i_pSide)
		{
			const VVector3& rMiddle = i_rPoses[m_Joints[1].*i_pSide].t;
			return std::pair(Difference(rMiddle, i_rPoses[m_Joints[0].*i_pSide].t),
			    Difference(i_rPoses[m_Joints[2].*i_pSide].t, rMiddle));
		};
		const auto source = bones(i_rSource, &VProposedPair::m_Source);
		const auto target = bones(i_rTarget, &VProposedPair::m_Target);
		const double flexion = AngleBetween(source.first, source.second);
		m_Flexions.push_back(std::abs(AngleBetween(target.first, target.second) - flexion));
		if (flexion > c_Bent)
			m_Axes.push_back(
			    AngleBetween(CrossProduct(source.first, source.second), CrossProduct(target.first, target.second)));
	}

	VBendQuality Quality() const
	{
		return {m_pName, m_Side, Percentile(m_Flexions, 0.95), Percentile(m_Axes, 0.95), m_Axes.size()};
	}

private:
	const char* m_pName;
	ESide m_Side;
	VProposedPair m_Joints[3];
	std::vector<double> m_Flexions;
	std::vector<double> m_Axes;
};

/// The largest jump of each segment.
class VJumps
{
public:
	void Add(std::size_t i_Frame, const VPoses& i_rSource, const VPoses& i_rTarget)
	{
		if (!m_Source.empty())
		{
			double source = 0.0;
			for (std::size_t i = 0; i < i_rSource.size(); ++i)
				source = std::max(source, AngleBetween(m_Source[i].R, i_rSource[i].R));
			m_Largest.resize(i_rTarget.size());
			for (std::size_t i = 0; i < i_rTarget.size(); ++i)
			{
				const double angle = AngleBetween(m_Target[i].R, i_rTarget[i].R);
				if (angle > c_Jump + c_JumpFactor * source && angle > m_Largest[i].m_Angle)
					m_Largest[i] = {i_Frame, i, angle, source};
			}
		}
		m_Source = i_rSource;
		m_Target = i_rTarget;
	}

	std::vector<VJump> Largest() const
	{
		std::vector<VJump> jumps;
		std::ranges::copy_if(
		    m_Largest, std::back_inserter(jumps), [](const VJump& i_rJump) { return i_rJump.m_Angle > 0.0; });
		return jumps;
	}

private:
	VPoses m_Source;
	VPoses m_Target;
	std::vector<VJump> m_Largest;
};

VRestSkeleton SkeletonOf(const VSubject& i_rSubject, const VPoses& i_rPoses)
{
	VRestSkeleton skeleton;
	for (std::size_t i = 0; i < i_rPoses.size(); ++i)
	{
		const VSubject::VSegment& rSegment = i_rSubject.m_Segments[i];
		skeleton.push_back({rSegment.m_Name, i == 0 ? -1 : std::int64_t(rSegment.m_ParentSegmentIndex), i_rPoses[i].t,
		    rSegment.m_Joint.m_JointType != VSubjectParametrised::VJoint::EDummy});
	}
	return skeleton;
}

std::vector<VUnequalSides> FindUnequalSides(
    const VSubject& i_rTarget, const VRestSkeleton& i_rSkeleton, const std::vector<VTargetQuality>& i_rQualities)
{
	std::vector<VUnequalSides> unequal;
	const auto& rTargets = i_rTarget.m_Targets;
	for (std::size_t i = 0; i < rTargets.size(); ++i)
	{
		if (rTargets[i].m_SegmentIndices.empty() || rTargets[i].m_SegmentIndices.front() >= i_rSkeleton.size())
			continue;
		const std::int64_t partner = FindPartner(i_rSkeleton, rTargets[i].m_SegmentIndices.front()).m_Joint;
		for (std::size_t k = i + 1; partner >= 0 && k < rTargets.size(); ++k)
		{
			if (rTargets[k].m_Type != rTargets[i].m_Type || rTargets[k].m_SegmentIndices.empty()
			    || rTargets[k].m_SegmentIndices.front() != std::uint32_t(partner))
				continue;
			const bool bFirst = i_rQualities[i].m_Rms > i_rQualities[k].m_Rms;
			const double worse = i_rQualities[bFirst ? i : k].m_Rms;
			const double better = i_rQualities[bFirst ? k : i].m_Rms;
			const double least =
			    rTargets[i].m_Type == VSubject::VTarget::ELocalRotationToWorldRotation ? c_UnequalAngle : c_UnequalMm;
			if (worse > c_UnequalFactor * better && worse > better + least)
				unequal.push_back({bFirst ? k : i, bFirst ? i : k});
			break;
		}
	}
	return unequal;
}

} // namespace

bool ReportOn(const VSubject& i_rTarget, std::span<const double> i_BindPose, const VSourceMotion& i_rSource,
    const VSolvedTake& i_rSolved, const VSolveProgress& i_rProgress, VSolveReport& o_rReport)
{
	o_rReport = {};
	for (std::size_t i = 0; i < i_rSolved.m_NumberOfTargets; ++i)
		o_rReport.m_Targets.push_back(QualityOf(i_rSolved, i));
	for (std::size_t i = 0; i < i_rSolved.m_Frames; ++i)
		if (!i_rSolved.m_Converged[i])
			o_rReport.m_NotConverged.push_back(i_rSolved.m_First + i);
	o_rReport.m_MedianTime = Percentile(i_rSolved.m_Milliseconds, 0.5);
	o_rReport.m_P95Time = Percentile(i_rSolved.m_Milliseconds, 0.95);

	const ComputeSubject::VSegmentTree tree = ComputeSubject::MakeSegmentTree(i_rTarget);
	VPoses target(tree.size());
	const auto pose = [&](std::span<const double> i_States)
	{
		const double* pState = i_States.data();
		for (std::size_t i = 0; i < tree.size(); ++i)
		{
			tree[i]->Update(pState);
			tree[i]->SegmentPose(target[i]);
		}
	};
	std::vector<double> bindPose(i_rSolved.m_NumberOfStates, 0.0);
	std::copy_n(i_BindPose.begin(), std::min(i_BindPose.size(), bindPose.size()), bindPose.begin());
	if (tree.empty() || i_rSolved.m_Frames == 0)
		return true;
	pose(bindPose);
	const VRestSkeleton skeleton = SkeletonOf(i_rTarget, target);
	const VProposal proposal = Propose(i_rSource.RestSkeleton(), skeleton);
	o_rReport.m_BindPoses = CheckPose(i_rSource.RestSkeleton(), skeleton, proposal);
	o_rReport.m_Sides = FindUnequalSides(i_rTarget, skeleton, o_rReport.m_Targets);

	std::vector<VFoot> feet;
	std::vector<VBend> bends;
	for (const ESide side : {ESide::Left, ESide::Right})
	{
		if (const VPart ankle = FindPart(proposal, EFoot, side))
			feet.emplace_back(*ankle, FindPart(proposal, EToe, side), side, i_rSource.BindPoses(), target);
		const auto addBend = [&](const char* i_pName, EBodyPart i_Upper, EBodyPart i_Middle, EBodyPart i_Lower)
		{
			const VPart upper = FindPart(proposal, i_Upper, side);
			const VPart middle = FindPart(proposal, i_Middle, side);
			const VPart lower = FindPart(proposal, i_Lower, side);
			if (upper && middle && lower)
				bends.emplace_back(i_pName, side, *upper, *middle, *lower);
		};
		addBend("knee", EThigh, EShin, EFoot);
		addBend("elbow", EUpperArm, EForeArm, EHand);
	}
	VJumps jumps;
	VPoses joints;
	VPoses source;
	for (std::size_t i = 0; i < i_rSolved.m_Frames; ++i)
	{
		i_rSource.Poses(i_rSolved.m_First + i, joints, source);
		pose(i_rSolved.States(i));
		for (VFoot& rFoot : feet)
			rFoot.Add(source, target);
		for (VBend& rBend : bends)
			rBend.Add(source, target);
		jumps.Add(i_rSolved.m_First + i, source, target);
		if (i_rProgress && !i_rProgress(i + 1, i_rSolved.m_Frames))
			return false;
	}
	std::vector<double> standing;
	for (VFoot& rFoot : feet)
		rFoot.FindStanding(i_rSource.Take().m_Rate, standing);
	o_rReport.m_Floor = Percentile(standing, 0.5);
	for (VFoot& rFoot : feet)
		o_rReport.m_Feet.push_back(rFoot.Quality(i_rSolved.m_First, o_rReport.m_Floor));
	for (const VBend& rBend : bends)
		o_rReport.m_Bends.push_back(rBend.Quality());
	o_rReport.m_Jumps = jumps.Largest();
	for (std::size_t i = 0; i < i_rSolved.m_EndsOfRanges.size(); ++i)
		if (i_rSolved.m_EndsOfRanges[i] > 0)
			o_rReport.m_Ranges.push_back({i, i_rSolved.m_EndsOfRanges[i]});
	return true;
}

} // namespace TakeSolve
