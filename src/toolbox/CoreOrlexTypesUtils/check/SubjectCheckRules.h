#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypesUtils/check/SubjectCheckFindings.h"

/// The rules themselves, for single elements. Each returns whether the element is good.
namespace CoreOrlexTypesUtils::SubjectCheck
{

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;

bool CheckMarkers(const std::vector<VSubject::VMarker>& i_rMarkers, IFindings& io_rFindings);
bool CheckTarget(const VSubject& i_rSubject, std::size_t i_TargetIndex, IFindings& io_rFindings);
bool CheckTargetTemplate(const VSubjectParametrised::VTarget& i_rTarget, const VReport& i_rReport);
bool CheckJoint(const VSubject::VJoint& i_rJoint, const VReport& i_rReport);
bool CheckJointTemplate(const VSubjectParametrised::VJoint& i_rJoint, const VReport& i_rReport);
/// The joint, and the place in the tree.
bool CheckSegment(const VSubject& i_rSubject, std::size_t i_SegmentIndex, IFindings& io_rFindings);

/// The static parameters, and the expressions of segments and targets over them.
bool CheckExpressions(const VSubjectParametrised& i_rSubject, IFindings& io_rFindings);

} // namespace CoreOrlexTypesUtils::SubjectCheck
