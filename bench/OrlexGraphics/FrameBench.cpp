#include "../../tests/Matrices.h"
#include "../Frames.h"

#include "CoreGraphics/ShaderLibrary.h"
#include "CoreGraphics/Skin.h"
#include "CoreGraphics/SkinInstance.h"
#include "Flow2Graphics/FlowScene.h"
#include "InMemoryHost/Dispatcher.h"
#include "InMemoryHost/Selection.h"
#include "OrlexGraphics/frame/IRenderType.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "OrlexGraphics/skins/SkinRenderer.h"
#include "OrlexGraphics/stage/SphereHelper.h"

#include <chrono>
#include <cmath>

// What a frame and a pick cost without a window, beside a frame that only clears; and how long a frame with two skins
// takes while the camera turns.

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

constexpr std::size_t c_SkinBones = 50;
constexpr std::size_t c_RingVertices = 80;

/// A tube along Z, as high as a person, of 20,000 vertices with four bones each.
FBXIO::VSkin MakeTube()
{
	FBXIO::VSkin skin;
	auto pSkeleton = std::make_shared<FBXIO::VSkinSkeleton>(c_SkinBones);
	for (std::size_t i = 0; i < c_SkinBones; ++i)
	{
		(*pSkeleton)[i].m_Name = "bone" + std::to_string(i);
		(*pSkeleton)[i].m_ParentIndex = std::int64_t(i) - 1;
	}
	skin.m_pSkeleton = std::move(pSkeleton);
	FBXIO::VSkinMesh& rMesh = skin.m_Meshes.emplace_back();
	rMesh.m_Vertices.resize(20000);
	const std::size_t rings = rMesh.m_Vertices.size() / c_RingVertices;
	std::vector<std::uint16_t> indices;
	for (std::size_t i = 0; i < rMesh.m_Vertices.size(); ++i)
	{
		const std::size_t ring = i / c_RingVertices;
		const float angle = 6.2831853f * float(i % c_RingVertices) / float(c_RingVertices);
		FBXIO::VSkinVertex& rVertex = rMesh.m_Vertices[i];
		rVertex.m_Normal = {std::cos(angle), std::sin(angle), 0.0f};
		rVertex.m_Position = {250 * rVertex.m_Normal[0], 250 * rVertex.m_Normal[1], 1800 * float(ring) / float(rings)};
		const auto bone = std::uint8_t(ring * (c_SkinBones - 4) / rings);
		rVertex.m_BoneIndices = {bone, std::uint8_t(bone + 1), std::uint8_t(bone + 2), std::uint8_t(bone + 3)};
		rVertex.m_BoneWeights = {100, 80, 50, 25};
		if (ring + 1 == rings)
			continue;
		const std::size_t next = i % c_RingVertices + 1 == c_RingVertices ? i + 1 - c_RingVertices : i + 1;
		for (const std::size_t corner : {i, next, next + c_RingVertices, i, next + c_RingVertices, i + c_RingVertices})
			indices.push_back(std::uint16_t(corner));
	}
	FBXIO::VMeshPart& rPart = rMesh.m_Parts.emplace_back();
	rPart.m_Indices = CoreGraphics::BytesOf(indices);
	return skin;
}

/// Two skins beside each other.
class VSkins : public OrlexGraphics::IRenderType
{
public:
	explicit VSkins(CoreGraphics::VShaderLibrary& io_rLibrary) : m_Renderer(io_rLibrary)
	{
		const auto pSkin = std::make_shared<CoreGraphics::VSkin>(MakeTube(), "bench");
		std::vector<std::string> names;
		for (std::size_t i = 0; i < c_SkinBones; ++i)
			names.push_back("bone" + std::to_string(i));
		for (std::size_t i = 0; i < m_Skins.size(); ++i)
		{
			m_Skins[i].Bind(pSkin, names, std::vector<QVector3D>(c_SkinBones));
			QMatrix4x4 pose;
			pose.translate(i == 0 ? -500.0f : 500.0f, 0.0f);
			m_Skins[i].UpdatePose(std::vector<QMatrix4x4>(c_SkinBones, pose));
		}
	}

	void Render(CoreGraphics::VRenderContext& io_rContext, const OrlexGraphics::VSceneOptions& i_rOptions,
	    std::uint32_t i_Pass) override
	{
		if (m_Renderer.BeginRender(io_rContext, i_rOptions.m_SolvingSubject, i_Pass))
			for (const CoreGraphics::VSkinInstance& rSkin : m_Skins)
				m_Renderer.Draw(rSkin, io_rContext, i_rOptions.m_SolvingSubject, {});
	}

private:
	OrlexGraphics::VSkinRenderer m_Renderer;
	std::array<CoreGraphics::VSkinInstance, 2> m_Skins;
};

class VSkinScene : public Flow2Graphics::VFlowScene
{
public:
	using VFlowScene::VFlowScene;

	void InitialiseGL() override
	{
		VFlowScene::InitialiseGL();
		m_RenderList.push_back(std::make_shared<VSkins>(*m_pShaderLibrary));
	}
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

/// Frames on the floor, each from another side.
class VTurningSkins
{
public:
	VTurningSkins()
	{
		m_Drawing.Options().m_bFloorGrid = true;
		m_Drawing.Camera().m_Distance = 3000.0f;
		m_Drawing.Camera().m_Centre = {0.0f, 0.0f, 900.0f};
		m_Drawing.Update();
		Frame();
	}

	void Frame()
	{
		m_Drawing.Camera().m_Yaw += 1.0f;
		m_Drawing.Draw();
	}

private:
	Frames::VDrawing m_Drawing{std::make_shared<VSkinScene>(std::make_shared<CoreGraphics::VShaderLibrary>(),
	    std::make_shared<InMemoryHost::VSelectionManager>(), nullptr, std::make_shared<InMemoryHost::VDispatcher>(),
	    false)};
};

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

void TurningSkins(benchmark::State& io_rState)
{
	VTurningSkins skins;
	for (auto _ : io_rState)
		skins.Frame();
}

void TellTurningSkins()
{
	VTurningSkins skins;
	std::vector<double> times;
	for (int i = 0; i < Ratios::c_Pairs; ++i)
	{
		const auto before = std::chrono::steady_clock::now();
		skins.Frame();
		times.push_back(std::chrono::duration<double, std::milli>(std::chrono::steady_clock::now() - before).count());
	}
	Verdict::Tell("a frame with two skins while the camera turns, ms", "", "20,000 vertices", times, 50.0);
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
BENCHMARK(TurningSkins)->MeasureProcessCPUTime()->Unit(benchmark::kMicrosecond);

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	const bool bVerdict = Verdict::WasAskedFor(i_Count, i_ppArguments);
	return Frames::Main(i_Count, i_ppArguments,
	    {{"HoverPick", "ClearedFrame", 2.0}, {"Frame", "ClearedFrame", 10.0}, {"OutlinedFrame", "ClearedFrame", 10.0},
	        {"FloorFrame", "ClearedFrame", 10.0}},
	    [bVerdict]
	    {
		    if (bVerdict)
			    TellTurningSkins();
	    });
}
