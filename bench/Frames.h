#pragma once

#include "Ratios.h"

#include "OrlexGraphics/frame/FrameRenderer.h"
#include "OrlexGraphics/frame/OrlexScene.h"

#include <QGuiApplication>
#include <QOffscreenSurface>
#include <QOpenGLContext>
#include <QOpenGLFramebufferObject>
#include <QOpenGLFunctions>

#include <cstdio>
#include <functional>
#include <memory>

/// Frames of a scene without a window, 1280 by 720 pixels. Needs a display.
namespace Frames
{

inline const QSize c_Size(1280, 720);

inline void Finish()
{
	QOpenGLContext::currentContext()->functions()->glFinish();
}

/// A scene, ready to be drawn: drawn once, so that all that a first frame makes is there. What is measured is the walk
/// over what the scene holds, not the ground that it stands on.
class VDrawing
{
public:
	explicit VDrawing(std::shared_ptr<OrlexGraphics::VOrlexScene> i_pScene) : m_pScene(std::move(i_pScene))
	{
		m_pRenderer->Initialise();
		Options().m_bFloorGrid = Options().m_bGlobalAxis = false;
		m_pRenderer->m_Input.m_Camera.SetSize(c_Size);
		m_pRenderer->SetScene(m_pScene);
		m_pRenderer->SetSize(c_Size);
		m_pTarget = std::make_unique<QOpenGLFramebufferObject>(c_Size, m_pRenderer->TargetFormat());
	}

	OrlexGraphics::VSceneOptions& Options() { return m_pRenderer->m_Input.m_Options; }
	CoreGraphics::VCameraController& Camera() { return m_pRenderer->m_Input.m_Camera; }

	void Update()
	{
		m_pScene->SetNeedsRefresh();
		m_pRenderer->Update();
	}
	void Draw()
	{
		m_pRenderer->Render(*m_pTarget);
		Finish();
	}

	void MeasureFrames(benchmark::State& io_rState)
	{
		m_pScene->Synchronise();
		Update();
		Draw();
		for (auto _ : io_rState)
			Draw();
	}

	void MeasureUpdates(benchmark::State& io_rState)
	{
		m_pScene->Synchronise();
		for (auto _ : io_rState)
			Update();
	}

	/// At the middle of the view, or of a rectangle that begins a quarter of it away.
	void MeasurePicks(benchmark::State& io_rState, bool i_bRectangle)
	{
		m_pScene->Synchronise();
		Update();
		Draw();
		OrlexGraphics::VPickRequest request;
		request.m_Mouse = QPoint(c_Size.width() / 2, c_Size.height() / 2);
		request.m_bRectangle = i_bRectangle;
		request.m_Start = QPoint(c_Size.width() / 4, c_Size.height() / 4);
		OrlexGraphics::VPick pick;
		// The first one makes the framebuffer.
		m_pRenderer->Pick(request, pick);
		for (auto _ : io_rState)
		{
			m_pRenderer->Pick(request, pick);
			Finish();
		}
		if (pick.m_Items.empty())
			io_rState.SkipWithError("nothing was found");
	}

private:
	std::shared_ptr<OrlexGraphics::VOrlexScene> m_pScene;
	std::unique_ptr<OrlexGraphics::VFrameRenderer> m_pRenderer = std::make_unique<OrlexGraphics::VFrameRenderer>();
	std::unique_ptr<QOpenGLFramebufferObject> m_pTarget;
};

/// Ratios::Main with a context current, and what else is to be told.
inline int Main(
    int i_Count, char** i_ppArguments, const std::vector<Ratios::VRatio>& i_rRatios,
    const std::function<void()>& i_rTell = [] {})
{
	QGuiApplication application(i_Count, i_ppArguments);
	QOffscreenSurface surface;
	surface.create();
	QOpenGLContext context;
	if (!context.create() || !context.makeCurrent(&surface))
	{
		std::puts("No OpenGL here, nothing is measured.");
		return 0;
	}
	const int status = Ratios::Main(i_Count, i_ppArguments, i_rRatios);
	i_rTell();
	return status;
}

} // namespace Frames
