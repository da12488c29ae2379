#include "studio/window/ReportRun.h"

#include "DebugServices/GlobalLog.h"
#include "studio/host/UnsavedWork.h"
#include "studio/panel/RetargetPanel.h"
#include "studio/window/Named.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QJsonDocument>
#include <QJsonValue>
#include <QProgressDialog>

namespace StudioHost
{
namespace
{

/// Milliseconds until a page that is being written says so, and until a program that was told to end is ended.
constexpr int c_QuickPage = 300;
constexpr int c_SlowEnd = 3000;

} // namespace

QString VReportRun::Program()
{
	const QDir here(QCoreApplication::applicationDirPath());
	for (const char* const pPlace : {RETARGET_PROGRAM_IN_BUILD, "retarget"})
		if (const QFileInfo program(here.filePath(QLatin1String(pPlace))); program.isFile() && program.isExecutable())
			return QDir::cleanPath(program.filePath());
	return {};
}

VReportRun::VReportRun(VRetargetPanel& i_rPanel, const QString& i_rTake, const QString& i_rOut, QWidget& i_rWindow)
    : QObject(&i_rWindow), m_Out(i_rOut)
{
	setObjectName(QStringLiteral("ReportRun"));
	auto* const pWait = Named(new QProgressDialog(tr("Writing the report..."), tr("Cancel"), 0, 0, &i_rWindow),
	    "ReportProgress", tr("The report is being written"));
	pWait->setWindowTitle(tr("Write Report"));
	pWait->setAutoReset(false);
	pWait->setAutoClose(false);
	pWait->setValue(0);
	pWait->setMinimumDuration(c_QuickPage);
	connect(this, &QObject::destroyed, pWait, &QObject::deleteLater);
	connect(pWait, &QProgressDialog::canceled, this,
	    [this]
	    {
		    m_bGivenUp = true;
		    m_Process.terminate();
	    });
	connect(&m_Process, qOverload<int, QProcess::ExitStatus>(&QProcess::finished), this, [this] { Tell(true); });
	connect(&m_Process, &QProcess::errorOccurred, this,
	    [this](QProcess::ProcessError i_Error)
	    {
		    if (i_Error == QProcess::FailedToStart)
			    Tell(false);
	    });

	const VUnsavedWork work = i_rPanel.Work();
	const QString name = work.m_File.isEmpty() ? QStringLiteral("unsaved") : QFileInfo(work.m_File).completeBaseName();
	const QString copy = m_Folder.filePath(name + QStringLiteral(".qrr"));
	// Why it was not written is told.
	if (!m_Folder.isValid() || !i_rPanel.WriteCopy(copy))
	{
		Tell(false);
		return;
	}
	QStringList arguments{QStringLiteral("report"), QStringLiteral("--json"), QStringLiteral("-q")};
	for (const auto& [pOption, rFile] :
	    {std::pair("--source", work.m_Source), {"--fbx", work.m_Fbx}, {"--take", i_rTake}, {"-o", m_Out}})
		if (!rFile.isEmpty())
			arguments << QLatin1String(pOption) << rFile;
	m_Process.setStandardInputFile(QProcess::nullDevice());
	m_Process.start(Program(), arguments << QStringLiteral("--") << copy);
}

VReportRun::~VReportRun()
{
	m_Process.disconnect(this);
	if (m_Process.state() == QProcess::NotRunning)
		return;
	m_Process.terminate();
	m_Process.waitForFinished(c_SlowEnd);
}

void VReportRun::Tell(bool i_bEnded)
{
	deleteLater();
	const std::string out = m_Out.toStdString();
	if (m_bGivenUp)
	{
		NVX_LOG("Command", NVX::ELogInformation, "Write Report: cancelled, nothing was written to %1%", out);
		return;
	}
	if (!i_bEnded || m_Process.exitStatus() != QProcess::NormalExit || m_Process.exitCode() != 0)
	{
		const QString why = QString::fromUtf8(m_Process.readAllStandardError()).trimmed();
		NVX_LOG("Command", NVX::ELogError, "Write Report: nothing was written to %1%. %2%", out,
		    why.isEmpty() ? (i_bEnded ? "The program retarget broke off." : "It could not be begun.")
		                  : why.section('\n', -1).toStdString());
		return;
	}
	const auto told = QJsonDocument::fromJson(m_Process.readAllStandardOutput());
	const int pictures = told["pictures"].toInt();
	if (const QString why = told["noPictures"].toString(); !why.isEmpty())
		NVX_LOG("Command", NVX::ELogWarning, "Write Report: pictures are left out. %1%", why.toStdString());
	NVX_LOG("Command", NVX::ELogInformation, "The report was written to %1%, with %2% pictures", out, pictures);
}

} // namespace StudioHost

#include "moc_ReportRun.cpp"
