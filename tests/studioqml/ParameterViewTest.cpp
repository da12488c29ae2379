#include "FakeParameterModel.h"
#include "QmlPage.h"

#include <gtest/gtest.h>

#include <QAccessible>
#include <QApplication>
#include <QFileDialog>
#include <QLineEdit>
#include <QTemporaryDir>
#include <QTest>

namespace
{

enum EHint
{
	EDontCare,
	ESlider,
	EMultiLine,
	ECheckableOption,
	ECheckableSlider,
	EColour
};

const char* const c_View = R"(
	ParameterView { objectName: "view"; width: 400; model: group }
	OrlexButton { objectName: "elsewhere"; y: 370; text: "x" })";

/// A page with a view of these parameters.
struct VParameterPage
{
	explicit VParameterPage(std::vector<VFakeParameter> i_Parameters) : m_Model(std::move(i_Parameters))
	{
		m_Page.SetContext("group", &m_Model);
		m_bShown = m_Page.Show(c_View);
	}

	void TypeInto(const QString& i_rName, const QString& i_rText)
	{
		m_Page.Click(i_rName);
		m_Page.Key(Qt::Key_A, Qt::ControlModifier);
		m_Page.Type(i_rText);
	}
	QString Shown(const QString& i_rName) const { return m_Page.Property(i_rName, "text").toString(); }
	QString Error(const QString& i_rName) const
	{
		return m_Page.Has(i_rName + "Reason") ? m_Page.Property(i_rName + "Reason", "text").toString() : QString();
	}

	VFakeParameterModel m_Model;
	VQmlPage m_Page;
	bool m_bShown = false;
};

VFakeParameter Scale()
{
	return {.m_Name = "Scale", .m_Type = "double", .m_Value = "1.5", .m_Default = "1"};
}

VFakeParameter Weight(const QString& i_rValue)
{
	return {.m_Name = "Weight",
	    .m_Type = "double",
	    .m_Value = i_rValue,
	    .m_PresentationHint = ESlider,
	    .m_Minimum = 1,
	    .m_Maximum = 100};
}

} // namespace

TEST(ParameterView, TakesTypedNumbers)
{
	VParameterPage page({Scale()});
	ASSERT_TRUE(page.m_bShown);
	EXPECT_EQ(page.Shown("Scale"), "1.5");
	page.TypeInto("Scale", "2.25");
	// Not before it is committed.
	EXPECT_EQ(page.m_Model.Text("Scale"), "1.5");
	page.m_Page.Key(Qt::Key_Return);
	EXPECT_EQ(page.m_Model.Text("Scale"), "2.25");
	page.TypeInto("Scale", "3e2");
	page.m_Page.Key(Qt::Key_Tab);
	EXPECT_EQ(page.m_Model.Text("Scale"), "3e2");
	page.TypeInto("Scale", "4");
	page.m_Page.Click("elsewhere");
	EXPECT_EQ(page.m_Model.Text("Scale"), "4");
	EXPECT_EQ(page.m_Model.m_TakenCount, 3);

	// A visit without typing writes nothing.
	page.m_Page.Click("Scale");
	page.m_Page.Click("elsewhere");
	EXPECT_EQ(page.m_Model.m_TakenCount, 3);
}

