#include "UtilsFileSystem/Folder.h"
#include "UtilsFileSystem/Log.h"

#include "FileSystemWatcher/DirectoryMonitor.h"
#include "FileSystemWatcher/FileSystemWatcher.h"

#include <gtest/gtest.h>

#include <boost/system/system_error.hpp>

#include <chrono>
#include <condition_variable>
#include <deque>
#include <mutex>

namespace
{

using namespace FileSystemWatcher;
using boost::filesystem::path;
using VTexts = std::vector<std::string>;

const char* const c_pKinds[] = {"0", "added", "removed", "modified", "old", "new"};

/// What callbacks tell, as "kind name". Modifications in a row count as one: how many come is the system's affair.
class VInbox
{
public:
	void Put(const std::string& i_rText)
	{
		const std::lock_guard lock(m_Mutex);
		if (i_rText != m_Last || i_rText.find("modified") == std::string::npos)
			m_Texts.push_back(i_rText);
		m_Last = i_rText;
		m_Changed.notify_all();
	}

	VFileSystemWatcher::VChangeSignal::VCallback Callback(const std::string& i_rPrefix = {})
	{
		return [this, i_rPrefix](EFileChange i_Change, const path& i_rPath)
		{ Put(i_rPrefix + c_pKinds[i_Change] + ' ' + i_rPath.filename().string()); };
	}

