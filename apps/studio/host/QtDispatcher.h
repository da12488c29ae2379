#pragma once

#include "TesselPluginInterface/IDispatcher.h"

#include <QObject>

#include <atomic>
#include <cstddef>

namespace StudioHost
{

/// Posts callbacks to the event loop of the thread that made it. What is still queued when it ends never runs.
class VQtDispatcher : public QObject, public TesselPluginInterface::IDispatcher
{
	Q_OBJECT

public:
	void Post(std::function<void()> i_Callback) override;

	/// Callbacks that wait for their turn.
	std::size_t PendingCount() const { return m_Pending.load(); }

signals:
	/// The last callback that waited has run.
	void idle();

private:
	void Run(const std::function<void()>& i_rCallback);

	std::atomic<std::size_t> m_Pending{0};
};

} // namespace StudioHost
