#include "OrlexGraphics/skins/SkinCache.h"

#include "../FBXIO/MeshFile.h"
#include "CoreGraphics/Skin.h"
#include "DebugServices/GlobalLog.h"
#include "HeldJobs.h"
#include "InMemoryHost/Dispatcher.h"

#include <QTest>
#include <boost/filesystem/operations.hpp>
#include <gtest/gtest.h>

#include <fstream>
#include <mutex>

namespace
{

using boost::filesystem::path;
using CoreGraphics::VSkin;
using OrlexGraphics::VSkinCache;
namespace SkinStatus = OrlexGraphics::SkinStatus;

struct VHeldDelay : OrlexGraphics::IDelay
{
	void Start(std::chrono::milliseconds i_Time, std::function<void()> i_Callback) override
	{
		EXPECT_EQ(i_Time.count(), 1000);
		m_Callback = std::move(i_Callback);
		++m_Starts;
	}
	void Stop() override { m_Callback = nullptr; }

	std::function<void()> m_Callback;
	int m_Starts = 0;
};

class SkinCache : public testing::Test
{
protected:
	SkinCache()
	{
		for (const char* const pFolder : {"a", "b"})
			boost::filesystem::create_directories(m_Root / pFolder);
		auto pDelay = std::make_unique<VHeldDelay>();
		m_pDelay = pDelay.get();
		m_pCache = NVX::MakeShared<VSkinCache>(m_pDispatcher, m_pJobs, std::move(pDelay));
		m_pCache->ChangedSignal().Connect([this] { ++m_Changes; });
		m_pCache->LoadingSignal().Connect([this] { ++m_LoadingChanges; });
	}
	~SkinCache() override { boost::filesystem::remove_all(m_Root); }

	path Write(const char* i_pFile, const char* i_pText = "no skin")
	{
		std::ofstream((m_Root / i_pFile).string()) << i_pText;
		return m_Root / i_pFile;
	}
	void WriteHero(const char* i_pFile)
	{
		boost::filesystem::copy_file(RETARGET_SOURCE "/demo/character.fbx", m_Root / i_pFile);
	}

	std::uint32_t Status(const char* i_pName, const char* i_pGroup = OrlexGraphics::c_pSubjectSkins)
	{
		return m_pCache->GetSkin(m_pSkin, i_pName, i_pGroup);
	}
	void SetFolders(const std::vector<path>& i_rFolders)
	{
		m_pCache->SetFolders(OrlexGraphics::c_pSubjectSkins, i_rFolders);
	}
	std::uint32_t Load(const char* i_pName)
	{
		EXPECT_EQ(Status(i_pName), SkinStatus::c_Loading);
		m_pJobs->RunAll();
		return Status(i_pName);
	}
	/// The burst of changes that the folders tell of, until it has ended.
	testing::AssertionResult WaitForChange()
	{
		const int starts = m_pDelay->m_Starts;
		const auto changed = [&]
		{
			m_pDispatcher->RunPending();
			return m_pDelay->m_Starts > starts;
		};
		if (!QTest::qWaitFor(changed, 20000))
			return testing::AssertionFailure() << "no change was told";
		return testing::AssertionSuccess();
	}
	std::string TakeLog()
	{
		const std::lock_guard lock(m_LogMutex);
		return std::exchange(m_Log, {});
	}

