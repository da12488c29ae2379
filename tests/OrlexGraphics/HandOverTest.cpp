#include "../CoreGraphics/OffscreenContext.h"
#include "OrlexGraphics/frame/FrameRenderer.h"
#include "OrlexGraphics/manipulator/RenderManipulator.h"
#include "ViewFixture.h"

#include <QOpenGLFramebufferObject>

#include <atomic>
#include <semaphore>
#include <thread>

namespace
{

using OrlexGraphics::VFrameRenderer;

/// Two threads as a window has them: this one changes what is to be shown, asks for a frame and waits for the exchange
/// alone; the other one exchanges, then draws and picks while this one goes on. For a sanitizer of threads to watch.
class HandOver : public testing::Test
{
protected:
	HandOver()
	{
		m_Surface.create();
		m_pScene = std::make_shared<VBoxScene>(m_pShaders, m_pSelection, nullptr, m_pDispatcher, false);
		m_pScene->m_Size = m_Size;
		m_Camera.m_Type = CoreGraphics::ECameraFront;
		m_Camera.SetSize(m_Size);
		m_Render = std::thread([this] { Run(); });
	}

	~HandOver() override
	{
		Frame(true);
		m_Render.join();
	}

	/// Returns after the exchange, while the frame is being drawn.
	void Frame(bool i_bLast = false)
	{
		m_bLast = i_bLast;
		m_Wanted.release();
		m_Exchanged.acquire();
	}

	/// From the last frame that was drawn.
	std::size_t FoundCount() const { return m_FoundCount; }

	const QSize m_Size{200, 160};
	const std::shared_ptr<VEventLoopDispatcher> m_pDispatcher = std::make_shared<VEventLoopDispatcher>();
	const std::shared_ptr<InMemoryHost::VSelectionManager> m_pSelection =
	    std::make_shared<InMemoryHost::VSelectionManager>();
	const std::shared_ptr<CoreGraphics::VShaderLibrary> m_pShaders = std::make_shared<CoreGraphics::VShaderLibrary>();
	std::shared_ptr<VBoxScene> m_pScene;
	OrlexGraphics::VSceneOptions m_Options;
	CoreGraphics::VCameraController m_Camera;

private:
	void Run()
	{
		QOpenGLContext context;
		ASSERT_TRUE(context.create() && context.makeCurrent(&m_Surface));
		VFrameRenderer renderer;
		renderer.Initialise();
		renderer.SetSize(m_Size);
		QOpenGLFramebufferObject target(m_Size, renderer.TargetFormat());
		OrlexGraphics::VPickRequest request;
		request.m_bRectangle = true;
		request.m_Mouse = QPoint(199, 159);
		OrlexGraphics::VPick pick;
		for (bool bLast = false; !bLast;)
		{
			m_Wanted.acquire();
			bLast = m_bLast;
			if (!renderer.Scene())
				renderer.SetScene(m_pScene);
			m_pScene->Synchronise();
			renderer.m_Input.m_Options = m_Options;
			renderer.m_Input.m_Camera = m_Camera;
			m_Exchanged.release();

			renderer.Update();
			renderer.Pick(request, pick);
			renderer.Render(target);
			m_FoundCount = pick.m_Items.size();
		}
		renderer.SetScene({});
	}

	QOffscreenSurface m_Surface;
	std::binary_semaphore m_Wanted{0};
	std::binary_semaphore m_Exchanged{0};
	bool m_bLast = false;
	std::atomic<std::size_t> m_FoundCount = 0;
	std::thread m_Render;
};

TEST_F(HandOver, IsAllThatTheThreadsShare)
{
	int published = 0;
	m_pScene->PublishedSignal().Connect([&] { ++published; }, m_pDispatcher);
	constexpr int c_Frames = 60;
	for (int i = 0; i < c_Frames; ++i)
	{
		const auto index = static_cast<std::uint32_t>(i);
		const auto items = [&](std::uint32_t i_Count)
		{
			std::vector<NVX::ISelectionItem> all;
			for (std::uint32_t item = 0; item < i_Count; ++item)
				all.push_back(Item(item));
			return all;
		};
		m_pScene->m_Next.m_Boxes.push_back({Item(index), QRectF(2 * i, 20, 20, 100), static_cast<float>(-i)});
		m_pScene->m_Next.m_SubjectLabels = {{"label " + std::to_string(i), {}, Item(index)}};
		m_pSelection->Selection().Replace(items(index % 7));
		m_pSelection->PreSelection().Replace(items(index % 3));
		m_pScene->SetYUp(i % 4 == 1);
		m_pScene->RequestRefresh();
		m_Options.m_OverlayCamera = i % 5 == 0 ? "camera" : "";
		m_Options.m_bManipulator = i % 3 != 0;
		m_Camera.m_Yaw += 1.0f;
		m_Camera.Update();
		if (const auto& rpManipulator = m_pScene->RenderManipulator())
		{
			QMatrix4x4 transform;
			transform.translate(static_cast<float>(i), 0.0f, 0.0f);
			rpManipulator->SetTransform(transform);
			rpManipulator->SetVisible(i % 4 != 0);
		}
		Frame();
		// What the exchange has brought is read while the next frame is drawn.
		QMatrix4x4 transform;
		EXPECT_EQ(m_pScene->GetBounds(items(index)).size(), index) << i;
		EXPECT_EQ(m_pScene->GetItemTransform(items(1), transform), i > 0) << i;
		EXPECT_EQ(m_pScene->SubjectLabels().size(), i > 0 ? 1u : 0u) << i;
		QCoreApplication::processEvents();
	}
	Frame();
	QCoreApplication::processEvents();
	EXPECT_EQ(published, c_Frames);
	EXPECT_GT(FoundCount(), 16u);
}

} // namespace
