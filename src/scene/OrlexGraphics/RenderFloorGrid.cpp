#include "OrlexGraphics/RenderFloorGrid.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "CoreGraphics/Texture.h"
#include "OrlexGraphics/SceneOptions.h"

#include <QOpenGLFunctions>

#include <algorithm>
#include <cmath>
#include <vector>

namespace OrlexGraphics
{

using CoreGraphics::VRenderContext;

namespace
{

constexpr int c_TextureSide = 1024;
// The line at each edge of a tile, in texels.
constexpr int c_LineWidth = 2;
constexpr float c_Anisotropy = 16.0f;

const QVector4D c_EdgeColour(0.5f, 0.5f, 0.5f, 1.0f);
// Of the strips along the two axes, in millimetres.
constexpr float c_HalfStripWidth = 10.0f;

constexpr float c_MillimetresOfMetre = 1000.0f;

/// A square of lines; its tiles are a grid.
std::unique_ptr<CoreGraphics::VTexture> MakeTexture()
{
	std::vector<std::uint8_t> texels(std::size_t{c_TextureSide} * c_TextureSide, 0);
	const auto isEdge = [](int i_Texel) { return i_Texel < c_LineWidth || i_Texel >= c_TextureSide - c_LineWidth; };
	for (int y = 0; y < c_TextureSide; ++y)
	{
		for (int x = 0; x < c_TextureSide; ++x)
		{
			if (isEdge(x) || isEdge(y))
				texels[static_cast<std::size_t>(y) * c_TextureSide + static_cast<std::size_t>(x)] = 255;
		}
	}
	auto pTexture = std::make_unique<CoreGraphics::VTexture>(
	    CoreGraphics::FormOf(CoreGraphics::EPixelFormat::Grey8).m_InternalFormat, QSize(c_TextureSide, c_TextureSide),
	    true);
	pTexture->Upload(texels.data());
	return pTexture;
}

QVector4D ExtentsOf(const VFloor& i_rFloor)
{
	return {static_cast<float>(i_rFloor.m_X0), static_cast<float>(i_rFloor.m_Y0), static_cast<float>(i_rFloor.m_X1),
	    static_cast<float>(i_rFloor.m_Y1)};
}

CoreGraphics::VRenderState StateOf(bool i_bTranslucent)
{
	CoreGraphics::VRenderState state;
	state.m_ColourBlend = i_bTranslucent ? CoreGraphics::EColourBlendAlpha : CoreGraphics::EColourBlendOff;
	state.m_bDepthTest = true;
	state.m_DepthFunction = CoreGraphics::EDepthLessEqual;
	state.m_bDepthWrite = !i_bTranslucent;
	return state;
}

} // namespace

VRenderFloorGrid::VRenderFloorGrid(CoreGraphics::VShaderLibrary& io_rLibrary)
    : m_pLines(io_rLibrary.GetProgram("FloorGrid", "FloorGrid")),
      m_pEdges(io_rLibrary.GetProgram("FloorGrid", "UniformColour")),
      m_Square(
          CoreGraphics::VVertexFormat::Format2D(), CoreGraphics::BytesOf(std::vector<float>{0, 0, 1, 0, 1, 1, 0, 1}))
{
}

VRenderFloorGrid::~VRenderFloorGrid() = default;

VFloor VRenderFloorGrid::GetFloor(const VSceneOptions& i_rOptions) const
{
	if (m_Floor)
		return *m_Floor;
	// The largest floor that whole millimetres can tell, whatever the options ask for.
	const float half = std::clamp(0.5f * i_rOptions.m_FloorGridSize * c_MillimetresOfMetre, 0.0f, 1e9f);
	const auto side = static_cast<std::int32_t>(std::lround(std::isnan(half) ? 0.0f : half));
	return {-side, -side, side, side};
}

void VRenderFloorGrid::Render(VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass)
{
	const bool bTranslucent = i_rOptions.m_bFloorGridIsTranslucent;
	if (io_rContext.m_Mode != CoreGraphics::ERenderNormal || !i_rOptions.m_bFloorGrid
	    || i_Pass != (bTranslucent ? EPassTransparent : EPassOpaque))
		return;
	const VFloor floor = GetFloor(i_rOptions);
	io_rContext.ApplyState(StateOf(bTranslucent));
	// What lies on the floor is not to fight with it, nor its strips with its lines: from far away, depth tells no two
	// places apart that are a plate's thickness from each other.
	io_rContext.m_pFunctions->glEnable(GL_POLYGON_OFFSET_FILL);
	RenderLines(io_rContext, floor);
	RenderEdges(io_rContext, floor);
	io_rContext.m_pFunctions->glDisable(GL_POLYGON_OFFSET_FILL);
}

void VRenderFloorGrid::RenderLines(VRenderContext& io_rContext, const VFloor& i_rFloor)
{
	if (!m_pTexture || !m_pTexture->IsUsable())
		m_pTexture = MakeTexture();
	if (!io_rContext.UseProgram(m_pLines))
		return;
	CoreGraphics::VTextureSampling sampling;
	// On a processor the two lookups are nearly all that the floor costs, and twice as much between two mipmaps. Half a
	// level less makes it the finer one of the two: the coarser one would blur the lines.
	const bool bOneMipmap = io_rContext.m_bSoftware;
	sampling.m_Minification = bOneMipmap ? CoreGraphics::EMinificationLinearMipmapNearest
	                                     : CoreGraphics::EMinificationLinearMipmapLinear;
	sampling.m_bMagnificationLinear = true;
	sampling.m_Anisotropy = c_Anisotropy;
	m_pTexture->Bind(io_rContext, 0, sampling);
	io_rContext.SetUniform(m_Texture, 0);
	io_rContext.SetUniform(m_LevelBias, bOneMipmap ? -0.5f : 0.0f);
	io_rContext.SetUniform(m_GridSpacings,
	    QVector2D(i_rFloor.m_Spacing, i_rFloor.m_Spacing / static_cast<float>(std::max(i_rFloor.m_Divisions, 1u))));
	io_rContext.BindVertices(m_Square);
	io_rContext.m_pFunctions->glPolygonOffset(2.0f, 4.0f);
	DrawExtents(io_rContext, GL_TRIANGLE_FAN, ExtentsOf(i_rFloor));
}

void VRenderFloorGrid::RenderEdges(VRenderContext& io_rContext, const VFloor& i_rFloor)
{
	if (!io_rContext.UseProgram(m_pEdges))
		return;
	const QVector4D extents = ExtentsOf(i_rFloor);
	io_rContext.SetUniform(m_Colour, c_EdgeColour);
	io_rContext.BindVertices(m_Square);
	DrawExtents(io_rContext, GL_LINE_LOOP, extents);
	io_rContext.m_pFunctions->glPolygonOffset(1.0f, 2.0f);
	DrawExtents(io_rContext, GL_TRIANGLE_FAN, QVector4D(extents.x(), -c_HalfStripWidth, extents.z(), c_HalfStripWidth));
	DrawExtents(io_rContext, GL_TRIANGLE_FAN, QVector4D(-c_HalfStripWidth, extents.y(), c_HalfStripWidth, extents.w()));
}

void VRenderFloorGrid::DrawExtents(VRenderContext& io_rContext, unsigned int i_Mode, const QVector4D& i_rExtents)
{
	io_rContext.SetUniform(m_Extents, i_rExtents);
	io_rContext.DrawArrays(i_Mode, m_Square.Count());
}

} // namespace OrlexGraphics
