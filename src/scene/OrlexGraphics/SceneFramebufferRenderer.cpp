#include "OrlexGraphics/SceneFramebufferRenderer.h"

#include "OrlexGraphics/IRenderType.h"
#include "OrlexGraphics/OrlexScene.h"
#include "OrlexGraphics/RenderCameras.h"
#include "OrlexGraphics/SceneFramebufferObject.h"
#include "OrlexGraphics/SelectionRegistry.h"
#include "OrlexGraphics/SphereHelper.h"
#include "TesselPluginInterface/ISelectionManager.h"

#include <QColor>
#include <QOpenGLContext>
#include <QOpenGLFramebufferObject>
#include <QOpenGLFunctions>
#include <QOpenGLPaintDevice>
#include <QPainter>
#include <QQuickWindow>
#include <QTime>

#include <atomic>
#include <cstring>

namespace OrlexGraphics
{

namespace
{

std::atomic<std::uint64_t> s_Made{0};
std::atomic<std::uint64_t> s_Living{0};

/// Texture unit of the id frame.
constexpr unsigned int c_SelectionUnit = 7;
constexpr int c_Samples = 4;

/// Drawing takes the processor's time then, so that nothing is drawn that has not changed.
bool IsSoftware(QOpenGLFunctions& io_rGL)
{
	const auto* const pName = reinterpret_cast<const char*>(io_rGL.glGetString(GL_RENDERER));
	if (!pName)
		return false;
	for (const char* const pSoftware : {"llvmpipe", "softpipe", "swrast", "Software", "SWR", "GDI Generic", "WARP"})
		if (std::strstr(pName, pSoftware))
			return true;
	return false;
}

} // namespace

VSceneFramebufferRenderer::VSceneFramebufferRenderer()
{
	++s_Made;
	++s_Living;
}

VSceneFramebufferRenderer::~VSceneFramebufferRenderer()
{
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
	if (!m_bInitialised)
	{
		m_Context.Initialise();
		m_bContinuousUpdate = io_rItem.m_bContinuousUpdate && !IsSoftware(*m_Context.m_pFunctions);
		m_bInitialised = true;
	}
	const std::shared_ptr<VOrlexScene> pScene =
	    io_rItem.m_pScene ? io_rItem.m_pScene->weak_from_this().lock() : nullptr;
	if (m_pScene != pScene)
	{
		m_pScene = pScene;
		m_Pick = {};
		m_bPicked = false;
		m_Tracked.clear();
		if (m_pScene)
		{
			// The base's own, whatever an override leaves out: another context may have come.
			m_pScene->VOrlexScene::InitialiseGL();
			m_pScene->InitialiseGL();
			m_pScene->SetNeedsRefresh();
		}
	}
	if (m_pScene)
		m_pScene->Synchronise();
}

void VSceneFramebufferRenderer::Track(VSceneFramebufferObject& io_rItem)
{
	CoreGraphics::VCameraController& rCamera = *io_rItem.m_pCamera;
	if (m_Tracking != io_rItem.m_Tracking
	    && (m_Tracking == ETrackingTransform || io_rItem.m_Tracking == ETrackingTransform))
		rCamera.Reset(m_Tracking != ETrackingTransform);
	m_Tracking = io_rItem.m_Tracking;
	rCamera.m_bYUp = m_pScene && m_pScene->YUp();
	rCamera.SetSize(QSize(static_cast<int>(io_rItem.width()), static_cast<int>(io_rItem.height())));
	if (m_pScene && m_pScene->SelectionManager())
	{
		const std::vector<NVX::ISelectionItem>& rSelected = m_pScene->SelectionManager()->Selection().Items();
		if (io_rItem.m_bTrackSelectionPending)
			m_Tracked = rSelected;
		QMatrix4x4 transform;
		if (m_Tracking == ETrackingSelectionThen)
			rCamera.Fit(m_pScene->GetBounds(m_Tracked), false);
		else if (m_Tracking == ETrackingSelection)
			rCamera.Fit(m_pScene->GetBounds(rSelected), false);
		else if (m_Tracking == ETrackingTransform && m_pScene->GetItemTransform(m_Tracked, transform))
			rCamera.m_FrameOfReference = transform;
		// The bounds of a frame that is still to be drawn come with the exchange after it.
		if (io_rItem.m_bFitPending && !m_pScene->NeedsRefresh())
		{
			rCamera.Fit(m_pScene->GetBounds(rSelected), true);
			io_rItem.m_bFitPending = false;
		}
	}
	io_rItem.m_bTrackSelectionPending = false;

	const QMatrix4x4 view = rCamera.m_View;
	const QMatrix4x4 projection = rCamera.m_Projection;
	rCamera.Update();
	if (view != rCamera.m_View || projection != rCamera.m_Projection || m_Camera.m_Size != rCamera.m_Size)
		QMetaObject::invokeMethod(
		    &io_rItem, [&io_rItem] { io_rItem.OnFrameChanged(); }, Qt::QueuedConnection);
	m_Camera = rCamera;
}

void VSceneFramebufferRenderer::synchronize(QQuickFramebufferObject* io_pItem)
{
	auto& rItem = static_cast<VSceneFramebufferObject&>(*io_pItem);
	m_bVisible = rItem.isVisible();
	m_pWindow = rItem.window();
	m_PixelRatio = m_pWindow ? m_pWindow->effectiveDevicePixelRatio() : 1.0;
	TakeScene(rItem);

	const bool bDistorted = m_Options.m_b3D && m_Options.m_bDistort3D;
	m_Options = rItem.m_Options;
	if (bDistorted != (m_Options.m_b3D && m_Options.m_bDistort3D))
		invalidateFramebufferObject();

	Track(rItem);

	// A frame that is still to be drawn is not the one that was picked from.
	const std::uint64_t frame = m_Frame + (m_pScene && m_pScene->NeedsRefresh() ? 1 : 0);
	if (m_bPicked)
		rItem.CommitPick(m_Pick, rItem.MakePickRequest(frame));

	const EMouseState state = rItem.m_MouseState;
	m_Request = rItem.MakePickRequest(frame);
	m_MousePos = m_Request.m_Mouse;
	m_bPickActive = m_pScene && state != EMouseIdle;
	m_bRectangleActive = state == EMouseDragging || state == EMouseDragged;
	m_RectangleStart = rItem.m_PressPos;
	m_Context.m_ModifierState = rItem.m_ModifierState;

	// Only the item's own update leads to another exchange.
	const bool bOutstanding = m_bPickActive
	    && (state == EMouseClicked || state == EMouseDragged || !m_bPicked || m_Pick.m_Request != m_Request);
	if (m_bVisible && (m_bContinuousUpdate || bOutstanding || (rItem.m_bFitPending && m_pScene)))
		QMetaObject::invokeMethod(&rItem, &QQuickItem::update, Qt::QueuedConnection);
}

QOpenGLFramebufferObject* VSceneFramebufferRenderer::createFramebufferObject(const QSize& i_rSize)
{
	const bool bES = m_Context.m_pContext->isOpenGLES();
	QOpenGLFramebufferObjectFormat display;
	display.setAttachment(QOpenGLFramebufferObject::Depth);
	display.setSamples(bES || m_Options.m_bCameraView ? 0 : c_Samples);
	display.setInternalTextureFormat(bES ? GL_RGBA : GL_RGB);

	m_pIdFramebuffer = std::make_unique<QOpenGLFramebufferObject>(i_rSize, QOpenGLFramebufferObject::Depth);
	m_pOutlineFramebuffer = std::make_unique<QOpenGLFramebufferObject>(i_rSize, GL_TEXTURE_2D);
	return new QOpenGLFramebufferObject(i_rSize, display);
}

void VSceneFramebufferRenderer::render()
{
	if (!m_bVisible)
		return;
	const QSize frame = framebufferObject()->size();
	if (m_pScene && m_pScene->NeedsRefresh())
	{
		m_pScene->Refresh();
		++m_Frame;
	}
	m_Context.ResetState();
	m_Context.m_pOutlineFramebuffer = m_pOutlineFramebuffer.get();
	m_Context.m_DefaultFramebuffer = framebufferObject()->handle();
	SetUpCamera(frame);

	if (m_bPickActive)
		Pick(frame);
	if (m_pScene && m_pScene->Registry().HasFlagged())
		RenderIds();

	m_Context.m_Mode = CoreGraphics::ERenderNormal;
	m_Context.BindDefaultFramebuffer();
	m_Context.BindFramebufferTexture(c_SelectionUnit, *m_pIdFramebuffer);
	RenderScene();

	m_Context.ResetState();
	m_Context.ResetScissor();
	PaintOverlay(frame);
	if (m_pWindow)
		m_pWindow->resetOpenGLState();
}

void VSceneFramebufferRenderer::SetUpCamera(const QSize& i_rFrame)
{
	const bool bYUp = m_pScene && m_pScene->FrameYUp();
	m_Camera.m_bYUp = bYUp;
	m_Camera.Update();
	m_Camera.Apply(m_Context);
	// The camera counts in the item's pixels, the frame in the device's.
	m_Context.SetViewport(QRect(QPoint(), i_rFrame));
	m_Context.m_FrameSize = i_rFrame;
	m_Context.SetYUp(bYUp);
	m_Context.m_LightVector = (bYUp ? QVector3D(1.0f, 3.0f, 1.0f) : QVector3D(1.0f, 1.0f, 3.0f)).normalized();
	m_Context.m_GlobalTime = static_cast<float>(QTime::currentTime().msecsSinceStartOfDay()) * 0.001f;
}

void VSceneFramebufferRenderer::RenderIds()
{
	m_Context.m_Mode = CoreGraphics::ERenderId;
	m_Context.BindFramebuffer(m_pIdFramebuffer.get());
	RenderScene();
}

void VSceneFramebufferRenderer::RenderScene()
{
	m_Context.SetScissor();
	const bool bBackground =
	    m_Context.m_Mode == CoreGraphics::ERenderNormal && (m_Options.m_OverlayCamera.empty() || !m_Options.m_b3D);
	m_Context.SetClearColour(bBackground ? QColor(QRgb{m_Options.m_BackgroundColorRGB}) : QColor(0, 0, 0, 0));
	m_Context.ClearBuffers(true, true);
	if (!m_pScene)
		return;
	m_pScene->SphereHelper()->Clear();
	// Camera views consist of tiles; there are none here.
	if (!m_Options.m_bCameraView)
		RenderPasses();
	m_Context.SetViewport(QRect(QPoint(), m_Context.m_FrameSize));
	m_Context.SetScissor();
	for (const std::shared_ptr<IRenderType>& rpType : m_pScene->PostList())
		rpType->Render(m_Context, m_Options, EPassOverlay);
}

void VSceneFramebufferRenderer::RenderPasses()
{
	const auto pass = [&](ERenderPass i_Pass)
	{
		for (const std::shared_ptr<IRenderType>& rpType : m_pScene->RenderList())
			rpType->Render(m_Context, m_Options, i_Pass);
	};
	bool b3D = m_Options.m_b3D;
	if (m_pScene->CameraType() && !m_Options.m_OverlayCamera.empty())
		b3D = m_pScene->CameraType()->RenderOverlayCamera(m_Context, m_Options) && b3D;
	if (b3D)
	{
		pass(EPassOpaque);
		pass(EPassTransparent);
	}
	m_Context.ClearBuffers(false, true);
	pass(EPassOverlay);
}

void VSceneFramebufferRenderer::PaintOverlay(const QSize& i_rFrame)
{
	QOpenGLPaintDevice device(i_rFrame);
	device.setDevicePixelRatio(m_PixelRatio);
	QPainter painter(&device);
	painter.setRenderHint(QPainter::Antialiasing);
	if (m_bRectangleActive)
	{
		painter.setPen(QColor(231, 101, 0, 255));
		painter.setBrush(QColor(75, 120, 170, 64));
		painter.drawRect(QRect(m_RectangleStart, m_MousePos));
	}
	if (m_pScene)
		for (const std::shared_ptr<IRenderType>& rpType : m_pScene->RenderList())
			rpType->Paint(painter, m_Context, m_Options);
}

} // namespace OrlexGraphics
