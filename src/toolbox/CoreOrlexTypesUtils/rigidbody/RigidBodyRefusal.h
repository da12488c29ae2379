#pragma once

#include "DebugServices/GlobalLog.h"

#include <cstddef>

namespace CoreOrlexTypesUtils::RigidBodyUtils
{

/// Fewer markers do not tell how a body is turned.
inline constexpr std::size_t c_MarkersOfBody = 3;

/// Tells why something does not fit.
/// @return false.
template <typename... VArguments>
bool Refuse(const char* i_pMessage, const VArguments&... i_rArguments)
{
	NVX_LOG("RigidBodyUtils", NVX::ELogError, i_pMessage, i_rArguments...);
	return false;
}

} // namespace CoreOrlexTypesUtils::RigidBodyUtils
