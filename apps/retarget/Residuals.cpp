#include "retarget/Residuals.h"

#include "RetargetSetupDocument/RetargetTargets.h"

#include <algorithm>
#include <cmath>

namespace CommandLine
{
namespace
{

using CoreOrlexTypes::VSubject;
using Rotation::VPose;
using Rotation::VVector3;

double Length(const VVector3& i_rVector)
{
	return std::hypot(i_rVector[0], i_rVector[1], i_rVector[2]);
}

VResidual Residual(const VPose<double>& i_rSource, const VPose<double>& i_rTarget, const VSubject::VTarget& i_rOffset)
{
	if (i_rOffset.m_State.size() != 3)
		return {};
	const VVector3 state{i_rOffset.m_State[0], i_rOffset.m_State[1], i_rOffset.m_State[2]};
	switch (i_rOffset.m_Type)
	{
	case VSubject::VTarget::ELocalPointToWorldPoint:
	case VSubject::VTarget::ELocalPointToWorldPointGaussian:
	{
		const VVector3 point = Rotation::Apply(i_rTarget, state);
		return {Length({point[0] - i_rSource.t[0], point[1] - i_rSource.t[1], point[2] - i_rSource.t[2]}), {}};
	}
	case VSubject::VTarget::ELocalRotationToWorldRotation:
	{
		const auto rotation = Rotation::Product(i_rTarget.R, Rotation::RotationMatrixFromAngleAxis(state));
		const auto between = Rotation::Product(Rotation::Transposed(i_rSource.R), rotation);
		return {{}, Length(Rotation::CanonicalAngleAxis(Rotation::AngleAxisFromRotationMatrix(between)))};
	}
	default: return {};
	}
}

} // namespace

std::vector<VResidual> Residuals(
    const VRetargetSetup::VSubjectValues& i_rSource, const VRetargetSetup::VSubjectValues& i_rTarget)
{
	const auto& rSubject = *i_rTarget.m_pParametrised;
	std::vector<VResidual> residuals(rSubject.m_Targets.size());
	const auto sourcePoses = BindPosesOf(i_rSource, "source");
	const auto targetPoses = BindPosesOf(i_rTarget, "target");
	const auto& rSourceSegments = i_rSource.m_pParametrised->m_Segments;
	for (std::size_t i = 0; i < residuals.size(); ++i)
	{
		const auto& rTarget = rSubject.m_Targets[i];
		const std::string* const pName = RetargetSetup::SourceName(rSubject, rTarget);
		if (!pName || rTarget.m_SegmentIndices.empty())
			continue;
		const auto found = std::find_if(rSourceSegments.begin(), rSourceSegments.end(),
		    [&](const auto& i_rSegment) { return i_rSegment.m_Name == *pName; });
		const std::size_t source = std::size_t(found - rSourceSegments.begin());
		const std::size_t target = rTarget.m_SegmentIndices.front();
		if (source < sourcePoses.size() && target < targetPoses.size())
			residuals[i] = Residual(sourcePoses[source], targetPoses[target], i_rTarget.m_pSubject->m_Targets[i]);
	}
	return residuals;
}

} // namespace CommandLine
