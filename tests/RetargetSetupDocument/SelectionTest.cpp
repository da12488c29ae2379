#include "RetargetSetupDocument/RetargetSetupSelection.h"
#include "RetargetSetupDocument/StaleSelection.h"
#include "TestDocument.h"

#include <QMetaObject>
#include <QMetaProperty>

namespace
{

using NVX::ISelectionItem;

ISelectionItem Item(std::uint32_t i_Kind, std::uint32_t i_Index, std::uint32_t i_SubjectId = 0x0FFFFFFFu)
{
	return {i_Kind, i_SubjectId, i_Index, {}};
}

std::string Text(const VRetargetSetupSelection& i_rSelection)
{
	return std::to_string(i_rSelection.property("selectedSourceSegment").toInt()) + " "
	    + std::to_string(i_rSelection.property("selectedTargetSegment").toInt()) + " "
	    + std::to_string(i_rSelection.property("selectedTarget").toInt());
}

class Selection : public testing::Test
{
protected:
	Selection()
	{
		QObject::connect(m_pSelection.get(), &VRetargetSetupSelection::Changed, [this] { ++m_Changes; });
	}

	InMemoryHost::VPluginContext m_Host;
	std::shared_ptr<VRetargetSetupSelection> m_pSelection =
	    NVX::MakeShared<VRetargetSetupSelection>(m_Host.GetDispatcher(), m_Host.GetSelectionManager());
	int m_Changes = 0;
};

TEST_F(Selection, ThreeIntegersForQml)
{
	EXPECT_EQ(Text(*m_pSelection), "-1 -1 -1");
	for (const char* const pName : {"selectedSourceSegment", "selectedTargetSegment", "selectedTarget"})
	{
		const QMetaObject& rMeta = VRetargetSetupSelection::staticMetaObject;
		const QMetaProperty property = rMeta.property(rMeta.indexOfProperty(pName));
		EXPECT_EQ(property.type(), QVariant::Int) << pName;
		EXPECT_STREQ(property.notifySignal().methodSignature(), "Changed()") << pName;
		EXPECT_TRUE(property.write(m_pSelection.get(), 4)) << pName;
		EXPECT_EQ(property.read(m_pSelection.get()).toInt(), 4) << pName;
	}
	EXPECT_EQ(m_Changes, 3);
	m_pSelection->setProperty("selectedTarget", 4);
	EXPECT_EQ(m_Changes, 3) << "its own value";
}

TEST_F(Selection, FollowsTheHostRows)
{
	const struct
	{
		const char* m_pName;
		std::vector<ISelectionItem> m_Items;
		const char* m_pExpected;
		int m_Changes;
		std::array<int, 3> m_Counts;
	} rows[] = {
	    {"one source segment", {Item(11, 2)}, "2 -1 -1", 1, {1, 0, 0}},
	    {"a pair for a target", {Item(11, 2), Item(14, 7)}, "2 7 -1", 1, {1, 1, 0}},
	    {"all three at once are told once", {Item(16, 1), Item(14, 3), Item(11, 0)}, "0 3 1", 1, {1, 1, 1}},
	    {"two source segments are none", {Item(11, 2), Item(11, 3), Item(14, 7)}, "-1 7 -1", 1, {2, 1, 0}},
	    {"three are none, too", {Item(16, 2), Item(16, 3), Item(16, 4)}, "-1 -1 -1", 1, {0, 0, 3}},
	    {"another subject does not count", {Item(11, 2), Item(11, 5, 9), Item(14, 1, 9)}, "2 -1 -1", 1, {1, 0, 0}},
	    {"other kinds tell nothing", {Item(28, 2), Item(11, 2), Item(7, 0)}, "2 -1 -1", 0, {1, 0, 0}},
	    {"nothing", {}, "-1 -1 -1", 1, {0, 0, 0}},
	};
	for (const auto& rRow : rows)
	{
		m_Changes = 0;
		m_Host.SelectionManager().Selection().Replace(rRow.m_Items);
		EXPECT_EQ(m_Changes, 0) << "through the dispatcher only";
		m_Host.Dispatcher().RunPending();
		EXPECT_EQ(Text(*m_pSelection), rRow.m_pExpected) << rRow.m_pName;
		EXPECT_EQ(m_Changes, rRow.m_Changes) << rRow.m_pName;
		const std::array<int, 3> counts{m_pSelection->property("sourceSegmentCount").toInt(),
		    m_pSelection->property("targetSegmentCount").toInt(), m_pSelection->property("targetCount").toInt()};
		EXPECT_EQ(counts, rRow.m_Counts) << rRow.m_pName;
	}
	m_Host.SelectionManager().PreSelection().Add({Item(11, 1)});
	EXPECT_EQ(m_Host.Dispatcher().PendingCount(), 0u) << "pointing selects nothing";
}

TEST_F(Selection, LetsGoOfTheHostWhenItEnds)
{
	m_Host.SelectionManager().Selection().Add({Item(11, 1)});
	m_pSelection.reset();
	EXPECT_EQ(m_Host.Dispatcher().RunPending(), 1u) << "what was posted finds no object";
	EXPECT_EQ(m_Host.SelectionManager().Selection().ChangedSignal().Count(), 0u);
}

using StaleSelection = VDocumentTest;

TEST_F(StaleSelection, ItemsBeyondTheirListsGo)
{
	SetSmallSubjects();
	m_Document.AddTarget(1, 1, true, true);
	auto& rManager = m_Host.SelectionManager();
	const std::vector<ISelectionItem> kept{
	    Item(11, 4), Item(14, 4), Item(16, 1), Item(11, 5, 9), Item(16, 2, 9), Item(28, 100), Item(7, 100)};
	const std::vector<ISelectionItem> stale{Item(11, 5), Item(14, 5), Item(16, 2), Item(16, 0xFFFFFFFFu)};
	for (auto* const pSelection : {&rManager.Selection(), &rManager.PreSelection()})
	{
		pSelection->Replace(kept);
		pSelection->Add(stale);
	}
	RetargetSetup::DropStaleItems(m_Document, rManager);
	EXPECT_EQ(rManager.Selection().Items(), kept);
	EXPECT_EQ(rManager.PreSelection().Items(), kept);

	int fired = 0;
	rManager.Selection().ChangedSignal().Connect([&fired] { ++fired; });
	RetargetSetup::DropStaleItems(m_Document, rManager);
	EXPECT_EQ(fired, 0) << "nothing left to drop";
	m_Document.RemoveTarget(0);
	RetargetSetup::DropStaleItems(m_Document, rManager);
	EXPECT_EQ(fired, 1);
	EXPECT_TRUE(rManager.Selection().ItemsOfKind(16) == std::vector{Item(16, 2, 9)});
}

} // namespace
