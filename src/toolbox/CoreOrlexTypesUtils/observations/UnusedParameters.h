#pragma once

#include "CoreOrlexTypes/Subject.h"

#include <set>
#include <string>

namespace CoreOrlexTypesUtils
{

/// The static and dynamic parameters that an expression of the subject uses.
std::set<std::string> ParametersInUse(const CoreOrlexTypes::VSubjectParametrised& i_rSubject);

/// Drops the static parameters that a target, which has left the subject or has been written anew, used in its state
/// and that no expression of the subject uses.
void DropParametersOf(
    const CoreOrlexTypes::VSubjectParametrised::VTarget& i_rTarget, CoreOrlexTypes::VSubjectParametrised& io_rSubject);

/// Has no parameters.
inline void DropParametersOf(const CoreOrlexTypes::VSubject::VTarget&, CoreOrlexTypes::VSubject&) {}

} // namespace CoreOrlexTypesUtils
