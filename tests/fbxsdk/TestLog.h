#pragma once

#include "DebugServices/GlobalLog.h"

#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace FbxTest
{

using VMessages = std::vector<std::pair<int, std::string>>;

/// What the category "FBXIO" tells at any level while this lives.
class VTestLog
{
public:
	VTestLog()
	{
		NVX::GlobalLog::Category("FBXIO").SetLevel(NVX::ELogDetail);
		m_pSink = NVX::GlobalLog::AddSink(
		    [this](const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rMessage)
		    {
			    if (i_rCategory.Name() == "FBXIO")
				    m_Messages.emplace_back(i_Level, i_rMessage);
		    });
	}
	~VTestLog() { NVX::GlobalLog::Category("FBXIO").SetLevel(m_LevelBefore); }
	VTestLog(const VTestLog&) = delete;
	VTestLog& operator=(const VTestLog&) = delete;

	VMessages m_Messages;

private:
	const int m_LevelBefore = NVX::GlobalLog::Category("FBXIO").Level();
	std::shared_ptr<void> m_pSink;
};

} // namespace FbxTest
