#pragma once

#include "CoreOrlexTypes/Subject.h"

#include <vector>

namespace TakeSolve
{

/// A subject in numbers, with the states of its bind pose. A target that has no numbers is of no type.
struct VPosedSubject
{
	explicit VPosedSubject(const CoreOrlexTypes::VSubjectParametrised& i_rSubject);

	CoreOrlexTypes::VSubject m_Subject;
	std::vector<double> m_BindPose;
};

} // namespace TakeSolve
