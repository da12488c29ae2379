#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "TakeSolve/TakeSolve.h"

#include <memory>
#include <vector>

namespace CommandLine
{

/// A subject in numbers, with the states of its bind pose. Targets that do not evaluate have no type.
struct VPosed
{
	explicit VPosed(const CoreOrlexTypes::VSubjectParametrised& i_rSubject);

	CoreOrlexTypes::VSubject m_Subject;
	std::vector<double> m_BindPose;
};

/// The same subject with a pose as its bind pose, which is only to be looked at: all joints' states, in the order of
/// the segments.
CoreOrlexTypes::VSubjectParametrised WithBindPose(
    CoreOrlexTypes::VSubjectParametrised i_Subject, std::span<const double> i_States);

/// The same with world poses of its segments, which its joints may not be able to take: all are free in the result.
CoreOrlexTypes::VSubjectParametrised WithWorldPoses(
    CoreOrlexTypes::VSubjectParametrised i_Subject, const std::vector<Rotation::VPose<double>>& i_rPoses);

} // namespace CommandLine
