#include "OrlexGraphics/manipulator/ManipulatorDrag.h"

#include "CoreGraphics/CameraController.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace OrlexGraphics
{

using CoreGraphics::VCameraController;

namespace
{

// Of a ray and a line: beyond it, the nearest point runs away with the least move of the mouse.
constexpr float c_MostParallel = 0.99f;
// Of a ray and a plane's normal: below it, the ray runs along the plane.
constexpr float c_LeastSlope = 0.000001f;
// How far away a plane is met, in millimetres.
constexpr float c_FarthestPlane = 90000.0f;

constexpr double c_SnapAngle = std::numbers::pi / 4.0;
constexpr double c_FineFactor = 0.2;
// Nearer to the centre than this a pixel tells no direction.
constexpr double c_LeastArm = 1.0;

// Depths that a ray is laid through; the far plane itself is too far for floats.
constexpr float c_NearDepth = 0.0f;
constexpr float c_FarDepth = 0.9f;

/// Pixels from the upper left corner. Nothing for a point behind the eye.
std::optional<QPointF> OnScreen(const VCameraController& i_rCamera, const QVector3D& i_rPoint)
{
	const QVector4D clip = i_rCamera.m_Projection * (i_rCamera.m_View * QVector4D(i_rPoint, 1.0f));
	if (!(clip.w() > 0.0f))
		return {};
	return QPointF(0.5 * (1.0 + static_cast<double>(clip.x() / clip.w())) * i_rCamera.m_Size.width(),
	    0.5 * (1.0 - static_cast<double>(clip.y() / clip.w())) * i_rCamera.m_Size.height());
}

} // namespace

std::optional<VMouseRay> MakeMouseRay(const VCameraController& i_rCamera, const QPointF& i_rMouse)
{
	bool bInvertible = false;
	const QMatrix4x4 fromClip = i_rCamera.m_Projection.inverted(&bInvertible);
	if (!bInvertible || i_rCamera.m_Size.isEmpty())
		return {};
	const auto x = static_cast<float>(2.0 * i_rMouse.x() / i_rCamera.m_Size.width() - 1.0);
	const auto y = static_cast<float>(1.0 - 2.0 * i_rMouse.y() / i_rCamera.m_Size.height());
	// The direction is taken in the space of the eye, where the two points are not lost in the eye's own distance.
	const QVector3D from = fromClip.map(QVector3D(x, y, 2.0f * c_NearDepth - 1.0f));
	const QVector3D to = fromClip.map(QVector3D(x, y, 2.0f * c_FarDepth - 1.0f));
	const QMatrix4x4 fromEye = i_rCamera.m_View.inverted();
	return VMouseRay{fromEye.map(from), fromEye.mapVector(to - from).normalized()};
}

std::optional<QVector3D> PointOnLine(const VMouseRay& i_rRay, const QVector3D& i_rPoint, const QVector3D& i_rDirection)
{
	const float slope = QVector3D::dotProduct(i_rRay.m_Direction, i_rDirection);
	if (!(std::abs(slope) <= c_MostParallel))
		return {};
	// Both feet of the common perpendicular, from its being at right angles to either line.
	const QVector3D between = i_rPoint - i_rRay.m_Origin;
	const float alongRay = QVector3D::dotProduct(between, i_rRay.m_Direction);
	const float alongLine = QVector3D::dotProduct(between, i_rDirection);
	const float squaredSine = 1.0f - slope * slope;
	if ((alongRay - slope * alongLine) / squaredSine < 0.0f)
		return {};
	return i_rPoint + (slope * alongRay - alongLine) / squaredSine * i_rDirection;
}

std::optional<QVector3D> PointOnPlane(const VMouseRay& i_rRay, const QVector3D& i_rPoint, const QVector3D& i_rNormal)
{
	const float slope = QVector3D::dotProduct(i_rRay.m_Direction, i_rNormal);
	if (!(std::abs(slope) >= c_LeastSlope))
		return {};
	const float distance = QVector3D::dotProduct(i_rPoint - i_rRay.m_Origin, i_rNormal) / slope;
	if (distance < 0.0f || distance > c_FarthestPlane)
		return {};
	return i_rRay.m_Origin + distance * i_rRay.m_Direction;
}

std::optional<VManipulatorDrag> VManipulatorDrag::Press(const VCameraController& i_rCamera, const QPoint& i_rMouse,
    const VManipulatorHandle& i_rHandle, const QMatrix4x4& i_rStart)
{
	const std::optional<VMouseRay> ray = MakeMouseRay(i_rCamera, i_rMouse);
	if (!ray || i_rHandle.m_Group > EManipulatorRing || i_rHandle.m_Axis > 2)
		return {};
	VManipulatorDrag drag;
	drag.m_Handle = i_rHandle;
	drag.m_Start = i_rStart;
	drag.m_Centre = i_rStart.column(3).toVector3D();
	drag.m_Axis = i_rStart.column(static_cast<int>(i_rHandle.m_Axis)).toVector3D().normalized();
	drag.m_LastMouse = i_rMouse;
	drag.m_Sign = QVector3D::dotProduct(ray->m_Direction, drag.m_Axis) < 0.0f ? 1.0 : -1.0;
	if (i_rHandle.m_Group == EManipulatorRing)
		return drag;
	const std::optional<QVector3D> point = drag.PointUnder(*ray);
	if (!point)
		return {};
	drag.m_Offset = *point;
	return drag;
}

std::optional<QVector3D> VManipulatorDrag::PointUnder(const VMouseRay& i_rRay) const
{
	return m_Handle.m_Group == EManipulatorArrow ? PointOnLine(i_rRay, m_Centre, m_Axis)
	                                             : PointOnPlane(i_rRay, m_Centre, m_Axis);
}

std::optional<QMatrix4x4> VManipulatorDrag::Drag(
    const VCameraController& i_rCamera, const QPoint& i_rMouse, Qt::KeyboardModifiers i_Modifiers)
{
	if (m_Handle.m_Group == EManipulatorRing)
		return Turn(i_rCamera, i_rMouse, i_Modifiers);
	const std::optional<VMouseRay> ray = MakeMouseRay(i_rCamera, i_rMouse);
	const std::optional<QVector3D> point = ray ? PointUnder(*ray) : std::nullopt;
	if (!point)
		return {};
	QMatrix4x4 moved = m_Start;
	moved.setColumn(3, QVector4D(m_Centre + *point - m_Offset, 1.0f));
	return moved;
}

std::optional<QMatrix4x4> VManipulatorDrag::Turn(
    const VCameraController& i_rCamera, const QPoint& i_rMouse, Qt::KeyboardModifiers i_Modifiers)
{
	const std::optional<QPointF> centre = OnScreen(i_rCamera, m_Centre);
	if (!centre)
		return {};
	const QPointF from = QPointF(m_LastMouse) - *centre;
	const QPointF to = QPointF(i_rMouse) - *centre;
	if (std::hypot(to.x(), to.y()) < c_LeastArm)
		return {};
	m_LastMouse = i_rMouse;
	if (std::hypot(from.x(), from.y()) >= c_LeastArm)
		// Counter-clockwise as seen, where Y of the screen runs down.
		m_Angle += std::atan2(from.y() * to.x() - from.x() * to.y(), QPointF::dotProduct(from, to));

	double angle = m_Angle;
	if (i_Modifiers.testFlag(Qt::ControlModifier))
		angle = std::round(angle / c_SnapAngle) * c_SnapAngle;
	else if (i_Modifiers.testFlag(Qt::ShiftModifier))
		angle *= c_FineFactor;

	QMatrix4x4 turned;
	turned.rotate(static_cast<float>(m_Sign * angle * 180.0 / std::numbers::pi), m_Axis);
	turned *= m_Start;
	turned.setColumn(3, QVector4D(m_Centre, 1.0f));
	return turned;
}

} // namespace OrlexGraphics
