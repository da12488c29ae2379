#pragma once

#include <memory>
#include <string>
#include <string_view>

namespace rapidxml
{
template <class Ch>
class xml_node;
template <class Ch>
class xml_attribute;
template <class Ch>
class xml_document;
} // namespace rapidxml

namespace UtilsRapidXml
{

using VXmlNode = rapidxml::xml_node<char>;
using VXmlAttribute = rapidxml::xml_attribute<char>;
using VXmlDocument = rapidxml::xml_document<char>;

/// An XML document in memory, with the text that its nodes point into: parsed from a text, or built and then printed.
/// rapidxml stays behind it.
class VDocument
{
public:
	VDocument();
	~VDocument();
	VDocument(const VDocument&) = delete;
	VDocument& operator=(const VDocument&) = delete;

	/// Replaces what the document held. Any bytes may be given: nothing is thrown for them, and Limits.h tells what is
	/// refused for its size.
	/// @return false if the text is no XML; the document is empty then and o_rError tells what is wrong, with the line.
	bool Parse(std::string i_Text, std::string& o_rError);

	/// The node above all elements.
	VXmlNode* GetRoot();

	/// Writes the declaration of version 1.0, UTF-8, not standalone. Everything that is printed begins with it.
	void AppendDeclaration();
	void AppendProcessingInstruction(std::string_view i_Target, std::string_view i_Text);
	/// @return the new element, the last child of its parent.
	VXmlNode* AppendElement(VXmlNode* i_pParent, std::string_view i_Name);
	/// @return false, with nothing appended, if the text has bytes that XML cannot hold.
	bool AppendAttribute(VXmlNode* i_pElement, std::string_view i_Name, std::string_view i_Text);
	void SetText(VXmlNode* i_pElement, std::string_view i_Text);

	/// One tab for each level. Line ends and tabs of attributes are written as character references, so that every
	/// parser gives them back.
	std::string Print() const;

private:
	struct VContent;
	std::unique_ptr<VContent> m_pContent;
};

} // namespace UtilsRapidXml
