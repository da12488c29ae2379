#include "OrlexGraphics/manipulator/VolumeDrag.h"

#include "CoreGraphics/CameraController.h"

#include <algorithm>
#include <array>

namespace OrlexGraphics
{

namespace
{

int UpAxis(bool i_bYUp)
{
	return i_bYUp ? 1 : 2;
}

/// The axes of the floor.
std::array<int, 2> FloorAxes(int i_UpAxis)
{
	return i_UpAxis == 1 ? std::array<int, 2>{0, 2} : std::array<int, 2>{0, 1};
}

bool IsUpper(std::uint32_t i_Bits, std::size_t i_Bit)
{
	return (i_Bits >> i_Bit & 1) != 0;
}

/// Moves one side of a volume, to no more than the least distance from the other.
void MoveSide(VVolume& io_rVolume, int i_Axis, bool i_bUpper, float i_Way)
{
	float& rLow = io_rVolume.m_Minimum[i_Axis];
	float& rHigh = io_rVolume.m_Maximum[i_Axis];
	if (i_bUpper)
		rHigh = std::max(rHigh + i_Way, rLow + VVolumeDrag::c_LeastSide);
	else
		rLow = std::min(rLow + i_Way, rHigh - VVolumeDrag::c_LeastSide);
}

} // namespace

std::uint32_t VolumeHandleCount(std::uint32_t i_Group)
{
	constexpr std::array<std::uint32_t, EVolumeHandleCount> counts = {6, 4, 1};
	return i_Group < counts.size() ? counts[i_Group] : 0;
}

QVector3D VolumeFaceNormal(std::uint32_t i_Face)
{
	QVector3D normal;
	normal[static_cast<int>(i_Face / 2)] = IsUpper(i_Face, 0) ? 1.0f : -1.0f;
	return normal;
}

QVector3D VolumeHandlePlace(const VVolume& i_rVolume, const VVolumeHandle& i_rHandle, bool i_bYUp)
{
	QVector3D place = 0.5f * (i_rVolume.m_Minimum + i_rVolume.m_Maximum);
	const auto side = [&](int i_Axis, bool i_bUpper)
	{ place[i_Axis] = i_bUpper ? i_rVolume.m_Maximum[i_Axis] : i_rVolume.m_Minimum[i_Axis]; };
	if (i_rHandle.m_Group == EVolumeFace)
		side(static_cast<int>(i_rHandle.m_Index / 2), IsUpper(i_rHandle.m_Index, 0));
	else if (i_rHandle.m_Group == EVolumeCorner)
	{
		const int up = UpAxis(i_bYUp);
		for (std::size_t i = 0; i < 2; ++i)
			side(FloorAxes(up)[i], IsUpper(i_rHandle.m_Index, i));
		side(up, false);
	}
	return place;
}

std::optional<VVolumeDrag> VVolumeDrag::Press(const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_rMouse,
    const VVolumeHandle& i_rHandle, const VVolume& i_rStart)
{
	if (i_rHandle.m_Index >= VolumeHandleCount(i_rHandle.m_Group))
		return {};
	VVolumeDrag drag;
	drag.m_Handle = i_rHandle;
	drag.m_Start = i_rStart;
	drag.m_UpAxis = UpAxis(i_rCamera.m_bYUp);
	drag.m_Place = VolumeHandlePlace(i_rStart, i_rHandle, i_rCamera.m_bYUp);
	if (i_rHandle.m_Group == EVolumeFace)
		drag.m_Direction = VolumeFaceNormal(i_rHandle.m_Index);
	else
		drag.m_Direction[drag.m_UpAxis] = 1.0f;
	const std::optional<QVector3D> point = drag.PointUnder(i_rCamera, i_rMouse);
	if (!point)
		return {};
	drag.m_Offset = *point;
	return drag;
}

std::optional<QVector3D> VVolumeDrag::PointUnder(
    const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_rMouse) const
{
	const std::optional<VMouseRay> ray = MakeMouseRay(i_rCamera, i_rMouse);
	if (!ray)
		return {};
	return m_Handle.m_Group == EVolumeFace ? PointOnLine(*ray, m_Place, m_Direction)
	                                       : PointOnPlane(*ray, m_Place, m_Direction);
}

std::optional<VVolume> VVolumeDrag::Drag(const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_rMouse) const
{
	const std::optional<QVector3D> point = PointUnder(i_rCamera, i_rMouse);
	if (!point)
		return {};
	const QVector3D way = *point - m_Offset;
	VVolume volume = m_Start;
	if (m_Handle.m_Group == EVolumeFace)
	{
		const int axis = static_cast<int>(m_Handle.m_Index / 2);
		MoveSide(volume, axis, IsUpper(m_Handle.m_Index, 0), way[axis]);
		return volume;
	}
	const std::array<int, 2> axes = FloorAxes(m_UpAxis);
	for (std::size_t i = 0; i < 2; ++i)
	{
		if (m_Handle.m_Group == EVolumeCorner)
		{
			MoveSide(volume, axes[i], IsUpper(m_Handle.m_Index, i), way[axes[i]]);
			continue;
		}
		volume.m_Minimum[axes[i]] += way[axes[i]];
		volume.m_Maximum[axes[i]] += way[axes[i]];
	}
	return volume;
}

} // namespace OrlexGraphics
