#include "OrlexGraphics/item/SceneFramebufferRenderer.h"

#include "OrlexGraphics/frame/OrlexScene.h"
#include "OrlexGraphics/item/Samples.h"
#include "OrlexGraphics/item/SceneFramebufferObject.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "TesselPluginInterface/ISelectionManager.h"

#include <QOpenGLFramebufferObject>
#include <QQuickWindow>

#include <atomic>
#include <utility>

namespace OrlexGraphics
{

namespace
{

std::atomic<std::uint64_t> s_Made{0};
std::atomic<std::uint64_t> s_Living{0};

} // namespace

VSceneFramebufferRenderer::VSceneFramebufferRenderer()
{
	++s_Made;
	++s_Living;
}

VSceneFramebufferRenderer::~VSceneFramebufferRenderer()
{
	// The material of what showed them may hold them for longer.
	if (m_pSamples)
		m_pSamples->Release();
	--s_Living;
}

std::uint64_t VSceneFramebufferRenderer::LivingCount()
{
	return s_Living;
}

std::uint64_t VSceneFramebufferRenderer::MadeCount()
{
	return s_Made;
}

void VSceneFramebufferRenderer::TakeScene(VSceneFramebufferObject& io_rItem)
{
	if (!m_Renderer.IsInitialised())
	{
		m_Renderer.Initialise();
		// The processor has better things to do than to draw again what has not changed.
		m_bContinuousUpdate = io_rItem.m_bContinuousUpdate && !m_Renderer.IsSoftware();
		if (VSamples::AreReadable())
			m_pSamples = std::make_shared<VSamples>();
		io_rItem.m_pSamples = m_pSamples;
	}
	std::shared_ptr<VOrlexScene> pScene = io_rItem.m_pScene ? io_rItem.m_pScene->weak_from_this().lock() : nullptr;
	if (m_Renderer.Scene() != pScene)
	{
		m_Pick.reset();
		m_Tracked.clear();
		m_Renderer.SetScene(std::move(pScene));
	}
	if (m_Renderer.Scene())
		m_Renderer.Scene()->Synchronise();
}

void VSceneFramebufferRenderer::Fit(
    const VOrlexScene& i_rScene, EFit i_Fit, CoreGraphics::VCameraController& io_rCamera)
{
	if (i_Fit == EFit::None)
		return;
	std::vector<QVector4D> bounds;
	if (i_Fit == EFit::Selection && i_rScene.SelectionManager())
		bounds = i_rScene.GetBounds(i_rScene.SelectionManager()->Selection().Items());
	if (bounds.empty())
		bounds = i_rScene.GetBounds(i_rScene.ItemsToFrame());
	const std::uint32_t shown = io_rCamera.m_Type;
	if (i_Fit == EFit::All)
	{
		io_rCamera.m_Type = io_rCamera.IsOrthographic() ? CoreGraphics::ECameraPerspective : CoreGraphics::ECameraFront;
		io_rCamera.Fit(bounds, true);
		io_rCamera.m_Type = shown;
	}
	io_rCamera.Fit(bounds, true);
}

void VSceneFramebufferRenderer::Track(VSceneFramebufferObject& io_rItem)
{
	CoreGraphics::VCameraController& rCamera = *io_rItem.m_pCamera;
	const VOrlexScene* const pScene = m_Renderer.Scene().get();
	// As it was drawn.
	if (m_Tracking == ETrackingSelectionThen)
		rCamera.m_Centre = m_Renderer.m_Input.m_Camera.m_Centre;
	if (m_Tracking != io_rItem.m_Tracking
	    && (m_Tracking == ETrackingTransform || io_rItem.m_Tracking == ETrackingTransform))
		rCamera.Reset(m_Tracking != ETrackingTransform);
	m_Tracking = io_rItem.m_Tracking;
	rCamera.m_bYUp = pScene && pScene->YUp();
	rCamera.SetSize(QSize(static_cast<int>(io_rItem.width()), static_cast<int>(io_rItem.height())));
	if (pScene && pScene->SelectionManager())
	{
		const std::vector<NVX::ISelectionItem>& rSelected = pScene->SelectionManager()->Selection().Items();
		if (io_rItem.m_bTrackSelectionPending)
			m_Tracked = rSelected;
		QMatrix4x4 transform;
		// From the frame that was drawn, so that labels go along where no other frame follows.
		if (m_Tracking == ETrackingSelectionThen)
			rCamera.Fit(pScene->GetBounds(m_Tracked), false);
		else if (m_Tracking == ETrackingSelection)
			rCamera.Fit(pScene->GetBounds(rSelected), false);
		else if (m_Tracking == ETrackingTransform && pScene->GetItemTransform(m_Tracked, transform))
			rCamera.m_FrameOfReference = transform;
		// The bounds of a frame that is still to be drawn come with the exchange after it.
		if (!pScene->NeedsRefresh())
			Fit(*pScene, std::exchange(io_rItem.m_Fit, EFit::None), rCamera);
	}
	io_rItem.m_bTrackSelectionPending = false;

	const QMatrix4x4 view = rCamera.m_View;
	const QMatrix4x4 projection = rCamera.m_Projection;
	rCamera.Update();
	if (view != rCamera.m_View || projection != rCamera.m_Projection
	    || m_Renderer.m_Input.m_Camera.m_Size != rCamera.m_Size)
		QMetaObject::invokeMethod(
		    &io_rItem, [&io_rItem] { io_rItem.OnFrameChanged(); }, Qt::QueuedConnection);
	m_Renderer.m_Input.m_Camera = rCamera;
}

void VSceneFramebufferRenderer::synchronize(QQuickFramebufferObject* io_pItem)
{
	auto& rItem = static_cast<VSceneFramebufferObject&>(*io_pItem);
	VFrameRenderer::VInput& rInput = m_Renderer.m_Input;
	m_bVisible = rItem.isVisible();
	m_pWindow = rItem.window();
	rInput.m_PixelRatio = m_pWindow ? m_pWindow->effectiveDevicePixelRatio() : 1.0;
	TakeScene(rItem);

	const bool bDistorted = rInput.m_Options.m_b3D && rInput.m_Options.m_bDistort3D;
	rInput.m_Options = rItem.m_Options;
	if (bDistorted != (rInput.m_Options.m_b3D && rInput.m_Options.m_bDistort3D))
		invalidateFramebufferObject();

	Track(rItem);

	const VOrlexScene* const pScene = m_Renderer.Scene().get();
	if (pScene && pScene->PickingRests())
	{
		m_Pick.reset();
		rItem.m_MouseState = EMouseIdle;
	}
	// A frame that is still to be drawn is not the one that was picked from.
	const std::uint64_t frame = m_Renderer.UpdateCount() + (pScene && pScene->NeedsRefresh() ? 1 : 0);
	if (m_Pick)
		rItem.CommitPick(*m_Pick, rItem.MakePickRequest(frame));

	const EMouseState state = rItem.m_MouseState;
	m_Request = rItem.MakePickRequest(frame);
	m_bPickActive = pScene && state != EMouseIdle;
	rInput.m_ModifierState = rItem.m_ModifierState;
	rInput.m_Rectangle.reset();
	if (state == EMouseDragging || state == EMouseDragged)
		rInput.m_Rectangle.emplace(rItem.m_PressPos, m_Request.m_Mouse);

	// Only the item's own update leads to another exchange.
	const bool bOutstanding = m_bPickActive
	    && (state == EMouseClicked || state == EMouseDragged || !m_Pick || m_Pick->m_Request != m_Request);
	if (m_bVisible && (m_bContinuousUpdate || bOutstanding || (rItem.m_Fit != EFit::None && pScene)))
		QMetaObject::invokeMethod(&rItem, &QQuickItem::update, Qt::QueuedConnection);
}

QOpenGLFramebufferObject* VSceneFramebufferRenderer::createFramebufferObject(const QSize& i_rSize)
{
	m_Renderer.SetSize(i_rSize);
	const QOpenGLFramebufferObjectFormat format = m_Renderer.TargetFormat();
	if (m_pSamples)
		m_pSamples->Make(i_rSize, format);
	// What is shown of samples does not go through it.
	return m_pSamples && m_pSamples->AreThere() ? new QOpenGLFramebufferObject(i_rSize)
	                                            : new QOpenGLFramebufferObject(i_rSize, format);
}

/// What is tracked stands elsewhere in the frame that was just taken, and the exchange only knew the one before it.
void VSceneFramebufferRenderer::FollowTracked()
{
	const VOrlexScene* const pScene = m_Renderer.Scene().get();
	if (m_Tracking != ETrackingSelectionThen || !pScene)
		return;
	m_TrackedBounds.clear();
	for (const NVX::ISelectionItem& rItem : m_Tracked)
		if (const QVector4D* const pBound = pScene->Registry().GetItemBound(rItem))
			m_TrackedBounds.push_back(*pBound);
	CoreGraphics::VCameraController& rCamera = m_Renderer.m_Input.m_Camera;
	rCamera.Fit(m_TrackedBounds, false);
	rCamera.Update();
}

void VSceneFramebufferRenderer::render()
{
	if (!m_bVisible)
		return;
	m_Renderer.Update();
	FollowTracked();
	if (m_bPickActive)
	{
		if (!m_Pick)
			m_Pick.emplace();
		m_Renderer.Pick(m_Request, *m_Pick);
	}
	m_Renderer.Render(m_pSamples && m_pSamples->AreThere() ? m_pSamples->Framebuffer() : framebufferObject()->handle());
	m_Renderer.Paint();
	if (m_pWindow)
		m_pWindow->resetOpenGLState();
}

} // namespace OrlexGraphics
