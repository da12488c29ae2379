#include "CoreGraphics/RenderContext.h"
#include "OrlexGraphics/frame/FrameRenderer.h"
#include "OrlexGraphics/item/Samples.h"
#include "OrlexGraphics/stage/SphereHelper.h"
#include "SceneFixture.h"
#include "ViewFixture.h"

#include <QImage>

#include <cmath>
#include <memory>

namespace
{

using OrlexGraphics::VFrameRenderer;

/// In a row, 20 pixels apart, of radii in pixels.
void AddSpheres(const std::vector<double>& i_rRadii, VBoxScene& io_rScene)
{
	for (std::uint32_t i = 0; const double radius : i_rRadii)
	{
		const QPointF middle(20.0 * i + 20.5, 120.5), reach(radius, radius);
		io_rScene.m_Next.m_Boxes.push_back({Item(100 + i++), {middle - reach, middle + reach}, 0.0f, {1, 1, 1, 1},
		    OrlexGraphics::EPassOpaque, {}, true});
	}
}

class Offscreen : public VSceneTest
{
protected:
	Offscreen() : VSceneTest(QSize(200, 160)) {}

	void SetUp() override
	{
		ASSERT_NO_FATAL_FAILURE(VSceneTest::SetUp());
		m_pScene = Show<VBoxScene>();
		m_pScene->m_Size = m_Size;
		Camera().m_Type = CoreGraphics::ECameraFront;
		Camera().SetSize(m_Size);
	}

	std::vector<std::uint32_t> Picked(const QPoint& i_rMouse, const std::optional<QPoint>& i_rStart = {})
	{
		return Indices(Pick(i_rMouse, i_rStart));
	}

