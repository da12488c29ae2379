#include "../Ratios.h"

#include "CoreGraphics/ShaderLibrary.h"
#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectState.h"
#include "Flow2Graphics/FlowScene.h"
#include "InMemoryHost/Dispatcher.h"
#include "InMemoryHost/Flow.h"
#include "InMemoryHost/Selection.h"
#include "OrlexGraphics/FrameRenderer.h"
#include "OrlexGraphics/RenderManipulator.h"

#include <QGuiApplication>
#include <QOffscreenSurface>
#include <QOpenGLContext>
#include <QOpenGLFramebufferObject>
#include <QOpenGLFunctions>

#include <cstdio>

// What two subjects cost, with bones, joints, axes, targets and the manipulator, beside a frame that only clears. The
// argument is the number of segments of each. Needs a display.

namespace
{

const QSize c_Size(1280, 720);
constexpr std::uint32_t c_Id = 7;

/// Five limbs, a target on each segment.
CoreOrlexTypes::VSubject MakeSubject(std::uint32_t i_Segments)
{
	CoreOrlexTypes::VSubject subject;
	subject.m_SubjectId = c_Id;
	for (std::uint32_t i = 0; i < i_Segments; ++i)
	{
		CoreOrlexTypes::VSubject::VSegment segment;
		segment.m_Name = "segment" + std::to_string(i);
		segment.m_SegmentIndex = i;
		segment.m_Joint.m_JointType = CoreOrlexTypes::VSubjectParametrised::VJoint::EBall;
		if (i > 0)
		{
			segment.m_ParentSegmentIndex = i < 6 ? 0 : i - 5;
			segment.m_PreRotation = {0.0, 0.0, i < 6 ? 1.2566 * i : 0.1};
			segment.m_PreTranslation = {5000.0 / i_Segments, 0.0, 1000.0 / i_Segments};
		}
		subject.m_Segments.push_back(segment);
		CoreOrlexTypes::VSubject::VTarget target;
		target.m_Type = i % 2 ? CoreOrlexTypes::VSubject::VTarget::ELocalRotationToWorldRotation
		                      : CoreOrlexTypes::VSubject::VTarget::ELocalPointToWorldPoint;
		target.m_SegmentIndices = {i};
		(i % 2 ? target.m_RotationObservationIndices : target.m_MarkerIndices) = {i / 2};
		target.m_State = {0.1, 0.2, 0.3};
		subject.m_Targets.push_back(target);
	}
	return subject;
}

struct VBench
{
	explicit VBench(std::uint32_t i_Segments)
	    : m_pScene(std::make_shared<Flow2Graphics::VFlowScene>(std::make_shared<CoreGraphics::VShaderLibrary>(),
	        std::make_shared<InMemoryHost::VSelectionManager>(), nullptr, std::make_shared<InMemoryHost::VDispatcher>(),
	        false))
	{
		m_Renderer.Initialise();
		OrlexGraphics::VSceneOptions& rOptions = m_Renderer.m_Input.m_Options;
		rOptions.m_bFloorGrid = rOptions.m_bGlobalAxis = false;
		rOptions.m_LabellingSubject.m_bJoints = rOptions.m_LabellingSubject.m_bAxes =
		    rOptions.m_LabellingSubject.m_bTargets = true;
		rOptions.m_SolvingSubject = rOptions.m_LabellingSubject;
		m_Renderer.m_Input.m_Camera.SetSize(c_Size);
		m_Renderer.SetScene(m_pScene);
		m_Renderer.SetSize(c_Size);
		m_pTarget = std::make_unique<QOpenGLFramebufferObject>(c_Size, m_Renderer.TargetFormat());
		if (i_Segments > 0)
		{
			ShowSubjects(i_Segments);
			m_pScene->RenderManipulator()->SetVisible(true);
		}
		m_pScene->Synchronise();
		Update();
		m_Renderer.Render(*m_pTarget);
		Finish();
	}

	void ShowSubjects(std::uint32_t i_Segments)
	{
		InMemoryHost::VItemFactory factory;
		NVX::CountedPointer<TesselPluginInterface::IFlowFrame> pFrame(new InMemoryHost::VFlowFrame);
		const auto add = [&](const char* i_pFlowType, auto i_Value)
		{
			const auto pItem = factory.CreateItem(i_pFlowType);
			TesselPluginInterface::SetItemValue(pItem, std::make_shared<const decltype(i_Value)>(i_Value));
			pFrame->AddItem(pItem);
		};
		const CoreOrlexTypes::VSubjectDynamicParameters pose{c_Id, {}};
		add("FlowSubject", MakeSubject(i_Segments));
		add("FlowSubjectDynamicParameters", pose);
		add("FlowSubjectForSolving", MakeSubject(i_Segments));
		add("FlowSubjectDynamicParametersForSolving", pose);
		m_pScene->SetFrame(pFrame);
	}

	void Update()
	{
		m_pScene->SetNeedsRefresh();
		m_Renderer.Update();
	}

	static void Finish() { QOpenGLContext::currentContext()->functions()->glFinish(); }

	const std::shared_ptr<Flow2Graphics::VFlowScene> m_pScene;
	OrlexGraphics::VFrameRenderer m_Renderer;
	std::unique_ptr<QOpenGLFramebufferObject> m_pTarget;
};

void DrawFrames(benchmark::State& io_rState, VBench& io_rBench)
{
	for (auto _ : io_rState)
	{
		io_rBench.m_Renderer.Render(*io_rBench.m_pTarget);
		VBench::Finish();
	}
}

void ClearedFrame(benchmark::State& io_rState)
{
	VBench bench(0);
	DrawFrames(io_rState, bench);
}

void SubjectsFrame(benchmark::State& io_rState)
{
	VBench bench(static_cast<std::uint32_t>(io_rState.range(0)));
	DrawFrames(io_rState, bench);
}

void SubjectsHoverPick(benchmark::State& io_rState)
{
	VBench bench(static_cast<std::uint32_t>(io_rState.range(0)));
	OrlexGraphics::VPickRequest request;
	request.m_Mouse = QPoint(c_Size.width() / 2, c_Size.height() / 2);
	OrlexGraphics::VPick pick;
	// The first one makes the framebuffer.
	bench.m_Renderer.Pick(request, pick);
	for (auto _ : io_rState)
	{
		bench.m_Renderer.Pick(request, pick);
		VBench::Finish();
	}
	if (pick.m_Items.empty())
		io_rState.SkipWithError("nothing was found");
}

void SubjectsUpdate(benchmark::State& io_rState)
{
	VBench bench(static_cast<std::uint32_t>(io_rState.range(0)));
	for (auto _ : io_rState)
		bench.Update();
}

void Segments(benchmark::internal::Benchmark* io_pBenchmark)
{
	io_pBenchmark->Arg(70)->Arg(300)->MeasureProcessCPUTime()->Unit(benchmark::kMicrosecond);
}

BENCHMARK(ClearedFrame)->Apply(Segments);
BENCHMARK(SubjectsFrame)->Apply(Segments);
BENCHMARK(SubjectsHoverPick)->Apply(Segments);
BENCHMARK(SubjectsUpdate)->Apply(Segments);

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
	return Ratios::Main(
	    i_Count, i_ppArguments, {{"SubjectsFrame", "ClearedFrame", 10.0}, {"SubjectsHoverPick", "ClearedFrame", 2.0}});
}
