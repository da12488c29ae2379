#pragma once

#include "NVX/ISelectionItem.h"
#include "NVX/Signal.h"

#include <cstdint>
#include <vector>

namespace TesselPluginInterface
{

/// A set of items in the order in which they came; an item stands in it once. User interface thread only.
class ISelection
{
public:
	virtual ~ISelection() = default;

	virtual const std::vector<NVX::ISelectionItem>& Items() const = 0;

	/// Those of one kind, in order.
	virtual std::vector<NVX::ISelectionItem> ItemsOfKind(std::uint32_t i_Kind) const = 0;

	virtual void Replace(const std::vector<NVX::ISelectionItem>& i_rItems) = 0;
	virtual void Add(const std::vector<NVX::ISelectionItem>& i_rItems) = 0;
	virtual void Remove(const std::vector<NVX::ISelectionItem>& i_rItems) = 0;
	virtual void Toggle(const std::vector<NVX::ISelectionItem>& i_rItems) = 0;

	/// Fires after an operation that changed the items, and only then.
	virtual NVX::VSignal<>& ChangedSignal() = 0;
};

/// What the operator has selected, and what the mouse points at.
class ISelectionManager
{
public:
	virtual ~ISelectionManager() = default;

	virtual ISelection& Selection() = 0;
	virtual ISelection& PreSelection() = 0;
};

} // namespace TesselPluginInterface
