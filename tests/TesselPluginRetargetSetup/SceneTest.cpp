#include "../CoreGraphics/OffscreenContext.h"
#include "InMemoryHost/Application.h"
#include "NVX/SelectionItemVariant.h"
#include "OrlexGraphics/frame/FrameRenderer.h"
#include "OrlexGraphics/manipulator/RenderManipulator.h"
#include "RetargetSetupCore/Identity.h"
#include "TestPanel.h"

#include <QOpenGLFramebufferObject>

namespace
{

/// The preview drawn off the screen.
class Scene : public VPanelTest
{
protected:
	void SetUp() override
	{
		ASSERT_TRUE(m_GL.IsValid());
		OpenDemo();
		m_pDocument->CreateTargetSubject();
		Run();
		m_Renderer.Initialise();
		m_Renderer.SetScene(m_pScene);
		m_Renderer.SetSize(m_Size);
		m_pTarget = std::make_unique<QOpenGLFramebufferObject>(m_Size, m_Renderer.TargetFormat());
		Run();
		Frame();
		ASSERT_TRUE(m_pScene->RenderManipulator());
	}

	/// One frame, and what follows from it.
	void Frame()
	{
		m_pScene->Synchronise();
		m_Renderer.Update();
		m_Renderer.Render(*m_pTarget);
		m_pScene->Synchronise();
		Run();
	}

	void SelectSegment(std::uint32_t i_Index)
	{
		Select(NVX::ESelectionTargetSegment, i_Index);
		Run();
		Frame();
	}

	std::uint32_t IndexOf(const std::string& i_rName) const
	{
		const auto segments = Target().m_Segments;
		for (std::uint32_t i = 0; i < segments.size(); ++i)
			if (segments[i].m_Name == i_rName)
				return i;
		ADD_FAILURE() << i_rName;
		return 0;
	}

	/// As the last frame has it.
	QMatrix4x4 World(std::uint32_t i_Index) const
	{
		QMatrix4x4 matrix;
		EXPECT_TRUE(m_pScene->GetItemTransform(
		    {{NVX::ESelectionTargetSegment, RetargetSetup::c_SubjectId, i_Index, {}}}, matrix));
		return matrix;
	}

	OrlexGraphics::VRenderManipulator& Manipulator() { return *m_pScene->RenderManipulator(); }

