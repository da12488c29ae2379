#include "retarget/subject/Residuals.h"

#include "retarget/subject/TargetKinematics.h"

#include "ComputeSubjectFK/ComputeSegmentFK.h"
#include "ComputeSubjectFK/TargetFKInterfaces.h"
#include "CoreOrlexTypesUtils/joints/PoseVector.h"

#include <algorithm>
#include <cmath>
#include <numbers>
#include <unordered_map>

namespace CommandLine
{
namespace
{

using ComputeSubject::ITargetFK;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;
using Rotation::VPose;
using Rotation::VVector3;

VVector3 Difference(const VVector3& i_rA, const VVector3& i_rB)
{
	return {i_rA[0] - i_rB[0], i_rA[1] - i_rB[1], i_rA[2] - i_rB[2]};
}

double Dot(const VVector3& i_rA, const VVector3& i_rB)
{
	return i_rA[0] * i_rB[0] + i_rA[1] * i_rB[1] + i_rA[2] * i_rB[2];
}

double Length(const VVector3& i_rVector)
{
	return std::hypot(i_rVector[0], i_rVector[1], i_rVector[2]);
}

double Angle(const Rotation::VMatrix3& i_rA, const Rotation::VMatrix3& i_rB)
{
	const auto between = Rotation::Product(Rotation::Transposed(i_rA), i_rB);
	return Length(Rotation::CanonicalAngleAxis(Rotation::AngleAxisFromRotationMatrix(between)));
}

double DistanceFromLine(const VVector3& i_rPoint, const VVector3& i_rOnLine1, const VVector3& i_rOnLine2)
{
	const VVector3 along = Difference(i_rOnLine2, i_rOnLine1);
	const VVector3 to = Difference(i_rPoint, i_rOnLine1);
	const double length = Length(along);
	if (!(length > 0.0))
		return Length(to);
	return Length({along[1] * to[2] - along[2] * to[1], along[2] * to[0] - along[0] * to[2],
	           along[0] * to[1] - along[1] * to[0]})
	    / length;
}

/// The source's segments by name, of several the first.
class VSourcePoses
{
public:
	explicit VSourcePoses(const VRetargetSetupCore::VSubjectValues& i_rSource)
	    : m_Poses(BindPosesOf(i_rSource, "source"))
	{
		const auto& rSegments = i_rSource.m_pParametrised->m_Segments;
		for (std::size_t i = 0; i < std::min(rSegments.size(), m_Poses.size()); ++i)
			m_Indices.emplace(rSegments[i].m_Name, i);
	}

