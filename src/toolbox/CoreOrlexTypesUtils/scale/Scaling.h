#pragma once

#include "CoreOrlexTypes/Subject.h"

/// A factor on everything that is a length: positions, and lengths in the states of joints and targets, by the factor;
/// their covariances by its square. Rotations, angles and directions stay, and so does the size of a marker, which is
/// the same ball on a taller subject. What is of a size that does not fit its type is left as it is.
namespace CoreOrlexTypesUtils
{

/// Logs to the category "SubjectUtils".
namespace TemplateSubjectUtils
{

void ScaleJoint(CoreOrlexTypes::VSubject::VJoint& io_rJoint, double i_Factor);
void ScaleTarget(CoreOrlexTypes::VSubject::VTarget& io_rTarget, double i_Factor);

/// False, with nothing changed, for a factor that is not finite and above 0.
bool ScaleSubject(CoreOrlexTypes::VSubject& io_rSubject, double i_Factor);

} // namespace TemplateSubjectUtils

/// Logs to the category "SubjectParametrisedUtils".
namespace SubjectParametrisedUtils
{

/// All variants of the statistics, the bind pose too. A value that is not set stays so.
void ScaleJoint(CoreOrlexTypes::VSubjectParametrised::VJoint& io_rJoint, double i_Factor);

/// A length that is a number is multiplied, any other becomes (expression)*factor.
void ScaleTarget(CoreOrlexTypes::VSubjectParametrised::VTarget& io_rTarget, double i_Factor);

/// Scales by the static parameters where it can: one that occurs in lengths only, each of them a multiple of static
/// parameters alone, is multiplied in its Prior and UserValue where these are set; one that lives by its default
/// expression hands the demand on to the parameters in that. A length without parameters is multiplied as a number. Any
/// other length becomes (expression)*factor, and none of its static parameters is touched. So every length is the
/// factor times what it was, and nothing else changes.
/// False, with nothing changed, for a factor that is not finite and above 0, for static parameters that cannot be
/// evaluated, and for values that would leave the finite range (all told).
bool ScaleSubject(CoreOrlexTypes::VSubjectParametrised& io_rSubject, double i_Factor);

} // namespace SubjectParametrisedUtils

} // namespace CoreOrlexTypesUtils
