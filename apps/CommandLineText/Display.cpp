#include "CommandLineText/Display.h"

#include "CommandLineText/Messages.h"

#include <QByteArray>
#include <QString>
#include <QtGlobal>

#include <cstdlib>

namespace CommandLine
{
namespace
{

VWithoutDisplay s_Without{c_pCategory, EBadOutput, ""};

int LevelOf(QtMsgType i_Type)
{
	switch (i_Type)
	{
	case QtDebugMsg: return NVX::ELogDetail;
	case QtInfoMsg: return NVX::ELogInformation;
	case QtWarningMsg: return NVX::ELogWarning;
	default: return NVX::ELogError;
	}
}

void HandleQtMessage(QtMsgType i_Type, const QMessageLogContext& i_rContext, const QString& i_rText)
{
	if (i_Type != QtFatalMsg)
	{
		// What Qt says to itself is nothing that an operator could mend. Sessions without that folder, such as a job of
		// cron, are no worse for it.
		const bool bNoMatter = QByteArray(i_rContext.category).startsWith("qt.")
		    || i_rText.startsWith(QLatin1String("QStandardPaths: XDG_RUNTIME_DIR not set"));
		NVX_LOG("Qt", bNoMatter ? NVX::ELogDetail : LevelOf(i_Type), "%1%", i_rText.toStdString());
		return;
	}
	// The program ends before a list could show it.
	const auto tell = [](const char* i_pCategory, const std::string& i_rMessage)
	{
		ReleaseMessages();
		PrintMessage(NVX::GlobalLog::Category(i_pCategory), NVX::ELogError, i_rMessage);
	};
	if (i_rText.contains(QLatin1String("no Qt platform plugin could be initialized")))
	{
		tell(s_Without.m_pCategory, s_Without.m_pSentence);
		std::_Exit(s_Without.m_Status);
	}
	tell("Qt", i_rText.toStdString());
}

} // namespace

void PrepareDisplay(const VWithoutDisplay& i_rWithout)
{
	s_Without = i_rWithout;
	bool bNamed = false;
	for (const char* const pName : {"DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM"})
		bNamed |= !qEnvironmentVariableIsEmpty(pName);
	if (!bNamed)
		throw VCommandError(i_rWithout.m_Status, i_rWithout.m_pSentence);
	qInstallMessageHandler(HandleQtMessage);
}

} // namespace CommandLine
