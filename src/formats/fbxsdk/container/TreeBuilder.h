#pragma once

#include "fbxsdk/container/ElementTree.h"

namespace FbxFormat
{

/// What the two readers share: the records that are open, and the list of findings. No recursion: the depth of a file
/// is the size of a list.
class VTreeBuilder
{
public:
	VTreeBuilder(VElementTree& io_rTree, std::string_view i_Bytes, EContent i_Content);

	/// Whether nobody asks for a record of that name in the innermost open one: it is passed over.
	bool IsLeftOut(std::string_view i_Name) const;

	/// Adds a record as the last child of the innermost open one. False if there are too many records: reading ends.
	bool Add(const VElement& i_rElement);

	/// Opens the record that was added last. False if it lies too deep. i_End is where its content ends at the latest.
	bool Open(std::size_t i_End);
	void Close() { m_Open.pop_back(); }
	std::size_t Depth() const { return m_Open.size(); }
	std::size_t End() const { return m_Open.back().m_End; }

	VElement& Last() { return m_rTree.m_Elements.back(); }

	/// Notes what is broken, or beyond a limit, with its place. Only the first is kept.
	void Error(std::string_view i_What, std::size_t i_Position, bool i_bLimit = false);

private:
	struct VOpen
	{
		VElementIndex m_Element;
		VElementIndex m_LastChild;
		std::size_t m_End;
	};

	VElementTree& m_rTree;
	const EContent m_Content;
	std::vector<VOpen> m_Open;
};

/// Both add what they find below the root. i_rBuilder has the root open, up to the end of the bytes.
void ReadBinaryRecords(std::string_view i_Bytes, std::uint32_t i_Version, VTreeBuilder& io_rBuilder);
void ReadTextRecords(std::string_view i_Bytes, VTreeBuilder& io_rBuilder);

} // namespace FbxFormat
