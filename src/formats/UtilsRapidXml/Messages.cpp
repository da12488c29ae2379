#include "UtilsRapidXml/Messages.h"

#include "UtilsRapidXml/Limits.h"

namespace UtilsRapidXml
{

bool VMessages::IsFull() const
{
	return m_Bytes > c_MaximumMessageBytes;
}

void VMessages::Add(const std::string& i_rText)
{
	++m_Count;
	if (IsFull())
		return;
	m_Bytes += i_rText.size() + sizeof(std::string);
	m_Texts.push_back(i_rText);
}

std::vector<std::string> VMessages::GetTexts() const
{
	std::vector<std::string> texts = m_Texts;
	if (m_Count > texts.size())
		texts.push_back("and " + std::to_string(m_Count - texts.size()) + " more");
	return texts;
}

} // namespace UtilsRapidXml
