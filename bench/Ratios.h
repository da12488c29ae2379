#pragma once

#include "Verdict.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <iterator>
#include <map>
#include <optional>
#include <sched.h>
#include <string>
#include <string_view>
#include <vector>

/// Runs all benchmarks of a program and holds some of its rows beside others, their peers. A row's time is its
/// processor time; of a row whose work runs on several threads, so that its name tells another kind of time, it is the
/// real time.
///
/// With "--verdict" each pair runs in turns, ours, peer, ours, peer, on one processor where that is allowed, and what
/// counts is the median of the pairs' ratios: what else the machine does meets both.
namespace Ratios
{

struct VRatio
{
	const char* m_pOver;
	const char* m_pUnder;
	double m_Limit;
	/// The arguments of the rows that this limit holds for; all if empty.
	std::vector<std::string> m_Arguments{};
};

inline constexpr int c_Pairs = 21;

/// The times of the rows, by name of the function and arguments.
class VReporter : public benchmark::ConsoleReporter
{
public:
	explicit VReporter(bool i_bPrint) : ConsoleReporter(OO_Tabular), m_bPrint(i_bPrint) {}

	struct VRow
	{
		std::string m_Name;
		double m_Time;
		bool m_bOneThread;
	};
	using VRows = std::map<std::pair<std::string, std::string>, VRow>;

	bool ReportContext(const Context& i_rContext) override
	{
		return !m_bPrint || ConsoleReporter::ReportContext(i_rContext);
	}

	void ReportRuns(const std::vector<Run>& i_rRuns) override
	{
		std::vector<Run> medians;
		for (const Run& rRun : i_rRuns)
		{
			if (rRun.error_occurred || (rRun.run_type == Run::RT_Aggregate && rRun.aggregate_name == "median"))
				medians.push_back(rRun);
			if (rRun.error_occurred || rRun.run_type != Run::RT_Iteration)
				continue;
			const bool bOneThread = rRun.run_name.time_type.empty();
			const double time = bOneThread ? rRun.GetAdjustedCPUTime() : rRun.GetAdjustedRealTime();
			const auto [found, bNew] = m_Rows.emplace(std::pair{rRun.run_name.function_name, rRun.run_name.args},
			    VRow{rRun.run_name.str(), time, bOneThread});
			if (!bNew)
				found->second.m_Time = std::min(found->second.m_Time, time);
		}
		if (m_bPrint || std::any_of(i_rRuns.begin(), i_rRuns.end(), [](const Run& i) { return i.error_occurred; }))
			ConsoleReporter::ReportRuns(medians);
	}

