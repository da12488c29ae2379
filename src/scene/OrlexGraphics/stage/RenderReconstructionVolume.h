#pragma once

#include "CoreGraphics/RenderState.h"
#include "CoreGraphics/Shapes.h"
#include "CoreGraphics/Uniform.h"
#include "OrlexGraphics/frame/IRenderType.h"
#include "OrlexGraphics/manipulator/Volume.h"

#include <memory>
#include <optional>

namespace CoreGraphics
{
class VShaderLibrary;
class VShaderProgram;
} // namespace CoreGraphics

namespace OrlexGraphics
{

/// The box in which markers are looked for: its edges, and the insides of its far walls. Render thread; made with the
/// context current.
class VRenderReconstructionVolume : public IRenderType
{
public:
	explicit VRenderReconstructionVolume(CoreGraphics::VShaderLibrary& io_rLibrary);

	/// Nothing is drawn without a volume.
	void SetVolume(const std::optional<VVolume>& i_rVolume) { m_Volume = i_rVolume; }
	const std::optional<VVolume>& Volume() const { return m_Volume; }

	void Render(
	    CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass) override;

private:
	const std::shared_ptr<CoreGraphics::VShaderProgram> m_pWalls;
	const std::shared_ptr<CoreGraphics::VShaderProgram> m_pEdges;
	CoreGraphics::VShape m_Box;
	CoreGraphics::VShape m_WireBox;
	CoreGraphics::VRenderState m_WallState;
	CoreGraphics::VRenderState m_EdgeState;
	CoreGraphics::VUniform m_Model{"u_ModelTransform"};
	CoreGraphics::VUniform m_WallColour{"u_ModelColour"};
	CoreGraphics::VUniform m_EdgeColour{"u_colour"};
	std::optional<VVolume> m_Volume;
};

} // namespace OrlexGraphics
