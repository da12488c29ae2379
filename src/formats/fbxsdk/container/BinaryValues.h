#pragma once

#include <bit>
#include <cstdint>
#include <cstring>

/// The values of the binary form: a byte for the type, then the value in little-endian bytes.
namespace FbxFormat::Binary
{

static_assert(std::endian::native == std::endian::little, "values are read as they stand in the file");

template <typename T>
T Load(const char* i_pFrom)
{
	T value;
	std::memcpy(&value, i_pFrom, sizeof(T));
	return value;
}

/// The bytes of one entry of an array of that type, 0 if it is not the type of an array.
std::uint32_t ArrayItemSize(char i_Type);

/// An array as it stands in the file.
struct VArray
{
	char m_Type = 0;
	std::uint32_t m_Count = 0;
	bool m_bDeflated = false;
	const char* m_pBytes = nullptr;
	std::uint32_t m_Size = 0;
};

/// The place after the value that begins here; null if it is of no known type, does not end before i_pEnd, or is an
/// array whose count its bytes cannot hold.
const char* SkipValue(const char* i_pFrom, const char* i_pEnd);

/// i_pFrom is the type of an array that SkipValue has found sound.
VArray LoadArray(const char* i_pFrom);

} // namespace FbxFormat::Binary
