#include "DebugServices/GlobalLog.h"

#include <gtest/gtest.h>

#include <atomic>
#include <future>
#include <memory>
#include <string>
#include <thread>
#include <vector>

namespace
{

TEST(GlobalLog, AMessageThatCannotBeFormattedIsToldAsSuch)
{
	std::vector<std::pair<int, std::string>> log;
	const auto pSink = NVX::GlobalLog::AddSink([&](const NVX::VLogCategory&, int i_Level, const std::string& i_rMessage)
	    { log.emplace_back(i_Level, i_rMessage); });
	NVX_LOG("System", NVX::ELogWarning, "Marker duplicate id: %1% %2%", 7);
	NVX_LOG("System", NVX::ELogWarning, "Marker duplicate id: %1%", 7, 8);
	NVX_LOG("System", NVX::ELogWarning, "Marker duplicate id: %1%", "%s %2%");
	EXPECT_EQ(log,
	    (std::vector<std::pair<int, std::string>>{{2, "Cannot Format Log Message \"Marker duplicate id: %1% %2%\""},
	        {2, "Cannot Format Log Message \"Marker duplicate id: %1%\""}, {3, "Marker duplicate id: %s %2%"}}));
}

TEST(GlobalLog, ASinkRunsNoMoreWhenItsTokenIsGone)
{
	std::promise<void> begun, goes;
	std::atomic<bool> bEnded = false;
	auto pToken = NVX::GlobalLog::AddSink(
	    [&](const NVX::VLogCategory&, int, const std::string&)
	    {
		    begun.set_value();
		    goes.get_future().wait();
		    for (int i = 0; i < 100'000; ++i)
			    std::this_thread::yield();
		    bEnded = true;
	    });
	std::thread logging([] { NVX_LOG("System", NVX::ELogError, "On another thread"); });
	begun.get_future().wait();
	goes.set_value();
	pToken.reset();
	EXPECT_TRUE(bEnded);
	logging.join();
}

TEST(GlobalLog, ASinkMayEndItselfAndAnother)
{
	std::string called;
	std::shared_ptr<void> pFirst, pSecond;
	pFirst = NVX::GlobalLog::AddSink(
	    [&](const NVX::VLogCategory&, int, const std::string&)
	    {
		    called += '1';
		    pFirst.reset();
		    pSecond.reset();
	    });
	pSecond = NVX::GlobalLog::AddSink([&](const NVX::VLogCategory&, int, const std::string&) { called += '2'; });
	const auto pThird =
	    NVX::GlobalLog::AddSink([&](const NVX::VLogCategory&, int, const std::string&) { called += '3'; });
	NVX_LOG("System", NVX::ELogError, "Once");
	NVX_LOG("System", NVX::ELogError, "Twice");
	EXPECT_EQ(called, "133");
}

} // namespace
