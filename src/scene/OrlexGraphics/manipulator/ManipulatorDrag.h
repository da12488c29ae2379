#pragma once

#include <QMatrix4x4>
#include <QPoint>
#include <QVector3D>
#include <Qt>

#include <array>
#include <cstdint>
#include <optional>

namespace CoreGraphics
{
class VCameraController;
}

namespace OrlexGraphics
{

/// What the handles of a manipulator do, by groups of three, one for each axis.
enum EManipulatorGroup : std::uint32_t
{
	/// Moves along the axis.
	EManipulatorArrow,
	/// Moves in the plane at right angles to the axis.
	EManipulatorPlane,
	/// Turns about the axis.
	EManipulatorRing,
	/// Marks the axis that is dragged; does nothing itself.
	EManipulatorMarker,
	EManipulatorGroupCount
};

struct VManipulatorHandle
{
	/// EManipulatorGroup.
	std::uint32_t m_Group = EManipulatorArrow;
	/// 0 for X, 1 for Y, 2 for Z.
	std::uint32_t m_Axis = 0;

	bool operator==(const VManipulatorHandle&) const = default;
};

/// From the eye through a pixel.
struct VMouseRay
{
	QVector3D m_Origin;
	/// Of length 1.
	QVector3D m_Direction;
};

/// @param i_rMouse in pixels of the camera's viewport, from its upper left corner
/// @return nothing for a view without size
std::optional<VMouseRay> MakeMouseRay(const CoreGraphics::VCameraController& i_rCamera, const QPointF& i_rMouse);

/// The point of a line that is nearest to the ray. Nothing if the two are nearly parallel, or if it lies behind the
/// eye.
/// @param i_rDirection of the line, of length 1
std::optional<QVector3D> PointOnLine(const VMouseRay& i_rRay, const QVector3D& i_rPoint, const QVector3D& i_rDirection);

/// Where the ray meets a plane. Nothing if it runs along the plane, or meets it behind the eye or too far away.
/// @param i_rNormal of length 1
std::optional<QVector3D> PointOnPlane(const VMouseRay& i_rRay, const QVector3D& i_rPoint, const QVector3D& i_rNormal);

/// What one drag of a handle makes of a transform. Millimetres, radians; matrices for column vectors.
class VManipulatorDrag
{
public:
	/// Nothing if the handle cannot be dragged as the camera stands: then there is no drag.
	/// @param i_rStart rotation and translation of the manipulator
	static std::optional<VManipulatorDrag> Press(const CoreGraphics::VCameraController& i_rCamera,
	    const QPoint& i_rMouse, const VManipulatorHandle& i_rHandle, const QMatrix4x4& i_rStart);

	/// The transform for a place of the mouse. Nothing if the mouse points where there is none: the last one holds.
	/// @param i_Modifiers for a ring, Ctrl gives steps of an eighth of a turn, Shift alone a fifth of the angle
	std::optional<QMatrix4x4> Drag(
	    const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_rMouse, Qt::KeyboardModifiers i_Modifiers);

	const VManipulatorHandle& Handle() const { return m_Handle; }

private:
	std::optional<QVector3D> PointUnder(const VMouseRay& i_rRay) const;
	std::optional<QMatrix4x4> Turn(
	    const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_rMouse, Qt::KeyboardModifiers i_Modifiers);

	VManipulatorHandle m_Handle;
	QMatrix4x4 m_Start;
	QVector3D m_Centre;
	QVector3D m_Axis;
	/// The point that was taken hold of.
	QVector3D m_Offset;
	QPoint m_LastMouse;
	/// Counter-clockwise on the screen since the press, over all turns.
	double m_Angle = 0.0;
	/// 1 if the axis points at the eye, else -1.
	double m_Sign = 1.0;
};

} // namespace OrlexGraphics
