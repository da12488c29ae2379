#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string_view>

namespace UtilsRapidXml
{

/// True for the code points that XML 1.0 can hold, be it as such or as a character reference (production 2, Char).
constexpr bool IsXmlCharacter(char32_t i_Code)
{
	return (i_Code >= 0x20 && i_Code <= 0xD7FF) || i_Code == '\t' || i_Code == '\n' || i_Code == '\r'
	    || (i_Code >= 0xE000 && i_Code <= 0xFFFD) || (i_Code >= 0x10000 && i_Code <= 0x10FFFF);
}

/// Bytes looked at together, by the vector extension that g++ and clang share.
using VBlock = signed char __attribute__((vector_size(16)));

/// Whether i_Is, which gives a block of comparisons, is true for a byte of the t_Count blocks that begin here.
template <std::size_t t_Count = 1, typename TIs>
bool BlockHas(const char* i_pBytes, TIs i_Is)
{
	VBlock is{};
	for (std::size_t i = 0; i < t_Count; ++i)
	{
		VBlock bytes;
		std::memcpy(&bytes, i_pBytes + i * sizeof bytes, sizeof bytes);
		is |= i_Is(bytes);
	}
	std::uint64_t halves[2];
	std::memcpy(halves, &is, sizeof halves);
	return (halves[0] | halves[1]) != 0;
}

/// One of 64 bits for a name, which is not empty. Names that differ nearly always differ in it.
inline std::uint64_t NameBit(std::string_view i_Name)
{
	return std::uint64_t(1) << ((i_Name.size() * 7 + i_Name.back() * 3 + i_Name.front()) % 64);
}

/// As ==, without a call of the library for names of some bytes.
inline bool AreSameName(std::string_view i_Left, std::string_view i_Right)
{
	using VWord = std::uint64_t;
	const std::size_t size = i_Left.size();
	const auto differsAt = [&](std::size_t i_At)
	{
		VWord left;
		VWord right;
		std::memcpy(&left, i_Left.data() + i_At, sizeof left);
		std::memcpy(&right, i_Right.data() + i_At, sizeof right);
		return left != right;
	};
	if (size != i_Right.size())
		return false;
	if (size < sizeof(VWord))
		return std::equal(i_Left.begin(), i_Left.end(), i_Right.begin());
	// The last word may overlap the one before.
	for (std::size_t at = 0; at + sizeof(VWord) < size; at += sizeof(VWord))
		if (differsAt(at))
			return false;
	return !differsAt(size - sizeof(VWord));
}

/// @return the place of the first byte that is no well-formed UTF-8 (overlong forms and surrogates included) or begins
/// a character that XML cannot hold, npos if there is none.
std::size_t FindBrokenCharacter(std::string_view i_Text);

} // namespace UtilsRapidXml
