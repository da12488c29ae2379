#include "PicturesFixture.h"

#include "../OrlexGraphics/Allocations.h"
#include "CoreOrlexQRTIO/Reader.h"
#include "CoreOrlexTypesUtils/PoseVector.h"
#include "CoreOrlexTypesUtils/SubjectParametrisedConverter.h"
#include "Flow2Graphics/SubjectTypes.h"
#include "OrlexGraphics/SelectionRegistry.h"
#include "TestSubject.h"

#include <functional>

namespace
{

using namespace Flow2Graphics;
using OrlexGraphics::VSubjectOptions;
using TestSubject::Item;

class Pictures : public VPicturesTest
{
protected:
	/// The small subject as one for solving.
	void ShowSmall(const CoreOrlexTypes::VReconstructionLabelSet* i_pLabels = nullptr)
	{
		auto items = std::vector{Item("FlowSubjectForSolving", TestSubject::Make()),
		    Item("FlowSubjectApplicationDataForSolving", TestSubject::MakeData()),
		    Item("FlowSubjectDynamicParametersForSolving", TestSubject::MakePose())};
		if (i_pLabels)
			items.push_back(Item("FlowReconstructionLabelSetForSolving", *i_pLabels));
		m_pScene->SetFrame(TestSubject::Frame(items));
	}

	/// Performer and character of the demo, in the poses that their files hold.
	void ShowDemo()
	{
		std::vector<NVX::CountedPointer<TesselPluginInterface::IFlowItem>> items;
		const auto add = [&items](const std::string& i_rPath, const VSubjectTypes& i_rTypes, auto i_pStatistic)
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
			items.push_back(Item(i_rTypes.m_Class == ESubjectClassSolving ? "FlowSubjectForSolving" : "FlowSubject",
			    std::move(subject)));
			items.push_back(Item(i_rTypes.m_Class == ESubjectClassSolving ? "FlowSubjectApplicationDataForSolving"
			                                                              : "FlowSubjectApplicationData",
			    std::move(data)));
			items.push_back(Item(i_rTypes.m_Class == ESubjectClassSolving ? "FlowSubjectDynamicParametersForSolving"
			                                                              : "FlowSubjectDynamicParameters",
			    CoreOrlexTypes::VSubjectDynamicParameters{
			        TestSubject::c_Id, CoreOrlexTypesUtils::PoseVector(parametrised, i_pStatistic)}));
		};
		using VJoint = CoreOrlexTypes::VSubjectParametrised::VJoint;
		add(RETARGET_SOURCE "/demo/performer.qrs", VFlowSubjectTypes::c_Types, &VJoint::m_BindPose);
		add(RETARGET_TEST_DATA "/pictures/kestrel.qrr", VFlowSubjectForSolvingTypes::c_Types, &VJoint::m_BindPose);
		m_pScene->SetFrame(TestSubject::Frame(items));
	}
};

VSubjectOptions Only(const std::function<void(VSubjectOptions&)>& i_rSwitchOn)
{
	VSubjectOptions options;
	options.m_bBones = options.m_bMarkers = options.m_bSticks = options.m_bMissingMarkers = options.m_bSkin = false;
	i_rSwitchOn(options);
	return options;
}

const VView c_Small{{0, 170, 110}, 460.0f, -65.0f, 60.0f};

TEST_F(Pictures, OfEachThingThatASubjectIsDrawnAs)
{
	const struct
	{
		const char* m_pName;
		std::function<void(VSubjectOptions&)> m_SwitchOn;
	} c_Rows[] = {
	    {"origins", [](VSubjectOptions&) {}},
	    {"bones", [](VSubjectOptions& o_rOptions) { o_rOptions.m_bBones = true; }},
	    {"joints", [](VSubjectOptions& o_rOptions) { o_rOptions.m_bJoints = true; }},
	    {"axes", [](VSubjectOptions& o_rOptions) { o_rOptions.m_bAxes = true; }},
	    {"targets", [](VSubjectOptions& o_rOptions) { o_rOptions.m_bTargets = true; }},
	    {"covariances", [](VSubjectOptions& o_rOptions) { o_rOptions.m_bTargetCovariances = true; }},
	    {"markers", [](VSubjectOptions& o_rOptions) { o_rOptions.m_bMarkers = true; }},
	    {"sticks", [](VSubjectOptions& o_rOptions) { o_rOptions.m_bSticks = o_rOptions.m_bMarkers = true; }},
	};
	ShowSmall();
	Options().m_LabellingSubject.m_bEnabled = false;
	for (const auto& rRow : c_Rows)
	{
		Options().m_SolvingSubject = Only(rRow.m_SwitchOn);
		Compare(Draw(c_Small), rRow.m_pName);
	}
	// Nothing of it is drawn when it is switched off.
	Options().m_SolvingSubject = VSubjectOptions();
	Options().m_SolvingSubject.m_bEnabled = false;
	const QImage nothing = Draw(c_Small);
	for (int y = 0; y < nothing.height(); ++y)
		for (int x = 0; x < nothing.width(); ++x)
			ASSERT_EQ(nothing.pixel(x, y), 0xff202020u) << x << " " << y;
}

