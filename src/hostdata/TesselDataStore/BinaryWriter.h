#pragma once

#include "TesselDataStore/BinaryReader.h"

#include "DebugServices/Assert.h"

#include <string>

namespace NVX::IO
{

/// Appends typed bytes to a text of bytes that it does not own.
class VBinaryWriter
{
public:
	explicit VBinaryWriter(std::string& io_rBytes) : m_rBytes(io_rBytes) {}

	template <CNumber T>
	void Number(T i_Value)
	{
		char bytes[sizeof(T)];
		std::memcpy(bytes, &i_Value, sizeof(T));
		if constexpr (std::endian::native == std::endian::big)
			std::reverse(std::begin(bytes), std::end(bytes));
		m_rBytes.append(bytes, sizeof(T));
	}

	void Count(std::size_t i_Count)
	{
		NVX_ASSERT(i_Count <= UINT32_MAX);
		Number(std::uint32_t(i_Count));
	}

	void Text(std::string_view i_Text)
	{
		Count(i_Text.size());
		m_rBytes += i_Text;
	}

private:
	std::string& m_rBytes;
};

} // namespace NVX::IO
