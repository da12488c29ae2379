#pragma once

#include "CoreGraphics/Buffers.h"
#include "CoreGraphics/RenderState.h"
#include "CoreGraphics/Uniform.h"
#include "OrlexGraphics/frame/IRenderType.h"

#include <QVector3D>

#include <memory>
#include <vector>

namespace CoreGraphics
{
class VShaderLibrary;
class VShaderProgram;
} // namespace CoreGraphics

namespace OrlexGraphics
{

/// Draws the points that the cameras have found, as crosses along the axes of the world. Render thread; made with the
/// context current.
class VRenderReconstructions : public IRenderType
{
public:
	explicit VRenderReconstructions(CoreGraphics::VShaderLibrary& io_rLibrary);

	/// Millimetres.
	void SetPoints(const std::vector<QVector3D>& i_rPoints);

	void Render(
	    CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass) override;

private:
	void MakeVertices(float i_Scale);

	const std::shared_ptr<CoreGraphics::VShaderProgram> m_pProgram;
	CoreGraphics::VRenderState m_State;
	CoreGraphics::VUniform m_Colour{"u_colour"};
	std::vector<QVector3D> m_Points;
	/// Of the points at m_Scale, which is negative before there are any.
	std::vector<QVector3D> m_Vertices;
	float m_Scale = -1.0f;
	CoreGraphics::VStreamBuffer m_Buffer;
};

} // namespace OrlexGraphics
