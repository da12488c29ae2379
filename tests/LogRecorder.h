#pragma once

#include "DebugServices/GlobalLog.h"

#include <memory>
#include <mutex>
#include <string>
#include <utility>

/// What the log receives while this lives, from any thread: one line for each message, as "3 RetargetSetup: text".
class VLogRecorder
{
public:
	/// @param i_LastLevel the least important one that counts
	/// @param i_rExcept a category that does not count
	explicit VLogRecorder(int i_LastLevel = NVX::ELogDetail, const std::string& i_rExcept = {})
	    : m_pToken(NVX::GlobalLog::AddSink(
	        [this, i_LastLevel, i_rExcept](
	            const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rMessage)
	        {
		        if (i_Level > i_LastLevel || i_rCategory.Name() == i_rExcept)
			        return;
		        const std::lock_guard lock(m_Mutex);
		        m_Text += (m_Text.empty() ? "" : "\n") + std::to_string(i_Level) + " " + i_rCategory.Name() + ": "
		            + i_rMessage;
	        }))
	{
	}

	/// The lines so far, which are then forgotten.
	std::string Take()
	{
		const std::lock_guard lock(m_Mutex);
		return std::exchange(m_Text, {});
	}

private:
	std::mutex m_Mutex;
	std::string m_Text;
	std::shared_ptr<void> m_pToken;
};
