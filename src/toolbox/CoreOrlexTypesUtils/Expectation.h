#pragma once

#include "DebugServices/Assert.h"

#include <cstddef>
#include <string>

namespace CoreOrlexTypesUtils
{

/// An assertion whose text is given, for texts that do not follow from the code. Like every assertion it tells and goes
/// on; the result is there to be tested.
inline bool Expect(
    bool i_bHolds, const char* i_pText, const char* i_pFile = __builtin_FILE(), int i_Line = __builtin_LINE())
{
	if (!i_bHolds)
		DebugServices::CallAssertFailHandler(i_pText, i_pFile, i_Line);
	return i_bHolds;
}

/// Expects "NAME.size() == SIZE".
template <typename TList>
bool ExpectSize(const TList& i_rList, const char* i_pName, std::size_t i_Size, const char* i_pFile = __builtin_FILE(),
    int i_Line = __builtin_LINE())
{
	return i_rList.size() == i_Size
	    || Expect(
	        false, std::string(i_pName).append(".size() == ").append(std::to_string(i_Size)).c_str(), i_pFile, i_Line);
}

} // namespace CoreOrlexTypesUtils
