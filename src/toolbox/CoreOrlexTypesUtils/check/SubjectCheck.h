#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypesUtils/check/SubjectFinding.h"

#include <vector>

/// Whether a subject is well formed. Findings are errors of the log category "SubjectCheck"; nothing is repaired,
/// nothing thrown, and no input is too broken to be checked. Arguments are only read, so that any thread may check.
namespace CoreOrlexTypesUtils
{

/// Markers, then targets, then segments; ends at the first of these elements that fails.
bool CheckSubject(const CoreOrlexTypes::VSubject& i_rSubject);

/// No two markers may share an id or a name; all that do are told.
bool CheckMarkers(const std::vector<CoreOrlexTypes::VSubject::VMarker>& i_rMarkers);

/// Sizes by type, then indices, then view normals; ends at the first finding.
bool CheckTarget(const CoreOrlexTypes::VSubject& i_rSubject, std::size_t i_TargetIndex);

/// Statistics must be there, ranges may be empty; all findings are told.
bool CheckJoint(const CoreOrlexTypes::VSubject::VJoint& i_rJoint);

/// The subject evaluated to numbers, then the template statistics, weights and expressions, which are all looked at
/// whatever was found before.
bool CheckSubjectParametrised(const CoreOrlexTypes::VSubjectParametrised& i_rSubject);

/// Template statistics and ranges and the bind pose, each of which may be empty; all findings are told.
bool CheckJointTemplate(const CoreOrlexTypes::VSubjectParametrised::VJoint& i_rJoint);

/// Weights, template covariance and view normals; ends at the first finding. A negative weight has no message.
bool CheckTargetTemplate(const CoreOrlexTypes::VSubjectParametrised::VTarget& i_rTarget);

/// All that CheckSubjectParametrised can find, in its order: it goes on where that function ends, and tells nothing to
/// the log.
std::vector<VSubjectFinding> FindSubjectFaults(const CoreOrlexTypes::VSubjectParametrised& i_rSubject);

} // namespace CoreOrlexTypesUtils
