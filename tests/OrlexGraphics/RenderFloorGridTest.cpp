#include "RenderTypeFixture.h"

#include "OrlexGraphics/stage/RenderAxis.h"
#include "OrlexGraphics/stage/RenderFloorGrid.h"

#include <algorithm>
#include <limits>

using namespace OrlexGraphics;

namespace
{

constexpr int c_FloorWidth = 600;
constexpr int c_FloorHeight = 400;

/// The floor and the corner's axes over a grey background.
class RenderFloor : public VRenderTypeTest
{
protected:
	RenderFloor() : VRenderTypeTest(QSize(c_FloorWidth, c_FloorHeight)) {}

	void SetUp() override
	{
		VRenderTypeTest::SetUp();
		m_pFloor = std::make_unique<VRenderFloorGrid>(m_Library);
		m_pAxis = std::make_unique<VRenderAxis>(m_Library);
		// 20 mm a pixel, the origin in the middle.
		m_Camera.m_OrthographicScale = 20.0f;
		m_Camera.m_Type = CoreGraphics::ECameraTop;
	}

	std::unique_ptr<VRenderFloorGrid> m_pFloor;
	std::unique_ptr<VRenderAxis> m_pAxis;
};
INSTANTIATE_IN_BOTH_DIALECTS(RenderFloor);

} // namespace

TEST_P(RenderFloor, IsOpaqueOrSeenThroughFromEitherSide)
{
	struct VRow
	{
		std::uint32_t m_Type;
		bool m_bTranslucent;
		float m_Alpha;
	};
	const VRow rows[] = {{CoreGraphics::ECameraTop, true, 0.75f}, {CoreGraphics::ECameraBottom, true, 0.25f},
	    {CoreGraphics::ECameraTop, false, 1.0f}, {CoreGraphics::ECameraBottom, false, 1.0f}};
	m_Background = QColor(100, 100, 100);
	// 5 mm a pixel: 300 pixels, from the middle.
	m_Camera.m_OrthographicScale = 5.0f;
	m_pFloor->SetFloor(VFloor{-750, -750, 750, 750, 500.0f, 10});
	for (const bool bYUp : {false, true})
	{
		for (const VRow& rRow : rows)
		{
			SCOPED_TRACE(testing::Message() << rRow.m_Type << rRow.m_bTranslucent << bYUp);
			m_Camera.m_Type = rRow.m_Type;
			m_Camera.m_bYUp = bYUp;
			m_Options.m_bFloorGridIsTranslucent = rRow.m_bTranslucent;
			EXPECT_FALSE(Draw(*m_pFloor, rRow.m_bTranslucent ? EPassOpaque : EPassTransparent));
			Draw(*m_pFloor, rRow.m_bTranslucent ? EPassTransparent : EPassOpaque);
			ExpectNear(Drawn(), QRect(150, 50, 301, 301));
			// Halfway between all lines a grey of 0.2, over the background.
			const float expected = rRow.m_Alpha * 51.0f + (1.0f - rRow.m_Alpha) * 100.0f;
			EXPECT_NEAR(static_cast<float>(Pixel(300 + 55, 200 + 45)[0]), expected, 3.0f);
			// The strips along the axes, and the edge, are not seen through.
			const int edge = Drawn().left();
			for (const VColour& rColour : {Pixel(300, 325), Pixel(399, 200), Pixel(edge, 325)})
			{
				for (const int channel : rColour)
					EXPECT_NEAR(channel, 128, 1);
			}
			// A large line at 500 mm is brighter than what lies beside it.
			EXPECT_GT(std::max({Pixel(399, 245)[0], Pixel(400, 245)[0]}), Pixel(395, 245)[0] + 10);
		}
	}
}

