#include "UtilsRapidXml/WriterNode.h"

#include "UtilsRapidXml/Limits.h"

namespace UtilsRapidXml
{

VWriterNode::VWriterNode(VDocument& i_rDocument)
    : VWriterNode(i_rDocument, i_rDocument.GetRoot(), {}, 0, std::make_shared<VGlobalInfo>())
{
	i_rDocument.AppendDeclaration();
}

VWriterNode::VWriterNode(VDocument& i_rDocument, VXmlNode* i_pElement, std::string_view i_Name, std::size_t i_Depth,
    std::shared_ptr<VGlobalInfo> i_pGlobal)
    : m_rDocument(i_rDocument), m_pElement(i_pElement), m_Name(i_Name), m_Depth(i_Depth),
      m_pGlobal(std::move(i_pGlobal))
{
}

bool VWriterNode::WriteAttribute(
    std::string_view i_Name, std::string_view i_Text, VVersion i_Minimum, VVersion i_Maximum)
{
	if (!InRange(GetVersion(), i_Minimum, i_Maximum))
		return false;
	if (m_rDocument.AppendAttribute(m_pElement, i_Name, i_Text))
		return true;
	m_pGlobal->m_Errors.Add("%1% node's %2% attribute has bytes that XML cannot hold.", m_Name, i_Name);
	return false;
}

bool VWriterNode::WriteElement(std::string_view i_Name, const std::function<void(VWriterNode&)>& i_rCallback,
    VVersion i_Minimum, VVersion i_Maximum)
{
	if (!InRange(GetVersion(), i_Minimum, i_Maximum))
		return false;
	if (m_Depth == c_MaximumDepth)
	{
		m_pGlobal->m_Errors.Add(
		    "%1% element is nested deeper than %2% levels and could not be read back.", i_Name, c_MaximumDepth);
		return false;
	}
	VWriterNode child(m_rDocument, m_rDocument.AppendElement(m_pElement, i_Name), i_Name, m_Depth + 1, m_pGlobal);
	i_rCallback(child);
	return true;
}

} // namespace UtilsRapidXml