	/// Waits for a text and takes all that came up to it.
	VTexts TakeTo(const std::string& i_rText)
	{
		std::unique_lock lock(m_Mutex);
		VTexts taken;
		const auto arrived = [&]
		{
			while (!m_Texts.empty() && (taken.empty() || taken.back() != i_rText))
			{
				taken.push_back(m_Texts.front());
				m_Texts.pop_front();
			}
			return !taken.empty() && taken.back() == i_rText;
		};
		// The time only ends a test that would hang.
		EXPECT_TRUE(m_Changed.wait_for(lock, std::chrono::seconds(30), arrived)) << "no " << i_rText;
		return taken;
	}

private:
	std::mutex m_Mutex;
	std::condition_variable m_Changed;
	std::deque<std::string> m_Texts;
	std::string m_Last;
};

TEST(FileSystemWatcher, TellsOfFilesAndDirectories)
{
	const VTestFolder folder;
	VInbox inbox;
	VFileSystemWatcher watcher;
	watcher.Watch(folder.Path(), inbox.Callback(), inbox.Callback("directory "));

	Put(folder / "a", "one");
	EXPECT_EQ(inbox.TakeTo("modified a"), (VTexts{"added a", "modified a"}));
	rename(folder / "a", folder / "b \xC3\xA4");
	EXPECT_EQ(inbox.TakeTo("new b \xC3\xA4"), (VTexts{"old a", "new b \xC3\xA4"}));
	Put(folder / "b \xC3\xA4", "two");
	EXPECT_EQ(inbox.TakeTo("modified b \xC3\xA4"), VTexts{"modified b \xC3\xA4"});
	remove(folder / "b \xC3\xA4");
	EXPECT_EQ(inbox.TakeTo("removed b \xC3\xA4"), VTexts{"removed b \xC3\xA4"});
	create_directory(folder / "sub");
	EXPECT_EQ(inbox.TakeTo("directory added sub"), VTexts{"directory added sub"});
	rename(folder / "sub", folder / "below");
	EXPECT_EQ(inbox.TakeTo("directory new below"), (VTexts{"directory old sub", "directory new below"}));
	// Not what lies below.
	Put(folder / "below/file", "");
	remove_all(folder / "below");
	EXPECT_EQ(inbox.TakeTo("directory removed below").back(), "directory removed below");
}

/// From one directory to another it is not a rename for either, whether both are watched or one.
TEST(FileSystemWatcher, TellsOfMovesBetweenDirectories)
{
	const VTestFolder left;
	const VTestFolder right;
	const VTestFolder unwatched;
	VInbox inbox;
	VFileSystemWatcher watcher;
	Put(left / "a", "");
	watcher.Watch(left.Path(), inbox.Callback("left "));
	watcher.Watch(right.Path(), inbox.Callback("right "));
	rename(left / "a", right / "b");
	EXPECT_EQ(inbox.TakeTo("right added b"), (VTexts{"left removed a", "right added b"}));
	rename(right / "b", unwatched / "c");
	EXPECT_EQ(inbox.TakeTo("right removed b"), VTexts{"right removed b"});
	rename(unwatched / "c", left / "d");
	EXPECT_EQ(inbox.TakeTo("left added d"), VTexts{"left added d"});
}

TEST(FileSystemWatcher, ServesAllCallbacksOfADirectory)
{
	const VTestFolder folder;
	create_directory_symlink(folder.Path(), folder / "link");
	VInbox first;
	VInbox second;
	VFileSystemWatcher watcher;
	watcher.Watch(folder.Path(), first.Callback());
	watcher.Watch(folder / "link", second.Callback());
	create_symlink("nowhere", folder / "a");
	EXPECT_EQ(first.TakeTo("added a"), VTexts{"added a"});
	EXPECT_EQ(second.TakeTo("added a"), VTexts{"added a"});
}

TEST(FileSystemWatcher, SignalsFilesOfItsExtension)
{
	const VTestFolder folder;
	const VTestFolder other;
	VInbox inbox;
	VFileSystemWatcher watcher(".fbx");
	const auto note = [&](const std::string& i_rKind)
	{ return [&inbox, i_rKind](const path& i_rPath) { inbox.Put(i_rKind + i_rPath.filename().string()); }; };
	watcher.GetAdded().Connect(note("added "));
	watcher.GetRemoved().Connect(note("removed "));
	watcher.GetModified().Connect(note("modified "));
	watcher.SetDirectories({folder.Path(), other.Path()});
	Put(other / "first.fbx", "");
	inbox.TakeTo("modified first.fbx");
	watcher.SetDirectories({folder.Path()});
	Put(other / "gone.fbx", "");
	Put(folder / "a.txt", "");
	create_directory(folder / "directory.fbx");
	Put(folder / "a.FBX", "");
	rename(folder / "a.FBX", folder / "a.old");
	rename(folder / "a.old", folder / "b.fbx");
	remove(folder / "b.fbx");
	EXPECT_EQ(inbox.TakeTo("removed b.fbx"),
	    (VTexts{"added a.FBX", "modified a.FBX", "removed a.FBX", "added b.fbx", "removed b.fbx"}));
}

TEST(FileSystemWatcher, RefusesWhatItCannotWatch)
{
	const VTestFolder folder;
	Put(folder / "file", "");
	VTestLog log("FilesystemWatcher");
	VFileSystemWatcher watcher;
	using namespace boost::system;
	for (const auto& [rName, condition] :
	    {std::pair("no", errc::no_such_file_or_directory), std::pair("file", errc::not_a_directory)})
		try
		{
			watcher.Watch(folder / rName, {});
			ADD_FAILURE() << rName;
		}
		catch (const system_error& rError)
		{
			EXPECT_EQ(rError.code(), condition) << rError.what();
			EXPECT_EQ(rError.what(),
			    "boost::asio::basic_dir_monitor_service::init_iocp: CreateIoCompletionPort failed: "
			        + rError.code().message());
		}
	watcher.SetDirectories({folder / "no"});
	const VTexts texts = log.Take();
	ASSERT_EQ(texts.size(), 2u);
	EXPECT_EQ(texts[0].find("2 Error monitoring directory for changes:" + (folder / "no").string()), 0u) << texts[0];
	EXPECT_EQ(texts[1],
	    "3 The folder " + (folder / "no").string()
	        + " does not exist. Make it, or choose another one; it is used as soon as it is there");
}

/// However a listed directory comes, goes or is replaced: its files are followed.
class ListedDirectories : public testing::Test
{
protected:
	ListedDirectories()
	{
		m_Watcher.GetAdded().Connect([&](const path& i_rPath) { m_Inbox.Put("added " + i_rPath.string()); });
		m_Watcher.GetRefreshed().Connect([&](const path& i_rPath) { m_Inbox.Put("refreshed " + i_rPath.string()); });
	}

	void Follows(const char* i_pWhat, const path& i_rListed, bool i_bThere = true)
	{
		SCOPED_TRACE(i_pWhat);
		m_Inbox.TakeTo("refreshed " + i_rListed.string());
		const path put = i_rListed / (std::to_string(++m_File) + ".fbx");
		if (!i_bThere)
			return;
		Put(put, "");
		m_Inbox.TakeTo("added " + put.string());
	}

