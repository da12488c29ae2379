#include "../UtilsFileSystem/Folder.h"
#include "TesselPluginRetargetSetup/ProductFolders.h"

#include <gtest/gtest.h>

namespace
{

namespace fs = boost::filesystem;

TEST(ProductFolders, AreThoseThatAreThereInTheOrderOfTheProducts)
{
	const VTestFolder root;
	const fs::path rally = root / "rally";
	const fs::path stage = root / "stage";
	fs::create_directories(rally / "Configuration" / "ModelTemplates");
	fs::create_directories(stage / "Configuration" / "ModelTemplates");
	fs::create_directories(stage / "Configuration" / "Skins");
	std::vector<std::string> asked;
	const auto both = RetargetSetup::InstalledFolders(
	    [&](const std::string& i_rName)
	    {
		    asked.push_back(i_rName);
		    return i_rName == "Orlex Rally" ? rally : stage;
	    });
	EXPECT_EQ(asked, (std::vector<std::string>{"Orlex Rally", "Orlex Stage"}));
	EXPECT_EQ(both.m_Models,
	    (std::vector<fs::path>{rally / "Configuration/ModelTemplates", stage / "Configuration/ModelTemplates"}));
	EXPECT_EQ(both.m_Skins, std::vector<fs::path>{stage / "Configuration/Skins"}) << "one product has no skins";
	const auto none = RetargetSetup::InstalledFolders([](const std::string&) { return fs::path(); });
	EXPECT_TRUE(none.m_Models.empty() && none.m_Skins.empty());
}

} // namespace
