#include "PicturesFixture.h"

#include "CoreOrlexQRTIO/Reader.h"
#include "CoreOrlexTypes/SubjectState.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "CoreOrlexTypesUtils/joints/PoseVector.h"
#include "Flow2Graphics/SubjectTypes.h"
#include "Flow2TypesUtils/ItemCatalogue.h"
#include "OrlexGraphics/manipulator/RenderManipulator.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "TestSubject.h"

#include <QQuaternion>
#include <QtMath>

namespace
{

using namespace Flow2Graphics;

class Pictures : public VPicturesTest
{
protected:
	/// Performer and character of the demo, in the poses that their files hold. The files have Z up.
	void ShowDemo(bool i_bYUp = false)
	{
		m_pScene->SetYUp(i_bYUp);
		std::vector<NVX::CountedPointer<TesselPluginInterface::IFlowItem>> items;
		const auto add = [&](const std::string& i_rPath, const VSubjectTypes& i_rTypes, auto i_pStatistic)
		{
			CoreOrlexTypes::VSubjectParametrised parametrised;
			CoreOrlexTypes::VSubjectApplicationData data;
			CoreOrlexQRTIO::VSubjectQRTExtras extras;
			std::vector<std::string> errors, warnings;
			ASSERT_TRUE(CoreOrlexQRTIO::VReader().Read(
			    i_rPath, "demo", TestSubject::c_Id, parametrised, data, extras, errors, warnings))
			    << i_rPath;
			CoreOrlexTypes::VSubject subject;
			CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(parametrised, subject);
			items.push_back(TestSubject::Item(i_rTypes.m_Subject, std::move(subject)));
			items.push_back(TestSubject::Item(i_rTypes.m_ApplicationData, std::move(data)));
			std::vector<double> pose = CoreOrlexTypesUtils::PoseVector(parametrised, i_pStatistic);
			if (i_bYUp)
				TurnToYUp(pose);
			items.push_back(TestSubject::Item(
			    i_rTypes.m_Pose, CoreOrlexTypes::VSubjectDynamicParameters{TestSubject::c_Id, std::move(pose)}));
		};
		using VJoint = CoreOrlexTypes::VSubjectParametrised::VJoint;
		add(RETARGET_SOURCE "/demo/performer.qrs", VFlowSubjectTypes::c_Types, &VJoint::m_BindPose);
		add(RETARGET_TEST_DATA "/pictures/kestrel.qrr", VFlowSubjectForSolvingTypes::c_Types, &VJoint::m_BindPose);
		m_pScene->SetFrame(TestSubject::MakeFrame(items));
	}

private:
	/// Rotation vector and translation of a root without a pose of its own before them.
	static void TurnToYUp(std::vector<double>& io_rPose)
	{
		const auto part = [&](std::size_t i_Index) { return static_cast<float>(io_rPose[i_Index]); };
		const QQuaternion turn = QQuaternion::fromAxisAndAngle(1, 0, 0, -90);
		const QVector3D rotation(part(0), part(1), part(2));
		QVector3D axis;
		float degrees = 0.0f;
		(turn * QQuaternion::fromAxisAndAngle(rotation, qRadiansToDegrees(rotation.length())))
		    .getAxisAndAngle(&axis, &degrees);
		const QVector3D place = turn.rotatedVector({part(3), part(4), part(5)});
		for (int i = 0; i < 3; ++i)
		{
			io_rPose[static_cast<std::size_t>(i)] = static_cast<double>(axis[i] * qDegreesToRadians(degrees));
			io_rPose[static_cast<std::size_t>(i) + 3] = static_cast<double>(place[i]);
		}
	}
};
INSTANTIATE_IN_BOTH_DIALECTS(Pictures);

TEST_P(Pictures, OfEachThingThatASubjectIsDrawnAs)
{
	const struct
	{
		const char* m_pName;
		QStringList m_Options;
	} c_Rows[] = {
	    {"origins", {}},
	    // They show in any case.
	    {"origins", {"Origins"}},
	    {"bones", {"Bones"}},
	    {"joints", {"Joints"}},
	    {"axes", {"Axes"}},
	    {"targets", {"Targets"}},
	    {"covariances", {"TargetCovariances"}},
	    {"markers", {"Markers"}},
	    {"sticks", {"Sticks", "Markers"}},
	};
	ShowSmall();
	ShowOnly("LabellingSubject", {});
	for (const auto& rRow : c_Rows)
	{
		ShowOnly("SolvingSubject", rRow.m_Options + QStringList("Enabled"));
		Compare(Draw(c_Small), rRow.m_pName);
	}
	ShowOnly("SolvingSubject", {"Bones", "Markers"});
	QImage background(m_Size, QImage::Format_RGB32);
	background.fill(0xff202020u);
	EXPECT_EQ(Draw(c_Small), background) << "it is not enabled";
}

TEST_P(Pictures, OfEachClassUnderItsOptions)
{
	const char* const c_Classes[ESubjectClassCount] = {
	    "PropSubject", "LabellingSubject", "PropSubject", "SolvingSubject", "RetargetingSubject"};
	for (const VSubjectTypes& rTypes : c_SubjectTypes)
	{
		SCOPED_TRACE(rTypes.m_Class);
		ShowSmall(rTypes);
		for (const char* const pClass : c_Classes)
			ShowOnly(pClass, {});
		ShowOnly(c_Classes[rTypes.m_Class], {"Enabled", "Bones"});
		Compare(Draw(c_Small), "bones");
		// Those for retargeting have no markers.
		ShowOnly(c_Classes[rTypes.m_Class], {"Enabled", "Markers"});
		Compare(Draw(c_Small), rTypes.m_Class == ESubjectClassRetargeting ? "origins" : "markers");
	}
}

TEST_P(Pictures, OfMissingMarkers)
{
	const CoreOrlexTypes::VReconstructionLabelSet labels{
	    {{TestSubject::c_Id, 0, {0, 320, 130}}, {TestSubject::c_Id, 1, {10, 360, 190}}}};
	ShowSmall(VFlowSubjectForSolvingTypes::c_Types, &labels);
	const VView near{{0, 320, 160}, 260.0f, -65.0f, 60.0f};
	const QStringList options{"Enabled", "MissingMarkers", "Markers", "Sticks"};
	ShowOnly("SolvingSubject", options);
	Compare(Draw(near), "missing-markers");
	ShowOnly("SolvingSubject", options + QStringList("SticksDuringGaps"));
	Compare(Draw(near), "sticks-during-gaps");
}

TEST_P(Pictures, OfTranslucentBonesBesideASource)
{
	ShowSmall();
	for (const char* const pClass : {"SolvingSubject", "LabellingSubject"})
		ShowOnly(pClass, {"Enabled", "Bones"});
	const QImage dual = Draw(c_Small);
	Compare(dual, "bones-translucent");
	Options().m_LabellingSubject.m_bBones = false;
	EXPECT_NE(Draw(c_Small), dual) << "alone it is opaque";
}

TEST_P(Pictures, OfSourceAndTarget)
{
	ASSERT_NO_FATAL_FAILURE(ShowDemo());
	Options().m_bFloorGrid = Options().m_bGlobalAxis = true;
	const VView whole{{0, 0, 900}, 3000.0f, -75.0f, 30.0f};
	Options().m_LabellingSubject.m_bMarkers = Options().m_LabellingSubject.m_bSticks = false;
	Compare(Draw(whole), "source-and-target");
	Options().m_LabellingSubject.m_bEnabled = false;
	Options().m_SolvingSubject.m_bTargets = Options().m_SolvingSubject.m_bJoints = true;
	Options().m_SolvingSubject.m_bAxes = true;
	Compare(Draw(whole), "target");
}

TEST_P(Pictures, OfSourceAndTargetFromEachSide)
{
	const char* const c_Names[CoreGraphics::ECameraTypeCount] = {
	    "perspective", "front", "back", "left", "right", "top", "bottom"};
	Options().m_bFloorGrid = Options().m_bGlobalAxis = true;
	Options().m_FloorGridSize = 2.0f;
	Options().m_LabellingSubject.m_bMarkers = Options().m_LabellingSubject.m_bSticks = false;
	for (const bool bYUp : {false, true})
	{
		ASSERT_NO_FATAL_FAILURE(ShowDemo(bYUp));
		const QVector3D middle = bYUp ? QVector3D(0, 900, 0) : QVector3D(0, 0, 900);
		// The other views are the same arithmetic in both dialects.
		const bool bES2 = GetParam() == GraphicsTest::EDialect::ES2;
		for (std::uint32_t type = 0; type < (bES2 ? 1u : CoreGraphics::ECameraTypeCount); ++type)
			Compare(Draw({middle, 3000.0f, -75.0f, 30.0f, type, 9.0f}),
			    std::string(bYUp ? "y-up-" : "z-up-") + c_Names[type]);
	}
}

TEST_P(Pictures, OfAPlateThatLiesOnTheFloor)
{
	ShowSmall(VFlowSubjectForSolvingTypes::c_Types, nullptr,
	    CoreOrlexTypes::VSubjectDynamicParameters{TestSubject::c_Id, {0, 0, 0.7}});
	Options().m_bFloorGrid = true;
	// Through a telescope: there a step of depth is twice as large as the plate's height over the floor.
	Camera().m_FieldOfView = 1.3f;
	for (const bool bTranslucent : {true, false})
	{
		Options().m_bFloorGridIsTranslucent = bTranslucent;
		Compare(Draw({{0, 0, 0}, 7000.0f, -60.0f}), bTranslucent ? "plate-on-floor" : "plate-on-opaque-floor");
	}
}

TEST_P(Pictures, OfOutlines)
{
	ShowSmall();
	ShowOnly("SolvingSubject", {"Enabled", "Bones", "Targets", "Joints"});
	const VSubjectSelectionMaker<VFlowSubjectForSolvingTypes> items;
	const auto segment = [&](std::uint32_t i_Index) { return items.Segment(TestSubject::c_Id, i_Index); };
	const NVX::ISelectionItem root = segment(TestSubject::ERoot), spine = segment(TestSubject::ESpine),
	                          limb = segment(TestSubject::ELimb), body = items.Target(TestSubject::c_Id, 2),
	                          rotation = items.Target(TestSubject::c_Id, 1), subject = items.Subject(TestSubject::c_Id);
	const struct
	{
		const char* m_pName;
		std::vector<NVX::ISelectionItem> m_Selected;
		std::vector<NVX::ISelectionItem> m_Preselected = {};
		std::uint32_t m_Modifier = CoreGraphics::EModifierNone;
	} c_Rows[] = {
	    {"selected", {spine}},
	    {"selected-two", {spine, limb}},
	    {"selected-of-other-kinds", {subject, rotation, body}},
	    {"preselected", {limb}, {spine}},
	    {"preselected-to-add", {limb}, {spine}, CoreGraphics::EModifierAdd},
	    {"preselected-to-subtract", {limb}, {limb}, CoreGraphics::EModifierSubtract},
	    {"preselected-to-toggle", {limb}, {limb, spine}, CoreGraphics::EModifierToggle},
	    {"preselected-primary", {spine, limb, root}, {spine}},
	    {"preselected-of-other-kinds", {}, {subject, rotation, body}, CoreGraphics::EModifierAdd},
	};
	for (const auto& rRow : c_Rows)
	{
		m_pSelection->Selection().Replace(rRow.m_Selected);
		m_pSelection->PreSelection().Replace(rRow.m_Preselected);
		m_Renderer.m_Input.m_ModifierState = rRow.m_Modifier;
		Compare(Draw(c_Small), rRow.m_pName);
	}
}

TEST_P(Pictures, OfTheManipulator)
{
	using namespace OrlexGraphics;
	const struct
	{
		const char* m_pName;
		std::uint32_t m_ModeMask;
		std::optional<VManipulatorHandle> m_Hovered = {};
		/// How far the mouse then drags it, from above the middle of the picture.
		std::optional<QPoint> m_Drag = {};
		std::uint32_t m_Type = CoreGraphics::ECameraPerspective;
		float m_Scale = 1.0f;
	} c_Rows[] = {
	    {"manipulator", 7},
	    {"manipulator-arrows", 1},
	    {"manipulator-planes", 2},
	    {"manipulator-rings", 4},
	    {"manipulator-arrow-hover", 7, VManipulatorHandle{EManipulatorArrow, 1}},
	    {"manipulator-plane-hover", 7, VManipulatorHandle{EManipulatorPlane, 2}},
	    {"manipulator-ring-hover", 7, VManipulatorHandle{EManipulatorRing, 0}},
	    {"manipulator-arrow-drag", 7, VManipulatorHandle{EManipulatorArrow, 1}, QPoint(-40, 0)},
	    {"manipulator-plane-drag", 7, VManipulatorHandle{EManipulatorPlane, 2}, QPoint(-30, 10)},
	    {"manipulator-ring-drag", 4, VManipulatorHandle{EManipulatorRing, 0}, QPoint(30, 30)},
	    {"manipulator-front", 7, {}, {}, CoreGraphics::ECameraFront},
	    {"manipulator-small", 7, {}, {}, CoreGraphics::ECameraPerspective, 0.4f},
	};
	ShowSmall();
	ShowOnly("SolvingSubject", {"Enabled", "Bones"});
	VRenderManipulator& rManipulator = *m_pScene->RenderManipulator();
	QMatrix4x4 transform;
	transform.translate(10, 170, 130);
	for (const auto& rRow : c_Rows)
	{
		VView view = c_Small;
		view.m_Centre = transform.column(3).toVector3D();
		view.m_Type = rRow.m_Type;
		view.m_Scale = 1.0f;
		rManipulator.SetTransform(transform);
		rManipulator.SetVisible(true);
		rManipulator.SetModeMask(rRow.m_ModeMask);
		Options().m_ManipulatorScale = rRow.m_Scale;
		m_pSelection->PreSelection().Replace({});
		if (rRow.m_Hovered)
			m_pSelection->PreSelection().Replace({HandleItem(*rRow.m_Hovered)});
		if (rRow.m_Drag)
		{
			const CoreGraphics::VCameraController& rCamera = SetView(view);
			rManipulator.Press(rCamera, {160, 70});
			rManipulator.Drag(rCamera, QPoint(160, 70) + *rRow.m_Drag, {});
			ASSERT_TRUE(rManipulator.IsDragging()) << rRow.m_pName;
		}
		Compare(Draw(view), rRow.m_pName);
		rManipulator.Release();
	}
	// On a fine display it is as large in millimetres of the display.
	const QImage doubled = Draw(c_Small);
	m_Renderer.m_Input.m_PixelRatio = 2.0;
	Options().m_ManipulatorScale *= 0.5f;
	EXPECT_EQ(Draw(c_Small), doubled);
}

TEST_P(Pictures, WalkOverWhatDoesNotChange)
{
	ASSERT_NO_FATAL_FAILURE(ShowDemo());
	OrlexGraphics::VSubjectOptions& rOptions = Options().m_SolvingSubject;
	rOptions.m_bAxes = rOptions.m_bJoints = rOptions.m_bTargets = rOptions.m_bTargetCovariances = true;
	Options().m_LabellingSubject = rOptions;
	m_pSelection->Selection().Replace({VSubjectSelectionMaker<VFlowSubjectTypes>().Segment(TestSubject::c_Id, 1)});
	Draw({{0, 0, 900}, 3000.0f});
	ExpectThatAFrameIsAWalk();
}

TEST_P(Pictures, PicksFindWhatIsSeen)
{
	ShowSmall();
	ShowOnly("SolvingSubject", {"Enabled", "Bones", "Targets"});
	Draw(c_Small);
	const VSubjectSelectionMaker<VFlowSubjectForSolvingTypes> items;
	const struct
	{
		QVector3D m_Place;
		NVX::ISelectionItem m_Item;
	} c_Rows[] = {
	    // Far from the spine's own origin: the middle of its bone.
	    {{10, 170, 130}, items.Segment(TestSubject::c_Id, TestSubject::ESpine)},
	    {{10, 20, 70}, items.Segment(TestSubject::c_Id, TestSubject::ERoot)},
	    {{40, -10, 31}, items.Subject(TestSubject::c_Id)},
	    {{10, 310, 200}, items.Target(TestSubject::c_Id, TestSubject::EBody)},
	};
	for (const auto& rRow : c_Rows)
	{
		const std::vector<NVX::ISelectionItem> picked = PickAt(rRow.m_Place);
		ASSERT_EQ(picked.size(), 1u) << rRow.m_Item.m_Kind << " " << rRow.m_Item.m_ElementIndex;
		EXPECT_EQ(picked[0], rRow.m_Item) << picked[0].m_Kind << " " << picked[0].m_ElementIndex;
	}

	// What is there to be looked at alone is in no rectangle: the plates are.
	ShowOnly("SolvingSubject", {"Enabled", "Axes", "TargetCovariances", "MissingMarkers"});
	const CoreOrlexTypes::VReconstructionLabelSet labels{{{TestSubject::c_Id, 0, {0, 320, 130}}}};
	ShowSmall(VFlowSubjectForSolvingTypes::c_Types, &labels);
	Draw(c_Small);
	const std::vector<NVX::ISelectionItem> picked = Pick({319, 239}, QPoint());
	EXPECT_EQ(picked.size(), 2u);
	for (const auto& rItem : {items.Subject(TestSubject::c_Id), items.Segment(TestSubject::c_Id, TestSubject::ELimb)})
		EXPECT_EQ(std::count(picked.begin(), picked.end(), rItem), 1) << rItem.m_Kind;
}

} // namespace
