#pragma once

#include "TesselDataStore/Readers.h"
#include "Variant/Schema.h"

#include <vector>

namespace NVX::IO
{

using VSkipReader = std::unique_ptr<IReaderCollapsable>;

/// Steps over a fixed number of bytes, its neighbours' included.
class VReaderSkipBytes : public IReaderCollapsable
{
public:
	explicit VReaderSkipBytes(std::uint64_t i_Size) : m_Size(i_Size) {}
	bool Read(VBinaryReader& io_rBytes, void* o_pValue) const override;
	std::optional<std::uint64_t> FixedSize() const override { return m_Size; }
	bool Collapse(const IReaderCollapsable& i_rNext) override;

private:
	std::uint64_t m_Size;
};

/// One that stays alone, for who needs to stop between two values.
class VReaderSkipBytesNoCollapse : public VReaderSkipBytes
{
public:
	using VReaderSkipBytes::VReaderSkipBytes;
	std::optional<std::uint64_t> FixedSize() const override { return std::nullopt; }
	bool Collapse(const IReaderCollapsable&) override { return false; }
};

/// A reader whose number of bytes depends on the bytes.
class VReaderSkipVariable : public IReaderCollapsable
{
public:
	std::optional<std::uint64_t> FixedSize() const override { return std::nullopt; }
	bool Collapse(const IReaderCollapsable&) override { return false; }
};

/// Steps over a fixed number of elements, one by one.
class VReaderSkipArray : public VReaderSkipVariable
{
public:
	VReaderSkipArray(VSkipReader i_pElement, std::uint32_t i_Count)
	    : m_pElement(std::move(i_pElement)), m_Count(i_Count)
	{
	}
	bool Read(VBinaryReader& io_rBytes, void* o_pValue) const override;

private:
	VSkipReader m_pElement;
	std::uint32_t m_Count;
};

/// Steps over a counted list of elements of one size, or a text, in one move.
class VReaderSkipContiguousVector : public VReaderSkipVariable
{
public:
	explicit VReaderSkipContiguousVector(std::uint64_t i_ElementSize) : m_ElementSize(i_ElementSize) {}
	bool Read(VBinaryReader& io_rBytes, void* o_pValue) const override;

private:
	std::uint64_t m_ElementSize;
};

/// Steps over a counted list of elements of different sizes.
class VReaderSkipContainer : public VReaderSkipVariable
{
public:
	explicit VReaderSkipContainer(VSkipReader i_pElement) : m_pElement(std::move(i_pElement)) {}
	bool Read(VBinaryReader& io_rBytes, void* o_pValue) const override;

private:
	VSkipReader m_pElement;
};

/// Steps over members of which not all have a fixed size.
class VReaderSkipTuple : public VReaderSkipVariable
{
public:
	explicit VReaderSkipTuple(std::vector<VSkipReader> i_Members) : m_Members(std::move(i_Members)) {}
	bool Read(VBinaryReader& io_rBytes, void* o_pValue) const override;

private:
	std::vector<VSkipReader> m_Members;
};

enum class ECollapse : bool
{
	ENo,
	EYes
};

/// The reader that steps over any value of a schema, in as few moves as possible.
/// @param i_Collapse ENo keeps what is of fixed size apart from what stands beside it.
VSkipReader MakeSkipReader(const ISchema& i_rSchema, ECollapse i_Collapse = ECollapse::EYes);

/// The bytes that every value of a schema has at least. The largest number if they are more than can be counted.
std::uint64_t MinimumSize(const ISchema& i_rSchema);

/// A product or sum that stops at the largest number.
std::uint64_t SaturatedProduct(std::uint64_t i_Left, std::uint64_t i_Right);
std::uint64_t SaturatedSum(std::uint64_t i_Left, std::uint64_t i_Right);

} // namespace NVX::IO
