#include "QmlPage.h"

#include "InMemoryHost/Dispatcher.h"
#include "InMemoryHost/ParameterRegistry.h"
#include "TesselDataStore/DataStore.h"
#include "TesselParameters/ParameterGroup.h"
#include "TesselParametersGUI/ParameterGroupModel.h"

#include <gtest/gtest.h>

#include <QAccessible>
#include <QApplication>
#include <QFileDialog>
#include <QLineEdit>
#include <QTemporaryDir>
#include <QTest>

namespace
{

using TesselDataStore::ToVariant;
using TesselParameters::VParameter;
using TesselParameters::VParameterGroup;
using TesselPluginInterface::EFileAccess;
using TesselPluginInterface::EPresentationHint;
using TesselPluginInterface::IParameter;
using TesselPluginInterface::VEnumEntry;

std::vector<VEnumEntry> Entries(const std::vector<std::string>& i_rNames)
{
	std::vector<VEnumEntry> entries;
	for (const std::string& rName : i_rNames)
		entries.push_back({rName, ToVariant(rName)});
	return entries;
}

/// A view of a group as modules make them, over a store and the host's registry.
class ParameterView : public testing::Test
{
protected:
	template <typename T>
	VParameter& Add(const std::string& i_rName, EPresentationHint i_Hint = EPresentationHint::EDontCare)
	{
		const auto pParameter = m_pGroup->Add<T>(i_rName, i_rName);
		pParameter->SetPresentationHint(i_Hint);
		return *pParameter;
	}
	VParameter& AddScale()
	{
		VParameter& rScale = Add<double>("Scale");
		rScale.SetDefault(1.0);
		rScale.Set(1.5);
		return rScale;
	}
	VParameter& AddWeight(double i_Value)
	{
		VParameter& rWeight = Add<double>("Weight", EPresentationHint::ESlider);
		rWeight.SetLimits(1.0, 100.0);
		rWeight.Set(i_Value);
		return rWeight;
	}
	bool Show()
	{
		m_Page.m_Services.m_MakeParameterGroupModel = [this](const QString& i_rPath, const QString& i_rGroup) {
			return std::make_unique<TesselParametersGUI::VParameterGroupModel>(
			    m_pRegistry, m_pDispatcher, i_rPath, i_rGroup);
		};
		m_pRegistry->Register("Panel", m_pGroup);
		return m_Page.Show(R"(
			ParameterView { objectName: "view"; width: 400
				model: TesselParameters.ParameterGroupModel("Panel", "Group") }
			OrlexButton { objectName: "elsewhere"; y: 370; text: "x" })");
	}
	/// Lets the view follow what the last act has changed.
	void Run() { m_pDispatcher->RunPending(); }
	void Click(const QString& i_rName)
	{
		m_Page.Click(i_rName);
		Run();
	}
	void Key(int i_Key, Qt::KeyboardModifiers i_Modifiers = Qt::NoModifier)
	{
		m_Page.Key(i_Key, i_Modifiers);
		Run();
	}
	/// In the place of what stands in a field, without committing it.
	void TypeInto(const QString& i_rName, const QString& i_rText)
	{
		Click(i_rName);
		Key(Qt::Key_A, Qt::ControlModifier);
		m_Page.Type(i_rText);
	}
	QString Shown(const QString& i_rName) const { return m_Page.Property(i_rName, "text").toString(); }
	QString Error(const QString& i_rName) const
	{
		return m_Page.Has(i_rName + "Reason") ? m_Page.Property(i_rName + "Reason", "text").toString() : QString();
	}

