#include "DebugServices/GlobalLog.h"

#include <boost/format.hpp>

#include <condition_variable>
#include <cstddef>
#include <cstdio>
#include <exception>
#include <list>
#include <locale>
#include <map>
#include <mutex>
#include <vector>

namespace
{

/// All but the call itself under the lock of the state.
struct VSink
{
	NVX::VLogSink m_Call;
	bool m_bRemoved = false;
	/// Calls that run.
	std::size_t m_Calls = 0;
};

struct VLogState
{
	std::mutex m_Mutex;
	std::condition_variable m_CallEnded;
	std::map<std::string, std::unique_ptr<NVX::VLogCategory>> m_Categories;
	int m_DefaultLevel = NVX::ELogWarning;
	std::list<std::shared_ptr<VSink>> m_Sinks;
};

/// Never destroyed: categories are kept by call sites that may still run while the process ends.
VLogState& State()
{
	static VLogState* const s_pState = new VLogState;
	return *s_pState;
}

/// Calls of sinks that this thread is in.
thread_local std::size_t s_CallsOfThread = 0;

/// One call of a sink, as long as this lives; none if the sink was removed.
class VCall
{
public:
	explicit VCall(VSink& io_rSink) : m_rSink(io_rSink)
	{
		const std::lock_guard lock(State().m_Mutex);
		m_bMay = !m_rSink.m_bRemoved;
		m_rSink.m_Calls += m_bMay;
		s_CallsOfThread += m_bMay;
	}
	~VCall()
	{
		const std::lock_guard lock(State().m_Mutex);
		m_rSink.m_Calls -= m_bMay;
		s_CallsOfThread -= m_bMay;
		if (m_rSink.m_bRemoved)
			State().m_CallEnded.notify_all();
	}
	VCall(const VCall&) = delete;

	bool May() const { return m_bMay; }

private:
	VSink& m_rSink;
	bool m_bMay = false;
};

void Remove(const std::shared_ptr<VSink>& i_rpSink)
{
	VLogState& rState = State();
	std::unique_lock lock(rState.m_Mutex);
	rState.m_Sinks.remove(i_rpSink);
	i_rpSink->m_bRemoved = true;
	// From within a call it would wait for itself, or for one that waits for it.
	if (s_CallsOfThread == 0)
		rState.m_CallEnded.wait(lock, [&] { return i_rpSink->m_Calls == 0; });
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
	auto pSink = std::make_shared<VSink>(VSink{std::move(i_Sink)});
	const std::lock_guard lock(rState.m_Mutex);
	rState.m_Sinks.push_back(pSink);
	return {nullptr, [pSink](void*) { Remove(pSink); }};
}

void LoggingDetail::GlobalLogStream(const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rMessage)
{
	std::vector<std::shared_ptr<VSink>> sinks;
	{
		VLogState& rState = State();
		const std::lock_guard lock(rState.m_Mutex);
		sinks.assign(rState.m_Sinks.begin(), rState.m_Sinks.end());
	}
	for (const auto& pSink : sinks)
		if (const VCall call(*pSink); call.May())
			pSink->m_Call(i_rCategory, i_Level, i_rMessage);
	if (sinks.empty())
		std::fprintf(stderr, "%d %s: %s\n", i_Level, i_rCategory.Name().c_str(), i_rMessage.c_str());
}

void LoggingDetail::Log(const NVX::VLogCategory& i_rCategory, int i_Level, const char* i_pFormat,
    std::initializer_list<VArgument> i_Arguments)
{
	std::string message;
	try
	{
		boost::format format(i_pFormat, std::locale::classic());
		for (const VArgument& rArgument : i_Arguments)
			std::visit([&format](const auto& i_rValue) { format % i_rValue; }, rArgument.Value());
		message = format.str();
	}
	catch (const std::exception&)
	{
		i_Level = NVX::ELogError;
		message = std::string("Cannot Format Log Message \"") + i_pFormat + "\"";
	}
	GlobalLogStream(i_rCategory, i_Level, message);
}
