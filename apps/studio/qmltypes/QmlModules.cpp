#include "studio/qmltypes/QmlModules.h"

#include "studio/qmltypes/Ownership.h"
#include "studio/qmltypes/SelectionManager.h"
#include "studio/qmltypes/SelectionWatcher.h"
#include "studio/qmltypes/Side.h"

#include <QQmlEngine>
#include <QtQml>

// Outside of any namespace, as the resource compiler's function is.
static void InitialiseResources()
{
	Q_INIT_RESOURCE(StudioQml);
}

namespace StudioHost
{
namespace
{

/// The engine's child that carries its singletons.
class VEngineServices : public QObject
{
public:
	VEngineServices(VQmlServices i_Services, QObject* i_pParent)
	    : QObject(i_pParent), m_Selection(std::move(i_Services.m_pSelectionManager)),
	      m_Parameters(std::move(i_Services.m_MakeParameterGroupModel)), m_Tessel(std::move(i_Services.m_RunCommand))
	{
		setObjectName(Name());
		for (QObject* pSingleton : {static_cast<QObject*>(&m_Selection), static_cast<QObject*>(&m_Parameters),
		         static_cast<QObject*>(&m_Tessel)})
			QQmlEngine::setObjectOwnership(pSingleton, QQmlEngine::CppOwnership);
	}

	static QString Name() { return QStringLiteral("StudioHost::VEngineServices"); }

	static VEngineServices* Of(const QQmlEngine* i_pEngine)
	{
		return i_pEngine
		    ? static_cast<VEngineServices*>(i_pEngine->findChild<QObject*>(Name(), Qt::FindDirectChildrenOnly))
		    : nullptr;
	}

	VSelectionManager m_Selection;
	VTesselParameters m_Parameters;
	VTessel m_Tessel;
};

template <auto t_pMember>
QObject* Singleton(QQmlEngine* i_pEngine, QJSEngine*)
{
	VEngineServices* const pServices = VEngineServices::Of(i_pEngine);
	return pServices ? &(pServices->*t_pMember) : nullptr;
}

void RegisterTypes()
{
	qmlRegisterSingletonType<VSelectionManager>(
	    "Orlex.Selection", 1, 0, "SelectionManager", Singleton<&VEngineServices::m_Selection>);
	qmlRegisterType<VSelectionWatcher>("Orlex.Selection", 1, 0, "SelectionWatcher");
	qmlRegisterSingletonType<VOwnership>(
	    "Orlex.Controls", 1, 0, "Ownership", [](QQmlEngine*, QJSEngine*) -> QObject* { return new VOwnership; });
	qmlRegisterSingletonType<VSide>(
	    "Orlex.Controls", 1, 0, "Side", [](QQmlEngine*, QJSEngine*) -> QObject* { return new VSide; });
	qmlRegisterSingletonType<VTesselParameters>(
	    "Orlex.Tessel.Parameters", 1, 0, "TesselParameters", Singleton<&VEngineServices::m_Parameters>);
	qmlRegisterSingletonType<VTessel>("TesselQML", 1, 0, "Tessel", Singleton<&VEngineServices::m_Tessel>);
}

} // namespace

void RegisterQmlModules(QQmlEngine& io_rEngine, VQmlServices i_Services, const QString& i_rSourceFolder)
{
	static const bool s_bRegistered = (InitialiseResources(), RegisterTypes(), true);
	Q_UNUSED(s_bRegistered)
	new VEngineServices(std::move(i_Services), &io_rEngine);
	// The last one added is looked at first.
	io_rEngine.addImportPath(QStringLiteral("qrc:/qml"));
	if (!i_rSourceFolder.isEmpty())
		io_rEngine.addImportPath(i_rSourceFolder);
}

VSelectionManager* SelectionManagerOf(const QQmlEngine* i_pEngine)
{
	VEngineServices* const pServices = VEngineServices::Of(i_pEngine);
	return pServices ? &pServices->m_Selection : nullptr;
}

} // namespace StudioHost

#include "moc_Ownership.cpp"
#include "moc_Side.cpp"
