#include "../Frames.h"

#include "CoreGraphics/ShaderLibrary.h"
#include "Flow2Graphics/FlowScene.h"
#include "InMemoryHost/Dispatcher.h"
#include "InMemoryHost/Selection.h"
#include "OrlexGraphics/frame/IRenderType.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "OrlexGraphics/stage/SphereHelper.h"

#include <cmath>

// What a frame and a pick cost without a window, beside a frame that only clears.

namespace
{

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

/// A scene of so many items, of which so many are selected.
Frames::VDrawing MakeDrawing(int i_Count, std::uint32_t i_Selected = 0)
{
	std::vector<NVX::ISelectionItem> selected;
	for (std::uint32_t i = 0; i < i_Selected; ++i)
		selected.push_back({NVX::ESelectionTargetSegment, 0x0fffffff, i, {}});
	const auto pSelection = std::make_shared<InMemoryHost::VSelectionManager>();
	pSelection->Selection().Replace(selected);
	const auto pScene = std::make_shared<VScene>(std::make_shared<CoreGraphics::VShaderLibrary>(), pSelection, nullptr,
	    std::make_shared<InMemoryHost::VDispatcher>(), false);
	pScene->m_Count = i_Count;
	return Frames::VDrawing(pScene);
}

int Count(const benchmark::State& i_rState)
{
	return static_cast<int>(i_rState.range(0));
}

void ClearedFrame(benchmark::State& io_rState)
{
	MakeDrawing(0).MeasureFrames(io_rState);
}

void FloorFrame(benchmark::State& io_rState)
{
	Frames::VDrawing drawing = MakeDrawing(0);
	drawing.Options().m_bFloorGrid = true;
	drawing.MeasureFrames(io_rState);
}

void Frame(benchmark::State& io_rState)
{
	MakeDrawing(Count(io_rState)).MeasureFrames(io_rState);
}

void OutlinedFrame(benchmark::State& io_rState)
{
	MakeDrawing(Count(io_rState), 2).MeasureFrames(io_rState);
}

void HoverPick(benchmark::State& io_rState)
{
	MakeDrawing(Count(io_rState)).MeasurePicks(io_rState, false);
}

void RectanglePick(benchmark::State& io_rState)
{
	MakeDrawing(Count(io_rState)).MeasurePicks(io_rState, true);
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
	return Frames::Main(i_Count, i_ppArguments,
	    {{"HoverPick", "ClearedFrame", 2.0}, {"Frame", "ClearedFrame", 10.0}, {"OutlinedFrame", "ClearedFrame", 10.0},
	        {"FloorFrame", "ClearedFrame", 10.0}});
}
