#include "Assertions.h"
#include "UtilsFileSystem/Log.h"

#include "TesselDataStore/DataStore.h"
#include "TesselDataStore/DataWriter.h"
#include "TesselDataStore/TypedGet.h"

#include "InMemoryHost/Dispatcher.h"

#include <gtest/gtest.h>

#include <future>
#include <thread>

namespace
{

using namespace TesselDataStore;
using VTexts = std::vector<std::string>;

class DataStore : public testing::Test
{
protected:
	const VAssertions m_Assertions;
	VTestLog m_Log{"Store"};
	const std::shared_ptr<VDataStore> m_pStore = std::make_shared<VDataStore>();
	const std::shared_ptr<InMemoryHost::VDispatcher> m_pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
};

const char* const c_pOtherType =
    "2 Failed getting value for store entry 'key': the requested value type does not match the store value type.";

TEST_F(DataStore, KeepsTypedValues)
{
	VDataWriter writer(m_pStore);
	EXPECT_TRUE(writer.SetBool("bool", true));
	EXPECT_TRUE(writer.SetInt32("int", -3));
	EXPECT_TRUE(writer.SetUInt32("uint", 3));
	EXPECT_TRUE(writer.SetFloat64("real", 0.5));
	EXPECT_TRUE(writer.SetString("text", "a"));
	EXPECT_TRUE(writer.SetPath("path", "/b"));
	EXPECT_TRUE(writer.Set("long", ToVariant<std::int64_t>(-5)));
	EXPECT_TRUE(writer.Set("ulong", ToVariant<std::uint64_t>(5)));
	EXPECT_TRUE(writer.Set("float", ToVariant(0.25f)));
	EXPECT_TRUE(writer.Set("empty", {}));
	const auto expect = [&]<typename T>(
	                        bool (VDataReader::*i_pGet)(const std::string&, T&) const, const char* i_pKey, T i_Expected)
	{
		T value{};
		EXPECT_TRUE((writer.*i_pGet)(i_pKey, value));
		EXPECT_EQ(value, i_Expected);
	};
	expect(&VDataReader::GetBool, "bool", true);
	expect(&VDataReader::GetInt32, "int", -3);
	expect(&VDataReader::GetUInt32, "uint", 3u);
	expect(&VDataReader::GetInt64, "long", std::int64_t(-5));
	expect(&VDataReader::GetUInt64, "ulong", std::uint64_t(5));
	expect(&VDataReader::GetFloat32, "float", 0.25f);
	expect(&VDataReader::GetFloat64, "real", 0.5);
	expect(&VDataReader::GetString, "text", std::string("a"));
	expect(&VDataReader::GetPath, "path", boost::filesystem::path("/b"));

	EXPECT_TRUE(writer.HasEntry("empty"));
	EXPECT_FALSE(writer.HasValue("empty"));
	EXPECT_FALSE(writer.HasEntry("other"));
	EXPECT_EQ(writer.GetSchema("real"), NVX::IO::GetUniquePodSchema(NVX::IO::EType::EFloat64));
	EXPECT_EQ(writer.GetSchema("other"), nullptr);
	EXPECT_EQ(writer.GetKeys("u"), (VTexts{"uint", "ulong"}));
	EXPECT_TRUE(writer.Remove("uint"));
	EXPECT_FALSE(writer.Remove("uint"));
	EXPECT_FALSE(writer.HasEntry("uint"));
	EXPECT_EQ(m_Log.Take(), VTexts());
}

TEST_F(DataStore, TellsWhyADefaultIsReturned)
{
	VDataWriter writer(m_pStore);
	const boost::filesystem::path standard = "/standard";
	EXPECT_EQ(TypedGetOr(writer, "key", standard), standard);
	EXPECT_EQ(m_Log.Take(), VTexts{"4 Store entry 'key' has no value, returning the default value."});
	writer.SetFloat64("key", 1.0);
	EXPECT_EQ(TypedGetOr(writer, "key", standard), standard);
	EXPECT_EQ(m_Log.Take(), VTexts{c_pOtherType});
	writer.SetString("key", "/set");
	EXPECT_EQ(TypedGetOr(writer, "key", standard), "/set");
	EXPECT_EQ(m_Log.Take(), VTexts());
}

/// The colour of a newer program: one member more.
NVX::IO::VVariant NewerPair()
{
	NVX::IO::ISchema schema;
	schema.m_Type = NVX::IO::EType::ENamedTuple;
	schema.m_Children = {{"Major", "", 0, SchemaOf<std::uint32_t>()}};
	return {GetUniqueSchema(schema), ToVariant<std::uint32_t>(3).m_Bytes};
}

TEST_F(DataStore, VerifyingHoldersCompareSchemas)
{
	{
		VDataVerifyWriter writer(m_pStore);
		EXPECT_TRUE(writer.SetFloat64("key", 1.0));
		EXPECT_TRUE(writer.SetFloat64("key", 2.0));
		EXPECT_FALSE(writer.SetInt32("key", 3));
		EXPECT_FALSE(writer.Set("key", NewerPair()));
		double value = 0.0;
		EXPECT_TRUE(writer.GetFloat64("key", value));
		EXPECT_EQ(value, 2.0);
		std::int32_t number = 9;
		EXPECT_FALSE(writer.GetInt32("key", number));
		EXPECT_EQ(number, 9);
		EXPECT_EQ(m_Log.Take(), VTexts{c_pOtherType});
	}
	EXPECT_TRUE(VDataWriter(m_pStore).Set("key", NewerPair()));
	// The members that both know are read by a holder that does not verify.
	NVX::IO::VVariant value;
	EXPECT_FALSE(VDataVerifyReader(m_pStore).Get("key", SchemaOf<double>(), value));
	EXPECT_TRUE(VDataVerifyReader(m_pStore).Get("key", NewerPair().m_pSchema, value));
	EXPECT_TRUE(VDataVerifyReader(m_pStore).Get("key", nullptr, value));
	EXPECT_TRUE(VDataReader(m_pStore).Get("key", SchemaOf<double>(), value));
	EXPECT_EQ(value, NewerPair());
}

TEST_F(DataStore, AnOperationWithoutAStoreFailsItsAssertion)
{
	VDataWriter writer(nullptr);
	const VTexts once{"m_pDataStore != nullptr"};
	EXPECT_EQ(m_Assertions.Take(), once);
	std::string text;
	EXPECT_FALSE(writer.SetString("key", "a"));
	EXPECT_EQ(m_Assertions.Take(), once);
	EXPECT_FALSE(writer.GetString("key", text));
	EXPECT_FALSE(writer.Remove("key"));
	EXPECT_FALSE(writer.HasEntry("key"));
	EXPECT_EQ(writer.GetKeys("").size(), 0u);
	EXPECT_EQ(m_Assertions.Take().size(), 4u);
}

TEST_F(DataStore, AWriterInsideAReaderStaysWithoutAStore)
{
	VDataWriter(m_pStore).SetInt32("key", 1);
	{
		const VDataReader reader(m_pStore);
		VDataWriter writer(m_pStore);
		EXPECT_EQ(m_Assertions.Take(), VTexts{"Fatal attempt to acquire a write lock from within a read lock."});
		EXPECT_FALSE(writer.SetInt32("key", 2));
		EXPECT_EQ(m_Assertions.Take(), VTexts{"m_pDataStore != nullptr"});
		std::int32_t value = 0;
		EXPECT_TRUE(reader.GetInt32("key", value));
		EXPECT_EQ(value, 1);
		// Another store is another matter.
		EXPECT_TRUE(VDataWriter(std::make_shared<VDataStore>()).SetInt32("key", 2));
	}
	EXPECT_TRUE(VDataWriter(m_pStore).SetInt32("key", 2));
	EXPECT_EQ(m_Assertions.Take(), VTexts());
}

TEST_F(DataStore, AThreadMayOpenAgainWhatItHolds)
{
	std::int32_t value = 0;
	{
		const VDataReader outer(m_pStore);
		const VDataReader inner(m_pStore);
	}
	auto pWriter = std::make_unique<VDataWriter>(m_pStore);
	{
		const VDataReader reader(m_pStore);
		VDataWriter inner(m_pStore);
		EXPECT_TRUE(inner.SetInt32("key", 1));
		EXPECT_TRUE(reader.GetInt32("key", value));
	}
	// A reader that outlives its writer keeps others out.
	auto pReader = std::make_unique<VDataReader>(m_pStore);
	pWriter.reset();
	std::promise<void> asked;
	std::thread other(
	    [&]
	    {
		    asked.set_value();
		    VDataWriter(m_pStore).SetInt32("key", 2);
	    });
	asked.get_future().wait();
	EXPECT_TRUE(pReader->GetInt32("key", value));
	EXPECT_EQ(value, 1);
	pReader.reset();
	other.join();
	EXPECT_TRUE(VDataReader(m_pStore).GetInt32("key", value));
	EXPECT_EQ(value, 2);
	EXPECT_EQ(m_Assertions.Take(), VTexts());
}

TEST_F(DataStore, ReadersAreInTogether)
{
	// Each waits inside for the other: if one had to stay out, this would not end.
	std::promise<void> inside[2];
	const auto read = [&](int i_Reader)
	{
		const VDataReader reader(m_pStore);
		inside[i_Reader].set_value();
		inside[1 - i_Reader].get_future().wait();
	};
	std::thread other(read, 1);
	read(0);
	other.join();
}

TEST_F(DataStore, AWriterIsAlone)
{
	constexpr std::int32_t c_Writes = 500;
	VDataWriter(m_pStore).SetInt32("left", 0);
	VDataWriter(m_pStore).SetInt32("right", 0);
	std::vector<std::thread> threads;
	std::atomic<int> torn{0};
	for (int thread = 0; thread < 2; ++thread)
	{
		threads.emplace_back(
		    [&]
		    {
			    for (std::int32_t count = 0; count < c_Writes; ++count)
			    {
				    VDataWriter writer(m_pStore);
				    std::int32_t value = 0;
				    writer.GetInt32("left", value);
				    writer.SetInt32("left", value + 1);
				    writer.SetInt32("right", value + 1);
			    }
		    });
		threads.emplace_back(
		    [&]
		    {
			    for (std::int32_t left = 0, right = 0; left < 2 * c_Writes;)
			    {
				    const VDataReader reader(m_pStore);
				    reader.GetInt32("left", left);
				    reader.GetInt32("right", right);
				    torn += left != right;
			    }
		    });
	}
	for (std::thread& rThread : threads)
		rThread.join();
	EXPECT_EQ(torn, 0);
}

TEST_F(DataStore, TellsOfChangesOnlyQueuedAndAfterTheWriter)
{
	VTexts told;
	const auto subscribe = [&](const char* i_pKey)
	{
		return m_pStore->Subscribe(
		    i_pKey,
		    [&told, i_pKey, this](const std::string& i_rKey)
		    {
			    told.push_back(std::string(i_pKey) + ">" + i_rKey);
			    // The lock is free for whoever is told. An echo would not end.
			    if (told.size() < 20)
				    VDataWriter(m_pStore).SetBool("told", true);
		    },
		    m_pDispatcher);
	};
	subscribe("Group/a");
	subscribe("Group/");
	NVX::VConnection all = subscribe("");
	const auto run = [&]
	{
		m_pDispatcher->RunPending();
		std::sort(told.begin(), told.end());
		return std::exchange(told, {});
	};

	{
		VDataWriter writer(m_pStore);
		writer.SetInt32("Group/a", 1);
		writer.SetInt32("Group/a", 2);
		writer.SetInt32("Groupa", 1);
		{
			VDataWriter inner(m_pStore);
			inner.SetInt32("Group/b", 1);
		}
		EXPECT_EQ(m_pDispatcher->PendingCount(), 0u);
	}
	EXPECT_EQ(told, VTexts());
	EXPECT_EQ(run(),
	    (VTexts{">Group/a", ">Group/b", ">Groupa", ">told", "Group/>Group/a", "Group/>Group/b", "Group/a>Group/a"}));
	all.Disconnect();

	{
		VDataWriter writer(m_pStore);
		writer.SetInt32("Group/a", 2);
		writer.SetInt32("Group/b", 7);
		writer.SetInt32("Group/b", 1);
		writer.SetInt32("Group/c", 1);
		writer.Remove("Group/c");
	}
	EXPECT_EQ(run(), VTexts());
	// Of another type, with the same bytes.
	VDataWriter(m_pStore).SetUInt32("Group/b", 1);
	EXPECT_EQ(run(), VTexts{"Group/>Group/b"});
	VDataWriter(m_pStore).Remove("Group/a");
	EXPECT_EQ(run(), (VTexts{"Group/>Group/a", "Group/a>Group/a"}));
	EXPECT_EQ(m_Assertions.Take(), VTexts());
	EXPECT_FALSE(m_pStore
	                 ->Subscribe(
	                     "key", [](const std::string&) {}, nullptr)
	                 .IsConnected());
	EXPECT_EQ(m_Assertions.Take().size(), 1u);
}

TEST_F(DataStore, ChangesAreToldWhileOthersSubscribe)
{
	std::atomic<int> told{0};
	std::thread other(
	    [&]
	    {
		    for (int count = 0; count < 200; ++count)
			    m_pStore->Subscribe(
			        "key" + std::to_string(count), [&](const std::string&) { ++told; }, m_pDispatcher);
	    });
	for (int count = 0; count < 200; ++count)
		VDataWriter(m_pStore).SetInt32("key" + std::to_string(count), count);
	other.join();
	m_pDispatcher->RunPending();
	told = 0;
	VDataWriter(m_pStore).SetInt32("key7", -1);
	m_pDispatcher->RunPending();
	EXPECT_EQ(told, 1);
}

} // namespace
