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

class Module : public testing::Test
{
protected:
	void SetUp() override
	{
		m_pModule = dlopen(RETARGET_MODULE, RTLD_NOW | RTLD_LOCAL);
		ASSERT_TRUE(m_pModule) << dlerror();
		m_pCreate = reinterpret_cast<VCreatePlugin*>(dlsym(m_pModule, "CreatePlugin"));
		m_pDestroy = reinterpret_cast<VDestroyPlugin*>(dlsym(m_pModule, "DestroyPlugin"));
		m_pRevision = reinterpret_cast<VPluginBuildRevision*>(dlsym(m_pModule, "PluginBuildRevision"));
		ASSERT_TRUE(m_pCreate && m_pDestroy && m_pRevision);
	}

	void* m_pModule = nullptr;
	VCreatePlugin* m_pCreate = nullptr;
	VDestroyPlugin* m_pDestroy = nullptr;
	VPluginBuildRevision* m_pRevision = nullptr;
};

TEST_F(Module, TellsItsRevisionAndTakesNoPlugin)
{
	EXPECT_EQ(m_pRevision(), 125783u);
	m_pDestroy(nullptr);
}

TEST_F(Module, GoesThroughALifeInTheHost)
{
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
		IPlugin* const pPlugin = m_pCreate();
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
		m_pDestroy(pPlugin);
		RunAll(*context);
		EXPECT_EQ(gui->m_pEngine->m_Warnings.join('\n').toStdString(), "");
		gui.reset();
		context.reset();
		EXPECT_TRUE(pDispatcher.expired()) << "the module keeps nothing of the host";
	}
}

TEST_F(Module, ComesAndGoesAHundredTimes)
{
	VTestContext context;
	VTestGui gui(context);
	for (int life = 0; life < 100; ++life)
	{
		IPlugin* const pPlugin = m_pCreate();
		ASSERT_TRUE(pPlugin->RegisterQmlTypes() && pPlugin->CreateContent(context, gui));
		ASSERT_EQ(gui.PanelManager().Panels().size(), std::size_t(life + 1));
		delete gui.PanelManager().Panels().back().m_pWidget;
		EXPECT_TRUE(pPlugin->ReleaseContent());
		m_pDestroy(pPlugin);
	}
	// What the panels had posted finds none of them.
	context.Folders().SetFolder("FolderSubjects", "/");
	RunAll(context);
	EXPECT_EQ(gui.m_pEngine->m_Warnings.join('\n').toStdString(), "");
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
