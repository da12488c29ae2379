#pragma once

#include "retarget/picture/RenderCommand.h"
#include "retarget/subject/SubjectFile.h"

#include <string>

namespace CommandLine
{

/// What "retarget report" is asked for.
struct VReportSettings
{
	std::string m_In;
	/// Empty for none.
	std::string m_Source;
	std::string m_Fbx;
	std::string m_Take;
	bool m_bPictures = true;
};

struct VReport
{
	/// The page.
	std::string m_Text;
	std::size_t m_Targets = 0;
	std::size_t m_Findings = 0;
	std::size_t m_Pictures = 0;
	/// Why there are fewer pictures than there could be; empty if there are all.
	std::string m_NoPictures;
};

/// Of the files alone: the same ones give the same bytes, as far as the same display draws them.
VReport MakeReport(const VReportSettings& i_rSettings, const VRender& i_rRender);

} // namespace CommandLine
