#include "Flow2Graphics/SubjectTypes.h"

#include "CoreOrlexTypes/SubjectState.h"
#include "Flow2TypesUtils/TaggedCoreTypeExtractor.h"

namespace Flow2Graphics
{

bool IsOfClass(
    const Flow2TypesUtils::VTaggedCoreTypeExtractor& i_rItems, const VSubjectTypes& i_rTypes, std::uint32_t i_SubjectId)
{
	if (!i_rTypes.m_Settings)
		return true;
	const auto pSettings = i_rItems.Get<CoreOrlexTypes::VSubjectSettings>(i_rTypes.m_Settings);
	const bool bProp = pSettings && pSettings->m_SubjectId == i_SubjectId && pSettings->m_Prop;
	return bProp == (i_rTypes.m_Class == ESubjectClassProp);
}

} // namespace Flow2Graphics
