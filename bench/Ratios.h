#pragma once

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdio>
#include <map>
#include <string>
#include <vector>

/// Runs all benchmarks of a program and prints ratios between their rows behind the table. A row's time is the least of
/// its repetitions' processor times: on a machine that does other work too, the rest is noise. Of a row whose work runs
/// on several threads, so that its name tells another kind of time, it is the least of the real times.
namespace Ratios
{

struct VRatio
{
	const char* m_pOver;
	const char* m_pUnder;
	double m_Limit;
};

class VReporter : public benchmark::ConsoleReporter
{
public:
	VReporter() : ConsoleReporter(OO_Tabular) {}

	void ReportRuns(const std::vector<Run>& i_rRuns) override
	{
		std::vector<Run> medians;
		for (const Run& rRun : i_rRuns)
		{
			if (rRun.error_occurred || (rRun.run_type == Run::RT_Aggregate && rRun.aggregate_name == "median"))
				medians.push_back(rRun);
			if (rRun.error_occurred || rRun.run_type != Run::RT_Iteration)
				continue;
			const double time =
			    rRun.run_name.time_type.empty() ? rRun.GetAdjustedCPUTime() : rRun.GetAdjustedRealTime();
			const auto [found, bNew] =
			    m_Times.emplace(std::pair{rRun.run_name.function_name, rRun.run_name.args}, time);
			if (!bNew)
				found->second = std::min(found->second, time);
		}
		ConsoleReporter::ReportRuns(medians);
	}

	void Print(const std::vector<VRatio>& i_rRatios) const
	{
		for (const VRatio& rRatio : i_rRatios)
			for (const auto& [rRow, rTime] : m_Times)
			{
				const auto under = m_Times.find({rRatio.m_pUnder, rRow.second});
				if (rRow.first != rRatio.m_pOver || under == m_Times.end())
					continue;
				const double ratio = rTime / under->second;
				std::printf("%s / %s at %s: %.3f (limit %g)%s\n", rRatio.m_pOver, rRatio.m_pUnder, rRow.second.c_str(),
				    ratio, rRatio.m_Limit, ratio > rRatio.m_Limit ? " EXCEEDED" : "");
			}
	}

private:
	std::map<std::pair<std::string, std::string>, double> m_Times;
};

inline int Main(int i_Count, char** i_ppArguments, const std::vector<VRatio>& i_rRatios)
{
	// Options of the command line come later and win.
	std::vector<char*> arguments{i_ppArguments[0]};
	std::string defaults[] = {
	    "--benchmark_repetitions=9", "--benchmark_min_time=0.02", "--benchmark_enable_random_interleaving=true"};
	for (std::string& rDefault : defaults)
		arguments.push_back(rDefault.data());
	arguments.insert(arguments.end(), i_ppArguments + 1, i_ppArguments + i_Count);
	int count = static_cast<int>(arguments.size());
	benchmark::Initialize(&count, arguments.data());
	if (benchmark::ReportUnrecognizedArguments(count, arguments.data()))
		return 2;
	VReporter reporter;
	benchmark::RunSpecifiedBenchmarks(&reporter);
	reporter.Print(i_rRatios);
	return 0;
}

} // namespace Ratios
