// The module as a host meets it: nothing but the file and the names of its functions.

#include "TestHost.h"

#include "TesselPluginInterface/IPlugin.h"

#include <QWidget>

#include <dlfcn.h>
#include <gtest/gtest.h>

#include <cctype>
#include <cstdio>
#include <optional>
#include <set>
#include <string>

namespace
{

using TesselPluginInterface::IPlugin;

TEST(Module, GoesThroughALifeInTheHost)
{
	void* const pModule = dlopen(RETARGET_MODULE, RTLD_NOW | RTLD_LOCAL);
	ASSERT_TRUE(pModule) << dlerror();
	const auto pCreate = reinterpret_cast<VCreatePlugin*>(dlsym(pModule, "CreatePlugin"));
	const auto pDestroy = reinterpret_cast<VDestroyPlugin*>(dlsym(pModule, "DestroyPlugin"));
	const auto pRevision = reinterpret_cast<VPluginBuildRevision*>(dlsym(pModule, "PluginBuildRevision"));
	ASSERT_TRUE(pCreate && pDestroy && pRevision);
	EXPECT_EQ(pRevision(), 125783u);
	pDestroy(nullptr);
	const auto expectAgreement = [](IPlugin& i_rPlugin)
	{
		EXPECT_TRUE(i_rPlugin.FirstText().empty() && i_rPlugin.SecondText().empty());
		EXPECT_TRUE(i_rPlugin.FirstHook() && i_rPlugin.SecondHook() && i_rPlugin.ThirdHook() && i_rPlugin.FourthHook()
		    && i_rPlugin.FifthHook());
		i_rPlugin.LastHook();
	};
	for (int life = 0; life < 2; ++life)
	{
		std::optional<VTestContext> context(std::in_place);
		std::optional<VTestGui> gui(std::in_place, *context);
		const std::weak_ptr<TesselPluginInterface::IDispatcher> pDispatcher = context->GetDispatcher();
		IPlugin* const pPlugin = pCreate();
		ASSERT_TRUE(pPlugin);
		expectAgreement(*pPlugin);
		EXPECT_TRUE(pPlugin->RegisterQmlTypes());
		EXPECT_TRUE(pPlugin->CreateContent(*context, *gui));
		expectAgreement(*pPlugin);
		ASSERT_EQ(gui->PanelManager().Panels().size(), 1u);
		const auto& rPanel = gui->PanelManager().Panels()[0];
		EXPECT_EQ(rPanel.m_Title, "Retarget Setup");
		EXPECT_EQ(rPanel.m_Order, 5500);
		ASSERT_TRUE(rPanel.m_pWidget);
		EXPECT_TRUE(rPanel.m_pWidget->qt_metacast("ITesselExecuteCommand"));
		RunAll(*context);
		delete rPanel.m_pWidget;
		EXPECT_TRUE(pPlugin->ReleaseContent());
		EXPECT_TRUE(pPlugin->ReleaseContent());
		pDestroy(pPlugin);
		RunAll(*context);
		EXPECT_EQ(gui->m_pEngine->m_Warnings.join('\n').toStdString(), "");
		gui.reset();
		context.reset();
		EXPECT_TRUE(pDispatcher.expired()) << "the module keeps nothing of the host";
	}
}

TEST(ModuleFile, ShowsItsThreeFunctionsAndItsClassOnly)
{
	FILE* const pOutput = popen("nm -D -C --defined-only --extern-only " RETARGET_MODULE, "r");
	ASSERT_TRUE(pOutput);
	std::set<std::string> names;
	char line[1024];
	while (std::fgets(line, sizeof line, pOutput))
	{
		// Address, type, name; a type in small letters is for the module itself.
		const std::string text = line;
		const std::string name = text.substr(19, text.find_last_not_of('\n') - 18);
		if (std::isupper(static_cast<unsigned char>(text[17])) && name.find("VTesselPluginRetargetSetup") == name.npos)
			names.insert(name);
	}
	ASSERT_EQ(pclose(pOutput), 0);
	EXPECT_EQ(names, (std::set<std::string>{"CreatePlugin", "DestroyPlugin", "PluginBuildRevision"}));
}

} // namespace
