#pragma once

#include "DebugServices/GlobalLog.h"

#include <string>
#include <utility>
#include <vector>

/// Gathers what is logged in one category, as "level text".
class VTestLog
{
public:
	explicit VTestLog(const std::string& i_rCategory) : m_rCategory(NVX::GlobalLog::Category(i_rCategory))
	{
		m_rCategory.SetLevel(NVX::ELogDetail);
	}
	~VTestLog() { m_rCategory.SetLevel(NVX::ELogWarning); }

	std::vector<std::string> Take() { return std::exchange(m_Texts, {}); }

private:
	NVX::VLogCategory& m_rCategory;
	std::vector<std::string> m_Texts;
	std::shared_ptr<void> m_pSink = NVX::GlobalLog::AddSink(
	    [this](const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rText)
	    {
		    if (&i_rCategory == &m_rCategory)
			    m_Texts.push_back(std::to_string(i_Level) + ' ' + i_rText);
	    });
};
