#include "TesselPluginRetargetSetup/SideSeen.h"

#include "CoreGraphics/CameraController.h"

#include <cmath>

namespace RetargetSetup
{

const char* SideSeen(const QVector3D& i_rLeft, bool i_bYUp, std::uint32_t i_CameraType)
{
	if (i_CameraType < CoreGraphics::ECameraFront || i_CameraType > CoreGraphics::ECameraRight)
		return "";
	const QVector3D up = i_bYUp ? QVector3D(0.0f, 1.0f, 0.0f) : QVector3D(0.0f, 0.0f, 1.0f);
	const QVector3D front = QVector3D::crossProduct(i_rLeft, up);
	// Much of a body that lies on its side would be told by little.
	if (front.length() < 0.5f * i_rLeft.length() || front.isNull())
		return "";
	CoreGraphics::VCameraController camera;
	camera.m_Type = i_CameraType;
	camera.m_bYUp = i_bYUp;
	const QVector3D toEye = camera.Orientation().transposed().mapVector(QVector3D(0.0f, 0.0f, 1.0f));
	const float ahead = QVector3D::dotProduct(front, toEye);
	const float aside = QVector3D::dotProduct(QVector3D::crossProduct(up, front), toEye);
	if (std::abs(ahead) >= std::abs(aside))
		return ahead > 0.0f ? "front" : "back";
	return aside > 0.0f ? "left side" : "right side";
}

} // namespace RetargetSetup
