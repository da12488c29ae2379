#pragma once

#include "NVX/IQuickWidget.h"
#include "NVX/Signal.h"

#include <QPointer>
#include <QQmlContext>
#include <QQmlPropertyMap>
#include <QQuickWidget>
#include <QUrl>

#include <memory>

namespace TesselPluginInterface
{
class IQuickEngine;
}

namespace OrlexQtQuick
{

/// A panel written in QML as a widget that the host can dock. The QML runs in a child context of the engine's root,
/// with the widget as "contextQuickWidget" and its persistent properties as "contextPersistentProperties".
class VQuickWidget : public QQuickWidget, public NVX::IQuickWidget
{
	Q_OBJECT
	Q_INTERFACES(NVX::IQuickWidget)

public:
	/// The provider must have an engine.
	explicit VQuickWidget(std::shared_ptr<TesselPluginInterface::IQuickEngine> i_pEngine, QWidget* i_pParent = nullptr);
	~VQuickWidget() override;

	bool IsDeveloper() const override { return m_bDeveloper; }
	void Reload() override;
	void setContextProperty(const QString& i_rName, QObject* i_pObject) override;
	void setContextProperty(const QString& i_rName, const QVariant& i_rValue) override;
	void setContextProperties(const QVariantMap& i_rProperties) override;
	QVariant contextProperty(const QString& i_rName) const override;
	void Load(const QString& i_rFolder, const QString& i_rFile) override;
	void SetPersistentProperty(const QString& i_rName, const QVariant& i_rValue) override;
	QQmlPropertyMap& PersistentProperties() override { return m_PersistentProperties; }
	QWidget* Widget() override { return this; }

	/// Fires behind each load, one that failed included.
	NVX::VSignal<>& LoadedSignal() { return m_LoadedSignal; }

protected:
	/// Ends the QML: its objects, then its context. For the destructors of derived classes whose members it shows.
	void ReleaseContent();

	bool event(QEvent* i_pEvent) override;
	void keyPressEvent(QKeyEvent* i_pEvent) override;

private:
	void ShowSource();

	const std::shared_ptr<TesselPluginInterface::IQuickEngine> m_pEngine;
	const bool m_bDeveloper;
	/// A child of the widget, which outlives the QML and not the engine.
	QPointer<QQmlContext> m_pContext;
	QUrl m_SourceUrl;
	QQmlPropertyMap m_PersistentProperties;
	NVX::VSignal<> m_LoadedSignal;
	NVX::VConnection m_ReloadConnection;
};

} // namespace OrlexQtQuick
