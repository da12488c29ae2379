// The demo's take in the studio's window of 1280 by 720 pixels, four times as fast as it was recorded, so that no frame
// waits for its time: pictures a second, and the longest that the window did not answer. What is solved already is the
// same scene unsolved; beside it each picture is solved for itself, and while a sequence is solved. Then a take of
// 100,000 frames is opened.
#include "../DemoFiles.h"
#include "../Verdict.h"

#include "studio/host/Preferences.h"
#include "studio/host/Services.h"
#include "studio/motion/TakePlayer.h"
#include "studio/panel/RetargetPanel.h"
#include "studio/window/DarkStyle.h"
#include "studio/window/StudioWindow.h"

#include <QApplication>
#include <QElapsedTimer>
#include <QFile>
#include <QQuickWidget>
#include <QQuickWindow>
#include <QSettings>
#include <QTimer>

#include <cstdio>
#include <ctime>
#include <functional>

namespace
{

constexpr int c_LongTake = 100'000;
constexpr qint64 c_Milliseconds = 6000;
/// The heart beats so often; what is longer between two beats is a block.
constexpr int c_Beat = 2;

/// Counts what is drawn, and how long the window did not answer.
class VWatch
{
public:
	explicit VWatch(QQuickWindow& i_rView)
	{
		QObject::connect(&i_rView, &QQuickWindow::afterRendering, &m_Beat, [this] { ++m_Frames; });
		QObject::connect(&m_Beat, &QTimer::timeout, &m_Beat,
		    [this]
		    {
			    m_Longest = std::max(m_Longest, double(m_SinceBeat.nsecsElapsed()) * 1e-6 - c_Beat);
			    m_LongestWork = std::max(m_LongestWork, OwnWork() - m_WorkAtBeat);
			    Begin();
		    });
		m_Beat.setTimerType(Qt::PreciseTimer);
		m_Beat.start(c_Beat);
	}

	/// Until the condition holds, or for that long.
	void Run(const char* i_pWhat, qint64 i_Milliseconds, const std::function<bool()>& i_rUntil)
	{
		QElapsedTimer elapsed;
		elapsed.start();
		Begin();
		m_Longest = m_LongestWork = 0.0;
		m_Frames = 0;
		while (elapsed.elapsed() < i_Milliseconds && !i_rUntil())
			QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
		const double seconds = double(elapsed.nsecsElapsed()) * 1e-9;
		if (i_pWhat)
			std::printf("%-52s %6.1f frames a second, %6.2f ms each, longest block %6.1f ms, work %5.1f ms, %.1f s\n",
			    i_pWhat, m_Frames / seconds, 1e3 * seconds / std::max(1, m_Frames), m_Longest, m_LongestWork, seconds);
		m_LastTime = seconds / std::max(1, m_Frames);
	}

	/// Seconds of a frame, and milliseconds, of the last run.
	double m_LastTime = 0.0;
	double m_Longest = 0.0;

private:
	void Begin()
	{
		m_SinceBeat.start();
		m_WorkAtBeat = OwnWork();
	}

	/// Milliseconds of a processor on this thread: what is left of a block where nobody else wants one.
	static double OwnWork()
	{
		timespec time{};
		clock_gettime(CLOCK_THREAD_CPUTIME_ID, &time);
		return 1e3 * double(time.tv_sec) + 1e-6 * double(time.tv_nsec);
	}

	QTimer m_Beat;
	QElapsedTimer m_SinceBeat;
	double m_WorkAtBeat = 0.0;
	double m_LongestWork = 0.0;
	int m_Frames = 0;
};

void WriteLongTake(const QString& i_rPath)
{
	QFile walk(RETARGET_DEMO "/walk.bvh"), file(i_rPath);
	if (!walk.open(QIODevice::ReadOnly) || !file.open(QIODevice::WriteOnly))
		return;
	const QByteArray text = walk.readAll();
	const int count = text.indexOf("Frames:");
	const int first = text.indexOf('\n', text.indexOf("Frame Time:")) + 1;
	QList<QByteArray> lines = text.mid(first).split('\n');
	lines.removeAll({});
	file.write(text.left(count) + "Frames: " + QByteArray::number(c_LongTake)
	    + text.mid(text.indexOf('\n', count), first - text.indexOf('\n', count)));
	for (int i = 0; i < c_LongTake; ++i)
		file.write(lines[i % lines.size()] + '\n');
}

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	QCoreApplication::setAttribute(Qt::AA_ShareOpenGLContexts);
	QApplication application(i_Count, i_ppArguments);
	StudioHost::ApplyDarkStyle(application);
	const VDemoFiles files;
	if (!files.Make())
		return 1;
	const auto file = [&](const char* i_pName) { return files.Path(i_pName); };
	WriteLongTake(file("long.bvh"));

	QSettings settings(file("studio.ini"), QSettings::IniFormat);
	StudioHost::VStudioWindow window(settings);
	window.Context().Preferences().SetFolder("FolderSkins", files.Folder().toStdString());
	if (!window.LoadModule(RETARGET_MODULE))
		return 1;
	window.resize(1280, 720);
	window.show();
	for (const char* const pName : {"performer.qrs", "character.fbx", "kestrel.qrr"})
		window.Open(file(pName));
	StudioHost::VTakePlayer& rPlayer = window.Motion();
	auto* const pPanel = qobject_cast<QQuickWidget*>(window.RetargetPanel()->Widget());
	VWatch watch(*pPanel->quickWindow());
	const auto never = [] { return false; };
	const auto judged = [&] { return rPlayer.AtRest() && rPlayer.Judged(); };
	watch.Run(nullptr, 3000, never);
	window.OpenTake(file("walk.bvh"));
	watch.Run(nullptr, 60000, judged);
	rPlayer.SetSpeed(4.0);
	rPlayer.Play();
	watch.Run("solved already", c_Milliseconds, never);
	const double unsolved = watch.m_LastTime;
	rPlayer.Pause();
	// Reading it anew begins with nothing.
	rPlayer.Open(file("walk.bvh"));
	watch.Run(nullptr, 60000, [&] { return !rPlayer.IsReading(); });
	rPlayer.Cancel();
	rPlayer.Play();
	watch.Run("each picture is solved", c_Milliseconds, never);
	const bool bVerdict = Verdict::WasAskedFor(i_Count, i_ppArguments);
	if (bVerdict)
	{
		Verdict::Tell("a picture while the take plays, ms", "", "", {1e3 * watch.m_LastTime}, 1e3 / 15);
		Verdict::Tell("the same", "the scene unsolved", "", {watch.m_LastTime / unsolved}, 1.3);
		Verdict::Tell("longest block of the window, ms", "", "playing", {watch.m_Longest}, 50);
	}
	std::printf("%-52s %6.2f times, at most 1.3\n", "beside the same scene unsolved", watch.m_LastTime / unsolved);
	rPlayer.Pause();
	rPlayer.Open(file("long.bvh"));
	watch.Run("a take of 100,000 frames is opened", 60000, [&] { return !rPlayer.IsReading(); });
	rPlayer.Play();
	watch.Run("it plays while it is solved", c_Milliseconds, never);
	if (bVerdict)
		Verdict::Tell("longest block of the window, ms", "", "solving 100,000 frames", {watch.m_Longest}, 50);
	rPlayer.Seek(c_LongTake / 2);
	watch.Run("from its middle on", c_Milliseconds, never);
	watch.Run("until all is solved", 120000, [&] { return bool(rPlayer.Judged()); });
	rPlayer.Seek(c_LongTake - 200);
	watch.Run("its end, solved", c_Milliseconds, never);
	return 0;
}
