#pragma once

#include "TesselPluginInterface/IFlowItem.h"

namespace TesselPluginInterface
{

class IItemFactory : public NVX::ICounted
{
public:
	/// A new item without a value. Null for a flow type that the host does not know.
	virtual NVX::CountedPointer<IFlowItem> CreateItem(const std::string& i_rFlowType) = 0;
};

} // namespace TesselPluginInterface
