#pragma once

#include "NVX/ISelectionItem.h"

#include <QMatrix4x4>
#include <QPoint>
#include <QRect>
#include <QSize>
#include <QVector4D>

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace OrlexGraphics
{

/// What a pick looks for, and under which conditions.
struct VPickRequest
{
	/// Item pixels.
	QPoint m_Mouse;
	/// Where the rectangle started; only looked at if there is one.
	QPoint m_Start;
	bool m_bRectangle = false;
	QMatrix4x4 m_View;
	QMatrix4x4 m_Projection;
	/// Number of the frame update that placed what can be picked.
	std::uint64_t m_Frame = 0;

	bool operator==(const VPickRequest&) const = default;
};

/// What a pick found.
struct VPick
{
	VPickRequest m_Request;
	std::vector<NVX::ISelectionItem> m_Items;
	/// Of the items, for the tool tip.
	std::vector<std::string> m_Names;
};

/// The mouse moves by more than this before it moves something, in item pixels.
inline constexpr int c_MouseTolerance = 3;

/// Whether a press and a release are so near to each other that a point is meant.
bool IsPoint(const QPoint& i_rStart, const QPoint& i_rEnd);

/// The pixels around the mouse that a point pick looks at: 11 by 11, less at the edge of the framebuffer.
/// @param i_Mouse in device pixels from the upper left corner of the frame; the result is from the lower left one
QRect PointPickRectangle(const QPoint& i_Mouse, int i_FrameHeight, const QSize& i_rFramebuffer);

/// The pixels between two corners, which are counted in.
/// @param i_A in device pixels from the upper left corner, as is i_B; the result is from the lower left one
/// @param i_Scale pixels of the framebuffer by device pixels of the frame
/// @param i_rFrame the frame's size in device pixels
/// @return empty if it is below one pixel.
QRect RectanglePickRectangle(const QPoint& i_A, const QPoint& i_B, double i_Scale, const QSize& i_rFrame);

/// The id, without flags, of the pixel that is nearest to the mouse; of pixels at equal distance the first one in the
/// order of rows. 0 if all pixels are empty.
/// @param i_pPixels RGBA bytes, row by row from the bottom, of the rectangle
/// @param i_rMouse the pixel of the mouse, from the rectangle's lower left corner
std::uint32_t NearestId(const std::uint8_t* i_pPixels, const QSize& i_rSize, const QPoint& i_rMouse);

/// Adds the ids, without flags, that appear in pixels and were not found before.
/// @param io_rFound by id
/// @return whether there were any.
bool CollectIds(const std::uint8_t* i_pPixels, std::size_t i_Count, std::vector<bool>& io_rFound,
    std::vector<std::uint32_t>& io_rIds);

/// The names in order, one a line; ten at most, then "...".
std::string ToolTip(std::vector<std::string> i_Names);

/// The bound of a pick rectangle in clip space: what lies outside of it need not be drawn.
struct VPickFrustum
{
	/// Keeps what is inside: dot((x, y, z, 1), plane) >= 0 in world space, with normals of length 1.
	QVector4D m_Planes[4];

	bool Contains(const QVector4D& i_rSphere) const;
};

/// @param i_rRectangle in pixels from the lower left corner of a frame of this size
VPickFrustum MakePickFrustum(const QMatrix4x4& i_rViewProjection, const QRect& i_rRectangle, const QSize& i_rFrame);

/// The pixels of a frame of this size that spheres lie within, from the lower left corner. All of them if a sphere
/// reaches behind the eye.
QRect ScreenRectangle(
    const std::vector<QVector4D>& i_rSpheres, const QMatrix4x4& i_rViewProjection, const QSize& i_rFrame);

} // namespace OrlexGraphics
