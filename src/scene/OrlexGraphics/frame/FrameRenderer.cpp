#include "OrlexGraphics/frame/FrameRenderer.h"

#include "OrlexGraphics/frame/IRenderType.h"
#include "OrlexGraphics/frame/OrlexScene.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "OrlexGraphics/stage/RenderCameras.h"
#include "OrlexGraphics/stage/SphereHelper.h"

#include <QColor>
#include <QOpenGLContext>
#include <QOpenGLFramebufferObject>
#include <QOpenGLFunctions>
#include <QOpenGLPaintDevice>
#include <QPainter>
#include <QTime>

namespace OrlexGraphics
{

namespace
{

/// Texture unit of the id frame.
constexpr unsigned int c_SelectionUnit = 7;
constexpr int c_Samples = 4;

} // namespace

VFrameRenderer::VFrameRenderer() = default;
VFrameRenderer::~VFrameRenderer() = default;

void VFrameRenderer::Initialise()
{
	m_Context.Initialise();
}

void VFrameRenderer::SetScene(std::shared_ptr<VOrlexScene> i_pScene)
{
	m_pScene = std::move(i_pScene);
	if (!m_pScene)
		return;
	// The base's own, whatever an override leaves out: another context may have come.
	m_pScene->VOrlexScene::InitialiseGL();
	m_pScene->InitialiseGL();
	m_pScene->SetNeedsRefresh();
}

void VFrameRenderer::SetSize(const QSize& i_rSize)
{
	m_Size = i_rSize;
	m_pIdFramebuffer.reset();
	m_pPickFramebuffer.reset();
	m_pOutlineFramebuffer.reset();
}

QOpenGLFramebufferObjectFormat VFrameRenderer::TargetFormat() const
{
	const bool bES = m_Context.m_pContext->isOpenGLES();
	QOpenGLFramebufferObjectFormat format;
	format.setAttachment(QOpenGLFramebufferObject::Depth);
	format.setSamples(bES || m_Input.m_Options.m_bCameraView ? 0 : c_Samples);
	format.setInternalTextureFormat(bES ? GL_RGBA : GL_RGB);
	return format;
}

void VFrameRenderer::Update()
{
	if (!m_pScene || !m_pScene->NeedsRefresh())
		return;
	m_pScene->Refresh();
	++m_UpdateCount;
}

void VFrameRenderer::BeginFrame()
{
	m_Context.ResetState();
	m_Context.ResetScissor();
	m_Context.m_ModifierState = m_Input.m_ModifierState;

	const bool bYUp = m_pScene && m_pScene->FrameYUp();
	m_Input.m_Camera.m_bYUp = bYUp;
	m_Input.m_Camera.Update();
	m_Input.m_Camera.Apply(m_Context);
	m_Context.SetViewport(QRect(QPoint(), m_Size));
	m_Context.m_FrameSize = m_Size;
	m_Context.m_PixelRatio = static_cast<float>(m_Input.m_PixelRatio);
	m_Context.SetYUp(bYUp);
	m_Context.m_LightVector = (bYUp ? QVector3D(1.0f, 3.0f, 1.0f) : QVector3D(1.0f, 1.0f, 3.0f)).normalized();
	m_Context.m_GlobalTime = static_cast<float>(QTime::currentTime().msecsSinceStartOfDay()) * 0.001f;
}

void VFrameRenderer::Render(QOpenGLFramebufferObject& io_rTarget)
{
	Render(io_rTarget.handle());
}

void VFrameRenderer::Render(unsigned int i_Target)
{
	BeginFrame();
	m_Context.m_OutlineRectangle = OutlineRectangle();
	if (!m_Context.m_OutlineRectangle.isEmpty())
	{
		if (!m_pIdFramebuffer)
		{
			m_pIdFramebuffer = std::make_unique<QOpenGLFramebufferObject>(m_Size, QOpenGLFramebufferObject::Depth);
			m_pOutlineFramebuffer = std::make_unique<QOpenGLFramebufferObject>(m_Size, GL_TEXTURE_2D);
		}
		m_Context.m_Mode = CoreGraphics::ERenderId;
		m_Context.BindFramebuffer(m_pIdFramebuffer.get());
		RenderScene();
	}
	m_Context.m_Mode = CoreGraphics::ERenderNormal;
	m_Context.m_DefaultFramebuffer = i_Target;
	m_Context.BindDefaultFramebuffer();
	m_Context.m_pOutlineFramebuffer = m_pOutlineFramebuffer.get();
	if (m_pIdFramebuffer)
		m_Context.BindFramebufferTexture(c_SelectionUnit, *m_pIdFramebuffer);
	RenderScene();
	m_Context.ResetState();
	m_Context.ResetScissor();
}

QRect VFrameRenderer::OutlineRectangle()
{
	if (!m_pScene || !m_pScene->Registry().HasFlagged())
		return {};
	const QRect frame(QPoint(), m_Size);
	if (!m_pScene->Registry().GetFlaggedBounds(m_Bounds))
		return frame;
	const QRect bounds = ScreenRectangle(m_Bounds, m_Context.m_Projection * m_Context.m_View, m_Size);
	// Room for the edges, which look at the pixels around them.
	constexpr int c_Edge = 6;
	return bounds.isEmpty() ? bounds : bounds.adjusted(-c_Edge, -c_Edge, c_Edge, c_Edge) & frame;
}

void VFrameRenderer::RenderScene()
{
	if (m_Context.m_Mode == CoreGraphics::ERenderId)
		m_Context.SetScissor(m_Context.m_OutlineRectangle);
	else
		m_Context.SetScissor();
	const VSceneOptions& rOptions = m_Input.m_Options;
	const bool bBackground =
	    m_Context.m_Mode == CoreGraphics::ERenderNormal && (rOptions.m_OverlayCamera.empty() || !rOptions.m_b3D);
	m_Context.SetClearColour(bBackground ? QColor(QRgb{rOptions.m_BackgroundColorRGB}) : QColor(0, 0, 0, 0));
	m_Context.ClearBuffers(true, true);
	if (!m_pScene)
		return;
	m_pScene->SphereHelper()->Clear();
	// Camera views consist of tiles; there are none here.
	if (!rOptions.m_bCameraView)
		RenderPasses();
	m_Context.SetViewport(QRect(QPoint(), m_Context.m_FrameSize));
	m_Context.SetScissor();
	for (const std::shared_ptr<IRenderType>& rpType : m_pScene->PostList())
		rpType->Render(m_Context, rOptions, EPassOverlay);
}

void VFrameRenderer::RenderPasses()
{
	const VSceneOptions& rOptions = m_Input.m_Options;
	const auto pass = [&](ERenderPass i_Pass)
	{
		for (const std::shared_ptr<IRenderType>& rpType : m_pScene->RenderList())
			rpType->Render(m_Context, rOptions, i_Pass);
	};
	bool b3D = rOptions.m_b3D;
	if (m_pScene->CameraType() && !rOptions.m_OverlayCamera.empty())
		b3D = m_pScene->CameraType()->RenderOverlayCamera(m_Context, rOptions) && b3D;
	if (b3D)
	{
		pass(EPassOpaque);
		pass(EPassTransparent);
	}
	m_Context.ClearBuffers(false, true);
	pass(EPassOverlay);
}

void VFrameRenderer::Paint()
{
	QOpenGLPaintDevice device(m_Size);
	device.setDevicePixelRatio(m_Input.m_PixelRatio);
	QPainter painter(&device);
	painter.setRenderHint(QPainter::Antialiasing);
	if (m_Input.m_Rectangle)
	{
		painter.setPen(QColor(231, 101, 0, 255));
		painter.setBrush(QColor(75, 120, 170, 64));
		painter.drawRect(QRect(m_Input.m_Rectangle->first, m_Input.m_Rectangle->second));
	}
	if (m_pScene)
		for (const std::shared_ptr<IRenderType>& rpType : m_pScene->RenderList())
			rpType->Paint(painter, m_Context, m_Input.m_Options);
}

} // namespace OrlexGraphics
