#pragma once

#include "../CoreGraphics/OffscreenContext.h"

#include "CoreGraphics/CameraController.h"
#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "OrlexGraphics/IRenderType.h"
#include "OrlexGraphics/SceneOptions.h"

#include <QColor>
#include <QOpenGLFramebufferObject>

#include <array>
#include <cstdlib>
#include <vector>

/// Draws one render type alone, in one pass, 400 by 300 pixels over a grey background.
class VDrawTest : public GraphicsTest::InBothDialects
{
protected:
	static constexpr int c_Width = 400;
	static constexpr int c_Height = 300;
	static constexpr int c_Background = 40;

	using VColour = std::array<int, 3>;

	void SetUp() override
	{
		InBothDialects::SetUp();
		m_Library.InitialiseGL();
		m_Render.Initialise();
		m_Render.ResetState();
		m_pTarget = std::make_unique<QOpenGLFramebufferObject>(c_Width, c_Height, QOpenGLFramebufferObject::Depth);
		m_Render.BindFramebuffer(m_pTarget.get());
		// From +X, with Y to the right and Z up, 10 mm a pixel, the origin in the middle of the picture.
		m_Camera.m_Type = CoreGraphics::ECameraRight;
		m_Camera.m_OrthographicScale = 10.0f;
		m_Camera.SetSize(QSize(c_Width, c_Height));
	}

	void Draw(OrlexGraphics::IRenderType& io_rType, std::uint32_t i_Pass)
	{
		m_Camera.Update();
		m_Camera.Apply(m_Render);
		m_Render.SetYUp(m_Camera.m_bYUp);
		const int grey = m_Render.m_Mode == CoreGraphics::ERenderNormal ? c_Background : 0;
		m_Render.SetClearColour(QColor(grey, grey, grey));
		m_Render.ClearBuffers(true, true);
		io_rType.Render(m_Render, m_Options, i_Pass);
		m_Render.ReadPixels(QRect(0, 0, c_Width, c_Height), m_Pixels);
	}

	/// From the lower left corner.
	VColour Pixel(int i_X, int i_Y) const
	{
		const auto first = m_Pixels.begin() + 4 * (i_Y * c_Width + i_X);
		return {first[0], first[1], first[2]};
	}

	std::uint32_t Id(int i_X, int i_Y) const
	{
		const VColour pixel = Pixel(i_X, i_Y);
		return static_cast<std::uint32_t>(pixel[0] | pixel[1] << 8 | pixel[2] << 16);
	}

	/// Of what was drawn; the camera and the mode must be those of the last picture.
	QRect Extent() const
	{
		const int grey = m_Render.m_Mode == CoreGraphics::ERenderNormal ? c_Background : 0;
		QRect extent;
		for (int y = 0; y < c_Height; ++y)
		{
			for (int x = 0; x < c_Width; ++x)
			{
				if (Pixel(x, y) != VColour{grey, grey, grey})
					extent |= QRect(x, y, 1, 1);
			}
		}
		return extent;
	}

	/// Edges that lie between two pixels may fall to either.
	static void ExpectNear(const QRect& i_rActual, const QRect& i_rExpected, int i_Tolerance = 1)
	{
		EXPECT_NEAR(i_rActual.left(), i_rExpected.left(), i_Tolerance);
		EXPECT_NEAR(i_rActual.right(), i_rExpected.right(), i_Tolerance);
		EXPECT_NEAR(i_rActual.top(), i_rExpected.top(), i_Tolerance);
		EXPECT_NEAR(i_rActual.bottom(), i_rExpected.bottom(), i_Tolerance);
	}

	CoreGraphics::VShaderLibrary m_Library;
	CoreGraphics::VRenderContext m_Render;
	CoreGraphics::VCameraController m_Camera;
	OrlexGraphics::VSceneOptions m_Options;
	std::unique_ptr<QOpenGLFramebufferObject> m_pTarget;
	std::vector<std::uint8_t> m_Pixels;
};
