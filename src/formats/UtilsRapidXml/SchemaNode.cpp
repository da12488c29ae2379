#include "UtilsRapidXml/SchemaNode.h"

#include <utility>

namespace UtilsRapidXml
{

VSchemaNode::VSchemaNode(
    VDocument& i_rDocument, bool i_bStylesheet, const std::string& i_rSchemaNamespace, const std::string& i_rStylesheet)
    : m_rDocument(i_rDocument), m_pInfo(std::make_shared<VSchemaInfo>())
{
	i_rDocument.AppendDeclaration();
	if (i_bStylesheet)
		i_rDocument.AppendProcessingInstruction("xml-stylesheet", "type=\"text/xsl\" href=\"" + i_rStylesheet + '"');
	m_pInfo->m_pSchema = i_rDocument.AppendElement(i_rDocument.GetRoot(), "xsd:schema");
	i_rDocument.AppendAttribute(m_pInfo->m_pSchema, "xmlns:orlex", i_rSchemaNamespace);
	i_rDocument.AppendAttribute(m_pInfo->m_pSchema, "xmlns:xml", "http://www.w3.org/XML/1998/namespace");
	i_rDocument.AppendAttribute(m_pInfo->m_pSchema, "xmlns:xsd", "http://www.w3.org/2001/XMLSchema");
}

VSchemaNode::VSchemaNode(
    VDocument& i_rDocument, const VDeclaration& i_rDeclaration, std::shared_ptr<VSchemaInfo> i_pInfo)
    : m_rDocument(i_rDocument), m_Name(i_rDeclaration.m_Name), m_pInfo(std::move(i_pInfo))
{
	VXmlNode* const pElement = m_rDocument.AppendElement(m_pInfo->m_pSchema, "xsd:element");
	m_rDocument.AppendAttribute(pElement, "name", m_Name);
	AppendAnnotation(pElement, i_rDeclaration.m_Doc, i_rDeclaration.m_Minimum, i_rDeclaration.m_Maximum);
	m_pType = m_rDocument.AppendElement(pElement, "xsd:complexType");
}

VSchemaNode::~VSchemaNode()
{
	if (!m_pType)
		return;
	for (const VAttribute& rAttribute : m_Attributes)
	{
		VXmlNode* const pAttribute = m_rDocument.AppendElement(m_pType, "xsd:attribute");
		m_rDocument.AppendAttribute(pAttribute, "name", rAttribute.m_Name);
		m_rDocument.AppendAttribute(pAttribute, "type", rAttribute.m_Type);
		if (rAttribute.m_bRequired)
			m_rDocument.AppendAttribute(pAttribute, "use", "required");
		AppendAnnotation(pAttribute, rAttribute.m_Doc, rAttribute.m_Minimum, rAttribute.m_Maximum);
	}
}

void VSchemaNode::AppendAnnotation(
    VXmlNode* i_pPlace, const std::string& i_rDoc, VVersion i_Minimum, VVersion i_Maximum)
{
	VXmlNode* const pAnnotation = m_rDocument.AppendElement(i_pPlace, "xsd:annotation");
	if (i_Maximum.IsSet())
		m_rDocument.AppendAttribute(pAnnotation, "orlex:maxVersion", ToText(i_Maximum));
	if (i_Minimum.IsSet())
		m_rDocument.AppendAttribute(pAnnotation, "orlex:minVersion", ToText(i_Minimum));
	VXmlNode* const pDocumentation = m_rDocument.AppendElement(pAnnotation, "xsd:documentation");
	m_rDocument.AppendAttribute(pDocumentation, "xml:lang", "en");
	m_rDocument.SetText(pDocumentation, i_rDoc);
}

void VSchemaNode::DeclareEnum(const IEnum& i_rEnum)
{
	if (!m_pInfo->m_Emitted.insert(i_rEnum.GetName()).second)
		return;
	VXmlNode* const pType = m_rDocument.AppendElement(m_pInfo->m_pSchema, "xsd:simpleType");
	m_rDocument.AppendAttribute(pType, "name", i_rEnum.GetName());
	VXmlNode* const pRestriction = m_rDocument.AppendElement(pType, "xsd:restriction");
	m_rDocument.AppendAttribute(pRestriction, "base", "xsd:string");
	for (const std::string& rText : i_rEnum.GetTexts())
		m_rDocument.AppendAttribute(m_rDocument.AppendElement(pRestriction, "xsd:enumeration"), "value", rText);
}

void VSchemaNode::DeclareElement(std::string_view i_Name, std::string_view i_Doc, std::uint32_t i_MinimumCount,
    std::uint32_t i_MaximumCount, VVersion i_Minimum, VVersion i_Maximum)
{
	m_Pending.push_back(
	    {std::string(i_Name), std::string(i_Doc), i_MinimumCount, i_MaximumCount, i_Minimum, i_Maximum});
}

void VSchemaNode::AppendReference(VXmlNode* i_pPlace, const VDeclaration& i_rDeclaration, bool i_bChoice)
{
	VXmlNode* const pReference = m_rDocument.AppendElement(i_pPlace, "xsd:element");
	if (!i_bChoice)
	{
		if (std::int32_t(i_rDeclaration.m_MaximumCount) < 0)
			m_rDocument.AppendAttribute(pReference, "maxOccurs", "unbounded");
		else if (i_rDeclaration.m_MaximumCount != 1)
			m_rDocument.AppendAttribute(pReference, "maxOccurs", std::to_string(i_rDeclaration.m_MaximumCount));
		if (i_rDeclaration.m_MinimumCount != 1)
			m_rDocument.AppendAttribute(pReference, "minOccurs", std::to_string(i_rDeclaration.m_MinimumCount));
	}
	m_rDocument.AppendAttribute(pReference, "ref", i_rDeclaration.m_Name);
}

void VSchemaNode::ProcessElements(const std::function<void(INode&)>& i_rCallback, bool i_bChoice)
{
	VXmlNode* pPlace = nullptr;
	if (m_pType)
	{
		if (!m_pSequence)
			m_pSequence = m_rDocument.AppendElement(m_pType, "xsd:sequence");
		pPlace = i_bChoice ? m_rDocument.AppendElement(m_pSequence, "xsd:choice") : m_pSequence;
	}
	for (const VDeclaration& rDeclaration : std::exchange(m_Pending, {}))
	{
		if (pPlace)
			AppendReference(pPlace, rDeclaration, i_bChoice);
		if (!m_pInfo->m_Emitted.insert(rDeclaration.m_Name).second)
			continue;
		VSchemaNode child(m_rDocument, rDeclaration, m_pInfo);
		i_rCallback(child);
	}
}

bool VSchemaNode::ProcessAttribute(std::string_view i_Name, std::string_view&, std::string_view i_Doc,
    std::string_view i_SchemaType, bool i_bRequired, VVersion i_Minimum, VVersion i_Maximum)
{
	m_Attributes.push_back(
	    {std::string(i_Name), std::string(i_Doc), std::string(i_SchemaType), i_bRequired, i_Minimum, i_Maximum});
	return false;
}

} // namespace UtilsRapidXml
