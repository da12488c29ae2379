#include "CoreOrlexTypes/SubjectParametrised.h"
#include "Flow2Graphics/FlowRenderSubjects.h"
#include "Flow2Graphics/FlowSubjectSceneTransform.h"
#include "Flow2TypesUtils/ParameterSet.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "TestSubject.h"

#include <gtest/gtest.h>

namespace
{

using namespace Flow2Graphics;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectDynamicParameters;
using CoreOrlexTypes::VSubjectParametrised;
using CoreOrlexTypes::VSubjectSettings;
using Flow2TypesUtils::FlowSubjectSceneTransformItem;
using Flow2TypesUtils::FlowUpAxisItem;
using TesselPluginInterface::ItemValue;
using TestSubject::Item;
using TestSubject::MakeFrame;
using VPlaced = VFlowSubjectSceneArrangement::VPlaced;

TEST(Arrangement, RowsOfTheClassesSortedByName)
{
	VFlowSubjectSceneArrangement::VGroups groups;
	EXPECT_EQ(VFlowSubjectSceneArrangement::Arrange(groups, false), (std::array{-1000, 1000, -1000, 1000}));

	groups[ESubjectClassLabelling] = {{"b", {1, 1}}};
	EXPECT_EQ(VFlowSubjectSceneArrangement::Arrange(groups, false), (std::array{-1000, 1000, -1000, 1000}));
	EXPECT_EQ(groups[ESubjectClassLabelling][0].m_Translation, (std::array{0.0, 0.0, 1000.0}));

	groups[ESubjectClassLabelling] = {{"c", {1, 3}}, {"a", {1, 1}}, {"b", {1, 2}}};
	groups[ESubjectClassRigidObject] = {};
	groups[ESubjectClassSolving] = {{"y", {2, 1}}, {"x", {2, 2}}};
	EXPECT_EQ(VFlowSubjectSceneArrangement::Arrange(groups, false), (std::array{-3000, 3000, -1000, 3000}));
	const std::vector<VPlaced> first = {
	    {"a", {1, 1}, {-2000, 0, 1000}}, {"b", {1, 2}, {0, 0, 1000}}, {"c", {1, 3}, {2000, 0, 1000}}};
	EXPECT_EQ(groups[ESubjectClassLabelling], first);
	const std::vector<VPlaced> second = {{"x", {2, 2}, {-1000, 2000, 1000}}, {"y", {2, 1}, {1000, 2000, 1000}}};
	EXPECT_EQ(groups[ESubjectClassSolving], second);

	VFlowSubjectSceneArrangement::Arrange(groups, true);
	EXPECT_EQ(groups[ESubjectClassSolving][0].m_Translation, (std::array{-1000.0, 1000.0, 2000.0}));
}

class SceneTransform : public testing::Test
{
protected:
	SceneTransform()
	{
		for (const char* const pName : {"PoseIndex", "LabellingPoseIndex", "SolvingPoseIndex"})
			m_pParameters->Add(std::make_unique<Flow2Utils::VParameterTyped<std::uint32_t>>(pName));
		m_Transform.SetParameters(m_pParameters);
	}

	static VSubjectParametrised Parametrised()
	{
		VSubjectParametrised subject;
		subject.m_SubjectId = TestSubject::c_Id;
		subject.m_Segments.resize(2);
		for (double i = 0; VSubjectParametrised::VSegment & rSegment : subject.m_Segments)
		{
			auto& rJoint = rSegment.m_Joint;
			rJoint.m_JointType = VSubjectParametrised::VJoint::EHinge;
			for (auto* const pStatistic : {&rJoint.m_Mean, &rJoint.m_RangeCentringState, &rJoint.m_TemplateMean,
			         &rJoint.m_TemplateRangeCentringState, &rJoint.m_TPoseMean, &rJoint.m_BindPose})
				*pStatistic = {++i};
		}
		return subject;
	}

	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> Run(
	    const NVX::CountedPointer<TesselPluginInterface::IFlowFrame>& i_rpFrame)
	{
		NVX::CountedPointer<TesselPluginInterface::IFlowFrame> pOut;
		m_Transform.Transform(pOut, i_rpFrame, 0);
		return pOut;
	}

	void SetIndex(const char* i_pName, std::uint32_t i_Index)
	{
		ASSERT_EQ(m_pParameters->SetValue(i_pName, i_Index), 0u);
	}

