#include "DebugServices/GlobalLog.h"

#include <cstdio>
#include <list>
#include <map>
#include <mutex>
#include <vector>

namespace
{

struct VLogState
{
	std::mutex m_Mutex;
	std::map<std::string, std::unique_ptr<NVX::VLogCategory>> m_Categories;
	int m_DefaultLevel = NVX::ELogWarning;
	std::list<std::shared_ptr<const NVX::VLogSink>> m_Sinks;
};

/// Never destroyed: categories are kept by call sites that may still run while the process ends.
VLogState& State()
{
	static VLogState* const s_pState = new VLogState;
	return *s_pState;
}

} // namespace

NVX::VLogCategory& NVX::GlobalLog::Category(const std::string& i_rName)
{
	VLogState& rState = State();
	const std::lock_guard lock(rState.m_Mutex);
	std::unique_ptr<VLogCategory>& rpCategory = rState.m_Categories[i_rName];
	if (!rpCategory)
	{
		rpCategory = std::make_unique<VLogCategory>(i_rName);
		rpCategory->SetLevel(rState.m_DefaultLevel);
	}
	return *rpCategory;
}

void NVX::GlobalLog::SetDefaultLevel(int i_Level)
{
	VLogState& rState = State();
	const std::lock_guard lock(rState.m_Mutex);
	rState.m_DefaultLevel = i_Level;
	for (const auto& [rName, rpCategory] : rState.m_Categories)
		rpCategory->SetLevel(i_Level);
}

std::shared_ptr<void> NVX::GlobalLog::AddSink(VLogSink i_Sink)
{
	VLogState& rState = State();
	auto pSink = std::make_shared<const VLogSink>(std::move(i_Sink));
	const std::lock_guard lock(rState.m_Mutex);
	rState.m_Sinks.push_back(pSink);
	return {nullptr,
	    [pSink](void*)
	    {
		    VLogState& rState = State();
		    const std::lock_guard lock(rState.m_Mutex);
		    rState.m_Sinks.remove(pSink);
	    }};
}

void LoggingDetail::GlobalLogStream(const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rMessage)
{
	std::vector<std::shared_ptr<const NVX::VLogSink>> sinks;
	{
		VLogState& rState = State();
		const std::lock_guard lock(rState.m_Mutex);
		sinks.assign(rState.m_Sinks.begin(), rState.m_Sinks.end());
	}
	for (const auto& pSink : sinks)
		(*pSink)(i_rCategory, i_Level, i_rMessage);
	if (sinks.empty())
		std::fprintf(stderr, "%d %s: %s\n", i_Level, i_rCategory.Name().c_str(), i_rMessage.c_str());
}
