#pragma once

#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectParametrised.h"

namespace CoreOrlexTypes
{

/// The pair that a retarget subject's text form holds.
struct VSubjectRecord
{
	VSubjectParametrised m_SubjectParametrised;
	VSubjectApplicationData m_SubjectApplicationData;
};

/// Exact, field by field.
bool operator==(const VSubjectRecord& i_rLeft, const VSubjectRecord& i_rRight);

} // namespace CoreOrlexTypes
