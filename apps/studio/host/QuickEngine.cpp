#include "studio/host/QuickEngine.h"

#include "DebugServices/GlobalLog.h"

namespace StudioHost
{

VQuickEngine::VQuickEngine(bool i_bDeveloper, VQmlServices i_Services) : m_bDeveloper(i_bDeveloper)
{
	m_Engine.setOutputWarningsToStandardError(false);
	QObject::connect(&m_Engine, &QQmlEngine::warnings, &m_Engine,
	    [](const QList<QQmlError>& i_rWarnings)
	    {
		    for (const QQmlError& rWarning : i_rWarnings)
			    NVX_LOG("QuickWidget", NVX::ELogWarning, "%1%", rWarning.toString().toStdString());
	    });
	RegisterQmlModules(m_Engine, std::move(i_Services), i_bDeveloper ? QStringLiteral(RETARGET_STUDIO_QML) : QString());
}

} // namespace StudioHost
