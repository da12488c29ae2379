#pragma once

#include "CoreGraphics/Buffers.h"
#include "CoreGraphics/RenderState.h"
#include "CoreGraphics/Uniform.h"
#include "OrlexGraphics/frame/IRenderType.h"

#include <cstdint>
#include <memory>
#include <optional>

class QVector2D;
class QVector4D;

namespace CoreGraphics
{
class VShaderLibrary;
class VShaderProgram;
class VTexture;
} // namespace CoreGraphics

namespace OrlexGraphics
{

/// A floor, in millimetres.
struct VFloor
{
	std::int32_t m_X0 = 0;
	std::int32_t m_Y0 = 0;
	std::int32_t m_X1 = 0;
	std::int32_t m_Y1 = 0;
	/// Between two large lines.
	float m_Spacing = 1000.0f;
	/// Small squares along the side of a large one.
	std::uint32_t m_Divisions = 10;

	bool operator==(const VFloor&) const = default;
};

/// The floor with its lines: a square about the origin as large as the options say, unless a floor was given. Render
/// thread; made with the context current.
class VRenderFloorGrid : public IRenderType
{
public:
	explicit VRenderFloorGrid(CoreGraphics::VShaderLibrary& io_rLibrary);
	~VRenderFloorGrid() override;

	void SetFloor(const std::optional<VFloor>& i_rFloor) { m_Floor = i_rFloor; }

	/// The floor that is drawn.
	VFloor GetFloor(const VSceneOptions& i_rOptions) const;

	void Render(
	    CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass) override;

private:
	void RenderLines(CoreGraphics::VRenderContext& io_rContext, const VFloor& i_rFloor);
	void BindTexture(CoreGraphics::VRenderContext& io_rContext);
	void SetPixelSize(CoreGraphics::VRenderContext& io_rContext, const QVector2D& i_rSpacings);
	void RenderEdges(CoreGraphics::VRenderContext& io_rContext, const VFloor& i_rFloor);
	void DrawExtents(CoreGraphics::VRenderContext& io_rContext, unsigned int i_Mode, const QVector4D& i_rExtents);

	const std::shared_ptr<CoreGraphics::VShaderProgram> m_pLines;
	const std::shared_ptr<CoreGraphics::VShaderProgram> m_pComputedLines;
	const std::shared_ptr<CoreGraphics::VShaderProgram> m_pEdges;
	CoreGraphics::VVertexBuffer m_Square;
	CoreGraphics::VUniform m_Extents{"u_Extents"};
	CoreGraphics::VUniform m_GridSpacings{"u_GridSpacings"};
	CoreGraphics::VUniform m_Texture{"t_Texture"};
	CoreGraphics::VUniform m_LineWidth{"u_LineWidth"};
	CoreGraphics::VUniform m_TilesAcross{"u_TilesAcross"};
	CoreGraphics::VUniform m_TilesUp{"u_TilesUp"};
	CoreGraphics::VUniform m_InverseDepths{"u_InverseDepths"};
	CoreGraphics::VUniform m_Colour{"u_colour"};
	std::unique_ptr<CoreGraphics::VTexture> m_pTexture;
	std::optional<VFloor> m_Floor;
};

} // namespace OrlexGraphics
