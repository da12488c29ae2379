#include "SetupReview/advice/RangeOfMotion.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "ComputeSubjectSolve/ComputeSubjectSolve.h"
#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypesUtils/joints/PoseVector.h"
#include "RetargetSetupCore/BindPose.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "numerics/Rotation.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <limits>
#include <numbers>
#include <unordered_map>

namespace SetupReview
{
namespace
{

using ComputeSubject::VComputeSubjectSolve;
using ComputeSubject::VSolvedFrame;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;
using Rotation::VVector3;
using VJoint = VSubjectParametrised::VJoint;

constexpr double c_Degree = std::numbers::pi / 180.0;
/// To either side of the bind pose, where the file tells no range, and at most.
constexpr double c_UnknownRange = 45.0 * c_Degree;
constexpr double c_WidestRange = 120.0 * c_Degree;
/// Poses to either side.
constexpr int c_Steps = 4;
/// More than at rest, in mm and radians.
constexpr double c_MissedDistance = 10.0;
constexpr double c_MissedAngle = 5.0 * c_Degree;
/// A target without which at most this share of the miss is left pulls against it.
constexpr double c_LeftShare = 0.25;
/// Poses, and solves in which a target is left out; a body takes some hundred of each, and a damaged file may hold more
/// than anybody waits for.
constexpr std::size_t c_MostPoses = 5000;
constexpr std::size_t c_MostTrials = 5000;

/// The performer, and what the character's targets see of it.
class VObserved
{
public:
	VObserved(const VRetargetSetupCore::VSubjectValues& i_rSource, const VSubjectParametrised& i_rTarget)
	    : m_pKinematics(
	        RetargetSetup::KinematicsInBindPose(*i_rSource.m_pParametrised, *i_rSource.m_pSubject, "source")),
	      m_BindPose(CoreOrlexTypesUtils::PoseVector(*i_rSource.m_pParametrised, &VJoint::m_BindPose))
	{
		std::unordered_map<std::string_view, std::size_t> segments;
		const auto& rSegments = i_rSource.m_pParametrised->m_Segments;
		for (std::size_t i = 0; i < rSegments.size(); ++i)
			segments.emplace(rSegments[i].m_Name, i);
		const auto places = [&](const auto& i_rElements)
		{
			std::vector<std::size_t> found;
			for (const auto& rElement : i_rElements)
			{
				const auto segment = segments.find(rElement.m_Name);
				found.push_back(segment == segments.end() ? rSegments.size() : segment->second);
			}
			return found;
		};
		m_Markers = places(i_rTarget.m_Markers);
		m_Rotations = places(i_rTarget.m_Rotations);
		m_bFollowed.resize(rSegments.size());
		for (const std::vector<std::size_t>* const pList : {&m_Markers, &m_Rotations})
			for (const std::size_t followed : *pList)
				for (std::size_t at = followed; at < rSegments.size() && !m_bFollowed[at];
				     at = rSegments[at].m_ParentSegmentIndex)
					m_bFollowed[at] = true;
	}

	bool IsBuilt() const { return m_pKinematics != nullptr; }
	const std::vector<double>& BindPose() const { return m_BindPose; }
	/// Whether a target follows the segment or one beneath it.
	bool IsFollowed(std::size_t i_Segment) const { return m_bFollowed[i_Segment]; }

