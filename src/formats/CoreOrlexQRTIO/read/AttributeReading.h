#pragma once

#include "CoreOrlexQRTIO/format/Format.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"

#include <span>
#include <string>
#include <vector>

/// The value forms that the skeleton format adds to those of the XML layer. As there, the result is true if the
/// attribute was present and converted, and a text that does not convert has added an error.
namespace CoreOrlexQRTIO
{

/// Exactly as many expressions as there is room for.
bool ReadExpressions(
    UtilsRapidXml::INode& io_rNode, const Format::VAttribute& i_rAttribute, std::span<std::string> o_Expressions);

/// Any number of reals.
bool ReadReals(UtilsRapidXml::INode& io_rNode, const Format::VAttribute& i_rAttribute, std::vector<double>& o_rValues);

/// Red, green and blue, each clamped to 255; alpha becomes 255.
bool ReadColour(
    UtilsRapidXml::INode& io_rNode, const Format::VAttribute& i_rAttribute, CoreOrlexTypes::VColour& o_rColour);

/// A real that is cut to an integer and clamped to 0..255.
bool ReadOpacity(UtilsRapidXml::INode& io_rNode, const Format::VAttribute& i_rAttribute, std::uint8_t& o_rAlpha);

/// HIDDEN attributes: true gives a false o_rVisible.
bool ReadHidden(UtilsRapidXml::INode& io_rNode, const Format::VAttribute& i_rAttribute, bool& o_rVisible);

} // namespace CoreOrlexQRTIO
