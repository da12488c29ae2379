#pragma once

#include "TesselPluginInterface/IFlowItem.h"

namespace TesselPluginInterface
{

/// The items of one moment of the flow. Filled by its maker, then only read.
class IFlowFrame : public NVX::ICounted
{
public:
	/// Keeps an owner of the item. Null is taken and ignored.
	virtual void AddItem(const NVX::CountedPointer<IFlowItem>& i_rpItem) = 0;

	/// The item of this flow type that was added last, null if there is none.
	virtual NVX::CountedPointer<IFlowItem> Item(const std::string& i_rFlowType) const = 0;

	/// Another frame with the same items, for its maker to add to.
	virtual NVX::CountedPointer<IFlowFrame> Copy() const = 0;
};

class IFrameFactory : public NVX::ICounted
{
public:
	virtual NVX::CountedPointer<IFlowFrame> CreateFrame() = 0;
};

} // namespace TesselPluginInterface
