#include "UtilsRapidXml/WriterNode.h"

#include "UtilsRapidXml/Characters.h"
#include "UtilsRapidXml/Limits.h"
#include "UtilsRapidXml/Printer.h"

#include <algorithm>
#include <utility>

namespace UtilsRapidXml
{

VWriterNode::VWriterNode(std::string& o_rText) : VWriterNode(o_rText, {}, 0, std::make_shared<VGlobalInfo>())
{
	o_rText = "<?xml";
	for (const auto& [name, value] : c_Declaration)
		PrintAttribute(name, value, o_rText);
	o_rText += "?>\n";
	// It has no tag of its own that would have to be ended.
	m_bHasChildren = true;
}

VWriterNode::VWriterNode(
    std::string& io_rText, std::string_view i_Name, std::size_t i_Depth, std::shared_ptr<VGlobalInfo> i_pGlobal)
    : m_rText(io_rText), m_Name(i_Name), m_Depth(i_Depth), m_pGlobal(std::move(i_pGlobal))
{
}

void VWriterNode::Open()
{
	(m_rText.append(m_Depth - 1, '\t') += '<') += m_Name;
	m_AttributesEnd = m_rText.size();
}

void VWriterNode::EndAttribute(std::size_t i_Begin)
{
	if (m_bHasChildren)
		std::rotate(m_rText.begin() + std::ptrdiff_t(m_AttributesEnd), m_rText.begin() + std::ptrdiff_t(i_Begin),
		    m_rText.end());
	m_AttributesEnd += m_rText.size() - i_Begin;
}

void VWriterNode::Close()
{
	if (m_bHasChildren)
		((m_rText.append(m_Depth - 1, '\t') += "</") += m_Name) += ">\n";
	else
		m_rText += "/>\n";
}

bool VWriterNode::WriteAttribute(
    std::string_view i_Name, std::string_view i_Text, VVersion i_Minimum, VVersion i_Maximum)
{
	// The document itself has no attributes.
	if (m_Depth == 0 || !InRange(GetVersion(), i_Minimum, i_Maximum))
		return false;
	if (StandsForItself(i_Text))
	{
		WriteAttributeInPlace(i_Name, [&](std::string& io_rText) { io_rText += i_Text; });
		return true;
	}
	if (FindBrokenCharacter(i_Text) != std::string_view::npos)
	{
		m_pGlobal->m_Errors.Add("%1% node's %2% attribute has bytes that XML cannot hold.", m_Name, i_Name);
		return false;
	}
	const std::size_t begin = m_rText.size();
	PrintAttribute(i_Name, i_Text, m_rText);
	EndAttribute(begin);
	return true;
}

bool VWriterNode::BeginChild(std::string_view i_Name, VVersion i_Minimum, VVersion i_Maximum)
{
	if (!InRange(GetVersion(), i_Minimum, i_Maximum))
		return false;
	if (m_Depth == c_MaximumDepth)
	{
		m_pGlobal->m_Errors.Add(
		    "%1% element is nested deeper than %2% levels and could not be read back.", i_Name, c_MaximumDepth);
		return false;
	}
	if (!std::exchange(m_bHasChildren, true))
		m_rText += ">\n";
	return true;
}

} // namespace UtilsRapidXml
