#include "TesselParameters/ParameterGroup.h"

#include "InMemoryHost/Dispatcher.h"
#include "TesselDataStore/DataStore.h"
#include "TesselDataStore/DataWriter.h"

#include <gtest/gtest.h>

namespace
{

using namespace TesselParameters;
using TesselPluginInterface::VEnumEntry;

class Parameter : public testing::Test
{
protected:
	const std::shared_ptr<TesselDataStore::VDataStore> m_pStore = std::make_shared<TesselDataStore::VDataStore>();
	VParameterGroup m_Group{m_pStore, "RetargetSetup", "Target"};
};

TEST_F(Parameter, LivesInTheStoreUnderPathAndName)
{
	const auto pWeight = m_Group.Add<double>("TargetWeight", "Weight", "How much it counts.");
	EXPECT_TRUE(pWeight->SetDefault(1.0));
	EXPECT_TRUE(pWeight->Set(2.5));
	double value = 0.0;
	EXPECT_TRUE(TesselDataStore::VDataReader(m_pStore).GetFloat64("RetargetSetup/TargetWeight", value));
	EXPECT_EQ(value, 2.5);
	pWeight->ClearValue();
	EXPECT_TRUE(pWeight->Get(value));
	EXPECT_EQ(value, 1.0);
}

TEST_F(Parameter, TellsChangesThroughTheDispatcherOnly)
{
	const auto pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
	const auto pRoot = m_Group.Add<std::uint32_t>("TargetRoot");
	int calls = 0;
	NVX::VConnection connection = pRoot->ConnectValue([&] { ++calls; }, pDispatcher);
	pRoot->Set(3u);
	EXPECT_EQ(calls, 0);
	pDispatcher->RunPending();
	EXPECT_EQ(calls, 1);
	pRoot->Set(3u);
	EXPECT_EQ(pDispatcher->PendingCount(), 0u);
}

} // namespace
