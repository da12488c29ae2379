#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"

namespace RetargetSetup
{

/// A T-pose for a subject whose file has none: the root one metre above the floor, turned upright if the head lies
/// along Y, and all Ball joints at rest. Does nothing without segments.
void ApplyDefaultPose(CoreOrlexTypes::VSubjectParametrised& io_rSubject);

/// Moves the T-pose of every joint into its bind pose; the T-pose's covariance goes.
void AdoptTPoseAsBindPose(CoreOrlexTypes::VSubjectParametrised& io_rSubject);

/// True if there are no segments, or the first has no bind pose.
bool LacksBindPose(const CoreOrlexTypes::VSubjectParametrised& i_rSubject);

} // namespace RetargetSetup
