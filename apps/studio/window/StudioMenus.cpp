#include "studio/window/StudioWindow.h"

#include "DebugServices/GlobalLog.h"
#include "TesselPluginInterface/IPreferenceFolders.h"
#include "TesselPluginInterface/ISelectionManager.h"
#include "TesselPluginInterface/PathTypes.h"
#include "UtilsFileSystem/Paths.h"
#include "studio/host/Preferences.h"
#include "studio/host/QtDispatcher.h"
#include "studio/host/Services.h"
#include "studio/panel/FileKind.h"
#include "studio/panel/RecentFiles.h"
#include "studio/panel/RetargetPanel.h"
#include "studio/window/AlignDialog.h"
#include "studio/window/EditKeys.h"
#include "studio/window/Named.h"
#include "studio/window/PlainTexts.h"
#include "studio/window/PreferencesDialog.h"
#include "studio/window/ProposeDialog.h"
#include "studio/window/RebindDialog.h"

#include <QAction>
#include <QClipboard>
#include <QDialog>
#include <QDockWidget>
#include <QFileDialog>
#include <QFileInfo>
#include <QGuiApplication>
#include <QMenu>
#include <QMenuBar>
#include <QMessageBox>
#include <QTextBrowser>
#include <QTimer>
#include <QUrl>
#include <QVBoxLayout>

#include <cstring>
#include <tuple>

static void InitialiseHelp()
{
	Q_INIT_RESOURCE(Help);
}

