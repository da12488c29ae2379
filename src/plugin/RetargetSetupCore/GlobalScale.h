#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"

namespace RetargetSetup
{

/// The dynamic parameter that every length of a target subject is a multiple of.
inline constexpr const char* c_GlobalScaleName = "GlobalScale";

/// Finite and above 0.
bool IsUsableScale(double i_Scale);

/// Leaves exactly one dynamic parameter, the scale, with i_Scale as its prior and value.
void SetGlobalScale(CoreOrlexTypes::VSubjectParametrised& io_rSubject, double i_Scale);

/// The value of the first dynamic parameter of that name, 1.0 if there is none.
double GetGlobalScale(const CoreOrlexTypes::VSubjectParametrised& i_rSubject);

/// The names of the dynamic parameters that SetGlobalScale would drop, joined by "', '"; empty if it drops none.
std::string DroppedParameters(const CoreOrlexTypes::VSubjectParametrised& i_rSubject);

/// Those of them, in the same form, that expressions use, which would then have no value.
std::string LostParameters(const CoreOrlexTypes::VSubjectParametrised& i_rSubject);

} // namespace RetargetSetup
