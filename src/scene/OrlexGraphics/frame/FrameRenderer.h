#pragma once

#include "CoreGraphics/CameraController.h"
#include "CoreGraphics/RenderContext.h"
#include "OrlexGraphics/frame/SceneOptions.h"
#include "OrlexGraphics/picking/Picking.h"

#include <QPoint>
#include <QSize>

#include <cstdint>
#include <memory>
#include <optional>
#include <utility>
#include <vector>

class QOpenGLFramebufferObject;
class QOpenGLFramebufferObjectFormat;

namespace OrlexGraphics
{

class VOrlexScene;

/// Draws frames of a scene into framebuffers, and picks from them. It knows no window: a view on screen and a picture
/// for a file are drawn alike. Everything needs the context that Initialise took to be current.
class VFrameRenderer
{
public:
	/// What a frame is drawn with.
	struct VInput
	{
		VSceneOptions m_Options;
		/// Counts in the pixels of the item that is drawn, however many pixels the device makes of them.
		CoreGraphics::VCameraController m_Camera;
		/// Pixels of the framebuffer by pixels of the item.
		double m_PixelRatio = 1.0;
		/// CoreGraphics::EModifierState.
		std::uint32_t m_ModifierState = CoreGraphics::EModifierNone;
		/// Corners of the selection rectangle that is being drawn, in pixels of the item.
		std::optional<std::pair<QPoint, QPoint>> m_Rectangle;
	};

	VFrameRenderer();
	~VFrameRenderer();

	/// Takes the current context.
	void Initialise();
	bool IsInitialised() const { return m_Context.m_pContext != nullptr; }
	/// Whether the processor draws.
	bool IsSoftware() const { return m_Context.m_bSoftware; }

	/// Makes the scene ready for this context. While the user interface thread waits.
	void SetScene(std::shared_ptr<VOrlexScene> i_pScene);
	const std::shared_ptr<VOrlexScene>& Scene() const { return m_pScene; }

	/// Of the framebuffers that are drawn into, in device pixels.
	void SetSize(const QSize& i_rSize);
	/// What a framebuffer that is drawn into should be.
	QOpenGLFramebufferObjectFormat TargetFormat() const;

	/// To be set before a frame.
	VInput m_Input;

	/// The scene's frame update, if it needs one.
	void Update();
	/// How many frame updates there were.
	std::uint64_t UpdateCount() const { return m_UpdateCount; }

	/// Draws the ids of what is asked for, and reads them.
	/// @param o_rPick the request's frame becomes the one that was picked from.
	void Pick(const VPickRequest& i_rRequest, VPick& o_rPick);
	/// Draws the visible frame into a framebuffer of the size that was set.
	/// @param i_Target OpenGL's name of it
	void Render(unsigned int i_Target);
	void Render(QOpenGLFramebufferObject& io_rTarget);
	/// Draws 2D text and marks over it.
	void Paint();

private:
	void BeginFrame();
	/// Where outlines can be, in device pixels from the lower left corner.
	QRect OutlineRectangle();
	/// A whole frame in the context's mode.
	void RenderScene();
	void RenderPasses();

	/// @param i_rMouse in device pixels from the upper left corner, as are the corners of PickRect
	std::uint32_t PickPoint(const QPoint& i_rMouse);
	void PickRect(const QPoint& i_rA, const QPoint& i_rB, double i_Scale, int i_MaxPasses);
	/// Draws and reads the ids in a rectangle of the pick framebuffer.
	void ReadIds(const QRect& i_rRectangle);

	CoreGraphics::VRenderContext m_Context;
	std::shared_ptr<VOrlexScene> m_pScene;
	QSize m_Size;
	std::uint64_t m_UpdateCount = 0;
	/// Null until something is to be outlined, or to be picked.
	std::unique_ptr<QOpenGLFramebufferObject> m_pIdFramebuffer;
	std::unique_ptr<QOpenGLFramebufferObject> m_pPickFramebuffer;
	std::unique_ptr<QOpenGLFramebufferObject> m_pOutlineFramebuffer;
	/// Of what is selected.
	std::vector<QVector4D> m_Bounds;
	std::vector<std::uint8_t> m_Pixels;
	/// By id.
	std::vector<bool> m_Found;
	std::vector<std::uint32_t> m_PickedIds;
};

} // namespace OrlexGraphics
