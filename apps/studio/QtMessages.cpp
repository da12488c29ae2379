#include "studio/QtMessages.h"

#include "DebugServices/GlobalLog.h"

#include <QString>
#include <QtGlobal>

#include <cstdio>

namespace StudioHost
{
namespace
{

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

void Handle(QtMsgType i_Type, const QMessageLogContext&, const QString& i_rText)
{
	// The program ends before a list could show it.
	if (i_Type == QtFatalMsg)
		std::fprintf(stderr, "error Qt: %s\n", qPrintable(i_rText));
	else
		NVX_LOG("Qt", LevelOf(i_Type), "%1%", i_rText.toStdString());
}

} // namespace

void SendQtMessagesToLog()
{
	qInstallMessageHandler(Handle);
}

} // namespace StudioHost