TEST(ParameterView, RefusesVisibly)
{
	VParameterPage page({Scale(), Weight("7")});
	ASSERT_TRUE(page.m_bShown);
	const double height = page.m_Page.Property("view", "implicitHeight").toDouble();
	page.TypeInto("Scale", "1,5");
	page.m_Page.Key(Qt::Key_Return);
	EXPECT_EQ(page.Error("Scale"), "\"1,5\" is not a number");
	EXPECT_EQ(page.m_Page.Property("Scale", "error"), "\"1,5\" is not a number");
	EXPECT_EQ(page.Shown("Scale"), "1,5");
	EXPECT_EQ(page.m_Model.Text("Scale"), "1.5");
	EXPECT_EVENTUALLY(page.m_Page.Property("view", "implicitHeight").toDouble() > height);

	// Leaving does not ask again, and what was refused stays to be seen.
	page.m_Page.Click("elsewhere");
	EXPECT_EQ(page.m_Model.m_RefusedCount, 1);
	EXPECT_EQ(page.Shown("Scale"), "1,5");
	// Escape brings back what the parameter holds.
	page.m_Page.Click("Scale");
	page.m_Page.Key(Qt::Key_Escape);
	EXPECT_EQ(page.Shown("Scale"), "1.5");
	EXPECT_EQ(page.Error("Scale"), "");
	EXPECT_EVENTUALLY(page.m_Page.Property("view", "implicitHeight") == height);

	// Beyond the limits, then typed on: the reason goes with the first key.
	page.TypeInto("Weight", "500");
	page.m_Page.Key(Qt::Key_Return);
	EXPECT_EQ(page.Error("Weight"), "Value is greater than permitted maximum");
	EXPECT_EQ(page.m_Model.Text("Weight"), "7");
	page.m_Page.Key(Qt::Key_Backspace);
	EXPECT_EQ(page.Error("Weight"), "");
	page.m_Page.Key(Qt::Key_Return);
	EXPECT_EQ(page.m_Model.Text("Weight"), "50");

	// A new value from elsewhere takes the place of what was refused.
	page.TypeInto("Scale", "x");
	page.m_Page.Key(Qt::Key_Return);
	ASSERT_NE(page.Error("Scale"), "");
	page.m_Model.Bring("Scale", "9");
	EXPECT_EQ(page.Error("Scale"), "");
	EXPECT_EQ(page.Shown("Scale"), "9");
}

TEST(ParameterView, ShowsWhatAFileBrings)
{
	VParameterPage page({Weight("1")});
	ASSERT_TRUE(page.m_bShown);
	page.m_Model.Bring("Weight", "0.5");
	EXPECT_EQ(page.Shown("Weight"), "0.5");
	EXPECT_EQ(page.Error("Weight"), "");
	EXPECT_EQ(page.m_Page.Property("WeightSlider", "value"), 1.0);
	// And leaves it so.
	page.m_Page.Click("Weight");
	page.m_Page.Click("elsewhere");
	EXPECT_EQ(page.m_Model.Text("Weight"), "0.5");
}

TEST(ParameterView, SliderDragsInShortNumbers)
{
	VParameterPage page({Weight("1")});
	ASSERT_TRUE(page.m_bShown);
	const QQuickItem* const pSlider = page.m_Page.Item("WeightSlider");
	const auto at = [pSlider](double i_Share) {
		return pSlider->mapToScene({pSlider->width() * i_Share, pSlider->height() / 2}).toPoint();
	};
	QTest::mousePress(&page.m_Page.View(), Qt::LeftButton, {}, at(0.3));
	for (const double share : {0.31, 0.35, 0.4, 0.45, 0.5})
		QTest::mouseMove(&page.m_Page.View(), at(share));
	QTest::mouseRelease(&page.m_Page.View(), Qt::LeftButton, {}, at(0.5));
	EXPECT_NEAR(page.m_Model.Text("Weight").toDouble(), 50.5, 1.5);
	EXPECT_LE(page.m_Model.Text("Weight").size(), 4);
	EXPECT_EQ(page.Shown("Weight"), page.m_Model.Text("Weight"));
	EXPECT_GE(page.m_Model.m_TakenCount, 2);

	page.m_Model.Bring("Weight", "20");
	page.m_Page.Key(Qt::Key_Right);
	EXPECT_EQ(page.m_Model.Text("Weight"), "20.1");
	// The wheel belongs to what the slider stands in.
	QWheelEvent wheel(
	    at(0.5), page.m_Page.View().mapToGlobal(at(0.5)), {}, {0, 120}, Qt::NoButton, {}, Qt::NoScrollPhase, false);
	QCoreApplication::sendEvent(&page.m_Page.View(), &wheel);
	EXPECT_EQ(page.m_Model.Text("Weight"), "20.1");
}