	const path m_Root = boost::filesystem::temp_directory_path() / boost::filesystem::unique_path("skins-%%%%%%%%");
	const std::shared_ptr<InMemoryHost::VDispatcher> m_pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
	const std::shared_ptr<VHeldJobs> m_pJobs = std::make_shared<VHeldJobs>();
	/// The watcher's thread tells, too, until the cache has ended.
	std::mutex m_LogMutex;
	std::string m_Log;
	const std::shared_ptr<void> m_pSink = NVX::GlobalLog::AddSink(
	    [this](const NVX::VLogCategory&, int, const std::string& i_rMessage)
	    {
		    const std::lock_guard lock(m_LogMutex);
		    m_Log += i_rMessage + "\n";
	    });
	VHeldDelay* m_pDelay = nullptr;
	std::shared_ptr<VSkinCache> m_pCache;
	std::shared_ptr<VSkin> m_pSkin;
	int m_Changes = 0;
	int m_LoadingChanges = 0;
};

TEST_F(SkinCache, LoadsSkinsOfAGroupInTheBackground)
{
	WriteHero("a/Hero.fbx");
	WriteHero("a/K\xc3\xb6nig.fbx");
	EXPECT_EQ(Status("Hero"), SkinStatus::c_NotFound) << "no such group";

	SetFolders({m_Root / "a", m_Root / "b", m_Root / "missing"});
	EXPECT_EQ(m_Changes, 1);
	EXPECT_EQ(Status("Hero"), SkinStatus::c_Loading);
	EXPECT_EQ(Status("Hero"), SkinStatus::c_Loading);
	ASSERT_EQ(m_pJobs->m_Jobs.size(), 1u) << "one job, however often one asks";
	EXPECT_EQ(m_pCache->Loading(), std::vector<std::string>{"Hero"});
	EXPECT_EQ(m_LoadingChanges, 1);
	EXPECT_EQ(m_pSkin, nullptr);

	m_pJobs->RunAll();
	EXPECT_EQ(Status("Hero"), SkinStatus::c_Ready) << "as soon as it is read";
	ASSERT_NE(m_pSkin, nullptr);
	EXPECT_EQ(m_pSkin->Name(), "Hero");
	EXPECT_FALSE(m_pSkin->Meshes().empty());
	EXPECT_EQ(m_Changes, 1);
	m_pDispatcher->RunPending();
	EXPECT_EQ(m_Changes, 2);
	EXPECT_TRUE(m_pCache->Loading().empty());
	EXPECT_EQ(m_LoadingChanges, 2);

	const std::shared_ptr<VSkin> pFirst = m_pSkin;
	EXPECT_EQ(Status("Hero"), SkinStatus::c_Ready);
	EXPECT_EQ(m_pSkin, pFirst) << "read once, worn by all";
	EXPECT_EQ(Load("K\xc3\xb6nig"), SkinStatus::c_Ready);
	EXPECT_EQ(Status("Villain"), SkinStatus::c_NotFound);
	EXPECT_EQ(Status("Hero", "Other"), SkinStatus::c_NotFound);

	m_pDispatcher->RunPending();
	m_Changes = 0;
	SetFolders({m_Root / "a", m_Root / "b", m_Root / "missing"});
	EXPECT_EQ(m_Changes, 0) << "the same folders again";
	EXPECT_EQ(Status("Hero"), SkinStatus::c_Ready);
	// The later folder counts, whatever is in it.
	Write("b/Hero.fbx");
	SetFolders({m_Root / "a", m_Root / "b"});
	EXPECT_EQ(m_Changes, 1);
	EXPECT_EQ(Load("Hero"), SkinStatus::c_LoadFailed);
	SetFolders({m_Root / "b", m_Root / "a"});
	EXPECT_EQ(Load("Hero"), SkinStatus::c_Ready);

	EXPECT_EQ(Status("K\xc3\xb6nig"), SkinStatus::c_Loading);
	m_pCache->Dispose();
	m_Changes = 0;
	EXPECT_EQ(Status("Hero"), SkinStatus::c_Disposed);
	SetFolders({m_Root / "b"});
	m_pJobs->RunAll();
	m_pDispatcher->RunPending();
	EXPECT_EQ(m_Changes, 0);
	EXPECT_EQ(Status("Hero"), SkinStatus::c_Disposed);
}

TEST_F(SkinCache, ReadsMeshesByItsRules)
{
	boost::filesystem::copy_file(RETARGET_TEST_DATA "/fbx/heaps_biped_zup_a7100.fbx", m_Root / "a/Hero.fbx");
	SetFolders({m_Root / "a"});
	Load("Hero");
	EXPECT_NE(TakeLog().find("4 polygon vertices of mesh Skeleton01 are moved"), std::string::npos);
	m_pCache->SetMeshRules(FBXIO::c_FaithfulMeshes);
	SetFolders({m_Root / "b", m_Root / "a"});
	EXPECT_EQ(Load("Hero"), SkinStatus::c_Ready);
	EXPECT_EQ(TakeLog().find("moved"), std::string::npos);
}

TEST_F(SkinCache, LoadsAtOnceWithoutABackground)
{
	WriteHero("a/Hero.fbx");
	m_pCache = NVX::MakeShared<VSkinCache>(m_pDispatcher);
	SetFolders({m_Root / "a"});
	EXPECT_EQ(Status("Hero"), SkinStatus::c_Ready);
	EXPECT_NE(m_pSkin, nullptr);
	EXPECT_EQ(m_pCache->Loading().size(), 1u) << "until its end is told";
	m_pCache.reset();
	m_pDispatcher->RunPending();
}

TEST_F(SkinCache, TellsWhyThereIsNoSkin)
{
	const path broken = Write("a/Broken.fbx");
	SetFolders({m_Root / "a", m_Root / "b"});
	EXPECT_EQ(Load("Broken"), SkinStatus::c_LoadFailed);
	EXPECT_NE(
	    TakeLog().find("The skin Broken is not shown: " + broken.string() + " could not be read"), std::string::npos);
	EXPECT_EQ(Status("Broken"), SkinStatus::c_LoadFailed) << "until the file changes";
	EXPECT_TRUE(m_pJobs->m_Jobs.empty());

	EXPECT_EQ(Status("Villain"), SkinStatus::c_NotFound);
	EXPECT_EQ(TakeLog(), "") << "a skin that may be missing";
	for (int i = 0; i < 2; ++i)
		m_pCache->WarnOfMissing("Villain", OrlexGraphics::c_pSubjectSkins);
	EXPECT_EQ(TakeLog(),
	    "The skin Villain is not shown: no file Villain.fbx in " + (m_Root / "a").string() + ", "
	        + (m_Root / "b").string() + "\n");
	SetFolders({});
	EXPECT_EQ(Status("Villain"), SkinStatus::c_NotFound);
	m_pCache->WarnOfMissing("Villain", OrlexGraphics::c_pSubjectSkins);
	EXPECT_EQ(TakeLog(), "The skin Villain is not shown: there are no folders of skins\n");
}

/// A chain of bones, the last of which moves a triangle.
std::string Chain(int i_Bones, bool i_bSkin)
{
	FbxTest::VTestScene scene;
	for (int i = 0; i < i_Bones; ++i)
		scene.m_Nodes.push_back({"bone" + std::to_string(i), "LimbNode", i - 1, {}});
	scene.m_Nodes.push_back({"body", "Mesh", -1, {}});
	FbxTest::VTestMesh mesh;
	mesh.m_Node = i_Bones;
	mesh.m_Points = {0, 0, 0, 1, 0, 0, 0, 1, 0};
	mesh.m_Polygons = {0, 1, -3};
	if (i_bSkin)
		mesh.m_Clusters = {{i_Bones - 1, {0, 1, 2}, {1, 1, 1}, {}, {}}};
	return FbxTest::Write(FbxTest::c_Forms[4], scene, {mesh});
}

TEST_F(SkinCache, TellsWhatOfASkinIsNotToBeSeen)
{
	SetFolders({m_Root / "a"});
	const std::string whole = Chain(250, true);
	const struct
	{
		const char* m_pName;
		std::string m_Content;
		std::string m_Message;
	} c_Rows[] = {{"most", whole, ""},
	    {"more", Chain(251, true),
	        "The skin more has 251 bones: 250 are shown, what the others move goes with a bone that is not its own\n"},
	    {"bare", Chain(3, false),
	        "The skin bare is not shown: no mesh in " + (m_Root / "a/bare.fbx").string() + " is bound to bones\n"},
	    {"cut", whole.substr(0, whole.rfind('}')),
	        "The skin cut is shown in part: " + (m_Root / "a/cut.fbx").string() + " could not be read to its end\n"}};
	for (const auto& rRow : c_Rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		std::ofstream((m_Root / "a" / rRow.m_pName).string() + ".fbx", std::ios::binary) << rRow.m_Content;
		EXPECT_EQ(Load(rRow.m_pName), SkinStatus::c_Ready);
		const std::string log = TakeLog();
		const std::size_t own = log.find("The skin");
		EXPECT_EQ(own == std::string::npos ? "" : log.substr(own), rRow.m_Message);
	}
}

TEST_F(SkinCache, FollowsTheFolders)
{
	SetFolders({m_Root / "a"});
	m_Changes = 0;
	NVX::VLogCategory& rCategory = NVX::GlobalLog::Category("VSkinCache");
	const int level = rCategory.Level();
	rCategory.SetLevel(NVX::ELogDetail);
	Write("a/NobodyWearsIt.fbx");
	ASSERT_TRUE(WaitForChange());
	rCategory.SetLevel(level);
	EXPECT_NE(TakeLog().find("Detected a change to " + (m_Root / "a/NobodyWearsIt.fbx").string()), std::string::npos);
	m_pDelay->m_Callback();
	EXPECT_EQ(m_Changes, 1);
	EXPECT_EQ(Status("Hero"), SkinStatus::c_NotFound);
	m_Changes = 0;
	WriteHero("a/Hero.fbx");
	Write("a/notes.txt");
	ASSERT_TRUE(WaitForChange());
	EXPECT_EQ(m_Changes, 0) << "the burst may go on";
	m_pDelay->m_Callback();
	EXPECT_EQ(m_Changes, 1);
	EXPECT_EQ(Load("Hero"), SkinStatus::c_Ready);
	const std::shared_ptr<VSkin> pWorn = m_pSkin;

	// What changes while it is being read is read again.
	Write("a/Hero.fbx");
	ASSERT_TRUE(WaitForChange());
	EXPECT_EQ(Status("Hero"), SkinStatus::c_Loading);
	boost::filesystem::remove(m_Root / "a/Hero.fbx");
	ASSERT_TRUE(WaitForChange());
	m_pJobs->RunAll();
	EXPECT_EQ(Status("Hero"), SkinStatus::c_NotFound);
	EXPECT_EQ(m_pSkin, pWorn) << "whoever wears it keeps it";
}

TEST_F(SkinCache, FollowsFoldersThatComeAndGo)
{
	WriteHero("a/Hero.fbx");
	SetFolders({m_Root / "a", m_Root / "not/yet"});
	EXPECT_EQ(Load("Hero"), SkinStatus::c_Ready);
	EXPECT_EQ(Status("Villain"), SkinStatus::c_NotFound);

	boost::filesystem::create_directories(m_Root / "new/yet");
	WriteHero("new/yet/Hero.fbx");
	WriteHero("new/yet/Villain.fbx");
	boost::filesystem::rename(m_Root / "new", m_Root / "not");
	ASSERT_TRUE(WaitForChange());
	EXPECT_EQ(Load("Villain"), SkinStatus::c_Ready);
	EXPECT_EQ(Load("Hero"), SkinStatus::c_Ready) << "the later folder's now";
	boost::filesystem::rename(m_Root / "not", m_Root / "new");
	ASSERT_TRUE(WaitForChange());
	EXPECT_EQ(Status("Villain"), SkinStatus::c_NotFound);
	EXPECT_EQ(Load("Hero"), SkinStatus::c_Ready);
	boost::filesystem::rename(m_Root / "new", m_Root / "not");
	ASSERT_TRUE(WaitForChange());
	EXPECT_EQ(Load("Villain"), SkinStatus::c_Ready) << "back again";
}

} // namespace
