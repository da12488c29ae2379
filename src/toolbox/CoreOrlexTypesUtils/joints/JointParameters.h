#pragma once

#include "CoreOrlexTypesUtils/joints/PoseVector.h"

#include <map>
#include <string>
#include <vector>

namespace CoreOrlexTypesUtils::SubjectParametrisedUtils
{

/// The statistics of joints by joint name, so that they can be carried to another subject of the same model.
struct VJointParameters
{
	struct VStatistics
	{
		std::vector<double> m_Mean;
		std::vector<double> m_Covariance;
	};

	std::map<std::string, VStatistics> m_SubjectDynamicParameters;
};

/// Of the joints that have degrees of freedom; of two of one name (asserted) the first. A joint without any is asserted
/// to have no T-pose.
VJointParameters GatherJointParameters(
    const CoreOrlexTypes::VSubjectParametrised& i_rSubject, ESubjectParametrisedPoseType i_PoseType);

/// Gives joints the statistics that stand under their name, where these have the joint's sizes or are empty.
void ApplyJointParameters(const VJointParameters& i_rParameters, ESubjectParametrisedPoseType i_PoseType,
    CoreOrlexTypes::VSubjectParametrised& io_rSubject);

} // namespace CoreOrlexTypesUtils::SubjectParametrisedUtils