TEST(ParameterView, Enumerations)
{
	QStringList bones;
	for (int i = 0; i < 5000; ++i)
		bones.append(QString(i % 6, ' ') + QString("Bone%1").arg(i));
	VParameterPage page(
	    {{.m_Name = "Root", .m_Value = bones[3], .m_EnumNames = bones}, {.m_Name = "Empty", .m_bEnumerated = true},
	        {.m_Name = "Source", .m_Value = "Gone", .m_EnumNames = {"(None)", "A", "B"}}});
	ASSERT_TRUE(page.m_bShown);
	EXPECT_EQ(page.m_Page.Property("Root", "displayText"), "Bone3");
	page.m_Page.Click("Root");
	page.m_Page.Type("4711");
	page.m_Page.Key(Qt::Key_Return);
	EXPECT_EQ(page.m_Model.Text("Root"), bones[4711]);
	EXPECT_EQ(page.m_Page.Property("Root", "displayText"), "Bone4711");

	// A stray arrow key changes nothing, it opens the list.
	page.m_Page.Key(Qt::Key_Down);
	EXPECT_TRUE(page.m_Page.Has("RootList"));
	page.m_Page.Key(Qt::Key_Escape);
	EXPECT_EQ(page.m_Model.Text("Root"), bones[4711]);

	// A value that the list does not have is shown as it is.
	EXPECT_EQ(page.m_Page.Property("Source", "displayText"), "Gone");
	EXPECT_EQ(page.m_Page.Property("Source", "currentIndex"), -1);
	page.m_Page.Click("Source");
	page.m_Page.Key(Qt::Key_Down);
	page.m_Page.Key(Qt::Key_Return);
	EXPECT_EQ(page.m_Model.Text("Source"), "A");
	// It follows the parameter after a pick.
	page.m_Model.Bring("Source", "B");
	EXPECT_EQ(page.m_Page.Property("Source", "displayText"), "B");
	page.m_Model.Change("Source",
	    [](VFakeParameter& io_rParameter) {
		    io_rParameter.m_EnumNames = QStringList{"B", "C"};
	    });
	EXPECT_EQ(page.m_Page.Property("Source", "displayText"), "B");
	EXPECT_EQ(page.m_Page.Property("Source", "currentIndex"), 0);

	EXPECT_EQ(page.m_Page.Property("Empty", "placeholderText"), "Nothing to choose from");
	page.m_Model.Change("Empty", [](VFakeParameter& io_rParameter) { io_rParameter.m_EnumNames = QStringList{"X"}; });
	page.m_Page.Click("Empty");
	page.m_Page.Key(Qt::Key_Return);
	EXPECT_EQ(page.m_Model.Text("Empty"), "X");
}

TEST(ParameterView, HiddenAdvancedAndCategories)
{
	VParameterPage page({{.m_Name = "A"}, {.m_Name = "B", .m_bHidden = true},
	    {.m_Name = "C", .m_Category = "More", .m_bAdvanced = true},
	    {.m_Name = "D", .m_bHidden = true, .m_bAdvanced = true}});
	ASSERT_TRUE(page.m_bShown);
	EXPECT_TRUE(page.m_Page.Has("A"));
	EXPECT_FALSE(page.m_Page.Has("B"));
	EXPECT_FALSE(page.m_Page.Has("C"));
	page.m_Page.Click("viewAdvanced");
	EXPECT_TRUE(page.m_Page.Has("C"));
	EXPECT_FALSE(page.m_Page.Has("D"));
	page.m_Page.Click("viewAdvanced");
	EXPECT_FALSE(page.m_Page.Has("C"));

	// Flags may change while the view is open.
	const auto hide = [&page](const QString& i_rName, bool i_bHidden) {
		page.m_Model.Change(
		    i_rName, [i_bHidden](VFakeParameter& io_rParameter) { io_rParameter.m_bHidden = i_bHidden; });
	};
	hide("B", false);
	EXPECT_TRUE(page.m_Page.Has("B"));
	hide("A", true);
	EXPECT_FALSE(page.m_Page.Has("A"));
	hide("C", true);
	// Without an advanced parameter there is nothing to unfold.
	EXPECT_FALSE(page.m_Page.Has("viewAdvanced"));
	hide("D", false);
	EXPECT_TRUE(page.m_Page.Has("viewAdvanced"));
}

