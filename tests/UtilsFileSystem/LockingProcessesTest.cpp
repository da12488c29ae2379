#include "Folder.h"
#include "Log.h"

#include "UtilsFileSystem/FileStreams.h"
#include "UtilsFileSystem/Files.h"
#include "UtilsFileSystem/LockingProcesses.h"
#include "UtilsFileSystem/MemoryMappedFile.h"

#include <gtest/gtest.h>

#include <csignal>
#include <fcntl.h>
#include <map>
#include <sys/wait.h>
#include <unistd.h>

namespace
{

using namespace UtilsFileSystem;
using boost::filesystem::path;
using VTexts = std::vector<std::string>;

/// What a process answers; an absent answer is a refusal.
struct VAnswers
{
	std::uint64_t m_StartTime = 0;
	std::string m_Image;
};

class VTestProcess final : public IProcess
{
public:
	explicit VTestProcess(const VAnswers& i_rAnswers) : m_Answers(i_rAnswers) {}
	bool GetStartTime(std::uint64_t& o_rTime) override
	{
		o_rTime = m_Answers.m_StartTime;
		return o_rTime != 0;
	}
	bool GetImagePath(std::string& o_rPath) override
	{
		o_rPath = m_Answers.m_Image;
		return !o_rPath.empty();
	}

private:
	const VAnswers m_Answers;
};

class VTestTable final : public IProcessTable
{
public:
	bool FindHolders(const path&, std::vector<VLockHolder>& o_rHolders) override
	{
		o_rHolders = m_Holders;
		return m_bKnown;
	}
	std::unique_ptr<IProcess> Open(std::uint32_t i_ProcessId) override
	{
		const auto it = m_Processes.find(i_ProcessId);
		return it == m_Processes.end() ? nullptr : std::make_unique<VTestProcess>(it->second);
	}

	bool m_bKnown = true;
	std::vector<VLockHolder> m_Holders;
	std::map<std::uint32_t, VAnswers> m_Processes;
};

TEST(LockingProcesses, NamesOnlyWhoIsStillTheSame)
{
	VTestTable table;
	table.m_Holders = {{1, 100}, {2, 200}, {3, 300}, {4, 400}, {5, 500}};
	table.m_Processes = {{1, {100, "/bin/one"}}, {2, {201, "/bin/later"}}, {3, {0, "/bin/untimed"}}, {4, {400, ""}}};
	VTexts names;
	EXPECT_TRUE(GetLockingProcesses(table, "file", names));
	EXPECT_EQ(names, (VTexts{"/bin/one", "unknown process", "unknown process", "unknown process"}));
	EXPECT_EQ(JoinNames({"a", "b"}), "a', 'b");
}

TEST(LockingProcesses, GivesNoListThatIsNotWhole)
{
	VTestTable table;
	VTexts names = {"old"};
	table.m_bKnown = false;
	EXPECT_FALSE(GetLockingProcesses(table, "file", names));
	EXPECT_EQ(names, VTexts{});
	table.m_bKnown = true;
	for (std::uint32_t id = 1; id <= c_MaximumHolders; ++id)
	{
		table.m_Holders.push_back({id, 7});
		table.m_Processes[id] = {7, "p"};
	}
	EXPECT_TRUE(GetLockingProcesses(table, "file", names));
	EXPECT_EQ(names.size(), c_MaximumHolders);
	table.m_Holders.push_back({11, 7});
	EXPECT_FALSE(GetLockingProcesses(table, "file", names));
	EXPECT_EQ(names, VTexts{});
}

TEST(LockingProcesses, FindsWhoLockedAFile)
{
	if (!std::ifstream("/proc/locks"))
		GTEST_SKIP() << "the system does not list locks";
	const VTestFolder folder;
	const path file = folder / "a";
	Put(file, "x");
	VTexts names;
	EXPECT_TRUE(GetLockingProcesses(file, names));
	EXPECT_EQ(names, VTexts{});

	int ready[2];
	ASSERT_EQ(::pipe(ready), 0);
	const pid_t child = ::fork();
	ASSERT_GE(child, 0);
	if (child == 0)
	{
		const int descriptor = ::open(file.c_str(), O_RDWR);
		struct flock lock = {};
		lock.l_type = F_WRLCK;
		const char done = ::fcntl(descriptor, F_SETLK, &lock) == 0 ? 'y' : 'n';
		if (::write(ready[1], &done, 1) == 1)
			::pause();
		::_exit(0);
	}
	char done = 0;
	EXPECT_EQ(::read(ready[0], &done, 1), 1);
	EXPECT_EQ(done, 'y');
	EXPECT_TRUE(GetLockingProcesses(file, names));
	EXPECT_EQ(names, VTexts{boost::filesystem::canonical("/proc/self/exe").native()});
	EXPECT_FALSE(GetLockingProcesses(folder / "no", names));
	::kill(child, SIGKILL);
	::waitpid(child, nullptr, 0);
	::close(ready[0]);
	::close(ready[1]);
	EXPECT_TRUE(GetLockingProcesses(file, names));
	EXPECT_EQ(names, VTexts{});
}

/// The one sharing failure of this system: a program that runs cannot be written to.
TEST(LockingProcesses, FailedOpensTellWhoIsInTheWay)
{
	const VTestFolder folder;
	const path program = folder / "cat";
	copy_file("/bin/cat", program);
	int output[2];
	ASSERT_EQ(::pipe(output), 0);
	const pid_t child = ::fork();
	ASSERT_GE(child, 0);
	if (child == 0)
	{
		::dup2(output[1], 1);
		::execl(program.c_str(), "cat", "/dev/zero", nullptr);
		::_exit(1);
	}
	// The program runs once something comes of it.
	char byte = 'x';
	ASSERT_EQ(::read(output[0], &byte, 1), 1);

	VTestLog log("System");
	const std::string name = program.native();
	EXPECT_TRUE(VFileOutputStream(program, std::ios_base::app).fail());
	EXPECT_EQ(OpenFile(program, "ab"), nullptr);
	EXPECT_FALSE(VMemoryMappedOutputFile(program, 1).IsOpen());
	EXPECT_EQ(log.Take(),
	    (VTexts{"2 Failed to open output file stream " + name + " locked by processes '" + name + "'.",
	        "2 Failed to open output file " + name + " locked by processes '" + name + "'.",
	        "2 Failed to open output file '" + name + "' locked by processes '" + name + "'."}));
	LogOpenFailure(program, ETXTBSY, "Failed to open input file %1% locked by processes '%2%'.");
	EXPECT_EQ(log.Take(), VTexts{"2 Failed to open input file " + name + " locked by processes '" + name + "'."});
	::kill(child, SIGKILL);
	::waitpid(child, nullptr, 0);
	::close(output[0]);
	::close(output[1]);
}

} // namespace
