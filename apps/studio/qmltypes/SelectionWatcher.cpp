#include "studio/qmltypes/SelectionWatcher.h"

#include "studio/qmltypes/QmlModules.h"
#include "studio/qmltypes/SelectionManager.h"

#include <QQmlEngine>

using NVX::ISelectionItem;

namespace StudioHost
{

void VSelectionWatcher::classBegin()
{
	m_pManager = SelectionManagerOf(qmlEngine(this));
	if (!m_pManager)
		return;
	connect(m_pManager, &VSelectionManager::selectionChanged, this, &VSelectionWatcher::UpdateSelected);
	connect(m_pManager, &VSelectionManager::preSelectionChanged, this, &VSelectionWatcher::UpdatePreSelected);
}

void VSelectionWatcher::SetItem(const QVariant& i_rItem)
{
	// Variants of a type without a registered comparison never equal: a row that is told of its item again follows.
	m_Item = i_rItem;
	emit itemChanged();
	UpdateSelected();
	UpdatePreSelected();
}

void VSelectionWatcher::UpdateSelected()
{
	const bool bSelected =
	    m_pManager && m_Item.canConvert<ISelectionItem>() && m_pManager->IsSelected(m_Item.value<ISelectionItem>());
	if (std::exchange(m_bSelected, bSelected) != bSelected)
		emit selectedChanged();
}

void VSelectionWatcher::UpdatePreSelected()
{
	const bool bPreSelected =
	    m_pManager && m_Item.canConvert<ISelectionItem>() && m_pManager->IsPreSelected(m_Item.value<ISelectionItem>());
	if (std::exchange(m_bPreSelected, bPreSelected) != bPreSelected)
		emit preselectedChanged();
}

} // namespace StudioHost

#include "moc_SelectionWatcher.cpp"
