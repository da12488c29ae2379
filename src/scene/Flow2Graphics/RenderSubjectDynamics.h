#pragma once

#include "CoreGraphics/RenderState.h"
#include "CoreGraphics/ShapeBatch.h"
#include "CoreGraphics/Shapes.h"
#include "Flow2Graphics/RenderSubjectData.h"
#include "Flow2Graphics/SubjectTypes.h"
#include "OrlexGraphics/frame/IRenderType.h"
#include "OrlexGraphics/frame/SceneOptions.h"
#include "OrlexGraphics/skins/SkinRenderer.h"

#include <array>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace CoreGraphics
{
class VShaderLibrary;
class VShaderProgram;
} // namespace CoreGraphics

namespace OrlexGraphics
{
class VSelectionRegistry;
class VSphereHelper;
} // namespace OrlexGraphics

namespace Flow2Graphics
{

/// The options of a class of subjects.
const OrlexGraphics::VSubjectOptions& SubjectOptions(
    const OrlexGraphics::VSceneOptions& i_rOptions, ESubjectClass i_Class);

/// Draws bones, joints, targets, axes, origins and what is missing of all subjects: a walk over their arrays, that does
/// no mathematics of subjects and allocates nothing. All bones of a class are one draw, as are all its boxes, arrows...
/// Render thread; made with the context current.
class VRenderSubjectDynamics : public OrlexGraphics::IRenderType
{
public:
	using VSubjects = std::vector<std::shared_ptr<const VRenderSubjectData>>;

	/// Without the bones' mesh there are no bones, and the log says so.
	VRenderSubjectDynamics(CoreGraphics::VShaderLibrary& io_rLibrary,
	    std::shared_ptr<const OrlexGraphics::VSelectionRegistry> i_pRegistry,
	    std::shared_ptr<OrlexGraphics::VSphereHelper> i_pSphereHelper);
	~VRenderSubjectDynamics() override;

	void SetSubjects(ESubjectClass i_Class, VSubjects i_Subjects) { m_Lists[i_Class] = std::move(i_Subjects); }
	const VSubjects& Subjects(ESubjectClass i_Class) const { return m_Lists[i_Class]; }

	void Render(CoreGraphics::VRenderContext& io_rContext, const OrlexGraphics::VSceneOptions& i_rOptions,
	    std::uint32_t i_Pass) override;

private:
	/// The walk over one list.
	struct VWalk
	{
		CoreGraphics::VRenderContext& m_rContext;
		ESubjectClass m_Class;
		const VSubjects& m_rSubjects;
		const OrlexGraphics::VSubjectOptions& m_rOptions;
		std::uint32_t m_Pass;
		/// Translucent bones are drawn as such.
		bool m_bDual;
		/// Ids instead of colours.
		bool m_bPick;
	};

	/// A program with the shapes that it draws, by class and pass.
	struct VStep
	{
		std::shared_ptr<CoreGraphics::VShaderProgram> m_pProgram;
		CoreGraphics::VRenderState m_State;
		CoreGraphics::VRenderState m_SelectionState;
		unsigned int m_Mode;
		std::array<std::array<CoreGraphics::VShapeBatch, 2>, ESubjectClassCount> m_Batches;

		VStep(CoreGraphics::VShaderLibrary& io_rLibrary, const std::string& i_rFragment,
		    const CoreGraphics::VRenderState& i_rState, unsigned int i_Mode);
	};

	void RenderList(const VWalk& i_rWalk);
	void RenderPositionTargets(const VWalk& i_rWalk);
	void RenderCovariances(const VWalk& i_rWalk);
	void RenderBoxes(const VWalk& i_rWalk);
	void RenderBones(const VWalk& i_rWalk);
	void RenderRotationTargets(const VWalk& i_rWalk);
	void RenderSpheres(const VWalk& i_rWalk, std::vector<VRenderSubjectData::VShape> VRenderSubjectData::*i_pSpheres,
	    std::uint32_t i_LevelCap);
	void RenderSkins(const VWalk& i_rWalk);
	void RenderMissingMarkers(const VWalk& i_rWalk);
	void RenderAxes(const VWalk& i_rWalk);

	/// Whether the pick is not to see it.
	bool IsLeftOut(const VWalk& i_rWalk, const CoreGraphics::VSelectionId& i_rId) const;
	/// Where the walk gathers what a step draws.
	CoreGraphics::VShapeBatch& BatchOf(const VWalk& i_rWalk, VStep& io_rStep);
	/// @param i_rPlace a matrix, or a place and a scale
	/// @return false if it is left out.
	template <typename TPlace>
	bool Gather(const VWalk& i_rWalk, VStep& io_rStep, const CoreGraphics::VShape& i_rShape, const TPlace& i_rPlace,
	    const QVector4D& i_rColour, const CoreGraphics::VSelectionId& i_rId);
	/// What was gathered, until the next step begins.
	void Draw(const VWalk& i_rWalk, VStep& io_rStep);

	const std::shared_ptr<const OrlexGraphics::VSelectionRegistry> m_pRegistry;
	const std::shared_ptr<OrlexGraphics::VSphereHelper> m_pSphereHelper;
	OrlexGraphics::VSkinRenderer m_SkinRenderer;
	std::array<VSubjects, ESubjectClassCount> m_Lists;

	CoreGraphics::VShape m_SolidBox;
	CoreGraphics::VShape m_WireBox;
	/// Shaft and head of an arrow, and with fewer sides those of a thin one.
	std::array<std::array<CoreGraphics::VShape, 2>, 2> m_ArrowShapes;
	CoreGraphics::VShape m_Sphere;
	CoreGraphics::VShape m_AxesLines;
	std::optional<CoreGraphics::VShape> m_Bone;

	VStep m_PositionTargets;
	VStep m_Covariances;
	VStep m_Boxes;
	VStep m_Bones;
	VStep m_TranslucentBones;
	VStep m_Arrows;
	VStep m_MissingMarkers;
	VStep m_Axes;
	/// Ids, of one step after the other.
	CoreGraphics::VShapeBatch m_IdBatch;
	const std::shared_ptr<CoreGraphics::VShaderProgram> m_pIds;
	/// Of shaft and head for each axis, within the frame of target or segment.
	std::array<std::array<QMatrix4x4, 2>, 3> m_ArrowParts;
};

} // namespace Flow2Graphics
