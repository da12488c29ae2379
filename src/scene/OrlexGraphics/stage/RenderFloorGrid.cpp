#include "OrlexGraphics/stage/RenderFloorGrid.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "CoreGraphics/Texture.h"
#include "OrlexGraphics/frame/SceneOptions.h"

#include <QMatrix4x4>
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
      m_pComputedLines(io_rLibrary.GetProgram("FloorGrid", "FloorGridComputed")),
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

void VRenderFloorGrid::BindTexture(VRenderContext& io_rContext)
{
	if (!m_pTexture || !m_pTexture->IsUsable())
		m_pTexture = MakeTexture();
	CoreGraphics::VTextureSampling sampling;
	sampling.m_Minification = CoreGraphics::EMinificationLinearMipmapLinear;
	sampling.m_bMagnificationLinear = true;
	sampling.m_Anisotropy = c_Anisotropy;
	m_pTexture->Bind(io_rContext, 0, sampling);
	io_rContext.SetUniform(m_Texture, 0);
}

void VRenderFloorGrid::SetPixelSize(VRenderContext& io_rContext, const QVector2D& i_rSpacings)
{
	// From a place on the floor to where it is in the frame, without depth.
	QMatrix4x4 plane = io_rContext.m_Projection * io_rContext.m_View;
	plane.setColumn(1, plane.column(io_rContext.m_bYUp ? 2 : 1));
	plane.setColumn(2, QVector4D(0.0f, 0.0f, 1.0f, 0.0f));
	plane.setRow(2, QVector4D(0.0f, 0.0f, 1.0f, 0.0f));
	const QMatrix4x4 toPlane = plane.inverted();
	const QVector4D across = toPlane.column(0) * (2.0f / static_cast<float>(io_rContext.m_Viewport.width()));
	const QVector4D up = toPlane.column(1) * (2.0f / static_cast<float>(io_rContext.m_Viewport.height()));
	const auto tiles = [&i_rSpacings](const QVector4D& i_rStep)
	{
		return QVector4D(i_rStep.x() / i_rSpacings.x(), i_rStep.y() / i_rSpacings.x(), i_rStep.x() / i_rSpacings.y(),
		    i_rStep.y() / i_rSpacings.y());
	};
	io_rContext.SetUniform(m_TilesAcross, tiles(across));
	io_rContext.SetUniform(m_TilesUp, tiles(up));
	io_rContext.SetUniform(m_InverseDepths, QVector2D(across.w(), up.w()));
}

void VRenderFloorGrid::RenderLines(VRenderContext& io_rContext, const VFloor& i_rFloor)
{
	// On a processor the two lookups are most of what the floor costs, and without anisotropy they blur.
	const bool bComputed = io_rContext.m_bSoftware;
	if (!io_rContext.UseProgram(bComputed ? m_pComputedLines : m_pLines))
		return;
	const QVector2D spacings(
	    i_rFloor.m_Spacing, i_rFloor.m_Spacing / static_cast<float>(std::max(i_rFloor.m_Divisions, 1u)));
	if (bComputed)
	{
		io_rContext.SetUniform(m_LineWidth, static_cast<float>(c_LineWidth) / c_TextureSide);
		SetPixelSize(io_rContext, spacings);
	}
	else
		BindTexture(io_rContext);
	io_rContext.SetUniform(m_GridSpacings, spacings);
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
	io_rContext.m_pFunctions->glPolygonOffset(1.0f, 2.0f);
	DrawExtents(io_rContext, GL_LINE_LOOP, extents);
	DrawExtents(io_rContext, GL_TRIANGLE_FAN, QVector4D(extents.x(), -c_HalfStripWidth, extents.z(), c_HalfStripWidth));
	DrawExtents(io_rContext, GL_TRIANGLE_FAN, QVector4D(-c_HalfStripWidth, extents.y(), c_HalfStripWidth, extents.w()));
}

void VRenderFloorGrid::DrawExtents(VRenderContext& io_rContext, unsigned int i_Mode, const QVector4D& i_rExtents)
{
	io_rContext.SetUniform(m_Extents, i_rExtents);
	io_rContext.DrawArrays(i_Mode, m_Square.Count());
}

} // namespace OrlexGraphics
