#include "UtilsFileSystem/Log.h"

#include "TesselParameters/ParameterGroup.h"

#include "InMemoryHost/Dispatcher.h"
#include "TesselDataStore/DataStore.h"
#include "TesselDataStore/DataWriter.h"

#include <gtest/gtest.h>

namespace
{

using namespace TesselParameters;
using TesselDataStore::ToVariant;
using TesselDataStore::VDataReader;
using TesselDataStore::VDataWriter;
using VTexts = std::vector<std::string>;

class Parameter : public testing::Test
{
protected:
	double Stored() const
	{
		double value = -1.0;
		(void)VDataReader(m_pStore).GetFloat64("RetargetSetup/TargetWeight", value);
		return value;
	}

	const std::shared_ptr<TesselDataStore::VDataStore> m_pStore = std::make_shared<TesselDataStore::VDataStore>();
	VParameterGroup m_Group{m_pStore, "RetargetSetup", "Target"};
	const std::shared_ptr<VParameter> m_pWeight = m_Group.Add<double>("TargetWeight");
	VTestLog m_Log{"VParameter"};
	VTestLog m_StoreLog{"Store"};
};

TEST_F(Parameter, LivesInTheStoreUnderPathAndName)
{
	EXPECT_FALSE(m_pWeight->HasValue());
	EXPECT_EQ(m_pWeight->GetValueText(), "");
	EXPECT_TRUE(m_pWeight->SetDefault(1.0));
	EXPECT_TRUE(m_pWeight->HasValue());
	EXPECT_EQ(m_pWeight->GetValueText(), "1");
	EXPECT_EQ(Stored(), -1.0);
	EXPECT_TRUE(m_pWeight->Set(2.5));
	EXPECT_EQ(Stored(), 2.5);
	m_pWeight->ResetToDefault();
	EXPECT_EQ(Stored(), 1.0);
	m_pWeight->ClearValue();
	EXPECT_FALSE(VDataReader(m_pStore).HasEntry("RetargetSetup/TargetWeight"));
	EXPECT_EQ(m_pWeight->GetValueText(), "1");

	// One that a stored value waits for.
	VDataWriter(m_pStore).SetUInt32("RetargetSetup/TargetRoot", 7);
	EXPECT_EQ(m_Group.Add<std::uint32_t>("TargetRoot")->GetValueText(), "7");
}

TEST_F(Parameter, AnotherSchemaIsRefusedAndChangesNothing)
{
	EXPECT_FALSE(m_pWeight->Set(1.0f));
	EXPECT_FALSE(m_pWeight->Set("1"));
	EXPECT_FALSE(VDataReader(m_pStore).HasEntry(m_pWeight->GetStoreKey()));
	m_pWeight->Set(2.0);
	EXPECT_FALSE(m_pWeight->Set<std::uint32_t>(1));
	EXPECT_EQ(Stored(), 2.0);

	// The entry became another one behind its back: it keeps what it is, and is told.
	VDataWriter(m_pStore).SetString(m_pWeight->GetStoreKey(), "ten");
	EXPECT_FALSE(m_pWeight->Set(3.0));
	EXPECT_NE(m_pWeight->SetValueText("3"), "");
	EXPECT_FALSE(m_pWeight->HasValue());
	EXPECT_EQ(m_StoreLog.Take(),
	    VTexts{"2 Failed getting value for store entry 'RetargetSetup/TargetWeight': the requested value type does not "
	           "match the store value type."});
	std::string text;
	EXPECT_TRUE(VDataReader(m_pStore).GetString(m_pWeight->GetStoreKey(), text));
	EXPECT_EQ(text, "ten");
}

TEST_F(Parameter, VerificationKeepsWhatAnotherProgramLeft)
{
	const auto leave = [this] { VDataWriter(m_pStore).SetString(m_pWeight->GetStoreKey(), "ten"); };
	const auto bKept = [this] { return VDataReader(m_pStore).HasEntry(m_pWeight->GetStoreKey()); };
	leave();
	m_pWeight->SetVerifyRequired(true);
	EXPECT_TRUE(m_pWeight->GetVerifyRequired());
	EXPECT_TRUE(m_pWeight->SetDefault(1.0));
	EXPECT_TRUE(bKept());
	double value = 0.0;
	EXPECT_TRUE(m_pWeight->Get(value));
	EXPECT_EQ(value, 1.0);
	EXPECT_EQ(m_Log.Take(), VTexts());

	m_pWeight->SetVerifyRequired(false);
	EXPECT_EQ(m_Log.Take(),
	    VTexts{"3 VParameter::SetVerifyRequired called after VParameter::SetValueDefault for Parameter "
	           "\"TargetWeight\", parameters previously imported from other Orlex applications may be lost."});
	EXPECT_FALSE(m_pWeight->GetVerifyRequired());
	EXPECT_TRUE(m_pWeight->SetDefault(1.0));
	EXPECT_FALSE(bKept());
	EXPECT_TRUE(m_pWeight->Set(4.0));
	EXPECT_TRUE(m_pWeight->SetDefault(2.0));
	EXPECT_EQ(Stored(), 4.0);
}

TEST_F(Parameter, AnEmptyTextIsNothingChosen)
{
	const auto pSource = m_Group.Add<std::string>("SourceSkeleton");
	const auto pSkin = m_Group.Add<boost::filesystem::path>("SourceSkin");
	pSource->SetEnumeration({{"(None)", ToVariant("")}, {"A", ToVariant("/a.qrs")}});
	EXPECT_EQ(pSource->SetValueText("A"), "");
	EXPECT_TRUE(pSource->HasValue());
	EXPECT_EQ(pSource->GetValueText(), "/a.qrs");
	EXPECT_EQ(pSource->SetValueText("(None)"), "");
	EXPECT_FALSE(pSource->HasValue());
	EXPECT_TRUE(pSkin->Set(boost::filesystem::path()));
	EXPECT_FALSE(pSkin->HasValue());
	EXPECT_TRUE(pSkin->Set<boost::filesystem::path>("/b"));
	EXPECT_TRUE(pSkin->HasValue());
}

TEST_F(Parameter, TellsChangesThroughTheDispatcherOnly)
{
	const auto pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
	VTexts told;
	NVX::VConnection connection =
	    m_pWeight->ConnectValue([&] { told.push_back(m_pWeight->GetValueText()); }, pDispatcher);
	m_pWeight->Set(3.0);
	m_pWeight->Set(3.0);
	EXPECT_EQ(told, VTexts());
	pDispatcher->RunPending();
	EXPECT_EQ(told, VTexts{"3"});
	m_pWeight->SetDisplay("Weight");
	m_Group.Add<double>("Other")->Set(1.0);
	EXPECT_EQ(pDispatcher->PendingCount(), 0u);
	m_pWeight->Set(4.0);
	connection.Disconnect();
	pDispatcher->RunPending();
	EXPECT_EQ(told, VTexts{"3"});
}

} // namespace
