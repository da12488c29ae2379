#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"

/// For both subject types, TSubject; logs to the category "SubjectUtils" or "SubjectParametrisedUtils".
namespace CoreOrlexTypesUtils::SubjectParametrisedUtils
{

/// Labelling needs a single point target for each marker: of several only the first is kept. Point targets are put in
/// the order of their markers; all others, which labelers do not support, follow in their old order. What is dropped or
/// not supported is told as a warning. The application data's targets follow; one that is missing or has no name gets
/// the name "Target_" and its index.
template <typename TSubject>
void MakeOneTargetPerMarker(TSubject& io_rSubject, CoreOrlexTypes::VSubjectApplicationData& io_rAppData);

/// Whether a subject can be calibrated: every marker has one target, and all are point targets. Every kind of fault is
/// told as an error.
template <typename TSubject>
bool CheckCalibration(const TSubject& i_rSubject);

} // namespace CoreOrlexTypesUtils::SubjectParametrisedUtils
