#include "UtilsFileSystem/Folder.h"
#include "UtilsFileSystem/Log.h"

#include "TesselParametersGUI/ParameterFBX.h"

#include "InMemoryHost/Dispatcher.h"
#include "TesselDataStore/DataStore.h"

#include <QCoreApplication>
#include <QTest>

#include <gtest/gtest.h>

namespace
{

using namespace TesselParametersGUI;
using TesselParameters::CheckerOf;
using VTexts = std::vector<std::string>;

/// Callbacks that run when the test says so.
class VHeldDelay
{
public:
	VParameterEnumFolderWatcher::VDelay Delay()
	{
		return [pHeld = m_pHeld](std::chrono::milliseconds, std::function<void()> i_Callback)
		{ pHeld->push_back(std::move(i_Callback)); };
	}

	/// Lets the time pass once: what is asked for meanwhile waits for the next one.
	std::size_t Pass()
	{
		const auto due = std::exchange(*m_pHeld, {});
		for (const auto& rCallback : due)
			rCallback();
		return due.size();
	}

private:
	std::shared_ptr<std::vector<std::function<void()>>> m_pHeld =
	    std::make_shared<std::vector<std::function<void()>>>();
};

class FolderWatcher : public testing::Test
{
protected:
	FolderWatcher() { create_directory(m_Folder / "User"); }

	template <typename TParameter, typename... VArguments>
	std::shared_ptr<TParameter> Make(VArguments... i_Arguments)
	{
		auto pParameter = NVX::MakeShared<TParameter>(
		    m_pStore, "RetargetSetup", "SourceSkeleton", CheckerOf<std::string>(), i_Arguments..., m_Delay.Delay());
		pParameter->AddFolder("User", m_Folder / "User", 10);
		pParameter->Refresh();
		return pParameter;
	}
	std::shared_ptr<VParameterEnumFolderWatcher> MakeWatcher()
	{
		return Make<VParameterEnumFolderWatcher>(".qrs", std::string());
	}

	/// The system's notice, without waiting for it.
	static void Notice(VParameterEnumFolderWatcher& io_rParameter, const boost::filesystem::path& i_rFolder)
	{
		io_rParameter.OnDirectoryChanged(QString::fromStdString(i_rFolder.string()));
	}

	static VTexts Names(const TesselPluginInterface::IParameter& i_rParameter)
	{
		VTexts names;
		for (const auto& rEntry : i_rParameter.GetEnumeration())
			names.push_back(rEntry.m_Name);
		return names;
	}

