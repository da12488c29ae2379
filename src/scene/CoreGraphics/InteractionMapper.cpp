#include "CoreGraphics/InteractionMapper.h"

namespace CoreGraphics
{

namespace
{

std::weak_ptr<VInteractionMapper>& Active()
{
	static std::weak_ptr<VInteractionMapper> s_pActive;
	return s_pActive;
}

} // namespace

VInteractionMapper::~VInteractionMapper() = default;

bool VInteractionMapper::IsAction(EInteraction i_Action, std::uint32_t i_Buttons, std::uint32_t i_Modifiers) const
{
	const bool bLeft = (i_Buttons & EButtonLeft) != 0;
	const bool bOther = (i_Buttons & (EButtonRight | EButtonMiddle)) != 0;
	switch (i_Action)
	{
	case EInteractionPan: return i_Modifiers == 0 && bLeft && bOther;
	case EInteractionOrbit: return i_Modifiers == 0 && i_Buttons == EButtonLeft;
	case EInteractionDolly: return i_Modifiers == 0 && i_Buttons == EButtonRight;
	case EInteractionSelect: return i_Modifiers == EKeyAlt && (bLeft || bOther);
	}
	return false;
}

void VInteractionMapper::SetActive(const std::shared_ptr<VInteractionMapper>& i_rpMapper)
{
	Active() = i_rpMapper;
}

bool VInteractionMapper::Test(EInteraction i_Action, std::uint32_t i_Buttons, std::uint32_t i_Modifiers)
{
	const std::shared_ptr<VInteractionMapper> pMapper = Active().lock();
	return pMapper && pMapper->IsAction(i_Action, i_Buttons, i_Modifiers);
}

} // namespace CoreGraphics
