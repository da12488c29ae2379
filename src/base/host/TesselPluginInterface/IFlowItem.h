#pragma once

#include "NVX/CountedPointer.h"

#include <memory>
#include <string>
#include <utility>

namespace TesselPluginInterface
{

/// A value on its way through the host's flow, under the name of its flow type ("FlowSubject", ...).
/// Immutable in spirit: filled once after it was made, then shared; an edit makes a new item.
class IFlowItem : public NVX::ICounted
{
public:
	virtual const std::string& FlowType() const = 0;
};

/// An item that carries a T. The host moves items without knowing their types; who knows the type asks for it with
/// ItemValue and SetItemValue.
template <typename T>
class IFlowItemOf : public IFlowItem
{
public:
	/// Null until a value was set. Threads may share it.
	virtual std::shared_ptr<const T> Value() const = 0;
	virtual void SetValue(std::shared_ptr<const T> i_pValue) = 0;
};

/// The value of an item; null for no item, an item of another type, or one without a value.
template <typename T>
std::shared_ptr<const T> ItemValue(const NVX::CountedPointer<IFlowItem>& i_rpItem)
{
	const auto* const pTyped = dynamic_cast<const IFlowItemOf<T>*>(i_rpItem.get());
	return pTyped ? pTyped->Value() : nullptr;
}

/// False for no item and for an item of another type.
template <typename T>
bool SetItemValue(const NVX::CountedPointer<IFlowItem>& i_rpItem, std::shared_ptr<const T> i_pValue)
{
	auto* const pTyped = dynamic_cast<IFlowItemOf<T>*>(i_rpItem.get());
	if (pTyped)
		pTyped->SetValue(std::move(i_pValue));
	return pTyped != nullptr;
}

} // namespace TesselPluginInterface
