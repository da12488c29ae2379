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

class Table : public testing::Test
{
protected:
	void Show(int i_Rows)
	{
		m_pRows = std::make_unique<VRows>(i_Rows);
		m_Page.SetContext("rows", m_pRows.get());
		ASSERT_TRUE(m_Page.Show(c_Table));
	}

	std::unique_ptr<VRows> m_pRows;
	VQmlPage m_Page;
	TesselPluginInterface::ISelection& m_rSelection = m_Page.Selection().Selection();
};

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

TEST_F(Table, HoverAndPress)
{
	Show(4);
	EXPECT_EQ(m_Page.Property("tableRow1weight", "text"), "0.333333");
	EXPECT_EQ(m_Page.Property("tableRow1weight", "toolTip"), "0.3333333333333333");
	auto& rPreSelection = m_Page.Selection().PreSelection();
	m_rSelection.Replace({Source(4)});

	m_Page.Hover("tableRow1");
	EXPECT_EVENTUALLY(rPreSelection.Items() == std::vector{Target(1)});
	m_Page.Hover("tableRow3");
	EXPECT_EVENTUALLY(rPreSelection.Items() == std::vector{Target(3)});
	m_Page.Hover("field");
	EXPECT_EVENTUALLY(rPreSelection.Items().empty());

	m_Page.Press("tableRow2");
	EXPECT_EQ(m_rSelection.Items(), (std::vector{Source(4), Target(2)}));
	EXPECT_TRUE(m_Page.Property("tableRows", "activeFocus").toBool());
}

TEST_F(Table, TakesTheFocusBeforeItSelects)
{
	Show(4);
	m_Page.Click("field");
	ASSERT_EQ(m_Page.FocusName(), "field");
	m_Page.Press("tableRow2");
	EXPECT_EQ(m_Page.Property("field", "selectedWhenLeft"), 0);
	EXPECT_EQ(m_rSelection.Items(), std::vector{Target(2)});
}

TEST_F(Table, KeysMoveTheSelection)
{
	Show(40);
	m_Page.Click("tableRow1");
	const struct
	{
		int m_Key;
		std::uint32_t m_Selected;
	} steps[] = {{Qt::Key_Down, 2}, {Qt::Key_Up, 1}, {Qt::Key_Home, 0}, {Qt::Key_Up, 0}, {Qt::Key_End, 39},
	    {Qt::Key_Down, 39}, {Qt::Key_Up, 38}};
	for (const auto& rStep : steps)
	{
		m_Page.Key(rStep.m_Key);
		EXPECT_EQ(m_rSelection.Items(), std::vector{Target(rStep.m_Selected)}) << rStep.m_Key;
	}
	EXPECT_TRUE(m_Page.Has("tableRow39"));
}

TEST_F(Table, GoesToWhatIsSelectedElsewhere)
{
	Show(40);
	m_Page.Click("tableRow1");
	m_Page.Item("table")->setProperty("selectedIndex", 30);
	EXPECT_TRUE(m_Page.Has("tableRow30"));
	m_Page.Key(Qt::Key_Down);
	EXPECT_EQ(m_rSelection.Items(), std::vector{Target(31)});
}

TEST_F(Table, KeepsItsScrollPositionOverAReset)
{
	Show(100);
	const QQuickItem* const pRows = m_Page.Item("tableRows");
	const auto scrolled = [pRows] { return pRows->property("contentY").toInt() - pRows->property("originY").toInt(); };
	m_Page.Item("tableRows")->setProperty("contentY", 50 * 22 + 7);
	m_pRows->Reset();
	EXPECT_EQ(scrolled(), 50 * 22 + 7);
	QCoreApplication::processEvents();
	EXPECT_EQ(scrolled(), 50 * 22 + 7);
	EXPECT_TRUE(m_Page.Has("tableRow51"));

	// Where fewer rows are left, it ends at the last one.
	m_pRows->removeRows(10, 90);
	m_pRows->Reset();
	EXPECT_EVENTUALLY(scrolled() == (10 - 5) * 22);
}