	const std::shared_ptr<Flow2Utils::VParameterSet> m_pParameters = std::make_shared<Flow2Utils::VParameterSet>();
	VFlowSubjectSceneTransform m_Transform{
	    NVX::CountedPointer<TesselPluginInterface::IItemFactory>(new InMemoryHost::VItemFactory)};
	const NVX::CountedPointer<TesselPluginInterface::IFlowFrame> m_pFrame =
	    MakeFrame({Item("FlowSubject", TestSubject::Make()), Item("FlowSubjectParametrised", Parametrised()),
	        Item("FlowSubjectDynamicParameters", TestSubject::MakePose())});
};

TEST_F(SceneTransform, PosesAreThoseOfTheIndex)
{
	const auto pose = [](const auto& i_rpFrame)
	{ return ItemValue<VSubjectDynamicParameters>(i_rpFrame->Item("FlowSubjectDynamicParameters"))->m_State; };
	const auto own = TestSubject::MakePose().m_State;
	EXPECT_EQ(pose(Run(m_pFrame)), own);
	for (std::uint32_t index = 1; index <= 6; ++index)
	{
		SetIndex("PoseIndex", index);
		EXPECT_EQ(pose(Run(m_pFrame)), (std::vector<double>{double(index), double(index + 6)})) << index;
		EXPECT_EQ(pose(Run(m_pFrame)), (std::vector<double>{double(index), double(index + 6)})) << "again";
	}
	SetIndex("LabellingPoseIndex", 2);
	EXPECT_EQ(pose(Run(m_pFrame))[0], 2.0);
	SetIndex("SolvingPoseIndex", 3);
	EXPECT_EQ(pose(Run(m_pFrame))[0], 3.0);
	SetIndex("SolvingPoseIndex", 0);
	EXPECT_EQ(pose(Run(m_pFrame))[0], 2.0);
	SetIndex("LabellingPoseIndex", 7);
	EXPECT_EQ(pose(Run(m_pFrame)), own) << "no such pose";
	EXPECT_EQ(pose(m_pFrame), own) << "the frame that came in stays";
	EXPECT_EQ(Run(nullptr), nullptr);
}

TEST_F(SceneTransform, IsMadeAnewOnlyWhenSomethingChanges)
{
	const auto item = [&] { return Run(m_pFrame)->Item(FlowSubjectSceneTransformItem::c_pName); };
	const auto pFirst = item();
	ASSERT_TRUE(pFirst);
	EXPECT_EQ(item(), pFirst);
	SetIndex("LabellingPoseIndex", 1);
	const auto pSecond = item();
	EXPECT_NE(pSecond, pFirst);
	EXPECT_EQ(item(), pSecond) << "dropped once";

	const auto pValue = ItemValue<FlowSubjectSceneTransformItem>(pSecond);
	EXPECT_EQ(pValue->m_Translations.at({4114, TestSubject::c_Id}), (std::array{0.0, 0.0, 1000.0}));
	m_pFrame->AddItem(Item(FlowUpAxisItem::c_pName, FlowUpAxisItem{FlowUpAxisItem::c_Y}));
	EXPECT_EQ(ItemValue<FlowSubjectSceneTransformItem>(item())->m_Translations.at({4114, TestSubject::c_Id}),
	    (std::array{0.0, 1000.0, 0.0}));

	m_Transform.SetMode(0);
	EXPECT_EQ(item(), nullptr) << "all in one world";
}

TEST_F(SceneTransform, PropsAreAnotherClass)
{
	m_pFrame->AddItem(Item("FlowSubjectSettings", VSubjectSettings{TestSubject::c_Id, true}));
	Run(m_pFrame);
	EXPECT_TRUE(m_Transform.Arrangement().Groups().contains(ESubjectClassProp));
	EXPECT_FALSE(m_Transform.Arrangement().Groups().contains(ESubjectClassLabelling));
	m_pFrame->AddItem(Item("FlowSubjectSettings", VSubjectSettings{TestSubject::c_Id + 1, true}));
	Run(m_pFrame);
	EXPECT_FALSE(m_Transform.Arrangement().Groups().contains(ESubjectClassProp));
}

TEST_F(SceneTransform, ListsTakeTheirSubjectsAndPlaces)
{
	VFlowRenderSubjectList list(std::make_shared<const VSubjectSelectionMaker<VFlowSubjectTypes>>());
	VFlowRenderSubjectList props(std::make_shared<const VSubjectSelectionMaker<VFlowPropTypes>>());
	OrlexGraphics::VSelectionRegistry registry;
	VFlowContext context{registry};
	FlowSubjectSceneTransformItem aside;
	aside.m_Translations[{4114, TestSubject::c_Id}] = {0, 0, 1000};
	list.Update(*m_pFrame, context, &aside);
	props.Update(*m_pFrame, context, nullptr);
	EXPECT_TRUE(props.Subjects().empty());
	ASSERT_EQ(list.Subjects().size(), 1u);
	EXPECT_TRUE(list.IsRebindSet());
	EXPECT_EQ(list.Data()[0]->m_BoneSpheres[0].m_PositionAndSize.z(), 1030.0f);
	EXPECT_EQ(registry.GetName(list.Data()[0]->m_Id.m_Id), "Ann");

	const auto* const pSubject = list.Subjects()[0].get();
	list.Update(*m_pFrame, context, nullptr);
	EXPECT_EQ(list.Subjects()[0].get(), pSubject) << "the same items, the same subject";
	EXPECT_EQ(list.Data()[0]->m_BoneSpheres[0].m_PositionAndSize.z(), 30.0f);

	m_pFrame->AddItem(Item("FlowSubjectSettings", VSubjectSettings{TestSubject::c_Id, true}));
	list.Update(*m_pFrame, context, nullptr);
	props.Update(*m_pFrame, context, nullptr);
	EXPECT_TRUE(list.Subjects().empty());
	EXPECT_EQ(props.Subjects().size(), 1u);

	const auto pOther = MakeFrame({Item("FlowSubjectForSolving", TestSubject::Make())});
	props.Update(*pOther, context, nullptr);
	EXPECT_EQ(props.Subjects().size(), 1u) << "a frame without its items leaves it";
	props.Forget();
	props.Update(*pOther, context, nullptr);
	EXPECT_TRUE(props.Subjects().empty());
	props.Update(*m_pFrame, context, nullptr);
	EXPECT_EQ(props.Subjects().size(), 1u) << "the same items again";
	pOther->AddItem(Item("FlowSubjectSettings", VSubjectSettings{TestSubject::c_Id, true}));
	props.Update(*pOther, context, nullptr);
	EXPECT_TRUE(props.Subjects().empty()) << "gone with the next change";
	EXPECT_TRUE(props.Data().empty());
}

} // namespace
