#pragma once

#include "CoreOrlexTypes/SubjectRecord.h"

#include <string>

namespace CoreOrlexTypes
{

/// The keys and indices that lead to the first field in which the two differ, in declared order, as
/// "SubjectParametrised.Segments[3].Joint.BindPose[0]"; a list of another length is named itself. Empty if the two are
/// equal (see operator==).
std::string FirstDifference(const VSubjectRecord& i_rLeft, const VSubjectRecord& i_rRight);

} // namespace CoreOrlexTypes
