#include "Flow2Graphics/FlowRenderReconstructionVolume.h"

#include "Flow2TypesUtils/ParameterSet.h"
#include "OrlexGraphics/manipulator/RenderVolumeManipulator.h"
#include "OrlexGraphics/stage/RenderReconstructionVolume.h"

namespace Flow2Graphics
{

using Flow2Utils::VParameterSet;
using OrlexGraphics::VVolume;

namespace
{

/// The value of a parameter of any type of number.
template <typename... TNumbers>
std::optional<float> Number(const VParameterSet& i_rSet, const std::string& i_rName)
{
	const Flow2Utils::VParameter* const pParameter = i_rSet.Find(i_rName);
	std::optional<float> number;
	const auto read = [&]<typename T>(std::type_identity<T>)
	{
		const auto* const pTyped = dynamic_cast<const Flow2Utils::VParameterTyped<T>*>(pParameter);
		if (pTyped && (pTyped->IsSet() || pTyped->HasDefault()))
			number = static_cast<float>(pTyped->Get());
	};
	(read(std::type_identity<TNumbers>()), ...);
	return number;
}

std::optional<VVolume> ReadVolume(const VParameterSet& i_rSet, const char* i_pName)
{
	VVolume volume;
	for (int axis = 0; axis < 3; ++axis)
	{
		for (const auto& [pLimit, rCorner] : {std::pair("Min", &volume.m_Minimum), {"Max", &volume.m_Maximum}})
		{
			const std::string name = std::string(pLimit) + i_pName + "XYZ"[axis];
			const std::optional<float> number = Number<float, double, std::int32_t, std::uint32_t>(i_rSet, name);
			if (!number)
				return {};
			(*rCorner)[axis] = *number;
		}
	}
	return IsValid(volume) ? std::optional(volume) : std::nullopt;
}

} // namespace

VFlowRenderReconstructionVolume::VFlowRenderReconstructionVolume(
    std::shared_ptr<OrlexGraphics::VRenderReconstructionVolume> i_pPartner,
    std::shared_ptr<OrlexGraphics::VRenderVolumeManipulator> i_pManipulator,
    std::shared_ptr<OrlexGraphics::VRenderVolumeManipulator> i_pHotspotManipulator)
    : m_pPartner(std::move(i_pPartner)), m_pManipulator(std::move(i_pManipulator)),
      m_pHotspotManipulator(std::move(i_pHotspotManipulator)),
      m_Parameters(Flow2TypesUtils::FlowParametersItem::c_pName)
{
}

void VFlowRenderReconstructionVolume::UpdateStatic(const TesselPluginInterface::IFlowFrame& i_rFrame)
{
	if (!m_Parameters.Update(i_rFrame) || !m_Parameters.Value() || m_Parameters.Value()->m_Tag != c_pGroup)
		return;
	const Flow2TypesUtils::FlowParametersItem& rItem = *m_Parameters.Value();
	if (m_Taken == std::pair(rItem.m_Identity, rItem.m_Revision))
		return;
	m_Taken.emplace(rItem.m_Identity, rItem.m_Revision);
	static const VParameterSet s_None;
	const auto& rpSet = rItem.m_pParameters;
	const VParameterSet& rSet = rpSet ? *rpSet : s_None;
	const std::optional<VVolume> volume = ReadVolume(rSet, "Recon");
	m_pPartner->SetVolume(volume);
	m_pManipulator->BringVolume(volume);
	m_pHotspotManipulator->BringVolume(ReadVolume(rSet, "Hotspot"));
}

} // namespace Flow2Graphics
