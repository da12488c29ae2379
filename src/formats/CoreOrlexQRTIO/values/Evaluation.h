#pragma once

#include "CoreOrlexQRTIO/SubjectQRTExtras.h"
#include "CoreOrlexQRTIO/values/JointGeometry.h"
#include "CoreOrlexTypesUtils/convert/StaticExpressionParser.h"

#include <optional>
#include <span>

namespace CoreOrlexQRTIO
{

/// The first three expressions as numbers; 0 for one that is missing or does not evaluate.
Rotation::VVector3 EvaluateVector(
    CoreOrlexTypesUtils::VDynamicExpressionParserSimple& io_rParser, std::span<const std::string> i_Expressions);

/// The pose of the segment in its joint's frame as a file up to 3.1 told it, the joint's own word before its
/// template's; nothing if it told none.
std::optional<VJointPose> PostPose(
    CoreOrlexTypesUtils::VDynamicExpressionParserSimple& io_rParser, const VSubjectQRTExtras::VJoint& i_rExtras);

} // namespace CoreOrlexQRTIO
