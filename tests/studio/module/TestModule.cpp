// A small module: two panels that answer a command. Compiled several times, each time with another fault.

#include "TestModule.h"

#include "TesselPluginInterface/IPanelManager.h"
#include "TesselPluginInterface/IPlugin.h"
#include "TesselPluginInterface/IPluginContext.h"
#include "TesselPluginInterface/IPluginGui.h"
#include "TesselPluginInterface/ITesselExecuteCommand.h"

#include <QLabel>

#include <cstring>

namespace
{

std::vector<std::string> g_Calls;

class VPanel : public QLabel, public ITesselExecuteCommand
{
public:
	explicit VPanel(const char* i_pName) : QLabel(i_pName)
	{
		setObjectName(i_pName);
		setAccessibleName(i_pName);
	}
	~VPanel() override { g_Calls.push_back("~" + objectName().toStdString()); }

	void* qt_metacast(const char* i_pName) override
	{
		return std::strcmp(i_pName, "ITesselExecuteCommand") == 0 ? static_cast<ITesselExecuteCommand*>(this)
		                                                          : QLabel::qt_metacast(i_pName);
	}

	bool ExecuteCommand(const std::string& i_rCommand) override
	{
		if (i_rCommand != "Workspace3d:FrameSelected")
			return false;
		g_Calls.push_back(objectName().toStdString() + " " + i_rCommand);
		return true;
	}
};

class VPlugin : public TesselPluginInterface::IPlugin
{
public:
	~VPlugin() override { g_Calls.emplace_back("~Plugin"); }

	bool RegisterQmlTypes() override
	{
		g_Calls.emplace_back("RegisterQmlTypes");
		return true;
	}

	bool CreateContent(
	    TesselPluginInterface::IPluginContext& i_rContext, TesselPluginInterface::IPluginGui& i_rGui) override
	{
		g_Calls.emplace_back("CreateContent");
		i_rContext.GetPreferenceFolders()->ChangedSignal().Connect(
		    [pThis = std::weak_ptr<int>(m_pContent)](const std::string& i_rKey)
		    {
			    if (pThis.expired())
				    throw NVX::VDeregisterWeakCallbackException();
			    g_Calls.push_back("changed " + i_rKey);
		    },
		    i_rContext.GetDispatcher());
		i_rGui.GetPanelManager()->AddPanel("Second", 20, new VPanel("SecondPanel"));
		i_rGui.GetPanelManager()->AddPanel("First", 10, new VPanel("FirstPanel"));
#ifdef TEST_MODULE_REFUSES
		return false;
#else
		return true;
#endif
	}

	bool ReleaseContent() override
	{
		m_pContent.reset();
		g_Calls.emplace_back("ReleaseContent");
		return true;
	}

private:
	std::shared_ptr<int> m_pContent = std::make_shared<int>();
};

} // namespace

extern "C"
{
#ifndef TEST_MODULE_LACKS_FUNCTIONS
	__attribute__((visibility("default"))) TesselPluginInterface::IPlugin* CreatePlugin()
	{
#ifdef TEST_MODULE_MAKES_NOTHING
		return nullptr;
#else
		return new VPlugin;
#endif
	}

	__attribute__((visibility("default"))) void DestroyPlugin(TesselPluginInterface::IPlugin* i_pPlugin)
	{
		delete i_pPlugin;
	}
#endif

	__attribute__((visibility("default"))) std::uint64_t PluginBuildRevision()
	{
#ifdef TEST_MODULE_OTHER_REVISION
		return 1;
#else
		return TesselPluginInterface::c_PluginBuildRevision;
#endif
	}
}

__attribute__((visibility("default"))) std::vector<std::string>& TestModuleCalls() asm("TestModuleCalls");
std::vector<std::string>& TestModuleCalls()
{
	return g_Calls;
}
