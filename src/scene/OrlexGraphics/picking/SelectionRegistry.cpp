#include "OrlexGraphics/picking/SelectionRegistry.h"

#include "CoreGraphics/RenderContext.h"
#include "OrlexGraphics/picking/Picking.h"
#include "OrlexGraphics/picking/SelectionKinds.h"

#include <boost/container_hash/hash.hpp>

namespace OrlexGraphics
{

std::size_t VSelectionItemHash::operator()(const NVX::ISelectionItem& i_rItem) const
{
	std::size_t hash = 0;
	boost::hash_combine(hash, i_rItem.m_Kind);
	boost::hash_combine(hash, i_rItem.m_SubjectId);
	boost::hash_combine(hash, i_rItem.m_ElementIndex);
	boost::hash_combine(hash, i_rItem.m_Name);
	return hash;
}

VSelectionRegistry::VSelectionRegistry() : m_pPlaces(std::make_shared<VItemPlaces>()) {}

void VSelectionRegistry::SetSelection(
    const std::vector<NVX::ISelectionItem>& i_rSelected, const std::vector<NVX::ISelectionItem>& i_rPreselected)
{
	m_Selected = i_rSelected;
	m_Preselected = i_rPreselected;
}

void VSelectionRegistry::Reset()
{
	m_Items.clear();
	m_Ids.clear();
	m_Names.clear();
	m_NextId = 1;
	m_Excluded.clear();
	m_BoundsById.clear();
	m_PickBounds.clear();
	m_FlaggedIds.clear();
	// Others may still read those of the frame before.
	m_pPlaces = std::make_shared<VItemPlaces>();

	m_Flags.clear();
	struct VKind
	{
		const NVX::ISelectionItem* m_pFirst;
		std::size_t m_Count = 0;
	};
	std::unordered_map<std::uint32_t, VKind> kinds;
	for (const NVX::ISelectionItem& rItem : m_Selected)
	{
		m_Flags[rItem] |= CoreGraphics::ESelectionIdSelected;
		++kinds.try_emplace(rItem.m_Kind, VKind{&rItem}).first->second.m_Count;
	}
	for (const auto& [kind, rKind] : kinds)
		if (rKind.m_Count > 1)
			m_Flags[*rKind.m_pFirst] |= CoreGraphics::ESelectionIdPrimary;
	for (const NVX::ISelectionItem& rItem : m_Preselected)
		m_Flags[rItem] |= CoreGraphics::ESelectionIdPreselected;
}

std::uint32_t VSelectionRegistry::Allocate(const NVX::ISelectionItem& i_rItem, std::uint32_t i_Count)
{
	if (const auto found = m_Ids.find(i_rItem); found != m_Ids.end())
		return found->second;
	if (i_Count == 0 || i_Count > CoreGraphics::ESelectionIdMask + 1 - m_NextId)
		return 0;
	const std::uint32_t id = m_NextId;
	m_NextId += i_Count;
	m_Ids.emplace(i_rItem, id);
	m_Items.emplace_hint(m_Items.end(), id, i_rItem);
	return id;
}

std::uint32_t VSelectionRegistry::Allocate(const NVX::ISelectionItem& i_rItem, const std::string& i_rName)
{
	const std::uint32_t id = Allocate(i_rItem);
	if (id != 0)
		m_Names[id] = i_rName;
	return id;
}

CoreGraphics::VSelectionId VSelectionRegistry::GetId(const NVX::ISelectionItem& i_rItem)
{
	const std::uint32_t id = Allocate(i_rItem);
	const auto flags = m_Flags.find(i_rItem);
	if (id == 0 || flags == m_Flags.end())
		return CoreGraphics::MakeSelectionId(id);
	// The handles are not drawn in the id frame: they show by their colour.
	if (!IsHandle(i_rItem.m_Kind))
		m_FlaggedIds.push_back(id);
	return CoreGraphics::MakeSelectionId(id | flags->second);
}

bool VSelectionRegistry::ResolveId(std::uint32_t i_Id, NVX::ISelectionItem& o_rItem) const
{
	const std::uint32_t id = i_Id & CoreGraphics::ESelectionIdMask;
	if (id == 0 || id >= m_NextId)
		return false;
	const auto found = std::prev(m_Items.upper_bound(id));
	o_rItem = found->second;
	if (HasChildren(o_rItem.m_Kind))
		o_rItem.m_ElementIndex = id - found->first;
	return true;
}

const std::string& VSelectionRegistry::GetName(std::uint32_t i_Id) const
{
	static const std::string s_Empty;
	const auto found = m_Names.find(i_Id & CoreGraphics::ESelectionIdMask);
	return found == m_Names.end() ? s_Empty : found->second;
}

void VSelectionRegistry::SetItemBound(const NVX::ISelectionItem& i_rItem, const QVector4D& i_rBound)
{
	m_pPlaces->m_Bounds[i_rItem] = i_rBound;
}

void VSelectionRegistry::SetItemMatrix(const NVX::ISelectionItem& i_rItem, const QMatrix4x4& i_rMatrix)
{
	m_pPlaces->m_Matrices[i_rItem] = i_rMatrix;
}

const QVector4D* VSelectionRegistry::GetItemBound(const NVX::ISelectionItem& i_rItem) const
{
	const auto found = m_pPlaces->m_Bounds.find(i_rItem);
	return found == m_pPlaces->m_Bounds.end() ? nullptr : &found->second;
}

const QMatrix4x4* VSelectionRegistry::GetItemMatrix(const NVX::ISelectionItem& i_rItem) const
{
	const auto found = m_pPlaces->m_Matrices.find(i_rItem);
	return found == m_pPlaces->m_Matrices.end() ? nullptr : &found->second;
}

bool VSelectionRegistry::IsHidden(const CoreGraphics::VSelectionId& i_rId, std::uint32_t i_Mode) const
{
	switch (i_Mode)
	{
	case CoreGraphics::ERenderPick:
	{
		const std::uint32_t id = i_rId.m_Id & CoreGraphics::ESelectionIdMask;
		return id < m_Excluded.size() && m_Excluded[id];
	}
	case CoreGraphics::ERenderId:
		return (i_rId.m_Id & (CoreGraphics::ESelectionIdSelected | CoreGraphics::ESelectionIdPreselected)) == 0;
	default: return false;
	}
}

void VSelectionRegistry::Exclude(std::uint32_t i_Id)
{
	const std::uint32_t id = i_Id & CoreGraphics::ESelectionIdMask;
	if (id >= m_Excluded.size())
		m_Excluded.resize(id + 1);
	m_Excluded[id] = true;
}

const QVector4D* VSelectionRegistry::FindPickBound(const NVX::ISelectionItem& i_rItem) const
{
	const auto pick = m_PickBounds.find(i_rItem);
	return pick == m_PickBounds.end() ? GetItemBound(i_rItem) : &pick->second;
}

bool VSelectionRegistry::GetFlaggedBounds(std::vector<QVector4D>& o_rBounds) const
{
	o_rBounds.clear();
	for (const std::uint32_t id : m_FlaggedIds)
	{
		const QVector4D* const pBound = FindPickBound(m_Items.at(id));
		if (!pBound)
			return false;
		o_rBounds.push_back(*pBound);
	}
	return true;
}

void VSelectionRegistry::ExcludeOutside(const VPickFrustum& i_rFrustum)
{
	if (m_BoundsById.empty())
		for (const auto& [rItem, rBound] : m_pPlaces->m_Bounds)
			if (const auto id = m_Ids.find(rItem); id != m_Ids.end())
				m_BoundsById.emplace_back(id->second, *FindPickBound(rItem));
	for (const auto& [id, rBound] : m_BoundsById)
		if (!i_rFrustum.Contains(rBound))
			Exclude(id);
}

} // namespace OrlexGraphics
