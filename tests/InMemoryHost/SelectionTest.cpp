#include "InMemoryHost/PluginContext.h"

#include <gtest/gtest.h>

namespace
{

using NVX::ISelectionItem;
using TesselPluginInterface::ISelection;

/// One letter for each item: a small one for a source segment, a capital for a target segment.
std::vector<ISelectionItem> Items(std::string_view i_Letters)
{
	std::vector<ISelectionItem> items;
	for (const char letter : i_Letters)
		items.push_back(letter >= 'a'
		        ? ISelectionItem{NVX::ESelectionSourceSegment, 1, std::uint32_t(letter - 'a'), {}}
		        : ISelectionItem{NVX::ESelectionTargetSegment, 1, std::uint32_t(letter - 'A'), {}});
	return items;
}

std::string Letters(const std::vector<ISelectionItem>& i_rItems)
{
	std::string letters;
	for (const ISelectionItem& rItem : i_rItems)
		letters += char((rItem.m_Kind == NVX::ESelectionSourceSegment ? 'a' : 'A') + int(rItem.m_ElementIndex));
	return letters;
}

TEST(Selection, OperationsRows)
{
	using VOperation = void (ISelection::*)(const std::vector<ISelectionItem>&);
	const struct
	{
		const char* m_pName;
		const char* m_pBefore;
		VOperation m_pOperation;
		const char* m_pArgument;
		const char* m_pAfter;
		int m_Fired;
	} rows[] = {
	    {"replace", "abC", &ISelection::Replace, "Cd", "Cd", 1},
	    {"replace by itself", "abC", &ISelection::Replace, "abC", "abC", 0},
	    {"replace by another order", "ab", &ISelection::Replace, "ba", "ba", 1},
	    {"replace, item twice", "", &ISelection::Replace, "aba", "ab", 1},
	    {"clear", "ab", &ISelection::Replace, "", "", 1},
	    {"clear nothing", "", &ISelection::Replace, "", "", 0},
	    {"add keeps order", "bA", &ISelection::Add, "ab", "bAa", 1},
	    {"add known ones", "bA", &ISelection::Add, "Ab", "bA", 0},
	    {"same index of another kind", "a", &ISelection::Add, "A", "aA", 1},
	    {"remove", "abcD", &ISelection::Remove, "Db", "ac", 1},
	    {"remove unknown", "ab", &ISelection::Remove, "cA", "ab", 0},
	    {"toggle", "abc", &ISelection::Toggle, "bD", "acD", 1},
	    {"toggle, item twice", "a", &ISelection::Toggle, "aabb", "b", 1},
	    {"toggle nothing", "a", &ISelection::Toggle, "", "a", 0},
	};
	for (const auto& rRow : rows)
	{
		InMemoryHost::VSelection selection;
		selection.Replace(Items(rRow.m_pBefore));
		int fired = 0;
		selection.ChangedSignal().Connect([&fired] { ++fired; });
		(selection.*rRow.m_pOperation)(Items(rRow.m_pArgument));
		EXPECT_EQ(Letters(selection.Items()), rRow.m_pAfter) << rRow.m_pName;
		EXPECT_EQ(fired, rRow.m_Fired) << rRow.m_pName;
	}
}

TEST(Selection, ItemsOfOneKind)
{
	InMemoryHost::VSelection selection;
	selection.Replace(Items("aBcD"));
	EXPECT_EQ(Letters(selection.ItemsOfKind(NVX::ESelectionTargetSegment)), "BD");
	EXPECT_EQ(Letters(selection.ItemsOfKind(NVX::ESelectionTarget)), "");
}

TEST(Selection, TheHostKeepsSelectionAndPreSelectionApart)
{
	InMemoryHost::VPluginContext host;
	const auto pManager = host.GetSelectionManager();
	ASSERT_TRUE(pManager);
	pManager->Selection().Add(Items("a"));
	pManager->PreSelection().Add(Items("b"));
	EXPECT_EQ(Letters(host.GetSelectionManager()->Selection().Items()), "a");
	EXPECT_EQ(Letters(host.SelectionManager().PreSelection().Items()), "b");
}

TEST(Selection, ACallbackMaySelect)
{
	InMemoryHost::VSelection selection;
	selection.ChangedSignal().Connect([&selection] { selection.Add(Items("z")); });
	selection.Add(Items("a"));
	EXPECT_EQ(Letters(selection.Items()), "az");
}

} // namespace
