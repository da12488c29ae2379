#include "TesselDataStore/SkipReaders.h"

namespace NVX::IO
{

namespace
{

VSkipReader SkipBytes(std::uint64_t i_Size, ECollapse i_Collapse)
{
	if (i_Collapse == ECollapse::EYes)
		return std::make_unique<VReaderSkipBytes>(i_Size);
	return std::make_unique<VReaderSkipBytesNoCollapse>(i_Size);
}

VSkipReader SkipMembers(const ISchema& i_rSchema, ECollapse i_Collapse)
{
	std::vector<VSkipReader> members;
	for (const VSchemaChild& rChild : i_rSchema.m_Children)
	{
		VSkipReader pMember = MakeSkipReader(*rChild.m_pSchema, i_Collapse);
		if (members.empty() || !members.back()->Collapse(*pMember))
			members.push_back(std::move(pMember));
	}
	if (members.empty())
		return SkipBytes(0, i_Collapse);
	if (members.size() == 1)
		return std::move(members.front());
	return std::make_unique<VReaderSkipTuple>(std::move(members));
}

} // namespace

std::uint64_t SaturatedProduct(std::uint64_t i_Left, std::uint64_t i_Right)
{
	return i_Right != 0 && i_Left > UINT64_MAX / i_Right ? UINT64_MAX : i_Left * i_Right;
}

std::uint64_t SaturatedSum(std::uint64_t i_Left, std::uint64_t i_Right)
{
	return i_Left > UINT64_MAX - i_Right ? UINT64_MAX : i_Left + i_Right;
}

bool VReaderSkipBytes::Read(VBinaryReader& io_rBytes, void*) const
{
	io_rBytes.Take(m_Size);
	return true;
}

bool VReaderSkipBytes::Collapse(const IReaderCollapsable& i_rNext)
{
	const std::optional<std::uint64_t> next = i_rNext.FixedSize();
	if (next)
		m_Size = SaturatedSum(m_Size, *next);
	return next.has_value();
}

bool VReaderSkipArray::Read(VBinaryReader& io_rBytes, void*) const
{
	for (std::uint32_t index = 0; index < m_Count; ++index)
		if (!m_pElement->Read(io_rBytes, nullptr))
			return false;
	return true;
}

bool VReaderSkipContiguousVector::Read(VBinaryReader& io_rBytes, void*) const
{
	io_rBytes.Take(SaturatedProduct(io_rBytes.Number<std::uint32_t>(), m_ElementSize));
	return true;
}

bool VReaderSkipContainer::Read(VBinaryReader& io_rBytes, void*) const
{
	const auto count = io_rBytes.Number<std::uint32_t>();
	for (std::uint32_t index = 0; index < count; ++index)
		if (!m_pElement->Read(io_rBytes, nullptr))
			return false;
	return true;
}

bool VReaderSkipTuple::Read(VBinaryReader& io_rBytes, void*) const
{
	for (const VSkipReader& rpMember : m_Members)
		if (!rpMember->Read(io_rBytes, nullptr))
			return false;
	return true;
}

VSkipReader MakeSkipReader(const ISchema& i_rSchema, ECollapse i_Collapse)
{
	switch (i_rSchema.m_Type)
	{
	case EType::EString: return std::make_unique<VReaderSkipContiguousVector>(1);
	case EType::EArray:
	case EType::EList:
	{
		// Inside an element nobody stops.
		VSkipReader pElement = MakeSkipReader(*i_rSchema.m_pSubSchema);
		const std::optional<std::uint64_t> size = pElement->FixedSize();
		if (i_rSchema.m_Type == EType::EArray)
		{
			if (i_rSchema.m_Count == 0)
				return SkipBytes(0, i_Collapse);
			if (size)
				return SkipBytes(SaturatedProduct(*size, i_rSchema.m_Count), i_Collapse);
			return std::make_unique<VReaderSkipArray>(std::move(pElement), i_rSchema.m_Count);
		}
		if (size)
			return std::make_unique<VReaderSkipContiguousVector>(*size);
		return std::make_unique<VReaderSkipContainer>(std::move(pElement));
	}
	case EType::ETuple:
	case EType::ENamedTuple: return SkipMembers(i_rSchema, i_Collapse);
	default: return SkipBytes(SizeOf(i_rSchema.m_Type), i_Collapse);
	}
}

std::uint64_t MinimumSize(const ISchema& i_rSchema)
{
	switch (i_rSchema.m_Type)
	{
	case EType::EString:
	case EType::EList: return sizeof(std::uint32_t);
	case EType::EArray: return SaturatedProduct(MinimumSize(*i_rSchema.m_pSubSchema), i_rSchema.m_Count);
	case EType::ETuple:
	case EType::ENamedTuple:
	{
		std::uint64_t sum = 0;
		for (const VSchemaChild& rChild : i_rSchema.m_Children)
			sum = SaturatedSum(sum, MinimumSize(*rChild.m_pSchema));
		return sum;
	}
	default: return SizeOf(i_rSchema.m_Type);
	}
}

} // namespace NVX::IO