TEST_P(RenderFloor, LinesCountAsMuchAsTheyCover)
{
	// Lines are 4 mm and 2 mm wide.
	m_pFloor->SetFloor(VFloor{-100000, -100000, 100000, 100000, 1024.0f, 2});
	m_Options.m_bFloorGridIsTranslucent = false;
	struct VRow
	{
		float m_Scale;
		/// Of a pixel beside the line at 1024 mm.
		float m_Large;
		float m_Small;
	};
	for (const bool bSoftware : {true, false})
	{
		m_Render.m_bSoftware = bSoftware;
		for (const bool bYUp : {false, true})
		{
			m_Camera.m_bYUp = bYUp;
			for (const VRow& rRow :
			    {VRow{4.0f, 0.5f, 0.25f}, {8.0f, 0.25f, 0.125f}, {16.0f, 0.125f, 0.0625f}, {32.0f, 0.0625f, 0.03125f}})
			{
				SCOPED_TRACE(testing::Message() << bSoftware << bYUp << rRow.m_Scale);
				m_Camera.m_OrthographicScale = rRow.m_Scale;
				Draw(*m_pFloor, EPassOpaque);
				const float grey = 255.0f * (0.2f + rRow.m_Large + 0.5f * rRow.m_Small);
				// A line across and one up; the others are far.
				const int line = static_cast<int>(1024.0f / rRow.m_Scale);
				const int beside = std::max(static_cast<int>(256.0f / rRow.m_Scale), 4);
				for (const int at : {-line - 1, -line, line - 1, line})
				{
					EXPECT_NEAR(Pixel(c_FloorWidth / 2 + at, c_FloorHeight / 2 + beside)[0], grey, 2.0f);
					if (std::abs(at) < c_FloorHeight / 2)
					{
						EXPECT_NEAR(Pixel(c_FloorWidth / 2 + beside, c_FloorHeight / 2 + at)[0], grey, 2.0f);
					}
				}
			}
		}
	}
}

TEST_P(RenderFloor, LinesTurnWithTheCamera)
{
	// Seen at a slant, a camera that is rolled by a quarter has the same pixels, a quarter further.
	constexpr int c_Square = 400;
	m_pFloor->SetFloor(VFloor{-100000, -100000, 100000, 100000, 1024.0f, 2});
	m_Options.m_bFloorGridIsTranslucent = false;
	QMatrix4x4 view;
	view.lookAt({300.0f, -1700.0f, 1500.0f}, {1400.0f, 900.0f, 0.0f}, {0.0f, 0.0f, 1.0f});
	std::vector<VColour> level, rolled;
	for (std::vector<VColour>* const pPicture : {&level, &rolled})
	{
		m_Render.SetViewport(QRect(0, 0, c_Square, c_Square));
		m_Render.SetYUp(false);
		m_Render.m_Projection.setToIdentity();
		m_Render.m_Projection.perspective(45.0f, 1.0f, 1.0f, 100000.0f);
		m_Render.m_View.setToIdentity();
		m_Render.m_View.rotate(pPicture == &rolled ? 90.0f : 0.0f, 0.0f, 0.0f, 1.0f);
		m_Render.m_View *= view;
		m_Render.ClearBuffers(true, true);
		m_pFloor->Render(m_Render, m_Options, EPassOpaque);
		Read();
		for (int y = 0; y < c_Square; ++y)
		{
			for (int x = 0; x < c_Square; ++x)
				pPicture->push_back(pPicture == &level ? Pixel(x, y) : Pixel(c_Square - 1 - y, x));
		}
	}
	m_Render.SetViewport(QRect(QPoint(), m_Size));
	int bright = 0, others = 0;
	for (std::size_t i = 0; i < level.size(); ++i)
	{
		bright += level[i][0] > 60;
		others += std::abs(level[i][0] - rolled[i][0]) > 3;
	}
	EXPECT_GT(bright, 1000);
	// The edges of the strips along the axes may fall to either side.
	EXPECT_LT(others, 100);
}

TEST_P(RenderFloor, IsDrawnWithItsOptionForTheEyeAlone)
{
	EXPECT_EQ(DrawnIn(*m_pFloor), "transparent");
	EXPECT_EQ(DrawnIn(*m_pAxis), "overlay");
	m_Options.m_bFloorGridIsTranslucent = false;
	EXPECT_EQ(DrawnIn(*m_pFloor), "opaque");
	m_Options.m_OverlayCamera = "camera";
	EXPECT_EQ(DrawnIn(*m_pFloor), "opaque");
	EXPECT_EQ(DrawnIn(*m_pAxis), "");
	m_Options.m_OverlayCamera.clear();
	m_Options.m_bFloorGrid = m_Options.m_bGlobalAxis = false;
	EXPECT_EQ(DrawnIn(*m_pFloor), "");
	EXPECT_EQ(DrawnIn(*m_pAxis), "");
}

