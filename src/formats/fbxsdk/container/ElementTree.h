#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace FbxFormat
{

struct VFileKind;

/// Position of a record in its tree.
using VElementIndex = std::uint32_t;
inline constexpr VElementIndex c_NoElement = 0xFFFFFFFFu;

enum class EValueForm : std::uint8_t
{
	/// Values of the binary form, each behind a byte that tells its type.
	Binary,
	/// Values with commas between them.
	TextList,
	/// The numbers of "*24 { a: ... }".
	TextArray
};

/// One record: its name and values are places in the file, looked at only when somebody asks.
struct VElement
{
	std::uint32_t m_Name = 0;
	std::uint32_t m_Values = 0;
	std::uint32_t m_ValuesSize = 0;
	/// Of a TextArray the number that the file claims.
	std::uint32_t m_ValueCount = 0;
	VElementIndex m_FirstChild = c_NoElement;
	VElementIndex m_NextSibling = c_NoElement;
	std::uint8_t m_NameLength = 0;
	EValueForm m_Form = EValueForm::Binary;
};

/// What of a file is looked at.
enum class EContent
{
	All,
	/// Nothing of animation, poses and constraints, which are most of the records of a character that moves: what is
	/// in them, damage too, is passed over unread.
	WithoutMotion
};

/// The records of one file, both forms alike. The bytes of the file must outlive it.
class VElementTree
{
public:
	static constexpr VElementIndex c_Root = 0;

	VElementTree() : m_Elements(1) {}

	/// Reads all records. What is broken is passed over or cut short, and told in Error; the rest stays.
	/// @return false if anything was broken.
	bool Read(std::string_view i_Bytes, const VFileKind& i_rKind, EContent i_Content = EContent::All);

	/// The first thing that was broken, empty if nothing was.
	const std::string& Error() const { return m_Error; }

	/// Whether that was no damage, but more than is read.
	bool IsBeyondLimit() const { return m_bBeyondLimit; }

	std::size_t Size() const { return m_Elements.size(); }
	const VElement& operator[](VElementIndex i_Element) const { return m_Elements[i_Element]; }
	std::string_view Name(VElementIndex i_Element) const;
	std::string_view Values(VElementIndex i_Element) const;

	/// The first child of that name, or c_NoElement; of c_NoElement too.
	VElementIndex Find(VElementIndex i_Parent, std::string_view i_Name) const;

	class VChildIterator
	{
	public:
		using iterator_category = std::forward_iterator_tag;
		using value_type = VElementIndex;
		using difference_type = std::ptrdiff_t;
		using pointer = const VElementIndex*;
		using reference = VElementIndex;

		VChildIterator(const VElementTree& i_rTree, VElementIndex i_Element) : m_rTree(i_rTree), m_Element(i_Element) {}
		VElementIndex operator*() const { return m_Element; }
		bool operator==(const VChildIterator& i_rOther) const { return m_Element == i_rOther.m_Element; }
		VChildIterator& operator++()
		{
			m_Element = m_rTree[m_Element].m_NextSibling;
			return *this;
		}

	private:
		const VElementTree& m_rTree;
		VElementIndex m_Element;
	};

	struct VChildren
	{
		VChildIterator m_Begin;
		VChildIterator m_End;
		VChildIterator begin() const { return m_Begin; }
		VChildIterator end() const { return m_End; }
	};

	/// For a loop over the children of a record; c_NoElement has none.
	VChildren Children(VElementIndex i_Parent) const;

private:
	friend class VTreeBuilder;

	std::string_view m_Bytes;
	std::vector<VElement> m_Elements;
	std::string m_Error;
	bool m_bBeyondLimit = false;
};

} // namespace FbxFormat
