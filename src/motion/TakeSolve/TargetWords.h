#pragma once

#include "CoreOrlexTypes/Subject.h"

#include <string>

namespace TakeSolve
{

/// Whether residuals of a target are angles, in radians; others are mm.
bool IsRotationTarget(const CoreOrlexTypes::VSubject::VTarget& i_rTarget);
/// The residuals' unit, and what they are multiplied by for it.
const char* UnitOf(const CoreOrlexTypes::VSubject::VTarget& i_rTarget);
double UnitFactor(const CoreOrlexTypes::VSubject::VTarget& i_rTarget);
/// What a target follows, and the segment of the character that it stands on.
std::string SourceOf(const CoreOrlexTypes::VSubject& i_rSubject, const CoreOrlexTypes::VSubject::VTarget& i_rTarget);
std::string TargetOf(const CoreOrlexTypes::VSubject& i_rSubject, const CoreOrlexTypes::VSubject::VTarget& i_rTarget);

} // namespace TakeSolve