	ComputeSubject::VObservations At(const std::vector<double>& i_rStates)
	{
		constexpr double c_Missing = std::numeric_limits<double>::quiet_NaN();
		m_pKinematics->Update(i_rStates.data());
		m_Positions.assign(3 * m_Markers.size(), c_Missing);
		m_Turns.assign(9 * m_Rotations.size(), c_Missing);
		const std::size_t count = m_pKinematics->NumberOfSegments();
		for (std::size_t i = 0; i < m_Markers.size(); ++i)
			if (m_Markers[i] < count)
				std::ranges::copy(m_pKinematics->Segment(m_Markers[i]).SegmentPose().t, &m_Positions[3 * i]);
		for (std::size_t i = 0; i < m_Rotations.size(); ++i)
			if (m_Rotations[i] < count)
				std::ranges::copy(m_pKinematics->Segment(m_Rotations[i]).SegmentPose().R, &m_Turns[9 * i]);
		return {m_Positions, m_Turns};
	}

private:
	std::unique_ptr<ComputeSubject::VComputeSubjectFK> m_pKinematics;
	std::vector<double> m_BindPose;
	/// The performer's segments by the indices of what is observed.
	std::vector<std::size_t> m_Markers;
	std::vector<std::size_t> m_Rotations;
	std::vector<bool> m_bFollowed;
	std::vector<double> m_Positions;
	std::vector<double> m_Turns;
};

/// How far a joint goes about its own axis from the middle of its range.
double RangeAbout(const VJoint& i_rJoint, std::size_t i_Axis, std::size_t i_Size)
{
	double range = c_UnknownRange;
	if (i_rJoint.m_RangeMatrix.size() == i_Size * i_Size)
		if (const double square = i_rJoint.m_RangeMatrix[i_Axis * i_Size + i_Axis]; square > 0.0)
			range = std::sqrt(square);
	return std::min(std::isfinite(range) ? range : c_UnknownRange, c_WidestRange);
}

std::vector<double> Turned(
    std::vector<double> i_States, std::size_t i_First, std::size_t i_Size, std::size_t i_Axis, double i_Angle)
{
	if (i_Size < 3)
	{
		i_States[i_First + i_Axis] += i_Angle;
		return i_States;
	}
	const VVector3 before{i_States[i_First], i_States[i_First + 1], i_States[i_First + 2]};
	VVector3 turn{};
	turn[i_Axis] = i_Angle;
	const VVector3 now = Rotation::AngleAxisFromRotationMatrix(
	    Rotation::Product(Rotation::RotationMatrixFromAngleAxis(before), Rotation::RotationMatrixFromAngleAxis(turn)));
	std::ranges::copy(now, i_States.begin() + std::ptrdiff_t(i_First));
	return i_States;
}

std::string ValueWords(double i_Value, bool i_bRotation)
{
	char text[32];
	const double value = i_bRotation ? i_Value / c_Degree : i_Value;
	const auto end = std::to_chars(text, text + sizeof(text), std::min(value, 1e9), std::chars_format::fixed, 1);
	return std::string(text, end.ptr) + (i_bRotation ? " degrees" : " mm");
}

class VRange
{
public:
	VRange(const VRetargetSetupCore::VSubjectValues& i_rSource, const VRetargetSetupCore::VSubjectValues& i_rTarget)
	    : m_rSource(*i_rSource.m_pParametrised), m_rTarget(*i_rTarget.m_pParametrised),
	      m_rData(*i_rTarget.m_pApplicationData), m_rSubject(*i_rTarget.m_pSubject), m_Observed(i_rSource, m_rTarget),
	      m_BindPose(CoreOrlexTypesUtils::PoseVector(m_rTarget, &VJoint::m_BindPose))
	{
	}

	VRangeOfMotion Run()
	{
		VComputeSubjectSolve solve(m_rSubject, m_BindPose);
		if (!m_Observed.IsBuilt() || m_rSubject.m_Targets.empty() || solve.NumberOfActiveStates() == 0)
		{
			m_Result.m_Refusal = !m_Observed.IsBuilt() ? "the performer's segments make no tree"
			    : m_rSubject.m_Targets.empty()         ? "there is no target"
			                                           : "there is no joint that a target moves";
			return m_Result;
		}
		const VSolvedFrame& rRest = solve.Solve(m_Observed.At(m_Observed.BindPose()));
		m_AtRest = rRest.m_Residuals;
		const std::vector<double> rest = rRest.m_States;
		m_Worst.resize(m_AtRest.size());
		std::size_t first = 0;
		for (std::size_t i = 0; i < m_rSource.m_Segments.size(); ++i)
		{
			const VJoint& rJoint = m_rSource.m_Segments[i].m_Joint;
			const std::size_t size = CoreOrlexTypes::StateSize(rJoint.m_JointType);
			// Where the whole body turns, nothing of it is bent.
			if (rJoint.m_JointType != VJoint::EFree && rJoint.m_JointType != VJoint::ESlider
			    && m_Observed.IsFollowed(i))
				for (std::size_t axis = 0; axis < size; ++axis)
					for (const double sign : {1.0, -1.0})
					{
						solve.StartFrom(rest);
						m_Result.m_bCutShort = m_Result.m_Poses >= c_MostPoses;
						for (int step = 1; step <= c_Steps && !m_Result.m_bCutShort; ++step)
							Look(solve, {i, first, size, axis, sign * RangeAbout(rJoint, axis, size) * step / c_Steps});
					}
			first += size;
		}
		FindOpponents();
		return m_Result;
	}

private:
	/// One pose of the performer: its bind pose, and the angle of one joint about one axis.
	struct VPoseOfRange
	{
		std::size_t m_Segment = 0;
		std::size_t m_First = 0;
		std::size_t m_Size = 0;
		std::size_t m_Axis = 0;
		double m_Angle = 0.0;
	};

