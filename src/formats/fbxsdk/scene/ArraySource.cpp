#include "fbxsdk/scene/ArraySource.h"

#include "DebugServices/GlobalLog.h"

#include <atomic>
#include <future>

namespace
{

using namespace FbxFormat;

/// Below this many bytes in the file a second thread costs more than it gains.
constexpr std::size_t c_BytesForTwo = 100'000;

std::uint64_t CostOf(const VDecodeJob& i_rJob)
{
	return std::visit([&]<typename T>(const VArrayNumbers<T>*)
	    { return DecodedBytes<T>(*i_rJob.m_Source.m_pTree, i_rJob.m_Source.m_Element); },
	    i_rJob.m_pNumbers);
}

void Run(VDecodeJob& io_rJob)
{
	io_rJob.m_bSound = std::visit([&](auto* o_pNumbers)
	    { return ReadCharged(*io_rJob.m_Source.m_pTree, io_rJob.m_Source.m_Element, *o_pNumbers); },
	    io_rJob.m_pNumbers);
}

} // namespace

void FbxFormat::Decode(std::span<VDecodeJob> io_Jobs)
{
	std::vector<VDecodeJob*> jobs;
	std::size_t bytes = 0;
	for (VDecodeJob& rJob : io_Jobs)
	{
		std::visit([](auto* o_pNumbers) { o_pNumbers->clear(); }, rJob.m_pNumbers);
		if (rJob.m_Source.m_Element == c_NoElement)
			continue;
		// Charged before any thread runs: what is left out does not depend on which is faster.
		rJob.m_bSound = rJob.m_Source.m_pBudget->Take(CostOf(rJob));
		if (!rJob.m_bSound)
			continue;
		jobs.push_back(&rJob);
		bytes += rJob.m_Source.m_pTree->Values(rJob.m_Source.m_Element).size();
	}

	std::atomic<std::size_t> next = 0;
	const auto run = [&]
	{
		for (std::size_t i = next++; i < jobs.size(); i = next++)
			Run(*jobs[i]);
	};
	std::future<void> second;
	// With both policies this is a thread as long as the system has one to give.
	if (jobs.size() > 1 && bytes >= c_BytesForTwo)
		second = std::async(std::launch::async | std::launch::deferred, run);
	run();
	if (second.valid())
		second.wait();

	for (const VDecodeJob& rJob : io_Jobs)
		if (!rJob.m_bSound)
			NVX_LOG("FBXIO", NVX::ELogWarning, "Array %1% of %2% left out because it is damaged or too large",
			    rJob.m_Source.m_pTree->Name(rJob.m_Source.m_Element), rJob.m_pOwner);
}
