#include "InMemoryHost/Flow.h"

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"

#include <algorithm>

using NVX::CountedPointer;
using TesselPluginInterface::IFlowFrame;
using TesselPluginInterface::IFlowItem;

namespace InMemoryHost
{

VItemFactory::VItemFactory()
{
	for (const std::string flavour : {"", "ForSolving"})
	{
		Register<CoreOrlexTypes::VSubject>("FlowSubject" + flavour);
		Register<CoreOrlexTypes::VSubjectApplicationData>("FlowSubjectApplicationData" + flavour);
		Register<CoreOrlexTypes::VSubjectParametrised>("FlowSubjectParametrised" + flavour);
	}
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

CountedPointer<IFlowFrame> VFrameFactory::CreateFrame()
{
	return CountedPointer<IFlowFrame>(new VFlowFrame);
}

} // namespace InMemoryHost
