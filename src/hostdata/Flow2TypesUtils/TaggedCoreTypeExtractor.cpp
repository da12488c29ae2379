#include "Flow2TypesUtils/TaggedCoreTypeExtractor.h"

#include "Flow2TypesUtils/ItemTypes.h"

namespace Flow2TypesUtils
{

bool VTaggedCoreTypeExtractor::Insert(std::uint32_t i_Tag)
{
	const VItemDescriptor* const pType = FindItemType(i_Tag);
	if (!pType)
		return false;
	std::unique_ptr<VItemCache>& rpCache = m_ItemCacheMap[i_Tag];
	if (!rpCache)
		rpCache = VisitItemType(pType->m_Value,
		    [pType]<typename T>(std::type_identity<T>) -> std::unique_ptr<VItemCache>
		    { return std::make_unique<VItemCacheTyped<T>>(pType->m_Name); });
	return true;
}

bool VTaggedCoreTypeExtractor::Update(const TesselPluginInterface::IFlowFrame& i_rFrame)
{
	bool bChanged = false;
	for (const auto& [tag, pCache] : m_ItemCacheMap)
		bChanged |= pCache->Update(i_rFrame);
	return bChanged;
}

void VTaggedCoreTypeExtractor::Reset()
{
	for (const auto& [tag, pCache] : m_ItemCacheMap)
		pCache->Reset();
}

std::shared_ptr<const void> VTaggedCoreTypeExtractor::Get(std::uint32_t i_Tag) const
{
	const VItemCache* const pCache = Cache(i_Tag);
	return pCache ? pCache->GetValue() : nullptr;
}

const VItemCache* VTaggedCoreTypeExtractor::Cache(std::uint32_t i_Tag) const
{
	const auto It = m_ItemCacheMap.find(i_Tag);
	NVX_ASSERT(It != m_ItemCacheMap.end());
	return It != m_ItemCacheMap.end() ? It->second.get() : nullptr;
}

} // namespace Flow2TypesUtils
