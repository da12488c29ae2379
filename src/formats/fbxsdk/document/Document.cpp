#include "fbxsdk/document/Document.h"

#include "DebugServices/GlobalLog.h"
#include "fbxsdk/Limits.h"
#include "fbxsdk/container/Values.h"

#include <algorithm>
#include <iterator>
#include <random>

namespace
{

using namespace FbxFormat;

const std::uint64_t c_HashSeed = std::random_device()();

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
		const VElementTree::VChildren elements = m_rTree.Children(section);
		const auto count = std::size_t(std::distance(elements.begin(), elements.end()));
		m_Objects.reserve(std::min(Limits::c_Objects, m_Objects.size() + count));
		m_ByNumber.reserve(m_Objects.capacity());
		for (const VElementIndex element : elements)
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
				m_ByNumber.try_emplace(value.m_Integer, index);
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
	std::sort(m_ByName.begin(), m_ByName.end());
}

/// The finaliser of SplitMix64, from where nobody who writes a file can know.
std::size_t FbxFormat::VDocument::VNumberHash::operator()(std::int64_t i_Number) const
{
	std::uint64_t bits = std::uint64_t(i_Number) + c_HashSeed * 0x9E3779B97F4A7C15u;
	bits = (bits ^ bits >> 30) * 0xBF58476D1CE4E5B9u;
	bits = (bits ^ bits >> 27) * 0x94D049BB133111EBu;
	return bits ^ bits >> 31;
}

/// Of several objects with one key the first in the file is found.
FbxFormat::VObjectIndex FbxFormat::VDocument::FindObject(const VValue& i_rKey) const
{
	if (i_rKey.m_Kind == EValueKind::Integer)
	{
		if (i_rKey.m_Integer == 0)
			return c_SceneObject;
		const auto found = m_ByNumber.find(i_rKey.m_Integer);
		return found != m_ByNumber.end() ? found->second : c_NoObject;
	}
	if (i_rKey.m_Kind != EValueKind::Text)
		return c_NoObject;
	const VFullName name = SplitFullName(i_rKey.m_Text);
	if (name.m_Name == "Scene" && name.m_Class == "Model")
		return c_SceneObject;
	const auto found = std::lower_bound(m_ByName.begin(), m_ByName.end(), std::pair(i_rKey.m_Text, VObjectIndex(0)));
	return found != m_ByName.end() && found->first == i_rKey.m_Text ? found->second : c_NoObject;
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
			if (connection.m_Child == c_NoObject)
				continue;
			connection.m_Parent = FindObject(values.Next());
			if (connection.m_Parent == c_NoObject)
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
