#include "Flow2Graphics/FlowScene.h"

#include "OrlexGraphics/RenderAxis.h"
#include "OrlexGraphics/RenderFloorGrid.h"
#include "OrlexGraphics/RenderManipulator.h"
#include "OrlexGraphics/RenderOutlines.h"
#include "OrlexGraphics/SelectionRegistry.h"

namespace Flow2Graphics
{

VFlowScene::~VFlowScene() = default;

void VFlowScene::SetFrame(NVX::CountedPointer<TesselPluginInterface::IFlowFrame> i_pFrame)
{
	m_pPendingFrame = std::move(i_pFrame);
	RequestRefresh();
}

void VFlowScene::InitialiseGL()
{
	VOrlexScene::InitialiseGL();
	if (m_pRenderManipulator)
		return;
	// In the order of drawing.
	m_RenderList.push_back(std::make_shared<OrlexGraphics::VRenderFloorGrid>(*m_pShaderLibrary));
	m_pRenderManipulator =
	    std::make_shared<OrlexGraphics::VRenderManipulator>(*m_pShaderLibrary, m_pRegistry, SelectionManager());
	m_pManipulator = m_pRenderManipulator;
	m_RenderList.push_back(m_pRenderManipulator);
	m_RenderList.push_back(std::make_shared<OrlexGraphics::VRenderAxis>(*m_pShaderLibrary));
	m_PostList.push_back(std::make_shared<OrlexGraphics::VRenderOutlines>(*m_pShaderLibrary, m_pRegistry));
}

bool VFlowScene::Synchronise()
{
	if (m_pPendingFrame)
		m_pFrame = std::move(m_pPendingFrame);
	m_pPendingFrame.reset();
	return VOrlexScene::Synchronise();
}

void VFlowScene::Refresh()
{
	Registry().Reset();
	if (m_pRenderManipulator)
		m_pRenderManipulator->AllocateIds();
	VOrlexScene::Refresh();
}

std::vector<QVector4D> VFlowScene::GetBounds(const std::vector<NVX::ISelectionItem>& i_rSelection) const
{
	std::vector<QVector4D> bounds;
	for (const NVX::ISelectionItem& rItem : i_rSelection)
		if (const auto found = Places().m_Bounds.find(rItem); found != Places().m_Bounds.end())
			bounds.push_back(found->second);
	return bounds;
}

bool VFlowScene::GetItemTransform(const std::vector<NVX::ISelectionItem>& i_rSelection, QMatrix4x4& o_rTransform) const
{
	for (const NVX::ISelectionItem& rItem : i_rSelection)
		if (const auto found = Places().m_Matrices.find(rItem); found != Places().m_Matrices.end())
		{
			o_rTransform = found->second;
			return true;
		}
	return false;
}

std::vector<NVX::ISelectionItem> VFlowScene::MakeSelection(
    const std::vector<std::uint32_t>& i_rIds, std::vector<std::string>& o_rNames) const
{
	std::vector<NVX::ISelectionItem> items;
	NVX::ISelectionItem item;
	for (const std::uint32_t id : i_rIds)
		if (Registry().ResolveId(id, item))
		{
			items.push_back(item);
			if (const std::string& rName = Registry().GetName(id); !rName.empty())
				o_rNames.push_back(rName);
		}
	return items;
}

} // namespace Flow2Graphics
