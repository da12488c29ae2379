#include "InMemoryHost/Flow.h"

#include "Flow2TypesUtils/FlowParametersItem.h"
#include "Flow2TypesUtils/ItemTypes.h"
#include "Flow2TypesUtils/SceneItems.h"

#include <algorithm>

using NVX::CountedPointer;
using TesselPluginInterface::IFlowFrame;
using TesselPluginInterface::IFlowItem;

namespace InMemoryHost
{

VItemFactory::VItemFactory()
{
	for (const Flow2TypesUtils::VItemDescriptor& rType : Flow2TypesUtils::ItemCatalogue())
		Flow2TypesUtils::VisitItemType(
		    rType.m_Value, [this, &rType]<typename T>(std::type_identity<T>) { Register<T>(rType.m_Name); });
	Register<Flow2TypesUtils::FlowParametersItem>(Flow2TypesUtils::FlowParametersItem::c_pName);
	Register<Flow2TypesUtils::FlowSubjectSceneTransformItem>(Flow2TypesUtils::FlowSubjectSceneTransformItem::c_pName);
	Register<Flow2TypesUtils::FlowUpAxisItem>(Flow2TypesUtils::FlowUpAxisItem::c_pName);
	Register<Flow2TypesUtils::FlowFloorItem>(Flow2TypesUtils::FlowFloorItem::c_pName);
}

CountedPointer<IFlowItem> VItemFactory::CreateItem(const std::string& i_rFlowType)
{
	const auto found = m_Makers.find(i_rFlowType);
	return found == m_Makers.end() ? nullptr : CountedPointer<IFlowItem>(found->second());
}

void VFlowFrame::AddItem(const CountedPointer<IFlowItem>& i_rpItem)
{
	if (i_rpItem)
		m_Items.push_back(i_rpItem);
}

CountedPointer<IFlowItem> VFlowFrame::Item(const std::string& i_rFlowType) const
{
	const auto found = std::find_if(m_Items.rbegin(), m_Items.rend(),
	    [&i_rFlowType](const CountedPointer<IFlowItem>& i_rpItem) { return i_rpItem->FlowType() == i_rFlowType; });
	return found == m_Items.rend() ? nullptr : *found;
}

CountedPointer<IFlowFrame> VFlowFrame::Copy() const
{
	auto* const pCopy = new VFlowFrame;
	pCopy->m_Items = m_Items;
	return CountedPointer<IFlowFrame>(pCopy);
}

CountedPointer<IFlowFrame> VFrameFactory::CreateFrame()
{
	return CountedPointer<IFlowFrame>(new VFlowFrame);
}

} // namespace InMemoryHost
