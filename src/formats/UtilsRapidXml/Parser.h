#pragma once

#include "UtilsRapidXml/Document.h"

#include <string>

namespace UtilsRapidXml
{

/// Makes rapidxml's nodes of a text, as its parser does with no values of elements, but in one pass that trusts
/// nothing: nesting, tags, names, quotes, attributes that stand twice, references and UTF-8 are checked where they
/// stand, without recursion, and the limits of Limits.h hold. Names and values are slices of the text, which is changed
/// where a value has references or white space, and must outlive the nodes; no zero byte ends them.
/// Raw line ends and tabs within attribute values become blanks, as XML wants (a line end of two bytes becomes one).
/// A byte order mark is accepted. Entities other than the five of XML itself stay as they stand, and a document type
/// with an internal subset, which could define some, is refused.
/// @param io_rDocument empty; it has a part of the nodes if the text is not fine.
/// @return true if the text is fine; otherwise o_rError tells what is wrong, with the line.
bool ParseText(std::string& io_rText, VXmlDocument& io_rDocument, std::string& o_rError);

} // namespace UtilsRapidXml