TEST_F(Pictures, OfMissingMarkers)
{
	const CoreOrlexTypes::VReconstructionLabelSet labels{
	    {{TestSubject::c_Id, 0, {0, 320, 130}}, {TestSubject::c_Id, 1, {10, 360, 190}}}};
	ShowSmall(&labels);
	const auto options = [](bool i_bGaps)
	{
		return Only(
		    [i_bGaps](VSubjectOptions& o_rOptions)
		    {
			    o_rOptions.m_bMissingMarkers = o_rOptions.m_bMarkers = o_rOptions.m_bSticks = true;
			    o_rOptions.m_bSticksDuringGaps = i_bGaps;
		    });
	};
	const VView near{{0, 320, 160}, 260.0f, -65.0f, 60.0f};
	Options().m_SolvingSubject = options(false);
	Compare(Draw(near), "missing-markers");
	Options().m_SolvingSubject = options(true);
	Compare(Draw(near), "sticks-during-gaps");
}

TEST_F(Pictures, OfTranslucentBonesBesideASource)
{
	ShowSmall();
	const auto bones = Only([](VSubjectOptions& o_rOptions) { o_rOptions.m_bBones = true; });
	Options().m_SolvingSubject = Options().m_LabellingSubject = bones;
	const QImage dual = Draw(c_Small);
	Compare(dual, "bones-translucent");
	Options().m_LabellingSubject.m_bBones = false;
	EXPECT_NE(Draw(c_Small), dual) << "alone it is opaque";
}

TEST_F(Pictures, OfSourceAndTarget)
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

TEST_F(Pictures, OfOutlines)
{
	ShowSmall();
	Options().m_SolvingSubject = Only([](VSubjectOptions& o_rOptions) { o_rOptions.m_bBones = true; });
	const VSubjectSelectionMaker<VFlowSubjectForSolvingTypes> items;
	m_pSelection->Selection().Replace({items.Segment(TestSubject::c_Id, TestSubject::ERoot)});
	Compare(Draw(c_Small), "selected");
	m_pSelection->Selection().Add({items.Segment(TestSubject::c_Id, TestSubject::ELimb)});
	Compare(Draw(c_Small), "selected-two");
	m_pSelection->PreSelection().Replace({items.Segment(TestSubject::c_Id, TestSubject::ESpine)});
	for (std::uint32_t modifier = 0; modifier < 4; ++modifier)
	{
		m_Renderer.m_Input.m_ModifierState = modifier;
		Compare(Draw(c_Small), "preselected-" + std::to_string(modifier));
	}
}

TEST_F(Pictures, TakeNoMemoryForAFrameThatDoesNotChange)
{
	ASSERT_NO_FATAL_FAILURE(ShowDemo());
	VSubjectOptions& rOptions = Options().m_SolvingSubject;
	rOptions.m_bAxes = rOptions.m_bJoints = rOptions.m_bTargets = rOptions.m_bTargetCovariances = true;
	Options().m_LabellingSubject = rOptions;
	for (int i = 0; i < 3; ++i)
		Draw({{0, 0, 900}, 3000.0f});
	const std::size_t before = AllocationCount();
	m_Renderer.Render(*m_pTarget);
	EXPECT_EQ(AllocationCount() - before, 0u);
}

TEST_F(Pictures, PicksFindWhatIsSeen)
{
	ShowSmall();
	Options().m_SolvingSubject =
	    Only([](VSubjectOptions& o_rOptions) { o_rOptions.m_bBones = o_rOptions.m_bTargets = true; });
	Draw(c_Small);
	const CoreGraphics::VCameraController& rCamera = m_Renderer.m_Input.m_Camera;
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
		const QVector3D ndc = (rCamera.m_Projection * rCamera.m_View).map(rRow.m_Place);
		OrlexGraphics::VPickRequest request;
		request.m_Mouse = QPoint(int((ndc.x() * 0.5f + 0.5f) * 320.0f), int((0.5f - ndc.y() * 0.5f) * 240.0f));
		OrlexGraphics::VPick pick;
		m_Renderer.Pick(request, pick);
		ASSERT_EQ(pick.m_Items.size(), 1u) << rRow.m_Item.m_Kind << " " << rRow.m_Item.m_ElementIndex;
		EXPECT_EQ(pick.m_Items[0], rRow.m_Item) << pick.m_Items[0].m_Kind << " " << pick.m_Items[0].m_ElementIndex;
	}
}

} // namespace
