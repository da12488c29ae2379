// The whole job at the window, by mouse and keyboard alone: from two files to a saved retarget subject.

#include "WindowFixture.h"

#include "studio/host/OpenGLCheck.h"
#include "studio/host/Services.h"

#include <QApplication>
#include <QFile>
#include <QGuiApplication>
#include <QQuickItem>
#include <QStyleHints>

namespace
{

class Job : public Window
{
};

TEST_F(Job, TheWholeJob)
{
	VOperator& rOperator = *m_pOperator;
	EXPECT_TRUE(rOperator.Property("SourceSkeleton", "activeFocus").toBool()) << "the first field";
	EXPECT_TRUE(rOperator.Property("startPage", "visible").toBool());
	rOperator.AnswerNextDialog(File("performer.qrs"));
	rOperator.Click("start0");
	EXPECT_EVENTUALLY(rOperator.Property("sourceSegments", "count").toInt() > 20);
	EXPECT_FALSE(rOperator.Property("startPage", "visible").toBool());
	rOperator.Choose("TargetFBX", "character");
	EXPECT_EVENTUALLY(rOperator.Property("TargetRoot", "currentText").toString() == "haunch");
	rOperator.Choose("TargetRoot", "loin");
	rOperator.Choose("TargetRoot", "haunch");
	rOperator.Fill("TargetScale", "1.25");
	rOperator.Click("createTargetSubject");
	EXPECT_EVENTUALLY(rOperator.Property("targetSegments", "count").toInt() > 20);
	QStringList edits{"create", "--fbx", File("character.fbx"), "--source", File("performer.qrs"), "--scale", "1.25",
	    "--match-file-pose"};

	SelectPair("Pelvis", "haunch");
	rOperator.Click("addPositionTarget");
	EXPECT_EVENTUALLY(Targets() == 1);
	rOperator.Key(Qt::Key_R, Qt::AltModifier);
	EXPECT_EVENTUALLY(Targets() == 2);
	edits += {"--position", "Pelvis:haunch", "--rotation", "Pelvis:haunch"};

	rOperator.Click("targetSymmetry");
	SelectPair("L_Hand", "palmLeft");
	rOperator.Key(Qt::Key_T, Qt::AltModifier);
	EXPECT_EVENTUALLY(Targets() == 4);
	SelectPair("L_Humerus", "upperArmLeft");
	rOperator.Click("addRotationTarget");
	EXPECT_EVENTUALLY(Targets() == 6);
	rOperator.Click("targetSymmetry");
	SelectPair("Cranium", "skull");
	rOperator.Click("addPositionTarget");
	EXPECT_EVENTUALLY(Targets() == 7);
	edits += {"--symmetry", "--position", "L_Hand:palmLeft", "--rotation", "L_Humerus:upperArmLeft", "--no-symmetry",
	    "--position", "Cranium:skull"};

	rOperator.Click("removeUnnecessaryJoints");
	rOperator.Click("updateTargets");
	edits += {"--prune-joints", "--update-targets"};

	rOperator.ClickRow("targets", 6);
	EXPECT_EVENTUALLY(rOperator.Property("removeTarget", "enabled").toBool());
	rOperator.Fill("TargetWeight", "2.5");
	rOperator.Fill("TargetStateExpressionX", "12.5");
	rOperator.Fill("TargetStateExpressionY", "-3");
	edits += {"--weight", "6=2.5", "--state", "6=12.5,-3,-0.5"};
	rOperator.Replace("TargetStateExpressionZ", "-0.5");
	// What stands in a field belongs to the target that it was typed for.
	rOperator.ClickRow("targets", 2);
	EXPECT_EVENTUALLY(rOperator.Property("TargetWeight", "text").toString() == "1");
	const struct
	{
		const char* m_pField;
		const char* m_pText;
		const char* m_pReason;
	} refused[] = {{"TargetStateExpressionX", "abc", "Give a number of mm"},
	    {"TargetScale", "-1", "Give a number above 0"}, {"TargetWeight", "500", "Allowed: 1 to 100."}};
	for (const auto& rRow : refused)
	{
		const QString reason = QString(rRow.m_pField) + "Reason";
		rOperator.Fill(rRow.m_pField, rRow.m_pText);
		EXPECT_EVENTUALLY(rOperator.Property(reason, "visible").toBool());
		EXPECT_TRUE(rOperator.Property(reason, "text").toString().contains(rRow.m_pReason)) << rRow.m_pField;
		EXPECT_EQ(rOperator.Property(rRow.m_pField, "text").toString(), rRow.m_pText);
	}
	rOperator.Click("TargetScale");
	rOperator.Key(Qt::Key_Escape);
	rOperator.ClickRow("targets", 1);
	EXPECT_EVENTUALLY(rOperator.Property("TargetWeight", "text").toString() == "1");
	EXPECT_FALSE(rOperator.Property("TargetWeightReason", "visible").toBool());
	rOperator.Click("removeTarget");
	EXPECT_EVENTUALLY(Targets() == 6);
	rOperator.Click("createAllJoints");
	edits += {"--remove-target", "1", "--create-joints"};

	EXPECT_FALSE(rOperator.Property("save", "enabled").toBool());
	rOperator.Click("saveAs");
	rOperator.AnswerDialog(File("job.qrr"));
	EXPECT_EVENTUALLY(QFile::exists(File("job.qrr")));
	EXPECT_EVENTUALLY(rOperator.Property("currentFile", "text").toString() == "Current file: job.qrr");
	EXPECT_TRUE(Content("job.qrr") == CommandLine(edits));

	rOperator.ClickRow("targets", 0);
	EXPECT_EVENTUALLY(rOperator.Property("removeTarget", "enabled").toBool());
	// Saved with the field still open.
	rOperator.Replace("TargetWeight", "7");
	rOperator.Key(Qt::Key_S, Qt::ControlModifier);
	edits += {"--weight", "0=7"};
	const QByteArray saved = CommandLine(edits);
	EXPECT_EVENTUALLY(Content("job.qrr") == saved);

	rOperator.ClickRow("targets", 0);
	rOperator.Key(Qt::Key_Delete);
	EXPECT_EVENTUALLY(Targets() == 5);
	EXPECT_EVENTUALLY(rOperator.Property("unsavedMark", "visible").toBool());
	rOperator.AnswerNextQuestion("job.qrr has changes that are not saved.", QMessageBox::Discard);
	rOperator.Click("load");
	rOperator.AnswerDialog(File("job.qrr"));
	EXPECT_EVENTUALLY(Targets() == 6);
	rOperator.Click("save");
	EXPECT_TRUE(Content("job.qrr") == saved);

	// A name without its extension gets it, and a file of that name is not lost without a question.
	rOperator.Click("saveAs");
	rOperator.AnswerDialog(File("other.take"));
	EXPECT_EVENTUALLY(rOperator.Property("currentFile", "text").toString() == "Current file: other.take.qrr");
	EXPECT_TRUE(Content("other.take.qrr") == saved);
	rOperator.Click("updateTargets");
	for (const auto answer : {QMessageBox::No, QMessageBox::Yes})
	{
		rOperator.AnswerNextQuestion("job.qrr is there already. Do you want to replace it?", answer);
		rOperator.Click("saveAs");
		rOperator.AnswerDialog(File("job"));
		if (answer == QMessageBox::No)
		{
			EXPECT_TRUE(Content("job.qrr") == saved);
		}
	}
	EXPECT_EVENTUALLY(Content("job.qrr") != saved);
}

TEST_F(Job, SelectsWithMouseAndKeys)
{
	VOperator& rOperator = *m_pOperator;
	CreateTargetSubject();

	int other = -1;
	for (const QString& rList : {QStringLiteral("sourceSegments"), QStringLiteral("targetSegments")})
	{
		SCOPED_TRACE(rList.toStdString());
		EXPECT_EVENTUALLY(rOperator.Property(rList, "count").toInt() > 20);
		const int last = rOperator.Property(rList, "count").toInt() - 1;
		const auto selected = [&] { return rOperator.Property(rList, "selectedIndex").toInt(); };

		rOperator.ClickRow(rList, 3);
		EXPECT_EVENTUALLY(selected() == 3);
		rOperator.ClickRow(rList, 5, Qt::ControlModifier);
		EXPECT_EVENTUALLY(selected() == -1) << "two are selected";
		const auto told = [&] { return rOperator.Property("status", "text").toString(); };
		const struct
		{
			const char* m_pButton;
			const char* m_pReason;
		} disabled[] = {{"removeTarget", "No target is selected: select one."},
		    {"save", "No retarget subject was loaded or saved yet: use Save As."},
		    {"addPositionTarget",
		        rList == "sourceSegments" ? "2 source segments are selected: select only one."
		                                  : "2 target segments are selected: select only one."}};
		for (const auto& rRow : disabled)
		{
			rOperator.Hover(rRow.m_pButton);
			EXPECT_EVENTUALLY(told() == rRow.m_pReason);
		}
		rOperator.ClickRow(rList, 3, Qt::ControlModifier);
		EXPECT_EVENTUALLY(selected() == 5);
		const std::pair<Qt::Key, int> keys[] = {{Qt::Key_Down, 6}, {Qt::Key_Up, 5}, {Qt::Key_End, last},
		    {Qt::Key_Down, last}, {Qt::Key_Home, 0}, {Qt::Key_Up, 0}};
		for (const auto& rKey : keys)
		{
			rOperator.Key(rKey.first);
			EXPECT_EVENTUALLY(selected() == rKey.second) << rKey.first;
		}
		// A range, whole or of what a filter shows; what is typed filters.
		const auto count = [&] {
			return m_pWindow->Context()
			    .GetSelectionManager()
			    ->Selection()
			    .ItemsOfKind(rList[0] == 's' ? 11 : 14)
			    .size();
		};
		rOperator.ClickRow(rList, 2);
		rOperator.ClickRow(rList, 6, Qt::ShiftModifier);
		EXPECT_EQ(count(), 5u);
		rOperator.Key(Qt::Key_Up, Qt::ShiftModifier);
		EXPECT_EQ(count(), 4u);
		rOperator.Key(Qt::Key_PageDown);
		EXPECT_EVENTUALLY(selected() > 8);
		rOperator.Key(Qt::Key_PageUp);
		EXPECT_EVENTUALLY(selected() == 5);
		rOperator.Type("a l");
		EXPECT_EQ(rOperator.Property(rList + "Filter", "text").toString(), "a l");
		EXPECT_FALSE(rOperator.Property(rList + "Row0", "visible").toBool());
		rOperator.Key(Qt::Key_Return);
		EXPECT_EVENTUALLY(rOperator.Property(rList + "Row" + QString::number(selected()), "visible").toBool());
		rOperator.Key(Qt::Key_Escape);
		EXPECT_TRUE(rOperator.Property(rList + "Row0", "visible").toBool());
		rOperator.Key(Qt::Key_Home);
		EXPECT_EVENTUALLY(selected() == 0);
		auto& rPreSelection = m_pWindow->Context().GetSelectionManager()->PreSelection();
		rOperator.Hover(rList + "Row2");
		EXPECT_EVENTUALLY(rPreSelection.Items().size() == 1 && rPreSelection.Items()[0].m_ElementIndex == 2);
		EXPECT_EQ(selected(), 0) << "pointing at a row selects nothing";
		rOperator.Hover("updateTargets");
		EXPECT_EVENTUALLY(rPreSelection.Items().empty());

		if (other != -1)
		{
			EXPECT_EQ(rOperator.Property("sourceSegments", "selectedIndex").toInt(), other) << "lists are apart";
		}
		other = selected();
	}
	EXPECT_EVENTUALLY(rOperator.Property("addPositionTarget", "enabled").toBool());
	rOperator.Click("jointSymmetry");
	EXPECT_EVENTUALLY(!rOperator.Property("jointSymmetry", "checked").toBool());
	rOperator.Click("jointSymmetry");
	EXPECT_EVENTUALLY(rOperator.Property("jointSymmetry", "checked").toBool());
}

TEST_F(Job, MenusActOnWhatTheyWereOpenedOn)
{
	VOperator& rOperator = *m_pOperator;
	CreateTargetSubject();
	const auto row = [this](const char* i_pList, const char* i_pName)
	{ return QString(i_pList) + "Row" + QString::number(RowOf(i_pList, i_pName)); };
	const auto choose = [&](const QString& i_rEntry)
	{
		const QString item = "menu" + QString(i_rEntry).remove(' ');
		EXPECT_EVENTUALLY(rOperator.Shows(item, i_rEntry));
		rOperator.Click(item);
		EXPECT_EVENTUALLY(!rOperator.Shows(item, i_rEntry));
	};
	rOperator.ClickRow("sourceSegments", RowOf("sourceSegments", "L_Humerus"));
	rOperator.Click(row("targetSegments", "loin"), {}, Qt::RightButton);
	choose("Select partner");
	EXPECT_EQ(rOperator.Property("status", "text").toString(), "loin has no partner on the other side.");
	rOperator.ClickRow("targetSegments", RowOf("targetSegments", "upperArmRight"));
	rOperator.Click(row("targetSegments", "upperArmRight"), {}, Qt::RightButton);
	choose("Select partner");
	EXPECT_EQ(rOperator.Property("targetSegments", "selectedIndex").toInt(), RowOf("targetSegments", "upperArmLeft"));
	// The second time finds the one that is there.
	for (const char* const pEntry : {"Add position target", "Add rotation target", "Add position target"})
	{
		rOperator.Click(row("targetSegments", "upperArmLeft"), {}, Qt::RightButton);
		choose(pEntry);
	}
	EXPECT_EQ(Targets(), 2);
	rOperator.Click("targetsRow0", {}, Qt::RightButton);
	choose("Remove target");
	EXPECT_EQ(Targets(), 1);
	EXPECT_TRUE(rOperator.Property("removeTarget", "enabled").toBool()) << "the one that took its place";
}

TEST_F(Job, UndoesAndRedoes)
{
	VOperator& rOperator = *m_pOperator;
	CreateTargetSubject();
	const auto weight = [&] { return rOperator.Property("TargetWeight", "text").toString(); };
	const auto undo = [&] { rOperator.Key(Qt::Key_Z, Qt::ControlModifier); };
	const auto redo = [&] { rOperator.Key(Qt::Key_Z, Qt::ControlModifier | Qt::ShiftModifier); };
	const auto menu = [&](const char* i_pAction) { return rOperator.ChooseInMenu("EditMenu", i_pAction); };
	const auto selected = [&] { return rOperator.Property("sourceSegments", "selectedIndex").toInt(); };
	SelectPair("Pelvis", "haunch");
	rOperator.Click("addPositionTarget");
	rOperator.Click("saveAs");
	rOperator.AnswerDialog(File("first.qrr"));
	EXPECT_EVENTUALLY(rOperator.Property("currentFile", "text").toString() == "Current file: first.qrr");
	SelectPair("Cranium", "skull");
	rOperator.Key(Qt::Key_T, Qt::AltModifier);
	EXPECT_EVENTUALLY(Targets() == 2);
	rOperator.ClickRow("targets", 1);
	EXPECT_EVENTUALLY(weight() == "1");

	// What is being typed is the field's own; what it has taken is a step.
	rOperator.Replace("TargetWeight", "7");
	undo();
	EXPECT_EQ(weight(), "1");
	EXPECT_EQ(Targets(), 2);
	rOperator.Fill("TargetWeight", "7");
	rOperator.Fill("TargetWeight", "8");
	undo();
	EXPECT_EVENTUALLY(weight() == "7");
	undo();
	EXPECT_EVENTUALLY(weight() == "1");
	redo();
	EXPECT_EVENTUALLY(weight() == "7");
	rOperator.Replace("TargetWeight", "9");
	EXPECT_EQ(menu("Undo"), "&Undo Change Weight");
	EXPECT_EVENTUALLY(weight() == "7");
	EXPECT_EQ(menu("Redo"), "&Redo Change Weight");
	EXPECT_EVENTUALLY(weight() == "9");
	// The way of a slider.
	QQuickItem* const pSlider = rOperator.Item("TargetWeightSlider");
	const auto onSlider = [&](double i_Share)
	{
		return rOperator.Item("scene")
		    ->mapFromItem(pSlider, {i_Share * pSlider->width(), pSlider->height() / 2})
		    .toPoint();
	};
	for (const double end : {0.5, 0.8})
	{
		rOperator.Drag({Qt::LeftButton}, onSlider(0.2), onSlider(end));
		EXPECT_EVENTUALLY(weight().toDouble() > 90 * end);
	}
	undo();
	EXPECT_EVENTUALLY(weight().toDouble() < 60 && weight().toDouble() > 45);
	undo();
	EXPECT_EVENTUALLY(weight() == "9");

	EXPECT_TRUE(m_pWindow->isWindowModified());
	for (const char* const pStep : {"Change Weight", "Change Weight", "Add Target"})
		EXPECT_EQ(menu("Undo"), QString("&Undo ") + pStep);
	EXPECT_EQ(Targets(), 1);
	EXPECT_FALSE(m_pWindow->isWindowModified()) << "as it was saved";
	EXPECT_EVENTUALLY(selected() == RowOf("sourceSegments", "Cranium"));
	undo();
	undo();
	EXPECT_EVENTUALLY(rOperator.Property("targetSegments", "count").toInt() == 0);
	EXPECT_EQ(rOperator.Property("currentFile", "text").toString(), "Current file: *None*");
	undo();
	EXPECT_EQ(rOperator.Property("status", "text").toString(), "There is nothing to undo.");
	for (int i = 0; i < 3; ++i)
		rOperator.Key(Qt::Key_Y, Qt::ControlModifier);
	EXPECT_EQ(Targets(), 2);
	EXPECT_EQ(rOperator.Property("currentFile", "text").toString(), "Current file: first.qrr");
	rOperator.Key(Qt::Key_S, Qt::ControlModifier);
	EXPECT_TRUE(Content("first.qrr")
	    == CommandLine({"create", "--fbx", File("character.fbx"), "--source", File("performer.qrs"),
	        "--match-file-pose", "--position", "Pelvis:haunch", "--position", "Cranium:skull"}));
	EXPECT_FALSE(m_pWindow->isWindowModified());
}

TEST_F(Job, ClosesWhileTheSkinLoads)
{
	m_pOperator->Choose("SourceSkeleton", "performer");
	m_pWindow->Open(File("character.fbx"));
	EXPECT_EVENTUALLY(m_pOperator->Property("TargetRoot", "currentText").toString() == "haunch");
	m_pOperator->Click("createTargetSubject");
	m_pWindow.reset();
	for (const QWidget* const pWidget : QApplication::topLevelWidgets())
		EXPECT_FALSE(pWidget->isVisible()) << pWidget->metaObject()->className();
}

TEST_F(Job, ALegacyFileIsSavedUnderANewName)
{
	VOperator& rOperator = *m_pOperator;
	// A subject of one target as programs of old wrote it.
	CommandLine(
	    {"create", "--fbx", File("character.fbx"), "--source", File("performer.qrs"), "--rotation", "Pelvis:haunch"});
	const QByteArray legacy = "[[1,0,1],\"\"]" + Run({"dump", File("expected.qrr")});
	QFile file(File("old.qrx"));
	ASSERT_TRUE(file.open(QIODevice::WriteOnly) && file.write(legacy) == legacy.size());
	file.close();
	rOperator.Click("load");
	rOperator.AnswerDialog(File("old.qrx"));
	EXPECT_EVENTUALLY(rOperator.Property("currentFile", "text").toString() == "Current file: old.qrx");
	rOperator.Click("save");
	rOperator.AnswerDialog(File("new.qrr"));
	EXPECT_EVENTUALLY(QFile::exists(File("new.qrr")));
	EXPECT_TRUE(Content("new.qrr") == CommandLine({"edit", File("old.qrx")}));
	EXPECT_EVENTUALLY(rOperator.Property("currentFile", "text").toString() == "Current file: new.qrr");

	rOperator.Click("load");
	rOperator.AnswerDialog(File("old.qrx"));
	EXPECT_EVENTUALLY(rOperator.Property("currentFile", "text").toString() == "Current file: old.qrx");
	rOperator.Click("removeUnnecessaryJoints");
	rOperator.AnswerNextQuestion("old.qrx has changes that are not saved.", QMessageBox::Save);
	rOperator.AnswerNextDialog(File("closed.qrr"));
	EXPECT_TRUE(m_pWindow->close());
	EXPECT_TRUE(QFile::exists(File("closed.qrr")));
	EXPECT_TRUE(Content("old.qrx") == legacy);
}

TEST(OpenGLCheck, NoTextCursorBlinksWhereTheProcessorDraws)
{
	QGuiApplication::styleHints()->setCursorFlashTime(1000);
	EXPECT_TRUE(StudioHost::CheckOpenGL());
	EXPECT_EQ(QGuiApplication::styleHints()->cursorFlashTime(), 0);
}

} // namespace
