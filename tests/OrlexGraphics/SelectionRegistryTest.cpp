#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "CoreGraphics/RenderContext.h"
#include "OrlexGraphics/picking/Picking.h"

#include <gtest/gtest.h>

namespace
{

using CoreGraphics::ERenderId;
using CoreGraphics::ERenderNormal;
using CoreGraphics::ERenderPick;
using CoreGraphics::VSelectionId;
using NVX::ISelectionItem;
using OrlexGraphics::VSelectionRegistry;

ISelectionItem Segment(std::uint32_t i_Index)
{
	return {NVX::ESelectionTargetSegment, 0x0fffffff, i_Index, {}};
}

TEST(SelectionRegistry, GivesEachItemOneIdInAFrame)
{
	VSelectionRegistry registry;
	EXPECT_EQ(registry.Allocate(Segment(7)), 1u);
	EXPECT_EQ(registry.Allocate(Segment(8), "Arm"), 2u);
	EXPECT_EQ(registry.Allocate(Segment(7)), 1u);
	EXPECT_EQ(registry.GetId(Segment(8)).m_Id, 2u);
	EXPECT_EQ(registry.GetName(2), "Arm");
	EXPECT_EQ(registry.GetName(2 | CoreGraphics::ESelectionIdSelected), "Arm");
	EXPECT_EQ(registry.GetName(1), "");

	registry.SetItemBound(Segment(7), {1, 2, 3, 4});
	const auto pPlaces = registry.GetPlaces();
	registry.Reset();
	EXPECT_EQ(registry.GetItemBound(Segment(7)), nullptr);
	EXPECT_EQ(pPlaces->m_Bounds.size(), 1u) << "those of a frame stay for who still reads them";
	EXPECT_EQ(registry.GetName(2), "");
	EXPECT_EQ(registry.Allocate(Segment(8)), 1u);
}

TEST(SelectionRegistry, ResolvesIds)
{
	VSelectionRegistry registry;
	ISelectionItem item;
	EXPECT_FALSE(registry.ResolveId(1, item)) << "nothing is there";
	registry.Allocate(Segment(5));
	const ISelectionItem parents[] = {{2, 1, 0, {}}, {3, 1, 0, {}}, {5, 1, 0, {}}, {31, 1, 0, {}}, {4, 1, 9, {}}};
	std::uint32_t id = 2;
	for (const ISelectionItem& rParent : parents)
	{
		EXPECT_EQ(registry.Allocate(rParent, 10), id);
		ISelectionItem expected = rParent;
		if (rParent.m_Kind != 4)
			expected.m_ElementIndex = 3;
		ASSERT_TRUE(registry.ResolveId(id + 3, item)) << rParent.m_Kind;
		EXPECT_EQ(item, expected) << rParent.m_Kind;
		id += 10;
	}
	ASSERT_TRUE(registry.ResolveId(1 | CoreGraphics::ESelectionIdSelected | CoreGraphics::ESelectionIdPrimary, item));
	EXPECT_EQ(item, Segment(5));
	EXPECT_FALSE(registry.ResolveId(0, item));
	EXPECT_TRUE(registry.ResolveId(id - 1, item));
	EXPECT_FALSE(registry.ResolveId(id, item));
	EXPECT_FALSE(registry.ResolveId(0x1fffff, item));
}

TEST(SelectionRegistry, EndsWithItsIds)
{
	VSelectionRegistry registry;
	EXPECT_EQ(registry.Allocate({2, 1, 0, {}}, 0x1ffffe), 1u);
	EXPECT_EQ(registry.Allocate(Segment(1), 2), 0u) << "there is room for one";
	EXPECT_EQ(registry.Allocate(Segment(1)), 0x1fffffu);
	EXPECT_EQ(registry.Allocate(Segment(2)), 0u);
	EXPECT_EQ(registry.GetId(Segment(2)), VSelectionId());
	ISelectionItem item;
	ASSERT_TRUE(registry.ResolveId(0x1fffff, item));
	EXPECT_EQ(item, Segment(1));
	EXPECT_EQ(registry.GetId(Segment(1)).m_Green, 1.0f);
}

TEST(SelectionRegistry, MarksWhatIsSelected)
{
	VSelectionRegistry registry;
	const ISelectionItem source{NVX::ESelectionSourceSegment, 3, 1, {}};
	registry.SetSelection({Segment(1), source, Segment(2)}, {Segment(2), Segment(3)});
	registry.GetId(Segment(1));
	EXPECT_FALSE(registry.HasFlagged()) << "only a frame takes a selection";
	registry.Reset();
	EXPECT_FALSE(registry.HasFlagged()) << "of what is selected nothing is there yet";

	const struct
	{
		ISelectionItem m_Item;
		std::uint32_t m_Flags;
		bool m_bHiddenInIds;
	} rows[] = {
	    {Segment(1), 0xa00000, false},
	    {Segment(2), 0x600000, false},
	    {Segment(3), 0x400000, false},
	    {Segment(4), 0, true},
	    // Alone of its kind.
	    {source, 0x200000, false},
	};
	std::uint32_t id = 1;
	for (const auto& rRow : rows)
	{
		const VSelectionId record = registry.GetId(rRow.m_Item);
		EXPECT_EQ(record.m_Id, rRow.m_Flags | id) << id;
		EXPECT_FLOAT_EQ(record.m_Red, static_cast<float>(id) / 255.0f);
		EXPECT_FLOAT_EQ(record.m_Blue, static_cast<float>(rRow.m_Flags >> 16) / 255.0f);
		EXPECT_EQ(registry.IsHidden(record, ERenderId), rRow.m_bHiddenInIds) << id;
		EXPECT_FALSE(registry.IsHidden(record, ERenderNormal));
		EXPECT_FALSE(registry.IsHidden(record, ERenderPick));
		++id;
	}
	EXPECT_TRUE(registry.HasFlagged());

	// Handles show by their colour, not by an outline.
	for (const std::uint32_t kind : {28u, 34u})
	{
		const ISelectionItem handle{kind, 0, 1, {}};
		registry.SetSelection({handle}, {});
		registry.Reset();
		EXPECT_EQ(registry.GetId(handle).m_Id, 0x200001u);
		EXPECT_FALSE(registry.HasFlagged()) << kind;
	}
}

TEST(SelectionRegistry, LeavesOutOfPicksWhatIsExcludedOrElsewhere)
{
	VSelectionRegistry registry;
	registry.SetSelection({Segment(1)}, {});
	registry.Reset();
	const VSelectionId selected = registry.GetId(Segment(1));
	const VSelectionId other = registry.GetId(Segment(2));
	const VSelectionId unbounded = registry.GetId(Segment(3));
	registry.ClearExcluded();
	registry.Exclude(selected.m_Id & CoreGraphics::ESelectionIdMask);
	EXPECT_TRUE(registry.IsHidden(selected, ERenderPick));
	EXPECT_FALSE(registry.IsHidden(selected, ERenderId));
	EXPECT_FALSE(registry.IsHidden(other, ERenderPick));
	registry.ClearExcluded();
	EXPECT_FALSE(registry.IsHidden(selected, ERenderPick));

	// The upper right quarter of clip space.
	registry.SetItemBound(Segment(1), {0.5f, 0.5f, 0.0f, 0.1f});
	registry.SetItemBound(Segment(2), {-0.5f, 0.5f, 0.0f, 0.1f});
	registry.ExcludeOutside(OrlexGraphics::MakePickFrustum(QMatrix4x4(), QRect(50, 50, 50, 50), QSize(100, 100)));
	EXPECT_FALSE(registry.IsHidden(selected, ERenderPick));
	EXPECT_TRUE(registry.IsHidden(other, ERenderPick));
	EXPECT_FALSE(registry.IsHidden(unbounded, ERenderPick));
}

} // namespace
