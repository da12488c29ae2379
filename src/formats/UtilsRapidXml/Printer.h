#pragma once

#include "UtilsRapidXml/Document.h"

#include <string>
#include <string_view>
#include <utility>

namespace UtilsRapidXml
{

/// The text of a document: byte for byte that of rapidxml's printer with its default indentation, but for line ends and
/// tabs of attributes, which are written as character references. It copies whole runs of bytes where the printer goes
/// byte by byte, and it does not recurse.
std::string Print(const VXmlNode& i_rDocument);

/// With this declaration every text of ours begins: version 1.0, UTF-8, not standalone.
inline constexpr std::pair<std::string_view, std::string_view> c_Declaration[] = {
    {"version", "1.0"}, {"encoding", "UTF-8"}, {"standalone", "no"}};

/// True for nearly all values of attributes: printable ASCII that no quote of either kind lets mean something else.
bool StandsForItself(std::string_view i_Text);

/// An attribute of an element that is open, as Print writes it.
void PrintAttribute(std::string_view i_Name, std::string_view i_Value, std::string& io_rText);

} // namespace UtilsRapidXml
