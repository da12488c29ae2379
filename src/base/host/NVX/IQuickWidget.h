#pragma once

#include <QObject>
#include <QString>
#include <QVariant>

class QQmlPropertyMap;
class QWidget;

namespace NVX
{

/// A panel made of QML, as the host sees it.
class IQuickWidget
{
public:
	virtual ~IQuickWidget() = default;

	/// True where the panel's QML comes from the sources and F5 loads it again.
	virtual bool IsDeveloper() const = 0;

	/// Loads the present file again, whatever has become of it since.
	virtual void Reload() = 0;

	/// What the QML sees under a name. The object is not taken over, and must outlive the QML.
	virtual void setContextProperty(const QString& i_rName, QObject* i_pObject) = 0;
	virtual void setContextProperty(const QString& i_rName, const QVariant& i_rValue) = 0;
	/// Several at once: bindings are evaluated once, behind the last.
	virtual void setContextProperties(const QVariantMap& i_rProperties) = 0;
	/// An invalid variant for a name that is not there.
	virtual QVariant contextProperty(const QString& i_rName) const = 0;

	/// Shows a QML file: the one on disk below the folder where the host is a developer's and the file is there, the
	/// one in the resources otherwise.
	virtual void Load(const QString& i_rFolder, const QString& i_rFile) = 0;

	/// Properties that outlive a reload; the QML reads them from "contextPersistentProperties". A value that is there
	/// already changes nothing.
	virtual void SetPersistentProperty(const QString& i_rName, const QVariant& i_rValue) = 0;
	virtual QQmlPropertyMap& PersistentProperties() = 0;

	/// Called by the host around the docking of the panel.
	virtual void OnPanelShown() {}
	virtual void OnPanelHidden() {}

	virtual QWidget* Widget() = 0;
};

} // namespace NVX

Q_DECLARE_INTERFACE(NVX::IQuickWidget, "com.Orlex.IQuickWidget")
