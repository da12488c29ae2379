#pragma once

#include "NVX/CountedPointer.h"

#include <cstdint>
#include <string>

class QWidget;

namespace TesselPluginInterface
{

/// Docks finished panels in the host's window.
class IPanelManager : public NVX::ICounted
{
public:
	/// The host owns the widget from then on. Panels stand in ascending order.
	virtual void AddPanel(const std::string& i_rTitle, std::int32_t i_Order, QWidget* i_pWidget) = 0;
};

} // namespace TesselPluginInterface
