#include "UtilsFileSystem/InstalledProducts.h"

#include "TesselPluginInterface/IPreferenceFolders.h"

#include <gtest/gtest.h>

#include <cstring>
#include <map>
#include <vector>

namespace
{

using namespace std::string_literals;
using UtilsFileSystem::c_Read32BitView;
using UtilsFileSystem::c_Read64BitView;
using UtilsFileSystem::FindInstallLocation;
using UtilsFileSystem::IRegistryKey;

/// The values of one program by name, as they are stored.
using VProgram = std::map<std::string, std::string>;

struct VRegistry
{
	std::map<std::uint32_t, std::vector<std::pair<std::string, VProgram>>> m_Programs;
	/// Looks at the list from which on it holds anything.
	int m_FirstLook = 0;
	int m_Looks = 0;
	int m_Open = 0;
};

class VFakeKey : public IRegistryKey
{
public:
	explicit VFakeKey(VRegistry& i_rRegistry, std::uint32_t i_View = 0, const VProgram* i_pProgram = nullptr)
	    : m_rRegistry(i_rRegistry), m_View(i_View), m_pProgram(i_pProgram)
	{
		++m_rRegistry.m_Open;
	}
	~VFakeKey() override { --m_rRegistry.m_Open; }

	std::unique_ptr<IRegistryKey> Open(const char* i_pPath, std::uint32_t i_Access) const override
	{
		if (m_View == 0)
			return std::strcmp(i_pPath, "SOFTWARE\\Microsoft\\Windows\\CurrentVersion\\Uninstall") == 0
			        && ++m_rRegistry.m_Looks > m_rRegistry.m_FirstLook
			    ? std::make_unique<VFakeKey>(m_rRegistry, i_Access)
			    : nullptr;
		EXPECT_EQ(i_Access, m_View);
		for (const auto& [name, program] : m_rRegistry.m_Programs[m_View])
			if (name == i_pPath && name != "secret")
				return std::make_unique<VFakeKey>(m_rRegistry, i_Access, &program);
		return nullptr;
	}

	bool SubKeyName(std::uint32_t i_Index, std::span<char> o_Name, std::size_t& o_rSize) const override
	{
		const auto& rPrograms = m_rRegistry.m_Programs[m_View];
		return i_Index < rPrograms.size() && Copy(rPrograms[i_Index].first + '\0', o_Name, o_rSize);
	}

	bool Text(const char* i_pName, std::span<char> o_Text, std::size_t& o_rSize) const override
	{
		const auto found = m_pProgram->find(i_pName);
		return found != m_pProgram->end() && Copy(found->second, o_Text, o_rSize);
	}

private:
	static bool Copy(const std::string& i_rText, std::span<char> o_Text, std::size_t& o_rSize)
	{
		o_rSize = i_rText.size();
		if (i_rText.size() > o_Text.size())
			return false;
		std::memcpy(o_Text.data(), i_rText.data(), i_rText.size());
		return true;
	}

