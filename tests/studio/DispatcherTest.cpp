#include "Host.h"

#include "studio/host/QtDispatcher.h"

#include <QThread>

#include <thread>

namespace
{

using StudioHost::VQtDispatcher;

TEST(QtDispatcher, RunsOnItsThreadInTheOrderOfPosting)
{
	VQtDispatcher dispatcher;
	std::vector<int> order;
	int idle = 0;
	QObject::connect(&dispatcher, &VQtDispatcher::idle, [&] { ++idle; });
	const auto post = [&](int i_Number)
	{
		dispatcher.Post(
		    [&, i_Number]
		    {
			    EXPECT_EQ(QThread::currentThread(), dispatcher.thread());
			    order.push_back(i_Number);
		    });
	};
	post(1);
	std::thread([&] { post(2); }).join();
	dispatcher.Post([&] { post(4); });
	post(3);
	EXPECT_TRUE(order.empty()) << "nothing runs before the event loop does";
	EXPECT_EQ(dispatcher.PendingCount(), 4u);
	RunEvents();
	EXPECT_EQ(order, (std::vector<int>{1, 2, 3, 4}));
	EXPECT_EQ(dispatcher.PendingCount(), 0u);
	EXPECT_EQ(idle, 1);
}

TEST(QtDispatcher, GoesOnAfterACallbackThatThrows)
{
	VMessages messages;
	VQtDispatcher dispatcher;
	bool bRan = false;
	dispatcher.Post([] { throw std::runtime_error("no luck"); });
	dispatcher.Post([&] { bRan = true; });
	RunEvents();
	EXPECT_TRUE(bRan);
	EXPECT_EQ(messages.Take(), "2 System: A posted callback failed: no luck");
}

TEST(QtDispatcher, RunsNothingAfterItsEnd)
{
	bool bRan = false;
	{
		VQtDispatcher dispatcher;
		dispatcher.Post([&] { bRan = true; });
	}
	RunEvents();
	EXPECT_FALSE(bRan);
}

} // namespace
