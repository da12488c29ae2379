#pragma once

#include "CoreOrlexQRTIO/format/FormatFunctions.h"

namespace CoreOrlexTypesUtils
{
class VDynamicExpressionParserSimple;
}

/// What is left to do when the tree has been read.
namespace CoreOrlexQRTIO
{

/// Takes the subject's parameters into the parser and tries all expressions of segments. The parser's findings are
/// errors; those about the states of targets are warnings, since such a subject can still be mended.
/// @return false if there was an error.
bool CheckExpressions(CoreOrlexTypesUtils::VDynamicExpressionParserSimple& io_rParser, const VReading& i_rReading,
    std::vector<std::string>& io_rErrors, std::vector<std::string>& io_rWarnings);

/// Computes what the joints hold from what the file told of them, and checks what needs evaluated expressions.
void FinishJointsAndTargets(CoreOrlexTypesUtils::VDynamicExpressionParserSimple& io_rParser, VReading& io_rReading,
    std::vector<std::string>& io_rErrors, std::vector<std::string>& io_rWarnings);

/// The subject that the dynamic subspaces belong to.
void IdentifySubspaces(VReading& io_rReading);

} // namespace CoreOrlexQRTIO
