#include "QmlPage.h"

#include <gtest/gtest.h>

#include <QSignalSpy>
#include <QStandardItemModel>

using NVX::ISelectionItem;

namespace
{

ISelectionItem Target(std::uint32_t i_Index)
{
	return {NVX::ESelectionTarget, 0x0FFFFFFF, i_Index, {}};
}

ISelectionItem Source(std::uint32_t i_Index)
{
	return {NVX::ESelectionSourceSegment, 7, i_Index, {}};
}

/// Rows with a name, a weight and a selection item.
class VRows : public QStandardItemModel
{
public:
	explicit VRows(int i_Count)
	{
		setItemRoleNames(
		    {{Qt::UserRole, "sourceSegment"}, {Qt::UserRole + 1, "weight"}, {Qt::UserRole + 2, "selectionItem"}});
		for (int row = 0; row < i_Count; ++row)
		{
			auto* const pItem = new QStandardItem;
			pItem->setData(QString("LeftArm%1").arg(row), Qt::UserRole);
			pItem->setData(1.0 / 3.0, Qt::UserRole + 1);
			pItem->setData(QVariant::fromValue(Target(std::uint32_t(row))), Qt::UserRole + 2);
			appendRow(pItem);
		}
	}

	void Reset()
	{
		beginResetModel();
		endResetModel();
	}
};

const char* const c_Table = R"(
	OrlexTextField { id: field; objectName: "field"; width: 200
		property int selectedWhenLeft: -1
		onActiveFocusChanged: if (!activeFocus) selectedWhenLeft = Number(watcher.selected) }
	SelectionWatcher { id: watcher; item: rows.data(rows.index(2, 0), 258) }
	OrlexTableView { objectName: "table"; y: 40; width: 400; height: 22 * 6 + 2; model: rows
		columns: [{role: "sourceSegment", title: "Source", share: .5, sides: true},
			{role: "weight", title: "Weight", share: .25}] })";

} // namespace