	const std::shared_ptr<InMemoryHost::VParameterRegistry> m_pRegistry =
	    std::make_shared<InMemoryHost::VParameterRegistry>();
	const std::shared_ptr<InMemoryHost::VDispatcher> m_pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
	std::shared_ptr<VParameterGroup> m_pGroup =
	    std::make_shared<VParameterGroup>(std::make_shared<TesselDataStore::VDataStore>(), "Panel", "Group");
	VQmlPage m_Page;
};

TEST_F(ParameterView, TakesTypedNumbers)
{
	const VParameter& rScale = AddScale();
	ASSERT_TRUE(Show());
	EXPECT_EQ(Shown("Scale"), "1.5");
	TypeInto("Scale", "2.25");
	// Not before it is committed.
	EXPECT_EQ(rScale.GetValueText(), "1.5");
	Key(Qt::Key_Return);
	EXPECT_EQ(rScale.GetValueText(), "2.25");
	TypeInto("Scale", "3e2");
	Key(Qt::Key_Tab);
	EXPECT_EQ(rScale.GetValueText(), "300");
	EXPECT_EQ(Shown("Scale"), "300");
	TypeInto("Scale", "4");
	Click("elsewhere");
	EXPECT_EQ(rScale.GetValueText(), "4");
}

TEST_F(ParameterView, ShowsSixDigitsUntilItIsEdited)
{
	VParameter& rScale = AddScale();
	ASSERT_TRUE(Show());
	rScale.Set(1.0 / 3.0);
	Run();
	const QString whole = QString::fromStdString(rScale.GetValueText());
	for (int i = 0; i < 2; ++i)
	{
		EXPECT_EQ(Shown("Scale"), "0.333333");
		EXPECT_EQ(m_Page.Property("Scale", "toolTip"), whole);
		Click("Scale");
		EXPECT_EQ(Shown("Scale"), whole);
		Click("elsewhere");
		double value = 0.0;
		EXPECT_TRUE(rScale.Get(value) && value == 1.0 / 3.0) << "nothing was typed";
	}
	Click("Scale");
	Key(Qt::Key_End);
	m_Page.Type("e1");
	Click("elsewhere");
	EXPECT_EQ(rScale.GetValueText(), "3.333333333333333");
	EXPECT_EQ(Shown("Scale"), "3.33333");
}

TEST_F(ParameterView, RefusesVisibly)
{
	VParameter& rScale = AddScale();
	const VParameter& rWeight = AddWeight(7);
	ASSERT_TRUE(Show());
	const double height = m_Page.Property("view", "implicitHeight").toDouble();
	TypeInto("Scale", "1,5");
	Key(Qt::Key_Return);
	EXPECT_EQ(Error("Scale"), "Value is not a number");
	EXPECT_EQ(m_Page.Property("Scale", "error"), "Value is not a number");
	EXPECT_EQ(Shown("Scale"), "1,5");
	EXPECT_EQ(rScale.GetValueText(), "1.5");
	EXPECT_EVENTUALLY(m_Page.Property("view", "implicitHeight").toDouble() > height);

	// What was refused stays to be seen.
	Click("elsewhere");
	EXPECT_EQ(Shown("Scale"), "1,5");
	// Escape brings back what the parameter holds.
	Click("Scale");
	Key(Qt::Key_Escape);
	EXPECT_EQ(Shown("Scale"), "1.5");
	EXPECT_EQ(Error("Scale"), "");
	EXPECT_EVENTUALLY(m_Page.Property("view", "implicitHeight") == height);

	// Beyond the limits, then typed on: the reason goes with the first key.
	TypeInto("Weight", "500");
	Key(Qt::Key_Return);
	EXPECT_EQ(Error("Weight"), "Value is greater than permitted maximum. Allowed: 1 to 100.");
	EXPECT_EQ(rWeight.GetValueText(), "7");
	Key(Qt::Key_Backspace);
	EXPECT_EQ(Error("Weight"), "");
	Key(Qt::Key_Return);
	EXPECT_EQ(rWeight.GetValueText(), "50");

	// A new value from elsewhere takes the place of what was refused.
	TypeInto("Scale", "x");
	Key(Qt::Key_Return);
	ASSERT_NE(Error("Scale"), "");
	rScale.Set(9.0);
	Run();
	EXPECT_EQ(Error("Scale"), "");
	EXPECT_EQ(Shown("Scale"), "9");
}

TEST_F(ParameterView, ShowsWhatAFileBrings)
{
	VParameter& rWeight = AddWeight(1);
	ASSERT_TRUE(Show());
	rWeight.Set(0.5);
	Run();
	EXPECT_EQ(Shown("Weight"), "0.5");
	EXPECT_EQ(Error("Weight"), "");
	EXPECT_EQ(m_Page.Property("WeightSlider", "value"), 1.0);
	// A visit without typing leaves it so.
	Click("Weight");
	Click("elsewhere");
	EXPECT_EQ(Error("Weight"), "");
	EXPECT_EQ(rWeight.GetValueText(), "0.5");
}

TEST_F(ParameterView, SliderDragsInShortNumbers)
{
	VParameter& rWeight = AddWeight(1);
	ASSERT_TRUE(Show());
	const QQuickItem* const pSlider = m_Page.Item("WeightSlider");
	const auto at = [pSlider](double i_Share) {
		return pSlider->mapToScene({pSlider->width() * i_Share, pSlider->height() / 2}).toPoint();
	};
	QTest::mousePress(&m_Page.View(), Qt::LeftButton, {}, at(0.3));
	std::vector<double> weights;
	for (const double share : {0.31, 0.35, 0.4, 0.45, 0.5})
	{
		QTest::mouseMove(&m_Page.View(), at(share));
		Run();
		weights.push_back(std::stod(rWeight.GetValueText()));
		EXPECT_LE(rWeight.GetValueText().size(), 4u);
	}
	QTest::mouseRelease(&m_Page.View(), Qt::LeftButton, {}, at(0.5));
	Run();
	EXPECT_LT(weights[1], weights[4]);
	EXPECT_NEAR(std::stod(rWeight.GetValueText()), 50.5, 1.5);
	EXPECT_EQ(Shown("Weight").toStdString(), rWeight.GetValueText());

	rWeight.Set(20.0);
	Run();
	Key(Qt::Key_Right);
	EXPECT_EQ(rWeight.GetValueText(), "20.1");
	// The wheel belongs to what the slider stands in.
	QWheelEvent wheel(
	    at(0.5), m_Page.View().mapToGlobal(at(0.5)), {}, {0, 120}, Qt::NoButton, {}, Qt::NoScrollPhase, false);
	QCoreApplication::sendEvent(&m_Page.View(), &wheel);
	EXPECT_EQ(rWeight.GetValueText(), "20.1");
}

TEST_F(ParameterView, LongEnumerationIsFiltered)
{
	std::vector<std::string> bones;
	for (int i = 0; i < 5000; ++i)
		bones.push_back(std::string(std::size_t(i % 6), ' ') + "Bone" + std::to_string(i));
	VParameter& rRoot = Add<std::string>("Root");
	// An enumeration without entries is one all the same.
	rRoot.SetEnumeration({});
	ASSERT_TRUE(Show());
	EXPECT_EQ(m_Page.Property("Root", "placeholderText"), "Nothing to choose from");
	Click("Root");
	Key(Qt::Key_Return);
	EXPECT_FALSE(rRoot.HasValue());

	rRoot.SetEnumeration(Entries(bones));
	rRoot.Set(bones[3]);
	Run();
	EXPECT_EQ(m_Page.Property("Root", "displayText"), "Bone3");
	Click("Root");
	m_Page.Type("4711");
	Key(Qt::Key_Return);
	EXPECT_EQ(rRoot.GetValueText(), bones[4711]);
	EXPECT_EQ(m_Page.Property("Root", "displayText"), "Bone4711");

	// A stray arrow key changes nothing, it opens the list.
	Key(Qt::Key_Down);
	EXPECT_TRUE(m_Page.Has("RootList"));
	Key(Qt::Key_Escape);
	EXPECT_EQ(rRoot.GetValueText(), bones[4711]);
}

TEST_F(ParameterView, EnumerationFollowsItsParameter)
{
	VParameter& rSource = Add<std::string>("Source");
	rSource.SetEnumeration(Entries({"A", "B", "C"}));
	rSource.Set(std::string("Gone"));
	ASSERT_TRUE(Show());
	// A value that the list does not have is shown as it is.
	EXPECT_EQ(m_Page.Property("Source", "displayText"), "Gone");
	EXPECT_EQ(m_Page.Property("Source", "currentIndex"), -1);
	Click("Source");
	Key(Qt::Key_Down);
	Key(Qt::Key_Return);
	EXPECT_EQ(rSource.GetValueText(), "B");
	// After a pick, too.
	rSource.Set(std::string("C"));
	Run();
	EXPECT_EQ(m_Page.Property("Source", "displayText"), "C");
	rSource.SetEnumeration(Entries({"C", "D"}));
	Run();
	EXPECT_EQ(m_Page.Property("Source", "displayText"), "C");
	EXPECT_EQ(m_Page.Property("Source", "currentIndex"), 0);
}

TEST_F(ParameterView, NoValueIsTheEntryOfTheEmptyValue)
{
	VParameter& rSkin = Add<std::string>("Skin");
	rSkin.SetEnumeration({{"(None)", ToVariant(std::string())}, {"A", ToVariant(std::string("/a.fbx"))}});
	ASSERT_TRUE(Show());
	EXPECT_EQ(m_Page.Property("Skin", "displayText"), "(None)");
	Click("Skin");
	Key(Qt::Key_Down);
	Key(Qt::Key_Return);
	EXPECT_EQ(rSkin.GetValueText(), "/a.fbx");
	EXPECT_EQ(m_Page.Property("Skin", "displayText"), "A");
	Click("Skin");
	Key(Qt::Key_Up);
	Key(Qt::Key_Return);
	EXPECT_FALSE(rSkin.HasValue());
	EXPECT_EQ(m_Page.Property("Skin", "displayText"), "(None)");
}

TEST_F(ParameterView, HiddenAdvancedAndCategories)
{
	const auto flag = [this](const char* i_pName, IParameter::EFlags i_Flag, bool i_bSet)
	{
		std::static_pointer_cast<VParameter>(m_pGroup->Find(i_pName))->SetFlag(i_Flag, i_bSet);
		Run();
	};
	for (const char* pName : {"A", "B", "C", "D"})
		Add<std::string>(pName);
	flag("B", IParameter::EHidden, true);
	flag("C", IParameter::EAdvanced, true);
	flag("D", IParameter::EAdvanced, true);
	flag("D", IParameter::EHidden, true);
	ASSERT_TRUE(Show());
	EXPECT_TRUE(m_Page.Has("A"));
	EXPECT_FALSE(m_Page.Has("B"));
	EXPECT_FALSE(m_Page.Has("C"));
	Click("viewAdvanced");
	EXPECT_TRUE(m_Page.Has("C"));
	EXPECT_FALSE(m_Page.Has("D"));
	Click("viewAdvanced");
	EXPECT_FALSE(m_Page.Has("C"));

	// Flags may change while the view is open.
	flag("B", IParameter::EHidden, false);
	EXPECT_TRUE(m_Page.Has("B"));
	flag("A", IParameter::EHidden, true);
	EXPECT_FALSE(m_Page.Has("A"));
	flag("C", IParameter::EHidden, true);
	// Without an advanced parameter there is nothing to unfold.
	EXPECT_FALSE(m_Page.Has("viewAdvanced"));
	flag("D", IParameter::EHidden, false);
	EXPECT_TRUE(m_Page.Has("viewAdvanced"));
}

TEST_F(ParameterView, BooleansAndOptions)
{
	VParameter& rFlag = Add<bool>("Flag");
	VParameter& rOption = Add<bool>("Option", EPresentationHint::ECheckableOption);
	rOption.Set(true);
	ASSERT_TRUE(Show());
	EXPECT_FALSE(m_Page.Property("Flag", "checked").toBool());
	Click("Flag");
	EXPECT_EQ(rFlag.GetValueText(), "true");
	EXPECT_EQ(Shown("Option"), "On");
	Click("Option");
	EXPECT_EQ(rOption.GetValueText(), "false");
	EXPECT_EQ(Shown("Option"), "Off");
	rFlag.Set(false);
	rOption.Set(true);
	Run();
	EXPECT_FALSE(m_Page.Property("Flag", "checked").toBool());
	EXPECT_TRUE(m_Page.Property("Option", "checked").toBool());
}

TEST_F(ParameterView, CheckableParametersHaveNoValueUntilTheyAreSwitchedOn)
{
	VParameter& rLimit = Add<double>("Limit", EPresentationHint::ECheckableSlider);
	rLimit.SetLimits(2.0, 10.0);
	const VParameter& rNote = Add<std::string>("Note", EPresentationHint::ECheckableOption);
	VParameter& rAlways = Add<double>("Always", EPresentationHint::ECheckableSlider);
	rAlways.SetLimits(2.0, 10.0);
	rAlways.SetDefault(3.0);
	ASSERT_TRUE(Show());
	EXPECT_FALSE(m_Page.Property("Limit", "enabled").toBool());
	Click("LimitSwitch");
	EXPECT_EQ(rLimit.GetValueText(), "2");
	EXPECT_TRUE(m_Page.Property("Limit", "enabled").toBool());
	Click("LimitSwitch");
	EXPECT_FALSE(rLimit.HasValue());
	EXPECT_FALSE(m_Page.Property("LimitSlider", "enabled").toBool());

	// A text has no first value: it waits for what is typed.
	Click("NoteSwitch");
	EXPECT_TRUE(m_Page.Property("NoteSwitch", "checked").toBool());
	TypeInto("Note", "ok");
	Key(Qt::Key_Return);
	EXPECT_EQ(rNote.GetValueText(), "ok");

	// What has a default always has a value.
	EXPECT_FALSE(m_Page.Has("AlwaysSwitch"));
	EXPECT_TRUE(m_Page.Property("Always", "enabled").toBool());
}

TEST_F(ParameterView, SeveralLines)
{
	VParameter& rNotes = Add<std::string>("Notes", EPresentationHint::EMultiLine);
	rNotes.Set(std::string("one"));
	ASSERT_TRUE(Show());
	TypeInto("Notes", "two");
	Key(Qt::Key_Return);
	m_Page.Type("three");
	EXPECT_EQ(rNotes.GetValueText(), "one");
	Key(Qt::Key_Return, Qt::ControlModifier);
	EXPECT_EQ(rNotes.GetValueText(), "two\nthree");
	m_Page.Type("!");
	Key(Qt::Key_Escape);
	EXPECT_EQ(Shown("Notes"), "two\nthree");
	m_Page.Type("?");
	Key(Qt::Key_Tab);
	EXPECT_NE(m_Page.FocusName(), "Notes");
	EXPECT_NE(rNotes.GetValueText().find("?"), std::string::npos);
}

TEST_F(ParameterView, BackToTheDefault)
{
	const VParameter& rScale = AddScale();
	AddWeight(3);
	ASSERT_TRUE(Show());
	EXPECT_TRUE(m_Page.Has("ScaleReset"));
	EXPECT_FALSE(m_Page.Has("WeightReset"));
	Click("ScaleReset");
	EXPECT_EQ(rScale.GetValueText(), "1");
	EXPECT_FALSE(m_Page.Has("ScaleReset"));
}

TEST_F(ParameterView, Colours)
{
	VParameter& rColour = Add<std::string>("Colour", EPresentationHint::EColour);
	rColour.Set(std::string("#e76500"));
	ASSERT_TRUE(Show());
	const QPoint swatch = m_Page.Centre("ColourSwatch");
	EXPECT_EVENTUALLY(m_Page.View().grabWindow().pixelColor(swatch) == QColor(231, 101, 0));
	TypeInto("Colour", "#4b78aa");
	Key(Qt::Key_Return);
	EXPECT_EQ(rColour.GetValueText(), "#4b78aa");
	EXPECT_EVENTUALLY(m_Page.View().grabWindow().pixelColor(swatch) == QColor(75, 120, 170));
}

TEST_F(ParameterView, FileDialogs)
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
		const char* m_pName;
		EFileAccess m_Access;
		const char* m_pTitle;
		QFileDialog::FileMode m_Mode;
		QFileDialog::AcceptMode m_AcceptMode;
		QString m_Typed;
		QString m_Result;
	} rows[] = {
	    {"Folder", EFileAccess::EFolder, "Choose a folder", QFileDialog::Directory, QFileDialog::AcceptOpen,
	        folder.path(), folder.path()},
	    {"Save", EFileAccess::ESave, "Choose a file to save", QFileDialog::AnyFile, QFileDialog::AcceptSave,
	        folder.filePath("new.fbx"), folder.filePath("new.fbx")},
	    {"Load", EFileAccess::ELoad, "Choose a file", QFileDialog::ExistingFile, QFileDialog::AcceptOpen,
	        folder.filePath("b.fbx"), folder.filePath("b.fbx")},
	    {"Several", EFileAccess::ELoadMultiple, "Choose files", QFileDialog::ExistingFiles, QFileDialog::AcceptOpen,
	        "\"" + first + "\" \"" + folder.filePath("b.fbx") + "\"", first + ";" + folder.filePath("b.fbx")},
	};
	for (const auto& rRow : rows)
	{
		VParameter& rFile = Add<std::string>(rRow.m_pName);
		rFile.SetFileAccess(rRow.m_Access);
		rFile.SetFileFilter("FBX files (*.fbx);;All files (*)");
		rFile.Set(first.toStdString());
	}
	ASSERT_TRUE(Show());
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pTitle);
		Click(QString(rRow.m_pName) + "Browse");
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
		if (rRow.m_Access != EFileAccess::EFolder)
		{
			EXPECT_EQ(pDialog->nameFilters(), (QStringList{"FBX files (*.fbx)", "All files (*)"}));
			EXPECT_EQ(pDialog->directory().absolutePath(), folder.path());
		}
		auto* const pName = pDialog->findChild<QLineEdit*>("fileNameEdit");
		ASSERT_TRUE(pName);
		pName->setText(rRow.m_Typed);
		QMetaObject::invokeMethod(pDialog, "accept");
		EXPECT_EVENTUALLY(m_pGroup->Find(rRow.m_pName)->GetValueText() == rRow.m_Result.toStdString());
		EXPECT_EVENTUALLY(!pDialog->isVisible());

		m_Page.View().requestActivate();
		ASSERT_TRUE(QTest::qWaitForWindowActive(&m_Page.View()));
	}
}

