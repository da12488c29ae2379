#include "OrlexGraphics/item/TesselInteractionMapper.h"

#include "TesselPluginInterface/IPreferenceFolders.h"

namespace OrlexGraphics
{

VTesselInteractionMapper::VTesselInteractionMapper(
    std::shared_ptr<TesselPluginInterface::IPreferenceFolders> i_pPreferences,
    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher)
    : m_pPreferences(std::move(i_pPreferences)), m_pDispatcher(std::move(i_pDispatcher))
{
}

void VTesselInteractionMapper::OnShared()
{
	if (!m_pPreferences)
		return;
	m_pPreferences->ChangedSignal().Connect(WeakBind(&VTesselInteractionMapper::OnPreferenceChanged), m_pDispatcher);
	OnPreferenceChanged(TesselPluginInterface::c_NavigationAltKey);
}

void VTesselInteractionMapper::OnPreferenceChanged(const std::string& i_rKey)
{
	if (i_rKey == TesselPluginInterface::c_NavigationAltKey)
		m_bAltSelects = m_pPreferences->Number(i_rKey, 1) != 0;
}

bool VTesselInteractionMapper::IsAction(
    CoreGraphics::EInteraction i_Action, std::uint32_t i_Buttons, std::uint32_t i_Modifiers) const
{
	const bool bNavigate = m_bAltSelects != ((i_Modifiers & CoreGraphics::EKeyAlt) != 0);
	const bool bLeft = (i_Buttons & CoreGraphics::EButtonLeft) != 0;
	const bool bRight = (i_Buttons & CoreGraphics::EButtonRight) != 0;
	const bool bMiddle = (i_Buttons & CoreGraphics::EButtonMiddle) != 0;
	switch (i_Action)
	{
	case CoreGraphics::EInteractionPan: return bNavigate && bLeft && (bRight || bMiddle);
	case CoreGraphics::EInteractionOrbit: return bNavigate && bLeft && !bRight && !bMiddle;
	case CoreGraphics::EInteractionDolly: return bNavigate && bRight && !bLeft && !bMiddle;
	case CoreGraphics::EInteractionSelect: return !bNavigate && bLeft;
	}
	return false;
}

} // namespace OrlexGraphics