TEST(ParameterView, BooleansAndOptions)
{
	VParameterPage page({{.m_Name = "Flag", .m_Type = "bool", .m_Value = "false"},
	    {.m_Name = "Option", .m_Type = "bool", .m_Value = "true", .m_PresentationHint = ECheckableOption}});
	ASSERT_TRUE(page.m_bShown);
	EXPECT_FALSE(page.m_Page.Property("Flag", "checked").toBool());
	page.m_Page.Click("FlagRow");
	page.m_Page.Click("Flag");
	EXPECT_EQ(page.m_Model.Text("Flag"), "true");
	EXPECT_EQ(page.Shown("Option"), "On");
	page.m_Page.Click("Option");
	EXPECT_EQ(page.m_Model.Text("Option"), "false");
	EXPECT_EQ(page.Shown("Option"), "Off");
	page.m_Model.Bring("Flag", "false");
	page.m_Model.Bring("Option", "true");
	EXPECT_FALSE(page.m_Page.Property("Flag", "checked").toBool());
	EXPECT_TRUE(page.m_Page.Property("Option", "checked").toBool());
}

TEST(ParameterView, CheckableParametersHaveNoValueUntilTheyAreSwitchedOn)
{
	VParameterPage page({{.m_Name = "Limit",
	                         .m_Type = "double",
	                         .m_PresentationHint = ECheckableSlider,
	                         .m_Minimum = 2,
	                         .m_Maximum = 10},
	    {.m_Name = "Note", .m_PresentationHint = ECheckableOption},
	    {.m_Name = "Always",
	        .m_Type = "double",
	        .m_Default = "3",
	        .m_PresentationHint = ECheckableSlider,
	        .m_Minimum = 2,
	        .m_Maximum = 10}});
	ASSERT_TRUE(page.m_bShown);
	EXPECT_FALSE(page.m_Page.Property("Limit", "enabled").toBool());
	page.m_Page.Click("LimitSwitch");
	EXPECT_EQ(page.m_Model.Text("Limit"), "2");
	EXPECT_TRUE(page.m_Page.Property("Limit", "enabled").toBool());
	page.m_Page.Click("LimitSwitch");
	EXPECT_EQ(page.m_Model.Text("Limit"), "");
	EXPECT_FALSE(page.m_Page.Property("LimitSlider", "enabled").toBool());

	// A text has no first value: it waits for what is typed.
	page.m_Page.Click("NoteSwitch");
	EXPECT_TRUE(page.m_Page.Property("NoteSwitch", "checked").toBool());
	page.TypeInto("Note", "ok");
	page.m_Page.Key(Qt::Key_Return);
	EXPECT_EQ(page.m_Model.Text("Note"), "ok");

	// What has a default always has a value.
	EXPECT_FALSE(page.m_Page.Has("AlwaysSwitch"));
	EXPECT_TRUE(page.m_Page.Property("Always", "enabled").toBool());
}

TEST(ParameterView, SeveralLines)
{
	VParameterPage page({{.m_Name = "Notes", .m_Value = "one", .m_PresentationHint = EMultiLine}});
	ASSERT_TRUE(page.m_bShown);
	page.TypeInto("Notes", "two");
	page.m_Page.Key(Qt::Key_Return);
	page.m_Page.Type("three");
	EXPECT_EQ(page.m_Model.Text("Notes"), "one");
	page.m_Page.Key(Qt::Key_Return, Qt::ControlModifier);
	EXPECT_EQ(page.m_Model.Text("Notes"), "two\nthree");
	page.m_Page.Type("!");
	page.m_Page.Key(Qt::Key_Escape);
	EXPECT_EQ(page.m_Page.Property("Notes", "text"), "two\nthree");
	page.m_Page.Type("?");
	page.m_Page.Key(Qt::Key_Tab);
	EXPECT_NE(page.m_Page.FocusName(), "Notes");
	EXPECT_TRUE(page.m_Model.Text("Notes").contains("?"));
}

