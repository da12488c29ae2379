#include "fbxsdk/container/RecordInsertion.h"

#include "fbxsdk/Limits.h"
#include "fbxsdk/container/BinaryValues.h"
#include "fbxsdk/container/FileKind.h"

#include <algorithm>
#include <cstring>

namespace
{

using namespace FbxFormat;

/// Behind the last record: an id, zeros, and then the version with what follows it, at a place that exporters choose by
/// its remainder to 16.
constexpr std::size_t c_IdSize = 16;
constexpr std::size_t c_Alignment = 16;
constexpr std::size_t c_LeastZeros = 5;
constexpr std::size_t c_EndSize = 4 + 120 + 16;

struct VPart
{
	/// In the old file.
	std::size_t m_Place;
	/// Into which it is put.
	VElementIndex m_List;
	const VInsertion* m_pInsertion;
	std::string m_Bytes;
};

class VFile
{
public:
	VFile(std::string_view i_Bytes, std::uint32_t i_Version, const VElementTree& i_rTree)
	    : m_Bytes(i_Bytes), m_Version(i_Version), m_bWide(i_Version >= c_FirstWideVersion), m_rTree(i_rTree)
	{
	}

	void Write(const std::vector<VInsertion>& i_rInsertions)
	{
		for (const VInsertion& rInsertion : i_rInsertions)
		{
			const VElementIndex list = m_rTree.Find(VElementTree::c_Root, rInsertion.m_List);
			if (const VElementIndex last = LastChild(list); last != c_NoElement)
				m_Parts.push_back({EndOf(last), list, &rInsertion, {}});
		}
		std::ranges::sort(m_Parts, {}, &VPart::m_Place);
		std::size_t added = 0;
		for (VPart& rPart : m_Parts)
		{
			VRecordWriter writer(m_Version, rPart.m_Place + added);
			rPart.m_pInsertion->m_Write(writer);
			rPart.m_Bytes = writer.Finish();
			added += rPart.m_Bytes.size();
		}
	}

	std::string Joined() const
	{
		std::string bytes;
		std::size_t from = 0;
		for (const VPart& rPart : m_Parts)
		{
			bytes.append(m_Bytes.substr(from, rPart.m_Place - from)).append(rPart.m_Bytes);
			from = rPart.m_Place;
		}
		// The empty record that closes the list at the top stands before the end of the file.
		const std::size_t zeros = EndOf(LastChild(VElementTree::c_Root)) + RecordHeaderSize(m_bWide) + c_IdSize;
		if (m_Bytes.size() < zeros + c_LeastZeros + c_EndSize
		    || m_Bytes.size() >= zeros + c_LeastZeros + c_Alignment + c_EndSize)
			return bytes.append(m_Bytes.substr(from));
		const std::size_t end = m_Bytes.size() - c_EndSize;
		bytes.append(m_Bytes.substr(from, zeros - from)).append(c_LeastZeros, '\0');
		bytes.append((end - bytes.size()) % c_Alignment, '\0');
		return bytes.append(m_Bytes.substr(end));
	}

	void MoveEnds(std::string& io_rBytes) const
	{
		for (VElementIndex element = 1; element < m_rTree.Size(); ++element)
		{
			const std::size_t header = HeaderOf(element);
			const std::size_t oldEnd = EndOf(element);
			std::size_t place = header;
			std::uint64_t end = oldEnd;
			for (const VPart& rPart : m_Parts)
			{
				place += rPart.m_Place <= header ? rPart.m_Bytes.size() : 0;
				// A list may end with its last record.
				end += rPart.m_Place < oldEnd || rPart.m_List == element ? rPart.m_Bytes.size() : 0;
			}
			std::memcpy(io_rBytes.data() + place, &end, m_bWide ? 8 : 4);
		}
	}

private:
	VElementIndex LastChild(VElementIndex i_Parent) const
	{
		VElementIndex last = c_NoElement;
		for (const VElementIndex child : m_rTree.Children(i_Parent))
			last = child;
		return last;
	}

	std::size_t HeaderOf(VElementIndex i_Element) const
	{
		return m_rTree[i_Element].m_Name - RecordHeaderSize(m_bWide);
	}

	std::size_t EndOf(VElementIndex i_Element) const
	{
		const char* const pEnd = m_Bytes.data() + HeaderOf(i_Element);
		return m_bWide ? Binary::Load<std::uint64_t>(pEnd) : Binary::Load<std::uint32_t>(pEnd);
	}

	const std::string_view m_Bytes;
	const std::uint32_t m_Version;
	const bool m_bWide;
	const VElementTree& m_rTree;
	std::vector<VPart> m_Parts;
};

} // namespace

bool FbxFormat::InsertRecords(std::string_view i_File, std::uint32_t i_Version, const VElementTree& i_rTree,
    const std::vector<VInsertion>& i_rInsertions, std::string& o_rBytes)
{
	VFile file(i_File, i_Version, i_rTree);
	file.Write(i_rInsertions);
	std::string bytes = file.Joined();
	if (bytes.size() > Limits::c_FileBytes)
		return false;
	file.MoveEnds(bytes);
	// There may be more records than are read, too.
	if (VElementTree tree; !tree.Read(bytes, DetectFileKind(bytes)))
		return false;
	o_rBytes = std::move(bytes);
	return true;
}
