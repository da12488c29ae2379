#pragma once

#include "Flow2Graphics/IFlowRenderType.h"
#include "Flow2TypesUtils/FlowParametersItem.h"
#include "Flow2TypesUtils/ItemCache.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <utility>

namespace OrlexGraphics
{
class VRenderReconstructionVolume;
class VRenderVolumeManipulator;
} // namespace OrlexGraphics

namespace Flow2Graphics
{

/// The volumes that items of parameters tell of, where their tag is c_pGroup: MinReconX, MinReconY, MinReconZ,
/// MaxReconX, MaxReconY, MaxReconZ of the reconstruction, and the same with Hotspot for Recon of the part of it that
/// counts most. Numbers in millimetres. A volume that lacks one of them, or has no inside, is not drawn.
class VFlowRenderReconstructionVolume : public IFlowRenderType
{
public:
	static constexpr const char* c_pGroup = "Processing:Reconstruction";

	VFlowRenderReconstructionVolume(std::shared_ptr<OrlexGraphics::VRenderReconstructionVolume> i_pPartner,
	    std::shared_ptr<OrlexGraphics::VRenderVolumeManipulator> i_pManipulator,
	    std::shared_ptr<OrlexGraphics::VRenderVolumeManipulator> i_pHotspotManipulator);

	void UpdateStatic(const TesselPluginInterface::IFlowFrame& i_rFrame) override;

private:
	const std::shared_ptr<OrlexGraphics::VRenderReconstructionVolume> m_pPartner;
	const std::shared_ptr<OrlexGraphics::VRenderVolumeManipulator> m_pManipulator;
	const std::shared_ptr<OrlexGraphics::VRenderVolumeManipulator> m_pHotspotManipulator;
	Flow2TypesUtils::VItemCacheTyped<Flow2TypesUtils::FlowParametersItem> m_Parameters;
	/// Identity and revision of the parameters that the volumes were taken from: items made anew for each frame do not
	/// take back what was dragged.
	std::optional<std::pair<std::uint64_t, std::uint64_t>> m_Taken;
};

} // namespace Flow2Graphics
