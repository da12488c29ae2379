#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"
#include "DebugServices/GlobalLog.h"
#include "numerics/Rotation.h"

#include <vector>

/// What the conversions of joint statistics share.
namespace CoreOrlexTypesUtils::TemplateSubjectUtils
{

using VJoint = CoreOrlexTypes::VSubjectParametrised::VJoint;
using Rotation::VMatrix3;
using Rotation::VVector3;
using VNumbers = std::vector<double>;

/// Tells why a statistic is not converted.
/// @return false.
inline bool Refuse(const char* i_pMessage)
{
	NVX_LOG("SubjectUtils", NVX::ELogError, i_pMessage);
	return false;
}

} // namespace CoreOrlexTypesUtils::TemplateSubjectUtils
