#pragma once

#include "CoreGraphics/RenderState.h"
#include "CoreGraphics/Uniform.h"

#include <QMatrix4x4>
#include <QRect>
#include <QSize>
#include <QVector2D>
#include <QVector3D>
#include <QVector4D>

#include <bitset>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

class QColor;
class QOpenGLContext;
class QOpenGLFramebufferObject;
class QOpenGLFunctions;

namespace CoreGraphics
{

class VIndexBuffer;
class VShaderProgram;
class VVertexBuffer;
struct VVertexFormat;

/// What a frame is drawn for.
enum ERenderMode : std::uint32_t
{
	/// The eye.
	ERenderNormal,
	/// The mouse: ids of all that is not excluded.
	ERenderPick,
	/// The outlines: ids of what is selected or preselected.
	ERenderId
};

/// What a pick does with the selection: the keys that are held.
enum EModifierState : std::uint32_t
{
	EModifierNone,
	/// Shift.
	EModifierAdd,
	/// Ctrl and Shift.
	EModifierSubtract,
	/// Ctrl.
	EModifierToggle
};

/// Whether the processor draws. With a context current.
bool IsSoftware(QOpenGLFunctions& i_rFunctions);

/// OpenGL as the renderers use it: the matrices and vectors of the frame, the program in use, and plain records of
/// state. One renderer owns it, on the render thread; every method needs the context that Initialise took.
class VRenderContext
{
public:
	/// The picture of the overlay camera.
	struct VDistortion
	{
		QVector2D m_Centre;
		QVector3D m_Parameters;
		QVector2D m_SensorSize{1.0f, 1.0f};
	};

	/// As many attributes as can be enabled at once.
	static constexpr std::size_t c_AttributeArrays = 8;

	QOpenGLContext* m_pContext = nullptr;
	QOpenGLFunctions* m_pFunctions = nullptr;
	/// Whether the processor draws. Set by Initialise, like the next one.
	bool m_bSoftware = false;
	/// The most that textures can be sharpened with where they are seen at a slant. 1, for not at all, where the
	/// processor draws: it would spend most of a frame on it.
	float m_MostAnisotropy = 1.0f;
	std::bitset<c_AttributeArrays> m_EnabledAttributes;
	QMatrix4x4 m_Projection;
	QMatrix4x4 m_View;
	/// The camera grid's 2D view.
	QVector4D m_View2D{1.0f, 1.0f, 0.0f, 0.0f};
	/// In device pixels from the lower left corner. Set by SetViewport.
	QRect m_Viewport;
	QVector3D m_LightVector{0.0f, 0.0f, 1.0f};
	/// Set by SetYUp, like m_bYUp.
	QVector3D m_Up{0.0f, 0.0f, 1.0f};
	/// Of the whole frame, in device pixels.
	QSize m_FrameSize;
	/// Pixels of the device by those that sizes on the screen count in: more than 1 on a fine display.
	float m_PixelRatio = 1.0f;
	bool m_bYUp = false;
	/// Seconds in the day.
	float m_GlobalTime = 0.0f;
	VDistortion m_Distortion;
	/// ERenderMode.
	std::uint32_t m_Mode = ERenderNormal;
	/// EModifierState.
	std::uint32_t m_ModifierState = EModifierNone;
	/// What is bound; null for the default one.
	QOpenGLFramebufferObject* m_pFramebuffer = nullptr;
	/// Where the outlines are drawn before they are smoothed; null if there is none.
	QOpenGLFramebufferObject* m_pOutlineFramebuffer = nullptr;
	/// Where outlines can be, in device pixels from the lower left corner; empty if there are none.
	QRect m_OutlineRectangle;
	/// The program in use.
	std::shared_ptr<VShaderProgram> m_pProgram;
	/// What BindDefaultFramebuffer binds: not 0 where Qt Quick draws into a framebuffer object.
	unsigned int m_DefaultFramebuffer = 0;

	/// Takes the current context.
	void Initialise();
	/// From whatever state others left behind to the one that all drawing here starts from.
	void ResetState();

	/// The program, with the standard uniforms written as they are now. False for none, and for an empty one: then
	/// nothing is to be drawn.
	bool UseProgram(const std::shared_ptr<VShaderProgram>& i_rpProgram);

	/// Of the program in use; nothing if it does not have the uniform.
	void SetUniform(VUniform& io_rUniform, int i_Value);
	void SetUniform(VUniform& io_rUniform, float i_Value);
	void SetUniform(VUniform& io_rUniform, const QVector2D& i_rValue);
	void SetUniform(VUniform& io_rUniform, const QVector3D& i_rValue);
	void SetUniform(VUniform& io_rUniform, const QVector4D& i_rValue);
	void SetUniform(VUniform& io_rUniform, const QMatrix4x4& i_rValue);
	/// Matrices of 16 numbers each, column by column.
	void SetUniform(VUniform& io_rUniform, const float* i_pMatrices, std::size_t i_Count);

	/// Of the vertex buffer that is bound, for the program in use.
	/// @param i_First the vertex of the buffer that counts as the first
	void SetVertexFormat(const VVertexFormat& i_rFormat, std::size_t i_First = 0);
	/// Binds the buffer, and sets its format.
	void BindVertices(VVertexBuffer& io_rBuffer);
	void ApplyState(const VRenderState& i_rState);

	/// @param i_Mode GL_TRIANGLES, GL_LINES...
	void DrawArrays(unsigned int i_Mode, std::size_t i_Count);
	void DrawElements(unsigned int i_Mode, VIndexBuffer& io_rIndices);
	/// Of the indices that are bound, two bytes each.
	void DrawElements(unsigned int i_Mode, std::size_t i_First, std::size_t i_Count);

	/// For ClearBuffers.
	void SetClearColour(const QColor& i_rColour);
	/// Sets the masks of what it clears first.
	void ClearBuffers(bool i_bColour, bool i_bDepth);
	/// RGBA bytes, row by row from the bottom, from the framebuffer that is bound.
	void ReadPixels(const QRect& i_rRectangle, std::vector<std::uint8_t>& o_rPixels);

	void SetViewport(const QRect& i_rViewport);
	/// Nothing outside of the viewport is drawn or cleared, until ResetScissor.
	void SetScissor() { SetScissor(m_Viewport); }
	void SetScissor(const QRect& i_rRectangle);
	void ResetScissor();
	void SetYUp(bool i_bYUp);

	void BindFramebuffer(QOpenGLFramebufferObject* i_pFramebuffer);
	void BindDefaultFramebuffer();
	/// The framebuffer's picture as the texture of a unit; exact pixels in a mode other than the normal one. Unit 0 is
	/// the active one afterwards.
	void BindFramebufferTexture(unsigned int i_Unit, const QOpenGLFramebufferObject& i_rFramebuffer);
};

} // namespace CoreGraphics
