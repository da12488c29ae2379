#include "retarget/picture/Renderer.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QProcess>

namespace CommandLine
{

EExitStatus RunRenderer(const std::vector<std::string>& i_rArguments)
{
	// Only an application knows where its program lies.
	int count = 1;
	char name[] = "retarget";
	char* pArguments[] = {name, nullptr};
	const QCoreApplication application(count, pArguments);
	const QDir here(QCoreApplication::applicationDirPath());
	QString program;
	for (const char* const pPlace : {RETARGET_RENDER_IN_BUILD, RETARGET_RENDER_INSTALLED})
		if (const QString path = QDir::cleanPath(here.filePath(QLatin1String(pPlace)));
		    program.isEmpty() && QFileInfo(path).isExecutable())
			program = path;
	if (program.isEmpty())
		throw VCommandError(
		    EBadOutput, "The program that draws, retarget-render, is not in its place: build or install it");

	QStringList arguments;
	for (const std::string& rArgument : i_rArguments)
		arguments << QFile::decodeName(rArgument.c_str());
	QProcess process;
	process.setProcessChannelMode(QProcess::ForwardedChannels);
	// The subject may come that way.
	process.setInputChannelMode(QProcess::ForwardedInputChannel);
	process.start(program, arguments);
	if (!process.waitForFinished(-1))
		throw VCommandError(EBadOutput, "\"" + program.toStdString() + "\" cannot be started");
	if (process.exitStatus() == QProcess::CrashExit)
		throw VCommandError(
		    EBadOutput, "The display's OpenGL failed while it drew; LIBGL_ALWAYS_SOFTWARE=1 draws without its driver");
	return static_cast<EExitStatus>(process.exitCode());
}

} // namespace CommandLine
