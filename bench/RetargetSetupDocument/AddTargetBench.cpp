// One AddTarget through Publish, beside the deep copies that it must make: subjects are replaced and never changed, so
// at least a new editable subject, a new evaluated one and new application data come into being.
#include "../Ratios.h"

#include "InMemoryHost/PluginContext.h"
#include "RetargetSetupDocument/GlobalScale.h"
#include "RetargetSetupDocument/Identity.h"
#include "RetargetSetupDocument/RetargetSetup.h"
#include "RetargetSetupDocument/TargetConstruction.h"

#include <memory>
#include <random>

namespace
{

/// A character in a host: bones with up to four children, a target on every fourth segment.
class VBenchDocument
{
public:
	explicit VBenchDocument(std::size_t i_Segments)
	    : m_Document(m_Host.GetDispatcher(), m_Host.GetFrameFactory(), m_Host.GetItemFactory())
	{
		std::mt19937 random(1);
		std::uniform_real_distribution<float> number(-90.0f, 90.0f);
		FBXIO::VSkinSkeleton bones(i_Segments);
		for (std::size_t i = 0; i < i_Segments; ++i)
		{
			bones[i].m_Name = "Character:Segment" + std::to_string(i);
			bones[i].m_ParentIndex = (std::int64_t(i) - 1) / 4 - (i == 0 ? 1 : 0);
			bones[i].m_PreRotation.rotate(number(random), 1, 0, 0);
			bones[i].m_Local.translate(number(random), number(random), number(random));
			bones[i].m_Local.rotate(number(random), 0, 1, 0);
		}
		CoreOrlexTypes::VSubjectParametrised subject;
		CoreOrlexTypes::VSubjectApplicationData data;
		subject.m_Name = RetargetSetup::c_SubjectName;
		subject.m_SubjectId = data.m_SubjectId = RetargetSetup::c_SubjectId;
		RetargetSetup::BuildTargetSubject(bones, subject, data, 0);
		RetargetSetup::SetGlobalScale(subject, 1.0);
		m_Document.SetSourceSubject(subject, data);
		m_Document.SetTargetSubject(std::move(subject), std::move(data));
		for (std::size_t i = 0; i < i_Segments; i += 4)
			m_Document.AddTarget(int(i), int(i), i % 8 == 0, false);
		m_Start = m_Document.TargetValues();
	}

	void Restore() { m_Document.SetTargetSubject(*m_Start.m_pParametrised, *m_Start.m_pApplicationData); }

	InMemoryHost::VPluginContext m_Host;
	VRetargetSetup m_Document;
	VRetargetSetup::VSubjectValues m_Start;
};

void Report(benchmark::State& io_rState)
{
	io_rState.counters["per segment"] = benchmark::Counter(
	    double(io_rState.iterations() * io_rState.range(0)), benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
}

void AddTarget(benchmark::State& io_rState)
{
	VBenchDocument bench(std::size_t(io_rState.range(0)));
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

void Copies(benchmark::State& io_rState)
{
	VBenchDocument bench(std::size_t(io_rState.range(0)));
	for (auto _ : io_rState)
	{
		benchmark::DoNotOptimize(
		    std::make_shared<CoreOrlexTypes::VSubjectParametrised>(*bench.m_Start.m_pParametrised));
		benchmark::DoNotOptimize(std::make_shared<CoreOrlexTypes::VSubject>(*bench.m_Start.m_pSubject));
		benchmark::DoNotOptimize(
		    std::make_shared<CoreOrlexTypes::VSubjectApplicationData>(*bench.m_Start.m_pApplicationData));
	}
	Report(io_rState);
}

/// What a drag does at each move of the mouse.
void SetPose(benchmark::State& io_rState)
{
	VBenchDocument bench(std::size_t(io_rState.range(0)));
	for (auto _ : io_rState)
	{
		CoreOrlexTypes::VSubjectParametrised subject = *bench.m_Document.TargetValues().m_pParametrised;
		subject.m_Segments[1].m_Joint.m_BindPose[0] += 0.001;
		bench.m_Document.SetTargetSubjectParametrised(std::move(subject));
	}
	Report(io_rState);
}

void Sizes(benchmark::internal::Benchmark* io_pBenchmark)
{
	for (const int segments : {30, 70, 100, 300, 1000, 3000})
		io_pBenchmark->Arg(segments);
}

BENCHMARK(Copies)->Apply(Sizes);
BENCHMARK(AddTarget)->Apply(Sizes);
BENCHMARK(SetPose)->Apply(Sizes);

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	return Ratios::Main(i_Count, i_ppArguments, {{"AddTarget", "Copies", 6.0}, {"SetPose", "Copies", 6.0}});
}
