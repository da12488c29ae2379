#pragma once

#include <string>

namespace UtilsRapidXml
{

/// Makes sure that a text can be given to rapidxml, which recurses without limit, takes what it finds for well-formed
/// and keeps both of two attributes of one name: nesting, tags, names, quotes, attributes that stand twice, character
/// references and UTF-8 are checked here in one pass without recursion. Raw line ends and tabs within attribute values
/// become blanks, as XML wants (a line end of two bytes becomes two).
/// A byte order mark is accepted. Entities other than the five of XML itself stay as they stand, and a document type
/// with an internal subset, which could define some, is refused.
/// @return true if the text is fine; otherwise o_rError tells what is wrong, with the line.
bool CheckText(std::string& io_rText, std::string& o_rError);

} // namespace UtilsRapidXml