TEST_P(RenderFloor, TakesTheFloorThatItIsGiven)
{
	struct VRow
	{
		float m_Metres;
		VFloor m_Expected;
	};
	const float infinity = std::numeric_limits<float>::infinity();
	for (const VRow& rRow : {VRow{6.0f, {-3000, -3000, 3000, 3000, 1000.0f, 10}}, {0.5f, {-250, -250, 250, 250}},
	         {-1.0f, {0, 0, 0, 0}}, {std::numeric_limits<float>::quiet_NaN(), {0, 0, 0, 0}},
	         {infinity, {-1000000000, -1000000000, 1000000000, 1000000000}}})
	{
		m_Options.m_FloorGridSize = rRow.m_Metres;
		EXPECT_EQ(m_pFloor->GetFloor(m_Options), rRow.m_Expected) << rRow.m_Metres;
	}
	const VFloor given{-1000, -2000, 3000, 400, 500.0f, 5};
	m_pFloor->SetFloor(given);
	EXPECT_EQ(m_pFloor->GetFloor(m_Options), given);
	Draw(*m_pFloor, EPassTransparent);
	// From above, with X to the left and Y down.
	ExpectNear(Drawn(), QRect(150, 180, 201, 121));
}

TEST_P(RenderFloor, AnOpaqueFloorHidesWhatIsBelowATranslucentOneDoesNot)
{
	for (const bool bTranslucent : {false, true})
	{
		m_Options.m_bFloorGridIsTranslucent = bTranslucent;
		Draw(*m_pFloor, bTranslucent ? EPassTransparent : EPassOpaque);
		// A second floor, a hair below the first, is another one only where nothing wrote depth.
		const std::vector<std::uint8_t> once = m_Pixels;
		m_Camera.m_Centre.setZ(100.0f);
		m_Camera.Update();
		m_Camera.Apply(m_Render);
		m_pFloor->Render(m_Render, m_Options, bTranslucent ? EPassTransparent : EPassOpaque);
		Read();
		EXPECT_EQ(m_Pixels == once, !bTranslucent);
		m_Camera.m_Centre.setZ(0.0f);
	}
}

TEST_P(RenderFloor, AxesStandInTheCorner)
{
	for (const auto& [rViewport, ratio, rCorner] : {std::tuple(QRect(0, 0, 600, 400), 1.0f, QRect(0, 0, 100, 100)),
	         {QRect(0, 0, 4000, 3000), 1.0f, QRect(0, 0, 100, 100)},
	         {QRect(0, 0, 4000, 3000), 2.0f, QRect(0, 0, 200, 200)},
	         {QRect(10, 20, 300, 200), 2.0f, QRect(10, 20, 50, 50)}, {QRect(0, 0, 0, 0), 1.0f, QRect(0, 0, 0, 0)}})
		EXPECT_EQ(VRenderAxis::Corner(rViewport, ratio), rCorner);

	// From the right: Y points to the right, Z up, X at the eye.
	m_Camera.m_Type = CoreGraphics::ECameraRight;
	Draw(*m_pAxis, EPassOverlay);
	EXPECT_TRUE(QRect(0, 0, 100, 100).contains(Drawn()));
	EXPECT_NEAR(Drawn().right(), 90, 1);
	EXPECT_NEAR(Drawn().bottom(), 90, 1);
	EXPECT_EQ(std::max(Pixel(70, 49), Pixel(70, 50),
	              [](const VColour& i_rA, const VColour& i_rB) { return i_rA[1] < i_rB[1]; }),
	    (VColour{0, 255, 0}));
	EXPECT_EQ(std::max(Pixel(49, 70), Pixel(50, 70),
	              [](const VColour& i_rA, const VColour& i_rB) { return i_rA[2] < i_rB[2]; }),
	    (VColour{0, 0, 255}));
	// Where the camera is has no part in it.
	const std::vector<std::uint8_t> before = m_Pixels;
	m_Camera.m_Centre = QVector3D(5000, -300, 80);
	Draw(*m_pAxis, EPassOverlay);
	EXPECT_EQ(m_Pixels, before);
}
