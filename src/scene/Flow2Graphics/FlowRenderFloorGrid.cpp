#include "Flow2Graphics/FlowRenderFloorGrid.h"

#include "OrlexGraphics/stage/RenderFloorGrid.h"

namespace Flow2Graphics
{

namespace
{

/// Nothing for extents without an area.
std::optional<OrlexGraphics::VFloor> FloorOf(const std::array<std::int32_t, 4>& i_rExtents)
{
	const auto [minX, maxX, minRow, maxRow] = i_rExtents;
	if (minX >= maxX || minRow >= maxRow)
		return {};
	return OrlexGraphics::VFloor{minX, minRow, maxX, maxRow};
}

} // namespace

VFlowRenderFloorGrid::VFlowRenderFloorGrid(std::shared_ptr<OrlexGraphics::VRenderFloorGrid> i_pPartner)
    : m_pPartner(std::move(i_pPartner)), m_Floor(Flow2TypesUtils::FlowFloorItem::c_pName),
      m_Arrangement(Flow2TypesUtils::FlowSubjectSceneTransformItem::c_pName)
{
}

void VFlowRenderFloorGrid::UpdateStatic(const TesselPluginInterface::IFlowFrame& i_rFrame)
{
	// Both have to look at the frame.
	const bool bFloorChanged = m_Floor.Update(i_rFrame);
	if (!m_Arrangement.Update(i_rFrame) && !bFloorChanged)
		return;
	std::optional<OrlexGraphics::VFloor> floor = m_Floor.Value() ? FloorOf(m_Floor.Value()->m_Extents) : std::nullopt;
	if (!floor && m_Arrangement.Value())
		floor = FloorOf(m_Arrangement.Value()->m_Extents);
	m_pPartner->SetFloor(floor);
}

} // namespace Flow2Graphics
