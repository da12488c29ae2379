#pragma once

#include <optional>

class QVector3D;

namespace CoreGraphics
{
class VRenderContext;
}

namespace OrlexGraphics
{

/// Millimetres of a pixel that sizes on the screen count in, where the place is. Nothing behind the eye.
std::optional<float> PixelSizeAt(const CoreGraphics::VRenderContext& i_rContext, const QVector3D& i_rPlace);

} // namespace OrlexGraphics
