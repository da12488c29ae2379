#pragma once

#include "fbxsdk/Limits.h"
#include "fbxsdk/container/ElementTree.h"

#include <vector>

namespace FbxFile
{

/// What may still be decoded from one file.
struct VDecodeBudget
{
	std::uint64_t m_BytesLeft = Limits::c_DecodedBytes;
};

/// All numbers of a record, whichever way it holds them: a deflated or plain array, the text of one, or a list of
/// values. T is float, double, std::int32_t or std::int64_t; other types in the file are converted.
/// @return false if the numbers are damaged, not so many as the file claims, or beyond the budget; then o_rNumbers is
/// empty.
template <typename T>
bool ReadArray(
    const VElementTree& i_rTree, VElementIndex i_Element, VDecodeBudget& io_rBudget, std::vector<T>& o_rNumbers);

} // namespace FbxFile
