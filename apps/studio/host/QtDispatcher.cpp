#include "studio/host/QtDispatcher.h"

#include "DebugServices/GlobalLog.h"

namespace StudioHost
{

void VQtDispatcher::Post(std::function<void()> i_Callback)
{
	++m_Pending;
	QMetaObject::invokeMethod(
	    this, [this, callback = std::move(i_Callback)] { Run(callback); }, Qt::QueuedConnection);
}

void VQtDispatcher::Run(const std::function<void()>& i_rCallback)
{
	// Qt's event loop does not let exceptions through.
	try
	{
		i_rCallback();
	}
	catch (const std::exception& rError)
	{
		NVX_LOG("System", NVX::ELogError, "A posted callback failed: %1%", rError.what());
	}
	if (--m_Pending == 0)
		emit idle();
}

} // namespace StudioHost

#include "moc_QtDispatcher.cpp"
