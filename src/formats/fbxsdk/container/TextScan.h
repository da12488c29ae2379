#pragma once

#include <string_view>

/// The tokens of the text form. All functions take the place to begin at and the end of the text, and return the
/// place after what they took.
namespace FbxFormat::Text
{

const char* SkipByteOrderMark(const char* i_pFrom, const char* i_pEnd);

/// Blanks and tabulators.
const char* SkipBlanks(const char* i_pFrom, const char* i_pEnd);

/// White space, ends of lines and comments, which run from a semicolon to the end of the line.
const char* SkipSpace(const char* i_pFrom, const char* i_pEnd);

const char* SkipLine(const char* i_pFrom, const char* i_pEnd);

/// Up to the next brace, quote or comment, at the speed of memory.
const char* FindMark(const char* i_pFrom, const char* i_pEnd);

/// The name of a record without its colon; empty if there is none.
const char* ScanName(const char* i_pFrom, const char* i_pEnd);

/// One value: a quoted text with both its quotes, or a bare word or number. Empty if none stands here; null if a
/// quote is not closed.
const char* ScanValue(const char* i_pFrom, const char* i_pEnd);

/// Whether a bare value that reaches to here ends here.
bool EndsValue(const char* i_pAt, const char* i_pEnd);

/// The place behind the comma that leads to a further value of the same list, or null if the list has ended. A list
/// may be broken into lines before and after a comma.
const char* NextValue(const char* i_pFrom, const char* i_pEnd);

} // namespace FbxFormat::Text
