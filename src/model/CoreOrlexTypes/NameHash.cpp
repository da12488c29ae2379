#include "CoreOrlexTypes/NameHash.h"

#include <algorithm>
#include <bit>

namespace
{

/// The 32-bit x86 variant of Austin Appleby's MurmurHash3 with seed 0; blocks are read with the low byte first.
std::uint32_t MurmurHash3(std::string_view i_Bytes)
{
	constexpr std::uint32_t c_First = 0xCC9E2D51u;
	constexpr std::uint32_t c_Second = 0x1B873593u;

	std::uint32_t hash = 0;
	for (std::size_t at = 0; at < i_Bytes.size(); at += 4)
	{
		const std::size_t count = std::min<std::size_t>(4, i_Bytes.size() - at);
		std::uint32_t block = 0;
		for (std::size_t i = 0; i < count; ++i)
			block |= std::uint32_t(static_cast<unsigned char>(i_Bytes[at + i])) << (8 * i);
		hash ^= std::rotl(block * c_First, 15) * c_Second;
		if (count == 4)
			hash = std::rotl(hash, 13) * 5 + 0xE6546B64u;
	}
	hash ^= std::uint32_t(i_Bytes.size());
	hash = (hash ^ (hash >> 16)) * 0x85EBCA6Bu;
	hash = (hash ^ (hash >> 13)) * 0xC2B2AE35u;
	return hash ^ (hash >> 16);
}

} // namespace

std::uint32_t CoreOrlexTypes::HashName(std::string_view i_Name)
{
	if (i_Name.empty())
		return 0xFFFFFFFFu;
	return std::min(MurmurHash3(i_Name), 0xFFFFFFFEu);
}
