// From the start of the process to the first picture on the screen: the studio empty and with its last files, and a
// bare window, in turns. What a run takes least of the clock and of the processor is compared; a verdict is of each
// turn.
#include "../DemoFiles.h"
#include "../Verdict.h"

#include <QCoreApplication>
#include <QProcess>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <vector>

namespace
{

/// The limit of what the studio takes, in what the bare window takes.
constexpr double c_Limit = 2.2;
/// As often as the other programs' works.
constexpr int c_Runs = 21;

struct VStart
{
	const char* m_pName;
	QString m_Program;
	QStringList m_Arguments;
	/// Seconds, for each run.
	std::vector<double> m_Clock = {};
	std::vector<double> m_Processor = {};
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
	io_rStart.m_Clock.push_back(told[0].toDouble() - (double(begin.tv_sec) + 1e-9 * double(begin.tv_nsec)));
	io_rStart.m_Processor.push_back(told[1].toDouble());
	return true;
}

double Least(const std::vector<double>& i_rTimes)
{
	return *std::min_element(i_rTimes.begin(), i_rTimes.end());
}

void Judge(const char* i_pWork, const VStart& i_rStart, const VStart& i_rBare, std::vector<double> VStart::*i_pTimes)
{
	std::vector<double> ratios;
	for (std::size_t run = 0; run < (i_rStart.*i_pTimes).size(); ++run)
		ratios.push_back((i_rStart.*i_pTimes)[run] / (i_rBare.*i_pTimes)[run]);
	Verdict::Tell(i_pWork, "a bare window", i_rStart.m_pName, ratios, c_Limit, i_rBare.*i_pTimes);
}

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	QCoreApplication application(i_Count, i_ppArguments);
	const bool bVerdict = Verdict::WasAskedFor(i_Count, i_ppArguments);
	const int runs = i_Count > 1 && !bVerdict ? std::max(1, std::atoi(i_ppArguments[1])) : c_Runs;
	const VDemoFiles files;
	if (!files.Make())
		return 1;
	const auto file = [&](const char* i_pName) { return files.Path(i_pName); };
	const QStringList studio{"--module", RETARGET_MODULE, "--settings", file("studio.ini"), "--size", "1280x720", "-q"};
	VStart starts[] = {{"bare window", RETARGET_START_BARE, {}}, {"studio", RETARGET_START_STUDIO, studio},
	    {"studio with its files", RETARGET_START_STUDIO,
	        studio
	            + QStringList{"--source", file("performer.qrs"), "--fbx", file("character.fbx"), "--target",
	                file("kestrel.qrr")}}};
	// What the first run of each leaves for the next ones is not theirs.
	for (int run = 0; run <= runs; ++run)
		for (VStart& rStart : starts)
		{
			if (!Run(rStart))
				return 1;
			if (run == 0)
				rStart.m_Clock = rStart.m_Processor = {};
		}
	const VStart& rBare = starts[0];
	for (const VStart& rStart : starts)
		std::printf("%-24s %6.3f s, %5.2f times (at most %g); processor %6.3f s, %5.2f times\n", rStart.m_pName,
		    Least(rStart.m_Clock), Least(rStart.m_Clock) / Least(rBare.m_Clock), c_Limit, Least(rStart.m_Processor),
		    Least(rStart.m_Processor) / Least(rBare.m_Processor));
	if (bVerdict)
		for (const VStart& rStart : {starts[1], starts[2]})
		{
			Judge("the first picture, by the processor", rStart, rBare, &VStart::m_Processor);
			Judge("the first picture, by the clock", rStart, rBare, &VStart::m_Clock);
		}
	return 0;
}