	const VTestFolder m_Folder;
	VInbox m_Inbox;
	VFileSystemWatcher m_Watcher{".fbx"};
	int m_File = 0;
};

TEST_F(ListedDirectories, AreFollowedWhereverTheyStand)
{
	const path deep = m_Folder / "a/b/skins";
	const path odd = m_Folder / "u/./../u";
	m_Watcher.SetDirectories({deep, odd});
	create_directory(m_Folder / "a");
	create_directory(m_Folder / "a/b");
	// The thread has seen both when it tells of another directory.
	create_directory(m_Folder / "u");
	Follows("an odd spelling", odd);
	create_directory(deep);
	Follows("step by step", deep);
	rename(m_Folder / "a", m_Folder / "elsewhere");
	Follows("a directory above is renamed", deep, false);
	create_directories(deep);
	Follows("another one in its place", deep);
	rename(m_Folder / "a", m_Folder / "old");
	Follows("gone with one above", deep, false);
	rename(m_Folder / "elsewhere", m_Folder / "a");
	Follows("the first one is back", deep);
}

TEST_F(ListedDirectories, AreFollowedPastTheirEndAndThroughLinks)
{
	const path deep = m_Folder / "a/skins";
	const path link = m_Folder / "link";
	create_directories(deep);
	create_directories(m_Folder / "old/skins");
	m_Watcher.SetDirectories({deep, link});
	remove_all(deep);
	Follows("gone", deep, false);
	create_directory(deep);
	Follows("another one in its place", deep);
	create_directory_symlink(m_Folder / "old", link);
	Follows("a link", link);
	remove(link);
	Follows("no link", link, false);
	create_directory_symlink(m_Folder / "a", link);
	Follows("a link to another directory", link);
}

TEST(FileSystemWatcher, TellsWhenADirectoryGoes)
{
	VTestFolder folder;
	create_directory(folder / "sub");
	VTestLog log("FilesystemWatcher");
	VInbox inbox;
	{
		VFileSystemWatcher watcher;
		watcher.Watch(folder / "sub", inbox.Callback(), inbox.Callback("directory "));
		remove(folder / "sub");
		EXPECT_EQ(inbox.TakeTo("directory removed sub"), VTexts{"directory removed sub"});
		// The same path is a directory of its own when it comes back.
		create_directory(folder / "sub");
		watcher.Watch(folder / "sub", inbox.Callback(), inbox.Callback("directory "));
		rename(folder / "sub", folder / "elsewhere");
		EXPECT_EQ(inbox.TakeTo("directory removed sub"), VTexts{"directory removed sub"});
	}
	const std::string start = "2 Error monitoring directory for changes:" + (folder / "sub").string() + ": ";
	EXPECT_EQ(log.Take(), (VTexts{start + "the directory is gone", start + "the directory was moved"}));
}

/// Hands out events that the test makes up.
class VTestMonitor final : public IDirectoryMonitor
{
public:
	int Add(const path&) override { return ++m_Last; }
	void Remove(int) override {}
	bool Wait(std::vector<VSystemEvent>& o_rEvents) override
	{
		std::unique_lock lock(m_Mutex);
		m_Changed.wait(lock, [this] { return m_bStopped || !m_Events.empty(); });
		o_rEvents = std::exchange(m_Events, {});
		return !m_bStopped;
	}
	void Stop() override
	{
		const std::lock_guard lock(m_Mutex);
		m_bStopped = true;
		m_Changed.notify_all();
	}
	void Send(std::vector<VSystemEvent> i_Events)
	{
		const std::lock_guard lock(m_Mutex);
		m_Events = std::move(i_Events);
		m_Changed.notify_all();
	}

private:
	std::mutex m_Mutex;
	std::condition_variable m_Changed;
	std::vector<VSystemEvent> m_Events;
	int m_Last = 0;
	bool m_bStopped = false;
};

TEST(FileSystemWatcher, GoesOnAfterWhatWentWrong)
{
	VTestLog log("FilesystemWatcher");
	VInbox inbox;
	{
		const auto pMonitor = std::make_shared<VTestMonitor>();
		VFileSystemWatcher watcher({}, pMonitor);
		watcher.Watch("one", inbox.Callback(), inbox.Callback("directory "));
		watcher.Watch("two", inbox.Callback("two "), inbox.Callback("two directory "));
		watcher.Watch("one",
		    [](EFileChange, const path& i_rPath)
		    {
			    if (i_rPath.filename() == "throw")
				    throw std::runtime_error("from a callback");
		    });
		pMonitor->Send({{1, EFileChange(6), "x", false}, {1, EFileChange(0), "x", true}, {7, EAdded, "unknown watch"},
		    {1, EAdded, "throw"}, {-1, EAdded, {}, false, 0, "lost", false}, {1, EAdded, {}, false, 0, "broken", true},
		    {1, EAdded, "after its end"}, {-1, EAdded, {}}, {2, EAdded, "a"}});
		EXPECT_EQ(inbox.TakeTo("two added a"),
		    (VTexts{"added throw", "directory modified one", "two directory modified two", "directory removed one",
		        "two added a"}));
	}
	EXPECT_EQ(log.Take(),
	    (VTexts{"2 Unexpected type of change to regular file reported.",
	        "2 Unexpected type of change to directory reported.",
	        "2 Error monitoring directory for changes:from a callback",
	        "2 Error monitoring directory for changes:one: lost", "2 Error monitoring directory for changes:two: lost",
	        "2 Error monitoring directory for changes:one: broken"}));
}

TEST(FileSystemWatcher, EndsFromWithinACallback)
{
	const auto pMonitor = std::make_shared<VTestMonitor>();
	VInbox inbox;
	auto pWatcher = std::make_unique<VFileSystemWatcher>("", pMonitor);
	pWatcher->Watch("one",
	    [&](EFileChange, const path& i_rPath)
	    {
		    pWatcher.reset();
		    inbox.Put(i_rPath.filename().string());
	    });
	pMonitor->Send({{1, EAdded, "a"}, {1, EAdded, "never told"}});
	EXPECT_EQ(inbox.TakeTo("a"), VTexts{"a"});
	EXPECT_EQ(pWatcher, nullptr);
}

/// Files come and go while watchers are made and let go of: for ThreadSanitizer, and nothing is told afterwards.
TEST(FileSystemWatcher, EndsWhileChangesCome)
{
	const VTestFolder folder;
	std::atomic<bool> bDone{false};
	std::thread writer(
	    [&]
	    {
		    for (int round = 0; !bDone; ++round)
			    Put(folder / std::to_string(round % 10), "x");
	    });
	for (int round = 0; round < 20; ++round)
	{
		VInbox inbox;
		std::atomic<bool> bAlive{true};
		{
			VFileSystemWatcher watcher;
			watcher.Watch(folder.Path(),
			    [&](EFileChange, const path&)
			    {
				    EXPECT_TRUE(bAlive);
				    inbox.Put("change");
			    });
			inbox.TakeTo("change");
		}
		bAlive = false;
	}
	bDone = true;
	writer.join();
}

TEST(PairRenames, BringsTheHalvesTogether)
{
	const auto print = [](const std::vector<VSystemEvent>& i_rEvents)
	{
		std::string text;
		for (const VSystemEvent& rEvent : i_rEvents)
			text += std::to_string(rEvent.m_Watch) + c_pKinds[rEvent.m_Change] + rEvent.m_Name + ' ';
		return text;
	};
	using VEvents = std::vector<VSystemEvent>;
	const auto half = [](int i_Watch, EFileChange i_Change, const char* i_pName, std::uint32_t i_Rename) {
		return VSystemEvent{i_Watch, i_Change, i_pName, false, i_Rename};
	};
	const struct
	{
		VEvents m_Events;
		bool m_bMoreToCome;
		std::string m_Expected;
		bool m_bLeft;
	} c_Rows[] = {
	    {{half(1, ERenamedOld, "a", 5), half(1, ERenamedNew, "b", 5)}, true, "1olda 1newb ", false},
	    {{half(1, ERenamedOld, "a", 5), half(2, EModified, "m", 0), half(1, ERenamedNew, "b", 5)}, true,
	        "2modifiedm 1olda 1newb ", false},
	    {{half(1, ERenamedOld, "a", 5), half(2, ERenamedNew, "b", 5)}, true, "1removeda 2addedb ", false},
	    {{half(1, ERenamedOld, "a", 5), half(1, ERenamedNew, "b", 6)}, true, "1removeda 1addedb ", false},
	    {{half(1, ERenamedOld, "a", 5)}, false, "1removeda ", false},
	    {{half(1, EAdded, "x", 0), half(1, ERenamedOld, "a", 5)}, true, "1addedx 1olda ", true},
	    {{half(1, ERenamedOld, "a", 0), half(1, ERenamedNew, "b", 0)}, true, "1olda 1newb ", false},
	};
	for (const auto& rRow : c_Rows)
	{
		VEvents events = rRow.m_Events;
		EXPECT_EQ(PairRenames(events, rRow.m_bMoreToCome), rRow.m_bLeft) << rRow.m_Expected;
		EXPECT_EQ(print(events), rRow.m_Expected);
	}
	// The partner of a name that was left comes with the next events.
	VEvents events = {half(1, ERenamedOld, "a", 5)};
	EXPECT_TRUE(PairRenames(events, true));
	events.push_back(half(1, ERenamedNew, "b", 5));
	EXPECT_FALSE(PairRenames(events, true));
	EXPECT_EQ(print(events), "1olda 1newb ");
}

} // namespace