namespace StudioHost
{
namespace
{

/// For a menu, where a "&" in a name is no mnemonic.
QString Verbatim(const QString& i_rText)
{
	return ShownText(i_rText).replace('&', "&&");
}

struct VOpenRow
{
	EFileKind m_Kind;
	const char* m_pName;
	const char* m_pText;
	const char* m_pShortcut;
	TesselPluginInterface::EPathTypes m_Folder;
};

constexpr VOpenRow c_OpenRows[] = {
    {EFileKind::ESource, "OpenSource", QT_TRANSLATE_NOOP("Studio", "Open &Source Skeleton..."), "Ctrl+Shift+O",
        TesselPluginInterface::EPathSubjects},
    {EFileKind::EFbx, "OpenFbx", QT_TRANSLATE_NOOP("Studio", "Open &FBX..."), "Ctrl+Shift+F",
        TesselPluginInterface::EPathSkins},
    {EFileKind::ETarget, "OpenTarget", QT_TRANSLATE_NOOP("Studio", "&Open Retarget Subject..."), "Ctrl+O",
        TesselPluginInterface::EPathRetargets}};

struct VCommandRow
{
	const char* m_pName;
	const char* m_pText;
	/// Separated by blanks.
	const char* m_pShortcuts;
	const char* m_pCommand;
};

constexpr VCommandRow c_CommandRows[] = {
    {"FrameSelected", QT_TRANSLATE_NOOP("Studio", "&Frame Selected"), "Ctrl+F", "Workspace3d:FrameSelected"},
    {"ScaleUpManipulator", QT_TRANSLATE_NOOP("Studio", "&Larger Manipulator"),
        "Ctrl++ Ctrl+=", "Workspace3d:ScaleUpManipulator"},
    {"ScaleDownManipulator", QT_TRANSLATE_NOOP("Studio", "&Smaller Manipulator"), "Ctrl+-",
        "Workspace3d:ScaleDownManipulator"}};

} // namespace

const std::array<std::pair<const char*, void (VStudioWindow::*)()>, 6> VStudioWindow::c_Dialogs = {
    {{"advice", &VStudioWindow::ShowAdvice}, {"align", &VStudioWindow::ShowAlignment},
        {"check-pose", &VStudioWindow::ShowPoseCheck}, {"compare", &VStudioWindow::CompareWithSaved},
        {"preferences", &VStudioWindow::ShowPreferences}, {"propose", &VStudioWindow::ShowProposal}}};

QAction* VStudioWindow::AddAction(QMenu& io_rMenu, const char* i_pName, const QString& i_rText,
    const QKeySequence& i_rShortcut, std::function<void()> i_Run)
{
	QAction* const pAction = io_rMenu.addAction(i_rText);
	pAction->setObjectName(QLatin1String(i_pName));
	pAction->setShortcut(i_rShortcut);
	connect(pAction, &QAction::triggered, this, std::move(i_Run));
	return pAction;
}

void VStudioWindow::MakeMenus(bool i_bDeveloper)
{
	Named(menuBar(), "MenuBar", tr("Menus"));
	MakeFileMenu();
	MakeEditMenu();
	MakeViewMenu(i_bDeveloper);
	MakeToolsMenu();
	MakeHelpMenu();
}

void VStudioWindow::MakeFileMenu()
{
	QMenu& rMenu = *Named(menuBar()->addMenu(tr("&File")), "FileMenu", tr("File"));
	const auto withPanel = [this](void (VRetargetPanel::*i_pCommand)())
	{
		return [this, i_pCommand]
		{
			if (m_pRetargetPanel)
				(m_pRetargetPanel.get()->*i_pCommand)();
		};
	};
	AddAction(rMenu, "New", tr("&New Retarget Subject"), QKeySequence::New, withPanel(&VRetargetPanel::New));
	for (const VOpenRow& rRow : c_OpenRows)
		AddAction(rMenu, rRow.m_pName, tr(rRow.m_pText), QKeySequence(rRow.m_pShortcut),
		    [this, kind = int(rRow.m_Kind)] { AskAndOpen(kind); });
	AddAction(
	    rMenu, "OpenTake", tr("Open &Take..."), QKeySequence(QStringLiteral("Ctrl+T")), [this] { AskAndOpenTake(); });
	m_pRecentMenu = Named(rMenu.addMenu(tr("Open &Recent")), "RecentMenu", tr("Files used last"));
	connect(m_pRecentFiles.get(), &VRecentFiles::changed, this, &VStudioWindow::UpdateRecentFiles);
	UpdateRecentFiles();
	rMenu.addSeparator();
	// Off only while the menu shows it: the shortcut tells why nothing was saved.
	connect(&rMenu, &QMenu::aboutToShow, this, &VStudioWindow::UpdateSaveActions);
	connect(&rMenu, &QMenu::aboutToHide, this,
	    [this]
	    {
		    for (const char* const pName : {"New", "Save", "SaveAs"})
			    findChild<QAction*>(QLatin1String(pName))->setEnabled(true);
	    });
	AddAction(rMenu, "Save", tr("&Save Retarget Subject"), QKeySequence::Save, withPanel(&VRetargetPanel::Save));
	AddAction(rMenu, "SaveAs", tr("Save Retarget Subject &As..."), QKeySequence(QStringLiteral("Ctrl+Shift+S")),
	    withPanel(&VRetargetPanel::SaveAs));
	rMenu.addSeparator();
	AddAction(rMenu, "PreferencesAction", tr("&Preferences..."), QKeySequence(QStringLiteral("Ctrl+,")),
	    [this] { ShowPreferences(); });
	rMenu.addSeparator();
	AddAction(rMenu, "Quit", tr("&Quit"), QKeySequence::Quit, [this] { close(); });
}

void VStudioWindow::MakeEditMenu()
{
	QMenu& rMenu = *Named(menuBar()->addMenu(tr("&Edit")), "EditMenu", tr("Edit"));
	QAction* const pUndo =
	    AddAction(rMenu, "Undo", {}, QKeySequence(QStringLiteral("Ctrl+Z")), [this] { UndoOrRedo(true); });
	QAction* const pRedo = AddAction(rMenu, "Redo", {}, {}, [this] { UndoOrRedo(false); });
	pRedo->setShortcuts({QKeySequence(QStringLiteral("Ctrl+Shift+Z")), QKeySequence(QStringLiteral("Ctrl+Y"))});
	rMenu.addSeparator();
	AddAction(rMenu, "CopyCommands", tr("Copy as &Commands"), QKeySequence(QStringLiteral("Ctrl+Shift+C")),
	    [this] { CopyCommands(); });
	AddAction(rMenu, "SaveRecipe", tr("Save as Re&cipe..."), {}, [this] { SaveRecipe(); });
	// As with Save: the shortcut tells why nothing happens.
	connect(&rMenu, &QMenu::aboutToShow, this, [this] { UpdateEditActions(true); });
	connect(&rMenu, &QMenu::aboutToHide, this, [this] { UpdateEditActions(false); });
	UpdateEditActions(false);
	// Behind the edits that are still on their way.
	new VEditKeys(*this, {pUndo, pRedo},
	    [this]
	    {
		    m_pDispatcher->Post(
		        [this]
		        {
			        // The presses in a preview of a pose are none of their own.
			        if (m_pRetargetPanel && !m_pRetargetPanel->IsAligning())
				        m_pRetargetPanel->EndStep();
		        });
	    });
}

void VStudioWindow::CopyCommands()
{
	const QString commands = m_pRetargetPanel ? m_pRetargetPanel->SessionCommands() : QString();
	if (commands.isEmpty())
		return;
	QGuiApplication::clipboard()->setText(commands);
	NVX_LOG("Command", NVX::ELogInformation, "The steps were copied as a command line for a shell: %1% lines",
	    commands.count('\n'));
}

void VStudioWindow::SaveRecipe()
{
	if (!m_pRetargetPanel)
		return;
	const QString file =
	    AskWhereToSave(FolderOf(TesselPluginInterface::c_FolderKeys[TesselPluginInterface::EPathRetargets]),
	        tr("Recipes (*.json)"), QStringLiteral(".json"));
	if (!file.isEmpty() && m_pRetargetPanel->SaveRecipe(file))
		NVX_LOG("Command", NVX::ELogInformation, "The steps were saved as a recipe: retarget build %1%",
		    file.toStdString());
}

void VStudioWindow::UndoOrRedo(bool i_bBack)
{
	if (!UndoTyping(i_bBack) && m_pRetargetPanel)
		i_bBack ? m_pRetargetPanel->Undo() : m_pRetargetPanel->Redo();
}

void VStudioWindow::UpdateEditActions(bool i_bShown)
{
	// What is being typed is then the next to be undone.
	if (i_bShown && m_pRetargetPanel)
		m_pRetargetPanel->ApplyTyped();
	const std::tuple<const char*, QString, QString> rows[] = {
	    {"Undo", tr("&Undo"), i_bShown && m_pRetargetPanel ? m_pRetargetPanel->UndoName() : QString()},
	    {"Redo", tr("&Redo"), i_bShown && m_pRetargetPanel ? m_pRetargetPanel->RedoName() : QString()}};
	for (const auto& [pName, rText, rStep] : rows)
	{
		auto* const pAction = findChild<QAction*>(QLatin1String(pName));
		pAction->setText(rStep.isEmpty() ? rText : QStringLiteral("%1 %2").arg(rText, Verbatim(rStep)));
		pAction->setEnabled(!i_bShown || !rStep.isEmpty());
	}
}

void VStudioWindow::MakeViewMenu(bool i_bDeveloper)
{
	QMenu& rMenu = *Named(menuBar()->addMenu(tr("&View")), "ViewMenu", tr("View"));
	for (const VCommandRow& rRow : c_CommandRows)
	{
		QList<QKeySequence> shortcuts;
		for (const QString& rShortcut : QString(rRow.m_pShortcuts).split(' '))
			shortcuts << QKeySequence(rShortcut);
		AddAction(rMenu, rRow.m_pName, tr(rRow.m_pText), {},
		    [this, pCommand = rRow.m_pCommand] { Execute(QLatin1String(pCommand)); })
		    ->setShortcuts(shortcuts);
	}
	m_pFollow = AddAction(rMenu, "FollowSelected", tr("F&ollow Selected"), QKeySequence(QStringLiteral("Ctrl+L")),
	    [this] { FollowSelected(); });
	m_pFollow->setCheckable(true);
	rMenu.addSeparator();
	m_pPanelMenu = Named(rMenu.addMenu(tr("&Panels")), "PanelMenu", tr("Panels"));
	m_pPanelMenu->addAction(m_pLogDock->toggleViewAction());
	if (i_bDeveloper)
	{
		rMenu.addSeparator();
		AddAction(rMenu, "Reload", tr("&Reload QML"), QKeySequence(Qt::Key_F5),
		    [this] { m_pGui->QuickEngine().ReloadSignal().Fire(); });
	}
}

void VStudioWindow::MakeToolsMenu()
{
	QMenu& rMenu = *Named(menuBar()->addMenu(tr("T&ools")), "ToolsMenu", tr("Tools"));
	AddAction(rMenu, "ProposeTargets", tr("&Propose Targets..."), QKeySequence(QStringLiteral("Ctrl+P")),
	    [this] { ShowProposal(); });
	AddAction(rMenu, "AlignToSourceAction", tr("&Align to Source..."), {}, [this] { ShowAlignment(); });
	AddAction(rMenu, "RebindToFbx", tr("Re-bind to the &FBX..."), {}, [this] { ShowRebind(false, true); });
	AddAction(rMenu, "RebindToPerformer", tr("Re-bind to the Pe&rformer..."), {}, [this] { ShowRebind(true, true); });
	rMenu.addSeparator();
	AddAction(rMenu, "CheckPose", tr("Check P&ose"), {}, [this] { ShowPoseCheck(); });
	AddAction(rMenu, "ShowAdvice", tr("A&dvice..."), {}, [this] { ShowAdvice(); });
	AddAction(rMenu, "CompareWith", tr("&Compare with..."), {}, [this] { AskAndCompare(); });
	AddAction(rMenu, "CompareWithSaved", tr("Compare with Its File as Sa&ved"), {}, [this] { CompareWithSaved(); });
	AddAction(rMenu, "WriteReport", tr("&Write Report..."), {}, [this] { WriteReport(); });
	rMenu.addSeparator();
	AddAction(rMenu, "SavePreset", tr("&Save Targets as Preset..."), {}, [this] { SavePreset(); });
}

std::vector<std::string> VStudioWindow::Dialogs()
{
	std::vector<std::string> names;
	names.reserve(std::size(c_Dialogs));
	for (const auto& [pName, pShow] : c_Dialogs)
		names.emplace_back(pName);
	return names;
}

void VStudioWindow::OpenDialogSoon(const std::string& i_rName)
{
	m_pDispatcher->Post(
	    [this, i_rName]
	    {
		    // This one counts, too.
		    if (m_pDispatcher->PendingCount() > 1)
			    return OpenDialogSoon(i_rName);
		    for (const auto& [pName, pShow] : c_Dialogs)
			    if (i_rName == pName)
				    QTimer::singleShot(0, this, pShow);
	    });
}

QString VStudioWindow::FolderOf(const char* i_pKey) const
{
	return QString::fromStdString(UtilsFileSystem::ToUtf8(m_pContext->Preferences().Folder(i_pKey)));
}

void VStudioWindow::SavePreset()
{
	if (!m_pRetargetPanel)
		return;
	const QString file = AskWhereToSave(FolderOf(c_pPresetsFolderKey), tr("Presets (*.json)"), QStringLiteral(".json"));
	if (!file.isEmpty() && m_pRetargetPanel->SavePreset(file))
		NVX_LOG("Command", NVX::ELogInformation, "The pairs of the target subject are saved as the preset %1%",
		    file.toStdString());
}

void VStudioWindow::ShowProposal()
{
	if (auto* const pShown = findChild<QDialog*>(QStringLiteral("ProposeTargets")))
	{
		pShown->raise();
		return pShown->activateWindow();
	}
	// Why there is none is told.
	if (m_pRetargetPanel && !m_pRetargetPanel->ProposeTargets(0.0).isEmpty())
		(new VProposeDialog(
		     *m_pRetargetPanel, m_pContext->GetSelectionManager()->Selection(), FolderOf(c_pPresetsFolderKey), this))
		    ->show();
}

void VStudioWindow::ShowRebind(bool i_bPerformer, bool i_bAsked)
{
	if (!m_pRetargetPanel)
		return;
	delete findChild<QDialog*>(QStringLiteral("Rebind"));
	const QVariantMap look = m_pRetargetPanel->LookAtRebind(i_bPerformer);
	// Nobody has asked for what has no answer.
	if (!look.isEmpty() && (i_bAsked || !look.contains("refusal")))
		(new VRebindDialog(*m_pRetargetPanel, i_bPerformer, look, this))->show();
	else if (i_bAsked)
		NVX_LOG("Command", NVX::ELogInformation, "Re-bind: there is nothing that %1% asks for",
		    i_bPerformer ? "the performer" : "the FBX file");
}

void VStudioWindow::ShowAlignment()
{
	if (auto* const pShown = findChild<QDialog*>(QStringLiteral("AlignToSource")))
	{
		pShown->raise();
		return pShown->activateWindow();
	}
	if (!m_pRetargetPanel)
		return;
	auto* const pDialog = new VAlignDialog(*m_pRetargetPanel, m_pContext->GetSelectionManager()->Selection(), this);
	if (pDialog->Align())
		return pDialog->show();
	m_pRetargetPanel->EndAlignment(false);
	delete pDialog;
}

void VStudioWindow::MakeHelpMenu()
{
	InitialiseHelp();
	QMenu& rMenu = *Named(menuBar()->addMenu(tr("&Help")), "HelpMenu", tr("Help"));
	AddAction(
	    rMenu, "OperatorPage", tr("&Operator's Page"), QKeySequence::HelpContents, [this] { ShowOperatorPage(); });
	AddAction(rMenu, "MouseAndKeys", tr("&Mouse and Keys"), QKeySequence(QStringLiteral("Shift+F1")),
	    [this] { ShowMouseAndKeys(); });
	AddAction(rMenu, "About", tr("&About"), {}, [this] { ShowAbout(); });
}

QList<QAction*> VStudioWindow::StartActions() const
{
	QList<QAction*> actions;
	for (const VOpenRow& rRow : c_OpenRows)
		actions << findChild<QAction*>(QLatin1String(rRow.m_pName));
	return actions << findChild<QAction*>(QStringLiteral("PreferencesAction"));
}

void VStudioWindow::AskAndOpen(int i_Kind)
{
	for (const VOpenRow& rRow : c_OpenRows)
	{
		if (int(rRow.m_Kind) != i_Kind)
			continue;
		const char* const pKey = TesselPluginInterface::c_FolderKeys[rRow.m_Folder];
		const QString file = QFileDialog::getOpenFileName(this, tr("Choose a file"), FolderOf(pKey),
		    DialogFilter(rRow.m_Kind) + QStringLiteral(";;") + tr("All files (*)"));
		if (!file.isEmpty())
			Open(file);
	}
}

QString VStudioWindow::AskWhereToSave(const QString& i_rFolder, const QString& i_rFilter, const QString& i_rExtension)
{
	QString file = i_rFolder;
	for (;;)
	{
		file = QFileDialog::getSaveFileName(
		    this, tr("Choose a file"), file, i_rFilter, nullptr, QFileDialog::DontConfirmOverwrite);
		// A file of another extension would be none that the dialogs show.
		if (!file.isEmpty() && !file.endsWith(i_rExtension, Qt::CaseInsensitive))
			file += i_rExtension;
		if (file.isEmpty() || !QFileInfo::exists(file)
		    || QMessageBox::warning(this, tr("Save As"),
		           tr("%1 is there already. Do you want to replace it?").arg(ShownFileName(file)),
		           QMessageBox::Yes | QMessageBox::No, QMessageBox::No)
		        == QMessageBox::Yes)
			return file;
	}
}

void VStudioWindow::UpdateRecentFiles()
{
	m_pRecentMenu->clear();
	int number = 0;
	for (const QString& rFile : m_pRecentFiles->Files())
	{
		++number;
		const bool bTake = rFile.startsWith(QLatin1String(VRecentFiles::c_pAsTake));
		const QString path = bTake ? rFile.mid(int(std::strlen(VRecentFiles::c_pAsTake))) : rFile;
		const QString text =
		    QStringLiteral("&%1  %2%3").arg(number % 10).arg(Verbatim(path), bTake ? tr(" (take)") : QString());
		AddAction(*m_pRecentMenu, "RecentFile", text, {},
		    [this, rFile, path, bTake]
		    {
			    if (bTake && QFileInfo::exists(path))
				    OpenTake(path);
			    else if (bTake || !Open(path))
				    m_pRecentFiles->Remove(rFile);
		    });
	}
	m_pRecentMenu->setEnabled(number > 0);
	if (number == 0)
		return;
	m_pRecentMenu->addSeparator();
	AddAction(*m_pRecentMenu, "ClearRecentFiles", tr("&Clear"), {}, [this] { m_pRecentFiles->Clear(); });
}

void VStudioWindow::FollowSelected()
{
	if (m_pFollow->isChecked() && m_pContext->GetSelectionManager()->Selection().Items().empty())
	{
		m_pFollow->setChecked(false);
		NVX_LOG("Command", NVX::ELogWarning,
		    "Follow Selected: Nothing is selected: select a segment first, as the hips of the character.");
	}
	if (m_pRetargetPanel)
		m_pRetargetPanel->FollowSelected(m_pFollow->isChecked());
}

void VStudioWindow::ShowMouseAndKeys()
{
	const bool bAltSelects = m_pContext->Preferences().Number(TesselPluginInterface::c_NavigationAltKey, 1) != 0;
	const auto with = [](bool i_bAlt, const QString& i_rText)
	{ return i_bAlt ? tr("Alt and %1").arg(i_rText) : i_rText; };
	const std::pair<QString, QString> rows[] = {{with(!bAltSelects, tr("left button, dragged")), tr("turns the view")},
	    {with(!bAltSelects, tr("left and right or middle button, dragged")), tr("moves the view")},
	    {with(!bAltSelects, tr("right button, dragged; or the wheel")), tr("goes nearer and farther")},
	    {tr("Ctrl+F"), tr("brings what is selected into the middle, or all where nothing is")},
	    {tr("Ctrl+L"), tr("lets the view go along with what is selected as a take plays, and ends it")},
	    {tr("click"), tr("selects what is under the mouse, and nothing else")},
	    {tr("Shift and click"), tr("adds it to what is selected")},
	    {tr("right button, clicked"), tr("opens a menu for what is under the mouse")},
	    {tr("Ctrl and click"), tr("adds it, or takes it away")}, {tr("Ctrl, Shift and click"), tr("takes it away")},
	    {with(bAltSelects, tr("left button, dragged")), tr("selects all in a rectangle")},
	    {tr("a ring, dragged"),
	        tr("turns the selected target segment: with Ctrl by steps of 45 degrees, with Shift "
	           "finely")},
	    {tr("an arrow or a square corner, dragged"), tr("moves the root of the target subject")},
	    {tr("Esc"), tr("ends a drag of the manipulator or a rectangle as if it had not begun")},
	    {tr("Ctrl+Z and Ctrl+Shift+Z"), tr("undo the last edit and do it again")},
	    {tr("space, left and right"),
	        tr("play the take that is open, or pause, and step; home and end go to its ends")},
	    {tr("Ctrl++ and Ctrl+-"), tr("make the manipulator larger and smaller")},
	    {tr("Alt+T and Alt+R"), tr("add a position and a rotation target")}};
	QString text = tr("<b>In the preview</b>") + QStringLiteral("<table cellpadding='3'>");
	for (const auto& [rInput, rEffect] : rows)
		text += QStringLiteral("<tr><td>%1</td><td>%2</td></tr>").arg(rInput.toHtmlEscaped(), rEffect.toHtmlEscaped());
	QMessageBox box(
	    QMessageBox::NoIcon, tr("Mouse and keys"), text + QStringLiteral("</table>"), QMessageBox::Close, this);
	box.setTextFormat(Qt::RichText);
	Named(&box, "MouseAndKeysBox", tr("Mouse and keys"));
	box.exec();
}

void VStudioWindow::UpdateSaveActions()
{
	const QString why = m_pRetargetPanel ? m_pRetargetPanel->WhyNotSave() : tr("no panel is open");
	const QString file = m_pRetargetPanel ? m_pRetargetPanel->CurrentFile() : QString();
	const std::tuple<const char*, QString, QString> rows[] = {{"New", tr("&New Retarget Subject"), {}},
	    {"Save", tr("&Save Retarget Subject"), file.isEmpty() ? tr("asks for a name") : QFileInfo(file).fileName()},
	    {"SaveAs", tr("Save Retarget Subject &As..."), {}}};
	for (const auto& [pName, rText, rNote] : rows)
	{
		auto* const pAction = findChild<QAction*>(QLatin1String(pName));
		const QString note = why.isEmpty() ? rNote : why;
		pAction->setText(note.isEmpty() ? rText : QStringLiteral("%1 (%2)").arg(rText, Verbatim(note)));
		pAction->setEnabled(why.isEmpty());
	}
}

void VStudioWindow::ShowOperatorPage()
{
	if (auto* const pShown = findChild<QDialog*>(QStringLiteral("OperatorPageWindow")))
	{
		pShown->raise();
		return pShown->activateWindow();
	}
	// Beside the work, not instead of it.
	auto* const pDialog = Named(new QDialog(this), "OperatorPageWindow", tr("The operator's page"));
	pDialog->setAttribute(Qt::WA_DeleteOnClose);
	pDialog->setWindowTitle(tr("Operator's Page"));
	auto* const pText = Named(new QTextBrowser, "OperatorPageText", tr("The operator's page"));
	// Its links lead to the pages beside it.
	pText->setSource(QUrl(QStringLiteral("qrc:/help/operator.md")), QTextDocument::MarkdownResource);
	auto* const pLayout = new QVBoxLayout(pDialog);
	pLayout->setContentsMargins(0, 0, 0, 0);
	pLayout->addWidget(pText);
	pDialog->resize(640, 720);
	pDialog->show();
}

void VStudioWindow::ShowAbout()
{
	QMessageBox box(QMessageBox::NoIcon, tr("About"),
	    tr("<b>Retarget Studio %1</b><p>Relates a performer's skeleton to a character's, and saves the retarget "
	       "subject "
	       "that a real-time solver moves the character by.</p>")
	        .arg(QStringLiteral(RETARGET_VERSION)),
	    QMessageBox::Close, this);
	box.setTextFormat(Qt::RichText);
	Named(&box, "AboutBox", tr("About"));
	box.exec();
}

} // namespace StudioHost
