#include "fbxsdk/container/ElementTree.h"

#include "fbxsdk/Limits.h"
#include "fbxsdk/container/FileKind.h"
#include "fbxsdk/container/TreeBuilder.h"

#include <algorithm>

namespace
{

/// Objects of that kind, since version 7 by their own names; before, what moves stands in "Takes".
constexpr std::string_view c_MotionKinds[]{
    "AnimationCurve", "AnimationCurveNode", "AnimationLayer", "AnimationStack", "Constraint", "Pose"};

/// Exporters write some ten times as many bytes for a record; what is not used of the list costs nothing.
constexpr std::size_t c_BytesOfRecord = 64;

} // namespace

bool FbxFormat::VElementTree::Read(std::string_view i_Bytes, const VFileKind& i_rKind, EContent i_Content)
{
	m_Elements.reserve(std::min(Limits::c_Records, i_Bytes.size() / c_BytesOfRecord + 1));
	VTreeBuilder builder(*this, i_Bytes, i_Content);
	switch (i_rKind.m_Kind)
	{
	case EFileKind::Binary: ReadBinaryRecords(i_Bytes, i_rKind.m_Version, builder); break;
	case EFileKind::Text: ReadTextRecords(i_Bytes, builder); break;
	case EFileKind::None:
	case EFileKind::BinaryBigEndian:
	case EFileKind::DamagedBinary: builder.Error("it is of no kind that is read", 0); break;
	}
	return m_Error.empty();
}

std::string_view FbxFormat::VElementTree::Name(VElementIndex i_Element) const
{
	return m_Bytes.substr(m_Elements[i_Element].m_Name, m_Elements[i_Element].m_NameLength);
}

std::string_view FbxFormat::VElementTree::Values(VElementIndex i_Element) const
{
	return m_Bytes.substr(m_Elements[i_Element].m_Values, m_Elements[i_Element].m_ValuesSize);
}

FbxFormat::VElementIndex FbxFormat::VElementTree::Find(VElementIndex i_Parent, std::string_view i_Name) const
{
	for (const VElementIndex child : Children(i_Parent))
		if (Name(child) == i_Name)
			return child;
	return c_NoElement;
}

FbxFormat::VElementTree::VChildren FbxFormat::VElementTree::Children(VElementIndex i_Parent) const
{
	const VElementIndex first = i_Parent == c_NoElement ? c_NoElement : m_Elements[i_Parent].m_FirstChild;
	return {{*this, first}, {*this, c_NoElement}};
}

FbxFormat::VTreeBuilder::VTreeBuilder(VElementTree& io_rTree, std::string_view i_Bytes, EContent i_Content)
    : m_rTree(io_rTree), m_Content(i_Content)
{
	m_rTree.m_Bytes = i_Bytes;
	m_Open.push_back({VElementTree::c_Root, c_NoElement, i_Bytes.size()});
}

bool FbxFormat::VTreeBuilder::IsLeftOut(std::string_view i_Name) const
{
	if (m_Content == EContent::All || Depth() > 2)
		return false;
	if (Depth() == 1)
		return i_Name == "Takes";
	return m_rTree.Name(m_Open.back().m_Element) == "Objects"
	    && std::ranges::find(c_MotionKinds, i_Name) != std::end(c_MotionKinds);
}

bool FbxFormat::VTreeBuilder::Add(const VElement& i_rElement)
{
	if (m_rTree.m_Elements.size() >= Limits::c_Records)
	{
		Error("it has more than " + std::to_string(Limits::c_Records) + " records", i_rElement.m_Name, true);
		return false;
	}
	const VElementIndex added = VElementIndex(m_rTree.m_Elements.size());
	m_rTree.m_Elements.push_back(i_rElement);
	VOpen& rOpen = m_Open.back();
	if (rOpen.m_LastChild == c_NoElement)
		m_rTree.m_Elements[rOpen.m_Element].m_FirstChild = added;
	else
		m_rTree.m_Elements[rOpen.m_LastChild].m_NextSibling = added;
	rOpen.m_LastChild = added;
	return true;
}

bool FbxFormat::VTreeBuilder::Open(std::size_t i_End)
{
	if (m_Open.size() > Limits::c_RecordDepth)
	{
		Error("its records lie more than " + std::to_string(Limits::c_RecordDepth) + " deep in one another",
		    Last().m_Name, true);
		return false;
	}
	m_Open.push_back({VElementIndex(m_rTree.m_Elements.size() - 1), c_NoElement, i_End});
	return true;
}

void FbxFormat::VTreeBuilder::Error(std::string_view i_What, std::size_t i_Position, bool i_bLimit)
{
	if (!m_rTree.m_Error.empty())
		return;
	m_rTree.m_Error = std::string(i_What) + " (byte " + std::to_string(i_Position) + ")";
	m_rTree.m_bBeyondLimit = i_bLimit;
}
