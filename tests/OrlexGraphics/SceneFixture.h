#pragma once

#include "../Allocations.h"
#include "../CoreGraphics/OffscreenContext.h"
#include "../QueryCount.h"

#include "CoreGraphics/ShaderLibrary.h"
#include "InMemoryHost/Dispatcher.h"
#include "InMemoryHost/Selection.h"
#include "OrlexGraphics/frame/FrameRenderer.h"
#include "OrlexGraphics/frame/OrlexScene.h"

#include <QOpenGLFramebufferObject>

#include <memory>
#include <optional>
#include <vector>

/// Frames of a scene, drawn without a window.
class VSceneTest : public GraphicsTest::InBothDialects
{
protected:
	explicit VSceneTest(const QSize& i_rSize) : m_Size(i_rSize) {}

	template <typename TScene>
	std::shared_ptr<TScene> Show()
	{
		auto pScene = std::make_shared<TScene>(m_pShaders, m_pSelection, m_pSkinCache, m_pDispatcher, false);
		m_Renderer.Initialise();
		m_Renderer.SetScene(pScene);
		m_Renderer.SetSize(m_Size);
		m_pTarget = std::make_unique<QOpenGLFramebufferObject>(m_Size, m_Renderer.TargetFormat());
		return pScene;
	}

	OrlexGraphics::VSceneOptions& Options() { return m_Renderer.m_Input.m_Options; }
	CoreGraphics::VCameraController& Camera() { return m_Renderer.m_Input.m_Camera; }

	/// With what the scene is to show now.
	void Frame()
	{
		m_Renderer.Scene()->SetNeedsRefresh();
		m_Renderer.Scene()->Synchronise();
		m_Renderer.Update();
		m_Renderer.Render(*m_pTarget);
	}

	/// In the frame that was drawn last, at a point or in a rectangle from there to the start.
	std::vector<NVX::ISelectionItem> Pick(const QPoint& i_rMouse, const std::optional<QPoint>& i_rStart = {})
	{
		OrlexGraphics::VPickRequest request;
		request.m_Mouse = i_rMouse;
		request.m_bRectangle = i_rStart.has_value();
		request.m_Start = i_rStart.value_or(QPoint());
		OrlexGraphics::VPick pick;
		m_Renderer.Pick(request, pick);
		return pick.m_Items;
	}

	/// The frame that was drawn last, once more: it takes no memory, asks OpenGL for nothing and looks up no name. The
	/// first ones make the driver compile its shaders.
	void ExpectThatAFrameIsAWalk()
	{
		for (int i = 0; i < 3; ++i)
			m_Renderer.Render(*m_pTarget);
		const VQueryCount queries;
		const std::size_t before = AllocationCount();
		m_Renderer.Render(*m_pTarget);
		EXPECT_EQ(AllocationCount() - before, 0u);
		EXPECT_EQ(queries.Count(), 0u);
		// The counter itself works.
		QOpenGLContext::currentContext()->functions()->glGetError();
		EXPECT_EQ(queries.Count(), 1u);
	}

	const QSize m_Size;
	const std::shared_ptr<InMemoryHost::VDispatcher> m_pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
	const std::shared_ptr<InMemoryHost::VSelectionManager> m_pSelection =
	    std::make_shared<InMemoryHost::VSelectionManager>();
	const std::shared_ptr<CoreGraphics::VShaderLibrary> m_pShaders = std::make_shared<CoreGraphics::VShaderLibrary>();
	/// Null unless a test makes one before it shows a scene.
	std::shared_ptr<OrlexGraphics::VSkinCache> m_pSkinCache;
	OrlexGraphics::VFrameRenderer m_Renderer;
	std::unique_ptr<QOpenGLFramebufferObject> m_pTarget;
};
