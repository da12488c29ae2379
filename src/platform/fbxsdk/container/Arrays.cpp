#include "fbxsdk/container/Arrays.h"

#include "fbxsdk/container/BinaryValues.h"
#include "fbxsdk/container/TextScan.h"
#include "fbxsdk/container/Values.h"

#include <libdeflate.h>

#include <algorithm>
#include <limits>
#include <memory>
#include <type_traits>

namespace
{

using namespace FbxFile;

bool Take(VDecodeBudget& io_rBudget, std::uint64_t i_Count, std::uint64_t i_ItemSize)
{
	const std::uint64_t bytes = i_Count * i_ItemSize;
	if (bytes > io_rBudget.m_BytesLeft)
		return false;
	io_rBudget.m_BytesLeft -= bytes;
	return true;
}

/// Fills exactly i_Size bytes, or fails.
bool Decode(const Binary::VArray& i_rArray, void* o_pBytes, std::size_t i_Size)
{
	if (!i_rArray.m_bDeflated)
	{
		std::memcpy(o_pBytes, i_rArray.m_pBytes, i_Size);
		return true;
	}
	using VDecompressor = std::unique_ptr<libdeflate_decompressor, decltype(&libdeflate_free_decompressor)>;
	const VDecompressor pDecompressor(libdeflate_alloc_decompressor(), &libdeflate_free_decompressor);
	return pDecompressor
	    && libdeflate_zlib_decompress(
	           pDecompressor.get(), i_rArray.m_pBytes, i_rArray.m_Size, o_pBytes, i_Size, nullptr)
	    == LIBDEFLATE_SUCCESS;
}

/// A number that the other type cannot hold becomes 0 where it is whole, an infinity where it is not.
template <typename T, typename TFile>
T Convert(TFile i_Number)
{
	if constexpr (std::is_integral_v<T> && std::is_floating_point_v<TFile>)
	{
		const double limit = -double(std::numeric_limits<T>::min());
		return i_Number >= -limit && i_Number < limit ? T(i_Number) : T(0);
	}
	else
		return T(i_Number);
}

template <typename TFile, typename T>
bool DecodeAs(const Binary::VArray& i_rArray, VDecodeBudget& io_rBudget, std::vector<T>& o_rNumbers)
{
	if constexpr (std::is_same_v<TFile, T>)
	{
		o_rNumbers.resize(i_rArray.m_Count);
		return Decode(i_rArray, o_rNumbers.data(), o_rNumbers.size() * sizeof(T));
	}
	else
	{
		if (!Take(io_rBudget, i_rArray.m_Count, sizeof(TFile)))
			return false;
		std::vector<TFile> numbers(i_rArray.m_Count);
		if (!Decode(i_rArray, numbers.data(), numbers.size() * sizeof(TFile)))
			return false;
		o_rNumbers.resize(numbers.size());
		std::transform(numbers.begin(), numbers.end(), o_rNumbers.begin(), &Convert<T, TFile>);
		return true;
	}
}

template <typename T>
bool DecodeBinary(const Binary::VArray& i_rArray, VDecodeBudget& io_rBudget, std::vector<T>& o_rNumbers)
{
	if (i_rArray.m_Count == 0)
		return true;
	switch (i_rArray.m_Type)
	{
	case 'f': return DecodeAs<float>(i_rArray, io_rBudget, o_rNumbers);
	case 'd': return DecodeAs<double>(i_rArray, io_rBudget, o_rNumbers);
	case 'i': return DecodeAs<std::int32_t>(i_rArray, io_rBudget, o_rNumbers);
	case 'l': return DecodeAs<std::int64_t>(i_rArray, io_rBudget, o_rNumbers);
	default: return DecodeAs<std::int8_t>(i_rArray, io_rBudget, o_rNumbers);
	}
}

template <typename T>
bool Append(const VValue& i_rValue, std::vector<T>& io_rNumbers)
{
	if (i_rValue.m_Kind == EValueKind::Integer)
		io_rNumbers.push_back(Convert<T>(i_rValue.m_Integer));
	else if (i_rValue.m_Kind == EValueKind::Real)
		io_rNumbers.push_back(Convert<T>(i_rValue.m_Real));
	else
		return false;
	return true;
}

template <typename T>
bool ParseText(std::string_view i_Text, std::uint32_t i_Count, std::vector<T>& o_rNumbers)
{
	o_rNumbers.reserve(i_Count);
	const char* const pEnd = i_Text.data() + i_Text.size();
	const char* pNext = Text::SkipSpace(i_Text.data(), pEnd);
	while (pNext && pNext != pEnd)
	{
		const char* const pNumberEnd = Text::ScanValue(pNext, pEnd);
		if (!pNumberEnd || o_rNumbers.size() == i_Count
		    || !Append(ParseNumber({pNext, std::size_t(pNumberEnd - pNext)}), o_rNumbers))
			return false;
		pNext = Text::NextValue(pNumberEnd, pEnd);
	}
	return o_rNumbers.size() == i_Count;
}

template <typename T>
bool ReadList(const VElementTree& i_rTree, VElementIndex i_Element, std::vector<T>& o_rNumbers)
{
	o_rNumbers.reserve(i_rTree[i_Element].m_ValueCount);
	VValueCursor cursor(i_rTree, i_Element);
	for (VValue value = cursor.Next(); value.m_Kind != EValueKind::None; value = cursor.Next())
		if (!Append(value, o_rNumbers))
			return false;
	return true;
}

} // namespace

template <typename T>
bool FbxFile::ReadArray(
    const VElementTree& i_rTree, VElementIndex i_Element, VDecodeBudget& io_rBudget, std::vector<T>& o_rNumbers)
{
	o_rNumbers.clear();
	const VElement& rElement = i_rTree[i_Element];
	const std::string_view values = i_rTree.Values(i_Element);
	const bool bBinaryArray =
	    rElement.m_Form == EValueForm::Binary && !values.empty() && Binary::ArrayItemSize(values.front()) > 0;
	const Binary::VArray array = bBinaryArray ? Binary::LoadArray(values.data()) : Binary::VArray();
	bool bSound = Take(io_rBudget, bBinaryArray ? array.m_Count : rElement.m_ValueCount, sizeof(T));
	if (bSound && bBinaryArray)
		bSound = DecodeBinary(array, io_rBudget, o_rNumbers);
	else if (bSound && rElement.m_Form == EValueForm::TextArray)
		bSound = ParseText(values, rElement.m_ValueCount, o_rNumbers);
	else if (bSound)
		bSound = ReadList(i_rTree, i_Element, o_rNumbers);
	if (!bSound)
		o_rNumbers.clear();
	return bSound;
}

template bool FbxFile::ReadArray(const VElementTree&, VElementIndex, VDecodeBudget&, std::vector<float>&);
template bool FbxFile::ReadArray(const VElementTree&, VElementIndex, VDecodeBudget&, std::vector<double>&);
template bool FbxFile::ReadArray(const VElementTree&, VElementIndex, VDecodeBudget&, std::vector<std::int32_t>&);
template bool FbxFile::ReadArray(const VElementTree&, VElementIndex, VDecodeBudget&, std::vector<std::int64_t>&);
