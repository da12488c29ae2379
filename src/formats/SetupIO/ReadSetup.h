#pragma once

#include "SetupIO/Setup.h"

#include <initializer_list>
#include <string>
#include <string_view>

namespace SetupIO
{

/// What is wrong with a text, and where.
struct VFault
{
	/// From 1; 0 for the whole.
	std::size_t m_Line = 0;
	std::string m_Reason;
};

/// Reads a text in JSON. Nothing of it is looked up: whether segments, edits and files are there is seen where they are
/// used.
/// @param o_rFault what is wrong, if it is refused; then o_rSetup is empty.
bool ReadSetup(std::string_view i_Text, VSetup& o_rSetup, VFault& o_rFault);

/// Whether a text has only such fields beside "comment"; a fault names the first other one. One that may
/// have pairs alone is to have some.
/// @param i_pUse what it is to be, for the fault: "a mapping".
bool HasOnly(
    const VSetup& i_rSetup, std::initializer_list<std::string_view> i_Fields, const char* i_pUse, VFault& o_rFault);

} // namespace SetupIO
