#pragma once

#include "CoreOrlexTypes/SubjectRecord.h"
#include "CoreOrlexTypesUtils/check/SubjectFinding.h"

#include <vector>

namespace CommandLine
{

using VFindings = std::vector<CoreOrlexTypesUtils::VSubjectFinding>;

/// What "check" finds in a subject, with the names of targets, which stand in the application data.
VFindings FindingsOf(const CoreOrlexTypes::VSubjectRecord& i_rRecord);

/// "segment", "target", ...
const char* KindOf(CoreOrlexTypesUtils::VSubjectFinding::EElement i_Element);

} // namespace CommandLine