	struct VWorst
	{
		double m_Residual = -1.0;
		VPoseOfRange m_Pose;
		std::vector<double> m_States;
	};

	bool IsRotation(std::size_t i_Target) const
	{
		return m_rSubject.m_Targets[i_Target].m_Type == VSubject::VTarget::ELocalRotationToWorldRotation;
	}

	ComputeSubject::VObservations ObservedIn(const VPoseOfRange& i_rPose)
	{
		return m_Observed.At(
		    Turned(m_Observed.BindPose(), i_rPose.m_First, i_rPose.m_Size, i_rPose.m_Axis, i_rPose.m_Angle));
	}

	void Look(VComputeSubjectSolve& io_rSolve, const VPoseOfRange& i_rPose)
	{
		const VSolvedFrame& rFrame = io_rSolve.Solve(ObservedIn(i_rPose));
		++m_Result.m_Poses;
		m_Result.m_NotConverged += !rFrame.m_bConverged;
		for (std::size_t i = 0; i < m_Worst.size(); ++i)
			if (rFrame.m_Residuals[i] > m_Worst[i].m_Residual)
				m_Worst[i] = {rFrame.m_Residuals[i], i_rPose, rFrame.m_States};
	}

	bool IsAbove(std::size_t i_Above, std::size_t i_Segment) const
	{
		for (std::size_t at = i_Segment; at < m_rSubject.m_Segments.size();
		     at = m_rSubject.m_Segments[at].m_ParentSegmentIndex)
			if (at == i_Above)
				return true;
		return false;
	}

	/// Whether one of the two hangs on the other.
	bool OfOneLimb(std::size_t i_A, std::size_t i_B) const
	{
		const auto& rA = m_rSubject.m_Targets[i_A].m_SegmentIndices;
		const auto& rB = m_rSubject.m_Targets[i_B].m_SegmentIndices;
		return !rA.empty() && !rB.empty() && (IsAbove(rA.front(), rB.front()) || IsAbove(rB.front(), rA.front()));
	}

	double ResidualWithout(std::size_t i_Target, std::size_t i_Other, const VWorst& i_rWorst)
	{
		VSubject subject = m_rSubject;
		subject.m_Targets[i_Other].m_Weight = 0.0;
		VComputeSubjectSolve solve(subject, m_BindPose);
		solve.StartFrom(i_rWorst.m_States);
		return solve.Solve(ObservedIn(i_rWorst.m_Pose)).m_Residuals[i_Target];
	}

