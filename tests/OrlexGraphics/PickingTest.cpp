#include "OrlexGraphics/picking/Picking.h"

#include <gtest/gtest.h>

#include <array>

namespace
{

using OrlexGraphics::NearestId;

/// 11 by 11 pixels, or less.
struct VPixels
{
	explicit VPixels(const QSize& i_rSize = {11, 11})
	    : m_Size(i_rSize), m_Bytes(4 * static_cast<std::size_t>(i_rSize.width() * i_rSize.height()))
	{
	}

	VPixels& Set(int i_X, int i_Y, std::uint32_t i_Id)
	{
		std::uint8_t* const pPixel = &m_Bytes[4 * static_cast<std::size_t>(i_Y * m_Size.width() + i_X)];
		for (int i = 0; i < 3; ++i)
			pPixel[i] = static_cast<std::uint8_t>(i_Id >> (8 * i));
		pPixel[3] = 1;
		return *this;
	}

	QSize m_Size;
	std::vector<std::uint8_t> m_Bytes;
};

TEST(Picking, TakesThePixelNearestToTheMouse)
{
	const struct
	{
		const char* m_pName;
		VPixels m_Pixels;
		QPoint m_Mouse;
		std::uint32_t m_Expected;
	} rows[] = {
	    {"nothing", VPixels(), {5, 5}, 0},
	    {"under the mouse", VPixels().Set(5, 5, 3).Set(5, 4, 4), {5, 5}, 3},
	    {"the farthest corner", VPixels().Set(10, 10, 0x123456 & 0x1fffff), {5, 5}, 0x123456},
	    {"nearest of two", VPixels().Set(2, 5, 1).Set(7, 5, 2), {5, 5}, 2},
	    {"a diagonal step is longer than one to the side", VPixels().Set(4, 4, 1).Set(6, 5, 2), {5, 5}, 2},
	    {"equal distances: the first row", VPixels().Set(5, 7, 2).Set(5, 3, 1), {5, 5}, 1},
	    {"equal distances: the first in a row", VPixels().Set(7, 5, 2).Set(3, 5, 1), {5, 5}, 1},
	    {"equal distances over a knight's move", VPixels().Set(6, 7, 2).Set(7, 6, 1), {5, 5}, 1},
	    {"flags are not part of the id", VPixels().Set(5, 5, 0xe00009), {5, 5}, 9},
	    {"flags alone are nothing", VPixels().Set(5, 5, 0x600000).Set(0, 0, 2), {5, 5}, 2},
	    {"cut off at the edge of the frame", VPixels({6, 11}).Set(3, 5, 1).Set(0, 3, 2), {0, 5}, 2},
	};
	for (const auto& rRow : rows)
		EXPECT_EQ(NearestId(rRow.m_Pixels.m_Bytes.data(), rRow.m_Pixels.m_Size, rRow.m_Mouse), rRow.m_Expected)
		    << rRow.m_pName;
}

TEST(Picking, LooksAroundThePoint)
{
	const QSize framebuffer(4096, 4096);
	const struct
	{
		const char* m_pName;
		QPoint m_Mouse;
		int m_FrameHeight;
		QRect m_Expected;
	} rows[] = {
	    {"in the middle", {100, 60}, 160, {95, 95, 11, 11}},
	    {"upper left corner", {0, 0}, 160, {0, 155, 6, 11}},
	    {"lower left corner", {0, 159}, 160, {0, 0, 6, 7}},
	    {"right edge of the framebuffer", {4095, 100}, 4096, {4090, 3991, 6, 11}},
	    {"beyond the framebuffer", {5000, 60}, 160, {}},
	    {"far above", {10, -5000}, 160, {}},
	};
	for (const auto& rRow : rows)
	{
		const QRect found = OrlexGraphics::PointPickRectangle(rRow.m_Mouse, rRow.m_FrameHeight, framebuffer);
		EXPECT_TRUE(found == rRow.m_Expected || (found.isEmpty() && rRow.m_Expected.isEmpty())) << rRow.m_pName;
	}
}

TEST(Picking, PutsTheRectangleIntoTheFrame)
{
	const QSize frame(200, 160);
	const struct
	{
		const char* m_pName;
		QPoint m_A;
		QPoint m_B;
		double m_Scale;
		QRect m_Expected;
	} rows[] = {
	    {"full resolution", {10, 20}, {30, 60}, 1.0, {10, 100, 20, 40}},
	    {"half", {10, 20}, {30, 60}, 0.5, {5, 50, 10, 20}},
	    {"from any corner", {30, 20}, {10, 60}, 0.5, {5, 50, 10, 20}},
	    {"halves are rounded up", {11, 21}, {31, 61}, 0.5, {6, 50, 10, 20}},
	    {"below one pixel", {10, 20}, {10, 60}, 0.5, {}},
	    {"beyond the frame", {-50, -50}, {1000, 1000}, 0.5, {0, 0, 100, 80}},
	};
	for (const auto& rRow : rows)
	{
		const QRect found = OrlexGraphics::RectanglePickRectangle(rRow.m_A, rRow.m_B, rRow.m_Scale, frame);
		EXPECT_TRUE(found == rRow.m_Expected || (found.isEmpty() && rRow.m_Expected.isEmpty()))
		    << rRow.m_pName << " " << found.x() << " " << found.y() << " " << found.width() << " " << found.height();
	}
}

TEST(Picking, TellsAClickFromARectangle)
{
	EXPECT_TRUE(OrlexGraphics::IsPoint({10, 10}, {10, 10}));
	EXPECT_TRUE(OrlexGraphics::IsPoint({10, 10}, {12, 8}));
	EXPECT_FALSE(OrlexGraphics::IsPoint({10, 10}, {13, 10}));
	EXPECT_FALSE(OrlexGraphics::IsPoint({10, 10}, {10, 7}));
}

TEST(Picking, CollectsIdsOnce)
{
	VPixels pixels({6, 1});
	pixels.Set(0, 0, 4).Set(1, 0, 4).Set(3, 0, 2).Set(4, 0, 0x600004).Set(5, 0, 9);
	std::vector<bool> found(3);
	found[2] = true;
	std::vector<std::uint32_t> ids = {2};
	EXPECT_TRUE(OrlexGraphics::CollectIds(pixels.m_Bytes.data(), 6, found, ids));
	EXPECT_EQ(ids, (std::vector<std::uint32_t>{2, 4, 9}));
	EXPECT_FALSE(OrlexGraphics::CollectIds(pixels.m_Bytes.data(), 6, found, ids));
	EXPECT_EQ(ids.size(), 3u);
}

TEST(Picking, NamesTenThingsInTheToolTip)
{
	EXPECT_EQ(OrlexGraphics::ToolTip({}), "");
	EXPECT_EQ(OrlexGraphics::ToolTip({"b", "a"}), "a<br>b");
	std::vector<std::string> names;
	for (char name = 'j'; name >= 'a'; --name)
		names.emplace_back(1, name);
	EXPECT_EQ(OrlexGraphics::ToolTip(names), "a<br>b<br>c<br>d<br>e<br>f<br>g<br>h<br>i<br>j");
	names.emplace_back("k");
	EXPECT_EQ(OrlexGraphics::ToolTip(names), "a<br>b<br>c<br>d<br>e<br>f<br>g<br>h<br>i<br>j<br>...");
}

TEST(Picking, KnowsWhatCannotBeInTheRectangle)
{
	QMatrix4x4 viewProjection;
	viewProjection.perspective(90.0f, 1.0f, 1.0f, 1000.0f);
	// 20 by 20 pixels in the middle of 200: seen from 100 away, 10 to each side.
	const auto frustum = OrlexGraphics::MakePickFrustum(viewProjection, QRect(90, 90, 20, 20), QSize(200, 200));
	const struct
	{
		QVector4D m_Sphere;
		bool m_bInside;
	} rows[] = {
	    {{0, 0, -100, 1}, true},
	    {{10.5f, 0, -100, 1}, true},
	    {{12, 0, -100, 1}, false},
	    {{12, 0, -100, 3}, true},
	    {{0, -12, -100, 1}, false},
	    {{-12, 12, -200, 1}, true},
	    {{0, 0, 100, 1}, false},
	};
	for (const auto& rRow : rows)
		EXPECT_EQ(frustum.Contains(rRow.m_Sphere), rRow.m_bInside)
		    << rRow.m_Sphere.x() << " " << rRow.m_Sphere.y() << " " << rRow.m_Sphere.z();
}

TEST(Picking, KnowsWhereSpheresAreOnTheScreen)
{
	QMatrix4x4 viewProjection;
	viewProjection.perspective(90.0f, 2.0f, 1.0f, 1000.0f);
	const QSize frame(400, 200);
	const struct
	{
		const char* m_pName;
		std::vector<QVector4D> m_Spheres;
		/// What it must hold and what it may hold.
		QRect m_Inner;
		QRect m_Outer;
	} rows[] = {
	    {"nothing", {}, {}, {}},
	    {"in the middle", {{0, 0, -100, 10}}, {190, 90, 20, 20}, {186, 86, 28, 28}},
	    {"two", {{0, 0, -100, 10}, {100, 50, -100, 1}}, {190, 90, 111, 61}, {186, 86, 118, 68}},
	    {"cut off", {{-200, 0, -100, 10}}, {0, 90, 10, 20}, {0, 86, 32, 28}},
	    {"beside the frame", {{-300, 0, -100, 10}}, {}, {}},
	    {"around the eye", {{0, 0, 0, 10}}, {0, 0, 400, 200}, {0, 0, 400, 200}},
	    {"through the plane of the eye", {{500, 0, 5, 10}}, {0, 0, 400, 200}, {0, 0, 400, 200}},
	};
	for (const auto& rRow : rows)
	{
		const QRect found = OrlexGraphics::ScreenRectangle(rRow.m_Spheres, viewProjection, frame);
		EXPECT_TRUE(rRow.m_Inner.isEmpty() ? found.isEmpty() : found.contains(rRow.m_Inner)) << rRow.m_pName;
		EXPECT_TRUE(found.isEmpty() || rRow.m_Outer.contains(found)) << rRow.m_pName;
	}
}

} // namespace
