#pragma once

#include "Flow2Graphics/IFlowRenderType.h"
#include "Flow2TypesUtils/ItemCache.h"
#include "Flow2TypesUtils/SceneItems.h"

#include <memory>

namespace OrlexGraphics
{
class VRenderFloorGrid;
}

namespace Flow2Graphics
{

/// The floor: the measured one, else the one below subjects that stand side by side, else the one of the options.
class VFlowRenderFloorGrid : public IFlowRenderType
{
public:
	explicit VFlowRenderFloorGrid(std::shared_ptr<OrlexGraphics::VRenderFloorGrid> i_pPartner);

	void UpdateStatic(const TesselPluginInterface::IFlowFrame& i_rFrame) override;

private:
	const std::shared_ptr<OrlexGraphics::VRenderFloorGrid> m_pPartner;
	Flow2TypesUtils::VItemCacheTyped<Flow2TypesUtils::FlowFloorItem> m_Floor;
	Flow2TypesUtils::VItemCacheTyped<Flow2TypesUtils::FlowSubjectSceneTransformItem> m_SceneTransform;
	/// Of both, of the floor that is drawn.
	std::uint64_t m_Generation = 0;
};

} // namespace Flow2Graphics
