// What the window tells of the target subject as it stands, beside the dialogs that change it.

#include "DebugServices/GlobalLog.h"
#include "TesselPluginInterface/PathTypes.h"
#include "studio/host/Services.h"
#include "studio/motion/TakePlayer.h"
#include "studio/panel/FileKind.h"
#include "studio/panel/RetargetPanel.h"
#include "studio/window/PlainTexts.h"
#include "studio/window/ReportRun.h"
#include "studio/window/ReviewDialog.h"
#include "studio/window/StudioWindow.h"

#include <QFileDialog>
#include <QFileInfo>

#include <memory>

namespace StudioHost
{
namespace
{

/// @param i_rReview empty if there is nothing to tell.
bool ShowIn(VReviewDialog& io_rShown, const QVariantMap& i_rReview)
{
	if (!i_rReview.isEmpty())
		io_rShown.Show(i_rReview);
	return !i_rReview.isEmpty();
}

} // namespace

void VStudioWindow::ShowReview(const VReview& i_rReview)
{
	delete findChild<QDialog*>(QLatin1String(i_rReview.m_pName));
	auto pDialog = std::make_unique<VReviewDialog>(
	    i_rReview, *m_pRetargetPanel, m_pContext->GetSelectionManager()->Selection(), this);
	// Why there is nothing to show is told.
	if (pDialog->Look())
		pDialog.release()->show();
}

void VStudioWindow::AskAndCompare()
{
	if (!m_pRetargetPanel)
		return;
	const QString file = QFileDialog::getOpenFileName(this, tr("Choose the file to compare with"),
	    FolderOf(TesselPluginInterface::c_FolderKeys[TesselPluginInterface::EPathRetargets]),
	    DialogFilter(EFileKind::ETarget));
	if (!file.isEmpty())
		CompareWith(file);
}

void VStudioWindow::CompareWithSaved()
{
	const QString file = m_pRetargetPanel ? m_pRetargetPanel->CurrentFile() : QString();
	file.isEmpty() ? AskAndCompare() : CompareWith(file);
}

void VStudioWindow::CompareWith(const QString& i_rPath)
{
	ShowReview({"Compare", tr("Compare with %1").arg(ShownFileName(i_rPath)), {tr("What differs")}, 0,
	    [this, i_rPath](VReviewDialog& io_rShown)
	    { return ShowIn(io_rShown, m_pRetargetPanel->CompareWith(i_rPath)); }});
}

void VStudioWindow::ShowAdvice()
{
	if (m_pRetargetPanel)
		ShowReview(
		    {"Advice", tr("Advice"), {tr("Joint or target"), tr("Verdict"), tr("Bind pose without it"), tr("Why")}, 3,
		        [this](VReviewDialog& io_rShown)
		        {
			        connect(m_pRetargetPanel.get(), &VRetargetPanel::advised, &io_rShown, &VReviewDialog::Show,
			            Qt::UniqueConnection);
			        return m_pRetargetPanel->Advise();
		        },
		        tr("&Remove This Joint"),
		        [this](const QVariantMap& i_rRow) { m_pRetargetPanel->RemoveJoint(i_rRow["joint"].toInt()); },
		        QStringLiteral("joint")});
}

void VStudioWindow::ShowPoseCheck()
{
	if (m_pRetargetPanel)
		ShowReview({"PoseCheck", tr("Check Pose"), {tr("What"), tr("Looks"), tr("How the two stand"), tr("Mended by")},
		    2, [this](VReviewDialog& io_rShown) { return ShowIn(io_rShown, m_pRetargetPanel->CheckPose()); },
		    tr("&Align to Source..."), [this](const QVariantMap&) { ShowAlignment(); }});
}

void VStudioWindow::WriteReport()
{
	const auto refuse = [](const QString& i_rWhy)
	{ NVX_LOG("Command", NVX::ELogWarning, "Write Report: %1%", i_rWhy.toStdString()); };
	const QString why = m_pRetargetPanel ? m_pRetargetPanel->WhyNotSave() : tr("no panel is open");
	if (!why.isEmpty())
		return refuse(why);
	if (VReportRun::Program().isEmpty())
		return refuse(tr("the program retarget, which writes it, does not stand beside this one: install it"));
	const QString file =
	    AskWhereToSave(FolderOf(TesselPluginInterface::c_FolderKeys[TesselPluginInterface::EPathRetargets]),
	        tr("Pages (*.html)"), QStringLiteral(".html"));
	if (file.isEmpty())
		return;
	// One at a time.
	delete findChild<VReportRun*>();
	new VReportRun(*m_pRetargetPanel, Motion().Path(), file, *this);
}

} // namespace StudioHost
