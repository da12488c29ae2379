#include "../CoreGraphics/OffscreenContext.h"
#include "NVX/ISelectionItem.h"
#include "OrlexGraphics/FrameRenderer.h"
#include "OrlexGraphics/RenderManipulator.h"
#include "RetargetSetupDocument/Identity.h"
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
