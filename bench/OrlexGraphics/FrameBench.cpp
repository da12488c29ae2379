#include "../Ratios.h"

#include "CoreGraphics/ShaderLibrary.h"
#include "Flow2Graphics/FlowScene.h"
#include "InMemoryHost/Dispatcher.h"
#include "InMemoryHost/Selection.h"
#include "OrlexGraphics/FrameRenderer.h"
#include "OrlexGraphics/IRenderType.h"
#include "OrlexGraphics/SelectionRegistry.h"
#include "OrlexGraphics/SphereHelper.h"

#include <QGuiApplication>
#include <QOffscreenSurface>
#include <QOpenGLContext>
#include <QOpenGLFramebufferObject>
#include <QOpenGLFunctions>

#include <cmath>
#include <cstdio>

// What a frame and a pick cost without a window, beside a frame that only clears. Needs a display.

namespace
{

const QSize c_Size(1280, 720);

/// Items that can be picked, all over the view.
class VSpheres : public OrlexGraphics::IRenderType
{
public:
	explicit VSpheres(std::shared_ptr<OrlexGraphics::VSphereHelper> i_pHelper) : m_pHelper(std::move(i_pHelper)) {}

	void Update(OrlexGraphics::VSelectionRegistry& io_rRegistry, int i_Count)
	{
		m_Spheres.clear();
		m_Ids.clear();
		for (int i = 0; i < i_Count; ++i)
		{
			const float angle = 2.4f * static_cast<float>(i);
			const float distance = 2000.0f * std::sqrt(static_cast<float>(i) / static_cast<float>(i_Count));
			const QVector4D sphere(distance * std::cos(angle), distance * std::sin(angle), 0.0f, 30.0f);
			const NVX::ISelectionItem item{NVX::ESelectionTargetSegment, 0x0fffffff, static_cast<std::uint32_t>(i), {}};
			m_Spheres.push_back(sphere);
			m_Ids.push_back(io_rRegistry.GetId(item));
			io_rRegistry.SetItemBound(item, sphere);
		}
	}

	void Render(CoreGraphics::VRenderContext& io_rContext, const OrlexGraphics::VSceneOptions& /*i_rOptions*/,
	    std::uint32_t i_Pass) override
	{
		if (i_Pass != OrlexGraphics::EPassOpaque)
			return;
		m_pHelper->Begin(io_rContext);
		for (std::size_t i = 0; i < m_Spheres.size(); ++i)
			m_pHelper->Draw(io_rContext, m_Spheres[i], m_Ids[i], {1, 1, 1, 1}, 3);
		m_pHelper->End(io_rContext);
	}

private:
	const std::shared_ptr<OrlexGraphics::VSphereHelper> m_pHelper;
	std::vector<QVector4D> m_Spheres;
	std::vector<CoreGraphics::VSelectionId> m_Ids;
};

class VScene : public Flow2Graphics::VFlowScene
{
public:
	using VFlowScene::VFlowScene;

	void InitialiseGL() override
	{
		VFlowScene::InitialiseGL();
		m_pSpheres = std::make_shared<VSpheres>(m_pSphereHelper);
		m_RenderList.push_back(m_pSpheres);
	}
	void Refresh() override
	{
		m_pRegistry->Reset();
		m_pSpheres->Update(*m_pRegistry, m_Count);
		VOrlexScene::Refresh();
	}

