#pragma once

#include "Flow2Graphics/IFlowRenderType.h"
#include "Flow2TypesUtils/ItemCache.h"
#include "OrlexGraphics/stage/RenderForcePlates.h"

#include <memory>
#include <vector>

namespace Flow2Graphics
{

/// The force plates that items of devices carry as OrlexGraphics::VForcePlate; devices in other forms have no plates.
class VFlowRenderForcePlates : public IFlowRenderType
{
public:
	/// What an item carries.
	using VValue = std::vector<OrlexGraphics::VForcePlate>;
	static constexpr const char* c_pFlowType = "FlowDeviceSamples";

	explicit VFlowRenderForcePlates(std::shared_ptr<OrlexGraphics::VRenderForcePlates> i_pPartner)
	    : m_pPartner(std::move(i_pPartner))
	{
	}

	void Update(const TesselPluginInterface::IFlowFrame& i_rFrame, VFlowContext& /*io_rContext*/) override
	{
		if (m_Plates.Update(i_rFrame))
			m_pPartner->SetPlates(m_Plates.Value());
		// Ids are those of one frame update.
		m_pPartner->AllocateIds();
	}

private:
	const std::shared_ptr<OrlexGraphics::VRenderForcePlates> m_pPartner;
	Flow2TypesUtils::VItemCacheTyped<VValue> m_Plates{c_pFlowType};
};

} // namespace Flow2Graphics
