#pragma once

#include "CoreGraphics/Buffers.h"
#include "CoreGraphics/RenderState.h"
#include "CoreGraphics/Uniform.h"
#include "Flow2Graphics/IFlowRenderType.h"
#include "Flow2TypesUtils/ItemCache.h"
#include "OrlexGraphics/frame/IRenderType.h"

#include <QFont>
#include <QString>
#include <QVector2D>
#include <QVector3D>
#include <QVector4D>

#include <memory>
#include <vector>

namespace CoreGraphics
{
class VShaderLibrary;
class VShaderProgram;
} // namespace CoreGraphics

namespace Flow2Graphics
{

/// Lines, points and text that the host adds to a frame. Colours are red, green, blue and alpha up to 1.
struct VGeometry
{
	/// Name of the flow type whose items carry it.
	static constexpr const char* c_pName = "FlowGeometry";

	struct VLines
	{
		/// Both ends of each line, in millimetres.
		std::vector<QVector3D> m_Ends;
		QVector4D m_Colour;
	};

	struct VPoints
	{
		/// Millimetres.
		std::vector<QVector3D> m_Points;
		QVector4D m_Colour;
		/// Pixels.
		float m_Size = 1.0f;
	};

	/// In the camera grid's 2D view: from -1 to 1 across the whole view where there is no grid.
	struct VLines2D
	{
		/// Both ends of each line.
		std::vector<QVector2D> m_Ends;
		QVector4D m_Colour;
		/// Radians, counter-clockwise.
		float m_Rotation = 0.0f;
		QVector2D m_RotationCentre;
	};

	struct VText
	{
		QString m_Text;
		/// Of the beginning of its base line: millimetres, or for 2D text as VLines2D has it, without Z.
		QVector3D m_Position;
		QVector4D m_Colour;
		bool m_b2D = false;
	};

	std::vector<VLines> m_Lines;
	std::vector<VPoints> m_Points;
	std::vector<VLines2D> m_Lines2D;
	std::vector<VText> m_Texts;
};

/// Draws what frames bring of VGeometry; it is its own partner in the render list. 3D lines and points are hidden by
/// what stands before them; 2D lines and text by nothing. Render thread; made with the context current.
class VFlowRenderGeometry : public IFlowRenderType, public OrlexGraphics::IRenderType
{
public:
	explicit VFlowRenderGeometry(CoreGraphics::VShaderLibrary& io_rLibrary);

	void Update(const TesselPluginInterface::IFlowFrame& i_rFrame, VFlowContext& io_rContext) override;

	void Render(CoreGraphics::VRenderContext& io_rContext, const OrlexGraphics::VSceneOptions& i_rOptions,
	    std::uint32_t i_Pass) override;
	void Paint(QPainter& io_rPainter, CoreGraphics::VRenderContext& io_rContext,
	    const OrlexGraphics::VSceneOptions& i_rOptions) override;

private:
	void Render3D(CoreGraphics::VRenderContext& io_rContext, const VGeometry& i_rGeometry);
	void Render2D(CoreGraphics::VRenderContext& io_rContext, const VGeometry& i_rGeometry);

	const std::shared_ptr<CoreGraphics::VShaderProgram> m_p2D;
	const std::shared_ptr<CoreGraphics::VShaderProgram> m_p3D;
	CoreGraphics::VRenderState m_State2D;
	CoreGraphics::VRenderState m_State3D;
	CoreGraphics::VUniform m_Colour{"u_colour"};
	CoreGraphics::VUniform m_PointSize{"u_PointSize"};
	CoreGraphics::VUniform m_Rotation{"u_Rotation"};
	CoreGraphics::VUniform m_RotationCentre{"u_RotationCentre"};
	CoreGraphics::VStreamBuffer m_Buffer;
	const QFont m_Font{"Arial"};
	Flow2TypesUtils::VItemCacheTyped<VGeometry> m_Geometry{VGeometry::c_pName};
};

} // namespace Flow2Graphics
