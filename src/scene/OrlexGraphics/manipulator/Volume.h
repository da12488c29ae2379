#pragma once

#include <QMatrix4x4>
#include <QVector3D>

namespace OrlexGraphics
{

/// A box along the axes of the world, in millimetres.
struct VVolume
{
	QVector3D m_Minimum;
	QVector3D m_Maximum;

	bool operator==(const VVolume&) const = default;
};

/// Corners are numbers, and the box has an inside.
bool IsValid(const VVolume& i_rVolume);

/// Takes the unit cube about the origin to the box.
QMatrix4x4 BoxTransform(const VVolume& i_rVolume);

} // namespace OrlexGraphics
