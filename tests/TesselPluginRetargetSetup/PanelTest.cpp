// The panel's controls: what they are called, what they do, what they show.

#include "TestPanel.h"

#include "OrlexGraphics/item/SceneFramebufferObject.h"
#include "RetargetSetupCore/Identity.h"
#include "TesselDataStore/StoredValue.h"

#include <QLayout>
#include <QQmlProperty>
#include <QTest>

#include <boost/filesystem/operations.hpp>

namespace
{

using OrlexGraphics::VSceneFramebufferObject;

class Panel : public VPanelTest
{
protected:
	void Click(const QString& i_rObjectName)
	{
		Tap(i_rObjectName);
		Run();
	}

	/// So short a click that nothing that was posted runs before it ends.
	void Tap(const QString& i_rObjectName)
	{
		if (!m_pWidget->isVisible())
		{
			m_pWidget->resize(1280, 800);
			m_pWidget->show();
			m_pWidget->activateWindow();
			EXPECT_TRUE(QTest::qWaitForWindowActive(m_pWidget.get()));
			Run();
		}
		const QQuickItem* const pItem = Item(i_rObjectName);
		ASSERT_TRUE(pItem);
		QTest::mouseClick(m_pWidget.get(), Qt::LeftButton, {},
		    pItem->mapToScene({pItem->width() / 2, pItem->height() / 2}).toPoint());
	}

	/// Types in a field, and leaves it open.
	void Write(const QString& i_rField, const QString& i_rText)
	{
		Click(i_rField);
		QTest::keyClick(m_pWidget.get(), Qt::Key_A, Qt::ControlModifier);
		QTest::keyClicks(m_pWidget.get(), i_rText);
		EXPECT_EQ(Property(i_rField, "text").toString(), i_rText);
	}

