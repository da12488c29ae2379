#include "UtilsRapidXml/Document.h"

#include "UtilsRapidXml/Characters.h"
#include "UtilsRapidXml/Parser.h"
#include "UtilsRapidXml/Printer.h"

#include <rapidxml/rapidxml.hpp>

#include <cstring>

namespace UtilsRapidXml
{

struct VDocument::VContent
{
	/// A copy in the document's memory, without a zero at its end.
	char* Copy(std::string_view i_Text)
	{
		if (i_Text.empty())
			return m_Empty;
		char* const pCopy = m_Document.allocate_string(nullptr, i_Text.size());
		std::memcpy(pCopy, i_Text.data(), i_Text.size());
		return pCopy;
	}

	VXmlNode* Append(VXmlNode* i_pParent, rapidxml::node_type i_Type, std::string_view i_Name)
	{
		VXmlNode* const pNode = m_Document.allocate_node(i_Type);
		pNode->name(Copy(i_Name), i_Name.size());
		i_pParent->append_node(pNode);
		return pNode;
	}

	char m_Empty[1] = {0};
	std::string m_Text;
	VXmlDocument m_Document;
};

VDocument::VDocument() : m_pContent(std::make_unique_for_overwrite<VContent>()) {}

VDocument::~VDocument() = default;

bool VDocument::Parse(std::string i_Text, std::string& o_rError)
{
	m_pContent->m_Document.clear();
	m_pContent->m_Text = std::move(i_Text);
	if (ParseText(m_pContent->m_Text, m_pContent->m_Document, o_rError))
		return true;
	m_pContent->m_Document.clear();
	return false;
}

VXmlNode* VDocument::GetRoot()
{
	return &m_pContent->m_Document;
}

void VDocument::AppendDeclaration()
{
	VXmlNode* const pDeclaration = m_pContent->Append(GetRoot(), rapidxml::node_declaration, {});
	for (const auto& [name, value] : c_Declaration)
		AppendAttribute(pDeclaration, name, value);
}

void VDocument::AppendProcessingInstruction(std::string_view i_Target, std::string_view i_Text)
{
	VXmlNode* const pNode = m_pContent->Append(GetRoot(), rapidxml::node_pi, i_Target);
	pNode->value(m_pContent->Copy(i_Text), i_Text.size());
}

VXmlNode* VDocument::AppendElement(VXmlNode* i_pParent, std::string_view i_Name)
{
	return m_pContent->Append(i_pParent, rapidxml::node_element, i_Name);
}

bool VDocument::AppendAttribute(VXmlNode* i_pElement, std::string_view i_Name, std::string_view i_Text)
{
	if (FindBrokenCharacter(i_Text) != std::string_view::npos)
		return false;
	rapidxml::xml_attribute<char>* const pAttribute = m_pContent->m_Document.allocate_attribute();
	pAttribute->name(m_pContent->Copy(i_Name), i_Name.size());
	pAttribute->value(m_pContent->Copy(i_Text), i_Text.size());
	i_pElement->append_attribute(pAttribute);
	return true;
}

void VDocument::SetText(VXmlNode* i_pElement, std::string_view i_Text)
{
	i_pElement->value(m_pContent->Copy(i_Text), i_Text.size());
}

std::string VDocument::Print() const
{
	return UtilsRapidXml::Print(m_pContent->m_Document);
}

} // namespace UtilsRapidXml