TEST(Selection, OperationsOfTheSingleton)
{
	VRows rows(3);
	VQmlPage page;
	page.SetContext("rows", &rows);
	ASSERT_TRUE(page.Show(R"(
		property var item: rows.data(rows.index(1, 0), 258)
		function clearAndSelect() { SelectionManager.clearAndSelect(item) }
		function toggle() { SelectionManager.toggle(item) }
		function preselect() { SelectionManager.preselect(item) }
		function clearPreselection() { SelectionManager.clearPreselection() }
		function nonsense() { SelectionManager.clearAndSelect(undefined); SelectionManager.toggle("x")
			SelectionManager.preselect(3) }
		SelectionWatcher { objectName: "watcher"; id: watcher; item: page.item }
		property alias selected: watcher.selected
		property alias preselected: watcher.preselected)"));
	QQuickItem* const pRoot = page.View().rootObject();
	auto& rSelection = page.Selection().Selection();
	rSelection.Replace({Source(4), Target(0), Target(2)});
	int changes = 0;
	rSelection.ChangedSignal().Connect([&changes] { ++changes; });

	// Its own kind is cleared, the source segment stays; one change.
	QMetaObject::invokeMethod(pRoot, "clearAndSelect");
	EXPECT_EQ(rSelection.Items(), (std::vector{Source(4), Target(1)}));
	EXPECT_EQ(changes, 1);
	EXPECT_TRUE(pRoot->property("selected").toBool());
	EXPECT_FALSE(pRoot->property("preselected").toBool());

	QMetaObject::invokeMethod(pRoot, "toggle");
	EXPECT_EQ(rSelection.Items(), std::vector{Source(4)});
	EXPECT_FALSE(pRoot->property("selected").toBool());
	QMetaObject::invokeMethod(pRoot, "toggle");
	EXPECT_EQ(rSelection.Items(), (std::vector{Source(4), Target(1)}));

	page.Selection().PreSelection().Replace({Source(1)});
	QMetaObject::invokeMethod(pRoot, "preselect");
	EXPECT_EQ(page.Selection().PreSelection().Items(), std::vector{Target(1)});
	EXPECT_TRUE(pRoot->property("preselected").toBool());
	QMetaObject::invokeMethod(pRoot, "clearPreselection");
	EXPECT_TRUE(page.Selection().PreSelection().Items().empty());
	EXPECT_FALSE(pRoot->property("preselected").toBool());

	changes = 0;
	QMetaObject::invokeMethod(pRoot, "nonsense");
	EXPECT_EQ(changes, 0);

	// Without an item nothing is selected.
	pRoot->setProperty("item", QVariant());
	EXPECT_FALSE(pRoot->property("selected").toBool());
}

TEST(Selection, EnginesHaveTheirOwn)
{
	VRows rows(1);
	VQmlPage first;
	VQmlPage second;
	const char* const pQml =
	    "property bool selected: watcher.selected; property var item: rows.data(rows.index(0, 0), 258)\n"
	    "SelectionWatcher { id: watcher; item: page.item }";
	for (VQmlPage* pPage : {&first, &second})
	{
		pPage->SetContext("rows", &rows);
		ASSERT_TRUE(pPage->Show(pQml));
	}
	second.Selection().Selection().Replace({Target(0)});
	EXPECT_FALSE(first.View().rootObject()->property("selected").toBool());
	EXPECT_TRUE(second.View().rootObject()->property("selected").toBool());
}

TEST(Table, HoverAndPress)
{
	VRows rows(4);
	VQmlPage page;
	page.SetContext("rows", &rows);
	ASSERT_TRUE(page.Show(c_Table));
	auto& rSelection = page.Selection().Selection();
	auto& rPreSelection = page.Selection().PreSelection();
	rSelection.Replace({Source(4)});

	page.Hover("tableRow1");
	EXPECT_EVENTUALLY(rPreSelection.Items() == std::vector{Target(1)});
	page.Hover("tableRow3");
	EXPECT_EVENTUALLY(rPreSelection.Items() == std::vector{Target(3)});
	page.Hover("field");
	EXPECT_EVENTUALLY(rPreSelection.Items().empty());

	page.Press("tableRow2");
	EXPECT_EQ(rSelection.Items(), (std::vector{Source(4), Target(2)}));
	EXPECT_TRUE(page.Property("tableRows", "activeFocus").toBool());
}

TEST(Table, TakesTheFocusBeforeItSelects)
{
	VRows rows(4);
	VQmlPage page;
	page.SetContext("rows", &rows);
	ASSERT_TRUE(page.Show(c_Table));
	page.Click("field");
	ASSERT_EQ(page.FocusName(), "field");
	page.Press("tableRow2");
	EXPECT_EQ(page.Property("field", "selectedWhenLeft"), 0);
	EXPECT_EQ(page.Selection().Selection().Items(), std::vector{Target(2)});
}

TEST(Table, KeysMoveTheSelection)
{
	VRows rows(40);
	VQmlPage page;
	page.SetContext("rows", &rows);
	ASSERT_TRUE(page.Show(c_Table));
	page.Click("tableRow1");
	const struct
	{
		int m_Key;
		std::uint32_t m_Selected;
	} steps[] = {{Qt::Key_Down, 2}, {Qt::Key_Up, 1}, {Qt::Key_Home, 0}, {Qt::Key_Up, 0}, {Qt::Key_End, 39},
	    {Qt::Key_Down, 39}, {Qt::Key_Up, 38}};
	for (const auto& rStep : steps)
	{
		page.Key(rStep.m_Key);
		EXPECT_EQ(page.Selection().Selection().Items(), std::vector{Target(rStep.m_Selected)}) << rStep.m_Key;
	}
	EXPECT_TRUE(page.Has("tableRow39"));
}

TEST(Table, GoesToWhatIsSelectedElsewhere)
{
	VRows rows(40);
	VQmlPage page;
	page.SetContext("rows", &rows);
	ASSERT_TRUE(page.Show(c_Table));
	page.Click("tableRow1");
	page.Item("table")->setProperty("selectedIndex", 30);
	EXPECT_TRUE(page.Has("tableRow30"));
	page.Key(Qt::Key_Down);
	EXPECT_EQ(page.Selection().Selection().Items(), std::vector{Target(31)});
}

TEST(Table, KeepsItsScrollPositionOverAReset)
{
	VRows rows(100);
	VQmlPage page;
	page.SetContext("rows", &rows);
	ASSERT_TRUE(page.Show(c_Table));
	QQuickItem* const pRows = page.Item("tableRows");
	pRows->setProperty("contentY", 50 * 22 + 7);
	rows.Reset();
	EXPECT_EQ(pRows->property("contentY").toInt() - pRows->property("originY").toInt(), 50 * 22 + 7);
	QCoreApplication::processEvents();
	EXPECT_EQ(pRows->property("contentY").toInt() - pRows->property("originY").toInt(), 50 * 22 + 7);
	EXPECT_TRUE(page.Has("tableRow51"));

	// Where fewer rows are left, it ends at the last one.
	rows.removeRows(10, 90);
	rows.Reset();
	EXPECT_EVENTUALLY(pRows->property("contentY").toInt() - pRows->property("originY").toInt() == (10 - 5) * 22);
}
