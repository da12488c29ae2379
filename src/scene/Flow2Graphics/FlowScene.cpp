#include "Flow2Graphics/FlowScene.h"

#include "FBXIO/FBXReader.h"
#include "Flow2Graphics/FlowRenderCameras.h"
#include "Flow2Graphics/FlowRenderFloorGrid.h"
#include "Flow2Graphics/FlowRenderForcePlates.h"
#include "Flow2Graphics/FlowRenderGeometry.h"
#include "Flow2Graphics/FlowRenderReconstructionVolume.h"
#include "Flow2Graphics/FlowRenderReconstructions.h"
#include "Flow2Graphics/FlowRenderSubjects.h"
#include "OrlexGraphics/frame/RenderOutlines.h"
#include "OrlexGraphics/manipulator/RenderManipulator.h"
#include "OrlexGraphics/manipulator/RenderVolumeManipulator.h"
#include "OrlexGraphics/picking/SelectionKinds.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "OrlexGraphics/skins/SkinCache.h"
#include "OrlexGraphics/stage/RenderAxis.h"
#include "OrlexGraphics/stage/RenderFBXScene.h"
#include "OrlexGraphics/stage/RenderFloorGrid.h"
#include "OrlexGraphics/stage/RenderReconstructionVolume.h"
#include "TesselPluginInterface/ISelectionManager.h"

#include <QPointer>