TEST(ParameterView, BackToTheDefault)
{
	VParameterPage page({Scale(), Weight("3")});
	ASSERT_TRUE(page.m_bShown);
	EXPECT_TRUE(page.m_Page.Has("ScaleReset"));
	EXPECT_FALSE(page.m_Page.Has("WeightReset"));
	page.m_Page.Click("ScaleReset");
	EXPECT_EQ(page.m_Model.Text("Scale"), "1");
	EXPECT_FALSE(page.m_Page.Has("ScaleReset"));
}

TEST(ParameterView, Colours)
{
	VParameterPage page({{.m_Name = "Colour", .m_Value = "#e76500", .m_PresentationHint = EColour}});
	ASSERT_TRUE(page.m_bShown);
	const QPoint swatch = page.m_Page.Centre("ColourSwatch");
	EXPECT_EVENTUALLY(page.m_Page.View().grabWindow().pixelColor(swatch) == QColor(231, 101, 0));
	page.TypeInto("Colour", "#4b78aa");
	page.m_Page.Key(Qt::Key_Return);
	EXPECT_EQ(page.m_Model.Text("Colour"), "#4b78aa");
	EXPECT_EVENTUALLY(page.m_Page.View().grabWindow().pixelColor(swatch) == QColor(75, 120, 170));
}

TEST(ParameterView, FileDialogs)
{
	QTemporaryDir folder;
	for (const char* pName : {"a.fbx", "b.fbx"})
	{
		QFile file(folder.filePath(pName));
		ASSERT_TRUE(file.open(QIODevice::WriteOnly));
	}
	const QString first = folder.filePath("a.fbx");
	const struct
	{
		int m_Access;
		const char* m_pTitle;
		QFileDialog::FileMode m_Mode;
		QFileDialog::AcceptMode m_AcceptMode;
		QStringList m_Chosen;
		QString m_Result;
	} rows[] = {
	    {1, "Choose a folder", QFileDialog::Directory, QFileDialog::AcceptOpen, {folder.path()}, folder.path()},
	    {2, "Choose a file to save", QFileDialog::AnyFile, QFileDialog::AcceptSave, {folder.filePath("new.fbx")},
	        folder.filePath("new.fbx")},
	    {3, "Choose a file", QFileDialog::ExistingFile, QFileDialog::AcceptOpen, {first}, first},
	    {4, "Choose files", QFileDialog::ExistingFiles, QFileDialog::AcceptOpen, {first, folder.filePath("b.fbx")},
	        first + ";" + folder.filePath("b.fbx")},
	};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pTitle);
		VParameterPage page({{.m_Name = "File",
		    .m_Type = "path",
		    .m_Value = first,
		    .m_FileAccess = rRow.m_Access,
		    .m_FileFilter = "FBX files (*.fbx);;All files (*)"}});
		ASSERT_TRUE(page.m_bShown);
		page.m_Page.Click("FileBrowse");
		QFileDialog* pDialog = nullptr;
		ASSERT_TRUE(Eventually(
		    [&pDialog]
		    {
			    for (QWidget* pWidget : QApplication::topLevelWidgets())
				    if (pWidget->isVisible() && (pDialog = qobject_cast<QFileDialog*>(pWidget)))
					    return true;
			    return false;
		    }));
		EXPECT_EQ(pDialog->windowTitle(), rRow.m_pTitle);
		EXPECT_EQ(pDialog->acceptMode(), rRow.m_AcceptMode);
		EXPECT_EQ(pDialog->fileMode(), rRow.m_Mode);
		if (rRow.m_Access != 1)
		{
			EXPECT_EQ(pDialog->nameFilters(), (QStringList{"FBX files (*.fbx)", "All files (*)"}));
			EXPECT_EQ(pDialog->directory().absolutePath(), folder.path());
		}
		QStringList quoted;
		for (const QString& rFile : rRow.m_Chosen)
			quoted.append("\"" + rFile + "\"");
		auto* const pName = pDialog->findChild<QLineEdit*>("fileNameEdit");
		ASSERT_TRUE(pName);
		pName->setText(rRow.m_Chosen.size() > 1 ? quoted.join(" ") : rRow.m_Chosen[0]);
		QMetaObject::invokeMethod(pDialog, "accept");
		EXPECT_EVENTUALLY(page.m_Model.Text("File") == rRow.m_Result);
		EXPECT_EVENTUALLY(!pDialog->isVisible());
	}
}

