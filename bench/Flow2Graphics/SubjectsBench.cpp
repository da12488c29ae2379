#include "../Frames.h"

#include "CoreGraphics/ShaderLibrary.h"
#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectState.h"
#include "Flow2Graphics/FlowScene.h"
#include "InMemoryHost/Dispatcher.h"
#include "InMemoryHost/Flow.h"
#include "InMemoryHost/Selection.h"
#include "OrlexGraphics/item/SceneFramebufferObject.h"
#include "OrlexGraphics/manipulator/RenderManipulator.h"

#include <QQmlPropertyMap>
#include <QQuickFramebufferObject>
#include <QQuickView>

// What two subjects cost, with bones, joints, axes, targets and the manipulator, beside a frame that only clears, off
// screen and in a window. The argument is the number of segments of each.

namespace
{

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
	// What the targets observe.
	subject.m_Markers.resize((i_Segments + 1) / 2);
	subject.m_Rotations.resize(i_Segments / 2);
	return subject;
}

NVX::CountedPointer<TesselPluginInterface::IFlowFrame> MakeFrame(std::uint32_t i_Segments)
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
	return pFrame;
}

/// Two subjects of so many segments, or nothing.
std::shared_ptr<Flow2Graphics::VFlowScene> MakeScene(std::uint32_t i_Segments)
{
	const auto pScene = std::make_shared<Flow2Graphics::VFlowScene>(std::make_shared<CoreGraphics::VShaderLibrary>(),
	    std::make_shared<InMemoryHost::VSelectionManager>(), nullptr, std::make_shared<InMemoryHost::VDispatcher>(),
	    false);
	if (i_Segments > 0)
		pScene->SetFrame(MakeFrame(i_Segments));
	return pScene;
}

Frames::VDrawing MakeDrawing(std::uint32_t i_Segments)
{
	const auto pScene = MakeScene(i_Segments);
	Frames::VDrawing drawing(pScene);
	pScene->RenderManipulator()->SetVisible(i_Segments > 0);
	OrlexGraphics::VSubjectOptions& rOptions = drawing.Options().m_LabellingSubject;
	rOptions.m_bJoints = rOptions.m_bAxes = rOptions.m_bTargets = true;
	rOptions.m_bMarkers = false;
	drawing.Options().m_SolvingSubject = rOptions;
	return drawing;
}

/// Clears its framebuffer and draws nothing.
class VEmptyItem : public QQuickFramebufferObject
{
	struct VClear : Renderer
	{
		void render() override
		{
			QOpenGLFunctions& rGL = *QOpenGLContext::currentContext()->functions();
			rGL.glClearColor(0.2f, 0.2f, 0.2f, 1.0f);
			rGL.glClear(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
		}
		QOpenGLFramebufferObject* createFramebufferObject(const QSize& i_rSize) override
		{
			QOpenGLFramebufferObjectFormat format;
			format.setAttachment(QOpenGLFramebufferObject::CombinedDepthStencil);
			format.setSamples(4);
			return new QOpenGLFramebufferObject(i_rSize, format);
		}
	};

	Renderer* createRenderer() const override { return new VClear; }
};

/// Frames of a window that is filled by the item, from its update to the swap of buffers.
void MeasureWindow(benchmark::State& io_rState, QQuickItem* i_pItem, Flow2Graphics::VFlowScene* i_pScene = nullptr)
{
	// The others draw with this one.
	QOpenGLContext* const pContext = QOpenGLContext::currentContext();
	QSurface* const pSurface = pContext->surface();
	auto pView = std::make_unique<QQuickView>();
	QQuickView& view = *pView;
	view.setResizeMode(QQuickView::SizeRootObjectToView);
	view.setContent(QUrl(), nullptr, i_pItem);
	view.resize(Frames::c_Size);
	view.show();
	bool bSwapped = false;
	QObject::connect(&view, &QQuickWindow::frameSwapped, &view, [&] { bSwapped = true; });
	const auto frame = [&]
	{
		bSwapped = false;
		i_pItem->update();
		while (!bSwapped)
			QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
	};
	frame();
	if (i_pScene)
		i_pScene->RenderManipulator()->SetVisible(true);
	frame();
	frame();
	for (auto _ : io_rState)
		frame();
	pView.reset();
	pContext->makeCurrent(pSurface);
}

std::uint32_t Segments(const benchmark::State& i_rState)
{
	return static_cast<std::uint32_t>(i_rState.range(0));
}

void ClearedFrame(benchmark::State& io_rState)
{
	MakeDrawing(0).MeasureFrames(io_rState);
}

void SubjectsFrame(benchmark::State& io_rState)
{
	MakeDrawing(Segments(io_rState)).MeasureFrames(io_rState);
}

void SubjectsHoverPick(benchmark::State& io_rState)
{
	MakeDrawing(Segments(io_rState)).MeasurePicks(io_rState, false);
}

void SubjectsUpdate(benchmark::State& io_rState)
{
	MakeDrawing(Segments(io_rState)).MeasureUpdates(io_rState);
}

void EmptyWindow(benchmark::State& io_rState)
{
	MeasureWindow(io_rState, new VEmptyItem);
}

void SubjectsWindow(benchmark::State& io_rState)
{
	const auto pScene = MakeScene(Segments(io_rState));
	auto* const pItem = new OrlexGraphics::VSceneFramebufferObject;
	pItem->SetScene(pScene.get());
	for (const char* pName : {"-Enabled", "-Joints", "-Axes", "-Targets", "-Markers"})
		for (const char* pKind : {"LabellingSubject", "SolvingSubject"})
		{
			const QString key = QString(pKind) + pName;
			const bool bShown = std::string_view(pName) != "-Markers";
			pItem->GetSceneOptions()->insert(key, bShown);
			pItem->OnSceneOptionsMapChanged(key, bShown);
		}
	MeasureWindow(io_rState, pItem, pScene.get());
}

void Subjects(benchmark::internal::Benchmark* io_pBenchmark)
{
	io_pBenchmark->Arg(70)->Arg(300)->MeasureProcessCPUTime()->Unit(benchmark::kMicrosecond);
}

BENCHMARK(ClearedFrame)->Apply(Subjects);
BENCHMARK(SubjectsFrame)->Apply(Subjects);
BENCHMARK(SubjectsHoverPick)->Apply(Subjects);
BENCHMARK(SubjectsUpdate)->Apply(Subjects);
// It holds no segments: its argument says which window it stands beside.
BENCHMARK(EmptyWindow)->Apply(Subjects);
BENCHMARK(SubjectsWindow)->Apply(Subjects);

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	// The window's frames follow each other at once and on this thread.
	qputenv("QSG_RENDER_LOOP", "basic");
	qputenv("QT_QPA_UPDATE_IDLE_TIME", "0");
	return Frames::Main(i_Count, i_ppArguments,
	    {{"SubjectsFrame", "ClearedFrame", 2.5, {"70"}}, {"SubjectsFrame", "ClearedFrame", 4.0, {"300"}},
	        {"SubjectsHoverPick", "ClearedFrame", 0.25, {"70"}}, {"SubjectsHoverPick", "ClearedFrame", 0.7, {"300"}},
	        {"SubjectsWindow", "EmptyWindow", 1.25, {"70"}}, {"SubjectsWindow", "EmptyWindow", 1.5, {"300"}}});
}
