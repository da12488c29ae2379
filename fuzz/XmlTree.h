#pragma once

#include "UtilsRapidXml/Document.h"

#include <rapidxml/rapidxml.hpp>

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <random>
#include <string>
#include <vector>

extern "C" std::size_t LLVMFuzzerMutate(std::uint8_t* io_pData, std::size_t i_Size, std::size_t i_MaximumSize);

/// Changes of XML that is well formed and stays so: elements lost, doubled, put elsewhere or renamed, attributes lost,
/// exchanged or given other values.
namespace XmlTree
{

using UtilsRapidXml::VXmlAttribute;
using UtilsRapidXml::VXmlNode;

inline void Collect(VXmlNode& io_rNode, std::vector<VXmlNode*>& o_rNodes)
{
	for (VXmlNode* pChild = io_rNode.first_node(); pChild; pChild = pChild->next_sibling())
		if (pChild->type() == rapidxml::node_element)
		{
			o_rNodes.push_back(pChild);
			Collect(*pChild, o_rNodes);
		}
}

inline bool IsWithin(const VXmlNode* i_pNode, const VXmlNode* i_pAbove)
{
	while (i_pNode && i_pNode != i_pAbove)
		i_pNode = i_pNode->parent();
	return i_pNode != nullptr;
}

inline VXmlAttribute* AnyAttribute(const VXmlNode& i_rNode, std::mt19937& io_rRandom)
{
	std::vector<VXmlAttribute*> attributes;
	for (VXmlAttribute* pAttribute = i_rNode.first_attribute(); pAttribute; pAttribute = pAttribute->next_attribute())
		attributes.push_back(pAttribute);
	return attributes.empty() ? nullptr : attributes[io_rRandom() % attributes.size()];
}

inline void Change(UtilsRapidXml::VDocument& io_rDocument, std::mt19937& io_rRandom)
{
	static constexpr const char* c_Values[] = {"", "0", "-1", "1e400", "nan", "4294967295", "9999999999999999999", "*",
	    "0 0 0", "1*x", "((((1", "true", "../x", "\xE2\x80\xAE", "3.5", "0.1"};
	std::vector<VXmlNode*> nodes;
	Collect(*io_rDocument.GetRoot(), nodes);
	if (nodes.size() < 2)
		return;
	VXmlNode& rNode = *nodes[1 + io_rRandom() % (nodes.size() - 1)];
	VXmlNode& rOther = *nodes[io_rRandom() % nodes.size()];
	VXmlAttribute* const pAttribute = AnyAttribute(rNode, io_rRandom);
	VXmlAttribute* const pOther = AnyAttribute(rOther, io_rRandom);
	switch (io_rRandom() % 8)
	{
	case 0: return rNode.parent()->remove_node(&rNode);
	case 1:
		if (rNode.parent() && !IsWithin(&rOther, &rNode))
		{
			rNode.parent()->remove_node(&rNode);
			rOther.append_node(&rNode);
		}
		return;
	case 2: return rNode.parent()->prepend_node(rNode.document()->clone_node(&rNode));
	case 3: return rNode.name(rOther.name(), rOther.name_size());
	case 4:
		if (pAttribute)
			rNode.remove_attribute(pAttribute);
		return;
	case 5:
		if (pAttribute && pOther)
			pAttribute->value(pOther->value(), pOther->value_size());
		return;
	case 6:
		if (pAttribute && pOther)
			pAttribute->name(pOther->name(), pOther->name_size());
		return;
	default:
		if (pAttribute)
			pAttribute->value(c_Values[io_rRandom() % std::size(c_Values)]);
	}
}

/// For LLVMFuzzerCustomMutator: every other time, and for what is no XML, the bytes are changed instead.
inline std::size_t Mutate(std::uint8_t* io_pData, std::size_t i_Size, std::size_t i_MaximumSize, unsigned int i_Seed)
{
	std::mt19937 random{i_Seed};
	UtilsRapidXml::VDocument document;
	std::string error;
	if (random() % 2 == 0 || !document.Parse(std::string(reinterpret_cast<const char*>(io_pData), i_Size), error))
		return LLVMFuzzerMutate(io_pData, i_Size, i_MaximumSize);
	for (std::size_t changes = 1 + random() % 3; changes > 0; --changes)
		Change(document, random);
	const std::string text = document.Print();
	if (text.size() > i_MaximumSize)
		return LLVMFuzzerMutate(io_pData, i_Size, i_MaximumSize);
	std::memcpy(io_pData, text.data(), text.size());
	return text.size();
}

} // namespace XmlTree
