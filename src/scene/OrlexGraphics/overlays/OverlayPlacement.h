#pragma once

#include <QMatrix4x4>
#include <QPointF>
#include <QSizeF>
#include <QVector3D>

namespace OrlexGraphics
{

/// Where a label stands over a view.
struct VOverlayPlace
{
	/// From the view's centre, in item pixels, x to the right and y down.
	QPointF m_Position;
	/// 0 at the near plane, 1 at the far one and off screen.
	double m_Depth = 0.0;
	/// 0 downwards from the centre, 90 to the right.
	double m_RotationDegrees = 0.0;
	/// The point is not in the view, the position is on the view's edge towards it.
	bool m_bOffscreen = false;
};

/// @param i_rItemSize in item pixels
/// @param i_rPoint in the world, the label stands a little above it
VOverlayPlace PlaceOverlay(
    const QMatrix4x4& i_rViewProjection, const QSizeF& i_rItemSize, const QVector3D& i_rPoint, bool i_bYUp);

} // namespace OrlexGraphics
