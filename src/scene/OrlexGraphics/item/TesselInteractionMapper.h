#pragma once

#include "CoreGraphics/InteractionMapper.h"
#include "NVX/Shared.h"

#include <memory>
#include <string>

namespace TesselPluginInterface
{
class IDispatcher;
class IPreferenceFolders;
} // namespace TesselPluginInterface

namespace OrlexGraphics
{

/// The mouse as the host's preferences want it: Alt either selects, and the mouse alone moves the camera, or the other
/// way round. Made with NVX::MakeShared.
class VTesselInteractionMapper : public NVX::VShared, public CoreGraphics::VInteractionMapper
{
public:
	/// The preference is read now, and again whenever it changes.
	VTesselInteractionMapper(std::shared_ptr<TesselPluginInterface::IPreferenceFolders> i_pPreferences,
	    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher);

	bool IsAction(
	    CoreGraphics::EInteraction i_Action, std::uint32_t i_Buttons, std::uint32_t i_Modifiers) const override;

private:
	void OnShared() override;
	void OnPreferenceChanged(const std::string& i_rKey);

	const std::shared_ptr<TesselPluginInterface::IPreferenceFolders> m_pPreferences;
	const std::shared_ptr<TesselPluginInterface::IDispatcher> m_pDispatcher;
	/// The state of the Alt key that selects.
	bool m_bAltSelects = true;
};

} // namespace OrlexGraphics
