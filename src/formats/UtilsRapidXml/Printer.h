#pragma once

#include "UtilsRapidXml/Document.h"

#include <string>

namespace UtilsRapidXml
{

/// The text of a document: byte for byte that of rapidxml's printer with its default indentation, but for line ends and
/// tabs of attributes, which are written as character references. It copies whole runs of bytes where the printer goes
/// byte by byte, and it does not recurse.
std::string Print(const VXmlNode& i_rDocument);

} // namespace UtilsRapidXml
