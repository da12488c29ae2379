#include "DebugServices/GlobalLog.h"

#include <gtest/gtest.h>

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

} // namespace