TEST(ParameterView, TabWalksThroughTheFields)
{
	VParameterPage page({Scale(), Weight("3"), {.m_Name = "Root", .m_EnumNames = {"a", "b"}}});
	ASSERT_TRUE(page.m_bShown);
	page.m_Page.Click("Scale");
	QStringList visited;
	for (int i = 0; i < 5; ++i)
	{
		page.m_Page.Key(Qt::Key_Tab);
		visited.append(page.m_Page.FocusName());
	}
	EXPECT_EQ(visited, (QStringList{"ScaleReset", "WeightSlider", "Weight", "Root", "elsewhere"}));
	page.m_Page.Key(Qt::Key_Backtab);
	EXPECT_EQ(page.m_Page.FocusName(), "Root");
}

TEST(ParameterView, EveryControlHasAnAccessibleName)
{
	VParameterPage page(
	    {Scale(), Weight("3"), {.m_Name = "Root", .m_EnumNames = {"a", "b"}}, {.m_Name = "Flag", .m_Type = "bool"},
	        {.m_Name = "Option", .m_Type = "bool", .m_PresentationHint = ECheckableOption},
	        {.m_Name = "Note", .m_PresentationHint = ECheckableOption},
	        {.m_Name = "Notes", .m_PresentationHint = EMultiLine},
	        {.m_Name = "Colour", .m_Value = "#fff", .m_PresentationHint = EColour},
	        {.m_Name = "File", .m_FileAccess = 3}, {.m_Name = "Deep", .m_bAdvanced = true}});
	ASSERT_TRUE(page.m_bShown);
	const struct
	{
		const char* m_pItem;
		QAccessible::Role m_Role;
		const char* m_pName;
	} rows[] = {{"view", QAccessible::Grouping, "view"}, {"Scale", QAccessible::EditableText, "Scale"},
	    {"ScaleReset", QAccessible::Button, "Scale: back to the default"},
	    {"Weight", QAccessible::EditableText, "Weight"}, {"WeightSlider", QAccessible::Slider, "Weight"},
	    {"Root", QAccessible::ComboBox, "Root"}, {"Flag", QAccessible::CheckBox, "Flag"},
	    {"Option", QAccessible::CheckBox, "Option"}, {"NoteSwitch", QAccessible::CheckBox, "Note is set"},
	    {"Notes", QAccessible::EditableText, "Notes"}, {"ColourSwatch", QAccessible::Button, "Colour: choose a colour"},
	    {"Colour", QAccessible::EditableText, "Colour"}, {"FileBrowse", QAccessible::Button, "File: Choose a file"},
	    {"viewAdvanced", QAccessible::CheckBox, "Advanced"}};
	for (const auto& rRow : rows)
	{
		QAccessibleInterface* const pInterface = QAccessible::queryAccessibleInterface(page.m_Page.Item(rRow.m_pItem));
		ASSERT_TRUE(pInterface) << rRow.m_pItem;
		EXPECT_EQ(pInterface->role(), rRow.m_Role) << rRow.m_pItem;
		EXPECT_EQ(pInterface->text(QAccessible::Name).toStdString(), rRow.m_pName) << rRow.m_pItem;
	}
	// As a screen reader presses it.
	const auto act = [&page](const char* i_pItem, const QString& i_rAction)
	{ QAccessible::queryAccessibleInterface(page.m_Page.Item(i_pItem))->actionInterface()->doAction(i_rAction); };
	act("Flag", "Press");
	EXPECT_EQ(page.m_Model.Text("Flag"), "true");
	act("Flag", "Toggle");
	EXPECT_EQ(page.m_Model.Text("Flag"), "false");
	act("ScaleReset", "Press");
	EXPECT_EQ(page.m_Model.Text("Scale"), "1");
	act("viewAdvanced", "Press");
	EXPECT_TRUE(page.m_Page.Has("Deep"));
	act("Root", "Press");
	EXPECT_TRUE(page.m_Page.Has("RootList"));
}
