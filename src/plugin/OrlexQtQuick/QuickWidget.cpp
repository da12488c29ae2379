#include "OrlexQtQuick/QuickWidget.h"

#include "DebugServices/GlobalLog.h"
#include "OrlexQtQuick/GuardedCallback.h"
#include "TesselPluginInterface/IQuickEngine.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QKeyEvent>
#include <QQmlComponent>
#include <QQmlEngine>
#include <QQuickWindow>
#include <QShowEvent>

namespace OrlexQtQuick
{

namespace
{

constexpr const char* c_LogCategory = "QuickWidget";

} // namespace

VQuickWidget::VQuickWidget(std::shared_ptr<TesselPluginInterface::IQuickEngine> i_pEngine, QWidget* i_pParent)
    : QQuickWidget(&i_pEngine->Engine(), i_pParent), m_pEngine(std::move(i_pEngine)),
      m_bDeveloper(m_pEngine->IsDeveloper()), m_pContext(new QQmlContext(m_pEngine->Engine().rootContext(), this))
{
	QQmlEngine::setObjectOwnership(this, QQmlEngine::CppOwnership);
	m_pContext->setContextProperty(QStringLiteral("contextQuickWidget"), this);
	m_pContext->setContextProperty(QStringLiteral("contextPersistentProperties"), &m_PersistentProperties);
	setFocusPolicy(Qt::StrongFocus);
	setAttribute(Qt::WA_OpaquePaintEvent);
	setAttribute(Qt::WA_AlwaysStackOnTop);
	if (m_bDeveloper)
		m_ReloadConnection = m_pEngine->ReloadSignal().Connect(Guarded(this, &VQuickWidget::Reload));
}

VQuickWidget::~VQuickWidget()
{
	m_ReloadConnection.Disconnect();
	ReleaseContent();
}

void VQuickWidget::ReleaseContent()
{
	setSource({});
	delete m_pContext;
}

void VQuickWidget::setContextProperty(const QString& i_rName, QObject* i_pObject)
{
	if (i_pObject)
		QQmlEngine::setObjectOwnership(i_pObject, QQmlEngine::CppOwnership);
	if (m_pContext)
		m_pContext->setContextProperty(i_rName, i_pObject);
}

void VQuickWidget::setContextProperty(const QString& i_rName, const QVariant& i_rValue)
{
	if (m_pContext)
		m_pContext->setContextProperty(i_rName, i_rValue);
}

void VQuickWidget::setContextProperties(const QVariantMap& i_rProperties)
{
	QVector<QQmlContext::PropertyPair> properties;
	properties.reserve(i_rProperties.size());
	for (auto it = i_rProperties.begin(); it != i_rProperties.end(); ++it)
		properties.push_back({it.key(), it.value()});
	if (m_pContext)
		m_pContext->setContextProperties(properties);
}

QVariant VQuickWidget::contextProperty(const QString& i_rName) const
{
	return m_pContext ? m_pContext->contextProperty(i_rName) : QVariant();
}

void VQuickWidget::Load(const QString& i_rFolder, const QString& i_rFile)
{
	setSource({});
	const QString file = QDir::cleanPath(i_rFile);
	setObjectName(file);
	const QString onDisk = QDir(i_rFolder).filePath(file);
	m_SourceUrl =
	    m_bDeveloper && QFileInfo::exists(onDisk) ? QUrl::fromLocalFile(onDisk) : QUrl(QStringLiteral("qrc:/") + file);
	ShowSource();
}

void VQuickWidget::Reload()
{
	if (m_SourceUrl.isEmpty() || !m_pContext)
		return;
	setSource({});
	engine()->clearComponentCache();
	ShowSource();
}

void VQuickWidget::ShowSource()
{
	auto* const pComponent = new QQmlComponent(engine(), m_SourceUrl, this);
	QObject* const pRoot = pComponent->isReady() ? pComponent->create(m_pContext) : nullptr;
	for (const QQmlError& rError : pComponent->errors())
		NVX_LOG(c_LogCategory, NVX::ELogError, "%1%", rError.toString().toStdString());
	setContent(m_SourceUrl, pComponent, pRoot);
	NVX_LOG(c_LogCategory, NVX::ELogDetail, "Loading %1%", m_SourceUrl.toString().toStdString());
	m_LoadedSignal.Fire();
}

void VQuickWidget::SetPersistentProperty(const QString& i_rName, const QVariant& i_rValue)
{
	if (m_PersistentProperties.value(i_rName) == i_rValue)
		return;
	m_PersistentProperties.insert(i_rName, i_rValue);
	// The map itself tells only of changes that come from QML.
	emit m_PersistentProperties.valueChanged(i_rName, i_rValue);
}

bool VQuickWidget::event(QEvent* i_pEvent)
{
	switch (i_pEvent->type())
	{
	case QEvent::WindowChangeInternal:
	{
		// In another window what the old one's OpenGL context holds must be made anew.
		QQuickWindow* const pWindow = quickWindow();
		const bool bPersistent = pWindow->isPersistentSceneGraph();
		pWindow->setPersistentSceneGraph(false);
		const bool bResult = QQuickWidget::event(i_pEvent);
		pWindow->setPersistentSceneGraph(bPersistent);
		return bResult;
	}
	case QEvent::ScreenChangeInternal:
	{
		QEvent windowChange(QEvent::WindowChangeInternal);
		QCoreApplication::sendEvent(this, &windowChange);
		const bool bResult = QQuickWidget::event(i_pEvent);
		if (isVisible())
		{
			QShowEvent show;
			QCoreApplication::sendEvent(this, &show);
		}
		return bResult;
	}
	default: return QQuickWidget::event(i_pEvent);
	}
}

void VQuickWidget::keyPressEvent(QKeyEvent* i_pEvent)
{
	if (m_bDeveloper && i_pEvent->key() == Qt::Key_F5)
		Reload();
	else
		QQuickWidget::keyPressEvent(i_pEvent);
}

} // namespace OrlexQtQuick

#include "moc_QuickWidget.cpp"
