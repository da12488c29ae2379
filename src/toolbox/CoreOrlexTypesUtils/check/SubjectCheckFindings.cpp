#include "CoreOrlexTypesUtils/check/SubjectCheckFindings.h"

#include "DebugServices/GlobalLog.h"

namespace CoreOrlexTypesUtils::SubjectCheck
{

void VLoggedFindings::Line(const std::string& i_rText)
{
	if (!i_rText.empty())
		NVX_LOG("SubjectCheck", NVX::ELogError, "%1%", i_rText);
}

void VListedFindings::Found(VSubjectFinding i_Finding)
{
	if (!m_Known.emplace(i_Finding.m_Element, i_Finding.m_Index, i_Finding.m_Message, i_Finding.m_Remedy).second)
		return;
	if (i_Finding.m_Message.empty())
		m_Unsaid = m_List.size();
	m_List.push_back(std::move(i_Finding));
}

void VListedFindings::Line(const std::string& i_rText)
{
	if (m_Unsaid)
		m_List[*m_Unsaid].m_Message = i_rText;
	m_Unsaid.reset();
}

} // namespace CoreOrlexTypesUtils::SubjectCheck
