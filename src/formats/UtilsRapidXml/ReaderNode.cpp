#include "UtilsRapidXml/ReaderNode.h"

#include "UtilsRapidXml/Characters.h"

#include <rapidxml/rapidxml.hpp>

#include <algorithm>
#include <new>
#include <set>

namespace UtilsRapidXml
{
namespace
{

template <typename T>
std::string_view Name(const T* i_pItem)
{
	return {i_pItem->name(), i_pItem->name_size()};
}

/// "/" and the document node's name, which is empty, then "/" and a name for each element on the way.
std::string Path(const VXmlNode* i_pElement)
{
	std::vector<std::string_view> names;
	std::size_t size = 1;
	for (; i_pElement->parent(); i_pElement = i_pElement->parent())
	{
		names.push_back(Name(i_pElement));
		size += 1 + names.back().size();
	}
	std::string path;
	path.reserve(size);
	path += '/';
	for (auto name = names.rbegin(); name != names.rend(); ++name)
		(path += '/') += *name;
	return path;
}

/// Attributes of XML itself, which many programs write and no format declares.
bool IsOfNamespaces(std::string_view i_Name)
{
	return i_Name == "xmlns" || i_Name.starts_with("xmlns:") || i_Name.starts_with("xsi:");
}

bool Contains(const std::vector<std::string_view>& i_rNames, std::string_view i_Name)
{
	return std::find(i_rNames.begin(), i_rNames.end(), i_Name) != i_rNames.end();
}

} // namespace

VReaderNode::VReaderNode(VDocument& i_rDocument, bool i_bStrictOrder)
    : VReaderNode(i_rDocument.GetRoot(), std::make_shared<VGlobalInfo>())
{
	m_pGlobal->m_bStrictOrder = i_bStrictOrder;
}

VReaderNode::VReaderNode(VXmlNode* i_pElement, std::shared_ptr<VGlobalInfo> i_pGlobal)
    : m_pElement(i_pElement), m_pGlobal(std::move(i_pGlobal)), m_pNextAttribute(i_pElement->first_attribute())
{
	if (m_pGlobal->m_SpareNotes.empty())
		m_pNotes = std::make_unique<VNotes>();
	else
	{
		m_pNotes = std::move(m_pGlobal->m_SpareNotes.back());
		m_pGlobal->m_SpareNotes.pop_back();
	}
	for (const VXmlAttribute* pAttribute = m_pNextAttribute; pAttribute; pAttribute = pAttribute->next_attribute())
		m_AttributeBits |= NameBit(UtilsRapidXml::Name(pAttribute));
}

VReaderNode::~VReaderNode()
{
	try
	{
		TellIgnored();
		m_pNotes->m_Pending.clear();
		m_pNotes->m_RecognisedChildren.clear();
		m_pNotes->m_RecognisedAttributes.clear();
		m_pGlobal->m_SpareNotes.push_back(std::move(m_pNotes));
	}
	catch (const std::bad_alloc&)
	{
		m_pGlobal->m_bOutOfMemory = true;
	}
}

void VReaderNode::TellIgnored()
{
	std::set<std::string_view> told;
	for (const VXmlNode* pChild = m_pElement->first_node(); pChild; pChild = pChild->next_sibling())
	{
		const std::string_view name = UtilsRapidXml::Name(pChild);
		if (!Contains(m_pNotes->m_RecognisedChildren, name) && told.insert(name).second)
			m_pGlobal->m_Warnings.Add("Ignoring unrecognised element type: %1%", [&] { return Path(pChild); });
	}
	// Mostly all were asked for, in their order.
	const std::vector<const char*>& rRecognised = m_pNotes->m_RecognisedAttributes;
	auto next = rRecognised.begin();
	for (const auto* pAttribute = m_pElement->first_attribute(); pAttribute; pAttribute = pAttribute->next_attribute())
		if (next != rRecognised.end() && *next == pAttribute->name())
			++next;
		else if (std::find(rRecognised.begin(), rRecognised.end(), pAttribute->name()) == rRecognised.end())
			(m_pGlobal->m_bOwnFormsAreDetails && IsOfNamespaces(UtilsRapidXml::Name(pAttribute))
			        ? m_pGlobal->m_Details
			        : m_pGlobal->m_Warnings)
			    .Add("Ignoring unrecognised attribute: %1%",
			        [&] { return (Path(m_pElement) += '/') += UtilsRapidXml::Name(pAttribute); });
}

std::string_view VReaderNode::GetName() const
{
	return UtilsRapidXml::Name(m_pElement);
}

void VReaderNode::DeclareElement(std::string_view i_Name, std::string_view, std::uint32_t i_MinimumCount,
    std::uint32_t i_MaximumCount, VVersion i_Minimum, VVersion i_Maximum)
{
	m_pNotes->m_Pending.push_back({i_Name, i_MinimumCount, i_MaximumCount, i_Minimum, i_Maximum});
}

void VReaderNode::Match(const VDeclaration& i_rDeclaration, bool i_bChoice, std::string& io_rChosen)
{
	VMessages& rErrors = m_pGlobal->m_Errors;
	const auto path = [this] { return Path(m_pElement); };
	std::uint32_t count = 0;
	std::size_t position = 0;
	bool bRecognised = Contains(m_pNotes->m_RecognisedChildren, i_rDeclaration.m_Name);
	for (VXmlNode* pChild = m_pElement->first_node(); pChild; pChild = pChild->next_sibling(), ++position)
	{
		if (!AreSameName(UtilsRapidXml::Name(pChild), i_rDeclaration.m_Name))
			continue;
		const std::string_view name = UtilsRapidXml::Name(pChild);
		if (!bRecognised)
			m_pNotes->m_RecognisedChildren.push_back(name);
		bRecognised = true;
		const auto childPath = [pChild] { return Path(pChild); };
		if (!InRange(GetVersion(), i_rDeclaration.m_Minimum, i_rDeclaration.m_Maximum))
		{
			m_pGlobal->m_Warnings.Add(
			    "Ignoring %1% element. Not supported in files with version %2%", childPath, ToText(GetVersion()));
			continue;
		}
		if (m_pGlobal->m_bStrictOrder && position < m_HighestPosition)
		{
			rErrors.Add("%1% element did not appear in correct element sequence", childPath);
			continue;
		}
		m_HighestPosition = position;
		if (i_bChoice && !io_rChosen.empty())
		{
			rErrors.Add("%1% element cannot have both a %2% and a %3% child element", path, io_rChosen, name);
			continue;
		}
		if (i_bChoice)
			io_rChosen = name;
		else if (++count > i_rDeclaration.m_MaximumCount && i_rDeclaration.m_MaximumCount >= 1)
		{
			rErrors.Add(
			    "%1% element must have a maximum of %2% %3% child elements", path, i_rDeclaration.m_MaximumCount, name);
			continue;
		}
		m_pNotes->m_Matches.push_back({position, pChild});
	}
	if (!i_bChoice && count < i_rDeclaration.m_MinimumCount)
		rErrors.Add("%1% element must have a minimum of %2% %3% child elements", path, i_rDeclaration.m_MinimumCount,
		    i_rDeclaration.m_Name);
}

void VReaderNode::ProcessElements(const std::function<void(INode&)>& i_rCallback, bool i_bChoice)
{
	std::vector<VDeclaration>& rPending = m_pNotes->m_Pending;
	if (rPending.empty())
		return;
	std::string chosen;
	std::vector<VMatch>& rMatches = m_pNotes->m_Matches;
	rMatches.clear();
	for (const VDeclaration& rDeclaration : rPending)
		Match(rDeclaration, i_bChoice, chosen);
	if (i_bChoice && chosen.empty())
	{
		std::string names;
		for (const VDeclaration& rDeclaration : rPending)
			(names += ' ') += rDeclaration.m_Name;
		m_pGlobal->m_Errors.Add(
		    "%1% element must have a one of the following child elements:%2%", [this] { return Path(m_pElement); },
		    names);
	}
	rPending.clear();
	// Each declaration's matches stand in order already.
	const auto isBefore = [](const VMatch& i_rLeft, const VMatch& i_rRight)
	{ return i_rLeft.m_Position < i_rRight.m_Position; };
	if (!std::is_sorted(rMatches.begin(), rMatches.end(), isBefore))
		std::stable_sort(rMatches.begin(), rMatches.end(), isBefore);
	for (const VMatch& rMatch : rMatches)
	{
		VReaderNode child(rMatch.m_pElement, m_pGlobal);
		i_rCallback(child);
	}
}

const VXmlAttribute* VReaderNode::FindAttribute(std::string_view i_Name)
{
	// Attributes nearly always stand in the order in which they are asked for: the search goes on where the last one
	// was found.
	const VXmlAttribute* pAttribute = m_pNextAttribute;
	if (!pAttribute || !AreSameName(UtilsRapidXml::Name(pAttribute), i_Name))
	{
		if ((m_AttributeBits & NameBit(i_Name)) == 0)
			return nullptr;
		pAttribute = m_pElement->first_attribute();
		while (pAttribute && !AreSameName(UtilsRapidXml::Name(pAttribute), i_Name))
			pAttribute = pAttribute->next_attribute();
		if (!pAttribute)
			return nullptr;
	}
	m_pNextAttribute = pAttribute->next_attribute();
	m_pNotes->m_RecognisedAttributes.push_back(pAttribute->name());
	return pAttribute;
}

bool VReaderNode::ProcessAttribute(std::string_view i_Name, std::string_view& o_rText, std::string_view,
    std::string_view i_SchemaType, bool i_bRequired, VVersion i_Minimum, VVersion i_Maximum)
{
	const VXmlAttribute* const pAttribute = FindAttribute(i_Name);
	if (!pAttribute && !i_bRequired)
		return false;
	if (!InRange(GetVersion(), i_Minimum, i_Maximum))
	{
		if (pAttribute)
			m_pGlobal->m_Warnings.Add("Ignoring %1% attribute in %2% element. Not supported in files with version %3%",
			    i_Name, GetName(), ToText(GetVersion()));
		return false;
	}
	if (!pAttribute)
	{
		m_pGlobal->m_Errors.Add("%1% element missing required attribute %2%", GetName(), i_Name);
		return false;
	}
	o_rText = {pAttribute->value(), pAttribute->value_size()};
	if (i_SchemaType == "xsd:ID")
	{
		const auto [it, bNew] = m_pGlobal->m_Ids.emplace(o_rText, GetName());
		const bool bOtherKind = std::exchange(it->second, GetName()) != GetName();
		if (bOtherKind && m_pGlobal->m_bOwnFormsAreDetails)
			m_pGlobal->m_Details.Add("Elements of two kinds have the name %1%", o_rText);
		else if (!bNew)
			m_pGlobal->m_Warnings.Add("File contains duplicate ID : %1% ", o_rText);
	}
	else if (i_SchemaType == "xsd:IDREF" && !m_pGlobal->m_Ids.contains(o_rText))
		m_pGlobal->m_Warnings.Add("File contains unknown IDREF : %1% ", o_rText);
	return true;
}

} // namespace UtilsRapidXml
