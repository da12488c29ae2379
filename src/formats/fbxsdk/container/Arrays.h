#pragma once

#include "fbxsdk/Limits.h"
#include "fbxsdk/container/ElementTree.h"
#include "fbxsdk/container/Numbers.h"

namespace FbxFormat
{

/// What may still be decoded from one file.
struct VDecodeBudget
{
	std::uint64_t m_BytesLeft = Limits::c_DecodedBytes;

	/// False, with nothing taken, if there is not so much left.
	bool Take(std::uint64_t i_Bytes)
	{
		const bool bEnough = i_Bytes <= m_BytesLeft;
		m_BytesLeft -= bEnough ? i_Bytes : 0;
		return bEnough;
	}
};

/// The bytes that ReadArray takes from the budget: those of the numbers, and of the file's where these are of another
/// type.
template <typename T>
std::uint64_t DecodedBytes(const VElementTree& i_rTree, VElementIndex i_Element);

/// ReadArray without the budget, which was charged. Any number of threads may read different arrays of a tree.
template <typename T>
bool ReadCharged(const VElementTree& i_rTree, VElementIndex i_Element, VArrayNumbers<T>& o_rNumbers);

/// All numbers of a record, whichever way it holds them: a deflated or plain array, the text of one, or a list of
/// values. T is float, double, std::int32_t or std::int64_t; other types in the file are converted.
/// @return false if the numbers are damaged, not so many as the file claims, or beyond the budget; then o_rNumbers is
/// empty.
template <typename T>
bool ReadArray(
    const VElementTree& i_rTree, VElementIndex i_Element, VDecodeBudget& io_rBudget, VArrayNumbers<T>& o_rNumbers)
{
	o_rNumbers.clear();
	return io_rBudget.Take(DecodedBytes<T>(i_rTree, i_Element)) && ReadCharged(i_rTree, i_Element, o_rNumbers);
}

} // namespace FbxFormat
