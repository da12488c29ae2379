#pragma once

#include <QCoreApplication>
#include <QElapsedTimer>
#include <QTimer>

/// Handles events until the condition holds, which is asked after each batch of them and every few milliseconds. Unlike
/// QTest::qWaitFor it takes no naps: a window that is tested draws a frame for nearly every one of them.
/// @return false if it does not hold before the time is over
template <typename TCondition>
bool WaitFor(const TCondition& i_rCondition, int i_Milliseconds)
{
	QElapsedTimer elapsed;
	elapsed.start();
	QTimer wake;
	wake.start(5);
	while (!i_rCondition())
	{
		if (elapsed.elapsed() > i_Milliseconds)
			return false;
		QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
		QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
	}
	return true;
}
