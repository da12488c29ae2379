#include "Host.h"

#include "InMemoryHost/Dispatcher.h"
#include "TesselDataStore/DataReader.h"
#include "TesselDataStore/DataStore.h"
#include "TesselDataStore/DataWriter.h"
#include "TesselDataStore/StoredValue.h"
#include "TesselPluginInterface/PathTypes.h"
#include "studio/host/Preferences.h"
#include "studio/host/StoreFile.h"

#include <QFile>
#include <QSettings>

#include <limits>

namespace
{

using NVX::IO::VVariant;
using StudioHost::ParseValue;
using StudioHost::PrintValue;
using TesselDataStore::ToVariant;
using TesselDataStore::VDataReader;
using TesselDataStore::VDataStore;
using TesselDataStore::VDataWriter;

TEST(StoreFile, ValuesAsText)
{
	const std::pair<VVariant, const char*> rows[] = {
	    {ToVariant(true), "Bool true"},
	    {ToVariant(std::int8_t(-5)), "Int8 -5"},
	    {ToVariant(std::uint32_t(4294967295)), "UInt32 4294967295"},
	    {ToVariant(std::numeric_limits<std::int64_t>::min()), "Int64 -9223372036854775808"},
	    {ToVariant(0.1f), "Float32 0.10000000149011612"},
	    {ToVariant(0.1), "Float64 0.10000000000000001"},
	    {ToVariant(-std::numeric_limits<float>::infinity()), "Float32 -inf"},
	    {ToVariant(std::string()), "String "},
	    {ToVariant(std::string("/a b/100%/\xC3\xBC.qrs")), "String /a b/100%25/%C3%BC.qrs"},
	    {ToVariant(std::string("\0\n\xFF", 3)), "String %00%0A%FF"},
	};
	for (const auto& [rValue, pText] : rows)
	{
		EXPECT_EQ(PrintValue(rValue), pText);
		VVariant read;
		EXPECT_TRUE(ParseValue(pText, read)) << pText;
		EXPECT_EQ(read, rValue) << pText;
	}
	EXPECT_EQ(PrintValue({}), "");
	for (const char* pBad : {"", "Float64", "Float64 ", "Float64 1,5", "Float64 1.5x", "Int8 200", "UInt32 -1",
	         "Bool yes", "List 1", "Void ", "Colour red", "Float32 1e39"})
	{
		VVariant untouched = ToVariant(std::string("untouched"));
		EXPECT_FALSE(ParseValue(pBad, untouched)) << pBad;
		EXPECT_EQ(untouched, ToVariant(std::string("untouched")));
	}
}

class Store : public testing::Test, protected VScratchSettings
{
protected:
	const std::shared_ptr<VDataStore> m_pStore = std::make_shared<VDataStore>();
	const std::shared_ptr<InMemoryHost::VDispatcher> m_pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
};

TEST_F(Store, ComesBackInTheNextRun)
{
	{
		const StudioHost::VStoreFile file(m_Settings, m_pStore, m_pDispatcher);
		VDataWriter(m_pStore).SetFloat64("RetargetSetup/TargetScale", 2.5);
		VDataWriter(m_pStore).SetString("RetargetSetup/SourceSkeleton", "/skeletons/a.qrs");
		m_pDispatcher->RunPending();
		EXPECT_EQ(m_Settings.value("Store/RetargetSetup/TargetScale").toString(), "Float64 2.5");
		VDataWriter(m_pStore).Remove("RetargetSetup/SourceSkeleton");
		VDataWriter(m_pStore).SetUInt32("RetargetSetup/TargetRoot", 3);
		// The last changes are still on their way.
	}
	m_Settings.setValue("Store/RetargetSetup/Odd", "Colour red");
	VMessages messages;
	const auto pNext = std::make_shared<VDataStore>();
	{
		const StudioHost::VStoreFile file(m_Settings, pNext, m_pDispatcher);
		EXPECT_EQ(messages.Take(), "3 Store: The settings' entry 'RetargetSetup/Odd' cannot be read and is left out");
		const VDataReader reader(pNext);
		EXPECT_EQ(
		    reader.GetKeys({}), (std::vector<std::string>{"RetargetSetup/TargetRoot", "RetargetSetup/TargetScale"}));
		double scale = 0.0;
		EXPECT_TRUE(reader.GetFloat64("RetargetSetup/TargetScale", scale));
		EXPECT_EQ(scale, 2.5);
	}
	EXPECT_EQ(m_Settings.value("Store/RetargetSetup/Odd").toString(), "Colour red") << "another version may know it";
}

TEST_F(Store, ReadsWhatStandsAsAGroupWithinIt)
{
	const QString path = Path("grouped.ini");
	QFile file(path);
	ASSERT_TRUE(file.open(QIODevice::WriteOnly) && file.write("[Store\\RetargetSetup]\nTargetScale=Float64 2.5\n") > 0);
	file.close();
	QSettings settings(path, QSettings::IniFormat);
	const StudioHost::VStoreFile store(settings, m_pStore, m_pDispatcher);
	double scale = 0.0;
	EXPECT_TRUE(VDataReader(m_pStore).GetFloat64("RetargetSetup/TargetScale", scale));
	EXPECT_EQ(scale, 2.5);
}

TEST_F(Store, HoldsThePreferences)
{
	using TesselPluginInterface::c_NavigationAltKey;
	StudioHost::VPreferences preferences(m_pStore, m_pDispatcher);
	std::vector<std::string> changed;
	preferences.ChangedSignal().Connect([&](const std::string& i_rKey) { changed.push_back(i_rKey); });
	EXPECT_EQ(preferences.Number(c_NavigationAltKey, 1), 1);
	for (const char* pKey : TesselPluginInterface::c_FolderKeys)
	{
		EXPECT_TRUE(preferences.Folder(pKey).empty());
		preferences.SetFolder(pKey, "/folder");
		EXPECT_EQ(preferences.Folder(pKey), "/folder") << pKey;
	}
	m_pDispatcher->RunPending();
	EXPECT_EQ(
	    std::vector<std::string>(changed.begin(), changed.end()).size(), TesselPluginInterface::c_FolderKeys.size());
	changed.clear();

	preferences.SetFolder("FolderSkins", "/folder");
	VDataWriter(m_pStore).SetFloat64("RetargetSetup/TargetScale", 2.0);
	m_pDispatcher->RunPending();
	EXPECT_TRUE(changed.empty()) << "the same folder, and a setting of a panel, are no change of a preference";
	preferences.SetFolder("FolderSkins", {});
	preferences.SetNumber(c_NavigationAltKey, 0);
	m_pDispatcher->RunPending();
	EXPECT_EQ(changed, (std::vector<std::string>{"FolderSkins", c_NavigationAltKey}));
	EXPECT_EQ(preferences.Number(c_NavigationAltKey, 1), 0);

	VMessages messages;
	VDataWriter(m_pStore).SetFloat64("FolderProps", 1.0);
	EXPECT_TRUE(preferences.Folder("FolderProps").empty());
	EXPECT_EQ(messages.Take(),
	    "2 Store: Failed getting value for store entry 'FolderProps': the requested value type does not match the "
	    "store value type.");
}

} // namespace
