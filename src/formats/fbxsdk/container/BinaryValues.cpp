#include "fbxsdk/container/BinaryValues.h"

#include "fbxsdk/Limits.h"

namespace
{

/// Type, count, encoding, size in the file.
constexpr std::ptrdiff_t c_ArrayHeaderSize = 13;

constexpr std::ptrdiff_t ScalarSize(char i_Type)
{
	switch (i_Type)
	{
	case 'B':
	case 'C':
	case 'Z': return 1;
	case 'Y': return 2;
	case 'I':
	case 'F': return 4;
	case 'L':
	case 'D': return 8;
	default: return 0;
	}
}

} // namespace

std::uint32_t FbxFormat::Binary::ArrayItemSize(char i_Type)
{
	// An array has the small letter of its scalars.
	return i_Type >= 'a' && i_Type <= 'z' ? std::uint32_t(ScalarSize(char(i_Type - 'a' + 'A'))) : 0;
}

const char* FbxFormat::Binary::SkipValue(const char* i_pFrom, const char* i_pEnd)
{
	if (i_pFrom == i_pEnd)
		return nullptr;
	const char type = *i_pFrom;
	if (const std::ptrdiff_t size = ScalarSize(type); size > 0)
		return i_pEnd - i_pFrom > size ? i_pFrom + 1 + size : nullptr;
	if (type == 'S' || type == 'R')
	{
		if (i_pEnd - i_pFrom < 5)
			return nullptr;
		const auto size = Load<std::uint32_t>(i_pFrom + 1);
		return i_pEnd - i_pFrom - 5 >= std::ptrdiff_t(size) ? i_pFrom + 5 + size : nullptr;
	}
	const std::uint64_t itemSize = ArrayItemSize(type);
	if (itemSize == 0 || i_pEnd - i_pFrom < c_ArrayHeaderSize)
		return nullptr;
	const auto encoding = Load<std::uint32_t>(i_pFrom + 5);
	const VArray array = LoadArray(i_pFrom);
	if (i_pEnd - array.m_pBytes < std::ptrdiff_t(array.m_Size) || encoding > 1)
		return nullptr;
	const std::uint64_t decoded = array.m_Count * itemSize;
	if (array.m_bDeflated ? decoded > array.m_Size * Limits::c_DeflateRatio : decoded != array.m_Size)
		return nullptr;
	return array.m_pBytes + array.m_Size;
}

FbxFormat::Binary::VArray FbxFormat::Binary::LoadArray(const char* i_pFrom)
{
	return {*i_pFrom, Load<std::uint32_t>(i_pFrom + 1), Load<std::uint32_t>(i_pFrom + 5) == 1,
	    i_pFrom + c_ArrayHeaderSize, Load<std::uint32_t>(i_pFrom + 9)};
}
