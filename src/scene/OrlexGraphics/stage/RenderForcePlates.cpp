#include "OrlexGraphics/stage/RenderForcePlates.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "OrlexGraphics/picking/SelectionKinds.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"

#include <qopengl.h>

#include <cmath>
#include <numbers>

namespace OrlexGraphics
{

using CoreGraphics::VShape;

namespace
{

const QVector4D c_PlateColour(0.35f, 0.4f, 0.45f, 1.0f);
const QVector4D c_ArrowColour(0.9f, 0.2f, 0.2f, 1.0f);

// Of the arrow, in millimetres.
constexpr float c_ForceShaftRadius = 8.0f;
constexpr float c_ForceHeadRadius = 24.0f;
/// Of its length.
constexpr float c_HeadPart = 0.2f;
constexpr int c_ForceSides = 16;

struct VVertex
{
	QVector3D m_Position;
	/// None tells the shader that it is the plate's.
	QVector3D m_Normal;
	QVector2D m_UV;
};

VShape MakeShape(const std::vector<VVertex>& i_rVertices, const std::vector<std::uint16_t>& i_rIndices)
{
	return {CoreGraphics::VVertexBuffer(CoreGraphics::VVertexFormat::Mesh(), CoreGraphics::BytesOf(i_rVertices)),
	    CoreGraphics::VIndexBuffer(i_rIndices)};
}

VShape MakePlate()
{
	std::vector<VVertex> vertices;
	for (const QVector2D& rCorner : {QVector2D(0, 0), {1, 0}, {1, 1}, {0, 1}})
		vertices.push_back({QVector3D(rCorner - QVector2D(0.5f, 0.5f), 0.0f), {}, rCorner});
	return MakeShape(vertices, {0, 1, 2, 0, 2, 3});
}

/// A shaft and a head along Z, from 0 to 1.
VShape MakeArrow()
{
	struct VRing
	{
		float m_Radius;
		float m_Z;
	};
	const VRing rings[] = {{c_ForceShaftRadius, 0.0f}, {c_ForceShaftRadius, 1.0f - c_HeadPart},
	    {c_ForceHeadRadius, 1.0f - c_HeadPart}, {0.0f, 1.0f}};
	std::vector<VVertex> vertices;
	std::vector<std::uint16_t> indices;
	for (const VRing& rRing : rings)
	{
		for (int i = 0; i < c_ForceSides; ++i)
		{
			const auto angle = static_cast<float>(2.0 * std::numbers::pi * i / c_ForceSides);
			const QVector3D normal(std::cos(angle), std::sin(angle), 0.0f);
			vertices.push_back({normal * rRing.m_Radius + QVector3D(0.0f, 0.0f, rRing.m_Z), normal, {}});
		}
	}
	for (std::uint16_t ring = 0; ring + 1 < std::uint16_t{std::size(rings)}; ++ring)
	{
		for (std::uint16_t i = 0; i < c_ForceSides; ++i)
		{
			const auto at = [&](int i_Ring, int i_Side)
			{ return static_cast<std::uint16_t>((ring + i_Ring) * c_ForceSides + (i + i_Side) % c_ForceSides); };
			indices.insert(indices.end(), {at(0, 0), at(0, 1), at(1, 1), at(0, 0), at(1, 1), at(1, 0)});
		}
	}
	return MakeShape(vertices, indices);
}

} // namespace

VRenderForcePlates::VRenderForcePlates(
    CoreGraphics::VShaderLibrary& io_rLibrary, std::shared_ptr<VSelectionRegistry> i_pRegistry)
    : m_pRegistry(std::move(i_pRegistry)),
      m_PlateProgram(CoreGraphics::VSelectableProgram::Make(io_rLibrary, "ForcePlate", "ForcePlate")),
      m_ArrowProgram(CoreGraphics::VSelectableProgram::Make(io_rLibrary, "ForcePlate", "SimpleLighting")),
      m_Plate(MakePlate()), m_Arrow(MakeArrow())
{
	m_State.m_bDepthTest = true;
	m_State.m_DepthFunction = CoreGraphics::EDepthLessEqual;
}

void VRenderForcePlates::AllocateIds()
{
	m_Ids.clear();
	for (std::size_t i = 0; m_pPlates && i < m_pPlates->size(); ++i)
	{
		const VForcePlate& rPlate = (*m_pPlates)[i];
		const NVX::ISelectionItem item{ESelectionForcePlate, 0, static_cast<std::uint32_t>(i), rPlate.m_Name};
		m_pRegistry->Allocate(item, rPlate.m_Name);
		m_pRegistry->SetItemMatrix(item, rPlate.m_Transform);
		// About the plate's middle, the arrow included.
		const float radius = std::max(0.5f * rPlate.m_Size.length(),
		    rPlate.m_CentreOfPressure.length() + rPlate.m_Force.length() + c_ForceHeadRadius);
		m_pRegistry->SetItemBound(item, QVector4D(rPlate.m_Transform.column(3).toVector3D(), radius));
		m_Ids.push_back(m_pRegistry->GetId(item));
	}
}

void VRenderForcePlates::Render(
    CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& /*i_rOptions*/, std::uint32_t i_Pass)
{
	if (i_Pass != EPassOpaque || m_Ids.empty())
		return;
	io_rContext.ApplyState(
	    io_rContext.m_Mode == CoreGraphics::ERenderNormal ? m_State : CoreGraphics::MakeSelectionState(m_State));
	RenderShape(io_rContext, m_PlateProgram, m_Plate, false);
	RenderShape(io_rContext, m_ArrowProgram, m_Arrow, true);
}

void VRenderForcePlates::RenderShape(CoreGraphics::VRenderContext& io_rContext,
    CoreGraphics::VSelectableProgram& io_rProgram, VShape& io_rShape, bool i_bArrows)
{
	const bool bSelection = io_rContext.m_Mode != CoreGraphics::ERenderNormal;
	if (!io_rContext.UseProgram(io_rProgram.Get(bSelection)))
		return;
	io_rContext.BindVertices(io_rShape.m_Vertices);
	for (std::size_t i = 0; i < m_Ids.size(); ++i)
	{
		const VForcePlate& rPlate = (*m_pPlates)[i];
		if (m_pRegistry->IsHidden(m_Ids[i], io_rContext.m_Mode) || (i_bArrows && rPlate.m_Force.isNull()))
			continue;
		QMatrix4x4 model = rPlate.m_Transform;
		if (!i_bArrows)
			model.scale(rPlate.m_Size.x(), rPlate.m_Size.y(), 1.0f);
		if (bSelection)
			io_rProgram.SetId(io_rContext, m_Ids[i]);
		else
			io_rContext.SetUniform(m_Colour, i_bArrows ? c_ArrowColour : c_PlateColour);
		io_rContext.SetUniform(m_Model, model);
		io_rContext.SetUniform(m_Force, rPlate.m_Force);
		io_rContext.SetUniform(m_CentreOfPressure, rPlate.m_CentreOfPressure);
		io_rContext.DrawElements(GL_TRIANGLES, io_rShape.m_Indices);
	}
}

} // namespace OrlexGraphics
