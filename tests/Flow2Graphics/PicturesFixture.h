#pragma once

#include "../CoreGraphics/OffscreenContext.h"
#include "../PictureTest.h"

#include "CoreGraphics/ShaderLibrary.h"
#include "Flow2Graphics/FlowScene.h"
#include "InMemoryHost/Dispatcher.h"
#include "InMemoryHost/Selection.h"
#include "OrlexGraphics/FrameRenderer.h"

#include <QImage>
#include <QOpenGLFramebufferObject>

struct VView
{
	QVector3D m_Centre = {};
	float m_Distance = 1000.0f;
	float m_Pitch = -70.0f;
	float m_Yaw = 30.0f;
	std::uint32_t m_Type = CoreGraphics::ECameraPerspective;
	/// Millimetres of a pixel, where there is no perspective.
	float m_Scale = 10.0f;
};

/// Frames of the flow scene, without floor and axes unless a test wants them.
class VPicturesTest : public GraphicsTest::InBothDialects
{
protected:
	void SetUp() override
	{
		ASSERT_NO_FATAL_FAILURE(InBothDialects::SetUp());
		m_pScene = std::make_shared<Flow2Graphics::VFlowScene>(m_pShaders, m_pSelection, nullptr, m_pDispatcher, false);
		m_Renderer.Initialise();
		m_Renderer.SetScene(m_pScene);
		m_Renderer.SetSize(m_Size);
		m_pTarget = std::make_unique<QOpenGLFramebufferObject>(m_Size, m_Renderer.TargetFormat());
		Options().m_bFloorGrid = Options().m_bGlobalAxis = false;
	}
	OrlexGraphics::VSceneOptions& Options() { return m_Renderer.m_Input.m_Options; }

	CoreGraphics::VCameraController& SetView(const VView& i_rView)
	{
		CoreGraphics::VCameraController& rCamera = m_Renderer.m_Input.m_Camera;
		rCamera.m_Centre = i_rView.m_Centre;
		rCamera.m_Distance = i_rView.m_Distance;
		rCamera.m_Pitch = i_rView.m_Pitch;
		rCamera.m_Yaw = i_rView.m_Yaw;
		rCamera.m_Type = i_rView.m_Type;
		rCamera.m_OrthographicScale = i_rView.m_Scale;
		rCamera.m_bYUp = m_pScene->YUp();
		rCamera.SetSize(m_Size);
		rCamera.Update();
		return rCamera;
	}

	QImage Draw(const VView& i_rView)
	{
		SetView(i_rView);
		m_pScene->SetNeedsRefresh();
		m_pScene->Synchronise();
		m_Renderer.Update();
		m_Renderer.Render(*m_pTarget);
		return m_pTarget->toImage().convertToFormat(QImage::Format_RGB32);
	}

	/// Beside the stored one of the dialect: OpenGL ES has no samples, its edges are steps.
	void Compare(const QImage& i_rImage, const std::string& i_rName)
	{
		EXPECT_TRUE(
		    PictureTest::Matches(i_rImage, (GetParam() == GraphicsTest::EDialect::ES2 ? "es2-" : "") + i_rName));
	}

	const QSize m_Size{320, 240};
	const std::shared_ptr<InMemoryHost::VDispatcher> m_pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
	const std::shared_ptr<InMemoryHost::VSelectionManager> m_pSelection =
	    std::make_shared<InMemoryHost::VSelectionManager>();
	const std::shared_ptr<CoreGraphics::VShaderLibrary> m_pShaders = std::make_shared<CoreGraphics::VShaderLibrary>();
	std::shared_ptr<Flow2Graphics::VFlowScene> m_pScene;
	OrlexGraphics::VFrameRenderer m_Renderer;
	std::unique_ptr<QOpenGLFramebufferObject> m_pTarget;
};
