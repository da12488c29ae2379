#pragma once

#include "OffscreenContext.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"

#include <QOpenGLFramebufferObject>

#include <memory>

namespace GraphicsTest
{

/// A framebuffer, all of which is the viewport.
class VDrawingTest : public InBothDialects
{
protected:
	explicit VDrawingTest(const QSize& i_rSize) : m_Size(i_rSize) {}

	void SetUp() override
	{
		ASSERT_NO_FATAL_FAILURE(InBothDialects::SetUp());
		m_Library.InitialiseGL();
		m_Render.Initialise();
		m_Render.ResetState();
		m_pTarget = std::make_unique<QOpenGLFramebufferObject>(m_Size, QOpenGLFramebufferObject::Depth);
		m_Render.BindFramebuffer(m_pTarget.get());
		m_Render.SetViewport(QRect(QPoint(), m_Size));
		m_Render.m_FrameSize = m_Size;
	}

	const QSize m_Size;
	CoreGraphics::VShaderLibrary m_Library;
	CoreGraphics::VRenderContext m_Render;
	std::unique_ptr<QOpenGLFramebufferObject> m_pTarget;
};

} // namespace GraphicsTest