	VRegistry& m_rRegistry;
	const std::uint32_t m_View;
	const VProgram* const m_pProgram;
};

VProgram Program(const char* i_pName, const char* i_pVersion, const std::string& i_rFolder)
{
	return {{"DisplayName", i_pName + "\0"s}, {"DisplayVersion", i_pVersion + "\0"s},
	    {"InstallLocation", i_rFolder + "\0"s}};
}

TEST(FindInstallLocation, Rows)
{
	const std::string longest(1024, 'a');
	const struct
	{
		const char* m_pName;
		std::vector<VProgram> m_64Bit;
		std::vector<VProgram> m_32Bit;
		std::string m_Folder;
	} rows[] = {
	    {"nothing installed", {}, {}, ""},
	    {"one", {Program("Orlex Stage 1.2", "1.2.3", "C:\\Stage")}, {}, "C:\\Stage"},
	    {"1.9.0 and 1.10.0",
	        {Program("Orlex Stage", "1.9.0", "nine"), Program("Orlex Stage", "1.10.0", "ten"),
	            Program("Orlex Stage", "1.2.0", "two")},
	        {}, "ten"},
	    {"the third number", {Program("Orlex Stage", "1.0.9", "a"), Program("Orlex Stage", "1.0.11", "b")}, {}, "b"},
	    {"the first number first", {Program("Orlex Stage", "2.0.0", "a"), Program("Orlex Stage", "1.99.99", "b")}, {},
	        "a"},
	    {"a fourth number does not count",
	        {Program("Orlex Stage", "1.0.0.1", "a"), Program("Orlex Stage", "1.0.0.2", "b")}, {}, "a"},
	    {"equal versions", {Program("Orlex Stage", "1.0", "first"), Program("Orlex Stage", "1.0.0", "second")}, {},
	        "first"},
	    {"no version counts as 0",
	        {{{"DisplayName", "Orlex Stage"}, {"InstallLocation", "none"}}, Program("Orlex Stage", "0.0.1", "some")},
	        {}, "some"},
	    {"a version that is none counts as 0",
	        {Program("Orlex Stage", "new", "words"), Program("Orlex Stage", "0.1", "number")}, {}, "number"},
	    {"a version beyond all numbers",
	        {Program("Orlex Stage", "4294967295", "most"), Program("Orlex Stage", "99999999999999999999.1", "more")},
	        {}, "more"},
	    {"letters behind a number", {Program("Orlex Stage", "2b.1", "a"), Program("Orlex Stage", "2.0", "b")}, {}, "a"},
	    {"the name in the middle of the text", {Program("Tools for Orlex Stage", "9.0", "tools")}, {}, ""},
	    {"another case", {Program("ORLEX Stage", "9.0", "case")}, {}, ""},
	    {"another product", {Program("Orlex Rally", "9.0", "rally"), Program("Orlex Stage", "1.0", "stage")}, {},
	        "stage"},
	    {"a shorter name", {Program("Orlex Stag", "1.0", "stag")}, {}, ""},
	    {"no name", {{{"InstallLocation", "a"}, {"DisplayVersion", "1.0"}}}, {}, ""},
	    {"no folder", {{{"DisplayName", "Orlex Stage"}, {"DisplayVersion", "2"}}, Program("Orlex Stage", "1", "one")},
	        {}, "one"},
	    {"an empty folder", {Program("Orlex Stage", "2", ""), Program("Orlex Stage", "1", "one")}, {}, "one"},
	    {"only 32-bit", {Program("Orlex Rally", "1", "rally")}, {Program("Orlex Stage", "1.0", "32")}, "32"},
	    {"64-bit wins, whatever the version", {Program("Orlex Stage", "1.0", "64")},
	        {Program("Orlex Stage", "2.0", "32")}, "64"},
	    {"texts without a zero", {{{"DisplayName", "Orlex Stage"}, {"InstallLocation", "bare"}}}, {}, "bare"},
	    {"texts with several", {{{"DisplayName", "Orlex Stage"}, {"InstallLocation", "a\0b\0\0"s}}}, {}, "a"},
	    {"a folder that just fits", {{{"DisplayName", "Orlex Stage"}, {"InstallLocation", longest}}}, {}, longest},
	    {"a folder that does not fit", {{{"DisplayName", "Orlex Stage"}, {"InstallLocation", longest + "a"}}}, {}, ""},
	    {"a name that does not fit", {{{"DisplayName", "Orlex Stage" + longest}, {"InstallLocation", "a"}}}, {}, ""},
	    {"a version that does not fit counts as 0",
	        {{{"DisplayName", "Orlex Stage"}, {"InstallLocation", "a"}, {"DisplayVersion", "9" + longest}},
	            Program("Orlex Stage", "0.0.1", "b")},
	        {}, "b"},
	};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		VRegistry registry;
		for (const VProgram& rProgram : rRow.m_64Bit)
			registry.m_Programs[c_Read64BitView].emplace_back(
			    "{" + std::to_string(registry.m_Programs[c_Read64BitView].size()) + "}", rProgram);
		for (const VProgram& rProgram : rRow.m_32Bit)
			registry.m_Programs[c_Read32BitView].emplace_back(
			    "{" + std::to_string(registry.m_Programs[c_Read32BitView].size()) + "}", rProgram);
		EXPECT_EQ(FindInstallLocation(VFakeKey(registry), "Orlex Stage").string(), rRow.m_Folder);
		EXPECT_EQ(registry.m_Open, 0) << "every key is closed again";
	}
}

TEST(FindInstallLocation, KeysThatCannotBeOpenedAreNoProducts)
{
	VRegistry registry;
	registry.m_Programs[c_Read64BitView] = {
	    {"secret", Program("Orlex Stage", "2.0", "a")}, {"open", Program("Orlex Stage", "1.0", "b")}};
	EXPECT_EQ(FindInstallLocation(VFakeKey(registry), "Orlex Stage"), "b");
}

TEST(FindInstallLocation, ANameThatDoesNotFitEndsTheList)
{
	VRegistry registry;
	registry.m_Programs[c_Read64BitView] = {{std::string(1023, 'k'), Program("Orlex Stage", "1.0", "a")},
	    {std::string(1024, 'k'), Program("Orlex Stage", "2.0", "b")}, {"k", Program("Orlex Stage", "3.0", "c")}};
	EXPECT_EQ(FindInstallLocation(VFakeKey(registry), "Orlex Stage"), "a");
}

TEST(FindInstallLocation, LooksTwice)
{
	VRegistry registry;
	registry.m_Programs[c_Read64BitView] = {{"k", Program("Orlex Stage", "1.0", "a")}};
	registry.m_FirstLook = 2; // Both views of the first look are closed.
	EXPECT_EQ(FindInstallLocation(VFakeKey(registry), "Orlex Stage"), "a");
	registry.m_Looks = 0;
	registry.m_FirstLook = 4;
	EXPECT_EQ(FindInstallLocation(VFakeKey(registry), "Orlex Stage"), "");
}

TEST(FindInstallLocation, ThePreferencesNameProductFolders)
{
	class : public TesselPluginInterface::IPreferenceFolders
	{
	public:
		boost::filesystem::path Folder(const std::string& i_rKey) const override
		{
			return i_rKey == "ProductFolderOrlexStage" ? "/opt/stage" : "";
		}
		NVX::VSignal<std::string>& ChangedSignal() override { return m_ChangedSignal; }

	private:
		NVX::VSignal<std::string> m_ChangedSignal;
	} preferences;
	EXPECT_EQ(FindInstallLocation("Orlex Stage", preferences), "/opt/stage");
	EXPECT_EQ(FindInstallLocation("Orlex Rally", preferences), "");
	EXPECT_EQ(UtilsFileSystem::ProductFolderKey("Orlex Rally"), "ProductFolderOrlexRally");
}

} // namespace
