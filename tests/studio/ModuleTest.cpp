#include "Host.h"
#include "module/TestModule.h"

#include "OrlexGraphics/skins/SkinCache.h"
#include "TesselPluginInterface/IParameterGroup.h"
#include "TesselPluginInterface/ISelectionManager.h"
#include "studio/host/Module.h"
#include "studio/host/Preferences.h"
#include "studio/host/Services.h"
#include "studio/panel/RetargetPanel.h"
#include "studio/window/StudioWindow.h"

#include <QDockWidget>
#include <QLabel>

#include <dlfcn.h>

namespace
{

using StudioHost::VModule;
using StudioHost::VStudioWindow;

QString Module(const char* i_pName)
{
	return QStringLiteral(STUDIO_TEST_MODULES "/TestModule_%1.so").arg(i_pName);
}

/// What has happened in a module that is loaded.
std::vector<std::string>& Calls(const char* i_pName)
{
	void* const pLibrary = dlopen(Module(i_pName).toLocal8Bit().constData(), RTLD_NOW | RTLD_NOLOAD);
	void* const pFunction = pLibrary ? dlsym(pLibrary, "TestModuleCalls") : nullptr;
	if (!pFunction)
		throw std::runtime_error("the test module is not loaded");
	dlclose(pLibrary);
	return reinterpret_cast<VTestModuleCalls*>(pFunction)();
}

TEST(Modules, AreRefusedWithTheReason)
{
	const QTemporaryDir folder;
	const QString text = WriteFile(folder.filePath("Text.so"), "no library");
	const std::pair<QString, const char*> rows[] = {
	    {folder.filePath("None.so"), "None.so does not exist"},
	    {folder.path(), "is no file"},
	    {text, "Text.so is no library that can be loaded: "},
	    {Module("LACKS_FUNCTIONS"), "is no module: it has no function CreatePlugin and DestroyPlugin"},
	    {Module("OTHER_REVISION"), "is of revision 1, this program works with modules of revision 125783"},
	    {Module("MAKES_NOTHING"), "made no plug-in"},
	};
	for (const auto& [rPath, pWhy] : rows)
	{
		QString why;
		EXPECT_FALSE(VModule::Load(rPath, why));
		EXPECT_TRUE(why.contains(pWhy)) << why.toStdString();
		EXPECT_TRUE(why.startsWith(QFileInfo(rPath).absoluteFilePath())) << why.toStdString();
	}
}

TEST(Modules, LiveInAWindow)
{
	VScratchSettings scratch;
	VMessages messages;
	VStudioWindow window(scratch.m_Settings);
	window.show();
	ASSERT_TRUE(window.LoadModule(Module("WELL")));
	std::vector<std::string>& rCalls = Calls("WELL");
	QStringList titles;
	for (const QDockWidget* pDock : window.Gui().PanelManager().Docks())
		titles << pDock->windowTitle();
	EXPECT_EQ(titles, (QStringList{"First", "Second"}));
	EXPECT_TRUE(window.Gui().PanelManager().Panels().front()->isVisible());
	EXPECT_FALSE(window.findChild<QLabel*>("Notice")->isVisible());
	EXPECT_FALSE(window.RetargetPanel());

	EXPECT_TRUE(window.Execute("Workspace3d:FrameSelected"));
	EXPECT_FALSE(window.Execute("Workspace3d:frameselected"));
	EXPECT_EQ(messages.Take(), "3 Command: frameselected: No panel is open that can do this.");
	window.Context().Preferences().SetFolder("FolderSkins", "/skins");
	RunEvents();
	// On its way when the module is unloaded.
	window.Context().Preferences().SetFolder("FolderProps", "/props");
	window.UnloadModule();
	RunEvents();
	EXPECT_EQ(rCalls,
	    (std::vector<std::string>{"RegisterQmlTypes", "CreateContent", "FirstPanel Workspace3d:FrameSelected",
	        "changed FolderSkins", "~SecondPanel", "~FirstPanel", "ReleaseContent", "~Plugin"}));
	EXPECT_TRUE(window.findChild<QLabel*>("Notice")->isVisible());

	// And again, ended by the window itself.
	rCalls.clear();
	{
		VStudioWindow another(scratch.m_Settings);
		ASSERT_TRUE(another.LoadModule(Module("WELL")));
	}
	EXPECT_EQ(rCalls,
	    (std::vector<std::string>{
	        "RegisterQmlTypes", "CreateContent", "~SecondPanel", "~FirstPanel", "ReleaseContent", "~Plugin"}));
}

TEST(Modules, ThatFailLeaveAWindowThatTellsWhy)
{
	VScratchSettings scratch;
	VMessages messages;
	VStudioWindow window(scratch.m_Settings);
	EXPECT_FALSE(window.LoadModule(Module("REFUSES")));
	EXPECT_EQ(Calls("REFUSES"),
	    (std::vector<std::string>{
	        "RegisterQmlTypes", "CreateContent", "~SecondPanel", "~FirstPanel", "ReleaseContent", "~Plugin"}));
	EXPECT_TRUE(window.Gui().PanelManager().Docks().isEmpty());
	EXPECT_TRUE(window.findChild<QLabel*>("Notice")->text().contains("could not make its panels"));
	EXPECT_NE(messages.Take().find("could not make its panels"), std::string::npos);
	EXPECT_FALSE(window.Open("/a.qrr"));
	EXPECT_EQ(messages.Take(), "2 Import: /a.qrr cannot be opened: no module with a retarget panel is loaded");
}

TEST(Modules, ThePanelComesAndGoes)
{
	VScratchSettings scratch;
	VMessages messages;
	VStudioWindow window(scratch.m_Settings);
	window.show();
	const auto pDispatcher = window.Context().GetDispatcher();
	std::uint32_t round = 0;
	// A firing finds out which callbacks are of what is gone, the next one forgets them.
	const auto countOwners = [&]
	{
		for (int firing = 0; firing < 2; ++firing)
		{
			const NVX::ISelectionItem item{11, 1, ++round, "item"};
			window.Context().Preferences().SetFolder("FolderSkins", round % 2 ? "/usr" : "/tmp");
			window.Context().GetSelectionManager()->Selection().Replace({item});
			window.Context().GetSelectionManager()->PreSelection().Replace({item});
			window.Gui().GetSkinCache()->ChangedSignal().Fire();
			RunEvents();
		}
		return pDispatcher.use_count();
	};
	// The engine keeps its list models, and they their subscriptions, for the next panel.
	long owners = 0;
	for (int i = 0; i < 20; ++i)
	{
		ASSERT_TRUE(window.LoadModule(RETARGET_MODULE)) << messages.Take();
		ASSERT_TRUE(window.RetargetPanel() && window.RetargetPanel()->IsReady());
		if (i % 10 == 0)
		{
			window.Open(RETARGET_SOURCE "/demo/performer.qrs");
			window.Open(RETARGET_SOURCE "/demo/character.fbx");
			RunEvents();
		}
		// Callbacks that are still queued when the panel goes must not find it.
		window.Context().Preferences().SetFolder("FolderSkins", i % 2 ? "/var" : "/etc");
		window.UnloadModule();
		EXPECT_FALSE(window.Context().GetParameterRegistry()->Find("RetargetSetup", "Subject"));
		RunEvents();
		if (i == 0)
			owners = countOwners();
	}
	EXPECT_EQ(countOwners(), owners) << "the module keeps nothing of the host";
	EXPECT_EQ(messages.Take(), "");
}

} // namespace
