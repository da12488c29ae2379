// From the start of the process to the first picture on the screen: the studio empty and with its last files, and a
// bare window, in turns. What a run takes least of the clock and of the processor is compared.
#include <QCoreApplication>
#include <QFile>
#include <QProcess>
#include <QTemporaryDir>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <ctime>

namespace
{

struct VStart
{
	const char* m_pName;
	QString m_Program;
	QStringList m_Arguments;
	double m_Clock = 1e9;
	double m_Processor = 1e9;
};

bool Run(VStart& io_rStart)
{
	timespec begin{};
	clock_gettime(CLOCK_MONOTONIC, &begin);
	QProcess process;
	process.setProcessChannelMode(QProcess::ForwardedErrorChannel);
	process.start(io_rStart.m_Program, io_rStart.m_Arguments);
	if (!process.waitForFinished(-1) || process.exitCode() != 0)
		return false;
	const QList<QByteArray> told = process.readAllStandardOutput().simplified().split(' ');
	if (told.size() != 2)
		return false;
	io_rStart.m_Clock =
	    std::min(io_rStart.m_Clock, told[0].toDouble() - (double(begin.tv_sec) + 1e-9 * double(begin.tv_nsec)));
	io_rStart.m_Processor = std::min(io_rStart.m_Processor, told[1].toDouble());
	return true;
}

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	QCoreApplication application(i_Count, i_ppArguments);
	const int runs = i_Count > 1 ? std::max(1, std::atoi(i_ppArguments[1])) : 20;
	const QTemporaryDir folder;
	const auto file = [&](const char* i_pName) { return folder.filePath(QLatin1String(i_pName)); };
	for (const char* const pName : {"performer.qrs", "character.fbx"})
		QFile::copy(QStringLiteral(RETARGET_DEMO "/") + pName, file(pName));
	if (QProcess::execute(RETARGET_PROGRAM,
	        {"create", "-q", "--fbx", file("character.fbx"), "--source", file("performer.qrs"), "--edits",
	            RETARGET_DEMO "/mapping.json", "--prune-joints", "--match-file-pose", "--update-targets", "-o",
	            file("kestrel.qrr")})
	    != 0)
		return 1;
	const QStringList studio{"--module", RETARGET_MODULE, "--settings", file("studio.ini"), "--size", "1280x720", "-q"};
	VStart starts[] = {{"bare window", RETARGET_START_BARE, {}}, {"studio", RETARGET_START_STUDIO, studio},
	    {"studio with its files", RETARGET_START_STUDIO,
	        studio
	            + QStringList{"--source", file("performer.qrs"), "--fbx", file("character.fbx"), "--target",
	                file("kestrel.qrr")}}};
	for (int run = 0; run <= runs; ++run)
		for (VStart& rStart : starts)
			if (!Run(rStart))
				return 1;
	for (const VStart& rStart : starts)
		std::printf("%-24s %6.3f s, %5.2f times (at most 2.2); processor %6.3f s, %5.2f times\n", rStart.m_pName,
		    rStart.m_Clock, rStart.m_Clock / starts[0].m_Clock, rStart.m_Processor,
		    rStart.m_Processor / starts[0].m_Processor);
	return 0;
}
