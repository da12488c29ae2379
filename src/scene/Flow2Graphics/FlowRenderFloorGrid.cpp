#include "Flow2Graphics/FlowRenderFloorGrid.h"

#include "OrlexGraphics/RenderFloorGrid.h"

namespace Flow2Graphics
{

VFlowRenderFloorGrid::VFlowRenderFloorGrid(std::shared_ptr<OrlexGraphics::VRenderFloorGrid> i_pPartner)
    : m_pPartner(std::move(i_pPartner)), m_Floor(Flow2TypesUtils::FlowFloorItem::c_pName),
      m_SceneTransform(Flow2TypesUtils::FlowSubjectSceneTransformItem::c_pName)
{
}

void VFlowRenderFloorGrid::UpdateStatic(const TesselPluginInterface::IFlowFrame& i_rFrame)
{
	m_Floor.Update(i_rFrame);
	m_SceneTransform.Update(i_rFrame);
	if (const std::uint64_t generation = m_Floor.Generation() + m_SceneTransform.Generation();
	    generation != m_Generation)
		m_Generation = generation;
	else
		return;
	const auto* const pExtents = m_Floor.Value() ? &m_Floor.Value()->m_Extents
	    : m_SceneTransform.Value()               ? &m_SceneTransform.Value()->m_Extents
	                                             : nullptr;
	if (!pExtents)
		return;
	OrlexGraphics::VFloor floor;
	floor.m_X0 = (*pExtents)[0];
	floor.m_X1 = (*pExtents)[1];
	floor.m_Y0 = (*pExtents)[2];
	floor.m_Y1 = (*pExtents)[3];
	m_pPartner->SetFloor(floor);
}

} // namespace Flow2Graphics
