#include "studio/window/StudioWindow.h"

#include "DebugServices/GlobalLog.h"
#include "TesselPluginInterface/PathTypes.h"
#include "studio/host/ApplicationObject.h"
#include "studio/host/Module.h"
#include "studio/host/Services.h"
#include "studio/log/LogModel.h"
#include "studio/log/LogPanel.h"
#include "studio/motion/MotionPanel.h"
#include "studio/panel/FileKind.h"
#include "studio/panel/PanelCommands.h"
#include "studio/panel/RecentFiles.h"
#include "studio/panel/RetargetPanel.h"
#include "studio/panel/WorkKeeper.h"
#include "studio/window/FileDrop.h"
#include "studio/window/Named.h"
#include "studio/window/PlainTexts.h"
#include "studio/window/PreferencesDialog.h"
#include "studio/window/SkinProgress.h"

#include <QAction>
#include <QCloseEvent>
#include <QDialog>
#include <QDir>
#include <QDockWidget>
#include <QFileInfo>
#include <QLabel>
#include <QLocale>
#include <QMenu>
#include <QMenuBar>
#include <QMessageBox>
#include <QPushButton>
#include <QTimer>

namespace StudioHost
{
namespace
{

/// Raised when docks change so that an old layout does not fit them.
constexpr int c_LayoutVersion = 1;
/// So many messages are seen before anybody has moved the log.
constexpr int c_LogLines = 4;
const QString c_Title = QStringLiteral("Retarget Studio");
const QString c_GeometryKey = QStringLiteral("Window/Geometry");
const QString c_StateKey = QStringLiteral("Window/State");

} // namespace

VStudioWindow::VStudioWindow(QSettings& i_rSettings, bool i_bDeveloper, QWidget* i_pParent)
    : QMainWindow(i_pParent), m_rSettings(i_rSettings), m_pDispatcher(std::make_shared<VQtDispatcher>()),
      m_pLog(std::make_unique<VLogModel>(m_pDispatcher)), m_pRecentFiles(std::make_unique<VRecentFiles>(m_rSettings)),
      m_pContext(std::make_unique<VPluginContext>(m_rSettings, m_pDispatcher)),
      m_pGui(std::make_unique<VPluginGui>(
          *this, *m_pContext, i_bDeveloper, [this](const QString& i_rCommand) { return Execute(i_rCommand); }))
{
	Named(this, "StudioWindow", tr("Retarget Studio"));
	setWindowTitle(c_Title);
	setAcceptDrops(true);
	new VPlainTexts(this);
	std::dynamic_pointer_cast<VApplicationObject>(m_pContext->GetApplicationObject())->m_AskToOverwrite =
	    [this](const std::string& i_rPath) { return MayOverwrite(i_rPath); };
	setDockNestingEnabled(true);
	// Docks stand where they belong at once.
	setAnimated(false);

	m_pNotice = Named(new QLabel, "Notice", tr("Why there is no panel"));
	m_pNotice->setAlignment(Qt::AlignCenter);
	m_pNotice->setWordWrap(true);
	m_pNotice->setMargin(40);
	m_pNotice->setTextInteractionFlags(Qt::TextSelectableByMouse);
	setCentralWidget(m_pNotice);
	Say(tr("No module is loaded"));

	m_pLogDock = Named(new QDockWidget(tr("Log"), this), "LogDock", tr("Log"));
	m_pLogDock->setAcceptDrops(true);
	auto* const pLogPanel = new VLogPanel(*m_pLog);
	connect(pLogPanel, &VLogPanel::messageClicked, this, &VStudioWindow::SelectNamedIn);
	m_pLogDock->setWidget(pLogPanel);
	m_pLogDock->setSizePolicy(QSizePolicy::Preferred, QSizePolicy::Maximum);
	addDockWidget(Qt::BottomDockWidgetArea, m_pLogDock);

	m_pContext->Application().m_AskToReplace = [this](const std::string& i_rAction)
	{ return MayLoseChanges(QString::fromStdString(i_rAction)); };

	MakeMenus(i_bDeveloper);
	MakeMotionDock();
	new VFileDrop(
	    *this, *m_pMotionDock,
	    [this](const QStringList& i_rFiles)
	    {
		    if (m_pRetargetPanel)
			    m_pRetargetPanel->MarkDrop(i_rFiles);
	    },
	    // On the dock an FBX file is motion, elsewhere a character.
	    [this](const QString& i_rFile, bool i_bOnMotion)
	    { i_bOnMotion&& KindOf(i_rFile) == EFileKind::EFbx ? OpenTake(i_rFile) : void(Open(i_rFile)); });
	menuBar()->setCornerWidget(new VSkinProgress(m_pGui->GetSkinCache(), m_pDispatcher));
	resize(1280, 800);
}

VStudioWindow::~VStudioWindow()
{
	UnloadModule();
	// They show what goes before the window's children do.
	delete m_pLogDock;
	delete m_pMotionDock;
}

bool VStudioWindow::LoadModule(const QString& i_rPath)
{
	UnloadModule();
	QString why;
	std::unique_ptr<VModule> pModule = VModule::Load(i_rPath, why);
	if (pModule && !pModule->CreateContent(*m_pContext, *m_pGui))
	{
		why = tr("%1 could not make its panels").arg(pModule->Path());
		m_pGui->PanelManager().Clear();
		pModule.reset();
	}
	if (!pModule)
	{
		NVX_LOG("System", NVX::ELogError, "No module is loaded: %1%", why.toStdString());
		Say(tr("No module is loaded: %1").arg(why));
		return false;
	}
	NVX_LOG("System", NVX::ELogInformation, "Module %1% is loaded", pModule->Path().toStdString());
	m_pModule = std::move(pModule);

	const QList<QDockWidget*> docks = m_pGui->PanelManager().Docks();
	for (QDockWidget* pDock : docks)
		m_pPanelMenu->addAction(pDock->toggleViewAction());
	for (QWidget* pPanel : m_pGui->PanelManager().Panels())
		if (!m_pRetargetPanel)
			m_pRetargetPanel = VRetargetPanel::Find(*pPanel, m_pContext->GetParameterRegistry());
	if (m_pRetargetPanel)
	{
		connect(m_pRetargetPanel.get(), &VRetargetPanel::fileUsed, m_pRecentFiles.get(), &VRecentFiles::Add);
		connect(m_pRetargetPanel.get(), &VRetargetPanel::saveFailed, this, &VStudioWindow::ShowSaveFailure);
		connect(m_pRetargetPanel.get(), &VRetargetPanel::stateChanged, this, &VStudioWindow::UpdateTitle);
		// A view that was made anew follows nothing.
		connect(m_pRetargetPanel.get(), &VRetargetPanel::ready, m_pFollow, [this] { m_pFollow->setChecked(false); });
		connect(
		    m_pRetargetPanel.get(), &VRetargetPanel::rebindCalledFor, this,
		    [this](bool i_bPerformer) { ShowRebind(i_bPerformer, false); }, Qt::QueuedConnection);
		// Beside the settings, which are another user's or test's elsewhere.
		m_pWorkKeeper = std::make_unique<VWorkKeeper>(*m_pRetargetPanel,
		    QFileInfo(m_rSettings.fileName()).absoluteDir().filePath(QStringLiteral("unsaved-work")));
		m_pRetargetPanel->OfferToBegin(StartActions());
		m_pMotion->TakeKeysOf(
		    *m_pRetargetPanel->Widget(), [this] { return m_pRetargetPanel && m_pRetargetPanel->ViewHasKeyboard(); });
	}
	UpdateTitle();
	m_pNotice->setVisible(docks.isEmpty());
	// Below a panel it keeps its height when the window grows; in an area of its own it would not.
	if (!docks.isEmpty())
		splitDockWidget(docks.front(), m_pLogDock, Qt::Vertical);
	tabifyDockWidget(m_pLogDock, m_pMotionDock);
	return true;
}

void VStudioWindow::UnloadModule()
{
	m_pWorkKeeper.reset();
	for (const char* const pDialog : {"ProposeTargets", "AlignToSource", "Rebind"})
		delete findChild<QDialog*>(QLatin1String(pDialog));
	m_pRetargetPanel.reset();
	UpdateTitle();
	m_pGui->PanelManager().Clear();
	if (!m_pModule)
		return;
	m_pModule.reset();
	Say(tr("No module is loaded"));
}

bool VStudioWindow::Open(const QString& i_rPath)
{
	if (m_pRetargetPanel && KindOf(i_rPath) == EFileKind::ETake)
	{
		OpenTake(i_rPath);
		return true;
	}
	if (m_pRetargetPanel)
		return m_pRetargetPanel->Open(i_rPath);
	NVX_LOG("Import", NVX::ELogError, "%1% cannot be opened: no module with a retarget panel is loaded",
	    i_rPath.toStdString());
	return false;
}

bool VStudioWindow::Execute(const QString& i_rCommand)
{
	return RunCommand(m_pGui->PanelManager().Panels(), i_rCommand);
}

void VStudioWindow::OfferLeftWork()
{
	if (!m_pWorkKeeper)
		return;
	for (const VUnsavedWork& rWork : m_pWorkKeeper->Left())
	{
		const QString file =
		    rWork.m_File.isEmpty() ? tr("a retarget subject that was in no file yet") : ShownText(rWork.m_File);
		QMessageBox box(QMessageBox::Question, c_Title,
		    tr("Retarget Studio did not end cleanly, and work was not saved: %1").arg(file),
		    QMessageBox::Open | QMessageBox::Discard | QMessageBox::Cancel, this);
		QStringList lines{tr("Targets: %1, kept at %2")
		                      .arg(rWork.m_Targets)
		                      .arg(QLocale().toString(rWork.m_Time.toLocalTime(), QLocale::ShortFormat))};
		if (!rWork.m_Source.isEmpty())
			lines << tr("Performer: %1").arg(ShownText(rWork.m_Source));
		if (!rWork.m_Fbx.isEmpty())
			lines << tr("Character: %1").arg(ShownText(rWork.m_Fbx));
		box.setInformativeText(lines.join('\n'));
		Named(&box, "LeftWork", box.text());
		box.button(QMessageBox::Open)->setText(tr("&Take It Up Again"));
		box.button(QMessageBox::Cancel)->setText(tr("Ask &Later"));
		box.setDefaultButton(QMessageBox::Open);
		const int answer = box.exec();
		if (answer == QMessageBox::Discard)
			VUnsavedWorkFolder::Discard(rWork);
		// What else is left would take its place.
		else if (answer == QMessageBox::Open && m_pWorkKeeper->Restore(rWork))
			return;
	}
}

void VStudioWindow::RestoreLayout()
{
	restoreGeometry(m_rSettings.value(c_GeometryKey).toByteArray());
	m_bArranged = restoreState(m_rSettings.value(c_StateKey).toByteArray(), c_LayoutVersion);
}

void VStudioWindow::ShowPreferences()
{
	VPreferencesDialog(m_pContext->Preferences(), this).exec();
}

void VStudioWindow::showEvent(QShowEvent* i_pEvent)
{
	QMainWindow::showEvent(i_pEvent);
	if (m_pRetargetPanel)
		m_pRetargetPanel->FocusFirstField();
	// The layout has its size only now.
	if (!std::exchange(m_bArranged, true))
		QTimer::singleShot(0, this,
		    [this]
		    {
			    const auto& rLog = *qobject_cast<const VLogPanel*>(m_pLogDock->widget());
			    resizeDocks({m_pLogDock}, {m_pLogDock->height() + rLog.HeightMissingTo(c_LogLines)}, Qt::Vertical);
		    });
}

void VStudioWindow::closeEvent(QCloseEvent* i_pEvent)
{
	if (!MayLoseChanges(tr("Quit")))
		return i_pEvent->ignore();
	m_rSettings.setValue(c_GeometryKey, saveGeometry());
	m_rSettings.setValue(c_StateKey, saveState(c_LayoutVersion));
	QMainWindow::closeEvent(i_pEvent);
}

bool VStudioWindow::MayLoseChanges(const QString& i_rAction)
{
	if (!m_pRetargetPanel)
		return true;
	m_pRetargetPanel->ApplyTyped();
	if (!m_pRetargetPanel->HasUnsavedChanges())
		return true;
	const QString file = ShownFileName(m_pRetargetPanel->CurrentFile());
	QMessageBox box(QMessageBox::Warning, c_Title,
	    (file.isEmpty() ? tr("The retarget subject has changes that are in no file.")
	                    : tr("%1 has changes that are not saved.").arg(file)),
	    QMessageBox::Save | QMessageBox::Discard | QMessageBox::Cancel, this);
	box.setInformativeText(tr("\"%1\" would lose them.").arg(i_rAction));
	Named(&box, "UnsavedChanges", box.text());
	box.setDefaultButton(QMessageBox::Save);
	switch (box.exec())
	{
	case QMessageBox::Discard: return true;
	case QMessageBox::Save: return SaveChanges();
	default: return false;
	}
}

bool VStudioWindow::SaveChanges()
{
	QString file = m_pRetargetPanel->CurrentFile();
	if (file.isEmpty() || m_pRetargetPanel->IsCurrentFileReadOnly())
		file = AskWhereToSave(FolderOf(TesselPluginInterface::c_FolderKeys[TesselPluginInterface::EPathRetargets]),
		    tr("Subject files (*.qrr)"), QStringLiteral(".qrr"));
	if (file.isEmpty())
		return false;
	m_pRetargetPanel->SaveTo(file);
	return !m_pRetargetPanel->HasUnsavedChanges();
}

void VStudioWindow::ShowSaveFailure(const QString& i_rReason)
{
	auto* const pBox = Named(new QMessageBox(QMessageBox::Critical, c_Title, tr("The retarget subject is not saved."),
	                             QMessageBox::Ok, this),
	    "SaveFailure", tr("The retarget subject is not saved."));
	pBox->setInformativeText(i_rReason);
	pBox->setAttribute(Qt::WA_DeleteOnClose);
	pBox->open();
}

void VStudioWindow::UpdateTitle()
{
	const bool bUnsaved = m_pRetargetPanel && m_pRetargetPanel->HasUnsavedChanges();
	QString file = m_pRetargetPanel ? ShownFileName(m_pRetargetPanel->CurrentFile()) : QString();
	if (file.isEmpty() && bUnsaved)
		file = tr("New retarget subject");
	// Where the mark stands; in a name it is no mark.
	file.replace(QStringLiteral("[*]"), QStringLiteral("[*][*]"));
	setWindowTitle(file.isEmpty() ? c_Title : QStringLiteral("%1[*] - %2").arg(file, c_Title));
	setWindowModified(bUnsaved);
}

bool VStudioWindow::MayOverwrite(const std::string& i_rPath)
{
	QMessageBox box(QMessageBox::Warning, windowTitle(),
	    tr("%1 was changed by another program since it was last loaded or saved here. Overwrite it?")
	        .arg(ShownText(QString::fromStdString(i_rPath))),
	    QMessageBox::Save | QMessageBox::Cancel, this);
	Named(&box, "ChangedFile", box.text());
	box.button(QMessageBox::Save)->setText(tr("&Overwrite"));
	box.setDefaultButton(QMessageBox::Cancel);
	return box.exec() == QMessageBox::Save;
}

void VStudioWindow::SelectNamedIn(const QString& i_rMessage)
{
	const auto items =
	    m_pRetargetPanel ? m_pRetargetPanel->ItemsNamedIn(i_rMessage) : std::vector<NVX::ISelectionItem>();
	if (!items.empty())
		m_pContext->GetSelectionManager()->Selection().Replace(items);
}

void VStudioWindow::Say(const QString& i_rText)
{
	m_pNotice->setText(i_rText);
	m_pNotice->show();
}

} // namespace StudioHost

#include "moc_StudioWindow.cpp"
