#include "Flow2Graphics/RenderSubjectDynamics.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "Flow2Graphics/SubjectShapes.h"
#include "OrlexGraphics/manipulator/HandleSize.h"
#include "OrlexGraphics/manipulator/MeshFile.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "OrlexGraphics/stage/SphereHelper.h"

#include <qopengl.h>

using CoreGraphics::VRenderState;

namespace Flow2Graphics
{

namespace
{

constexpr float c_AxesLength = 100.0f;
constexpr float c_ArrowWidth = 5.0f;
/// Of the shaft, and of the head.
constexpr float c_ArrowLength = 50.0f;
constexpr std::uint32_t c_ArrowSides = 16;
/// Within a third of a pixel of the others as long as an arrow is thin: up to so many pixels from its middle.
constexpr std::uint32_t c_ThinArrowSides = 6;
constexpr float c_ThinArrow = 2.0f;
const QVector4D c_CovarianceColour(0.5f, 0.5f, 0.5f, 0.5f);
const std::array<QVector4D, 3> c_AxisColours{
    QVector4D(1.0f, 0.2f, 0.2f, 1.0f), QVector4D(0.2f, 1.0f, 0.2f, 1.0f), QVector4D(0.2f, 0.2f, 1.0f, 1.0f)};

VRenderState Solid()
{
	VRenderState state;
	state.m_Cull = CoreGraphics::ECullBack;
	state.m_bDepthTest = true;
	return state;
}

VRenderState Blended()
{
	VRenderState state = Solid();
	state.m_ColourBlend = CoreGraphics::EColourBlendAlpha;
	return state;
}

/// What is behind is not hidden.
VRenderState Fading()
{
	VRenderState state = Blended();
	state.m_bDepthWrite = false;
	return state;
}

VRenderState Lines()
{
	VRenderState state;
	state.m_bDepthTest = true;
	return state;
}

std::array<std::array<QMatrix4x4, 2>, 3> MakeArrowParts()
{
	std::array<std::array<QMatrix4x4, 2>, 3> parts;
	parts[0][0].rotate(90.0f, 0.0f, 1.0f, 0.0f);
	parts[1][0].rotate(-90.0f, 1.0f, 0.0f, 0.0f);
	for (auto& [rShaft, rHead] : parts)
	{
		rHead = rShaft;
		rShaft.scale(c_ArrowWidth, c_ArrowWidth, c_ArrowLength);
		rHead.translate(0.0f, 0.0f, c_ArrowLength);
		rHead.scale(c_ArrowWidth, c_ArrowWidth, c_ArrowLength);
	}
	return parts;
}

std::array<CoreGraphics::VShape, 2> MakeArrow(std::uint32_t i_Sides)
{
	return {CoreGraphics::MakeCylinder(i_Sides, true), CoreGraphics::MakeCone(i_Sides, true)};
}

bool IsThin(const CoreGraphics::VRenderContext& i_rContext, const VRenderSubjectData::VRotationTarget& i_rTarget)
{
	const std::optional<float> pixel = OrlexGraphics::PixelSizeAt(i_rContext, Translation(i_rTarget.m_Segment));
	return pixel && c_ArrowWidth < c_ThinArrow * *pixel;
}

} // namespace

const OrlexGraphics::VSubjectOptions& SubjectOptions(
    const OrlexGraphics::VSceneOptions& i_rOptions, ESubjectClass i_Class)
{
	switch (i_Class)
	{
	case ESubjectClassLabelling: return i_rOptions.m_LabellingSubject;
	case ESubjectClassSolving: return i_rOptions.m_SolvingSubject;
	case ESubjectClassRetargeting: return i_rOptions.m_RetargetingSubject;
	default: return i_rOptions.m_PropSubject;
	}
}

VRenderSubjectDynamics::VStep::VStep(CoreGraphics::VShaderLibrary& io_rLibrary, const std::string& i_rFragment,
    const VRenderState& i_rState, unsigned int i_Mode)
    : m_pProgram(io_rLibrary.GetProgram("Placed", i_rFragment)), m_State(i_rState),
      m_SelectionState(CoreGraphics::MakeSelectionState(i_rState)), m_Mode(i_Mode)
{
}

VRenderSubjectDynamics::VRenderSubjectDynamics(CoreGraphics::VShaderLibrary& io_rLibrary,
    std::shared_ptr<const OrlexGraphics::VSelectionRegistry> i_pRegistry,
    std::shared_ptr<OrlexGraphics::VSphereHelper> i_pSphereHelper)
    : m_pRegistry(std::move(i_pRegistry)), m_pSphereHelper(std::move(i_pSphereHelper)), m_SkinRenderer(io_rLibrary),
      m_SolidBox(CoreGraphics::MakeBox(false)),
      m_WireBox(CoreGraphics::MakeBox(true)), m_ArrowShapes{MakeArrow(c_ArrowSides), MakeArrow(c_ThinArrowSides)},
      m_Sphere(CoreGraphics::MakeSphere(2)), m_AxesLines(CoreGraphics::MakeAxes(c_AxesLength)),
      m_Bone(OrlexGraphics::ReadMeshFile(io_rLibrary, "tetra_stripe.fbx")),
      m_PositionTargets(io_rLibrary, "Colour", Blended(), GL_LINES),
      m_Covariances(io_rLibrary, "Covariance", Blended(), GL_TRIANGLES),
      m_Boxes(io_rLibrary, "SimpleLighting", Blended(), GL_TRIANGLES),
      m_Bones(io_rLibrary, "Segment", Solid(), GL_TRIANGLES),
      m_TranslucentBones(io_rLibrary, "Segment", Blended(), GL_TRIANGLES),
      m_Arrows(io_rLibrary, "SimpleLighting", Solid(), GL_TRIANGLES),
      m_MissingMarkers(io_rLibrary, "MissingMarker", Fading(), GL_TRIANGLES),
      m_Axes(io_rLibrary, "Colour", Lines(), GL_LINES), m_pIds(io_rLibrary.GetProgram("Placed", "Colour")),
      m_ArrowParts(MakeArrowParts())
{
}

VRenderSubjectDynamics::~VRenderSubjectDynamics() = default;

void VRenderSubjectDynamics::Render(
    CoreGraphics::VRenderContext& io_rContext, const OrlexGraphics::VSceneOptions& i_rOptions, std::uint32_t i_Pass)
{
	if (i_Pass == OrlexGraphics::EPassOverlay)
		return;
	// A source and a target skeleton stand together.
	const bool bDual = i_rOptions.m_LabellingSubject.m_bEnabled && i_rOptions.m_LabellingSubject.m_bBones
	    && i_rOptions.m_SolvingSubject.m_bEnabled && i_rOptions.m_SolvingSubject.m_bBones;
	for (const VSubjectTypes& rTypes : c_SubjectTypes)
	{
		const OrlexGraphics::VSubjectOptions& rOptions = SubjectOptions(i_rOptions, rTypes.m_Class);
		if (rOptions.m_bEnabled && !m_Lists[rTypes.m_Class].empty())
			RenderList({io_rContext, rTypes.m_Class, m_Lists[rTypes.m_Class], rOptions, i_Pass, bDual,
			    io_rContext.m_Mode != CoreGraphics::ERenderNormal});
	}
}

void VRenderSubjectDynamics::RenderList(const VWalk& i_rWalk)
{
	const bool bTransparent = i_rWalk.m_Pass == OrlexGraphics::EPassTransparent;
	const bool bDecoration = bTransparent && !i_rWalk.m_bPick;
	if (i_rWalk.m_rOptions.m_bTargets && !bTransparent)
		RenderPositionTargets(i_rWalk);
	if (i_rWalk.m_rOptions.m_bTargetCovariances && bDecoration)
		RenderCovariances(i_rWalk);
	RenderBoxes(i_rWalk);
	if (i_rWalk.m_rOptions.m_bBones && !(i_rWalk.m_bPick && bTransparent))
	{
		RenderBones(i_rWalk);
		RenderSpheres(i_rWalk, &VRenderSubjectData::m_BoneSpheres, 0);
	}
	if (i_rWalk.m_rOptions.m_bTargets && !bTransparent)
		RenderRotationTargets(i_rWalk);
	if (i_rWalk.m_rOptions.m_bJoints && !bTransparent)
		RenderSpheres(i_rWalk, &VRenderSubjectData::m_Joints, 3);
	RenderSkins(i_rWalk);
	if (i_rWalk.m_rOptions.m_bMissingMarkers && bDecoration)
		RenderMissingMarkers(i_rWalk);
	if (i_rWalk.m_rOptions.m_bAxes && bDecoration)
		RenderAxes(i_rWalk);
}

CoreGraphics::VShapeBatch& VRenderSubjectDynamics::BatchOf(const VWalk& i_rWalk, VStep& io_rStep)
{
	return i_rWalk.m_bPick ? m_IdBatch : io_rStep.m_Batches[i_rWalk.m_Class][i_rWalk.m_Pass];
}

bool VRenderSubjectDynamics::IsLeftOut(const VWalk& i_rWalk, const CoreGraphics::VSelectionId& i_rId) const
{
	return i_rWalk.m_bPick && (i_rId.m_Id == 0 || m_pRegistry->IsHidden(i_rId, i_rWalk.m_rContext.m_Mode));
}

template <typename TPlace>
bool VRenderSubjectDynamics::Gather(const VWalk& i_rWalk, VStep& io_rStep, const CoreGraphics::VShape& i_rShape,
    const TPlace& i_rPlace, const QVector4D& i_rColour, const CoreGraphics::VSelectionId& i_rId)
{
	if (IsLeftOut(i_rWalk, i_rId))
		return false;
	BatchOf(i_rWalk, io_rStep)
	    .Add(i_rShape, i_rPlace,
	        i_rWalk.m_bPick ? CoreGraphics::ColourBytes(i_rId) : CoreGraphics::ColourBytes(i_rColour));
	return true;
}

void VRenderSubjectDynamics::Draw(const VWalk& i_rWalk, VStep& io_rStep)
{
	CoreGraphics::VShapeBatch& rBatch = BatchOf(i_rWalk, io_rStep);
	if (!rBatch.IsEmpty() && i_rWalk.m_rContext.UseProgram(i_rWalk.m_bPick ? m_pIds : io_rStep.m_pProgram))
	{
		i_rWalk.m_rContext.ApplyState(i_rWalk.m_bPick ? io_rStep.m_SelectionState : io_rStep.m_State);
		rBatch.Draw(i_rWalk.m_rContext, io_rStep.m_Mode);
	}
	rBatch.Clear();
}

void VRenderSubjectDynamics::RenderPositionTargets(const VWalk& i_rWalk)
{
	for (const auto& rpSubject : i_rWalk.m_rSubjects)
		for (const VRenderSubjectData::VShape& rTarget : rpSubject->m_PositionTargets)
			if (Gather(
			        i_rWalk, m_PositionTargets, m_WireBox, rTarget.m_PositionAndSize, rTarget.m_Colour, rTarget.m_Id))
				m_pSphereHelper->AddPickPoint(i_rWalk.m_rContext, rTarget.m_PositionAndSize.toVector3D(), rTarget.m_Id);
	Draw(i_rWalk, m_PositionTargets);
}

void VRenderSubjectDynamics::RenderCovariances(const VWalk& i_rWalk)
{
	for (const auto& rpSubject : i_rWalk.m_rSubjects)
		for (const QMatrix4x4& rCovariance : rpSubject->m_Covariances)
			Gather(i_rWalk, m_Covariances, m_Sphere, rCovariance, c_CovarianceColour, {});
	Draw(i_rWalk, m_Covariances);
}

void VRenderSubjectDynamics::RenderBoxes(const VWalk& i_rWalk)
{
	const bool bTransparent = i_rWalk.m_Pass == OrlexGraphics::EPassTransparent;
	if (i_rWalk.m_bPick && bTransparent)
		return;
	for (const auto& rpSubject : i_rWalk.m_rSubjects)
		for (const VRenderSubjectData::VModel& rBox : rpSubject->m_Boxes)
		{
			if (!i_rWalk.m_bPick && bTransparent != (rBox.m_Colour.w() != 1.0f))
				continue;
			if (Gather(i_rWalk, m_Boxes, m_SolidBox, rBox.m_Matrix, rBox.m_Colour, rBox.m_Id))
				m_pSphereHelper->AddPickPoint(i_rWalk.m_rContext, Translation(rBox.m_Matrix), rBox.m_Id);
		}
	Draw(i_rWalk, m_Boxes);
}

void VRenderSubjectDynamics::RenderBones(const VWalk& i_rWalk)
{
	if (!m_Bone)
		return;
	VStep& rStep = i_rWalk.m_bDual ? m_TranslucentBones : m_Bones;
	const bool bTransparent = i_rWalk.m_Pass == OrlexGraphics::EPassTransparent;
	for (const auto& rpSubject : i_rWalk.m_rSubjects)
		for (const VRenderSubjectData::VModel& rBone : rpSubject->m_Bones)
		{
			const bool bTranslucent = i_rWalk.m_bDual && rBone.m_Colour.w() < 1.0f;
			if (i_rWalk.m_bPick || bTransparent == bTranslucent)
				Gather(i_rWalk, rStep, *m_Bone, rBone.m_Matrix, rBone.m_Colour, rBone.m_Id);
		}
	Draw(i_rWalk, rStep);
}

void VRenderSubjectDynamics::RenderSpheres(const VWalk& i_rWalk,
    std::vector<VRenderSubjectData::VShape> VRenderSubjectData::*i_pSpheres, std::uint32_t i_LevelCap)
{
	m_pSphereHelper->Begin(i_rWalk.m_rContext);
	for (const auto& rpSubject : i_rWalk.m_rSubjects)
		for (const VRenderSubjectData::VShape& rSphere : (*rpSubject).*i_pSpheres)
			m_pSphereHelper->Draw(
			    i_rWalk.m_rContext, rSphere.m_PositionAndSize, rSphere.m_Id, rSphere.m_Colour, i_LevelCap);
	m_pSphereHelper->End(i_rWalk.m_rContext);
}

void VRenderSubjectDynamics::RenderRotationTargets(const VWalk& i_rWalk)
{
	for (const auto& rpSubject : i_rWalk.m_rSubjects)
		for (const VRenderSubjectData::VRotationTarget& rTarget : rpSubject->m_RotationTargets)
		{
			if (IsLeftOut(i_rWalk, rTarget.m_Id))
				continue;
			const bool bThin = IsThin(i_rWalk.m_rContext, rTarget);
			for (std::size_t axis = 0; axis < m_ArrowParts.size(); ++axis)
				for (const std::size_t part : {0u, 1u})
				{
					// The shaft shows where the target is, the head where the segment is.
					const QMatrix4x4& rFrame = part == 0 ? rTarget.m_Target : rTarget.m_Segment;
					Gather(i_rWalk, m_Arrows, m_ArrowShapes[bThin][part], rFrame * m_ArrowParts[axis][part],
					    c_AxisColours[axis], rTarget.m_Id);
				}
		}
	Draw(i_rWalk, m_Arrows);
}

void VRenderSubjectDynamics::RenderSkins(const VWalk& i_rWalk)
{
	CoreGraphics::VRenderContext& rContext = i_rWalk.m_rContext;
	if (!m_SkinRenderer.BeginRender(rContext, i_rWalk.m_rOptions, i_rWalk.m_Pass))
		return;
	for (const auto& rpSubject : i_rWalk.m_rSubjects)
	{
		if (!rpSubject->m_bSkin || (i_rWalk.m_bPick && m_pRegistry->IsHidden(rpSubject->m_Id, rContext.m_Mode)))
			continue;
		if (i_rWalk.m_rOptions.m_bClusters)
			for (const CoreGraphics::VSkinInstance& rCluster : rpSubject->m_ClusterSkins)
				m_SkinRenderer.Draw(rCluster, rContext, i_rWalk.m_rOptions, rpSubject->m_Id);
		if (!rpSubject->m_pSkin)
			continue;
		m_SkinRenderer.Draw(*rpSubject->m_pSkin, rContext, i_rWalk.m_rOptions, rpSubject->m_Id);
		if (const auto bones = rpSubject->m_pSkin->BoneMatrices(); i_rWalk.m_bPick && !bones.empty())
			m_pSphereHelper->AddPickPoint(
			    rContext, QVector3D(bones.front()[12], bones.front()[13], bones.front()[14]), rpSubject->m_Id);
	}
}

void VRenderSubjectDynamics::RenderMissingMarkers(const VWalk& i_rWalk)
{
	for (const auto& rpSubject : i_rWalk.m_rSubjects)
		for (const VRenderSubjectData::VShape& rMarker : rpSubject->m_MissingMarkers)
			Gather(i_rWalk, m_MissingMarkers, m_Sphere, rMarker.m_PositionAndSize, rMarker.m_Colour, rMarker.m_Id);
	Draw(i_rWalk, m_MissingMarkers);
}

void VRenderSubjectDynamics::RenderAxes(const VWalk& i_rWalk)
{
	for (const auto& rpSubject : i_rWalk.m_rSubjects)
		for (const QMatrix4x4& rMatrix : rpSubject->m_Axes)
			Gather(i_rWalk, m_Axes, m_AxesLines, rMatrix, {}, {});
	Draw(i_rWalk, m_Axes);
}

} // namespace Flow2Graphics