	int m_Argument = 1;
	char m_Program[5] = "test";
	char* m_pProgram = m_Program;
	QCoreApplication m_Application{m_Argument, &m_pProgram};
	VTestFolder m_Folder;
	VTestLog m_Log{"Tessel"};
	VHeldDelay m_Delay;
	const std::shared_ptr<TesselDataStore::VDataStore> m_pStore = std::make_shared<TesselDataStore::VDataStore>();
};

TEST_F(FolderWatcher, OffersTheFilesOfTheExtension)
{
	for (const char* const pName : {"User/b.qrs", "User/Alpha.qrs", "User/a.fbx", "User/c.QRS", "User/noextension"})
		Put(m_Folder / pName, "");
	create_directory(m_Folder / "User/folder.qrs");
	const auto pParameter = MakeWatcher();
	EXPECT_EQ(Names(*pParameter), (VTexts{"Alpha", "b"}));
	EXPECT_EQ(pParameter->ToText(pParameter->GetEnumeration()[1].m_Value), (m_Folder / "User/b.qrs").string());
}

TEST_F(FolderWatcher, TheHigherPriorityStandsForAName)
{
	for (const char* const pName : {"Low", "High", "Same"})
		create_directory(m_Folder / pName);
	for (const char* const pName : {"Low/x.qrs", "High/x.qrs", "Same/x.qrs", "User/x.qrs", "Low/only.qrs"})
		Put(m_Folder / pName, "");
	const auto pParameter = MakeWatcher();
	pParameter->AddFolder("Installed0", m_Folder / "Low", 1);
	pParameter->AddFolder("Subjects", m_Folder / "High", 11);
	pParameter->AddFolder("Installed1", m_Folder / "Same", 1);
	EXPECT_EQ(Names(*pParameter), (VTexts{"only", "x"}));
	EXPECT_EQ(pParameter->SetValueText("x"), "");
	EXPECT_EQ(pParameter->GetValueText(), (m_Folder / "High/x.qrs").string());
	pParameter->SetFolder("Subjects", {});
	EXPECT_EQ(pParameter->ToText(pParameter->GetEnumeration()[1].m_Value), (m_Folder / "User/x.qrs").string());
	// It was of that folder.
	EXPECT_FALSE(pParameter->HasValue());
}

TEST_F(FolderWatcher, DeletingTheChosenFileClearsTheSelection)
{
	Put(m_Folder / "User/chosen.qrs", "");
	Put(m_Folder / "User/other.qrs", "");
	const auto pParameter = MakeWatcher();
	const std::string value = (m_Folder / "User/chosen.qrs").string();
	pParameter->Set(value);

	// Another one comes, another one goes: nothing of the chosen one.
	Put(m_Folder / "User/new.qrs", "");
	remove(m_Folder / "User/other.qrs");
	Notice(*pParameter, m_Folder / "User");
	Notice(*pParameter, m_Folder / "User");
	EXPECT_EQ(m_Delay.Pass(), 1u);
	EXPECT_EQ(Names(*pParameter), (VTexts{"chosen", "new", "other"}));
	EXPECT_EQ(m_Delay.Pass(), 1u);
	EXPECT_EQ(Names(*pParameter), (VTexts{"chosen", "new"}));
	EXPECT_EQ(pParameter->GetValueText(), value);
	EXPECT_EQ(m_Log.Take(), VTexts());

	rename(m_Folder / "User/chosen.qrs", m_Folder / "User/renamed.qrs");
	Notice(*pParameter, m_Folder / "User");
	m_Delay.Pass();
	EXPECT_EQ(pParameter->GetValueText(), value);
	m_Delay.Pass();
	EXPECT_EQ(Names(*pParameter), (VTexts{"new", "renamed"}));
	EXPECT_EQ(pParameter->GetValueText(), "");
	EXPECT_EQ(m_Log.Take(), VTexts{"2 SourceSkeleton: value [" + value + "] is not valid, clearing selection"});
	EXPECT_EQ(m_Delay.Pass(), 0u);
}

TEST_F(FolderWatcher, AFileThatIsSavedByRenamingStays)
{
	const boost::filesystem::path file = m_Folder / "User/chosen.qrs";
	Put(file, "");
	const auto pParameter = MakeWatcher();
	pParameter->Set(file.string());
	const auto pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
	int changes = 0;
	pParameter->ConnectValue([&] { ++changes; }, pDispatcher);
	pParameter->ConnectAttributes([&] { ++changes; }, pDispatcher);

	remove(file);
	Notice(*pParameter, m_Folder / "User");
	m_Delay.Pass();
	Put(file, "again");
	EXPECT_EQ(m_Delay.Pass(), 1u);
	EXPECT_EQ(m_Delay.Pass(), 0u);
	EXPECT_EQ(Names(*pParameter), VTexts{"chosen"});
	pDispatcher->RunPending();
	EXPECT_EQ(changes, 0);
}

TEST_F(FolderWatcher, AMissingFolderIsToldAndWatchedWhenItAppears)
{
	const auto pParameter = Make<VParameterFBX>(std::string("^Orlex.*"));
	pParameter->AddFolder("Installed0", m_Folder / "Not/Yet", 1);
	EXPECT_EQ(Names(*pParameter), VTexts{"(None)"});
	EXPECT_EQ(m_Log.Take(), VTexts{"2 Folder [" + (m_Folder / "Not/Yet").string() + "] does not exist"});
	EXPECT_EQ(pParameter->SetValueText("(None)"), "");
	EXPECT_FALSE(pParameter->HasValue());

	create_directories(m_Folder / "Not/Yet");
	Put(m_Folder / "Not/Yet/OrlexMale.fbx", "");
	Put(m_Folder / "Not/Yet/Other.fbx", "");
	Notice(*pParameter, m_Folder.Path());
	m_Delay.Pass();
	EXPECT_EQ(Names(*pParameter), (VTexts{"(None)", "OrlexMale"}));

	remove_all(m_Folder / "Not");
	Notice(*pParameter, m_Folder / "Not/Yet");
	m_Delay.Pass();
	m_Delay.Pass();
	EXPECT_EQ(Names(*pParameter), VTexts{"(None)"});
	EXPECT_EQ(m_Log.Take().size(), 1u);
}

TEST_F(FolderWatcher, FollowsTheSystemsNotices)
{
	// Real notices and a real timer; the time only ends a test that would hang.
	const auto pParameter = NVX::MakeShared<VParameterEnumFolderWatcher>(
	    m_pStore, "RetargetSetup", "SourceSkeleton", CheckerOf<std::string>(), ".qrs");
	pParameter->AddFolder("User", m_Folder / "User", 10);
	pParameter->Refresh();
	const auto becomes = [&](const VTexts& i_rNames)
	{ return QTest::qWaitFor([&] { return Names(*pParameter) == i_rNames; }, 30000); };

	Put(m_Folder / "User/a.qrs", "");
	EXPECT_TRUE(becomes({"a"}));
	rename(m_Folder / "User/a.qrs", m_Folder / "User/b.qrs");
	EXPECT_TRUE(becomes({"b"}));
	rename(m_Folder / "User", m_Folder / "Elsewhere");
	EXPECT_TRUE(becomes({}));
	Put(m_Folder / "Elsewhere/c.qrs", "");
	rename(m_Folder / "Elsewhere", m_Folder / "User");
	EXPECT_TRUE(becomes({"b", "c"}));
	remove(m_Folder / "User/b.qrs");
	EXPECT_TRUE(becomes({"c"}));
	// By the name of a folder above.
	const boost::filesystem::path other = m_Folder.Path().string() + "-renamed";
	rename(m_Folder.Path(), other);
	EXPECT_TRUE(becomes({}));
	rename(other, m_Folder.Path());
	EXPECT_TRUE(becomes({"c"}));
	remove_all(m_Folder / "User");
	EXPECT_TRUE(becomes({}));
	create_directory(m_Folder / "User");
	Put(m_Folder / "User/d.qrs", "");
	EXPECT_TRUE(becomes({"d"}));
}

/// However a folder is spelled, and however its way appears.
TEST_F(FolderWatcher, FollowsAWayThatAppearsStepByStep)
{
	const auto pParameter = MakeWatcher();
	pParameter->AddFolder("Deep", m_Folder / "a/b", 1);
	pParameter->AddFolder("Odd", m_Folder / "u/./../u", 1);
	// Notices are real, so each step is taken when the one before is watched; the time only ends a test that would
	// hang.
	const auto noticed = [&] { return QTest::qWaitFor([&] { return m_Delay.Pass() > 0; }, 30000); };
	for (const char* const pFolder : {"a", "a/b", "u"})
	{
		SCOPED_TRACE(pFolder);
		create_directory(m_Folder / pFolder);
		ASSERT_TRUE(noticed());
	}
	// At once, within one tick of the clock that dates folders.
	Put(m_Folder / "a/b/first.qrs", "");
	Put(m_Folder / "u/second.qrs", "");
	const auto becomes = [&]
	{
		m_Delay.Pass();
		return Names(*pParameter) == VTexts{"first", "second"};
	};
	EXPECT_TRUE(QTest::qWaitFor(becomes, 30000));

	// A notice that comes before that clock has gone on.
	constexpr std::time_t c_Time = 1000000000;
	last_write_time(m_Folder / "u", c_Time);
	pParameter->Refresh();
	Put(m_Folder / "u/third.qrs", "");
	last_write_time(m_Folder / "u", c_Time);
	Notice(*pParameter, m_Folder / "u");
	m_Delay.Pass();
	EXPECT_EQ(Names(*pParameter), (VTexts{"first", "second", "third"}));
}

TEST_F(FolderWatcher, AStoredValueIsHeldAgainstTheFilesOnce)
{
	Put(m_Folder / "User/kept.qrs", "");
	const struct
	{
		const char* m_pName;
		std::string m_Stored;
		bool m_bStays;
	} rows[] = {{"a file", (m_Folder / "User/kept.qrs").string(), true},
	    {"a file that is gone", (m_Folder / "User/gone.qrs").string(), false}, {"a bare name", "kept", false},
	    {"nothing", "", false}};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		m_pStore->LockWrite();
		m_pStore->Set("RetargetSetup/SourceSkeleton", TesselDataStore::ToVariant(rRow.m_Stored));
		m_pStore->UnlockWrite();
		const auto pParameter = MakeWatcher();
		EXPECT_EQ(pParameter->HasValue(), rRow.m_bStays);
		EXPECT_EQ(m_Log.Take().size(), !rRow.m_bStays && !rRow.m_Stored.empty() ? 1u : 0u);
		// From then on a name that was never among the files is somebody's own.
		pParameter->Set<std::string>("Template");
		Put(m_Folder / "User/unrelated.qrs", "");
		pParameter->Refresh();
		EXPECT_EQ(pParameter->GetValueText(), "Template");
		remove(m_Folder / "User/unrelated.qrs");
	}
}

TEST_F(FolderWatcher, ThousandsOfFilesAreOneChange)
{
	const auto pParameter = MakeWatcher();
	const auto pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
	int changes = 0;
	pParameter->ConnectAttributes([&] { ++changes; }, pDispatcher);
	Put(m_Folder / "file", "");
	for (int index = 0; index < 5000; ++index)
	{
		create_hard_link(m_Folder / "file", m_Folder / ("User/" + std::to_string(index) + ".qrs"));
		Notice(*pParameter, m_Folder / "User");
	}
	EXPECT_EQ(m_Delay.Pass(), 1u);
	EXPECT_EQ(Names(*pParameter).size(), 5000u);
	pDispatcher->RunPending();
	EXPECT_EQ(changes, 1);
}

} // namespace
