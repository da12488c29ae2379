#include "FirstPicture.h"

#include <QApplication>
#include <QEvent>
#include <QQuickWidget>
#include <QQuickWindow>
#include <QTimer>

#include <cstdio>
#include <ctime>
#include <utility>

namespace
{

class VFirstPicture : public QObject
{
public:
	using QObject::QObject;

	bool eventFilter(QObject* i_pWatched, QEvent* i_pEvent) override
	{
		auto* const pWidget = i_pEvent->type() == QEvent::Show ? qobject_cast<QQuickWidget*>(i_pWatched) : nullptr;
		if (pWidget && pWidget->isVisible())
			// Queued: the signal comes from within the drawing, before the window has it.
			connect(pWidget->quickWindow(), &QQuickWindow::afterRendering, this, &VFirstPicture::Tell,
			    Qt::QueuedConnection);
		return false;
	}

private:
	void Tell()
	{
		if (std::exchange(m_bTold, true))
			return;
		timespec clock{}, processor{};
		clock_gettime(CLOCK_MONOTONIC, &clock);
		clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &processor);
		std::printf("%lld.%09ld %lld.%09ld\n", static_cast<long long>(clock.tv_sec), clock.tv_nsec,
		    static_cast<long long>(processor.tv_sec), processor.tv_nsec);
		// What the driver keeps for the next start it writes beside.
		QTimer::singleShot(200, qApp, &QCoreApplication::quit);
	}

	bool m_bTold = false;
};

void Watch()
{
	qApp->installEventFilter(new VFirstPicture(qApp));
}

} // namespace

void TellFirstPicture()
{
	qAddPreRoutine(Watch);
}
