#include "Rows.h"

#include <cstdlib>
#include <fstream>

namespace
{

/// What a page shows is what a user gets: each "$ command" of its console blocks, with the lines behind it.
void RunSession(const std::string& i_rPage, std::size_t i_Steps)
{
	struct VStep
	{
		std::string m_Command;
		std::string m_Output;
	};
	std::vector<VStep> steps;
	std::ifstream page(RETARGET_SOURCE "/" + i_rPage);
	bool bConsole = false;
	bool bContinued = false;
	for (std::string line; std::getline(page, line);)
	{
		if (line.starts_with("```"))
			bConsole = line == "```console";
		else if (bConsole && line.starts_with("$ "))
			steps.push_back({line.substr(2), ""});
		else if (bConsole && bContinued)
			steps.back().m_Command += "\n" + line;
		else if (bConsole)
			steps.back().m_Output += line + "\n";
		bContinued = bConsole && line.ends_with("\\");
	}
	ASSERT_GE(steps.size(), i_Steps) << i_rPage;

	const VScratchFolder folder;
	boost::filesystem::create_directory_symlink(RETARGET_SOURCE "/demo", folder / "demo");
	for (const VStep& rStep : steps)
	{
		folder.Write("step",
		    "PATH='" + boost::filesystem::path(RETARGET_PROGRAM).parent_path().string() + "':$PATH\ncd '"
		        + folder.Path().string() + "'\n" + rStep.m_Command);
		std::system(("bash '" + (folder / "step").string() + "' > '" + (folder / "out").string() + "' 2>&1").c_str());
		EXPECT_EQ(folder.Read("out"), rStep.m_Output) << rStep.m_Command;
	}
}

TEST(Session, OfTheCommandLinesPage)
{
	RunSession("docs/command-line.md", 13);
}

TEST(Session, OfTheFirstScreen)
{
	RunSession("README.md", 2);
}

} // namespace
