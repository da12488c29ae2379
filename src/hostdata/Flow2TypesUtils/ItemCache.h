#pragma once

#include "TesselPluginInterface/IFlowFrame.h"

#include <cstdint>
#include <memory>
#include <string>
#include <utility>

namespace Flow2TypesUtils
{

/// The latest item of one flow type, for a scene that asks each frame and works only when something changed.
class VItemCache
{
public:
	virtual ~VItemCache() = default;

	virtual const std::string& FlowType() const = 0;

	/// Takes the item of this flow type from a frame. A frame without one leaves the latest.
	/// @return true if it is another item than the latest, which is a comparison of pointers: its value may be equal.
	virtual bool Update(const TesselPluginInterface::IFlowFrame& i_rFrame) = 0;

	/// Forgets the item, so that the next one counts as changed whichever it is.
	virtual void Reset() = 0;

	/// How often the latest item became another one; for several that read one cache.
	virtual std::uint64_t Generation() const = 0;

	/// Null before the first item, and for an item without a value of the type that this cache reads.
	virtual std::shared_ptr<const void> GetValue() const = 0;

	/// A new owner of the item, to pass it on.
	virtual NVX::CountedPointer<TesselPluginInterface::IFlowItem> GetItem() const = 0;
};

template <typename T>
class VItemCacheTyped : public VItemCache
{
public:
	explicit VItemCacheTyped(std::string i_FlowType) : m_FlowType(std::move(i_FlowType)) {}

	const std::string& FlowType() const override { return m_FlowType; }

	bool Update(const TesselPluginInterface::IFlowFrame& i_rFrame) override
	{
		NVX::CountedPointer<TesselPluginInterface::IFlowItem> pItem = i_rFrame.Item(m_FlowType);
		// The cache owns the item, so that no later one can have its address.
		if (!pItem || pItem == m_pItem)
			return false;
		m_pItem = std::move(pItem);
		m_pValue = TesselPluginInterface::ItemValue<T>(m_pItem);
		++m_Generation;
		return true;
	}

	void Reset() override
	{
		m_pItem = nullptr;
		m_pValue = nullptr;
	}

	std::uint64_t Generation() const override { return m_Generation; }
	std::shared_ptr<const void> GetValue() const override { return m_pValue; }
	NVX::CountedPointer<TesselPluginInterface::IFlowItem> GetItem() const override { return m_pItem; }

	const std::shared_ptr<const T>& Value() const { return m_pValue; }

private:
	const std::string m_FlowType;
	NVX::CountedPointer<TesselPluginInterface::IFlowItem> m_pItem;
	std::shared_ptr<const T> m_pValue;
	std::uint64_t m_Generation = 0;
};

} // namespace Flow2TypesUtils
