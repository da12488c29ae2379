#include "CoreOrlexTypes/NameHash.h"
#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectState.h"
#include "Flow2TypesUtils/FlowParametersItem.h"
#include "Flow2TypesUtils/ItemTypes.h"
#include "Flow2TypesUtils/TaggedCoreTypeExtractor.h"
#include "InMemoryHost/PluginContext.h"

#include <gtest/gtest.h>

namespace
{

using namespace Flow2TypesUtils;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using TesselPluginInterface::SetItemValue;

/// Puts a value of each type into a new item of the row's type and asks the extractor for it by the row's tag.
template <typename T>
bool Passes(const VItemDescriptor& i_rRow)
{
	InMemoryHost::VPluginContext host;
	const auto pItem = host.GetItemFactory()->CreateItem(i_rRow.m_Name);
	const auto pValue = std::make_shared<const T>();
	if (!SetItemValue(pItem, pValue))
		return false;
	const auto pFrame = host.GetFrameFactory()->CreateFrame();
	pFrame->AddItem(pItem);
	VTaggedCoreTypeExtractor extractor;
	EXPECT_TRUE(extractor.Insert(i_rRow.m_Tag));
	EXPECT_TRUE(extractor.Update(*pFrame));
	return extractor.Get<T>(i_rRow.m_Tag) == pValue && extractor.Get(i_rRow.m_Tag) == pValue;
}

/// What the host knows these items by: a change of any row gives the list another hash.
TEST(ItemCatalogue, IsTheHosts)
{
	std::string list;
	for (const VItemDescriptor& rRow : ItemCatalogue())
	{
		SCOPED_TRACE(rRow.m_Name);
		EXPECT_EQ(rRow.m_Version, 1u);
		EXPECT_EQ(rRow.m_Count, 0u);
		EXPECT_EQ(FindItemType(rRow.m_Tag), &rRow);
		EXPECT_EQ(FindItemType(rRow.m_Name), &rRow);
		const std::pair<const char*, bool> carried[] = {{"subject", Passes<VSubject>(rRow)},
		    {"parametrised", Passes<VSubjectParametrised>(rRow)},
		    {"application data", Passes<VSubjectApplicationData>(rRow)},
		    {"pose", Passes<CoreOrlexTypes::VSubjectDynamicParameters>(rRow)},
		    {"settings", Passes<CoreOrlexTypes::VSubjectSettings>(rRow)},
		    {"labels", Passes<CoreOrlexTypes::VReconstructionLabelSet>(rRow)}, {"bytes", Passes<VItemBytes>(rRow)}};
		list += std::to_string(rRow.m_Tag) + " " + rRow.m_Name + ", " + rRow.m_Text + ":";
		for (const auto& [pName, bPasses] : carried)
			list += bPasses ? std::string(" ") + pName : "";
		list += '\n';
	}
	EXPECT_EQ(ItemCatalogue().size(), 41u);
	EXPECT_EQ(CoreOrlexTypes::HashName(list), 1330808927u) << list;
}

TEST(ItemCatalogue, TagsIdentifyAndTextsDoNot)
{
	EXPECT_EQ(FindItemType("FlowSubject")->m_Text, FindItemType("FlowSubjectForSolving")->m_Text);
	EXPECT_NE(FindItemType("FlowSubject")->m_Tag, FindItemType("FlowSubjectForSolving")->m_Tag);
	for (const std::uint32_t tag : {0u, 4095u, 4100u, 4161u, 4165u, 0xFFFFFFFFu})
		EXPECT_EQ(FindItemType(tag), nullptr) << tag;
	EXPECT_EQ(FindItemType("Subject Item"), nullptr);
	EXPECT_EQ(FindItemType(FlowParametersItem::c_pName), nullptr) << "parameters have no tag";
}

} // namespace
