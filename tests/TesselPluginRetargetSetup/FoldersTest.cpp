#include "TesselPluginRetargetSetup/BoneList.h"

#include "../UtilsFileSystem/Folder.h"
#include "TesselPluginRetargetSetup/ProductFolders.h"

#include <gtest/gtest.h>

namespace
{

namespace fs = boost::filesystem;

TEST(ProductFolders, TakesWhatIsThereInTheOrderOfTheProducts)
{
	const VTestFolder root;
	const fs::path rally = root / "rally";
	const fs::path stage = root / "stage";
	fs::create_directories(rally / "Configuration" / "ModelTemplates");
	fs::create_directories(stage / "Configuration" / "ModelTemplates");
	fs::create_directories(stage / "Configuration" / "Skins");
	const auto both = RetargetSetup::InstalledFolders(
	    [&](const std::string& i_rName) { return i_rName == "Orlex Rally" ? rally : stage; });
	EXPECT_EQ(both.m_Models,
	    (std::vector<fs::path>{rally / "Configuration/ModelTemplates", stage / "Configuration/ModelTemplates"}));
	EXPECT_EQ(both.m_Skins, std::vector<fs::path>{stage / "Configuration/Skins"}) << "one product has no skins";

	std::vector<std::string> asked;
	const auto none = RetargetSetup::InstalledFolders(
	    [&asked](const std::string& i_rName)
	    {
		    asked.push_back(i_rName);
		    return fs::path();
	    });
	EXPECT_TRUE(none.m_Models.empty() && none.m_Skins.empty());
	EXPECT_EQ(asked, (std::vector<std::string>{"Orlex Rally", "Orlex Stage"}));
}

TEST(BoneList, IndentsByTheDepthInTheTree)
{
	FBXIO::VSkinSkeleton skeleton(5);
	const char* const names[] = {"hips", "ns:spine", "head", "leg", "prop"};
	const std::int64_t parents[] = {-1, 0, 1, 0, -1};
	for (std::size_t i = 0; i < skeleton.size(); ++i)
	{
		skeleton[i].m_Name = names[i];
		skeleton[i].m_ParentIndex = parents[i];
	}
	EXPECT_EQ(RetargetSetup::BoneListForEnum(skeleton),
	    (std::vector<std::pair<std::string, std::uint32_t>>{
	        {"hips", 0}, {" ns:spine", 1}, {"  head", 2}, {" leg", 3}, {"prop", 4}}));
	EXPECT_TRUE(RetargetSetup::BoneListForEnum({}).empty());
}

} // namespace
