#include "OrlexGraphics/manipulator/HandleSize.h"

#include "CoreGraphics/RenderContext.h"

namespace OrlexGraphics
{

std::optional<float> PixelSizeAt(const CoreGraphics::VRenderContext& i_rContext, const QVector3D& i_rPlace)
{
	const QVector4D clip = i_rContext.m_Projection * (i_rContext.m_View * QVector4D(i_rPlace, 1.0f));
	const float pixels = static_cast<float>(i_rContext.m_Viewport.height()) * i_rContext.m_Projection(1, 1) * 0.5f;
	if (!(clip.w() > 0.0f) || !(pixels > 0.0f))
		return {};
	return i_rContext.m_PixelRatio * clip.w() / pixels;
}

} // namespace OrlexGraphics
