#pragma once

#include "retarget/text/Output.h"

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectRecord.h"

namespace CommandLine
{

/// The keyed text form as JSON: keys in declared order, enumerations by name, colours as four numbers.
VJson Dump(const CoreOrlexTypes::VSubjectRecord& i_rRecord);
/// {"Subject": ...} with the same spellings.
VJson Dump(const CoreOrlexTypes::VSubject& i_rSubject);

} // namespace CommandLine
