#include "studio/qmltypes/SelectionManager.h"

#include <algorithm>

using NVX::ISelectionItem;
using TesselPluginInterface::ISelection;

namespace StudioHost
{
namespace
{

bool Holds(const ISelection& i_rSelection, const ISelectionItem& i_rItem)
{
	return std::ranges::find(i_rSelection.Items(), i_rItem) != i_rSelection.Items().end();
}

} // namespace

VSelectionManager::VSelectionManager(
    std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pManager, QObject* i_pParent)
    : QObject(i_pParent), m_pManager(std::move(i_pManager))
{
	if (!m_pManager)
		return;
	m_SelectionConnection = m_pManager->Selection().ChangedSignal().Connect([this] { emit selectionChanged(); });
	m_PreSelectionConnection =
	    m_pManager->PreSelection().ChangedSignal().Connect([this] { emit preSelectionChanged(); });
}

VSelectionManager::~VSelectionManager()
{
	m_SelectionConnection.Disconnect();
	m_PreSelectionConnection.Disconnect();
}

void VSelectionManager::clearAndSelect(const QVariant& i_rItem)
{
	if (!m_pManager || !i_rItem.canConvert<ISelectionItem>())
		return;
	const auto item = i_rItem.value<ISelectionItem>();
	// One operation, so that nobody sees the moment between.
	std::vector<ISelectionItem> items = m_pManager->Selection().Items();
	std::erase_if(items, [&item](const ISelectionItem& i_rOther) { return i_rOther.m_Kind == item.m_Kind; });
	items.push_back(item);
	m_pManager->Selection().Replace(items);
}

void VSelectionManager::toggle(const QVariant& i_rItem)
{
	if (m_pManager && i_rItem.canConvert<ISelectionItem>())
		m_pManager->Selection().Toggle({i_rItem.value<ISelectionItem>()});
}

void VSelectionManager::preselect(const QVariant& i_rItem)
{
	if (m_pManager && i_rItem.canConvert<ISelectionItem>())
		m_pManager->PreSelection().Replace({i_rItem.value<ISelectionItem>()});
}

void VSelectionManager::clearPreselection()
{
	if (m_pManager)
		m_pManager->PreSelection().Replace({});
}

bool VSelectionManager::IsSelected(const ISelectionItem& i_rItem) const
{
	return m_pManager && Holds(m_pManager->Selection(), i_rItem);
}

bool VSelectionManager::IsPreSelected(const ISelectionItem& i_rItem) const
{
	return m_pManager && Holds(m_pManager->PreSelection(), i_rItem);
}

} // namespace StudioHost

#include "moc_SelectionManager.cpp"
