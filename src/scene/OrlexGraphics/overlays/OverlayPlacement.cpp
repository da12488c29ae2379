#include "OrlexGraphics/overlays/OverlayPlacement.h"

#include <QVector4D>

#include <algorithm>
#include <cmath>

namespace OrlexGraphics
{

namespace
{

/// Millimetres above the point.
constexpr float c_Raise = 100.0f;
/// Pixels above the raised point.
constexpr double c_Lift = 20.0;
/// Pixels that labels keep from the view's edge.
constexpr double c_Border = 30.0;
constexpr double c_Degrees = 57.295776;

} // namespace

VOverlayPlace PlaceOverlay(
    const QMatrix4x4& i_rViewProjection, const QSizeF& i_rItemSize, const QVector3D& i_rPoint, bool i_bYUp)
{
	const QVector3D up = i_bYUp ? QVector3D(0.0f, c_Raise, 0.0f) : QVector3D(0.0f, 0.0f, c_Raise);
	const QVector4D point = i_rViewProjection * QVector4D(i_rPoint, 1.0f);
	const QVector4D raised = i_rViewProjection * QVector4D(i_rPoint + up, 1.0f);
	const double halfX = 0.5 * i_rItemSize.width();
	const double halfY = 0.5 * i_rItemSize.height();
	const double allowedX = std::max(halfX - c_Border, 0.0);
	const double allowedY = std::max(halfY - c_Border, 0.0);

	const bool bBehind = raised.w() < 0.0f;
	double x = 0.0;
	double y = -c_Lift;
	if (raised.w() != 0.0f)
	{
		x += halfX * static_cast<double>(raised.x() / raised.w());
		y -= halfY * static_cast<double>(raised.y() / raised.w());
	}
	if (bBehind)
	{
		x = -x;
		y = -y;
	}

	VOverlayPlace place;
	const double excess = std::max(std::abs(x) / std::max(allowedX, 1.0), std::abs(y) / std::max(allowedY, 1.0));
	place.m_bOffscreen = bBehind || excess > 1.0;
	if (place.m_bOffscreen && excess > 0.0)
	{
		x /= excess;
		y /= excess;
	}
	place.m_Position = QPointF(x, y);
	place.m_Depth =
	    place.m_bOffscreen || point.w() == 0.0f ? 1.0 : 0.5 * static_cast<double>(point.z() / point.w()) + 0.5;
	place.m_RotationDegrees = std::atan2(x, y) * c_Degrees;
	return place;
}

} // namespace OrlexGraphics