	VSceneFramebufferObject& Scene() const { return *qobject_cast<VSceneFramebufferObject*>(Item("scene")); }
	QVariant Option(const QString& i_rKey) const { return Scene().GetSceneOptions()->value(i_rKey); }
	QUrl Url(const char* i_pName) const
	{
		return QUrl::fromLocalFile(QString::fromStdString((m_Folder / i_pName).string()));
	}
};

TEST_F(Panel, ControlsAreCalledSo)
{
	struct VRow
	{
		const char* m_pName;
		const char* m_pText;
		const char* m_pToolTip;
		bool m_bEnabled = true;
		QVariant m_Checked = {};
	};
	const VRow rows[] = {
	    {"currentFile", "Current file: *None*", ""},
	    {"createTargetSubject", "Create Target Subject", "Create a retarget skeleton for the selected FBX"},
	    {"load", "Load", "Load an existing retarget skeleton from disk"},
	    {"save", "Save", "Save the current retarget skeleton to the last filename", false},
	    {"saveAs", "Save As", "Save the current retarget skeleton to a new file"},
	    {"createAllJoints", "Create all joints", "Add a joint to every segment in the retarget skeleton"},
	    {"removeUnnecessaryJoints", "Remove unnecessary joints",
	        "Remove joints from segments with no targets on themselves or their children"},
	    {"jointSymmetry", "Joint symmetry", "Apply mirrored rotation to left and right segments", true, true},
	    {"addPositionTarget", "Add position target",
	        "Add a world-space position target for the selected segments. Shortcut: Alt+T", false},
	    {"addRotationTarget", "Add rotation target",
	        "Add a world-space rotation target for the selected segments. Shortcut: Alt+R", false},
	    {"targetSymmetry", "Target symmetry", "Create matching targets on left and right", true, false},
	    {"updateTargets", "Update targets", "Recalculate offsets to each target based on the current pose"},
	    {"removeTarget", "Remove target", "Delete the selected target", false},
	    {"viewFilters", "View Filters", "", true, true},
	    {"showManipulator", "Show Manipulator", "", true, true},
	};
	Open();
	for (const VRow& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		EXPECT_EQ(Property(rRow.m_pName, "text").toString(), rRow.m_pText);
		EXPECT_EQ(Property(rRow.m_pName, "toolTip").toString(), rRow.m_pToolTip);
		EXPECT_EQ(Property(rRow.m_pName, "enabled").toBool(), rRow.m_bEnabled);
		EXPECT_TRUE(!rRow.m_Checked.isValid() || Property(rRow.m_pName, "checked") == rRow.m_Checked);
		EXPECT_EQ(
		    QQmlProperty(Item(rRow.m_pName), "Accessible.name", qmlContext(Item(rRow.m_pName))).read(), rRow.m_pText);
	}
	EXPECT_EQ(Property("cameraType", "model").toStringList(),
	    (QStringList{"Perspective", "Front", "Back", "Left", "Right", "Top", "Bottom"}));
	EXPECT_EQ(Property("cameraType", "currentIndex").toInt(), 0);
	EXPECT_EQ(Property("cameraType", "width").toInt(), 100);
	for (const char* const pDialog : {"loadDialog", "saveDialog"})
	{
		const QObject* const pObject = m_pWidget->rootObject()->findChild<QObject*>(pDialog);
		ASSERT_TRUE(pObject);
		EXPECT_EQ(pObject->property("title").toString(), "Choose a file");
		const bool bLoad = pDialog == QByteArray("loadDialog");
		EXPECT_EQ(pObject->property("selectExisting").toBool(), bLoad);
		EXPECT_FALSE(pObject->property("selectMultiple").toBool());
		EXPECT_EQ(pObject->property("nameFilters").toStringList(),
		    bLoad ? QStringList({"Subject files (*.qrr)", "Legacy subject files (*.qrx)"})
		          : QStringList({"Subject files (*.qrr)"}));
	}
}

TEST_F(Panel, LaysOutItsListsAndColumns)
{
	OpenDemo();
	m_pDocument->CreateTargetSubject();
	Run();
	EXPECT_EQ(qobject_cast<QQuickWidget*>(m_pWidget.get())->resizeMode(), QQuickWidget::SizeRootObjectToView);
	EXPECT_TRUE(m_pWidget->layout() && m_pWidget->layout()->inherits("QVBoxLayout"));
	EXPECT_EQ(Property("sourceSegments", "title").toString(), "Source Segments");
	EXPECT_EQ(Property("targetSegments", "title").toString(), "Target Segments");
	for (const auto& [pName, pModel] :
	    {std::pair<const char*, QAbstractItemModel*>{"sourceSegments", m_pDocument->GetSourceSegmentModel().get()},
	        {"targetSegments", m_pDocument->GetTargetSegmentModel().get()},
	        {"targets", m_pDocument->GetTargetModel().get()}})
		EXPECT_EQ(Property(pName, "model").value<QObject*>(), pModel) << pName;
	const QVariantList columns = Property("targets", "columns").toList();
	const std::tuple<const char*, const char*, double> expected[] = {{"sourceSegment", "Source", 0.25},
	    {"targetSegment", "Target", 0.25}, {"targetType", "Type", 0.25}, {"weight", "Weight", 0.2}};
	ASSERT_EQ(columns.size(), 4);
	for (int i = 0; i < 4; ++i)
	{
		const QVariantMap column = columns[i].toMap();
		EXPECT_EQ(column["role"].toString(), std::get<0>(expected[i]));
		EXPECT_EQ(column["title"].toString(), std::get<1>(expected[i]));
		EXPECT_EQ(column["share"].toDouble(), std::get<2>(expected[i]));
	}
}

TEST_F(Panel, NothingIsCutOffAtItsLeastSize)
{
	OpenDemo();
	const QSize least = m_pWidget->minimumSizeHint();
	EXPECT_LE(least.width(), 1280);
	EXPECT_LE(least.height(), 400) << "room for menus, messages and a title bar in 1366x768";
	m_pWidget->resize(least);
	m_pWidget->show();
	m_pWidget->activateWindow();
	EXPECT_TRUE(QTest::qWaitForWindowActive(m_pWidget.get()));
	Run();
	EXPECT_TRUE(Property("leftView", "interactive").toBool());
	EXPECT_GE(Item("targets")->height(), 6 * Item("status")->implicitHeight()) << "five rows under their header";
	const QRectF whole = m_pWidget->rootObject()->boundingRect();
	const auto isSeen = [&](const QQuickItem* i_pItem)
	{ return whole.contains(i_pItem->mapRectToItem(m_pWidget->rootObject(), i_pItem->boundingRect())); };
	for (const char* const pName : {"createTargetSubject", "load", "save", "saveAs", "createAllJoints",
	         "removeUnnecessaryJoints", "jointSymmetry", "addPositionTarget", "addRotationTarget", "targetSymmetry",
	         "updateTargets", "targets", "removeTarget", "targetParameters", "subjectParameters", "cameraType",
	         "viewFilters", "showManipulator", "sourceSegments", "targetSegments", "filterTargetSkinXRay"})
	{
		const QQuickItem* const pItem = Item(pName);
		// What does not fit into the left column can be scrolled to.
		QMetaObject::invokeMethod(
		    Item("leftView"), "reveal", Q_ARG(QVariant, QVariant::fromValue(const_cast<QQuickItem*>(pItem))));
		EXPECT_TRUE(isSeen(pItem)) << pName;
		const QByteArray type = pItem->metaObject()->className();
		EXPECT_TRUE(
		    !(type.startsWith("OrlexButton") || type.contains("CheckBox")) || pItem->width() >= pItem->implicitWidth())
		    << pName;
	}
	// What has the keyboard is scrolled to by itself.
	for (const char* const pName : {"SourceSkeleton", "targets", "SourceSkeleton"})
	{
		Item(pName)->forceActiveFocus();
		EXPECT_TRUE(isSeen(Item(pName))) << pName;
	}
}

TEST_F(Panel, SetsTheOptionsOfItsScene)
{
	Open();
	const std::pair<const char*, bool> options[] = {
	    {"LabellingSubject-Enabled", true},
	    {"LabellingSubject-Markers", false},
	    {"LabellingSubject-Sticks", false},
	    {"LabellingSubject-Targets", false},
	    {"LabellingSubject-SkinXRay", true},
	    {"SolvingSubject-Markers", false},
	    {"SolvingSubject-Sticks", false},
	    {"SolvingSubject-MissingMarkers", false},
	    {"SolvingSubject-SkinXRay", true},
	    {"SolvingSubject-Targets", true},
	};
	for (const auto& [pKey, bValue] : options)
		EXPECT_EQ(Option(pKey), QVariant(bValue)) << pKey;
	EXPECT_TRUE(Scene().Options().m_SolvingSubject.m_bSkinXRay && Scene().Options().m_SolvingSubject.m_bTargets)
	    << "the scene has them, too";
	EXPECT_EQ(Scene().GetScene(), m_pScene.get());

	Click("showManipulator");
	EXPECT_EQ(Option("Manipulator"), QVariant(false));
	Click("showManipulator");
	EXPECT_EQ(Option("Manipulator"), QVariant(true));
	ASSERT_TRUE(Item("cameraType")->setProperty("currentIndex", 4));
	EXPECT_EQ(Scene().GetCameraType(), 4);
	EXPECT_TRUE(Property("filters", "visible").toBool());
	Click("viewFilters");
	EXPECT_FALSE(Property("filters", "visible").toBool());
}

TEST_F(Panel, FiltersSwitchTheirOptions)
{
	struct VRow
	{
		const char* m_pName;
		const char* m_pText;
		QStringList m_Options;
		int m_Indent = 0;
	};
	const VRow rows[] = {
	    {"filterConstraints", "Constraints", {"SolvingSubject-Targets"}},
	    {"filterJoints", "Joints", {"LabellingSubject-Joints", "SolvingSubject-Joints"}},
	    {"filterSegmentAxes", "Segment Axes", {"LabellingSubject-Axes", "SolvingSubject-Axes"}},
	    {"filterSourceSkin", "Source Skin", {"LabellingSubject-Skin"}},
	    {"filterSourceSkinXRay", "Source Skin X-Ray", {"LabellingSubject-SkinXRay"}, 10},
	    {"filterTargetSkin", "Target Skin", {"SolvingSubject-Skin"}},
	    {"filterTargetSkinXRay", "Target Skin X-Ray", {"SolvingSubject-SkinXRay"}, 10},
	};
	Open();
	double y = -1.0;
	for (const VRow& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		EXPECT_EQ(Property(rRow.m_pName, "text").toString(), rRow.m_pText);
		EXPECT_EQ(Property(rRow.m_pName, "x").toInt(), rRow.m_Indent);
		EXPECT_GT(Property(rRow.m_pName, "y").toDouble(), std::exchange(y, Property(rRow.m_pName, "y").toDouble()));
		const bool bBefore = Option(rRow.m_Options[0]).toBool();
		EXPECT_EQ(Property(rRow.m_pName, "checked").toBool(), bBefore);
		for (const bool bExpected : {!bBefore, bBefore})
		{
			Click(rRow.m_pName);
			EXPECT_EQ(Property(rRow.m_pName, "checked").toBool(), bExpected);
			for (const QString& rOption : rRow.m_Options)
				EXPECT_EQ(Option(rOption), QVariant(bExpected)) << rOption.toStdString();
		}
	}
}

TEST_F(Panel, AnswersTheHostsCommands)
{
	Open();
	auto* const pCommands = static_cast<ITesselExecuteCommand*>(m_pWidget->qt_metacast("ITesselExecuteCommand"));
	ASSERT_TRUE(pCommands);
	EXPECT_STREQ(m_pWidget->metaObject()->className(), "VRetargetSetupWidget");
	struct VRow
	{
		const char* m_pCommand;
		double m_Before;
		double m_After;
	};
	const VRow rows[] = {
	    {"Workspace3d:ScaleUpManipulator", 1.0, 1.35},
	    {"Workspace3d:ScaleUpManipulator", 14.0, 15.0},
	    {"Workspace3d:ScaleDownManipulator", 1.0, 0.7407407},
	    {"Workspace3d:ScaleDownManipulator", 0.21, 0.2},
	};
	for (const VRow& rRow : rows)
	{
		Scene().GetSceneOptions()->insert("ManipulatorScale", rRow.m_Before);
		Scene().OnSceneOptionsMapChanged("ManipulatorScale", rRow.m_Before);
		EXPECT_TRUE(pCommands->ExecuteCommand(rRow.m_pCommand));
		Run();
		EXPECT_FLOAT_EQ(Scene().Options().m_ManipulatorScale, float(rRow.m_After)) << rRow.m_pCommand;
		EXPECT_FLOAT_EQ(Option("ManipulatorScale").toFloat(), float(rRow.m_After)) << rRow.m_pCommand;
	}
	for (const char* const pOther : {"", "Workspace3d:FrameSelected ", "workspace3d:frameselected", "FrameSelected"})
		EXPECT_FALSE(pCommands->ExecuteCommand(pOther)) << pOther;
	EXPECT_EQ(m_pWidget->contextProperty("FocusSelection"), QVariant(false));
	EXPECT_TRUE(pCommands->ExecuteCommand("Workspace3d:FrameSelected"));
	EXPECT_EQ(m_pWidget->contextProperty("FocusSelection"), QVariant(true));
}

TEST_F(Panel, TakesCommandsBeforeItsQmlIsThere)
{
	Open(false);
	ASSERT_FALSE(m_pWidget->rootObject());
	for (const char* const pCommand :
	    {"Workspace3d:FrameSelected", "Workspace3d:ScaleUpManipulator", "Workspace3d:ScaleDownManipulator"})
		EXPECT_TRUE(m_pWidget->ExecuteCommand(pCommand)) << pCommand;
	EXPECT_EQ(m_pWidget->minimumSizeHint(), QSize());
	m_pGui->m_pEngine->m_Warnings.clear();
}

TEST_F(Panel, ShowsTheDocumentToItsQml)
{
	m_Context.Folders().SetFolder("FolderRetargets", m_Folder.Path());
	Open();
	const std::pair<const char*, QObject*> objects[] = {{"FlowScene", m_pScene.get()},
	    {"ContextRetargetSetup", m_pDocument.get()}, {"RetargetSetupSelection", m_pSelection.get()},
	    {"SourceSegmentModel", m_pDocument->GetSourceSegmentModel().get()},
	    {"TargetSegmentModel", m_pDocument->GetTargetSegmentModel().get()},
	    {"TargetModel", m_pDocument->GetTargetModel().get()}};
	for (const auto& [pName, pObject] : objects)
		EXPECT_EQ(m_pWidget->contextProperty(pName).value<QObject*>(), pObject) << pName;
	EXPECT_EQ(m_pWidget->contextProperty("FocusSelection"), QVariant(false));
	EXPECT_EQ(m_pWidget->contextProperty("MouseOver"), QVariant(true));
	EXPECT_EQ(m_pWidget->contextProperty("ContextRetargetsUrl").toUrl(),
	    QUrl::fromLocalFile(QString::fromStdString(m_Folder.Path().string())));
	m_Context.Folders().SetFolder("FolderRetargets", "/somewhere else");
	Run();
	EXPECT_EQ(m_pWidget->contextProperty("ContextRetargetsUrl").toUrl(), QUrl("file:///somewhere else"));
}

TEST_F(Panel, AddsAndRemovesTargetsOfTheSelection)
{
	OpenDemo();
	Click("createTargetSubject");
	Select(NVX::ESelectionSourceSegment, 0);
	EXPECT_FALSE(Property("addPositionTarget", "enabled").toBool()) << "one segment is not enough";
	Select(NVX::ESelectionTargetSegment, 0);
	EXPECT_TRUE(Property("addPositionTarget", "enabled").toBool());
	EXPECT_TRUE(Property("addRotationTarget", "enabled").toBool());
	Click("addPositionTarget");
	Click("addRotationTarget");
	ASSERT_EQ(Target().m_Targets.size(), 2u);
	EXPECT_EQ(Target().m_Targets[0].m_Type, CoreOrlexTypes::VSubjectParametrised::VTarget::ELocalPointToWorldPoint);
	EXPECT_EQ(
	    Target().m_Targets[1].m_Type, CoreOrlexTypes::VSubjectParametrised::VTarget::ELocalRotationToWorldRotation);
	EXPECT_FALSE(Property("removeTarget", "enabled").toBool());
	Select(NVX::ESelectionTarget, 0);
	m_pWidget->grabFramebuffer();
	EXPECT_EQ(Property("TargetStateExpressionZUnit", "text").toString(), "mm");
	EXPECT_TRUE(Property("TargetStateExpressionZUnit", "visible").toBool());
	const double place = Item("removeTarget")->y();
	Select(NVX::ESelectionTarget, 1);
	m_pWidget->grabFramebuffer();
	EXPECT_EQ(Item("removeTarget")->y(), place) << "where the mouse is, though a rotation shows less";
	EXPECT_TRUE(Property("removeTarget", "enabled").toBool());
	EXPECT_TRUE(Property("targetParameters", "enabled").toBool());
	Click("removeTarget");
	EXPECT_EQ(Target().m_Targets.size(), 1u);
	EXPECT_EQ(m_pSelection->SelectedTarget(), 0) << "the one before it";
	Click("removeTarget");
	EXPECT_TRUE(Target().m_Targets.empty());
	EXPECT_FALSE(Property("removeTarget", "enabled").toBool()) << "it was the last one";
	EXPECT_FALSE(Property("targetParameters", "enabled").toBool());

	m_Context.SelectionManager().Selection().Add({{NVX::ESelectionSourceSegment, RetargetSetup::c_SubjectId, 1, {}}});
	Run();
	EXPECT_FALSE(Property("addPositionTarget", "enabled").toBool()) << "two source segments are too many";
	QTest::keyClick(m_pWidget.get(), Qt::Key_T, Qt::AltModifier);
	EXPECT_EQ(Property("status", "told").toString(), "2 source segments are selected: select only one.");

	EXPECT_TRUE(m_pDocument->JointSymmetry());
	Click("jointSymmetry");
	EXPECT_FALSE(m_pDocument->JointSymmetry());
	m_pDocument->SetJointSymmetry(true);
	EXPECT_TRUE(Property("jointSymmetry", "checked").toBool());
}

TEST_F(Panel, ACommandActsOnWhatIsSeen)
{
	OpenDemo();
	m_Context.Folders().SetFolder("FolderSkins", RETARGET_TEST_DATA "/fbx");
	// Nothing that was posted runs by itself from here on.
	Click("showManipulator");
	// Chosen just before.
	boost::filesystem::copy_file(c_DemoSource, m_Folder / "anna.qrs");
	Parameter("SourceSkeleton").SetValue(TesselDataStore::ToVariant((m_Folder / "anna.qrs").string()));
	Parameter("TargetRoot").SetValue(TesselDataStore::ToVariant(std::uint32_t(1)));
	Tap("createTargetSubject");
	EXPECT_EQ(m_pDocument->TargetValues().m_pApplicationData->m_RetargetSourceTemplate, "anna");
	EXPECT_EQ(Target().m_Segments.at(0).m_Name, "loin");
	EXPECT_EQ(Parameter("TargetFBX").SetValueText("heaps_biped_zup_a7100"), "");
	Tap("createTargetSubject");
	EXPECT_EQ(m_pDocument->TargetValues().m_pApplicationData->m_Skin, "heaps_biped_zup_a7100");
	Run();

	auto& rSelection = m_Context.SelectionManager().Selection();
	for (const std::uint32_t segment : {2u, 4u, 6u})
	{
		const auto select = [&](std::uint32_t i_Index)
		{
			rSelection.Replace({{NVX::ESelectionSourceSegment, RetargetSetup::c_SubjectId, i_Index, {}},
			    {NVX::ESelectionTargetSegment, RetargetSetup::c_SubjectId, i_Index, {}}});
		};
		select(1);
		Run();
		select(segment);
		Tap("addPositionTarget");
		Run();
		EXPECT_EQ(Target().m_Targets.back().m_SegmentIndices, (std::vector<std::uint32_t>{segment}));
	}
	const auto state = [this](std::size_t i_Target) { return Target().m_Targets[i_Target].m_StateExpressions[0]; };
	const std::string measured = state(0);
	const std::string last = state(2);

	Select(NVX::ESelectionTarget, 0);
	Write("TargetStateExpressionX", "77");
	Tap("createAllJoints");
	EXPECT_EQ(state(0), "77.000000*GlobalScale");
	Run();
	Write("TargetStateExpressionX", "78");
	Tap("updateTargets");
	Run();
	EXPECT_EQ(state(0), measured) << "what is measured counts, not what was typed before";
	Write("TargetWeight", "5");
	QTest::keyClick(m_pWidget.get(), Qt::Key_T, Qt::AltModifier);
	Run();
	EXPECT_EQ(Target().m_Targets[0].m_Weight, 5.0);
	Write("TargetStateExpressionX", "79");
	Tap("removeTarget");
	Run();
	EXPECT_EQ(Target().m_Targets.size(), 3u) << "one was added, one is gone";
	EXPECT_EQ(state(1), last);
	for (const auto& rTarget : Target().m_Targets)
		EXPECT_EQ(rTarget.m_StateExpressions[0].find("79"), std::string::npos) << "it went with its target";
	// Selected just before.
	rSelection.Remove(rSelection.ItemsOfKind(NVX::ESelectionTarget));
	rSelection.Add({{NVX::ESelectionTarget, RetargetSetup::c_SubjectId, 1, {}}});
	Tap("removeTarget");
	Run();
	EXPECT_EQ(Target().m_Targets.size(), 2u);
	EXPECT_NE(state(0), last);
	emit m_pDocument->targetFound(0);
	Run();
	EXPECT_EQ(m_pSelection->SelectedTarget(), 0);
	EXPECT_EQ(m_pSelection->SelectedTargetSegment(), 6) << "segments stay selected";
	Click("createTargetSubject");
	EXPECT_EQ(m_pSelection->SelectedTargetSegment(), -1) << "of the character before";
	EXPECT_EQ(m_pSelection->SelectedSourceSegment(), 6);
	EXPECT_EQ(Type("SourceSkeleton", "performer"), "");
	EXPECT_EQ(m_pSelection->SelectedSourceSegment(), -1) << "of the performer before";

	// A character that lies is told of until it stands.
	EXPECT_EQ(Type("TargetFBX", "pab_arnaud_b7500"), "");
	for (const char* const pButton : {"matchFilePose", "poseNoteMatch"})
	{
		EXPECT_FALSE(Property("poseNote", "visible").toBool());
		Click("createTargetSubject");
		EXPECT_TRUE(Property("poseNote", "visible").toBool());
		Click(pButton);
	}
	EXPECT_FALSE(Property("poseNote", "visible").toBool());
}

TEST_F(Panel, ListsStayWhereTheyWereScrolledTo)
{
	OpenDemo();
	Click("createTargetSubject");
	for (const char* const pList : {"sourceSegmentsView", "targetSegmentsView"})
		ASSERT_TRUE(Item(pList)->setProperty("contentY", 88.0));
	m_pDocument->AddTarget(0, 0, true, false);
	Run();
	for (const char* const pList : {"sourceSegmentsView", "targetSegmentsView"})
		EXPECT_EQ(Property(pList, "contentY").toDouble(), 88.0) << pList;
}

TEST_F(Panel, RemembersWhatWasLoadedAndNothingElse)
{
	OpenDemo();
	Click("createTargetSubject");
	EXPECT_FALSE(Property("save", "enabled").toBool()) << "a new subject has no file yet";
	m_pDocument->SaveTargetSubjectURL(Url("none/a b.qrr"));
	m_pDocument->LoadTargetSubjectURL(Url("none.qrr"));
	Run();
	EXPECT_EQ(Property("currentFile", "text").toString(), "Current file: *None*");
	EXPECT_TRUE(Property("unsavedMark", "visible").toBool());
	m_pDocument->SaveTargetSubjectURL(Url("a b.qrr"));
	Run();
	EXPECT_EQ(Property("currentFile", "text").toString(), "Current file: a b.qrr");
	EXPECT_FALSE(Property("unsavedMark", "visible").toBool());
	Click("createTargetSubject");
	EXPECT_EQ(Property("currentFile", "text").toString(), "Current file: *None*") << "one that is made has no file";
	m_pDocument->LoadTargetSubjectURL(Url("a b.qrr"));
	Run();
	EXPECT_EQ(Property("currentFile", "text").toString(), "Current file: a b.qrr");
	EXPECT_TRUE(Property("save", "enabled").toBool());
	m_pDocument->LoadTargetSubjectURL(Url("none.qrr"));
	Run();
	EXPECT_EQ(Property("currentFile", "text").toString(), "Current file: a b.qrr") << "a failed load changes nothing";

	boost::filesystem::remove(m_Folder / "a b.qrr");
	Click("save");
	EXPECT_TRUE(boost::filesystem::exists(m_Folder / "a b.qrr"));
}

} // namespace
