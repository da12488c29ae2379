#pragma once

#include <QObject>
#include <QPointer>
#include <QQmlParserStatus>
#include <QVariant>

namespace StudioHost
{

class VSelectionManager;

/// Tells whether one item is selected and whether the mouse points at it: "SelectionWatcher" of "Orlex.Selection", one
/// for each row of a list.
class VSelectionWatcher : public QObject, public QQmlParserStatus
{
	Q_OBJECT
	Q_INTERFACES(QQmlParserStatus)
	/// A variant of NVX::ISelectionItem; any other is never selected.
	Q_PROPERTY(QVariant item READ Item WRITE SetItem NOTIFY itemChanged)
	Q_PROPERTY(bool selected READ IsSelected NOTIFY selectedChanged)
	Q_PROPERTY(bool preselected READ IsPreSelected NOTIFY preselectedChanged)

public:
	using QObject::QObject;

	const QVariant& Item() const { return m_Item; }
	void SetItem(const QVariant& i_rItem);
	bool IsSelected() const { return m_bSelected; }
	bool IsPreSelected() const { return m_bPreSelected; }

	void classBegin() override;
	void componentComplete() override {}

signals:
	void itemChanged();
	void selectedChanged();
	void preselectedChanged();

private:
	void UpdateSelected();
	void UpdatePreSelected();

	QPointer<VSelectionManager> m_pManager;
	QVariant m_Item;
	bool m_bSelected = false;
	bool m_bPreSelected = false;
};

} // namespace StudioHost
