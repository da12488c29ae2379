#pragma once

#include "CoreGraphics/RenderState.h"
#include "CoreGraphics/Shapes.h"
#include "CoreGraphics/Uniform.h"
#include "Flow2Graphics/RenderSubjectData.h"
#include "Flow2Graphics/SubjectTypes.h"
#include "OrlexGraphics/frame/IRenderType.h"

#include <array>
#include <memory>
#include <vector>

namespace CoreGraphics
{
class VShaderLibrary;
class VShaderProgram;
} // namespace CoreGraphics

namespace OrlexGraphics
{
class VSphereHelper;
struct VSubjectOptions;
} // namespace OrlexGraphics

namespace Flow2Graphics
{

/// Draws markers and the sticks between them: of props, of rigid objects, and of either the subjects or the subjects
/// for solving. Render thread; made with the context current.
class VRenderSubjectMarkers : public OrlexGraphics::IRenderType
{
public:
	using VSubjects = std::vector<std::shared_ptr<const VRenderSubjectMarkerData>>;

	/// @param i_bSolving the third list is that of the subjects for solving
	VRenderSubjectMarkers(CoreGraphics::VShaderLibrary& io_rLibrary,
	    std::shared_ptr<OrlexGraphics::VSphereHelper> i_pSphereHelper, bool i_bSolving);

	/// For lists that it does not draw, too.
	void SetSubjects(ESubjectClass i_Class, VSubjects i_Subjects) { m_Lists[i_Class] = std::move(i_Subjects); }

	void Render(CoreGraphics::VRenderContext& io_rContext, const OrlexGraphics::VSceneOptions& i_rOptions,
	    std::uint32_t i_Pass) override;

private:
	void RenderList(CoreGraphics::VRenderContext& io_rContext, const VSubjects& i_rSubjects,
	    const OrlexGraphics::VSubjectOptions& i_rOptions, std::uint32_t i_Pass);
	void RenderSticks(CoreGraphics::VRenderContext& io_rContext, const VSubjects& i_rSubjects, bool i_bGaps);

	const std::shared_ptr<OrlexGraphics::VSphereHelper> m_pSphereHelper;
	const bool m_bSolving;
	std::array<VSubjects, ESubjectClassCount> m_Lists;
	const std::shared_ptr<CoreGraphics::VShaderProgram> m_pStick;
	CoreGraphics::VShape m_Cylinder;
	CoreGraphics::VRenderState m_State;
	CoreGraphics::VUniform m_Model{"u_ModelTransform"};
	CoreGraphics::VUniform m_ColourA{"u_StickColourA"};
	CoreGraphics::VUniform m_ColourB{"u_StickColourB"};
};

} // namespace Flow2Graphics
