#pragma once

#include "../CoreGraphics/DrawingFixture.h"

#include "CoreGraphics/CameraController.h"
#include "InMemoryHost/Selection.h"
#include "OrlexGraphics/frame/IRenderType.h"
#include "OrlexGraphics/frame/SceneOptions.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"

#include <QColor>

#include <array>
#include <cstdint>
#include <cstring>
#include <memory>
#include <string>
#include <utility>
#include <vector>

/// What is under the hand.
inline constexpr std::array<int, 3> c_Yellow{255, 255, 0};

/// One render type, drawn without a scene.
class VRenderTypeTest : public GraphicsTest::VDrawingTest
{
protected:
	using VColour = std::array<int, 3>;

	explicit VRenderTypeTest(const QSize& i_rSize) : VDrawingTest(i_rSize) { m_Camera.SetSize(i_rSize); }

	/// A frame update begins.
	void BeginFrame()
	{
		m_pRegistry->SetSelection(m_pSelection->Selection().Items(), m_pSelection->PreSelection().Items());
		m_pRegistry->Reset();
		m_pRegistry->ClearExcluded();
	}

	/// One pass over a background, which is black for ids.
	/// @return whether anything was drawn
	bool Draw(
	    OrlexGraphics::IRenderType& io_rType, std::uint32_t i_Pass, std::uint32_t i_Mode = CoreGraphics::ERenderNormal)
	{
		m_Camera.Update();
		m_Camera.Apply(m_Render);
		m_Render.SetYUp(m_Camera.m_bYUp);
		m_Render.m_Mode = i_Mode;
		m_Render.SetClearColour(i_Mode == CoreGraphics::ERenderNormal ? m_Background : Qt::black);
		m_Render.ClearBuffers(true, true);
		io_rType.Render(m_Render, m_Options, i_Pass);
		Read();
		EXPECT_EQ(m_Render.m_Viewport, QRect(QPoint(), m_Size));
		// Each pixel is like the one before it.
		return std::memcmp(m_Pixels.data(), m_Pixels.data() + 4, m_Pixels.size() - 4) != 0;
	}

	/// The exchange before a frame update, and what of that is the manipulator's.
	template <typename TManipulator>
	void Update(TManipulator& io_rManipulator)
	{
		io_rManipulator.Synchronise();
		BeginFrame();
		io_rManipulator.AllocateIds();
	}
	template <typename TManipulator>
	void DrawFrame(TManipulator& io_rManipulator, std::uint32_t i_Mode = CoreGraphics::ERenderNormal)
	{
		Update(io_rManipulator);
		Draw(io_rManipulator, OrlexGraphics::EPassOverlay, i_Mode);
	}

	/// Where it draws: the pass, and the mode where that is not the normal one.
	std::string DrawnIn(OrlexGraphics::IRenderType& io_rType)
	{
		std::string drawn;
		for (const auto& [mode, pMode] : {std::pair(CoreGraphics::ERenderNormal, ""),
		         {CoreGraphics::ERenderPick, " pick"}, {CoreGraphics::ERenderId, " id"}})
			for (const auto& [pass, pPass] : {std::pair(OrlexGraphics::EPassOpaque, "opaque"),
			         {OrlexGraphics::EPassTransparent, "transparent"}, {OrlexGraphics::EPassOverlay, "overlay"}})
				if (Draw(io_rType, pass, mode))
					drawn += (drawn.empty() ? "" : ", ") + std::string(pPass) + pMode;
		return drawn;
	}

	void Read() { m_Render.ReadPixels(QRect(QPoint(), m_Size), m_Pixels); }

	/// From the lower left corner.
	VColour Pixel(int i_X, int i_Y) const
	{
		const std::uint8_t* const pPixel = m_Pixels.data() + 4 * (i_Y * m_Size.width() + i_X);
		return {pPixel[0], pPixel[1], pPixel[2]};
	}

	/// Where the pixels are of which it holds.
	template <typename TCondition>
	QRect Extent(const TCondition& i_rCondition) const
	{
		QRect extent;
		for (int y = 0; y < m_Size.height(); ++y)
		{
			for (int x = 0; x < m_Size.width(); ++x)
			{
				if (i_rCondition(Pixel(x, y)))
					extent |= QRect(x, y, 1, 1);
			}
		}
		return extent;
	}

	/// What is not background, from the lower left corner.
	QRect Drawn() const
	{
		const VColour background{m_Background.red(), m_Background.green(), m_Background.blue()};
		return Extent([&](const VColour& i_rPixel) { return i_rPixel != background; });
	}

	/// Edges that lie between two pixels may fall to either.
	static void ExpectNear(const QRect& i_rActual, const QRect& i_rExpected, double i_Tolerance = 1.0)
	{
		EXPECT_NEAR(i_rActual.left(), i_rExpected.left(), i_Tolerance);
		EXPECT_NEAR(i_rActual.right(), i_rExpected.right(), i_Tolerance);
		EXPECT_NEAR(i_rActual.top(), i_rExpected.top(), i_Tolerance);
		EXPECT_NEAR(i_rActual.bottom(), i_rExpected.bottom(), i_Tolerance);
	}

	NVX::ISelectionItem ItemAt(int i_X, int i_Y) const
	{
		const VColour pixel = Pixel(i_X, i_Y);
		NVX::ISelectionItem item;
		m_pRegistry->ResolveId(static_cast<std::uint32_t>(pixel[0] | pixel[1] << 8 | pixel[2] << 16), item);
		return item;
	}

	QColor m_Background{40, 40, 40};
	const std::shared_ptr<InMemoryHost::VSelectionManager> m_pSelection =
	    std::make_shared<InMemoryHost::VSelectionManager>();
	const std::shared_ptr<OrlexGraphics::VSelectionRegistry> m_pRegistry =
	    std::make_shared<OrlexGraphics::VSelectionRegistry>();
	CoreGraphics::VCameraController m_Camera;
	OrlexGraphics::VSceneOptions m_Options;
	std::vector<std::uint8_t> m_Pixels;
};
