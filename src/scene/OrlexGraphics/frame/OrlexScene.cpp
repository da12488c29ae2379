#include "OrlexGraphics/frame/OrlexScene.h"

#include "CoreGraphics/ShaderLibrary.h"
#include "DebugServices/Assert.h"
#include "OrlexGraphics/frame/IRenderType.h"
#include "OrlexGraphics/manipulator/IManipulator.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "OrlexGraphics/skins/SkinCache.h"
#include "OrlexGraphics/stage/RenderCameras.h"
#include "OrlexGraphics/stage/SphereHelper.h"
#include "TesselPluginInterface/ISelectionManager.h"

#include <QPointer>

namespace OrlexGraphics
{

VOrlexScene::VOrlexScene(std::shared_ptr<CoreGraphics::VShaderLibrary> i_pShaderLibrary,
    std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pSelectionManager,
    std::shared_ptr<VSkinCache> i_pSkinCache, std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher,
    bool i_bAllowHiddenPick)
    : m_pShaderLibrary(std::move(i_pShaderLibrary)), m_pRegistry(std::make_shared<VSelectionRegistry>()),
      m_pSelectionManager(std::move(i_pSelectionManager)), m_pSkinCache(std::move(i_pSkinCache)),
      m_pDispatcher(std::move(i_pDispatcher)), m_bAllowHiddenPick(i_bAllowHiddenPick),
      m_pPlaces(m_pRegistry->GetPlaces())
{
	NVX_ASSERT(m_pShaderLibrary && m_pDispatcher);
	const auto refresh = [pScene = QPointer<VOrlexScene>(this)]
	{
		if (!pScene)
			throw NVX::VDeregisterWeakCallbackException();
		pScene->RequestRefresh();
	};
	if (m_pSkinCache)
		m_Connections.push_back(m_pSkinCache->ChangedSignal().Connect(refresh, m_pDispatcher));
	// The flags of what is selected are given out with the ids, once a frame update.
	if (m_pSelectionManager)
		for (auto* const pSelection : {&m_pSelectionManager->Selection(), &m_pSelectionManager->PreSelection()})
			m_Connections.push_back(pSelection->ChangedSignal().Connect(refresh, m_pDispatcher));
}

VOrlexScene::~VOrlexScene()
{
	for (NVX::VConnection& rConnection : m_Connections)
		rConnection.Disconnect();
}

void VOrlexScene::InitialiseGL()
{
	m_pShaderLibrary->InitialiseGL();
	if (!m_pSphereHelper)
		m_pSphereHelper = std::make_shared<VSphereHelper>(*m_pShaderLibrary, m_pRegistry);
}

void VOrlexScene::Refresh()
{
	m_bNeedsRefresh = false;
	m_bFrameUpdated = true;
	m_FrameChangedSignal.Fire();
}

void VOrlexScene::LoadFBXScene(const QString& /*i_rPath*/) {}

std::vector<QVector4D> VOrlexScene::GetBounds(const std::vector<NVX::ISelectionItem>& /*i_rSelection*/) const
{
	return {};
}

bool VOrlexScene::GetItemTransform(
    const std::vector<NVX::ISelectionItem>& /*i_rSelection*/, QMatrix4x4& /*o_rTransform*/) const
{
	return false;
}

std::vector<NVX::ISelectionItem> VOrlexScene::MakeSelection(
    const std::vector<std::uint32_t>& /*i_rIds*/, std::vector<std::string>& /*o_rNames*/) const
{
	return {};
}

QString VOrlexScene::GetSelectedCamera() const
{
	return {};
}

void VOrlexScene::SelectCamera(const QString& /*i_rDeviceURN*/, bool /*i_bPreselect*/) {}

bool VOrlexScene::Synchronise()
{
	if (m_bRefreshRequested)
		m_bNeedsRefresh = true;
	m_bRefreshRequested = false;
	if (m_pSelectionManager)
		m_pRegistry->SetSelection(
		    m_pSelectionManager->Selection().Items(), m_pSelectionManager->PreSelection().Items());

	// What was set last holds: by the operator since the last exchange, otherwise by the frame.
	if (m_bYUpSet)
		m_bFrameYUp = m_bYUp;
	else
		m_bYUp = m_bFrameYUp;
	m_bYUpSet = false;

	for (const auto& rpManipulator : {m_pManipulator, m_pReconstructionVolumeManipulator, m_pHotspotVolumeManipulator})
		if (rpManipulator)
			rpManipulator->Synchronise();

	if (!m_bFrameUpdated)
		return false;
	m_bFrameUpdated = false;
	m_Published = m_Overlay;
	m_pPlaces = m_pRegistry->GetPlaces();
	m_PublishedSignal.Fire();
	return true;
}

void VOrlexScene::RequestRefresh()
{
	m_bRefreshRequested = true;
	emit RefreshRequested();
}

void VOrlexScene::SetYUp(bool i_bYUp)
{
	m_bYUp = i_bYUp;
	m_bYUpSet = true;
}

} // namespace OrlexGraphics

#include "moc_OrlexScene.cpp"
