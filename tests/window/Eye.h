#pragma once

#include <Eigen/Geometry>

#include <QByteArray>
#include <QPointF>
#include <QSizeF>

#include <map>
#include <string>
#include <vector>

/// The camera of the preview as its users know it, and what it shows, by arithmetic that shares nothing with the
/// preview's own. Millimetres, degrees, pixels from the upper left corner; Z is up.
struct VEye
{
	static constexpr double c_HalfField = 22.5 * M_PI / 180.0;

	QSizeF m_Size;
	double m_Pitch = -60.0;
	double m_Yaw = 45.0;
	double m_Distance = 7000.0;
	Eigen::Vector3d m_Centre = Eigen::Vector3d::Zero();

	/// From the world's directions to the eye's, which looks along -Z.
	Eigen::Matrix3d Turn() const;
	Eigen::Vector3d Place() const;
	QPointF Project(const Eigen::Vector3d& i_rPoint) const;
	/// From the eye through a pixel, of length 1.
	Eigen::Vector3d Ray(const QPointF& i_rPixel) const;
	/// Millimetres that one pixel covers at a point.
	double PixelSize(const Eigen::Vector3d& i_rPoint) const;

	void Orbit(const QPointF& i_rMove);
	void Pan(const QPointF& i_rMove);
	void Dolly(const QPointF& i_rMove) { m_Distance += 15.0 * i_rMove.y(); }
	/// Fills the view with points and the margin round each.
	void Frame(const std::vector<Eigen::Vector3d>& i_rPoints);
};

/// Segments of a subject in the world.
using VSkeleton = std::map<std::string, Eigen::Isometry3d>;

/// @param i_rJson as "retarget fk" prints it
VSkeleton ReadSkeleton(const QByteArray& i_rJson);

/// Rotation vectors: axis times angle in radians.
Eigen::Matrix3d Exp(const Eigen::Vector3d& i_rVector);
Eigen::Vector3d Log(const Eigen::Matrix3d& i_rRotation);

/// The angle by which the mouse turns a ring about a centre: of the two points where the mouse meets the ring's plane.
double AngleInPlane(const VEye& i_rEye, const Eigen::Vector3d& i_rCentre, const Eigen::Vector3d& i_rNormal,
    const QPointF& i_rFrom, const QPointF& i_rTo);

/// The same on the screen, counter-clockwise.
double AngleOnScreen(const QPointF& i_rCentre, const QPointF& i_rFrom, const QPointF& i_rTo);
