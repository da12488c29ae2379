#include "Eye.h"

#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>

using Eigen::Matrix3d;
using Eigen::Vector3d;

Matrix3d VEye::Turn() const
{
	return (Eigen::AngleAxisd(m_Pitch * M_PI / 180.0, Vector3d::UnitX())
	    * Eigen::AngleAxisd(m_Yaw * M_PI / 180.0, Vector3d::UnitZ()))
	    .toRotationMatrix();
}

Vector3d VEye::Place() const
{
	return m_Centre + Turn().transpose() * Vector3d(0.0, 0.0, m_Distance);
}

QPointF VEye::Project(const Vector3d& i_rPoint) const
{
	const Vector3d seen = Turn() * (i_rPoint - Place());
	const double pixels = 0.5 * m_Size.height() / std::tan(c_HalfField) / -seen.z();
	return {0.5 * m_Size.width() + pixels * seen.x(), 0.5 * m_Size.height() - pixels * seen.y()};
}

Vector3d VEye::Ray(const QPointF& i_rPixel) const
{
	const Vector3d seen(i_rPixel.x() - 0.5 * m_Size.width(), 0.5 * m_Size.height() - i_rPixel.y(),
	    -0.5 * m_Size.height() / std::tan(c_HalfField));
	return Turn().transpose() * seen.normalized();
}

double VEye::PixelSize(const Vector3d& i_rPoint) const
{
	return -(Turn() * (i_rPoint - Place())).z() * 2.0 * std::tan(c_HalfField) / m_Size.height();
}

void VEye::Orbit(const QPointF& i_rMove)
{
	m_Yaw += 0.2 * i_rMove.x();
	m_Pitch += 0.2 * i_rMove.y();
}

void VEye::Pan(const QPointF& i_rMove)
{
	// What is under the mouse at the centre's distance stays under it.
	m_Centre -= PixelSize(m_Centre) * (Turn().transpose() * Vector3d(i_rMove.x(), -i_rMove.y(), 0.0));
}

void VEye::Frame(const std::vector<Vector3d>& i_rPoints)
{
	constexpr double c_Margin = 250.0;
	Eigen::AlignedBox3d box;
	for (const Vector3d& rPoint : i_rPoints)
		box.extend(rPoint);
	m_Centre = box.center();
	m_Distance = 0.0;
	const double upright = std::tan(c_HalfField), across = upright * m_Size.width() / m_Size.height();
	for (const Vector3d& rPoint : i_rPoints)
	{
		// The cone's edge at the point's depth, and the sphere of the margin that touches it.
		const Vector3d seen = Turn() * (rPoint - m_Centre);
		for (const auto& [aside, slope] : {std::pair(seen.x(), across), std::pair(seen.y(), upright)})
			m_Distance =
			    std::max(m_Distance, seen.z() + std::abs(aside) / slope + c_Margin / std::sin(std::atan(slope)));
	}
}

VSkeleton ReadSkeleton(const QByteArray& i_rJson)
{
	VSkeleton skeleton;
	for (const QJsonValue value : QJsonDocument::fromJson(i_rJson).object()["segments"].toArray())
	{
		const QJsonArray rotation = value["rotation"].toArray();
		const QJsonArray translation = value["translation"].toArray();
		Eigen::Isometry3d pose = Eigen::Isometry3d::Identity();
		for (int row = 0; row < 3; ++row)
		{
			for (int column = 0; column < 3; ++column)
				pose.matrix()(row, column) = rotation[3 * row + column].toDouble();
			pose.matrix()(row, 3) = translation[row].toDouble();
		}
		skeleton[value["name"].toString().toStdString()] = pose;
	}
	return skeleton;
}

Matrix3d Exp(const Vector3d& i_rVector)
{
	const double angle = i_rVector.norm();
	return angle == 0.0 ? Matrix3d::Identity() : Eigen::AngleAxisd(angle, i_rVector / angle).toRotationMatrix();
}

Vector3d Log(const Matrix3d& i_rRotation)
{
	const Eigen::AngleAxisd turn(i_rRotation);
	return turn.angle() * turn.axis();
}

double AngleInPlane(const VEye& i_rEye, const Vector3d& i_rCentre, const Vector3d& i_rNormal, const QPointF& i_rFrom,
    const QPointF& i_rTo)
{
	const auto arm = [&](const QPointF& i_rPixel) -> Vector3d
	{
		const Vector3d eye = i_rEye.Place() - i_rCentre;
		const Vector3d ray = i_rEye.Ray(i_rPixel);
		return eye - ray * (eye.dot(i_rNormal) / ray.dot(i_rNormal));
	};
	const Vector3d from = arm(i_rFrom);
	const Vector3d to = arm(i_rTo);
	return std::atan2(from.cross(to).dot(i_rNormal), from.dot(to));
}

double AngleOnScreen(const QPointF& i_rCentre, const QPointF& i_rFrom, const QPointF& i_rTo)
{
	const QPointF from = i_rFrom - i_rCentre;
	const QPointF to = i_rTo - i_rCentre;
	return std::atan2(from.y() * to.x() - from.x() * to.y(), QPointF::dotProduct(from, to));
}