	int m_Count = 0;

private:
	std::shared_ptr<VSpheres> m_pSpheres;
};

/// A scene of so many items, of which so many are selected, ready to be drawn.
struct VBench
{
	VBench(int i_Count, std::uint32_t i_Selected)
	{
		std::vector<NVX::ISelectionItem> selected;
		for (std::uint32_t i = 0; i < i_Selected; ++i)
			selected.push_back({NVX::ESelectionTargetSegment, 0x0fffffff, i, {}});
		m_pSelection->Selection().Replace(selected);
		m_pScene = std::make_shared<VScene>(std::make_shared<CoreGraphics::VShaderLibrary>(), m_pSelection, nullptr,
		    std::make_shared<InMemoryHost::VDispatcher>(), false);
		m_pScene->m_Count = i_Count;
		m_Renderer.Initialise();
		// What is measured is the walk, not what else a scene shows.
		m_Renderer.m_Input.m_Options.m_bFloorGrid = false;
		m_Renderer.m_Input.m_Options.m_bGlobalAxis = false;
		m_Renderer.m_Input.m_Camera.SetSize(c_Size);
		m_Renderer.SetScene(m_pScene);
		m_Renderer.SetSize(c_Size);
		m_pTarget = std::make_unique<QOpenGLFramebufferObject>(c_Size, m_Renderer.TargetFormat());
		m_pScene->Synchronise();
		m_Renderer.Update();
		m_Renderer.Render(*m_pTarget);
		Finish();
	}

	static void Finish() { QOpenGLContext::currentContext()->functions()->glFinish(); }

	const std::shared_ptr<InMemoryHost::VSelectionManager> m_pSelection =
	    std::make_shared<InMemoryHost::VSelectionManager>();
	std::shared_ptr<VScene> m_pScene;
	OrlexGraphics::VFrameRenderer m_Renderer;
	std::unique_ptr<QOpenGLFramebufferObject> m_pTarget;
};

void DrawFrame(benchmark::State& io_rState, VBench& io_rBench)
{
	for (auto _ : io_rState)
	{
		io_rBench.m_Renderer.Render(*io_rBench.m_pTarget);
		VBench::Finish();
	}
}

void ClearedFrame(benchmark::State& io_rState)
{
	VBench bench(0, 0);
	DrawFrame(io_rState, bench);
}

void FloorFrame(benchmark::State& io_rState)
{
	VBench bench(0, 0);
	bench.m_Renderer.m_Input.m_Options.m_bFloorGrid = true;
	DrawFrame(io_rState, bench);
}

void Frame(benchmark::State& io_rState)
{
	VBench bench(static_cast<int>(io_rState.range(0)), 0);
	DrawFrame(io_rState, bench);
}

void OutlinedFrame(benchmark::State& io_rState)
{
	VBench bench(static_cast<int>(io_rState.range(0)), 2);
	DrawFrame(io_rState, bench);
}

void Pick(benchmark::State& io_rState, bool i_bRectangle)
{
	VBench bench(static_cast<int>(io_rState.range(0)), 0);
	OrlexGraphics::VPickRequest request;
	request.m_Mouse = QPoint(c_Size.width() / 2, c_Size.height() / 2);
	request.m_bRectangle = i_bRectangle;
	request.m_Start = QPoint(c_Size.width() / 4, c_Size.height() / 4);
	OrlexGraphics::VPick pick;
	// The first one makes the framebuffer.
	bench.m_Renderer.Pick(request, pick);
	VBench::Finish();
	for (auto _ : io_rState)
	{
		bench.m_Renderer.Pick(request, pick);
		VBench::Finish();
	}
	if (pick.m_Items.empty())
		io_rState.SkipWithError("nothing was found");
}

void HoverPick(benchmark::State& io_rState)
{
	Pick(io_rState, false);
}

void RectanglePick(benchmark::State& io_rState)
{
	Pick(io_rState, true);
}

void Items(benchmark::internal::Benchmark* io_pBenchmark)
{
	io_pBenchmark->Arg(140)->Arg(1400)->MeasureProcessCPUTime()->Unit(benchmark::kMicrosecond);
}

BENCHMARK(ClearedFrame)->Apply(Items);
BENCHMARK(FloorFrame)->Apply(Items);
BENCHMARK(Frame)->Apply(Items);
BENCHMARK(OutlinedFrame)->Apply(Items);
BENCHMARK(HoverPick)->Apply(Items);
BENCHMARK(RectanglePick)->Apply(Items);

} // namespace

int main(int i_Count, char** i_ppArguments)
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
	return Ratios::Main(i_Count, i_ppArguments,
	    {{"HoverPick", "ClearedFrame", 2.0}, {"Frame", "ClearedFrame", 10.0}, {"OutlinedFrame", "ClearedFrame", 10.0}});
}
