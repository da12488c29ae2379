#include "TesselPluginInterface/IPlugin.h"
#include "TesselPluginInterface/IPluginContext.h"
#include "TesselPluginInterface/IPluginGui.h"

#include <gtest/gtest.h>

#include <array>
#include <bit>

namespace
{

using namespace TesselPluginInterface;

/// The place of a virtual function in the table, as the Itanium C++ interface encodes it in a member pointer.
/// The destructor takes the first two slots there and counts as one.
template <typename TMember>
std::size_t Slot(TMember i_pMember)
{
	const auto words = std::bit_cast<std::array<std::size_t, 2>>(i_pMember);
	return (words[0] - 1) / sizeof(void*);
}

TEST(Slots, StandInTheOrderThatHostsCallBy)
{
#if defined(__x86_64__)
	const std::size_t plugin[] = {Slot(&IPlugin::FirstText), Slot(&IPlugin::SecondText), Slot(&IPlugin::FirstHook),
	    Slot(&IPlugin::SecondHook), Slot(&IPlugin::ThirdHook), Slot(&IPlugin::FourthHook), Slot(&IPlugin::FifthHook),
	    Slot(&IPlugin::RegisterQmlTypes), Slot(&IPlugin::CreateContent), Slot(&IPlugin::ReleaseContent),
	    Slot(&IPlugin::LastHook)};
	const std::size_t context[] = {Slot(&IPluginContext::GetApplicationObject),
	    Slot(&IPluginContext::GetPreferenceFolders), Slot(&IPluginContext::GetDataStore),
	    Slot(&IPluginContext::GetParameterRegistry), Slot(&IPluginContext::GetDispatcher),
	    Slot(&IPluginContext::GetItemFactory), Slot(&IPluginContext::GetFrameFactory),
	    Slot(&IPluginContext::GetSelectionManager), Slot(&IPluginContext::GetSceneFlag)};
	const std::size_t gui[] = {Slot(&IPluginGui::GetQuickEngine), Slot(&IPluginGui::GetPanelManager),
	    Slot(&IPluginGui::GetGraphicsContext), Slot(&IPluginGui::GetSkinCache)};
	const auto expectInOrder = [](const auto& i_rSlots)
	{
		std::size_t expected = 2;
		for (const std::size_t slot : i_rSlots)
			EXPECT_EQ(slot, expected++);
	};
	expectInOrder(plugin);
	expectInOrder(context);
	expectInOrder(gui);
#else
	GTEST_SKIP() << "the encoding of member pointers is another one here";
#endif
}

TEST(Slots, ABarePluginAgreesToEverything)
{
	IPlugin plugin;
	EXPECT_TRUE(plugin.FirstText().empty());
	EXPECT_TRUE(plugin.SecondText().empty());
	EXPECT_TRUE(plugin.FirstHook() && plugin.SecondHook() && plugin.ThirdHook() && plugin.FourthHook()
	    && plugin.FifthHook() && plugin.RegisterQmlTypes() && plugin.ReleaseContent());
}

} // namespace
