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

/// The floor of the volume; without one the floor below the subjects that stand side by side. Without either the floor
/// is as large as the options say.
class VFlowRenderFloorGrid : public IFlowRenderType
{
public:
	explicit VFlowRenderFloorGrid(std::shared_ptr<OrlexGraphics::VRenderFloorGrid> i_pPartner);

	void UpdateStatic(const TesselPluginInterface::IFlowFrame& i_rFrame) override;

private:
	const std::shared_ptr<OrlexGraphics::VRenderFloorGrid> m_pPartner;
	Flow2TypesUtils::VItemCacheTyped<Flow2TypesUtils::FlowFloorItem> m_Floor;
	Flow2TypesUtils::VItemCacheTyped<Flow2TypesUtils::FlowSubjectSceneTransformItem> m_Arrangement;
};

} // namespace Flow2Graphics
