#include "fbxsdk/container/Arrays.h"

#include "fbxsdk/container/BinaryValues.h"
#include "fbxsdk/container/Lent.h"
#include "fbxsdk/container/TextScan.h"
#include "fbxsdk/container/Values.h"

#include <libdeflate.h>

#include <algorithm>
#include <charconv>
#include <cmath>
#include <limits>
#include <type_traits>

namespace
{

using namespace FbxFormat;

/// Fills exactly i_Size bytes, or fails.
bool Decode(const Binary::VArray& i_rArray, void* o_pBytes, std::size_t i_Size)
{
	if (!i_rArray.m_bDeflated)
	{
		std::memcpy(o_pBytes, i_rArray.m_pBytes, i_Size);
		return true;
	}
	const VLent<libdeflate_alloc_decompressor, libdeflate_free_decompressor> decompressor;
	return decompressor.Get()
	    && libdeflate_zlib_decompress(decompressor.Get(), i_rArray.m_pBytes, i_rArray.m_Size, o_pBytes, i_Size, nullptr)
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
bool DecodeAs(const Binary::VArray& i_rArray, VArrayNumbers<T>& o_rNumbers)
{
	if constexpr (std::is_same_v<TFile, T>)
	{
		o_rNumbers.resize(i_rArray.m_Count);
		return Decode(i_rArray, o_rNumbers.data(), o_rNumbers.size() * sizeof(T));
	}
	else
	{
		VArrayNumbers<TFile> numbers(i_rArray.m_Count);
		if (!Decode(i_rArray, numbers.data(), numbers.size() * sizeof(TFile)))
			return false;
		o_rNumbers.resize(numbers.size());
		std::transform(numbers.begin(), numbers.end(), o_rNumbers.begin(), &Convert<T, TFile>);
		return true;
	}
}

template <typename T>
bool DecodeBinary(const Binary::VArray& i_rArray, VArrayNumbers<T>& o_rNumbers)
{
	if (i_rArray.m_Count == 0)
		return true;
	switch (i_rArray.m_Type)
	{
	case 'f': return DecodeAs<float>(i_rArray, o_rNumbers);
	case 'd': return DecodeAs<double>(i_rArray, o_rNumbers);
	case 'y': return DecodeAs<std::int16_t>(i_rArray, o_rNumbers);
	case 'i': return DecodeAs<std::int32_t>(i_rArray, o_rNumbers);
	case 'l': return DecodeAs<std::int64_t>(i_rArray, o_rNumbers);
	default: return DecodeAs<std::int8_t>(i_rArray, o_rNumbers);
	}
}

template <typename T>
bool Append(const VValue& i_rValue, VArrayNumbers<T>& io_rNumbers)
{
	if (i_rValue.m_Kind == EValueKind::Integer)
		io_rNumbers.push_back(Convert<T>(i_rValue.m_Integer));
	else if (i_rValue.m_Kind == EValueKind::Real)
		io_rNumbers.push_back(Convert<T>(i_rValue.m_Real));
	else
		return false;
	return true;
}

/// Adds a number in the spelling of nearly all of them.
/// @return the place behind it, or null, with nothing added, for what ParseNumber must look at.
template <typename T>
const char* ParseDirect(const char* i_pFrom, const char* i_pEnd, VArrayNumbers<T>& io_rNumbers)
{
	// Not float: its numbers are rounded twice, as everywhere.
	std::conditional_t<std::is_integral_v<T>, T, double> number;
	const auto [p, error] = std::from_chars(i_pFrom, i_pEnd, number);
	if (error != std::errc() || !Text::EndsValue(p, i_pEnd))
		return nullptr;
	if constexpr (!std::is_integral_v<T>)
		if (!std::isnormal(number) && *i_pFrom != '0')
			return nullptr;
	io_rNumbers.push_back(T(number));
	return p;
}

template <typename T>
bool ParseText(std::string_view i_Text, std::uint32_t i_Count, VArrayNumbers<T>& o_rNumbers)
{
	o_rNumbers.reserve(i_Count);
	const char* const pEnd = i_Text.data() + i_Text.size();
	const char* pNext = Text::SkipSpace(i_Text.data(), pEnd);
	while (pNext && pNext != pEnd)
	{
		if (o_rNumbers.size() == i_Count)
			return false;
		const char* p = ParseDirect(pNext, pEnd, o_rNumbers);
		if (!p)
		{
			p = Text::ScanValue(pNext, pEnd);
			if (!p || !Append(ParseNumber({pNext, std::size_t(p - pNext)}), o_rNumbers))
				return false;
		}
		pNext = Text::NextValue(p, pEnd);
	}
	return o_rNumbers.size() == i_Count;
}

template <typename T>
bool ReadList(const VElementTree& i_rTree, VElementIndex i_Element, VArrayNumbers<T>& o_rNumbers)
{
	o_rNumbers.reserve(i_rTree[i_Element].m_ValueCount);
	VValueCursor cursor(i_rTree, i_Element);
	for (VValue value = cursor.Next(); value.m_Kind != EValueKind::None; value = cursor.Next())
		if (!Append(value, o_rNumbers))
			return false;
	return true;
}

/// The array that a record of the binary form holds; of no type if it holds none.
Binary::VArray ArrayOf(const VElementTree& i_rTree, VElementIndex i_Element)
{
	const std::string_view values = i_rTree.Values(i_Element);
	const bool bArray =
	    i_rTree[i_Element].m_Form == EValueForm::Binary && !values.empty() && Binary::ArrayItemSize(values.front()) > 0;
	return bArray ? Binary::LoadArray(values.data()) : Binary::VArray();
}

template <typename T>
constexpr char c_TypeOf = std::is_same_v<T, float> ? 'f'
    : std::is_same_v<T, double>                    ? 'd'
    : std::is_same_v<T, std::int32_t>              ? 'i'
                                                   : 'l';

} // namespace

template <typename T>
std::uint64_t FbxFormat::DecodedBytes(const VElementTree& i_rTree, VElementIndex i_Element)
{
	const Binary::VArray array = ArrayOf(i_rTree, i_Element);
	if (array.m_Type == 0)
		return i_rTree[i_Element].m_ValueCount * std::uint64_t(sizeof(T));
	const std::uint64_t converted = array.m_Type == c_TypeOf<T> ? 0 : Binary::ArrayItemSize(array.m_Type);
	return array.m_Count * (sizeof(T) + converted);
}

template <typename T>
bool FbxFormat::ReadCharged(const VElementTree& i_rTree, VElementIndex i_Element, VArrayNumbers<T>& o_rNumbers)
{
	o_rNumbers.clear();
	const VElement& rElement = i_rTree[i_Element];
	const Binary::VArray array = ArrayOf(i_rTree, i_Element);
	const bool bSound = array.m_Type != 0 ? DecodeBinary(array, o_rNumbers)
	    : rElement.m_Form != EValueForm::Binary
	    ? ParseText(i_rTree.Values(i_Element), rElement.m_ValueCount, o_rNumbers)
	    : ReadList(i_rTree, i_Element, o_rNumbers);
	if (!bSound)
		o_rNumbers.clear();
	return bSound;
}

#define RETARGET_ARRAYS_OF(T)                                                                                          \
	template std::uint64_t FbxFormat::DecodedBytes<T>(const VElementTree&, VElementIndex);                             \
	template bool FbxFormat::ReadCharged(const VElementTree&, VElementIndex, VArrayNumbers<T>&);
RETARGET_ARRAYS_OF(float)
RETARGET_ARRAYS_OF(double)
RETARGET_ARRAYS_OF(std::int32_t)
RETARGET_ARRAYS_OF(std::int64_t)
