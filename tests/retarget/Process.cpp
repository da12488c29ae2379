#include "Process.h"

#include <algorithm>
#include <fcntl.h>
#include <fstream>
#include <spawn.h>
#include <sstream>
#include <stdexcept>
#include <sys/wait.h>
#include <unistd.h>

extern char** environ;

namespace
{

std::string ReadAll(const std::filesystem::path& i_rPath)
{
	std::ifstream file(i_rPath, std::ios::binary);
	std::ostringstream text;
	text << file.rdbuf();
	return text.str();
}

} // namespace

VScratchFolder::VScratchFolder()
{
	std::string path = (std::filesystem::temp_directory_path() / "retarget-XXXXXX").string();
	if (!mkdtemp(path.data()))
		throw std::runtime_error("no scratch folder");
	m_Path = path;
}

VScratchFolder::~VScratchFolder()
{
	std::error_code ignored;
	std::filesystem::remove_all(m_Path, ignored);
}

void VScratchFolder::Write(const std::string& i_rName, const std::string& i_rText) const
{
	std::ofstream(m_Path / i_rName, std::ios::binary) << i_rText;
}

std::string VScratchFolder::Read(const std::string& i_rName) const
{
	return ReadAll(m_Path / i_rName);
}

std::vector<std::string> VScratchFolder::Names() const
{
	std::vector<std::string> names;
	for (const auto& rEntry : std::filesystem::directory_iterator(m_Path))
		names.push_back(rEntry.path().filename().string());
	std::sort(names.begin(), names.end());
	return names;
}

VRun RunRetarget(const std::vector<std::string>& i_rArguments, const std::filesystem::path& i_rFolder)
{
	// Files take any amount of output without a reader.
	const VScratchFolder output;
	const std::string out = (output / "out").string();
	const std::string err = (output / "err").string();

	posix_spawn_file_actions_t actions;
	posix_spawn_file_actions_init(&actions);
	posix_spawn_file_actions_addchdir_np(&actions, i_rFolder.c_str());
	posix_spawn_file_actions_addopen(&actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
	posix_spawn_file_actions_addopen(&actions, STDOUT_FILENO, out.c_str(), O_WRONLY | O_CREAT, 0600);
	posix_spawn_file_actions_addopen(&actions, STDERR_FILENO, err.c_str(), O_WRONLY | O_CREAT, 0600);

	std::vector<std::string> words = i_rArguments;
	words.insert(words.begin(), RETARGET_PROGRAM);
	std::vector<char*> pointers;
	for (std::string& rWord : words)
		pointers.push_back(rWord.data());
	pointers.push_back(nullptr);

	VRun run;
	pid_t child = 0;
	if (posix_spawn(&child, RETARGET_PROGRAM, &actions, nullptr, pointers.data(), environ) == 0)
	{
		int status = 0;
		waitpid(child, &status, 0);
		run.m_Status = WIFEXITED(status) ? WEXITSTATUS(status) : 1000 + WTERMSIG(status);
	}
	posix_spawn_file_actions_destroy(&actions);
	run.m_Out = ReadAll(out);
	run.m_Err = ReadAll(err);
	return run;
}
