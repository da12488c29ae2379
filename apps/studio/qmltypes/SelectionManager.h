#pragma once

#include "NVX/SelectionItemVariant.h"
#include "NVX/Signal.h"
#include "TesselPluginInterface/ISelectionManager.h"

#include <QObject>
#include <QVariant>

#include <memory>

namespace StudioHost
{

/// The host's selection and pre-selection for QML: the singleton "SelectionManager" of "Orlex.Selection". Items are
/// variants of NVX::ISelectionItem; any other variant is ignored.
class VSelectionManager : public QObject
{
	Q_OBJECT

public:
	/// Without a manager nothing is ever selected.
	explicit VSelectionManager(
	    std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pManager, QObject* i_pParent = nullptr);
	~VSelectionManager() override;

	/// Makes the item the only one of its kind; items of other kinds stay, so that lists of different kinds do not
	/// clear each other.
	Q_INVOKABLE void clearAndSelect(const QVariant& i_rItem);
	Q_INVOKABLE void toggle(const QVariant& i_rItem);
	/// Makes the item the one that the mouse points at.
	Q_INVOKABLE void preselect(const QVariant& i_rItem);
	Q_INVOKABLE void clearPreselection();

	bool IsSelected(const NVX::ISelectionItem& i_rItem) const;
	bool IsPreSelected(const NVX::ISelectionItem& i_rItem) const;

signals:
	void selectionChanged();
	void preSelectionChanged();

private:
	const std::shared_ptr<TesselPluginInterface::ISelectionManager> m_pManager;
	NVX::VConnection m_SelectionConnection;
	NVX::VConnection m_PreSelectionConnection;
};

} // namespace StudioHost
