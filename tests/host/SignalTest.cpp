#include "NVX/Signal.h"
#include "InMemoryHost/Dispatcher.h"

#include <gtest/gtest.h>

#include <string>

namespace
{

using VQueue = InMemoryHost::VDispatcher;

class VListener : public NVX::VShared
{
public:
	explicit VListener(int& io_rHeard) : m_rHeard(io_rHeard) {}
	void Hear() { ++m_rHeard; }
	std::function<void()> Callback() const { return WeakBind(&VListener::Hear); }

private:
	int& m_rHeard;
};

TEST(Signal, CallsAtOnceOrThroughTheDispatcher)
{
	NVX::VSignal<std::string> signal;
	const auto pQueue = std::make_shared<VQueue>();
	std::string heard;
	signal.Connect([&heard](const std::string& i_rText) { heard += "posted " + i_rText + ";"; }, pQueue);
	signal.Connect([&heard](const std::string& i_rText) { heard += "at once " + i_rText + ";"; });
	signal.Fire("a");
	EXPECT_EQ(heard, "at once a;");
	pQueue->RunPending();
	EXPECT_EQ(heard, "at once a;posted a;");
}

TEST(Signal, DropsACallbackWhoseObjectIsGoneAndCallsTheOthers)
{
	NVX::VSignal<> signal;
	const auto pQueue = std::make_shared<VQueue>();
	int heard = 0;
	auto pDirect = NVX::MakeShared<VListener>(heard);
	auto pPosted = NVX::MakeShared<VListener>(heard);
	const auto pStays = NVX::MakeShared<VListener>(heard);
	signal.Connect(pDirect->Callback());
	signal.Connect(pPosted->Callback(), pQueue);
	signal.Connect(pStays->Callback());
	pDirect.reset();
	pPosted.reset();
	signal.Fire();
	EXPECT_EQ(heard, 1);
	EXPECT_EQ(signal.Count(), 2u) << "the posted one has not been called yet";
	pQueue->RunPending();
	EXPECT_EQ(heard, 1);
	EXPECT_EQ(signal.Count(), 1u);
}

TEST(Signal, ADisconnectedCallbackIsNotCalledEvenWhenItWasPosted)
{
	NVX::VSignal<> signal;
	const auto pQueue = std::make_shared<VQueue>();
	int heard = 0;
	NVX::VConnection connection = signal.Connect([&heard] { ++heard; }, pQueue);
	signal.Fire();
	EXPECT_TRUE(connection.IsConnected());
	connection.Disconnect();
	pQueue->RunPending();
	signal.Fire();
	EXPECT_EQ(pQueue->PendingCount(), 0u);
	EXPECT_EQ(heard, 0);
}

TEST(Signal, ACallbackMayConnectDisconnectAndFireAgain)
{
	NVX::VSignal<> signal;
	int outer = 0;
	int inner = 0;
	NVX::VConnection connection;
	connection = signal.Connect(
	    [&]
	    {
		    ++outer;
		    connection.Disconnect();
		    signal.Connect([&inner] { ++inner; });
		    signal.Fire();
	    });
	signal.Fire();
	EXPECT_EQ(outer, 1);
	EXPECT_EQ(inner, 1) << "connected during the outer firing: called by the inner one alone";
}

TEST(Signal, APostThatNeverRunsDoesNotKeepTheDispatcher)
{
	NVX::VSignal<> signal;
	auto pQueue = std::make_shared<VQueue>();
	signal.Connect([] {}, pQueue).Disconnect();
	NVX::VConnection connection = signal.Connect([] {}, pQueue);
	signal.Fire();
	connection.Disconnect();
	signal.Fire();
	const std::weak_ptr<VQueue> pWeak = pQueue;
	pQueue.reset();
	EXPECT_TRUE(pWeak.expired());
}

} // namespace
