// One move of the mouse while it drags a ring of the manipulator, from the view's event to the frame that is published,
// beside the deep copies that it must make.
#include "../BenchDocument.h"
#include "../Frames.h"

#include "CoreGraphics/ShaderLibrary.h"
#include "OrlexGraphics/item/SceneFramebufferObject.h"
#include "OrlexGraphics/manipulator/RenderManipulator.h"
#include "OrlexGraphics/skins/SkinCache.h"
#include "TesselPluginInterface/ISelectionManager.h"
#include "TesselPluginRetargetSetup/RetargetSetupScene.h"

#include <QMouseEvent>

namespace
{

void MoveOfADrag(benchmark::State& io_rState)
{
	VBenchDocument bench(std::size_t(io_rState.range(0)));
	const auto pSelection = bench.m_Host.GetSelectionManager();
	const auto pScene = NVX::MakeShared<VRetargetSetupScene>(std::make_shared<CoreGraphics::VShaderLibrary>(),
	    bench.m_Host.GetDispatcher(), pSelection,
	    NVX::MakeShared<OrlexGraphics::VSkinCache>(bench.m_Host.GetDispatcher()), bench.m_pDocument,
	    bench.m_Host.GetItemFactory(), false);
	OrlexGraphics::VSceneFramebufferObject item;
	item.SetScene(pScene.get());
	Frames::VDrawing drawing(pScene);
	const auto exchange = [&]
	{
		bench.m_Host.Dispatcher().RunPending();
		pScene->Synchronise();
		drawing.Update();
		pScene->Synchronise();
		bench.m_Host.Dispatcher().RunPending();
	};
	exchange();
	pSelection->Selection().Replace({{NVX::ESelectionTargetSegment, RetargetSetup::c_SubjectId, 1, {}}});
	exchange();
	OrlexGraphics::VRenderManipulator& rManipulator = *pScene->RenderManipulator();
	pSelection->PreSelection().Replace({OrlexGraphics::HandleItem({OrlexGraphics::EManipulatorRing, 0})});
	exchange();
	item.Camera().SetSize(Frames::c_Size);
	item.Camera().Update();
	rManipulator.Press(item.Camera(), {300, 200});
	if (!rManipulator.IsDragging())
		io_rState.SkipWithError("nothing is dragged");
	std::uint64_t moves = 0;
	const auto before = bench.m_Document.TargetValues().m_pParametrised;
	for (auto _ : io_rState)
	{
		const QPoint mouse(300 + int(++moves % 40), 200);
		QMouseEvent move(QEvent::MouseMove, mouse, Qt::NoButton, Qt::LeftButton, {});
		QCoreApplication::sendEvent(&item, &move);
	}
	if (bench.m_Document.TargetValues().m_pParametrised == before)
		io_rState.SkipWithError("nothing was published");
	rManipulator.Release();
}

void Sizes(benchmark::internal::Benchmark* io_pBenchmark)
{
	io_pBenchmark->Arg(70)->Arg(300)->Unit(benchmark::kMicrosecond);
}

BENCHMARK(Copies)->Apply(Sizes);
BENCHMARK(MoveOfADrag)->Apply(Sizes);

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	return Frames::Main(i_Count, i_ppArguments, {{"MoveOfADrag", "Copies", 2.5}});
}
