#include "CoreOrlexQRTIO/Writer.h"
#include "TakeSolve/Performer.h"
#include "TesselPluginInterface/IPreferenceFolders.h"
#include "TesselPluginInterface/PathTypes.h"
#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/SaveFile.h"
#include "studio/host/Preferences.h"
#include "studio/host/Services.h"
#include "studio/host/UnsavedWork.h"
#include "studio/motion/MotionPanel.h"
#include "studio/panel/FileKind.h"
#include "studio/panel/RecentFiles.h"
#include "studio/panel/RetargetPanel.h"
#include "studio/window/Named.h"
#include "studio/window/StudioWindow.h"

#include <QAction>
#include <QDockWidget>
#include <QFileDialog>
#include <QMenu>
#include <QPointer>
#include <QTimer>

// The dock that plays a take.

namespace StudioHost
{
namespace
{

/// In pixels, when it is first shown: the controls and a dozen targets.
constexpr int c_MotionHeight = 300;

} // namespace

void VStudioWindow::MakeMotionDock()
{
	m_pMotion = new VMotionPanel(*m_pContext, *findChild<QAction*>(QStringLiteral("OpenTake")));
	m_pMotion->m_AskCharacter = [this] { return m_pRetargetPanel ? m_pRetargetPanel->Work().m_Fbx : QString(); };
	connect(m_pMotion, &VMotionPanel::makePerformerAsked, this, &VStudioWindow::MakePerformer);
	m_pMotionDock = Named(new QDockWidget(tr("Motion"), this), "MotionDock", tr("Motion"));
	m_pMotionDock->setAcceptDrops(true);
	m_pMotionDock->setWidget(m_pMotion);
	addDockWidget(Qt::BottomDockWidgetArea, m_pMotionDock);
	m_pMotionDock->hide();
	m_pPanelMenu->addAction(m_pMotionDock->toggleViewAction());

	VApplicationObject& rApplication = m_pContext->Application();
	rApplication.m_Show = [pPlayer = QPointer<VTakePlayer>(&m_pMotion->Player())](
	                          const NVX::CountedPointer<TesselPluginInterface::IFlowFrame>& i_rpDocument)
	{ return pPlayer ? pPlayer->Shown(i_rpDocument) : nullptr; };
	connect(&Motion(), &VTakePlayer::shownChanged, this, [&rApplication] { rApplication.ShownChangedSignal().Fire(); });
	connect(&Motion(), &VTakePlayer::stateChanged, this,
	    [this]
	    {
		    if (m_pRetargetPanel)
			    m_pRetargetPanel->SetViewInUse(Motion().IsShown());
	    });
	connect(&Motion(), &VTakePlayer::opened, m_pRecentFiles.get(), &VRecentFiles::AddTake);
}

VTakePlayer& VStudioWindow::Motion()
{
	return m_pMotion->Player();
}

void VStudioWindow::OpenTake(const QString& i_rPath, std::size_t i_Frame)
{
	if (m_pMotionDock->isHidden())
	{
		m_pMotionDock->show();
		// Behind what a window that is just shown does with its docks.
		QTimer::singleShot(0, this,
		    [this]
		    {
			    if (!m_pMotionDock->isFloating() && m_pMotionDock->height() < c_MotionHeight)
				    resizeDocks({m_pMotionDock}, {c_MotionHeight}, Qt::Vertical);
		    });
	}
	m_pMotionDock->raise();
	Motion().Open(i_rPath, i_Frame);
}

void VStudioWindow::MakePerformer()
{
	if (!Motion().Take())
		return;
	const QString name = QFileInfo(Motion().Path()).completeBaseName();
	const char* const pKey = TesselPluginInterface::c_FolderKeys[TesselPluginInterface::EPathSubjects];
	QFileDialog dialog(this, tr("Choose a file"),
	    QString::fromStdString(UtilsFileSystem::ToUtf8(m_pContext->Preferences().Folder(pKey))),
	    DialogFilter(EFileKind::ESource));
	dialog.setAcceptMode(QFileDialog::AcceptSave);
	dialog.setDefaultSuffix(QStringLiteral("qrs"));
	dialog.selectFile(name + QStringLiteral(".qrs"));
	if (dialog.exec() != QDialog::Accepted || !Motion().Take())
		return;
	const QString path = dialog.selectedFiles().value(0);
	// What it lacks was told when it began to play.
	std::vector<TakeSolve::VFinding> findings;
	auto record = TakeSolve::MakePerformer(
	    *Motion().Take(), TakeSolve::StandingPose(*Motion().Take()), name.toStdString(), findings);
	record.m_SubjectParametrised.m_Model = record.m_SubjectParametrised.m_Name;
	std::string text, error;
	std::vector<std::string> errors, warnings;
	if (!CoreOrlexQRTIO::VWriter().WriteText(record.m_SubjectParametrised, record.m_SubjectApplicationData, {},
	        CoreOrlexQRTIO::c_AutomaticVersion, text, errors, warnings))
		error = errors.empty() ? std::string() : errors.front();
	else if (UtilsFileSystem::SaveFile(UtilsFileSystem::PathFromUtf8(path.toStdString()), text, error) == 0)
	{
		Open(path);
		return;
	}
	m_pMotion->Tell(tr("The performer's skeleton is not saved. %1").arg(QString::fromStdString(error)));
}

void VStudioWindow::AskAndOpenTake()
{
	const QString folder =
	    QString::fromStdString(UtilsFileSystem::ToUtf8(m_pContext->Preferences().Folder(c_pTakesFolderKey)));
	const QString file = QFileDialog::getOpenFileName(this, tr("Choose a file"), folder,
	    tr("Takes (*.bvh *.BVH *.fbx *.FBX)") + QStringLiteral(";;") + tr("All files (*)"));
	if (!file.isEmpty())
		OpenTake(file);
}

} // namespace StudioHost
