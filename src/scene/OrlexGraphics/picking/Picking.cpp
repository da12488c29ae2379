#include "OrlexGraphics/picking/Picking.h"

#include "CoreGraphics/SelectionId.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>

namespace OrlexGraphics
{

namespace
{

constexpr int c_PointRadius = 5;
constexpr std::size_t c_ToolTipNames = 10;

std::uint32_t IdOf(const std::uint8_t* i_pPixel)
{
	const std::uint32_t colour = i_pPixel[0] | i_pPixel[1] << 8 | i_pPixel[2] << 16;
	return colour & CoreGraphics::ESelectionIdMask;
}

} // namespace

bool IsPoint(const QPoint& i_rStart, const QPoint& i_rEnd)
{
	return std::abs(i_rEnd.x() - i_rStart.x()) < c_MouseTolerance
	    && std::abs(i_rEnd.y() - i_rStart.y()) < c_MouseTolerance;
}

QRect PointPickRectangle(const QPoint& i_Mouse, int i_FrameHeight, const QSize& i_rFramebuffer)
{
	const QRect rectangle(i_Mouse.x() - c_PointRadius, i_FrameHeight - i_Mouse.y() - c_PointRadius,
	    2 * c_PointRadius + 1, 2 * c_PointRadius + 1);
	return rectangle & QRect(QPoint(), i_rFramebuffer);
}

QRect RectanglePickRectangle(const QPoint& i_A, const QPoint& i_B, double i_Scale, const QSize& i_rFrame)
{
	const auto scaled = [&](const QPoint& i_rPoint)
	{
		return QPoint(static_cast<int>(std::floor(i_rPoint.x() * i_Scale + 0.5)),
		    static_cast<int>(std::floor((i_rFrame.height() - i_rPoint.y()) * i_Scale + 0.5)));
	};
	const QPoint a = scaled(i_A);
	const QPoint b = scaled(i_B);
	const QPoint lower(std::min(a.x(), b.x()), std::min(a.y(), b.y()));
	const QSize size(std::abs(a.x() - b.x()), std::abs(a.y() - b.y()));
	const QSize frame(static_cast<int>(std::ceil(i_rFrame.width() * i_Scale)),
	    static_cast<int>(std::ceil(i_rFrame.height() * i_Scale)));
	return QRect(lower, size) & QRect(QPoint(), frame);
}

std::uint32_t NearestId(const std::uint8_t* i_pPixels, const QSize& i_rSize, const QPoint& i_rMouse)
{
	std::uint32_t nearest = 0;
	int nearestDistance = 0;
	for (int y = 0; y < i_rSize.height(); ++y)
		for (int x = 0; x < i_rSize.width(); ++x, i_pPixels += 4)
		{
			const std::uint32_t id = IdOf(i_pPixels);
			if (id == 0)
				continue;
			const int dx = x - i_rMouse.x();
			const int dy = y - i_rMouse.y();
			const int distance = dx * dx + dy * dy;
			if (nearest != 0 && distance >= nearestDistance)
				continue;
			nearest = id;
			nearestDistance = distance;
		}
	return nearest;
}

bool CollectIds(const std::uint8_t* i_pPixels, std::size_t i_Count, std::vector<bool>& io_rFound,
    std::vector<std::uint32_t>& io_rIds)
{
	const std::size_t before = io_rIds.size();
	std::uint32_t last = 0;
	for (const std::uint8_t* const pEnd = i_pPixels + 4 * i_Count; i_pPixels != pEnd; i_pPixels += 4)
	{
		const std::uint32_t id = IdOf(i_pPixels);
		// Neighbours are mostly of one thing.
		if (id == last)
			continue;
		last = id;
		if (id == 0)
			continue;
		if (id >= io_rFound.size())
			io_rFound.resize(id + 1);
		if (io_rFound[id])
			continue;
		io_rFound[id] = true;
		io_rIds.push_back(id);
	}
	return io_rIds.size() != before;
}

std::string ToolTip(std::vector<std::string> i_Names)
{
	std::sort(i_Names.begin(), i_Names.end());
	std::string text;
	for (std::size_t i = 0; i < i_Names.size(); ++i)
	{
		if (i != 0)
			text += "<br>";
		if (i == c_ToolTipNames)
		{
			text += "...";
			break;
		}
		text += i_Names[i];
	}
	return text;
}

bool VPickFrustum::Contains(const QVector4D& i_rSphere) const
{
	return std::none_of(std::begin(m_Planes), std::end(m_Planes),
	    [&](const QVector4D& i_rPlane)
	    { return QVector4D::dotProduct(i_rPlane, QVector4D(i_rSphere.toVector3D(), 1.0f)) < -i_rSphere.w(); });
}

VPickFrustum MakePickFrustum(const QMatrix4x4& i_rViewProjection, const QRect& i_rRectangle, const QSize& i_rFrame)
{
	const auto edge = [](int i_Pixel, int i_Size)
	{ return 2.0f * static_cast<float>(i_Pixel) / static_cast<float>(std::max(i_Size, 1)) - 1.0f; };
	const QVector4D x = i_rViewProjection.row(0);
	const QVector4D y = i_rViewProjection.row(1);
	const QVector4D w = i_rViewProjection.row(3);
	VPickFrustum frustum{{x - edge(i_rRectangle.x(), i_rFrame.width()) * w,
	    edge(i_rRectangle.x() + i_rRectangle.width(), i_rFrame.width()) * w - x,
	    y - edge(i_rRectangle.y(), i_rFrame.height()) * w,
	    edge(i_rRectangle.y() + i_rRectangle.height(), i_rFrame.height()) * w - y}};
	for (QVector4D& rPlane : frustum.m_Planes)
		if (const float length = rPlane.toVector3D().length(); length > 0.0f)
			rPlane /= length;
	return frustum;
}

QRect ScreenRectangle(
    const std::vector<QVector4D>& i_rSpheres, const QMatrix4x4& i_rViewProjection, const QSize& i_rFrame)
{
	const QRect frame(QPoint(), i_rFrame);
	const QVector4D rows[] = {i_rViewProjection.row(0), i_rViewProjection.row(1), i_rViewProjection.row(3)};
	QRectF all;
	for (const QVector4D& rSphere : i_rSpheres)
	{
		const QVector4D centre(rSphere.toVector3D(), 1.0f);
		const auto reach = [&](int i_Row) { return rSphere.w() * rows[i_Row].toVector3D().length(); };
		const float w = QVector4D::dotProduct(rows[2], centre);
		// Of all points of the sphere: no point is nearer to the eye, none farther.
		const float nearest = w - reach(2);
		const float farthest = w + reach(2);
		if (!(nearest > 0.0f))
			return frame;
		float edges[2][2];
		for (int axis = 0; axis < 2; ++axis)
		{
			const float low = QVector4D::dotProduct(rows[axis], centre) - reach(axis);
			const float high = low + 2.0f * reach(axis);
			edges[axis][0] = low / (low < 0.0f ? nearest : farthest);
			edges[axis][1] = high / (high > 0.0f ? nearest : farthest);
		}
		const auto pixel = [](float i_Edge, int i_Size)
		{ return (0.5 * static_cast<double>(std::clamp(i_Edge, -2.0f, 2.0f)) + 0.5) * i_Size; };
		all |= QRectF(QPointF(pixel(edges[0][0], i_rFrame.width()), pixel(edges[1][0], i_rFrame.height())),
		    QPointF(pixel(edges[0][1], i_rFrame.width()), pixel(edges[1][1], i_rFrame.height())));
	}
	return all.toAlignedRect() & frame;
}

} // namespace OrlexGraphics
