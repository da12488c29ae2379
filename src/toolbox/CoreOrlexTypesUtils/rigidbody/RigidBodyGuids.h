#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"

namespace CoreOrlexTypesUtils::RigidBodyUtils
{

/// Gives each component of the targets' states a static parameter of its own, of the same value, whose name is a random
/// UUID, so that a calibration can refine it; the component becomes that name, in quotes. A component that used one
/// static parameter passes that one's flags on, and one that is such a parameter already stays. The parameters that
/// were used stay in the subject.
/// False, with nothing changed, for components that cannot be evaluated or use several parameters or a dynamic one
/// (told, category "RigidBodyUtils").
bool AddGuids(CoreOrlexTypes::VSubjectParametrised& io_rSubject);

} // namespace CoreOrlexTypesUtils::RigidBodyUtils
