#pragma once

#include "TesselDataStore/Limits.h"

#include <algorithm>
#include <bit>
#include <concepts>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <stdexcept>
#include <string_view>
#include <type_traits>

namespace NVX::IO
{

template <typename T>
concept CNumber = std::is_arithmetic_v<T> && !std::is_same_v<T, bool>;

/// Typed bytes and a position in them. Does not own the bytes.
class VBinaryReader
{
public:
	explicit VBinaryReader(std::string_view i_Bytes) : m_pBase(i_Bytes.data()), m_Size(i_Bytes.size()) {}

	std::size_t Position() const { return m_Position; }
	/// 0 after a failure.
	std::size_t BytesLeft() const { return m_Size - std::min(m_Position, m_Size); }

	/// Goes on by a number of bytes and returns where they begin.
	/// @throw std::runtime_error "Unexpected end of binary data" if there are not so many; all that is asked for
	/// afterwards throws, too.
	const char* Take(std::uint64_t i_Count)
	{
		const std::size_t begin = m_Position;
		m_Position = i_Count > SIZE_MAX - begin ? SIZE_MAX : begin + std::size_t(i_Count);
		if (m_Position > m_Size)
			throw std::runtime_error("Unexpected end of binary data");
		return m_pBase + begin;
	}

	template <CNumber T>
	T Number()
	{
		char bytes[sizeof(T)];
		std::memcpy(bytes, Take(sizeof(T)), sizeof(T));
		if constexpr (std::endian::native == std::endian::big)
			std::reverse(std::begin(bytes), std::end(bytes));
		return std::bit_cast<T>(bytes);
	}

	/// @return false for a text whose length reaches past the end.
	/// @param o_rText looks at the bytes of this reader.
	bool Text(std::string_view& o_rText)
	{
		const auto length = Number<std::uint32_t>();
		if (length > BytesLeft())
			return false;
		o_rText = {Take(length), length};
		return true;
	}

	/// The count of a list's elements.
	/// @param i_MinimumSize of an element in bytes: a count that cannot fit what is left throws.
	/// @param i_SizeInMemory that an element will take.
	/// @return false if all lists together would take more memory than c_MaxElementBytes, or if more than
	/// c_MaxEmptyElements take no bytes.
	bool Count(std::uint64_t i_MinimumSize, std::size_t i_SizeInMemory, std::uint32_t& o_rCount)
	{
		o_rCount = Number<std::uint32_t>();
		if (i_MinimumSize != 0 && o_rCount > BytesLeft() / i_MinimumSize)
			Take(UINT64_MAX);
		if (i_MinimumSize == 0 && o_rCount > TesselDataStore::c_MaxEmptyElements)
			return false;
		if (std::uint64_t(o_rCount) * i_SizeInMemory > m_ElementBytesLeft)
			return false;
		m_ElementBytesLeft -= std::uint64_t(o_rCount) * i_SizeInMemory;
		return true;
	}

private:
	const char* m_pBase;
	std::size_t m_Size;
	std::size_t m_Position = 0;
	std::uint64_t m_ElementBytesLeft = TesselDataStore::c_MaxElementBytes;
};

} // namespace NVX::IO