TEST_F(ParameterView, TabWalksThroughTheFields)
{
	AddScale();
	AddWeight(3);
	Add<std::string>("Root").SetEnumeration(Entries({"a", "b"}));
	ASSERT_TRUE(Show());
	Click("Scale");
	QStringList visited;
	for (int i = 0; i < 5; ++i)
	{
		Key(Qt::Key_Tab);
		visited.append(m_Page.FocusName());
	}
	EXPECT_EQ(visited, (QStringList{"ScaleReset", "WeightSlider", "Weight", "Root", "elsewhere"}));
	Key(Qt::Key_Backtab);
	EXPECT_EQ(m_Page.FocusName(), "Root");
}

TEST_F(ParameterView, EndsWithItsGroup)
{
	AddWeight(3);
	ASSERT_TRUE(Show());
	// A module that goes while somebody types takes its parameters along.
	TypeInto("Weight", "7");
	m_pGroup.reset();
	Run();
	EXPECT_FALSE(m_Page.Has("Weight"));
	Key(Qt::Key_Return);

	// One that comes later is shown by the same view.
	m_pGroup = std::make_shared<VParameterGroup>(std::make_shared<TesselDataStore::VDataStore>(), "Panel", "Group");
	AddScale();
	m_pRegistry->Register("Panel", m_pGroup);
	EXPECT_EQ(Shown("Scale"), "1.5");
}

