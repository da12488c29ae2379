#include "fbxsdk/document/Document.h"

#include "DebugServices/GlobalLog.h"
#include "fbxsdk/Limits.h"
#include "fbxsdk/container/Values.h"

#include <algorithm>

namespace
{

using namespace FbxFormat;

/// Of several objects with one key the first in the file is found.
template <typename TKey>
VObjectIndex FindKey(const std::vector<std::pair<TKey, VObjectIndex>>& i_rSorted, const TKey& i_rKey)
{
	const auto found = std::lower_bound(i_rSorted.begin(), i_rSorted.end(), std::pair(i_rKey, VObjectIndex(0)));
	return found != i_rSorted.end() && found->first == i_rKey ? found->second : c_NoObject;
}

} // namespace

FbxFormat::VDocument::VDocument(const VElementTree& i_rTree) : m_rTree(i_rTree)
{
	const VElementIndex first = m_rTree[VElementTree::c_Root].m_FirstChild;
	m_bEscapes = first != c_NoElement && m_rTree[first].m_Form != EValueForm::Binary;
	// A file that was cut behind a section looks whole but for what follows.
	for (const char* pSection : {"Objects", "Connections"})
		if (m_Error.empty() && m_rTree.Find(VElementTree::c_Root, pSection) == c_NoElement)
			m_Error = std::string("its section \"") + pSection + "\" is missing";
	ReadObjects();
	ReadConnections();
}

void FbxFormat::VDocument::ReadObjects()
{
	for (const VElementIndex section : m_rTree.Children(VElementTree::c_Root))
	{
		if (m_rTree.Name(section) != "Objects")
			continue;
		for (const VElementIndex element : m_rTree.Children(section))
		{
			if (m_Objects.size() == Limits::c_Objects)
			{
				m_bBeyondLimit = m_Error.empty();
				if (m_bBeyondLimit)
					m_Error = "it has more than " + std::to_string(Limits::c_Objects) + " objects";
				break;
			}
			VValueCursor values(m_rTree, element);
			const VObjectIndex index = VObjectIndex(m_Objects.size());
			VValue value = values.Next();
			if (value.m_Kind == EValueKind::Integer)
			{
				m_ByNumber.emplace_back(value.m_Integer, index);
				value = values.Next();
			}
			else if (value.m_Kind == EValueKind::Text)
				m_ByName.emplace_back(value.m_Text, index);
			else
			{
				// Before version 7 the global settings stand here.
				m_Nameless += m_rTree.Name(element) == "GlobalSettings" ? 0 : 1;
				continue;
			}
			m_Objects.push_back(
			    {element, m_rTree.Name(element), SplitFullName(value.m_Text).m_Name, values.Next().m_Text});
		}
	}
	std::sort(m_ByNumber.begin(), m_ByNumber.end());
	std::sort(m_ByName.begin(), m_ByName.end());
}

FbxFormat::VObjectIndex FbxFormat::VDocument::FindObject(const VValue& i_rKey) const
{
	if (i_rKey.m_Kind == EValueKind::Integer)
		return i_rKey.m_Integer == 0 ? c_SceneObject : FindKey(m_ByNumber, i_rKey.m_Integer);
	if (i_rKey.m_Kind != EValueKind::Text)
		return c_NoObject;
	const VFullName name = SplitFullName(i_rKey.m_Text);
	return name.m_Name == "Scene" && name.m_Class == "Model" ? c_SceneObject : FindKey(m_ByName, i_rKey.m_Text);
}

void FbxFormat::VDocument::ReadConnections()
{
	for (const VElementIndex section : m_rTree.Children(VElementTree::c_Root))
	{
		if (m_rTree.Name(section) != "Connections")
			continue;
		for (const VElementIndex element : m_rTree.Children(section))
		{
			VValueCursor values(m_rTree, element);
			const std::string_view kind = values.Next().m_Text;
			if (kind != "OO" && kind != "OP")
				continue;
			VConnection connection;
			connection.m_Child = FindObject(values.Next());
			connection.m_Parent = FindObject(values.Next());
			if (connection.m_Child == c_NoObject || connection.m_Parent == c_NoObject)
				continue;
			if (kind == "OP")
				connection.m_Property = values.Next().m_Text;
			m_Connections.push_back(connection);
		}
	}
}

std::string FbxFormat::VDocument::Decoded(std::string_view i_Text) const
{
	if (i_Text.size() <= Limits::c_TextBytes)
		return DecodeText(i_Text, m_bEscapes);
	// Not inside a character of UTF-8, whose bytes behind the first are of the form 10xxxxxx.
	std::size_t size = Limits::c_TextBytes;
	while (size > Limits::c_TextBytes - 4 && (i_Text[size] & 0xC0) == 0x80)
		--size;
	std::string text = DecodeText(i_Text.substr(0, size), m_bEscapes);
	NVX_LOG("FBXIO", NVX::ELogWarning, "A name or path of %1% bytes is cut to %2%: %3%...", i_Text.size(), size,
	    text.substr(0, 64));
	return text;
}

FbxFormat::VElementIndex FbxFormat::VDocument::GlobalSettings() const
{
	const VElementIndex section = m_rTree.Find(VElementTree::c_Root, "GlobalSettings");
	if (section != c_NoElement)
		return section;
	// Before version 7 they are one of the objects.
	return m_rTree.Find(m_rTree.Find(VElementTree::c_Root, "Objects"), "GlobalSettings");
}

FbxFormat::VElementIndex FbxFormat::VDocument::Template(std::string_view i_Kind) const
{
	for (const VElementIndex type : m_rTree.Children(m_rTree.Find(VElementTree::c_Root, "Definitions")))
		if (m_rTree.Name(type) == "ObjectType" && ValueAt(m_rTree, type, 0).m_Text == i_Kind)
			return m_rTree.Find(type, "PropertyTemplate");
	return c_NoElement;
}