	VRows m_Rows;

private:
	bool m_bPrint;
};

/// For each pair of rows of one argument, one of which some ratio names: f(ratio, over, under, argument).
template <typename TFunction>
void ForEachPair(const VReporter::VRows& i_rRows, const std::vector<VRatio>& i_rRatios, TFunction f)
{
	for (const VRatio& rRatio : i_rRatios)
		for (const auto& [rKey, rRow] : i_rRows)
		{
			const auto& [rFunction, rArgument] = rKey;
			const auto under = i_rRows.find({rRatio.m_pUnder, rArgument});
			const std::vector<std::string>& rArguments = rRatio.m_Arguments;
			if (rFunction == rRatio.m_pOver && under != i_rRows.end()
			    && (rArguments.empty()
			        || std::find(rArguments.begin(), rArguments.end(), rArgument) != rArguments.end()))
				f(rRatio, rRow, under->second, rArgument);
		}
}

/// Keeps this thread on the processor that it runs on, until it goes. Where that is not allowed nothing is lost but a
/// little steadiness.
class VOneProcessor
{
public:
	VOneProcessor()
	{
		cpu_set_t one;
		CPU_ZERO(&one);
		CPU_SET(sched_getcpu(), &one);
		m_bKept = sched_getaffinity(0, sizeof m_Before, &m_Before) == 0 && sched_setaffinity(0, sizeof one, &one) == 0;
	}
	~VOneProcessor()
	{
		if (m_bKept)
			sched_setaffinity(0, sizeof m_Before, &m_Before);
	}
	VOneProcessor(const VOneProcessor&) = delete;
	VOneProcessor& operator=(const VOneProcessor&) = delete;

private:
	cpu_set_t m_Before{};
	bool m_bKept;
};

/// A regular expression for the name alone.
inline std::string Exactly(const std::string& i_rName)
{
	std::string expression = "^";
	for (const char character : i_rName)
	{
		if (std::string_view("\\^$.|?*+()[]{}").find(character) != std::string_view::npos)
			expression += '\\';
		expression += character;
	}
	return expression + "$";
}

inline int MeasureVerdict(const std::vector<VRatio>& i_rRatios)
{
	VReporter all(false);
	benchmark::RunSpecifiedBenchmarks(&all);
	ForEachPair(all.m_Rows, i_rRatios,
	    [](const VRatio& i_rRatio, const VReporter::VRow& i_rOver, const VReporter::VRow& i_rUnder,
	        const std::string& i_rArgument)
	    {
		    std::optional<VOneProcessor> processor;
		    if (i_rOver.m_bOneThread && i_rUnder.m_bOneThread)
			    processor.emplace();
		    std::vector<double> ratios;
		    std::vector<double> peers;
		    for (int i = 0; i < c_Pairs; ++i)
		    {
			    VReporter pair(false);
			    benchmark::RunSpecifiedBenchmarks(&pair, Exactly(i_rOver.m_Name));
			    benchmark::RunSpecifiedBenchmarks(&pair, Exactly(i_rUnder.m_Name));
			    ForEachPair(pair.m_Rows, {i_rRatio},
			        [&](const VRatio&, const VReporter::VRow& i_rOnce, const VReporter::VRow& i_rPeer,
			            const std::string&)
			        {
				        ratios.push_back(i_rOnce.m_Time / i_rPeer.m_Time);
				        peers.push_back(i_rPeer.m_Time);
			        });
		    }
		    Verdict::Tell(i_rRatio.m_pOver, i_rRatio.m_pUnder, i_rArgument, ratios, i_rRatio.m_Limit, peers);
	    });
	return 0;
}

inline int Main(int i_Count, char** i_ppArguments, const std::vector<VRatio>& i_rRatios)
{
	const bool bVerdict = Verdict::WasAskedFor(i_Count, i_ppArguments);
	// Options of the command line come later and win.
	std::vector<char*> arguments{i_ppArguments[0]};
	std::vector<std::string> defaults{
	    "--benchmark_repetitions=9", "--benchmark_min_time=0.02", "--benchmark_enable_random_interleaving=true"};
	if (bVerdict)
		defaults = {"--benchmark_repetitions=1", "--benchmark_min_time=0.01"};
	for (std::string& rDefault : defaults)
		arguments.push_back(rDefault.data());
	std::remove_copy_if(i_ppArguments + 1, i_ppArguments + i_Count, std::back_inserter(arguments), Verdict::IsOption);
	int count = static_cast<int>(arguments.size());
	benchmark::Initialize(&count, arguments.data());
	if (benchmark::ReportUnrecognizedArguments(count, arguments.data()))
		return 2;
	if (bVerdict)
		return MeasureVerdict(i_rRatios);
	VReporter reporter(true);
	benchmark::RunSpecifiedBenchmarks(&reporter);
	ForEachPair(reporter.m_Rows, i_rRatios,
	    [](const VRatio& i_rRatio, const VReporter::VRow& i_rOver, const VReporter::VRow& i_rUnder,
	        const std::string& i_rArgument)
	    {
		    const double ratio = i_rOver.m_Time / i_rUnder.m_Time;
		    std::printf("%s / %s at %s: %.3f (limit %g)%s\n", i_rRatio.m_pOver, i_rRatio.m_pUnder, i_rArgument.c_str(),
		        ratio, i_rRatio.m_Limit, ratio > i_rRatio.m_Limit ? " EXCEEDED" : "");
	    });
	return 0;
}

} // namespace Ratios
