#pragma once

#include <string>
#include <string_view>

namespace FbxFormat
{

/// An object's full name as it stands in a file, taken apart. The text form writes "Class::Name", the binary form
/// "Name", the bytes 0 and 1, and "Class".
struct VFullName
{
	std::string_view m_Name;
	std::string_view m_Class;
};

VFullName SplitFullName(std::string_view i_FullName);

/// A text of the file for the world outside: the escapes of the text form resolved if i_bEscaped, and in UTF-8. Text
/// that is no UTF-8, as old exporters write it, is taken as Latin-1, so that every byte is kept as a character.
std::string DecodeText(std::string_view i_Text, bool i_bEscaped);

} // namespace FbxFormat
