#include "QmlPage.h"

#include <gtest/gtest.h>

#include <QAccessible>
#include <QFileInfo>
#include <QQmlPropertyMap>
#include <QQuickWidget>
#include <QSignalSpy>
#include <QTest>

#include <cmath>

namespace
{

/// With a property as a document has it.
class VDocument : public QObject
{
	Q_OBJECT
	Q_PROPERTY(bool symmetry READ Symmetry WRITE SetSymmetry NOTIFY symmetryChanged)

public:
	bool Symmetry() const { return m_bSymmetry; }
	void SetSymmetry(bool i_bSymmetry)
	{
		++m_WriteCount;
		if (m_bRefuses || m_bSymmetry == i_bSymmetry)
			return;
		m_bSymmetry = i_bSymmetry;
		emit symmetryChanged();
	}

	bool m_bSymmetry = false;
	bool m_bRefuses = false;
	int m_WriteCount = 0;

signals:
	void symmetryChanged();
};

QColor ColourAt(VQmlPage& i_rPage, const QPoint& i_rPoint)
{
	return i_rPage.View().grabWindow().pixelColor(i_rPoint);
}

} // namespace

TEST(Theme, ColoursAndSizes)
{
	VQmlPage page;
	ASSERT_TRUE(page.Show(R"(
		property var colours: [Theme.window, Theme.windowText, Theme.base, Theme.text, Theme.dark, Theme.midlight,
			Theme.light, Theme.mid, Theme.bright, Theme.highlight, Theme.active, Theme.disabledText, Theme.border,
			Theme.button, Theme.buttonText, Theme.error, Theme.warning]
		property var sizes: [Theme.itemHeight, Theme.spacing, Theme.margin, Theme.radius, Theme.fontSize,
			Theme.infoToolTipDelay]
		property color highlight: Theme.highlight
		property color active: Theme.active
		function contrast(first, second) {
			const part = x => x <= 0.03928 ? x / 12.92 : Math.pow((x + 0.055) / 1.055, 2.4)
			const light = c => 0.2126 * part(c.r) + 0.7152 * part(c.g) + 0.0722 * part(c.b) + 0.05
			return Math.max(light(first), light(second)) / Math.min(light(first), light(second))
		}
		property real leastContrast: Math.min(contrast(Theme.text, Theme.base), contrast(Theme.windowText, Theme.window),
			contrast(Theme.buttonText, Theme.button), contrast(Theme.bright, Theme.light),
			contrast(Theme.text, Theme.midlight), contrast(Theme.error, Theme.window), contrast(Theme.warning, Theme.button)))"));
	const QQuickItem* const pRoot = page.View().rootObject();
	for (const QVariant& rColour : pRoot->property("colours").value<QJSValue>().toVariant().toList())
		EXPECT_TRUE(rColour.value<QColor>().isValid());
	for (const QVariant& rSize : pRoot->property("sizes").value<QJSValue>().toVariant().toList())
		EXPECT_GT(rSize.toInt(), 0);
	EXPECT_EQ(pRoot->property("highlight").value<QColor>(), QColor(75, 120, 170));
	EXPECT_EQ(pRoot->property("active").value<QColor>(), QColor(231, 101, 0));
	// What the accessibility guidelines ask of large text, at the least.
	EXPECT_GT(pRoot->property("leastContrast").toDouble(), 4.0);
}

TEST(Button, ClicksTogglesAndKeys)
{
	VQmlPage page;
	ASSERT_TRUE(page.Show(R"(
		property int clicks: 0
		Column {
			OrlexButton { objectName: "plain"; text: "Plain"; onClicked: page.clicks++ }
			OrlexButton { objectName: "off"; text: "Off"; enabled: false; onClicked: page.clicks += 100 }
			OrlexButton { objectName: "check"; text: "Check"; checkable: true; checked: true } })"));
	const QQuickItem* const pRoot = page.View().rootObject();
	page.Click("plain");
	page.Click("off");
	EXPECT_EQ(pRoot->property("clicks").toInt(), 1);
	EXPECT_EQ(page.FocusName(), "plain");
	page.Key(Qt::Key_Space);
	EXPECT_EQ(pRoot->property("clicks").toInt(), 2);

	// A disabled control is left out of the chain, and the keyboard's focus shows.
	EXPECT_FALSE(page.Property("check", "visualFocus").toBool());
	page.Key(Qt::Key_Tab);
	EXPECT_EQ(page.FocusName(), "check");
	EXPECT_TRUE(page.Property("check", "visualFocus").toBool());
	page.Key(Qt::Key_Space);
	EXPECT_FALSE(page.Property("check", "checked").toBool());

	// As a screen reader presses them.
	const auto act = [&page](const char* i_pItem, const QString& i_rAction)
	{ QAccessible::queryAccessibleInterface(page.Item(i_pItem))->actionInterface()->doAction(i_rAction); };
	act("plain", "Press");
	EXPECT_EQ(pRoot->property("clicks").toInt(), 3);
	act("check", "Toggle");
	EXPECT_TRUE(page.Property("check", "checked").toBool());
	act("check", "Press");
	EXPECT_FALSE(page.Property("check", "checked").toBool());

	// What is disabled, checked or at rest looks different.
	page.Click("check");
	const QPoint inside(3, 12);
	const auto ground = [&page, &inside](const char* i_pName)
	{ return ColourAt(page, page.Item(i_pName)->mapToScene(inside).toPoint()); };
	page.Hover("off");
	EXPECT_NE(ground("plain"), ground("off"));
	EXPECT_NE(ground("plain"), ground("check"));
}

TEST(Button, ToolTipUnderTheMouse)
{
	VQmlPage page;
	ASSERT_TRUE(page.Show(R"(
		OrlexButton { objectName: "button"; x: 20; y: 100; text: "Text"; toolTip: "What it does" }
		OrlexLabel { objectName: "label"; x: 20; y: 200; width: 80; text: "Character1:LeftForeArmTwist_L" }
		OrlexLabel { objectName: "long"; x: 20; y: 300; width: 80; text: "A long word, and another, ".repeat(6) }
		OrlexLabel { objectName: "short"; x: 20; y: 250; width: 80; text: "Short" })"));
	const auto shows = [&page](const QString& i_rText)
	{
		for (const QObject* pObject : page.View().contentItem()->findChildren<QObject*>())
			if (pObject->inherits("QQuickToolTip") && pObject->property("visible").toBool()
			    && pObject->property("text").toString() == i_rText)
				return true;
		return false;
	};
	page.Hover("button");
	EXPECT_EVENTUALLY(shows("What it does"));
	page.Hover("label");
	EXPECT_EVENTUALLY(shows("Character1:LeftForeArmTwist_L"));
	EXPECT_EVENTUALLY(!shows("What it does"));
	page.Hover("long");
	EXPECT_EVENTUALLY(shows(page.Property("long", "text").toString()));
	for (const QObject* pObject : page.View().contentItem()->findChildren<QObject*>())
		if (pObject->inherits("QQuickToolTip") && pObject->property("visible").toBool())
		{
			// Wrapped, and within the window.
			EXPECT_LT(pObject->property("width").toDouble(), 400);
			EXPECT_GT(pObject->property("height").toDouble(), 40);
		}
	page.Hover("short");
	EXPECT_EVENTUALLY(!shows(page.Property("long", "text").toString()));
	EXPECT_FALSE(shows("Short"));
}

TEST(PropertyCheckBox, FollowsAndSetsAnObject)
{
	VDocument document;
	VQmlPage page;
	page.SetContext("document", &document);
	ASSERT_TRUE(page.Show(
	    R"(PropertyCheckBox { objectName: "box"; text: "Joint symmetry"; target: document; property: "symmetry" })"));
	EXPECT_FALSE(page.Property("box", "checked").toBool());
	page.Click("box");
	EXPECT_TRUE(document.m_bSymmetry);
	EXPECT_TRUE(page.Property("box", "checked").toBool());
	// Still bound after a click.
	document.SetSymmetry(false);
	EXPECT_FALSE(page.Property("box", "checked").toBool());
	page.Key(Qt::Key_Space);
	EXPECT_TRUE(document.m_bSymmetry);

	// A target that refuses has the last word.
	document.m_bRefuses = true;
	document.m_WriteCount = 0;
	page.Click("box");
	EXPECT_EQ(document.m_WriteCount, 1);
	EXPECT_TRUE(page.Property("box", "checked").toBool());
}

TEST(PropertyCheckBox, FollowsAndSetsAPropertyMap)
{
	QQmlPropertyMap map;
	map.insert("Axes", false);
	QSignalSpy changes(&map, &QQmlPropertyMap::valueChanged);
	VQmlPage page;
	page.SetContext("map", &map);
	ASSERT_TRUE(page.Show(R"(PropertyCheckBox { objectName: "box"; text: "Axes"; target: map; property: "Axes" })"));
	EXPECT_FALSE(page.Property("box", "checked").toBool());
	page.Click("box");
	EXPECT_EQ(map.value("Axes"), true);
	ASSERT_EQ(changes.count(), 1);
	EXPECT_EQ(changes[0][0], "Axes");
	// From C++, which tells nobody but the bindings.
	map.insert("Axes", false);
	EXPECT_FALSE(page.Property("box", "checked").toBool());
	page.Click("box");
	EXPECT_EQ(map.value("Axes"), true);
	EXPECT_EQ(changes.count(), 2);
}

TEST(PropertyCheckBox, IsDisabledWithoutItsProperty)
{
	VDocument document;
	VQmlPage page;
	page.SetContext("document", &document);
	ASSERT_TRUE(page.Show(R"(
		Column {
			PropertyCheckBox { objectName: "none"; text: "x" }
			PropertyCheckBox { objectName: "null"; text: "x"; target: null; property: "symmetry" }
			PropertyCheckBox { objectName: "other"; text: "x"; target: document; property: "nothing" } })"));
	for (const char* pName : {"none", "null", "other"})
		EXPECT_FALSE(page.Property(pName, "enabled").toBool()) << pName;
}

TEST(ComboBox, ShortListByMouseAndKeys)
{
	VQmlPage page;
	ASSERT_TRUE(page.Show(R"(
		property var picked: []
		OrlexComboBox { objectName: "box"; width: 100; currentIndex: 0
			model: ["Perspective", "Front", "Back", "Left"]
			onActivated: page.picked = page.picked.concat([index, currentIndex]) })"));
	EXPECT_EQ(page.Property("box", "displayText"), "Perspective");
	page.Click("box");
	EXPECT_TRUE(page.Has("boxList"));
	EXPECT_FALSE(page.Has("boxFilter"));
	page.Key(Qt::Key_Down);
	page.Key(Qt::Key_Down);
	page.Key(Qt::Key_Return);
	EXPECT_EQ(page.Property("box", "currentIndex"), 2);
	EXPECT_FALSE(page.Has("boxList"));
	// The keyboard is back at the box, which steps without its list.
	EXPECT_EQ(page.FocusName(), "box");
	page.Key(Qt::Key_Up);
	EXPECT_EQ(page.Property("box", "displayText"), "Front");
	page.Key(Qt::Key_End);
	EXPECT_EQ(page.Property("box", "displayText"), "Left");
	page.Key(Qt::Key_Down);
	page.Key(Qt::Key_Space);
	EXPECT_TRUE(page.Has("boxList"));
	page.Key(Qt::Key_Home);
	page.Key(Qt::Key_Escape);
	EXPECT_FALSE(page.Has("boxList"));
	EXPECT_EQ(page.Property("box", "displayText"), "Left");
	EXPECT_EQ(page.View().rootObject()->property("picked").value<QJSValue>().toVariant().toList(),
	    (QVariantList{2, 2, 1, 1, 3, 3}));

	// A press elsewhere closes the list, one on an entry picks it.
	page.Click("box");
	QTest::mouseClick(&page.View(), Qt::LeftButton, {}, {400, 350});
	EXPECT_FALSE(page.Has("boxList"));
	page.Click("box");
	QTest::mouseClick(&page.View(), Qt::LeftButton, {}, page.Item("boxList")->mapToScene({30, 11}).toPoint());
	EXPECT_EQ(page.Property("box", "displayText"), "Perspective");
}

TEST(ComboBox, FiltersFiveThousand)
{
	VQmlPage page;
	ASSERT_TRUE(page.Show(R"(
		property var names: {
			const names = []
			for (let i = 0; i < 5000; ++i)
				names.push(" ".repeat(i % 4) + (i % 2 ? "Left" : "Right") + "Bone" + i)
			names[1] = "LeftBone2501Ctrl"
			return names
		}
		OrlexComboBox { objectName: "box"; width: 200; currentIndex: 4321; model: page.names })"));
	const auto rows = [&page] { return page.Property("boxList", "count").toInt(); };
	// Spaces in front are depth, not part of the name.
	EXPECT_EQ(page.Property("box", "displayText"), "LeftBone4321");
	page.Click("box");
	EXPECT_EQ(rows(), 5000);
	EXPECT_EQ(page.Property("boxList", "currentIndex"), 4321);
	EXPECT_EQ(page.FocusName(), "boxFilter");

	// Every word, in any case.
	page.Type("lef 499");
	// 499, and 4991 to 4999 the odd ones, with those that end in 1499, 2499, 3499, 4499.
	EXPECT_EQ(rows(), 1 + 5 + 4);
	page.Key(Qt::Key_Down);
	page.Key(Qt::Key_Return);
	EXPECT_EQ(page.Property("box", "displayText"), "LeftBone1499");
	EXPECT_EQ(page.FocusName(), "box");

	// A letter typed on the closed box opens it with that filter.
	page.Type("z");
	EXPECT_EQ(rows(), 0);
	page.Key(Qt::Key_Return);
	EXPECT_EQ(page.Property("box", "displayText"), "LeftBone1499");
	// Moving by pages, in a new list without the old filter.
	page.Click("box");
	EXPECT_EQ(rows(), 5000);
	page.Key(Qt::Key_PageDown);
	EXPECT_GT(page.Property("boxList", "currentIndex").toInt(), 1499 + 5);
	page.Key(Qt::Key_Escape);
	EXPECT_EQ(page.Property("box", "displayText"), "LeftBone1499");
	// What is typed in full is meant, not what begins with it.
	page.Type("leftbone2501");
	EXPECT_EQ(rows(), 2);
	page.Key(Qt::Key_Return);
	EXPECT_EQ(page.Property("box", "displayText"), "LeftBone2501");
}

TEST(ComboBox, StaysInItsWindow)
{
	VQmlPage page;
	ASSERT_TRUE(page.Show(R"(
		property var names: Array.from({length: 100}, (x, i) => "Bone" + i)
		OrlexComboBox { objectName: "low"; x: 380; y: 370; width: 110; model: page.names }
		OrlexComboBox { objectName: "high"; y: 5; width: 110; model: page.names })"));
	for (const char* pName : {"low", "high"})
	{
		page.Click(pName);
		const QQuickItem* const pList = page.Item(QString(pName) + "List");
		const QRectF list = pList->mapRectToScene(pList->boundingRect());
		const QQuickItem* const pBox = page.Item(pName);
		EXPECT_TRUE(QRectF(0, 0, 500, 400).contains(list)) << pName;
		EXPECT_FALSE(list.intersects(pBox->mapRectToScene(pBox->boundingRect()))) << pName;
		EXPECT_GT(list.height(), 200) << pName;
		page.Key(Qt::Key_Escape);
	}
}

TEST(ComboBox, ListFollowsItsModel)
{
	VQmlPage page;
	ASSERT_TRUE(page.Show(R"(
		property var names: ["a", "b", "c"]
		OrlexComboBox { objectName: "box"; width: 100; model: page.names; currentIndex: 2 })"));
	page.Click("box");
	page.View().rootObject()->setProperty("names", QStringList{"x"});
	EXPECT_EQ(page.Property("boxList", "count"), 1);
	EXPECT_EQ(page.Property("box", "displayText"), "");
	page.Key(Qt::Key_Return);
	EXPECT_EQ(page.Property("box", "displayText"), "x");
}

TEST(ComboBox, WorksInAWidget)
{
	QQmlEngine engine;
	StudioHost::RegisterQmlModules(engine, {});
	QQmlComponent component(&engine);
	component.setData("import QtQuick 2.15\nimport Orlex.Controls 1.0\nItem { OrlexComboBox { id: box; width: 150\n"
	                  "model: Array.from({length: 100}, (x, i) => \"Bone\" + i) }\n"
	                  "property alias shown: box.displayText }",
	    QUrl("qrc:/Page.qml"));
	QQuickWidget widget(&engine, nullptr);
	QObject* const pRoot = component.create();
	ASSERT_TRUE(pRoot) << component.errorString().toStdString();
	widget.setContent(QUrl("qrc:/Page.qml"), &component, pRoot);
	widget.setResizeMode(QQuickWidget::SizeRootObjectToView);
	widget.resize(400, 300);
	widget.show();
	widget.activateWindow();
	ASSERT_TRUE(QTest::qWaitForWindowActive(&widget));
	widget.setFocus();
	QTest::mouseClick(&widget, Qt::LeftButton, {}, {30, 12});
	QTest::keyClicks(&widget, "77");
	QTest::keyClick(&widget, Qt::Key_Return);
	EXPECT_EQ(pRoot->property("shown"), "Bone77");
	QTest::mouseClick(&widget, Qt::LeftButton, {}, {30, 12});
	QTest::keyClick(&widget, Qt::Key_Escape);
	QTest::keyClick(&widget, Qt::Key_Down);
	EXPECT_EQ(pRoot->property("shown"), "Bone78");
}

TEST(SplitView, ThreeColumnsAreDragged)
{
	VQmlPage page;
	ASSERT_TRUE(page.Show(R"(
		OrlexSplitView { id: split; anchors.fill: parent; orientation: Qt.Horizontal
			Item { objectName: "left"; implicitWidth: 100 }
			Item { objectName: "middle"; implicitWidth: 200 }
			Item { objectName: "right"; implicitWidth: 100 } })"));
	ASSERT_EQ(page.Property("left", "width"), 100);
	const double middle = page.Property("middle", "width").toDouble();
	const double right = page.Property("right", "width").toDouble();
	QTest::mousePress(&page.View(), Qt::LeftButton, {}, {102, 200});
	QTest::mouseMove(&page.View(), {120, 200});
	QTest::mouseMove(&page.View(), {142, 200});
	QTest::mouseRelease(&page.View(), Qt::LeftButton, {}, {142, 200});
	EXPECT_EVENTUALLY(page.Property("left", "width") == 140);
	EXPECT_EVENTUALLY(std::abs(page.Property("middle", "width").toDouble() + page.Property("right", "width").toDouble()
	                      - middle - right + 40)
	    < 1e-9);
}

TEST(SideMark, TellsLeftFromRight)
{
	VQmlPage page;
	ASSERT_TRUE(page.Show("SideMark { objectName: \"mark\" }"));
	for (const auto& [pName, pSide] : {std::pair{"LeftArm", "L"}, {"Character1:RightHandIndex1", "R"}, {"Hips", ""}})
	{
		page.Item("mark")->setProperty("name", pName);
		EXPECT_EQ(page.Property("mark", "side").toString().toStdString(), pSide) << pName;
		EXPECT_EQ(page.Item("mark")->isVisible(), *pSide != 0) << pName;
	}
}

TEST(Modules, SourcesComeBeforeResources)
{
	QQmlEngine engine;
	StudioHost::RegisterQmlModules(engine, {}, RETARGET_STUDIO_QML);
	QQmlComponent component(&engine);
	component.setData("import Orlex.Controls 1.0\nOrlexButton { text: \"x\" }", QUrl("qrc:/Page.qml"));
	const std::unique_ptr<QObject> pObject(component.create());
	ASSERT_TRUE(pObject) << component.errorString().toStdString();
	EXPECT_TRUE(QFileInfo(RETARGET_STUDIO_QML "/Orlex/Controls/OrlexButton.qml").isFile());
	EXPECT_EQ(engine.importPathList().first(), QString(RETARGET_STUDIO_QML));
}

#include "ControlsTest.moc"