	std::shared_ptr<VBoxScene> m_pScene;
};

INSTANTIATE_IN_BOTH_DIALECTS(Offscreen);

TEST(Samples, LeaveFramebuffersOfOtherContextsAlone)
{
	GraphicsTest::VOffscreenContext first(GraphicsTest::EDialect::Desktop);
	if (!OrlexGraphics::VSamples::AreReadable())
		GTEST_SKIP() << "no textures of samples here";
	auto pSamples = std::make_unique<OrlexGraphics::VSamples>();
	QOpenGLFramebufferObjectFormat format;
	format.setSamples(4);
	pSamples->Make(QSize(8, 8), format);
	ASSERT_TRUE(pSamples->AreThere());
	// A view that was moved to another window has them for a little longer than their context.
	GraphicsTest::VOffscreenContext second(GraphicsTest::EDialect::Desktop);
	const QOpenGLFramebufferObject other(8, 8);
	EXPECT_EQ(other.handle(), pSamples->Framebuffer()) << "of the same name";
	pSamples.reset();
	EXPECT_TRUE(second.GL().glIsFramebuffer(other.handle()));
}

TEST_P(Offscreen, DrawsAndPicksWithoutAWindow)
{
	m_pScene->m_Next.m_Boxes = {{Item(1), {20, 20, 40, 40}}, {Item(2), {100, 20, 40, 40}}, {Item(3), {100, 123, 1, 1}},
	    {Item(4), {100, 117, 1, 1}}, {Item(5), {50, 136, 1, 1}}};
	m_pSelection->Selection().Replace({Item(1)});
	Frame();
	// Samples and channels of what is drawn into.
	const bool bES2 = GetParam() == GraphicsTest::EDialect::ES2;
	for (const bool bCameraView : {true, false})
	{
		Options().m_bCameraView = bCameraView;
		const QOpenGLFramebufferObjectFormat format = m_Renderer.TargetFormat();
		EXPECT_EQ(format.samples(), bES2 || bCameraView ? 0 : 4);
		EXPECT_EQ(format.attachment(), QOpenGLFramebufferObject::Depth);
		EXPECT_EQ(format.internalTextureFormat(), static_cast<GLenum>(bES2 ? GL_RGBA : GL_RGB));
	}
	const QImage image = m_pTarget->toImage();
	EXPECT_EQ(image.pixel(40, 40), 0xff4040ffu);
	EXPECT_EQ(image.pixel(120, 40), 0xff0000ffu);
	EXPECT_EQ(image.pixel(190, 150), 0xff202020u);
	EXPECT_EQ(Picked({120, 40}), std::vector<std::uint32_t>{2});
	EXPECT_EQ(Picked({80, 120}), std::vector<std::uint32_t>{});
	EXPECT_EQ(Picked({100, 120}), std::vector<std::uint32_t>{3}) << "of equally far ones the first row from the bottom";
	EXPECT_EQ(Picked({50, 130}), std::vector<std::uint32_t>{}) << "six pixels are too far";
	EXPECT_EQ(Picked({10, 10}, QPoint(150, 100)), (std::vector<std::uint32_t>{1, 2}));
}

TEST_P(Offscreen, PicksRectanglesExactlyOrThroughLayers)
{
	m_pScene->m_Next.m_Boxes = {{Item(1), {20, 20, 40, 40}}, {Item(2), {30, 30, 20, 20}, 10.0f},
	    {Item(3), {100, 20, 40, 40}}, {Item(4), {103, 23, 34, 34}, -10.0f}};
	const struct
	{
		const char* m_pName;
		QPoint m_A;
		QPoint m_B;
		std::vector<std::uint32_t> m_Layers;
		std::vector<std::uint32_t> m_Exact;
	} rows[] = {
	    {"both", {10, 10}, {70, 70}, {1, 2}, {1, 2}},
	    {"within the nearer one", {35, 35}, {45, 45}, {2, 1}, {2}},
	    {"a hidden one", {110, 30}, {130, 50}, {3, 4}, {3}},
	    {"beside it by a scaled pixel", {64, 10}, {96, 70}, {}, {}},
	};
	for (const std::uint32_t type : {CoreGraphics::ECameraFront, CoreGraphics::ECameraPerspective})
	{
		// From the front, 4 mm a pixel in the plane of the boxes. Its scale of an exact pick is below a half.
		Camera().m_Type = type;
		Camera().m_Pitch = -90.0f;
		Camera().m_Yaw = 180.0f;
		Camera().m_Distance = 772.5f;
		Frame();
		for (const auto& rRow : rows)
			for (const bool bExact : {false, true})
			{
				m_pScene->m_bExactPick = bExact;
				EXPECT_EQ(Picked(rRow.m_B, rRow.m_A), bExact ? rRow.m_Exact : rRow.m_Layers)
				    << rRow.m_pName << (bExact ? ", exactly" : ", through layers");
			}
	}
}

TEST_P(Offscreen, DrawsSpheresByTheirSizeOnScreen)
{
	AddSpheres({0.0, 0.5, 1.3, 3.0, 9.0}, *m_pScene);
	Frame();
	const QImage image = m_pTarget->toImage();
	const auto lit = [&](int i_Index)
	{
		int pixels = 0;
		for (int y = 110; y < 131; ++y)
			for (int x = 10; x < 31; ++x)
				pixels += qRed(image.pixel(20 * i_Index + x, y)) > 0x30 ? 1 : 0;
		return pixels;
	};
	EXPECT_EQ(lit(0), 0) << "nothing";
	EXPECT_GE(lit(1), 1) << "a point";
	EXPECT_LE(lit(1), 16);
	EXPECT_EQ(lit(1), lit(2)) << "a point";
	EXPECT_GT(lit(3), lit(2)) << "a mesh";
	EXPECT_NEAR(lit(4), 254, 40) << "the disc";

	for (std::uint32_t i = 1; i < 5; ++i)
		EXPECT_EQ(Picked({20 + 20 * static_cast<int>(i), 120}), std::vector<std::uint32_t>{100 + i}) << i;
	EXPECT_EQ(Picked({0, 100}, QPoint(199, 140)).size(), 5u);
	EXPECT_EQ(Picked({50, 100}, QPoint(70, 140)), std::vector<std::uint32_t>{102});
}

TEST(SphereHelper, ChoosesTheMeshByTheEdgesOnScreen)
{
	// Chords of a circle of radius 1 cut in 4, 8, 16, 32: an edge is to be 2 pixels long.
	const double chords[] = {std::sqrt(2.0), 0.7653668647, 0.3901806440, 0.1960342807};
	for (int level = 0; level < 4; ++level)
	{
		const double radius = 2.0 / chords[level];
		EXPECT_EQ(OrlexGraphics::VSphereHelper::Level(static_cast<float>(radius * 0.999), 3), level - 1);
		EXPECT_EQ(OrlexGraphics::VSphereHelper::Level(static_cast<float>(radius * 1.001), 3), level);
	}
	EXPECT_EQ(OrlexGraphics::VSphereHelper::Level(1e6f, 1), 1);
	EXPECT_EQ(OrlexGraphics::VSphereHelper::Level(1e6f, 9), 3);
	EXPECT_EQ(OrlexGraphics::VSphereHelper::Level(-1.0f, 3), -1);
}

TEST_P(Offscreen, WalksOverWhatDoesNotChange)
{
	for (std::uint32_t i = 0; i < 40; ++i)
		m_pScene->m_Next.m_Boxes.push_back({Item(i), QRectF(4 * i, 20, 3, 3)});
	AddSpheres({0.5, 1.0, 3.0, 9.0}, *m_pScene);
	m_pSelection->Selection().Replace({Item(1), Item(2)});
	Frame();
	ExpectThatAFrameIsAWalk();
}

TEST_P(Offscreen, GoesOnInAContextThatSharesNothing)
{
	m_pScene->m_Next.m_Boxes = {{Item(1), {20, 20, 40, 40}}};
	AddSpheres({1.0, 9.0}, *m_pScene);
	m_pSelection->Selection().Replace({Item(1)});
	Frame();
	const QImage before = m_pTarget->toImage();
	GraphicsTest::VOffscreenContext other(GetParam());
	ASSERT_TRUE(other.IsValid());
	other.MakeCurrent();
	{
		VFrameRenderer renderer;
		renderer.Initialise();
		renderer.m_Input.m_Camera = Camera();
		renderer.SetScene(m_pScene);
		renderer.SetSize(m_Size);
		QOpenGLFramebufferObject target(m_Size, renderer.TargetFormat());
		m_pScene->Synchronise();
		renderer.Update();
		renderer.Render(target);
		EXPECT_EQ(target.toImage(), before);
		EXPECT_EQ(other.GL().glGetError(), static_cast<GLenum>(GL_NO_ERROR));
	}
	m_Context.MakeCurrent();
}

} // namespace
