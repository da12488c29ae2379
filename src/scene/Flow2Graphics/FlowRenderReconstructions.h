#pragma once

#include "Flow2Graphics/IFlowRenderType.h"
#include "Flow2TypesUtils/ItemCache.h"
#include "OrlexGraphics/stage/RenderReconstructions.h"

#include <memory>
#include <vector>

namespace Flow2Graphics
{

/// The reconstructed points that items carry as positions in millimetres; reconstructions in other forms have none.
class VFlowRenderReconstructions : public IFlowRenderType
{
public:
	/// What an item carries.
	using VValue = std::vector<QVector3D>;
	static constexpr const char* c_pFlowType = "FlowReconstructionSet";

	explicit VFlowRenderReconstructions(std::shared_ptr<OrlexGraphics::VRenderReconstructions> i_pPartner)
	    : m_pPartner(std::move(i_pPartner))
	{
	}

	void Update(const TesselPluginInterface::IFlowFrame& i_rFrame, VFlowContext& /*io_rContext*/) override
	{
		if (m_Points.Update(i_rFrame))
			m_pPartner->SetPoints(m_Points.Value() ? *m_Points.Value() : VValue());
	}

private:
	const std::shared_ptr<OrlexGraphics::VRenderReconstructions> m_pPartner;
	Flow2TypesUtils::VItemCacheTyped<VValue> m_Points{c_pFlowType};
};

} // namespace Flow2Graphics
