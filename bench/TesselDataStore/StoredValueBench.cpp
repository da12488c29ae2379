// A subject as typed bytes and back, beside the copy of the value, which any way of passing it on must cost at least,
// and beside its text form; and one number of a parameter.
#include "../Ratios.h"
#include "CoreOrlexTypes/RandomValue.h"

#include "CoreOrlexTypes/TextForm.h"
#include "TesselDataStore/DataStore.h"
#include "TesselDataStore/DataWriter.h"
#include "TesselDataStore/StoredValue.h"

#include <benchmark/benchmark.h>

namespace
{

using CoreOrlexTypes::VSubjectParametrised;

VSubjectParametrised Subject(benchmark::State& io_rState)
{
	VRandomValue random(1);
	VSubjectParametrised subject;
	random.Fill(subject);
	subject.m_Segments.resize(std::size_t(io_rState.range(0)));
	for (auto& rSegment : subject.m_Segments)
		random.Fill(rSegment);
	return subject;
}

void BM_Copy(benchmark::State& io_rState)
{
	const VSubjectParametrised subject = Subject(io_rState);
	for (auto _ : io_rState)
		benchmark::DoNotOptimize(VSubjectParametrised(subject));
}
BENCHMARK(BM_Copy)->Arg(100)->Arg(1000)->Unit(benchmark::kMicrosecond);

void BM_ToVariant(benchmark::State& io_rState)
{
	const VSubjectParametrised subject = Subject(io_rState);
	for (auto _ : io_rState)
		benchmark::DoNotOptimize(TesselDataStore::ToVariant(subject));
}
BENCHMARK(BM_ToVariant)->Arg(100)->Arg(1000)->Unit(benchmark::kMicrosecond);

void BM_FromVariant(benchmark::State& io_rState)
{
	const NVX::IO::VVariant variant = TesselDataStore::ToVariant(Subject(io_rState));
	VSubjectParametrised subject;
	for (auto _ : io_rState)
		if (!TesselDataStore::FromVariant(variant, subject))
			io_rState.SkipWithError("not read");
}
BENCHMARK(BM_FromVariant)->Arg(1)->Arg(100)->Arg(1000)->Unit(benchmark::kMicrosecond);

void BM_WriteText(benchmark::State& io_rState)
{
	const VSubjectParametrised subject = Subject(io_rState);
	for (auto _ : io_rState)
	{
		std::string text;
		if (!WriteText(subject, text))
			io_rState.SkipWithError("not written");
	}
}
BENCHMARK(BM_WriteText)->Arg(100)->Arg(1000)->Unit(benchmark::kMicrosecond);

void BM_ReadText(benchmark::State& io_rState)
{
	std::string text;
	VSubjectParametrised subject;
	if (!WriteText(Subject(io_rState), text))
		io_rState.SkipWithError("not written");
	for (auto _ : io_rState)
		if (!ReadText(text, subject))
			io_rState.SkipWithError("not read");
}
BENCHMARK(BM_ReadText)->Arg(100)->Arg(1000)->Unit(benchmark::kMicrosecond);

void BM_SetNumber(benchmark::State& io_rState)
{
	const auto pStore = std::make_shared<TesselDataStore::VDataStore>();
	double value = 0.0;
	for (auto _ : io_rState)
		TesselDataStore::VDataWriter(pStore).SetFloat64("RetargetSetup/TargetWeight", value += 1.0);
}
BENCHMARK(BM_SetNumber);

void BM_GetNumber(benchmark::State& io_rState)
{
	const auto pStore = std::make_shared<TesselDataStore::VDataStore>();
	TesselDataStore::VDataWriter(pStore).SetFloat64("RetargetSetup/TargetWeight", 1.0);
	double value = 0.0;
	for (auto _ : io_rState)
		TesselDataStore::VDataReader(pStore).GetFloat64("RetargetSetup/TargetWeight", value);
}
BENCHMARK(BM_GetNumber);

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	return Ratios::Main(i_Count, i_ppArguments, {});
}