namespace Flow2Graphics
{

struct VFlowScene::VFBXMeshes
{
	std::vector<OrlexGraphics::VRenderFBXScene::VMesh> m_Meshes;
};

VFlowScene::VFlowScene(std::shared_ptr<CoreGraphics::VShaderLibrary> i_pShaderLibrary,
    std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pSelectionManager,
    std::shared_ptr<OrlexGraphics::VSkinCache> i_pSkinCache,
    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher, bool i_bAllowHiddenPick)
    : VOrlexScene(std::move(i_pShaderLibrary), std::move(i_pSelectionManager), std::move(i_pSkinCache),
        std::move(i_pDispatcher), i_bAllowHiddenPick),
      m_UpAxis(Flow2TypesUtils::FlowUpAxisItem::c_pName)
{
	if (SkinCache())
		m_SkinConnection = SkinCache()->ChangedSignal().Connect(
		    [pScene = QPointer<VFlowScene>(this)]
		    {
			    if (!pScene)
				    throw NVX::VDeregisterWeakCallbackException();
			    if (pScene->m_pDynamics)
				    pScene->m_pDynamics->SetRebind();
		    },
		    Dispatcher());
}

VFlowScene::~VFlowScene()
{
	m_SkinConnection.Disconnect();
}

void VFlowScene::SetFrame(NVX::CountedPointer<TesselPluginInterface::IFlowFrame> i_pFrame)
{
	m_pPendingFrame = std::move(i_pFrame);
	RequestRefresh();
}

void VFlowScene::SetWholeFrame(NVX::CountedPointer<TesselPluginInterface::IFlowFrame> i_pFrame)
{
	m_bForget = true;
	SetFrame(std::move(i_pFrame));
}

template <typename TFlowType, typename TPartner, typename... TArguments>
std::shared_ptr<TFlowType> VFlowScene::AddFlowType(std::shared_ptr<TPartner> i_pPartner, TArguments&&... i_rArguments)
{
	m_RenderList.push_back(i_pPartner);
	auto pType = std::make_shared<TFlowType>(std::move(i_pPartner), std::forward<TArguments>(i_rArguments)...);
	m_FlowTypes.push_back(pType);
	return pType;
}

void VFlowScene::InitialiseGL()
{
	VOrlexScene::InitialiseGL();
	if (m_pRenderManipulator)
		return;
	// In the order of drawing.
	AddFlowType<VFlowRenderFloorGrid>(std::make_shared<OrlexGraphics::VRenderFloorGrid>(*m_pShaderLibrary));
	AddFlowType<VFlowRenderForcePlates>(
	    std::make_shared<OrlexGraphics::VRenderForcePlates>(*m_pShaderLibrary, m_pRegistry));
	m_pFBXScene = std::make_shared<OrlexGraphics::VRenderFBXScene>(*m_pShaderLibrary);
	m_RenderList.push_back(m_pFBXScene);
	AddFlowType<VFlowRenderReconstructions>(std::make_shared<OrlexGraphics::VRenderReconstructions>(*m_pShaderLibrary));
	AddSubjects();
	m_pCameraType = std::make_shared<OrlexGraphics::VRenderCameras>();
	AddFlowType<VFlowRenderCameras>(m_pCameraType);
	const auto pGeometry = std::make_shared<VFlowRenderGeometry>(*m_pShaderLibrary);
	m_RenderList.push_back(pGeometry);
	m_FlowTypes.push_back(pGeometry);
	m_pRenderManipulator =
	    std::make_shared<OrlexGraphics::VRenderManipulator>(*m_pShaderLibrary, m_pRegistry, SelectionManager());
	m_pManipulator = m_pRenderManipulator;
	m_RenderList.push_back(m_pRenderManipulator);
	const auto addVolume = [&](const char* i_pName, const QVector3D& i_rColour, const OrlexGraphics::VVolume& i_rVolume)
	{
		auto pVolume = std::make_shared<OrlexGraphics::VRenderVolumeManipulator>(
		    *m_pShaderLibrary, m_pRegistry, SelectionManager(), i_pName, i_rColour, i_rVolume);
		m_RenderList.push_back(pVolume);
		return pVolume;
	};
	m_pRenderReconstructionVolumeManipulator = addVolume("ReconstructionVolume", QVector3D(0.7f, 0.7f, 0.7f),
	    {QVector3D(-10000.0f, -10000.0f, -100.0f), QVector3D(10000.0f, 10000.0f, 3000.0f)});
	m_pRenderHotspotVolumeManipulator = addVolume("HotspotVolume", QVector3D(1.0f, 0.2f, 0.2f),
	    {QVector3D(-5000.0f, -5000.0f, -100.0f), QVector3D(5000.0f, 5000.0f, 3000.0f)});
	m_pReconstructionVolumeManipulator = m_pRenderReconstructionVolumeManipulator;
	m_pHotspotVolumeManipulator = m_pRenderHotspotVolumeManipulator;
	AddFlowType<VFlowRenderReconstructionVolume>(
	    std::make_shared<OrlexGraphics::VRenderReconstructionVolume>(*m_pShaderLibrary),
	    m_pRenderReconstructionVolumeManipulator, m_pRenderHotspotVolumeManipulator);
	m_RenderList.push_back(std::make_shared<OrlexGraphics::VRenderAxis>(*m_pShaderLibrary));
	m_PostList.push_back(std::make_shared<OrlexGraphics::VRenderOutlines>(*m_pShaderLibrary, m_pRegistry));
}

void VFlowScene::AddSubjects()
{
	const auto markers = [this](bool i_bSolving)
	{
		return AddFlowType<VFlowRenderSubjectMarkers>(
		    std::make_shared<VRenderSubjectMarkers>(*m_pShaderLibrary, SphereHelper(), i_bSolving));
	};
	const auto pMarkers = markers(false);
	const auto pMarkersForSolving = markers(true);
	m_pDynamics = AddFlowType<VFlowRenderSubjectDynamics>(
	    std::make_shared<VRenderSubjectDynamics>(*m_pShaderLibrary, m_pRegistry, SphereHelper()), pMarkers,
	    pMarkersForSolving);
}

bool VFlowScene::Synchronise()
{
	if (m_pPendingFrame)
		m_pFrame = std::move(m_pPendingFrame);
	m_pPendingFrame.reset();
	// Here alone no older frame is being updated.
	if (std::exchange(m_bForget, false) && m_pDynamics)
		m_pDynamics->Forget();
	if (m_pPendingMeshes && m_pFBXScene)
		m_pFBXScene->Set(std::move(std::exchange(m_pPendingMeshes, nullptr)->m_Meshes));
	// Both threads are here: whoever hears of what is published finds the frame.
	m_pPublishedFrame = m_pUpdatedFrame;
	return VOrlexScene::Synchronise();
}

void VFlowScene::LoadFBXScene(const QString& i_rPath)
{
	m_pPendingMeshes = std::make_unique<VFBXMeshes>();
	FBXIO::FBXReader reader;
	if (!i_rPath.isEmpty() && reader.LoadFile(i_rPath.toStdString()))
		m_pPendingMeshes->m_Meshes = OrlexGraphics::VRenderFBXScene::ReadMeshes(reader);
	RequestRefresh();
}

void VFlowScene::Refresh()
{
	Registry().Reset();
	if (m_pRenderManipulator)
	{
		m_pRenderManipulator->AllocateIds();
		m_pRenderReconstructionVolumeManipulator->AllocateIds();
		m_pRenderHotspotVolumeManipulator->AllocateIds();
	}
	if (m_pFrame)
		OnFrame();
	m_pUpdatedFrame = m_pFrame;
	VOrlexScene::Refresh();
}

void VFlowScene::OnFrame()
{
	if (m_UpAxis.Update(*m_pFrame) && m_UpAxis.Value())
		m_bFrameYUp = m_UpAxis.Value()->m_Axis == Flow2TypesUtils::FlowUpAxisItem::c_Y;
	VFlowContext context{Registry(), SkinCache().get(), m_bFrameYUp};
	for (const std::shared_ptr<IFlowRenderType>& rpType : m_FlowTypes)
	{
		rpType->UpdateStatic(*m_pFrame);
		rpType->Update(*m_pFrame, context);
	}
	if (m_pDynamics)
	{
		m_Overlay.m_SubjectLabels = m_pDynamics->Labels(false, m_bFrameYUp);
		m_Overlay.m_PropLabels = m_pDynamics->Labels(true, m_bFrameYUp);
	}
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

QString VFlowScene::GetSelectedCamera() const
{
	if (!SelectionManager())
		return {};
	const auto cameras = SelectionManager()->Selection().ItemsOfKind(OrlexGraphics::ESelectionCamera);
	return cameras.empty() ? QString() : QString::fromStdString(cameras.front().m_Name);
}

void VFlowScene::SelectCamera(const QString& i_rDeviceURN, bool i_bPreselect)
{
	if (!SelectionManager())
		return;
	std::vector<NVX::ISelectionItem> items;
	if (!i_rDeviceURN.isEmpty())
		items.push_back({OrlexGraphics::ESelectionCamera, 0, 0, i_rDeviceURN.toStdString()});
	(i_bPreselect ? SelectionManager()->PreSelection() : SelectionManager()->Selection()).Replace(items);
}

} // namespace Flow2Graphics

#include "moc_FlowScene.cpp"
