#pragma once

#include <QMainWindow>
#include <QSettings>

#include <array>
#include <functional>
#include <memory>
#include <string>
#include <utility>
#include <vector>

class QLabel;

namespace StudioHost
{

class VLogModel;
class VModule;
class VMotionPanel;
class VPluginContext;
class VPluginGui;
class VQtDispatcher;
class VRecentFiles;
class VRetargetPanel;
struct VReview;
class VTakePlayer;
class VWorkKeeper;

/// The window: the panels of the module, the log, the menus. It owns all services that the module is given, and ends
/// them in the right order: panels, plug-in, services.
class VStudioWindow : public QMainWindow
{
	Q_OBJECT

public:
	/// @param i_rSettings of layout, folders, recent files and panels; must outlive the window.
	explicit VStudioWindow(QSettings& i_rSettings, bool i_bDeveloper = false, QWidget* i_pParent = nullptr);
	~VStudioWindow() override;

	/// Replaces the module. Why there is none after it is told in the log and in the window.
	bool LoadModule(const QString& i_rPath);
	void UnloadModule();

	/// Opens a file by its kind. False, with the reason told in the log, if it was not even tried.
	bool Open(const QString& i_rPath);

	/// Plays a take, and shows the dock for it.
	void OpenTake(const QString& i_rPath, std::size_t i_Frame = 0);
	VTakePlayer& Motion();

	/// What OpenDialogSoon takes.
	static std::vector<std::string> Dialogs();
	/// Opens a dialog by its name, behind what the files that were opened have still to do.
	void OpenDialogSoon(const std::string& i_rName);

	/// Runs a named command on the panels.
	bool Execute(const QString& i_rCommand);

	/// Asks about work that is left of a program that did not end cleanly: it is taken up again, thrown away, or stays
	/// where it is.
	void OfferLeftWork();

	/// As it was when the window closed last.
	void RestoreLayout();

	VPluginContext& Context() { return *m_pContext; }
	VPluginGui& Gui() { return *m_pGui; }
	VQtDispatcher& Dispatcher() { return *m_pDispatcher; }
	VLogModel& Log() { return *m_pLog; }
	/// Null without a module that has one.
	VRetargetPanel* RetargetPanel() { return m_pRetargetPanel.get(); }
	/// As RetargetPanel.
	VWorkKeeper* WorkKeeper() { return m_pWorkKeeper.get(); }

	void ShowPreferences();

protected:
	void showEvent(QShowEvent* i_pEvent) override;
	void closeEvent(QCloseEvent* i_pEvent) override;

private:
	/// Names of dialogs and what shows them.
	static const std::array<std::pair<const char*, void (VStudioWindow::*)()>, 6> c_Dialogs;

	void MakeMenus(bool i_bDeveloper);
	void MakeFileMenu();
	void MakeEditMenu();
	void MakeViewMenu(bool i_bDeveloper);
	void MakeToolsMenu();
	void MakeHelpMenu();
	void MakeMotionDock();
	void AskAndOpenTake();
	/// Of the take that plays: saves it as a file of the operator's choice, and chooses it as the source skeleton.
	void MakePerformer();
	QAction* AddAction(QMenu& io_rMenu, const char* i_pName, const QString& i_rText, const QKeySequence& i_rShortcut,
	    std::function<void()> i_Run);
	void AskAndOpen(int i_Kind);
	/// Those that a job begins with, and the preferences.
	QList<QAction*> StartActions() const;
	/// @return empty if no file was chosen.
	QString AskWhereToSave(const QString& i_rFolder, const QString& i_rFilter, const QString& i_rExtension);
	/// Of the preferences; empty if it is not set.
	QString FolderOf(const char* i_pKey) const;
	void UpdateRecentFiles();
	void CopyCommands();
	void SaveRecipe();
	void SavePreset();
	void ShowProposal();
	void ShowAlignment();
	/// @param i_bAsked the operator wants to know, even that there is nothing to do.
	void ShowRebind(bool i_bPerformer, bool i_bAsked);
	/// In place of one of its name.
	void ShowReview(const VReview& i_rReview);
	void AskAndCompare();
	/// With the file that the target subject is of; asks for one if there is none.
	void CompareWithSaved();
	void CompareWith(const QString& i_rPath);
	void ShowAdvice();
	void ShowPoseCheck();
	/// Of the present state, with the take that plays.
	void WriteReport();
	void FollowSelected();
	/// What they do in the preview, as the preferences have it.
	void ShowMouseAndKeys();
	void ShowOperatorPage();
	void ShowAbout();
	/// Names what "Save" would write, or why it is off.
	void UpdateSaveActions();
	/// In the text field that is being typed in, else of the target subject.
	void UndoOrRedo(bool i_bBack);
	/// Names what they would undo and do again.
	/// @param i_bShown the menu is open: what can do nothing is off.
	void UpdateEditActions(bool i_bShown);
	/// Asks before what another program has written is lost.
	bool MayOverwrite(const std::string& i_rPath);
	/// Selects the segments and the target that a message is about; nothing changes if it names none.
	void SelectNamedIn(const QString& i_rMessage);
	void Say(const QString& i_rText);
	/// Asks what is to become of changes that are not saved.
	/// @param i_rAction what would lose them.
	/// @return false if they stay.
	bool MayLoseChanges(const QString& i_rAction);
	/// @return false if they are in no file then.
	bool SaveChanges();
	void ShowSaveFailure(const QString& i_rReason);
	void UpdateTitle();

	QSettings& m_rSettings;
	const std::shared_ptr<VQtDispatcher> m_pDispatcher;
	const std::unique_ptr<VLogModel> m_pLog;
	const std::unique_ptr<VRecentFiles> m_pRecentFiles;
	const std::unique_ptr<VPluginContext> m_pContext;
	const std::unique_ptr<VPluginGui> m_pGui;
	std::unique_ptr<VModule> m_pModule;
	std::unique_ptr<VRetargetPanel> m_pRetargetPanel;
	std::unique_ptr<VWorkKeeper> m_pWorkKeeper;
	QMenu* m_pRecentMenu = nullptr;
	QMenu* m_pPanelMenu = nullptr;
	QAction* m_pFollow = nullptr;
	/// What stands in the window where there is no panel.
	QLabel* m_pNotice = nullptr;
	QDockWidget* m_pLogDock = nullptr;
	QDockWidget* m_pMotionDock = nullptr;
	VMotionPanel* m_pMotion = nullptr;
	/// The docks have the sizes that they shall begin with.
	bool m_bArranged = false;
};

} // namespace StudioHost
