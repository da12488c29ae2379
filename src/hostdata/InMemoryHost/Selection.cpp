#include "InMemoryHost/Selection.h"

#include <boost/functional/hash.hpp>

#include <algorithm>
#include <iterator>
#include <unordered_set>
#include <utility>

using NVX::ISelectionItem;

namespace InMemoryHost
{

namespace
{

struct VItemHash
{
	std::size_t operator()(const ISelectionItem& i_rItem) const
	{
		std::size_t seed = boost::hash<std::string>()(i_rItem.m_Name);
		boost::hash_combine(seed, i_rItem.m_Kind);
		boost::hash_combine(seed, i_rItem.m_SubjectId);
		boost::hash_combine(seed, i_rItem.m_ElementIndex);
		return seed;
	}
};

using VItemSet = std::unordered_set<ISelectionItem, VItemHash>;

/// Adds, in order, the items that the set does not have.
void Append(const std::vector<ISelectionItem>& i_rNew, VItemSet& io_rKnown, std::vector<ISelectionItem>& io_rItems)
{
	std::copy_if(i_rNew.begin(), i_rNew.end(), std::back_inserter(io_rItems),
	    [&io_rKnown](const ISelectionItem& i_rItem) { return io_rKnown.insert(i_rItem).second; });
}

std::vector<ISelectionItem> Without(const std::vector<ISelectionItem>& i_rItems, const VItemSet& i_rDropped)
{
	std::vector<ISelectionItem> rest;
	std::copy_if(i_rItems.begin(), i_rItems.end(), std::back_inserter(rest),
	    [&i_rDropped](const ISelectionItem& i_rItem) { return !i_rDropped.contains(i_rItem); });
	return rest;
}

} // namespace

std::vector<ISelectionItem> VSelection::ItemsOfKind(std::uint32_t i_Kind) const
{
	std::vector<ISelectionItem> items;
	std::copy_if(m_Items.begin(), m_Items.end(), std::back_inserter(items),
	    [i_Kind](const ISelectionItem& i_rItem) { return i_rItem.m_Kind == i_Kind; });
	return items;
}

void VSelection::Replace(const std::vector<ISelectionItem>& i_rItems)
{
	VItemSet known;
	std::vector<ISelectionItem> items;
	Append(i_rItems, known, items);
	Take(std::move(items));
}

void VSelection::Add(const std::vector<ISelectionItem>& i_rItems)
{
	VItemSet known(m_Items.begin(), m_Items.end());
	std::vector<ISelectionItem> items = m_Items;
	Append(i_rItems, known, items);
	Take(std::move(items));
}

void VSelection::Remove(const std::vector<ISelectionItem>& i_rItems)
{
	Take(Without(m_Items, VItemSet(i_rItems.begin(), i_rItems.end())));
}

void VSelection::Toggle(const std::vector<ISelectionItem>& i_rItems)
{
	std::vector<ISelectionItem> items = Without(m_Items, VItemSet(i_rItems.begin(), i_rItems.end()));
	VItemSet known(m_Items.begin(), m_Items.end());
	Append(i_rItems, known, items);
	Take(std::move(items));
}

void VSelection::Take(std::vector<ISelectionItem> i_Items)
{
	if (i_Items == m_Items)
		return;
	m_Items = std::move(i_Items);
	m_ChangedSignal.Fire();
}

} // namespace InMemoryHost