	const QSize m_Size{64, 48};
	GraphicsTest::VOffscreenContext m_GL{GraphicsTest::EDialect::Desktop};
	OrlexGraphics::VFrameRenderer m_Renderer;
	std::unique_ptr<QOpenGLFramebufferObject> m_pTarget;
};

float Distance(const QMatrix4x4& i_rA, const QMatrix4x4& i_rB)
{
	float largest = 0.0f;
	for (int row = 0; row < 4; ++row)
		for (int column = 0; column < 4; ++column)
			largest = std::max(largest, std::abs(i_rA(row, column) - i_rB(row, column)));
	return largest;
}

TEST_F(Scene, ShowsTheManipulatorAtTheSelectedSegment)
{
	EXPECT_FALSE(Manipulator().IsVisible());
	for (const std::uint32_t index : {0u, 3u})
	{
		SelectSegment(index);
		EXPECT_TRUE(Manipulator().IsVisible());
		EXPECT_EQ(Manipulator().Transform(), World(index)) << index;
	}
	Select(NVX::ESelectionSourceSegment, 2);
	m_pScene->SelectionManager()->Selection().Replace({{NVX::ESelectionSourceSegment, 1, 2, {}}});
	Run();
	EXPECT_FALSE(Manipulator().IsVisible()) << "no target segment";

	SelectSegment(3);
	auto target = Target();
	target.m_Segments[3].m_Joint = {};
	m_pDocument->SetTargetSubjectParametrised(std::move(target));
	Run();
	Frame();
	EXPECT_FALSE(Manipulator().IsVisible()) << "its joint was removed";
	SelectSegment(100000);
	EXPECT_FALSE(Manipulator().IsVisible()) << "no such segment";
}

TEST_F(Scene, SegmentsStandWhereTheManipulatorIsDragged)
{
	SelectSegment(0);
	QMatrix4x4 place = World(0);
	place.setColumn(3, QVector4D(100, -200, 1000, 1));
	place.rotate(30, 1, 2, 3);
	Manipulator().ChangedSignal().Fire(place);
	Run();
	Frame();
	EXPECT_LT(Distance(World(0), place), 1e-2f) << "the root turns and moves";

	const std::uint32_t arm = IndexOf("collarLeft") + 1;
	SelectSegment(arm);
	const QMatrix4x4 before = World(arm);
	QMatrix4x4 turned = before;
	turned.rotate(40, 0, 1, 0);
	Manipulator().ChangedSignal().Fire(turned);
	Run();
	Frame();
	EXPECT_LT(Distance(World(arm), turned), 1e-2f);
	EXPECT_EQ(Target().m_Segments[arm].m_Joint.m_Mean, Target().m_Segments[arm].m_Joint.m_BindPose);

	turned.setColumn(3, QVector4D(0, 0, 0, 1));
	Manipulator().ChangedSignal().Fire(turned);
	Run();
	Frame();
	EXPECT_LT((World(arm).column(3) - before.column(3)).length(), 1e-2f) << "a limb does not leave its parent";
}

TEST_F(Scene, MirrorsTheChangeWhereTheHostWantsIt)
{
	m_pDocument->LoadTargetFBX(RETARGET_TEST_DATA "/fbx/own_ns_yup_cm_b7400.fbx");
	m_pDocument->CreateTargetSubject();
	Run();
	Frame();
	const std::uint32_t arm = IndexOf("LeftForeArm"), other = IndexOf("RightForeArm");
	const std::uint32_t upper = IndexOf("LeftArm"), otherUpper = IndexOf("RightArm");
	const auto drag = [&](std::uint32_t i_Segment, std::uint32_t i_Other, float i_Degrees)
	{
		SelectSegment(i_Segment);
		const QMatrix4x4 before = World(i_Other);
		QMatrix4x4 turned = World(i_Segment);
		turned.rotate(i_Degrees, 0, 1, 0);
		Manipulator().ChangedSignal().Fire(turned);
		Run();
		Frame();
		return Distance(before, World(i_Other));
	};
	EXPECT_GT(drag(arm, other, 1), 0.3f) << "the pose itself is mirrored";
	const auto pApplication = std::make_shared<InMemoryHost::VApplication>();
	pApplication->m_Rules.m_bMirrorChange = true;
	m_pDocument->SetHostRules(pApplication);
	m_pDocument->CreateTargetSubject();
	Run();
	Frame();
	TakeLog();
	NVX::GlobalLog::Category("RetargetSetup").SetLevel(NVX::ELogInformation);
	for (int i = 0; i < 2; ++i)
	{
		EXPECT_LT(drag(arm, other, 1), 0.02f);
		EXPECT_EQ(TakeLog().find("mirrors what changes in a pose") != std::string::npos, i == 0) << "told once";
	}
	m_pDocument->SetJointSymmetry(false);
	EXPECT_EQ(drag(upper, otherUpper, 30), 0.0f);
	m_pDocument->SetJointSymmetry(true);
	EXPECT_GT(drag(upper, otherUpper, 1), 0.3f) << "these are mirror images: it comes to the pose of the other side";

	auto renamed = Target();
	renamed.m_Segments[arm].m_Name = "bras gauche";
	renamed.m_Segments[other].m_Name = "bras droit";
	m_pDocument->SetTargetSubject(std::move(renamed), *m_pDocument->TargetValues().m_pApplicationData, {});
	for (const bool bBySides : {false, true})
	{
		pApplication->m_Rules.m_bPartnersBySides = bBySides;
		SelectSegment(arm);
		const std::vector<double> before = Target().m_Segments[other].m_Joint.m_BindPose;
		drag(arm, other, 1);
		EXPECT_EQ(Target().m_Segments[other].m_Joint.m_BindPose != before, bBySides);
	}
	NVX::GlobalLog::Category("RetargetSetup").SetLevel(NVX::ELogWarning);
}

TEST_F(Scene, ConnectsTheManipulatorOnce)
{
	const auto pManipulator = m_pScene->RenderManipulator();
	m_pScene->InitialiseGL();
	EXPECT_EQ(m_pScene->RenderManipulator(), pManipulator);
	int changes = 0;
	m_pDocument->GetChangedSignal().Connect([&changes] { ++changes; });
	SelectSegment(0);
	pManipulator->ChangedSignal().Fire(World(0));
	EXPECT_EQ(changes, 1);
}

TEST_F(Scene, TellsOfAJointThatCannotFollow)
{
	auto target = Target();
	target.m_Segments[3].m_Joint.m_JointOrientation = {0.1, 0, 0};
	m_pDocument->SetTargetSubjectParametrised(std::move(target));
	Run();
	for (const std::uint32_t index : {2u, 3u})
	{
		SelectSegment(index);
		TakeLog();
		Manipulator().BeginSignal().Fire();
		EXPECT_EQ(TakeLog().find("does not follow the manipulator") != std::string::npos, index == 3) << index;
	}
}

} // namespace