TEST_F(ParameterView, EveryControlHasAnAccessibleName)
{
	const VParameter& rScale = AddScale();
	AddWeight(3);
	Add<std::string>("Root").SetEnumeration(Entries({"a", "b"}));
	const VParameter& rFlag = Add<bool>("Flag");
	Add<bool>("Option", EPresentationHint::ECheckableOption);
	Add<std::string>("Note", EPresentationHint::ECheckableOption);
	Add<std::string>("Notes", EPresentationHint::EMultiLine);
	Add<std::string>("Colour", EPresentationHint::EColour);
	Add<std::string>("File").SetFileAccess(EFileAccess::ELoad);
	Add<std::string>("Deep").SetFlag(IParameter::EAdvanced, true);
	ASSERT_TRUE(Show());
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
		QAccessibleInterface* const pInterface = QAccessible::queryAccessibleInterface(m_Page.Item(rRow.m_pItem));
		ASSERT_TRUE(pInterface) << rRow.m_pItem;
		EXPECT_EQ(pInterface->role(), rRow.m_Role) << rRow.m_pItem;
		EXPECT_EQ(pInterface->text(QAccessible::Name).toStdString(), rRow.m_pName) << rRow.m_pItem;
	}
	// As a screen reader presses them.
	const auto act = [this](const char* i_pItem, const QString& i_rAction)
	{
		QAccessible::queryAccessibleInterface(m_Page.Item(i_pItem))->actionInterface()->doAction(i_rAction);
		Run();
	};
	act("Flag", "Press");
	EXPECT_EQ(rFlag.GetValueText(), "true");
	act("Flag", "Toggle");
	EXPECT_EQ(rFlag.GetValueText(), "false");
	EXPECT_FALSE(m_Page.Has("WeightReset")) << "no default";
	act("ScaleReset", "Press");
	EXPECT_EQ(rScale.GetValueText(), "1");
	EXPECT_FALSE(m_Page.Has("ScaleReset"));
	act("viewAdvanced", "Press");
	EXPECT_TRUE(m_Page.Has("Deep"));
	act("Root", "Press");
	EXPECT_TRUE(m_Page.Has("RootList"));
}

} // namespace
