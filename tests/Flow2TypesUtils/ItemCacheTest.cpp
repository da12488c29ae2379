#include "../Assertions.h"

#include "CoreOrlexTypes/Subject.h"
#include "Flow2TypesUtils/ItemCache.h"
#include "Flow2TypesUtils/TaggedCoreTypeExtractor.h"
#include "InMemoryHost/PluginContext.h"

#include <gtest/gtest.h>

namespace
{

using namespace Flow2TypesUtils;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;
using NVX::CountedPointer;
using TesselPluginInterface::IFlowFrame;
using TesselPluginInterface::IFlowItem;

using VTexts = std::vector<std::string>;

class ItemCache : public testing::Test
{
protected:
	template <typename T>
	CountedPointer<IFlowItem> Item(const char* i_pFlowType, std::shared_ptr<const T> i_pValue)
	{
		auto pItem = m_Host.GetItemFactory()->CreateItem(i_pFlowType);
		EXPECT_TRUE(TesselPluginInterface::SetItemValue(pItem, std::move(i_pValue)));
		return pItem;
	}

	CountedPointer<IFlowFrame> Frame(std::initializer_list<CountedPointer<IFlowItem>> i_Items)
	{
		auto pFrame = m_Host.GetFrameFactory()->CreateFrame();
		for (const auto& rpItem : i_Items)
			pFrame->AddItem(rpItem);
		return pFrame;
	}

	InMemoryHost::VPluginContext m_Host;
};

TEST_F(ItemCache, FollowsTheItemOfItsType)
{
	const auto pSubject = std::make_shared<const VSubject>();
	const auto pItem = Item("FlowSubject", pSubject);
	VItemCacheTyped<VSubject> cache("FlowSubject");
	EXPECT_FALSE(cache.GetValue() || cache.GetItem() || cache.Update(*Frame({}))) << "nothing came yet";
	EXPECT_TRUE(cache.Update(*Frame({Item("FlowSubjectForSolving", std::make_shared<const VSubject>()), pItem})));
	EXPECT_EQ(cache.Value(), pSubject);
	EXPECT_EQ(cache.GetItem(), pItem);
	EXPECT_EQ(cache.Generation(), 1u);

	EXPECT_FALSE(cache.Update(*Frame({pItem}))) << "the same item in another frame";
	EXPECT_FALSE(cache.Update(*Frame({}))) << "a frame without one leaves the latest";
	EXPECT_EQ(cache.Value(), pSubject);

	EXPECT_TRUE(cache.Update(*Frame({Item("FlowSubject", pSubject)}))) << "another item, though of the same value";
	EXPECT_EQ(cache.Generation(), 2u);
	cache.Reset();
	EXPECT_FALSE(cache.GetValue() || cache.GetItem());
	EXPECT_TRUE(cache.Update(*Frame({pItem})));
	EXPECT_EQ(cache.Generation(), 3u);
}

TEST_F(ItemCache, OwnsItsItemSoThatNoOtherTakesItsPlace)
{
	VItemCacheTyped<VSubject> cache("FlowSubject");
	for (std::uint64_t i = 1; i <= 50; ++i)
	{
		EXPECT_TRUE(cache.Update(*Frame({Item("FlowSubject", std::make_shared<const VSubject>())})));
		EXPECT_EQ(cache.Generation(), i);
	}
}

TEST_F(ItemCache, AnItemWithoutAValueHasNone)
{
	VItemCacheTyped<VSubject> cache("FlowSubject");
	cache.Update(*Frame({Item("FlowSubject", std::make_shared<const VSubject>())}));
	EXPECT_TRUE(cache.Update(*Frame({m_Host.GetItemFactory()->CreateItem("FlowSubject")})));
	EXPECT_FALSE(cache.GetValue());
	m_Host.ItemFactory().Register<int>("FlowSubject");
	EXPECT_TRUE(cache.Update(*Frame({Item("FlowSubject", std::make_shared<const int>(1))})));
	EXPECT_FALSE(cache.GetValue()) << "the host's item carries something else";
}

TEST_F(ItemCache, TheExtractorAsksByTag)
{
	const VAssertions assertions;
	VTaggedCoreTypeExtractor extractor;
	EXPECT_FALSE(extractor.Insert(4100)) << "no such type";
	EXPECT_TRUE(extractor.Insert(4114) && extractor.Insert(4122));
	const auto pSubject = std::make_shared<const VSubject>();
	const auto pFrame =
	    Frame({Item("FlowSubject", pSubject), Item("FlowSubjectForSolving", std::make_shared<const VSubject>())});
	EXPECT_EQ(extractor.Get(4114), nullptr);
	EXPECT_TRUE(extractor.Update(*pFrame));
	EXPECT_FALSE(extractor.Update(*pFrame));
	EXPECT_EQ(extractor.Get<VSubject>(4114), pSubject);
	EXPECT_EQ(extractor.Get(4122), nullptr) << "inserted, but nothing came";
	EXPECT_TRUE(extractor.Insert(4114));
	EXPECT_EQ(extractor.Get(4114), pSubject) << "inserting again keeps the item";
	EXPECT_EQ(extractor.Cache(4114)->Generation(), 1u);
	EXPECT_EQ(assertions.Take(), VTexts());

	extractor.Reset();
	EXPECT_EQ(extractor.Get(4114), nullptr);
	EXPECT_TRUE(extractor.Update(*pFrame));
	EXPECT_EQ(assertions.Take(), VTexts());
}

TEST_F(ItemCache, ATagThatWasNeverInsertedFailsTheAssertion)
{
	const VAssertions assertions;
	VTaggedCoreTypeExtractor extractor;
	extractor.Insert(4114);
	EXPECT_EQ(extractor.Get(4123), nullptr);
	EXPECT_EQ(assertions.Take(), VTexts{"It != m_ItemCacheMap.end()"});
	EXPECT_EQ(extractor.Get<VSubject>(4123), nullptr);
	EXPECT_EQ(assertions.Take(), VTexts{"It != m_ItemCacheMap.end()"});
	EXPECT_EQ(extractor.Get<VSubjectParametrised>(4114), nullptr);
	EXPECT_EQ(assertions.Take(), VTexts{"pTyped != nullptr"});
}

} // namespace
