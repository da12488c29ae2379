#pragma once

#include "OrlexGraphics/manipulator/ManipulatorDrag.h"
#include "OrlexGraphics/manipulator/Volume.h"

#include <QVector3D>

#include <cstdint>
#include <optional>

namespace OrlexGraphics
{

/// What the handles of a volume move.
enum EVolumeHandle : std::uint32_t
{
	/// 0 to 5: a face, the lower one of X first, then the upper one, then those of Y and Z.
	EVolumeFace,
	/// 0 to 3: an edge that stands upright, by its foot. Bit 0 is its side on the first axis of the floor, bit 1 that
	/// on the second.
	EVolumeCorner,
	/// The whole volume, along the floor.
	EVolumeCentre,
	EVolumeHandleCount
};

struct VVolumeHandle
{
	/// EVolumeHandle.
	std::uint32_t m_Group = EVolumeFace;
	std::uint32_t m_Index = 0;

	bool operator==(const VVolumeHandle&) const = default;
};

/// How many handles there are of each kind.
std::uint32_t VolumeHandleCount(std::uint32_t i_Group);

/// Where a handle stands, without the part of it that keeps its size on the screen.
QVector3D VolumeHandlePlace(const VVolume& i_rVolume, const VVolumeHandle& i_rHandle, bool i_bYUp);

/// Out of a face, of length 1.
QVector3D VolumeFaceNormal(std::uint32_t i_Face);

/// What one drag of a handle makes of a volume, which never becomes thinner than c_LeastSide.
class VVolumeDrag
{
public:
	static constexpr float c_LeastSide = 10.0f;

	/// Nothing if the handle cannot be dragged as the camera stands.
	static std::optional<VVolumeDrag> Press(const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_rMouse,
	    const VVolumeHandle& i_rHandle, const VVolume& i_rStart);

	/// Nothing if the mouse points where there is no place for the handle: the last volume holds.
	std::optional<VVolume> Drag(const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_rMouse) const;

	const VVolumeHandle& Handle() const { return m_Handle; }

private:
	std::optional<QVector3D> PointUnder(const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_rMouse) const;

	VVolumeHandle m_Handle;
	VVolume m_Start;
	/// A point of the line or plane that the handle moves in.
	QVector3D m_Place;
	/// Along the line, or out of the plane.
	QVector3D m_Direction;
	/// The point that was taken hold of.
	QVector3D m_Offset;
	int m_UpAxis = 2;
};

} // namespace OrlexGraphics
