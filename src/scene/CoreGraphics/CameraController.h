#pragma once

#include <QMatrix4x4>
#include <QPoint>
#include <QSize>
#include <QVector3D>
#include <QVector4D>

#include <cstdint>
#include <vector>

namespace CoreGraphics
{

class VRenderContext;

/// The free view, and the fixed ones, which are orthographic.
enum ECameraType : std::uint32_t
{
	ECameraPerspective,
	ECameraFront,
	ECameraBack,
	ECameraLeft,
	ECameraRight,
	ECameraTop,
	ECameraBottom,
	ECameraTypeCount
};

/// A camera that turns round a centre, and what the mouse does to it. A plain value: a copy draws what the original
/// showed. Lengths are millimetres, angles degrees, positions of the mouse pixels of the viewport from its upper left
/// corner. Changes of members show after Update.
class VCameraController
{
public:
	static constexpr float c_MinimumDistance = 10.0f;
	static constexpr float c_MaximumDistance = 50000.0f;
	static constexpr float c_MinimumScale = 0.001f;
	static constexpr float c_MaximumScale = 1000.0f;

	QMatrix4x4 m_Projection;
	QMatrix4x4 m_View;
	/// What the camera stands in: it follows a moving thing whose transform this is.
	QMatrix4x4 m_FrameOfReference;
	float m_Near = 1.0f;
	float m_Far = 100000.0f;
	/// From the upper edge to the lower one.
	float m_FieldOfView = 45.0f;
	float m_Pitch = -60.0f;
	float m_Yaw = 45.0f;
	/// From the centre to the eye, in the perspective view.
	float m_Distance = 7000.0f;
	/// Millimetres of a pixel, in the orthographic views.
	float m_OrthographicScale = 4.0f;
	QVector3D m_Centre;
	QSize m_Size;
	QPoint m_LastMouse;
	bool m_bTranslate = false;
	bool m_bRotate = false;
	bool m_bDolly = false;
	bool m_bYUp = false;
	/// ECameraType.
	std::uint32_t m_Type = ECameraPerspective;

	VCameraController() = default;
	VCameraController(const VCameraController&) = default;
	VCameraController& operator=(const VCameraController&) = default;
	virtual ~VCameraController();

	/// View and projection from the other members.
	virtual void Update();

	/// Of the viewport, in pixels.
	void SetSize(const QSize& i_rSize);
	/// @param i_bClose from above and near, for what is followed; or the view of the whole stage
	void Reset(bool i_bClose);
	/// Looks at the middle of the spheres, from where it looked.
	/// @param i_rBounds spheres as centre and radius; nothing changes if there is none that is finite
	/// @param i_bAdjust goes so near that they fill the view, a margin of 250 mm left round them
	void Fit(const std::vector<QVector4D>& i_rBounds, bool i_bAdjust);

	/// A button went down. What the buttons stand for is asked of VInteractionMapper.
	void Press(const QPoint& i_rMouse, std::uint32_t i_Buttons, std::uint32_t i_Modifiers);
	void Move(const QPoint& i_rMouse);
	/// A button went up. @param i_Buttons those that are still held
	void Release(std::uint32_t i_Buttons, std::uint32_t i_Modifiers);
	/// Of the mouse wheel; away from the user is positive.
	/// @param i_bInFixedViews orthographic views go nearer and farther, too, and keep the distance of the other one
	void Wheel(int i_Delta, bool i_bInFixedViews = false);

	/// Hands matrices, viewport and frame size to the context.
	void Apply(VRenderContext& io_rContext) const;

	/// Of the view, without position.
	QMatrix4x4 Orientation() const;
	bool IsOrthographic() const { return m_Type != ECameraPerspective; }

private:
	void UpdateProjection();
	void SetActions(std::uint32_t i_Buttons, std::uint32_t i_Modifiers);
	void SetDistance(float i_Distance);
	void SetScale(float i_Scale);
};

} // namespace CoreGraphics
