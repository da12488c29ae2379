#pragma once

#include "DebugServices/Assert.h"
#include "DebugServices/GlobalLog.h"

#include <string>
#include <utility>
#include <vector>

/// Gathers, while it lives, everything that is logged, as "category level text", and failed assertions, as "ASSERT
/// text", in the order in which they come.
class VMessageLog
{
public:
	VMessageLog()
	{
		Texts().clear();
		for (const char* pCategory :
		    {"SubjectUtils", "SubjectParametrisedUtils", "SubjectCalibrationAlgo", "RigidBodyUtils"})
			NVX::GlobalLog::Category(pCategory).SetLevel(NVX::ELogDetail);
		m_pBefore = DebugServices::SetAssertFailHandler(
		    [](const char* i_pText, const char*, int) { Texts().push_back(std::string("ASSERT ") + i_pText); });
	}
	~VMessageLog() { DebugServices::SetAssertFailHandler(m_pBefore); }
	VMessageLog(const VMessageLog&) = delete;
	VMessageLog& operator=(const VMessageLog&) = delete;

	std::vector<std::string> Take() { return std::exchange(Texts(), {}); }

	/// Only errors and warnings, without category, and assertions.
	std::vector<std::string> TakeTroubles()
	{
		std::vector<std::string> troubles;
		for (const std::string& rText : Take())
			if (const std::size_t level = rText.find_first_of("23"); rText.compare(0, 6, "ASSERT") == 0)
				troubles.push_back(rText);
			else if (level != std::string::npos && level == rText.find(' ') + 1)
				troubles.push_back(rText.substr(level));
		return troubles;
	}

private:
	static std::vector<std::string>& Texts()
	{
		static std::vector<std::string> s_Texts;
		return s_Texts;
	}

	DebugServices::VAssertFailHandler m_pBefore;
	std::shared_ptr<void> m_pSink =
	    NVX::GlobalLog::AddSink([](const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rText)
	        { Texts().push_back(i_rCategory.Name() + ' ' + std::to_string(i_Level) + ' ' + i_rText); });
};
