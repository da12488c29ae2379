#include "fbxsdk/container/BinaryValues.h"
#include "fbxsdk/container/FileKind.h"
#include "fbxsdk/container/TreeBuilder.h"

#include <algorithm>
#include <optional>

namespace
{

using namespace FbxFormat;

struct VHeader
{
	std::uint64_t m_End = 0;
	std::uint64_t m_ValueCount = 0;
	std::uint64_t m_ValuesSize = 0;
	std::uint8_t m_NameLength = 0;
};

VHeader ReadHeader(const char* i_pFrom, bool i_bWide)
{
	const auto length = std::uint8_t(i_pFrom[i_bWide ? 24 : 12]);
	if (i_bWide)
		return {Binary::Load<std::uint64_t>(i_pFrom), Binary::Load<std::uint64_t>(i_pFrom + 8),
		    Binary::Load<std::uint64_t>(i_pFrom + 16), length};
	return {Binary::Load<std::uint32_t>(i_pFrom), Binary::Load<std::uint32_t>(i_pFrom + 4),
	    Binary::Load<std::uint32_t>(i_pFrom + 8), length};
}

/// True if the values fill their bytes exactly, each within its own limits.
bool AreValuesSound(std::string_view i_Values, std::uint64_t i_Count)
{
	const char* p = i_Values.data();
	const char* const pEnd = p + i_Values.size();
	for (; i_Count > 0; --i_Count)
	{
		p = Binary::SkipValue(p, pEnd);
		if (!p)
			return false;
	}
	return p == pEnd;
}

} // namespace

void FbxFormat::ReadBinaryRecords(std::string_view i_Bytes, std::uint32_t i_Version, VTreeBuilder& io_rBuilder)
{
	const bool bWide = i_Version >= c_FirstWideVersion;
	const std::size_t headerSize = RecordHeaderSize(bWide);
	std::size_t position = c_BinaryHeaderSize;
	while (true)
	{
		const std::size_t listEnd = io_rBuilder.End();
		const bool bTop = io_rBuilder.Depth() == 1;
		if (position + headerSize > listEnd)
		{
			// A list inside a record may end without the empty record that closes it: the record's end tells.
			if (bTop || position != listEnd)
				io_rBuilder.Error("it ends inside a record", position);
			if (bTop)
				return;
			position = listEnd;
			io_rBuilder.Close();
			continue;
		}
		const VHeader header = ReadHeader(i_Bytes.data() + position, bWide);
		if (header.m_End == 0)
		{
			if (bTop)
				return;
			position = listEnd;
			io_rBuilder.Close();
			continue;
		}

		const std::size_t name = position + headerSize;
		const std::size_t values = name + header.m_NameLength;
		if (header.m_End > listEnd)
			io_rBuilder.Error("a record reaches beyond what holds it", position);
		const std::size_t end = std::min<std::uint64_t>(header.m_End, listEnd);
		if (values > end)
		{
			// Nothing tells where the next record begins: the rest of this list is given up.
			io_rBuilder.Error("a record ends before its header", position);
			position = listEnd;
			continue;
		}

		if (io_rBuilder.IsLeftOut(i_Bytes.substr(name, header.m_NameLength)))
		{
			position = end;
			continue;
		}

		VElement element;
		element.m_Name = std::uint32_t(name);
		element.m_NameLength = header.m_NameLength;
		element.m_Values = std::uint32_t(values);
		position = end;
		if (header.m_ValuesSize > end - values)
			io_rBuilder.Error("the values of a record reach beyond it", name);
		else if (!AreValuesSound(i_Bytes.substr(values, header.m_ValuesSize), header.m_ValueCount))
			io_rBuilder.Error("the values of a record are damaged", name);
		else
		{
			element.m_ValuesSize = std::uint32_t(header.m_ValuesSize);
			element.m_ValueCount = std::uint32_t(header.m_ValueCount);
		}
		if (!io_rBuilder.Add(element))
			return;
		if (header.m_ValuesSize < end - values && io_rBuilder.Open(end))
			position = values + header.m_ValuesSize;
	}
}
