#pragma once

#include <cstddef>
#include <cstdint>

namespace NVX
{

/// Bytes that can be read from any place.
class IInputStreamSeekable
{
public:
	virtual ~IInputStreamSeekable() = default;

	/// False if it could not be opened, or once a read failed for another reason than the end.
	virtual bool IsGood() const = 0;
	virtual std::uint64_t GetSize() const = 0;
	virtual std::uint64_t GetPosition() const = 0;
	/// @return false, with the position as it was, beyond the end.
	virtual bool Seek(std::uint64_t i_Position) = 0;
	/// Reads from the position on and moves it.
	/// @return the bytes read: less than asked for only at the end or on failure.
	virtual std::size_t Read(void* o_pBytes, std::size_t i_Count) = 0;
};

} // namespace NVX
