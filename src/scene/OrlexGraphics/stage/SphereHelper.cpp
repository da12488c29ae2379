#include "OrlexGraphics/stage/SphereHelper.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"

#include <QOpenGLContext>

#include <algorithm>
#include <cmath>

namespace OrlexGraphics
{

namespace
{

/// Pixels that an edge of a mesh has at least, and below which a sphere is a point.
constexpr float c_MinEdge = 2.0f;

/// Edges by the radius: chords of a circle that is cut in 4, 8, 16 and 32.
const std::array<float, VSphereHelper::c_Levels>& Chords()
{
	static const auto s_Chords = []
	{
		std::array<float, VSphereHelper::c_Levels> chords;
		for (std::uint32_t k = 0; k < chords.size(); ++k)
			chords[k] = static_cast<float>(2.0 * std::sin(std::pow(0.5, k) * 0.785398163397448310));
		return chords;
	}();
	return s_Chords;
}

} // namespace

VSphereHelper::VSphereHelper(
    CoreGraphics::VShaderLibrary& io_rLibrary, std::shared_ptr<const VSelectionRegistry> i_pRegistry)
    : m_pRegistry(std::move(i_pRegistry)), m_Spheres{CoreGraphics::MakeSphere(0), CoreGraphics::MakeSphere(1),
                                               CoreGraphics::MakeSphere(2), CoreGraphics::MakeSphere(3)},
      m_pProgram(io_rLibrary.GetProgram("Placed", "SimpleLighting")),
      m_pIdProgram(io_rLibrary.GetProgram("Placed", "Colour")),
      m_pPointProgram(io_rLibrary.GetProgram("Point3D", "Colour"))
{
	m_State.m_Cull = CoreGraphics::ECullBack;
	m_State.m_bDepthTest = true;
	m_SelectionState = CoreGraphics::MakeSelectionState(m_State);
}

VSphereHelper::~VSphereHelper() = default;

int VSphereHelper::Level(float i_Pixels, std::uint32_t i_LevelCap)
{
	int level = -1;
	for (std::uint32_t k = 0; k <= std::min(i_LevelCap, c_Levels - 1) && i_Pixels * Chords()[k] >= c_MinEdge; ++k)
		level = static_cast<int>(k);
	return level;
}

void VSphereHelper::Begin(CoreGraphics::VRenderContext& io_rContext)
{
	m_ViewProjection = io_rContext.m_Projection * io_rContext.m_View;
	m_PixelScale = static_cast<float>(io_rContext.m_Viewport.height()) * io_rContext.m_Projection(1, 1) * 0.5f;
	m_Splats.clear();
	if (io_rContext.m_Mode != CoreGraphics::ERenderNormal)
		m_pBatch = &m_IdWalk;
	else
	{
		if (m_Walk == m_Walks.size())
			m_Walks.emplace_back();
		m_pBatch = &m_Walks[m_Walk++];
	}
	m_pBatch->Clear();
}

void VSphereHelper::Clear()
{
	m_PickPoints.clear();
	m_Walk = 0;
}

void VSphereHelper::Draw(CoreGraphics::VRenderContext& io_rContext, const QVector4D& i_rSphere,
    const CoreGraphics::VSelectionId& i_rId, const QVector4D& i_rColour, std::uint32_t i_LevelCap)
{
	const bool bSelection = io_rContext.m_Mode != CoreGraphics::ERenderNormal;
	if (bSelection ? i_rId.m_Id == 0 || m_pRegistry->IsHidden(i_rId, io_rContext.m_Mode) : i_rSphere.w() <= 0.0f)
		return;
	const QVector4D clip = m_ViewProjection * QVector4D(i_rSphere.toVector3D(), 1.0f);
	// Behind the eye.
	if (clip.w() < -i_rSphere.w())
		return;
	const int level = clip.w() > 0.0f ? Level(i_rSphere.w() * m_PixelScale / clip.w(), i_LevelCap)
	                                  : static_cast<int>(std::min(i_LevelCap, c_Levels - 1));
	const CoreGraphics::VColourBytes colour =
	    bSelection ? CoreGraphics::ColourBytes(i_rId) : CoreGraphics::ColourBytes(i_rColour);
	if (level >= 0)
	{
		m_pBatch->Add(m_Spheres[static_cast<std::size_t>(level)], i_rSphere, colour);
		return;
	}
	m_Splats.push_back({{i_rSphere.x(), i_rSphere.y(), i_rSphere.z()}, colour});
	AddPickPoint(io_rContext, i_rSphere.toVector3D(), i_rId);
}

void VSphereHelper::AddPickPoint(
    const CoreGraphics::VRenderContext& i_rContext, const QVector3D& i_rPlace, const CoreGraphics::VSelectionId& i_rId)
{
	if (i_rContext.m_Mode != CoreGraphics::ERenderPick)
		return;
	const QVector4D clip = i_rContext.m_Projection * (i_rContext.m_View * QVector4D(i_rPlace, 1.0f));
	m_PickPoints.push_back({clip.x(), clip.y(), clip.w(), i_rId.m_Id});
}

void VSphereHelper::End(CoreGraphics::VRenderContext& io_rContext)
{
	const bool bSelection = io_rContext.m_Mode != CoreGraphics::ERenderNormal;
	io_rContext.ApplyState(bSelection ? m_SelectionState : m_State);
	if (!m_pBatch->IsEmpty() && io_rContext.UseProgram(bSelection ? m_pIdProgram : m_pProgram))
		m_pBatch->Draw(io_rContext, GL_TRIANGLES);
	if (m_Splats.empty() || !io_rContext.UseProgram(m_pPointProgram))
		return;
	m_SplatBuffer.Upload(m_Splats.data(), m_Splats.size() * sizeof(VSplat));
	io_rContext.SetVertexFormat(CoreGraphics::VVertexFormat::PositionColour());
	io_rContext.DrawArrays(GL_POINTS, m_Splats.size());
}

bool VSphereHelper::PickRectangle(const QRect& i_rRectangle, const QSize& i_rViewport, std::vector<bool>& io_rFound,
    std::vector<std::uint32_t>& io_rIds) const
{
	const std::size_t before = io_rIds.size();
	for (const VPickPoint& rPoint : m_PickPoints)
	{
		if (rPoint.m_ClipW <= 0.0f)
			continue;
		const auto pixel = [&](float i_Clip, int i_Size)
		{ return (i_Clip / rPoint.m_ClipW * 0.5f + 0.5f) * static_cast<float>(i_Size); };
		const float x = pixel(rPoint.m_ClipX, i_rViewport.width()) - static_cast<float>(i_rRectangle.x());
		const float y = pixel(rPoint.m_ClipY, i_rViewport.height()) - static_cast<float>(i_rRectangle.y());
		if (x < 0.0f || y < 0.0f || x > static_cast<float>(i_rRectangle.width())
		    || y > static_cast<float>(i_rRectangle.height()))
			continue;
		const std::uint32_t id = rPoint.m_Id & CoreGraphics::ESelectionIdMask;
		if (id >= io_rFound.size())
			io_rFound.resize(id + 1);
		if (!io_rFound[id])
			io_rIds.push_back(id);
		io_rFound[id] = true;
	}
	return io_rIds.size() != before;
}

} // namespace OrlexGraphics
