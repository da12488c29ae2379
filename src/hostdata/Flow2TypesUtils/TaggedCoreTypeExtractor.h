#pragma once

#include "DebugServices/Assert.h"
#include "Flow2TypesUtils/ItemCache.h"

#include <map>

namespace Flow2TypesUtils
{

/// The latest item of each type that a scene reads, by tag. One thread at a time.
class VTaggedCoreTypeExtractor
{
public:
	/// From now on the type's items are kept. A type that is kept already stays as it is.
	/// @return false for a tag that the catalogue does not have.
	bool Insert(std::uint32_t i_Tag);

	/// Takes what a frame holds of the types that are kept.
	/// @return true if any item is another one than before.
	bool Update(const TesselPluginInterface::IFlowFrame& i_rFrame);

	/// Forgets the items and goes on keeping their types.
	void Reset();

	/// The latest value; null if there was none yet. The tag must have been inserted: if not, an assertion fails, and
	/// then null is returned.
	std::shared_ptr<const void> Get(std::uint32_t i_Tag) const;

	/// The same as what it is. An assertion fails if items of this tag carry another type.
	template <typename T>
	std::shared_ptr<const T> Get(std::uint32_t i_Tag) const
	{
		const VItemCache* const pCache = Cache(i_Tag);
		if (!pCache)
			return nullptr;
		const auto* const pTyped = dynamic_cast<const VItemCacheTyped<T>*>(pCache);
		NVX_ASSERT(pTyped != nullptr);
		return pTyped ? pTyped->Value() : nullptr;
	}

	/// For its generation and item; as Get for a tag that was not inserted.
	const VItemCache* Cache(std::uint32_t i_Tag) const;

private:
	std::map<std::uint32_t, std::unique_ptr<VItemCache>> m_ItemCacheMap;
};

} // namespace Flow2TypesUtils
