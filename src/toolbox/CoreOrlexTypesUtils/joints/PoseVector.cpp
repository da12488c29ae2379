#include "CoreOrlexTypesUtils/joints/PoseVector.h"

#include "CoreOrlexTypes/JointType.h"

#include <algorithm>

namespace CoreOrlexTypesUtils
{

using CoreOrlexTypes::VSubjectParametrised;

std::vector<double> PoseVector(
    const VSubjectParametrised& i_rSubject, std::vector<double> VSubjectParametrised::VJoint::*i_pStatistic)
{
	std::vector<double> pose;
	pose.reserve(6 + 3 * i_rSubject.m_Segments.size());
	for (const auto& rSegment : i_rSubject.m_Segments)
	{
		const std::vector<double>& rStatistic = rSegment.m_Joint.*i_pStatistic;
		const std::size_t size = CoreOrlexTypes::StateSize(rSegment.m_Joint.m_JointType);
		const std::size_t given = std::min(size, rStatistic.size());
		pose.insert(pose.end(), rStatistic.begin(), rStatistic.begin() + std::ptrdiff_t(given));
		pose.insert(pose.end(), size - given, 0.0);
	}
	return pose;
}

std::vector<double> VSubjectParametrised::VJoint::*PoseMean(ESubjectParametrisedPoseType i_PoseType)
{
	using VJoint = VSubjectParametrised::VJoint;
	switch (i_PoseType)
	{
	case ESubjectParametrisedPoseType::ETPose: return &VJoint::m_TPoseMean;
	case ESubjectParametrisedPoseType::ETemplate: return &VJoint::m_TemplateMean;
	default: return &VJoint::m_Mean;
	}
}

std::vector<double> VSubjectParametrised::VJoint::*PoseCovariance(ESubjectParametrisedPoseType i_PoseType)
{
	using VJoint = VSubjectParametrised::VJoint;
	switch (i_PoseType)
	{
	case ESubjectParametrisedPoseType::ETPose: return &VJoint::m_TPoseCovariance;
	case ESubjectParametrisedPoseType::ETemplate: return &VJoint::m_TemplateCovariance;
	default: return &VJoint::m_Covariance;
	}
}

} // namespace CoreOrlexTypesUtils
