#pragma once

#include "CoreGraphics/CameraController.h"
#include "CoreGraphics/RenderContext.h"
#include "OrlexGraphics/Picking.h"
#include "OrlexGraphics/SceneOptions.h"
#include "OrlexGraphics/Tracking.h"

#include <QQuickFramebufferObject>

#include <cstdint>
#include <memory>
#include <vector>

class QOpenGLFramebufferObject;
class QQuickWindow;

namespace OrlexGraphics
{

class VOrlexScene;
class VSceneFramebufferObject;

/// Draws the scene of one SceneFramebufferObject, on the render thread, and picks from it. It owns the OpenGL objects
/// of the view and lives as long as they do.
class VSceneFramebufferRenderer : public QQuickFramebufferObject::Renderer
{
public:
	VSceneFramebufferRenderer();
	~VSceneFramebufferRenderer() override;

	/// The one place where the two threads exchange anything: the user interface thread waits.
	void synchronize(QQuickFramebufferObject* io_pItem) override;
	QOpenGLFramebufferObject* createFramebufferObject(const QSize& i_rSize) override;
	void render() override;

	/// How many there are in the process, and how many there were.
	static std::uint64_t LivingCount();
	static std::uint64_t MadeCount();

private:
	void TakeScene(VSceneFramebufferObject& io_rItem);
	void Track(VSceneFramebufferObject& io_rItem);

	void SetUpCamera(const QSize& i_rFrame);
	void Pick(const QSize& i_rFrame);
	void RenderIds();
	/// A whole frame in the context's mode.
	void RenderScene();
	void RenderPasses();
	void PaintOverlay(const QSize& i_rFrame);

	/// @param i_rMouse in device pixels from the upper left corner, as are the corners of PickRect
	std::uint32_t PickPoint(const QPoint& i_rMouse, const QSize& i_rFrame);
	void PickRect(const QPoint& i_rA, const QPoint& i_rB, double i_Scale, int i_MaxPasses, const QSize& i_rFrame);
	/// Draws and reads the ids in a rectangle of the pick framebuffer.
	void ReadIds(const QRect& i_rRectangle);

	CoreGraphics::VRenderContext m_Context;
	std::shared_ptr<VOrlexScene> m_pScene;
	VSceneOptions m_Options;
	/// As the item's was at the last exchange.
	CoreGraphics::VCameraController m_Camera;
	QQuickWindow* m_pWindow = nullptr;
	double m_PixelRatio = 1.0;
	std::unique_ptr<QOpenGLFramebufferObject> m_pIdFramebuffer;
	std::unique_ptr<QOpenGLFramebufferObject> m_pPickFramebuffer;
	std::unique_ptr<QOpenGLFramebufferObject> m_pOutlineFramebuffer;
	QPoint m_MousePos;
	QPoint m_RectangleStart;
	bool m_bPickActive = false;
	bool m_bRectangleActive = false;
	VPickRequest m_Request;
	/// What the last pick found.
	VPick m_Pick;
	bool m_bPicked = false;
	std::vector<std::uint8_t> m_Pixels;
	std::vector<bool> m_Found;
	std::vector<std::uint32_t> m_PickedIds;
	bool m_bContinuousUpdate = true;
	bool m_bInitialised = false;
	bool m_bVisible = false;
	ETracking m_Tracking = ETrackingNone;
	std::vector<NVX::ISelectionItem> m_Tracked;
	/// Of what can be picked.
	std::uint64_t m_Frame = 0;
};

} // namespace OrlexGraphics
