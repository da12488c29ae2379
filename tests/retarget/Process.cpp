#include "Process.h"

#include <boost/algorithm/string/replace.hpp>

#include <algorithm>
#include <cstdlib>
#include <sys/wait.h>

std::vector<std::string> VScratchFolder::Names() const
{
	std::vector<std::string> names;
	for (const auto& rEntry : boost::filesystem::directory_iterator(Path()))
		names.push_back(rEntry.path().filename().string());
	std::sort(names.begin(), names.end());
	return names;
}

std::map<std::string, std::string> VScratchFolder::Snapshot() const
{
	std::map<std::string, std::string> files;
	for (const std::string& rName : Names())
		files[rName] = Read(rName);
	return files;
}

VRun VScratchFolder::Run(const std::vector<std::string>& i_rArguments, const std::string& i_rInput) const
{
	// Files take any amount of output without a reader.
	const VTestFolder output;
	std::string command =
	    "cd '" + Path().string() + "' && cat '" + i_rInput + "' 2> /dev/null | '" RETARGET_PROGRAM "'";
	for (const std::string& rArgument : i_rArguments)
		command += " '" + boost::replace_all_copy(rArgument, "'", "'\\''") + "'";
	command += " > '" + (output / "out").string() + "' 2> '" + (output / "err").string() + "'";
	const int status = std::system(command.c_str());
	return {
	    WIFEXITED(status) ? WEXITSTATUS(status) : 1000 + WTERMSIG(status), Get(output / "out"), Get(output / "err")};
}
