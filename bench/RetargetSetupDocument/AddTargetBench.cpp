// One AddTarget through Publish, beside the deep copies that it must make.
#include "../BenchDocument.h"

namespace
{

void AddTarget(benchmark::State& io_rState, bool i_bHistory)
{
	VBenchDocument bench(std::size_t(io_rState.range(0)));
	if (i_bHistory)
		bench.m_Document.KeepHistory(bench.m_Host.GetSelectionManager());
	const std::size_t before = bench.m_Start.m_pParametrised->m_Targets.size();
	for (auto _ : io_rState)
	{
		bench.m_Document.AddTarget(1, 1, true, false);
		io_rState.PauseTiming();
		if (bench.m_Document.TargetValues().m_pParametrised->m_Targets.size() != before + 1)
			io_rState.SkipWithError("no target was added");
		bench.Restore();
		io_rState.ResumeTiming();
	}
	Report(io_rState);
}

/// What a drag does at each move of the mouse.
void SetPose(benchmark::State& io_rState, bool i_bHistory)
{
	VBenchDocument bench(std::size_t(io_rState.range(0)));
	if (i_bHistory)
		bench.m_Document.KeepHistory(bench.m_Host.GetSelectionManager());
	for (auto _ : io_rState)
	{
		CoreOrlexTypes::VSubjectParametrised subject = *bench.m_Document.TargetValues().m_pParametrised;
		subject.m_Segments[1].m_Joint.m_BindPose[0] += 0.001;
		bench.m_Document.SetTargetSubjectParametrised(std::move(subject), {"Pose", 1});
	}
	Report(io_rState);
}

void Sizes(benchmark::internal::Benchmark* io_pBenchmark)
{
	for (const int segments : {30, 70, 100, 300, 1000, 3000})
		io_pBenchmark->Arg(segments);
}

BENCHMARK(Copies)->Apply(Sizes);
BENCHMARK_CAPTURE(AddTarget, plain, false)->Name("AddTarget")->Apply(Sizes);
BENCHMARK_CAPTURE(SetPose, plain, false)->Name("SetPose")->Apply(Sizes);
// What a history costs beside them.
BENCHMARK_CAPTURE(AddTarget, history, true)->Name("AddTargetUndoable")->Apply(Sizes);
BENCHMARK_CAPTURE(SetPose, history, true)->Name("SetPoseUndoable")->Apply(Sizes);

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	return Ratios::Main(i_Count, i_ppArguments,
	    {{"AddTarget", "Copies", 3.0, {"30"}}, {"AddTarget", "Copies", 2.5, {"70", "100", "300", "1000", "3000"}},
	        {"SetPose", "Copies", 2.5}, {"AddTargetUndoable", "AddTarget", 1.5}, {"SetPoseUndoable", "SetPose", 1.1}});
}