	void FindOpponents()
	{
		std::size_t trials = 0;
		for (std::size_t i = 0; i < m_Worst.size(); ++i)
		{
			const VWorst& rWorst = m_Worst[i];
			const bool bRotation = IsRotation(i);
			const double atRest = std::isfinite(m_AtRest[i]) ? m_AtRest[i] : 0.0;
			if (!(rWorst.m_Residual > atRest + (bRotation ? c_MissedAngle : c_MissedDistance)))
				continue;
			if (trials >= c_MostTrials)
			{
				m_Result.m_bCutShort = true;
				return;
			}
			VRangeConflict conflict{i, atRest, rWorst.m_Residual, bRotation, rWorst.m_Pose.m_Segment,
			    rWorst.m_Pose.m_Axis, rWorst.m_Pose.m_Angle, i, rWorst.m_Residual * c_LeftShare, {}, {}, {}};
			for (std::size_t other = 0; other < m_Worst.size(); ++other)
				if (other != i && m_Worst[other].m_Residual >= 0.0 && OfOneLimb(i, other))
				{
					++trials;
					if (const double without = ResidualWithout(i, other, rWorst); without < conflict.m_Without)
					{
						conflict.m_Without = without;
						conflict.m_Against = other;
					}
				}
			if (conflict.m_Against == i)
				++m_Result.m_Unopposed;
			else
				m_Result.m_Conflicts.push_back(std::move(conflict));
		}
		KeepOneOfTwo();
		std::ranges::stable_sort(m_Result.m_Conflicts, {}, &VRangeConflict::m_Against);
		for (VRangeConflict& rConflict : m_Result.m_Conflicts)
		{
			rConflict.m_TargetName = NameOfTarget(rConflict.m_Target);
			rConflict.m_AgainstName = NameOfTarget(rConflict.m_Against);
			rConflict.m_Words = WordsFor(rConflict);
		}
	}

	/// Of two that pull against each other.
	void KeepOneOfTwo()
	{
		std::vector<VRangeConflict>& rConflicts = m_Result.m_Conflicts;
		std::vector<std::size_t> pulls(m_Worst.size());
		for (const VRangeConflict& rConflict : rConflicts)
			++pulls[rConflict.m_Against];
		const auto goes = [&, before = rConflicts](const VRangeConflict& i_rConflict)
		{
			const bool bMutual = std::ranges::any_of(before,
			    [&](const VRangeConflict& i_rOther)
			    { return i_rOther.m_Target == i_rConflict.m_Against && i_rOther.m_Against == i_rConflict.m_Target; });
			const std::size_t puller = pulls[i_rConflict.m_Against];
			const std::size_t pulled = pulls[i_rConflict.m_Target];
			return bMutual && (puller != pulled ? puller < pulled : i_rConflict.m_Against > i_rConflict.m_Target);
		};
		std::erase_if(rConflicts, goes);
	}

	std::string NameOfTarget(std::size_t i_Target) const
	{
		return std::to_string(i_Target)
		    + (i_Target < m_rData.m_Targets.size() ? " \"" + m_rData.m_Targets[i_Target].m_Name + "\"" : std::string());
	}

	std::string WordsFor(const VRangeConflict& i_rConflict) const
	{
		const bool bRotation = i_rConflict.m_bRotation;
		return "is missed by " + ValueWords(i_rConflict.m_AtWorst, bRotation) + " where the performer's \""
		    + m_rSource.m_Segments[i_rConflict.m_SourceSegment].m_Name + "\" turns by "
		    + ValueWords(std::abs(i_rConflict.m_Angle), true) + " about its " + "XYZ"[i_rConflict.m_Axis]
		    + " axis, and without that by " + ValueWords(i_rConflict.m_Without, bRotation);
	}

	const VSubjectParametrised& m_rSource;
	const VSubjectParametrised& m_rTarget;
	const CoreOrlexTypes::VSubjectApplicationData& m_rData;
	const VSubject& m_rSubject;
	VObserved m_Observed;
	const std::vector<double> m_BindPose;
	std::vector<double> m_AtRest;
	std::vector<VWorst> m_Worst;
	VRangeOfMotion m_Result;
};

} // namespace

VRangeOfMotion GoThroughRange(
    const VRetargetSetupCore::VSubjectValues& i_rSource, const VRetargetSetupCore::VSubjectValues& i_rTarget)
{
	try
	{
		return VRange(i_rSource, i_rTarget).Run();
	}
	catch (const ComputeSubject::VConstructionException&)
	{
		VRangeOfMotion none;
		none.m_Refusal = "the character has a joint or a target that no kinematics fit";
		return none;
	}
}

} // namespace SetupReview
