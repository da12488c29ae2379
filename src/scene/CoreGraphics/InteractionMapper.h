#pragma once

#include <cstdint>
#include <memory>

namespace CoreGraphics
{

/// What the mouse does in a 3D view.
enum EInteraction : std::uint32_t
{
	EInteractionPan,
	EInteractionOrbit,
	EInteractionDolly,
	EInteractionSelect
};

/// Bits of the mouse's buttons and of keys, as Qt has them.
enum EInteractionBits : std::uint32_t
{
	EButtonLeft = 0x1,
	EButtonRight = 0x2,
	EButtonMiddle = 0x4,
	EKeyShift = 0x2000000,
	EKeyControl = 0x4000000,
	EKeyAlt = 0x8000000
};

/// Which buttons and keys stand for which action. On the thread of the user interface only.
class VInteractionMapper
{
public:
	virtual ~VInteractionMapper();

	/// @param i_Buttons, i_Modifiers all that are held, EInteractionBits
	virtual bool IsAction(EInteraction i_Action, std::uint32_t i_Buttons, std::uint32_t i_Modifiers) const;

	/// The one mapper of the process, for as long as someone else owns it.
	static void SetActive(const std::shared_ptr<VInteractionMapper>& i_rpMapper);
	/// Asks the active mapper; false if there is none.
	static bool Test(EInteraction i_Action, std::uint32_t i_Buttons, std::uint32_t i_Modifiers);
};

} // namespace CoreGraphics