	/// Null if there is none.
	const VPose<double>* Find(const std::string& i_rName) const
	{
		const auto found = m_Indices.find(i_rName);
		return found == m_Indices.end() ? nullptr : &m_Poses[found->second];
	}

private:
	std::vector<VPose<double>> m_Poses;
	std::unordered_map<std::string, std::size_t> m_Indices;
};

void PlaceInBindPose(const VSubjectParametrised& i_rSubject, const ComputeSubject::VSegmentTree& i_rTree)
{
	const auto state = CoreOrlexTypesUtils::PoseVector(i_rSubject, &VSubjectParametrised::VJoint::m_BindPose);
	const double* pState = state.data();
	for (const auto& rpSegment : i_rTree)
		rpSegment->Update(pState);
}

std::optional<double> LargestMarkerDistance(
    const VSourcePoses& i_rSource, const std::vector<std::string>& i_rNames, const ITargetFK& i_rBody)
{
	double largest = 0.0;
	if (i_rNames.size() != i_rBody.MarkerGroup()->MarkerIndices().size())
		return {};
	for (std::size_t i = 0; i < i_rNames.size(); ++i)
	{
		const auto* const pSource = i_rSource.Find(i_rNames[i]);
		if (!pSource)
			return {};
		largest = std::max(largest, Length(Difference(i_rBody.FromPointGroup()->WorldPoint(i), pSource->t)));
	}
	return largest;
}

VResidual FromKinematics(const VPose<double>& i_rSource, const ITargetFK& i_rTarget)
{
	if (const auto& rpPoint = i_rTarget.FromLocalPoint())
		return {Length(Difference(rpPoint->WorldPoint(), i_rSource.t)), {}};
	if (const auto& rpLine = i_rTarget.FromLocalLine())
		return {DistanceFromLine(i_rSource.t, rpLine->WorldPoint1(), rpLine->WorldPoint2()), {}};
	if (const auto& rpPlane = i_rTarget.FromLocalPlane(); rpPlane && Length(rpPlane->WorldNormal()) > 0.0)
		return {std::abs(Dot(rpPlane->WorldNormal(), i_rSource.t) + rpPlane->WorldOffset()), {}};
	if (const auto& rpRotation = i_rTarget.FromLocalRotation())
		return {{}, Angle(i_rSource.R, rpRotation->WorldRotation())};
	return {};
}

/// The same of an offset in the segment's pose; i_Otherwise for types that hold none.
VResidual FromOffset(const VPose<double>& i_rSource, const VPose<double>& i_rSegment,
    const VSubject::VTarget& i_rTarget, const VResidual& i_rOtherwise)
{
	const bool bPoint = i_rTarget.m_Type == VSubject::VTarget::ELocalPointToWorldPoint
	    || i_rTarget.m_Type == VSubject::VTarget::ELocalPointToWorldPointGaussian;
	if (!bPoint && i_rTarget.m_Type != VSubject::VTarget::ELocalRotationToWorldRotation)
		return i_rOtherwise;
	if (i_rTarget.m_State.size() != 3)
		return {};
	const VVector3 state{i_rTarget.m_State[0], i_rTarget.m_State[1], i_rTarget.m_State[2]};
	if (bPoint)
		return {Length(Difference(Rotation::Apply(i_rSegment, state), i_rSource.t)), {}};
	return {{}, Angle(i_rSource.R, Rotation::Product(i_rSegment.R, Rotation::RotationMatrixFromAngleAxis(state)))};
}

} // namespace

std::vector<std::string> FollowedNames(
    const VSubjectParametrised& i_rSubject, const VSubjectParametrised::VTarget& i_rTarget)
{
	std::vector<std::string> names;
	const auto append = [&](const std::vector<std::uint32_t>& i_rIndices, const auto& i_rNamed)
	{
		for (const std::uint32_t index : i_rIndices)
			if (index < i_rNamed.size())
				names.push_back(i_rNamed[index].m_Name);
	};
	append(i_rTarget.m_MarkerIndices, i_rSubject.m_Markers);
	if (names.empty())
		append(i_rTarget.m_RotationObservationIndices, i_rSubject.m_Rotations);
	return names;
}

std::vector<VTargetResidual> Residuals(
    const VRetargetSetupCore::VSubjectValues& i_rSource, const VRetargetSetupCore::VSubjectValues& i_rTarget)
{
	const auto& rSubject = *i_rTarget.m_pParametrised;
	std::vector<VTargetResidual> residuals(rSubject.m_Targets.size());
	const VSourcePoses source(i_rSource);
	const auto segmentPoses = BindPosesOf(i_rTarget, "target");
	if (segmentPoses.empty())
		return residuals;
	const ComputeSubject::VSegmentTree tree = SegmentKinematics(*i_rTarget.m_pSubject);
	PlaceInBindPose(rSubject, tree);
	for (std::size_t i = 0; i < residuals.size(); ++i)
	{
		const VSubject::VTarget& rTarget = i_rTarget.m_pSubject->m_Targets[i];
		const auto pTarget = TargetKinematics(rTarget, tree);
		if (pTarget)
			pTarget->ComputeTargetFK()->Update();
		const std::vector<std::string> names = FollowedNames(rSubject, rSubject.m_Targets[i]);
		VTargetResidual& rResidual = residuals[i];
		if (pTarget && pTarget->FromPointGroup())
		{
			rResidual.m_Target.m_Distance = LargestMarkerDistance(source, names, *pTarget);
			rResidual.m_Offset = rResidual.m_Target;
			continue;
		}
		const VPose<double>* const pSource = names.empty() ? nullptr : source.Find(names.front());
		if (!pSource || rTarget.m_SegmentIndices.empty() || rTarget.m_SegmentIndices.front() >= segmentPoses.size())
			continue;
		if (pTarget)
			rResidual.m_Target = FromKinematics(*pSource, *pTarget);
		rResidual.m_Offset =
		    FromOffset(*pSource, segmentPoses[rTarget.m_SegmentIndices.front()], rTarget, rResidual.m_Target);
	}
	return residuals;
}

std::optional<std::size_t> WorstDisagreement(const std::vector<VTargetResidual>& i_rResiduals)
{
	constexpr double c_SameDistance = 0.01;
	constexpr double c_SameAngle = 0.001 * std::numbers::pi / 180.0;
	std::optional<std::size_t> worst;
	double largest = 1.0;
	for (std::size_t i = 0; i < i_rResiduals.size(); ++i)
	{
		const auto& [offset, target] = i_rResiduals[i];
		double apart = 0.0;
		if (offset.m_Distance && target.m_Distance)
			apart = std::abs(*offset.m_Distance - *target.m_Distance) / c_SameDistance;
		else if (offset.m_Angle && target.m_Angle)
			apart = std::abs(*offset.m_Angle - *target.m_Angle) / c_SameAngle;
		if (!(apart > largest))
			continue;
		largest = apart;
		worst = i;
	}
	return worst;
}

} // namespace CommandLine
