// The module as a host meets it: nothing but the file and the names of its functions.

#include "InMemoryHost/PluginContext.h"
#include "TesselPluginInterface/IPlugin.h"

#include <dlfcn.h>
#include <gtest/gtest.h>

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
		InMemoryHost::VPluginContext context;
		InMemoryHost::VPluginGui gui;
		const auto owners = context.GetDispatcher().use_count();
		IPlugin* const pPlugin = m_pCreate();
		ASSERT_TRUE(pPlugin);
		expectAgreement(*pPlugin);
		EXPECT_TRUE(pPlugin->RegisterQmlTypes());
		EXPECT_TRUE(pPlugin->CreateContent(context, gui));
		expectAgreement(*pPlugin);
		EXPECT_TRUE(pPlugin->ReleaseContent());
		EXPECT_TRUE(pPlugin->ReleaseContent());
		m_pDestroy(pPlugin);
		EXPECT_EQ(context.GetDispatcher().use_count(), owners) << "the module keeps nothing of the host";
	}
}

} // namespace
