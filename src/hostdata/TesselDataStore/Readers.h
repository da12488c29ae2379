#pragma once

#include "TesselDataStore/BinaryReader.h"

#include <memory>
#include <optional>

namespace NVX
{

/// One step of reading a value, made from the schema of the stored bytes.
class IReader
{
public:
	virtual ~IReader() = default;

	/// @param o_pValue receives the value; its type is known to who built the reader. Null for one that only skips.
	/// @return false if the bytes are no value of the schema.
	/// @throw std::runtime_error at the end of the bytes.
	virtual bool Read(IO::VBinaryReader& io_rBytes, void* o_pValue) const = 0;
};

/// A reader that steps over bytes, and may take over what its neighbour steps over.
class IReaderCollapsable : public IReader
{
public:
	/// The bytes that it always steps over; nothing if that depends on the bytes.
	virtual std::optional<std::uint64_t> FixedSize() const = 0;

	/// Takes over the work of the reader that comes next.
	/// @return false, with nothing changed, if the two cannot be one.
	virtual bool Collapse(const IReaderCollapsable& i_rNext) = 0;
};

} // namespace NVX
