#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "InMemoryHost/PluginContext.h"

#include <gtest/gtest.h>

#include <thread>

namespace
{

using namespace InMemoryHost;
using TesselPluginInterface::ItemValue;
using TesselPluginInterface::SetItemValue;

TEST(Dispatcher, RunsInOrderAndWhatIsPostedMeanwhile)
{
	VDispatcher dispatcher;
	std::string order;
	dispatcher.Post(
	    [&]
	    {
		    order += "a";
		    dispatcher.Post([&] { order += "c"; });
	    });
	dispatcher.Post([&] { order += "b"; });
	EXPECT_EQ(order, "") << "nothing runs inside Post";
	EXPECT_EQ(dispatcher.RunPending(), 3u);
	EXPECT_EQ(order, "abc");
}

TEST(Dispatcher, KeepsWhatStandsBehindACallbackThatThrows)
{
	VDispatcher dispatcher;
	bool bRan = false;
	dispatcher.Post([] { throw 1; });
	dispatcher.Post([&bRan] { bRan = true; });
	EXPECT_THROW(dispatcher.RunPending(), int);
	EXPECT_EQ(dispatcher.PendingCount(), 1u);
	EXPECT_EQ(dispatcher.RunPending(), 1u);
	EXPECT_TRUE(bRan);
}

TEST(Dispatcher, TakesPostsFromOtherThreads)
{
	VDispatcher dispatcher;
	std::size_t ran = 0;
	std::vector<std::thread> threads;
	for (int i = 0; i < 4; ++i)
		threads.emplace_back(
		    [&]
		    {
			    for (int post = 0; post < 250; ++post)
				    dispatcher.Post([&ran] { ++ran; });
		    });
	for (std::thread& rThread : threads)
		rThread.join();
	EXPECT_EQ(dispatcher.RunPending(), 1000u);
	EXPECT_EQ(ran, 1000u);
}

TEST(Flow, AnItemTakesOnlyItsOwnType)
{
	VPluginContext host;
	const auto pFactory = host.GetItemFactory();
	const auto pItem = pFactory->CreateItem("FlowSubjectForSolving");
	ASSERT_TRUE(pItem);
	EXPECT_EQ(pItem->FlowType(), "FlowSubjectForSolving");
	EXPECT_FALSE(ItemValue<CoreOrlexTypes::VSubject>(pItem)) << "no value yet";
	EXPECT_FALSE(SetItemValue(pItem, std::make_shared<const CoreOrlexTypes::VSubjectParametrised>()));
	const auto pValue = std::make_shared<const CoreOrlexTypes::VSubject>();
	EXPECT_TRUE(SetItemValue(pItem, pValue));
	EXPECT_EQ(ItemValue<CoreOrlexTypes::VSubject>(pItem), pValue);
	EXPECT_FALSE(ItemValue<int>(pItem));
	EXPECT_FALSE(pFactory->CreateItem("FlowUnheardOf"));
	host.ItemFactory().Register<int>("FlowUnheardOf");
	EXPECT_TRUE(SetItemValue(pFactory->CreateItem("FlowUnheardOf"), std::make_shared<const int>(3)));
}

TEST(Flow, AFrameKeepsItsItems)
{
	VPluginContext host;
	const auto pFrame = host.GetFrameFactory()->CreateFrame();
	pFrame->AddItem(nullptr);
	EXPECT_FALSE(pFrame->Item("FlowSubject"));
	auto pItem = host.GetItemFactory()->CreateItem("FlowSubject");
	const auto* const pRaw = pItem.get();
	pFrame->AddItem(pItem);
	pItem = nullptr;
	EXPECT_EQ(pFrame->Item("FlowSubject").get(), pRaw);
	EXPECT_NE(host.GetFrameFactory()->CreateFrame(), pFrame);
}

TEST(PreferenceFolders, TellsOfChangesOnly)
{
	VPreferenceFolders folders;
	std::string told;
	folders.ChangedSignal().Connect([&told](const std::string& i_rKey) { told += i_rKey + ";"; });
	EXPECT_TRUE(folders.Folder("FolderSkins").empty());
	folders.SetFolder("FolderSkins", "/a");
	folders.SetFolder("FolderSkins", "/a");
	folders.SetFolder("FolderRetargets", "/b");
	EXPECT_EQ(told, "FolderSkins;FolderRetargets;");
	EXPECT_EQ(folders.Folder("FolderSkins"), "/a");
}

TEST(PanelManager, KeepsPanelsInOrder)
{
	VPluginGui gui;
	gui.GetPanelManager()->AddPanel("Last", 9, nullptr);
	gui.GetPanelManager()->AddPanel("First", 1, nullptr);
	ASSERT_EQ(gui.PanelManager().Panels().size(), 2u);
	EXPECT_EQ(gui.PanelManager().Panels().front().m_Title, "First");
}

} // namespace
