#include "CoreGraphics/SelectionId.h"

namespace CoreGraphics
{

VSelectionId MakeSelectionId(std::uint32_t i_Id)
{
	const auto channel = [&](int i_Byte) { return static_cast<float>(i_Id >> (8 * i_Byte) & 0xff) * 0.003921569f; };
	return {channel(0), channel(1), channel(2), i_Id};
}

} // namespace CoreGraphics
