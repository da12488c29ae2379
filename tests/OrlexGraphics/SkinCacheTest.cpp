#include "OrlexGraphics/SkinCache.h"
#include "InMemoryHost/Dispatcher.h"

#include <QTest>
#include <boost/filesystem/operations.hpp>
#include <gtest/gtest.h>

#include <fstream>

namespace
{

using boost::filesystem::path;
namespace SkinStatus = OrlexGraphics::SkinStatus;

class SkinCache : public testing::Test
{
protected:
	SkinCache()
	{
		for (const char* const pFolder : {"a", "b"})
			boost::filesystem::create_directories(m_Root / pFolder);
		m_pCache->ChangedSignal().Connect([this] { ++m_Changes; });
	}
	~SkinCache() override { boost::filesystem::remove_all(m_Root); }

	path Write(const char* i_pFile)
	{
		std::ofstream((m_Root / i_pFile).string()) << "skin";
		return m_Root / i_pFile;
	}

	std::uint32_t Status(const char* i_pName, const char* i_pGroup = OrlexGraphics::c_pSubjectSkins)
	{
		m_Path.clear();
		return m_pCache->GetPath(m_Path, i_pName, i_pGroup);
	}

	const path m_Root = boost::filesystem::temp_directory_path() / boost::filesystem::unique_path("skins-%%%%%%%%");
	const std::shared_ptr<InMemoryHost::VDispatcher> m_pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
	const std::shared_ptr<OrlexGraphics::VSkinCache> m_pCache =
	    NVX::MakeShared<OrlexGraphics::VSkinCache>(m_pDispatcher);
	path m_Path;
	int m_Changes = 0;
};

TEST_F(SkinCache, FindsSkinsOfAGroup)
{
	Write("a/Hero.fbx");
	const path later = Write("b/Hero.fbx");
	const path clown = Write("a/K\xc3\xb6nig.fbx");
	EXPECT_EQ(Status("Hero"), SkinStatus::c_NotFound) << "no such group";

	m_pCache->SetFolders(OrlexGraphics::c_pSubjectSkins, {m_Root / "a", m_Root / "b", m_Root / "missing"});
	EXPECT_EQ(m_Changes, 1);
	EXPECT_EQ(Status("Hero"), SkinStatus::c_Ready);
	EXPECT_EQ(m_Path, later) << "the later folder";
	EXPECT_EQ(Status("K\xc3\xb6nig"), SkinStatus::c_Ready);
	EXPECT_EQ(m_Path, clown);
	EXPECT_EQ(Status("Villain"), SkinStatus::c_NotFound);
	EXPECT_EQ(Status("Hero", "Other"), SkinStatus::c_NotFound);

	m_pCache->SetFolders(OrlexGraphics::c_pSubjectSkins, {m_Root / "a", m_Root / "b", m_Root / "missing"});
	EXPECT_EQ(m_Changes, 1) << "the same folders again";
	m_pCache->SetFolders(OrlexGraphics::c_pSubjectSkins, {m_Root / "a"});
	EXPECT_EQ(m_Changes, 2);
	EXPECT_EQ(Status("Hero"), SkinStatus::c_Ready);
	EXPECT_NE(m_Path, later);

	m_pCache->Dispose();
	EXPECT_EQ(Status("Hero"), SkinStatus::c_Disposed);
	m_pCache->SetFolders(OrlexGraphics::c_pSubjectSkins, {m_Root / "b"});
	EXPECT_EQ(m_Changes, 2);
	EXPECT_EQ(Status("Hero"), SkinStatus::c_Disposed);
}

TEST_F(SkinCache, FollowsTheFolders)
{
	m_pCache->SetFolders(OrlexGraphics::c_pSubjectSkins, {m_Root / "a"});
	EXPECT_EQ(Status("Hero"), SkinStatus::c_NotFound);
	m_Changes = 0;
	const path hero = Write("a/Hero.fbx");
	Write("a/notes.txt");
	const auto changed = [&]
	{
		m_pDispatcher->RunPending();
		return m_Changes > 0;
	};
	ASSERT_TRUE(QTest::qWaitFor(changed, 20000));
	EXPECT_EQ(m_Changes, 1) << "a burst of changes is one";
	EXPECT_EQ(Status("Hero"), SkinStatus::c_Ready);
	EXPECT_EQ(m_Path, hero);

	m_Changes = 0;
	boost::filesystem::remove(hero);
	ASSERT_TRUE(QTest::qWaitFor(changed, 20000));
	EXPECT_EQ(Status("Hero"), SkinStatus::c_NotFound);
}

} // namespace
