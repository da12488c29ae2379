// The whole job at the window, by mouse and keyboard alone: from two files to a saved retarget subject.

#include "WindowFixture.h"

#include "studio/host/OpenGLCheck.h"
#include "studio/host/Services.h"

#include <QApplication>
#include <QCheckBox>
#include <QClipboard>
#include <QComboBox>
#include <QFile>
#include <QGuiApplication>
#include <QLabel>
#include <QProcess>
#include <QQuickItem>
#include <QRegularExpression>
#include <QStyleHints>
#include <QTableWidget>
#include <QTest>
#include <QTreeWidget>
#include <QWindow>

namespace
{

class Job : public Window
{
protected:
	void SelectPair(const char* i_pSource, const char* i_pTarget)
	{
		m_pOperator->ClickRow("sourceSegments", RowOf("sourceSegments", i_pSource));
		m_pOperator->ClickRow("targetSegments", RowOf("targetSegments", i_pTarget));
		EXPECT_EVENTUALLY(m_pOperator->Property("addPositionTarget", "enabled").toBool());
	}
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

TEST_F(Job, JudgesProposedTargets)
{
	VOperator& rOperator = *m_pOperator;
	CreateTargetSubject();
	SelectPair("Cranium", "skull");
	const auto selection = [this] { return m_pWindow->Context().GetSelectionManager()->Selection().Items(); };
	const auto before = selection();
	const auto open = [&]() -> QWidget&
	{
		rOperator.ChooseInMenu("ToolsMenu", "ProposeTargets");
		auto* const pDialog = m_pWindow->findChild<QWidget*>("ProposeTargets");
		EXPECT_EVENTUALLY(pDialog && pDialog->windowHandle() && pDialog->windowHandle()->isExposed());
		return *pDialog;
	};
	const auto click = [](QWidget& i_rDialog, const QWidget& i_rWidget, const QPoint& i_rPlace)
	{
		QTest::mouseClick(i_rDialog.windowHandle(), Qt::LeftButton, {}, i_rWidget.mapTo(&i_rDialog, i_rPlace));
		QTest::qWait(0);
	};
	const auto press = [&](QWidget& i_rDialog, const char* i_pButton)
	{
		const auto* const pButton = i_rDialog.findChild<QWidget*>(i_pButton);
		click(i_rDialog, *pButton, pButton->rect().center());
		EXPECT_EVENTUALLY(!m_pWindow->findChild<QWidget*>("ProposeTargets"));
		m_pWindow->activateWindow();
		EXPECT_TRUE(QTest::qWaitForWindowActive(m_pWindow.get()));
	};
	const auto itemOf = [](const QTableWidget& i_rTable, const char* i_pSource)
	{ return i_rTable.findItems(i_pSource, Qt::MatchExactly).value(0); };

	{
		QWidget& rDialog = open();
		const auto& rTable = *rDialog.findChild<QTableWidget*>("Pairs");
		auto* const pItem = itemOf(rTable, "L_Humerus");
		ASSERT_TRUE(pItem);
		EXPECT_TRUE(rTable.item(pItem->row(), 6)->text().contains("name")) << "a reason";
		auto& rFilter = *rDialog.findChild<QWidget*>("PairsFilter");
		click(rDialog, rFilter, rFilter.rect().center());
		for (const char letter : std::string("armleft"))
			QTest::keyClick(rDialog.windowHandle(), letter);
		EXPECT_EVENTUALLY(!rTable.isRowHidden(pItem->row()));
		EXPECT_TRUE(rTable.isRowHidden(itemOf(rTable, "R_Humerus")->row()));
		for (int i = 0; i < 7; ++i)
			QTest::keyClick(rDialog.windowHandle(), Qt::Key_Backspace);
		EXPECT_FALSE(rTable.isRowHidden(itemOf(rTable, "R_Humerus")->row()));
		const_cast<QTableWidget&>(rTable).scrollToItem(pItem);
		click(rDialog, *rTable.viewport(), rTable.visualItemRect(rTable.item(pItem->row(), 6)).center());
		ASSERT_EQ(selection().size(), 2u);
		EXPECT_EQ(Names("sourceSegments").value(int(selection()[0].m_ElementIndex)), "L_Humerus");
		EXPECT_EQ(Names("targetSegments").value(int(selection()[1].m_ElementIndex)), "upperArmLeft");
		press(rDialog, "ProposeCancel");
		EXPECT_EQ(Targets(), 0);
		EXPECT_EQ(selection(), before);
	}
	{
		press(open(), "ProposeAdd");
		EXPECT_GT(Targets(), 20);
		EXPECT_EQ(selection(), before);
		rOperator.Click("saveAs");
		rOperator.AnswerDialog(File("all.qrr"));
		EXPECT_EVENTUALLY(QFile::exists(File("all.qrr")));
		EXPECT_TRUE(Content("all.qrr")
		    == CommandLine({"create", "--fbx", File("character.fbx"), "--source", File("performer.qrs"),
		        "--match-file-pose", "--auto"}));
		rOperator.AnswerNextDialog(File("biped"));
		rOperator.ChooseInMenu("ToolsMenu", "SavePreset");
		EXPECT_EVENTUALLY(QFile::exists(File("biped.json")));
		EXPECT_EQ(rOperator.ChooseInMenu("EditMenu", "Undo"), "&Undo Propose Targets");
		EXPECT_EQ(Targets(), 0) << "one step";
	}
	{
		// A preset with a pair that this character has not.
		QFile preset(File("biped.json"));
		ASSERT_TRUE(preset.open(QIODevice::ReadWrite));
		QByteArray text = preset.readAll();
		text.replace("\"pairs\": [", "\"pairs\": [{\"source\": \"Antler\", \"target\": \"horn\"},");
		ASSERT_TRUE(preset.seek(0) && preset.write(text) == text.size());
		preset.close();
		m_pWindow->Context().Preferences().SetFolder("FolderPresets", m_Folder.path().toStdString());
		QWidget& rDialog = open();
		auto* const pOrigin = rDialog.findChild<QComboBox*>("PairsOrigin");
		click(rDialog, *pOrigin, pOrigin->rect().center());
		ASSERT_TRUE(Eventually([] { return QApplication::activePopupWidget() != nullptr; }));
		for (const Qt::Key key : {Qt::Key_Down, Qt::Key_Return})
			QTest::keyClick(QApplication::activePopupWidget()->windowHandle(), key);
		EXPECT_EVENTUALLY(pOrigin->currentText() == "biped");
		EXPECT_TRUE(
		    rDialog.findChild<QLabel*>("Findings")->text().contains("\"Antler\" and \"horn\": the source has no"));
		press(rDialog, "ProposeAdd");
		rOperator.Click("saveAs");
		rOperator.AnswerDialog(File("preset.qrr"));
		EXPECT_EVENTUALLY(QFile::exists(File("preset.qrr")));
		EXPECT_TRUE(Content("preset.qrr") == Content("all.qrr"));
		rOperator.Key(Qt::Key_Z, Qt::ControlModifier);
	}
	{
		QWidget& rDialog = open();
		const auto& rTable = *rDialog.findChild<QTableWidget*>("Pairs");
		const auto ticks = [&]
		{
			int count = 0;
			for (int row = 0; row < rTable.rowCount(); ++row)
				count += rTable.item(row, 0)->checkState() == Qt::Checked;
			return count;
		};
		// All but two rows lose their ticks; one of the two gets another target.
		for (int row = 0; row < rTable.rowCount(); ++row)
		{
			const auto* const pItem = rTable.item(row, 0);
			if (pItem->checkState() != Qt::Checked || pItem->text() == "L_Humerus" || pItem->text() == "Cranium")
				continue;
			const_cast<QTableWidget&>(rTable).scrollToItem(pItem);
			const QRect place = rTable.visualItemRect(pItem);
			click(rDialog, *rTable.viewport(), {place.left() + 10, place.center().y()});
		}
		EXPECT_EQ(ticks(), 2);
		auto* const pItem = itemOf(rTable, "L_Humerus");
		const_cast<QTableWidget&>(rTable).scrollToItem(pItem);
		auto* const pBox = qobject_cast<QComboBox*>(rTable.cellWidget(pItem->row(), 1));
		click(rDialog, *pBox, pBox->rect().center());
		ASSERT_TRUE(Eventually([] { return QApplication::activePopupWidget() != nullptr; }));
		for (const Qt::Key key : {Qt::Key_End, Qt::Key_Return})
			QTest::keyClick(QApplication::activePopupWidget()->windowHandle(), key);
		const QString last = Names("targetSegments").last();
		EXPECT_EVENTUALLY(pBox->currentText() == last);
		// The other becomes one of a position with a weight of its own.
		const int head = itemOf(rTable, "Cranium")->row();
		const_cast<QTableWidget&>(rTable).scrollToItem(rTable.item(head, 0));
		auto* const pKind = qobject_cast<QComboBox*>(rTable.cellWidget(head, 3));
		click(rDialog, *pKind, pKind->rect().center());
		ASSERT_TRUE(Eventually([] { return QApplication::activePopupWidget() != nullptr; }));
		for (const Qt::Key key : {Qt::Key_Home, Qt::Key_Return})
			QTest::keyClick(QApplication::activePopupWidget()->windowHandle(), key);
		EXPECT_EVENTUALLY(pKind->currentText() == "position");
		const auto* const pWeight = rTable.cellWidget(head, 4);
		click(rDialog, *pWeight, {20, pWeight->height() / 2});
		EXPECT_FALSE(rTable.cellWidget(head, 5)->isEnabled());
		QTest::keyClick(rDialog.windowHandle(), Qt::Key_A, Qt::ControlModifier);
		for (const char key : {'2', '.', '5'})
			QTest::keyClick(rDialog.windowHandle(), key);
		EXPECT_EQ(rTable.item(pItem->row(), 6)->text(), "chosen by hand");
		press(rDialog, "ProposeAdd");
		EXPECT_EQ(rOperator.Property("targetsRow0", "visible").toBool(), true);
		rOperator.Click("saveAs");
		rOperator.AnswerDialog(File("two.qrr"));
		EXPECT_EVENTUALLY(QFile::exists(File("two.qrr")));
		EXPECT_TRUE(Content("two.qrr")
		    == CommandLine(
		        {"create", "--fbx", File("character.fbx"), "--source", File("performer.qrs"), "--match-file-pose",
		            "--position", "Cranium:skull", "--weight", "0=2.5", "--rotation", "L_Humerus:" + last}));
		rOperator.Key(Qt::Key_Z, Qt::ControlModifier);
		EXPECT_EQ(Targets(), 0);
	}
}

TEST_F(Job, AlignsToTheSourceWithAPreview)
{
	VOperator& rOperator = *m_pOperator;
	CreateTargetSubject();
	rOperator.ChooseInMenu("ToolsMenu", "ProposeTargets");
	const auto press = [this](const char* i_pDialog, const char* i_pButton)
	{
		auto* const pDialog = m_pWindow->findChild<QWidget*>(i_pDialog);
		ASSERT_TRUE(pDialog);
		EXPECT_EVENTUALLY(pDialog->windowHandle() && pDialog->windowHandle()->isExposed());
		const auto* const pButton = pDialog->findChild<QWidget*>(i_pButton);
		QTest::mouseClick(
		    pDialog->windowHandle(), Qt::LeftButton, {}, pButton->mapTo(pDialog, QPoint(10, pButton->height() / 2)));
		QTest::qWait(0);
	};
	press("ProposeTargets", "ProposeAdd");
	rOperator.Click("saveAs");
	rOperator.AnswerDialog(File("before.qrr"));
	EXPECT_EVENTUALLY(QFile::exists(File("before.qrr")) && !m_pWindow->isWindowModified());
	const auto align = [&] { rOperator.ChooseInMenu("ToolsMenu", "AlignToSourceAction"); };
	align();
	EXPECT_TRUE(m_pWindow->isWindowModified()) << "the view shows it";
	press("AlignToSource", "AlignArms");
	press("AlignToSource", "AlignCancel");
	EXPECT_EVENTUALLY(!m_pWindow->findChild<QWidget*>("AlignToSource"));
	EXPECT_FALSE(m_pWindow->isWindowModified());
	align();
	press("AlignToSource", "AlignLegs");
	press("AlignToSource", "AlignLegs");
	const auto scaleBox = [this] { return m_pWindow->findChild<QCheckBox*>("AlignFitScale"); };
	EXPECT_TRUE(scaleBox()->isChecked() && scaleBox()->isEnabled());
	press("AlignToSource", "AlignFitScale");
	EXPECT_FALSE(scaleBox()->isChecked());
	press("AlignToSource", "AlignFitScale");
	const QString scale = QRegularExpression("by ([0-9.]+),").match(scaleBox()->text()).captured(1);
	{
		auto& rDialog = *m_pWindow->findChild<QWidget*>("AlignToSource");
		auto& rTable = *rDialog.findChild<QTableWidget*>("AlignedJoints");
		for (const char* const pHow : {"leans as the shin does", "keeps its tilt"})
		{
			press("AlignToSource", "AlignFeet");
			EXPECT_TRUE(
			    rTable.item(rTable.findItems("hockLeft", Qt::MatchExactly).value(0)->row(), 5)->text().contains(pHow));
		}
		const auto row = [&] { return rTable.findItems("upperArmLeft", Qt::MatchExactly).value(0)->row(); };
		const auto isLocked = [&] { return rTable.item(row(), 5)->text().contains("locked"); };
		for (const bool bLocked : {true, false})
		{
			rTable.scrollToItem(rTable.item(row(), 0));
			const QRect place = rTable.visualItemRect(rTable.item(row(), 0));
			QTest::mouseClick(rDialog.windowHandle(), Qt::LeftButton, {},
			    rTable.viewport()->mapTo(&rDialog, QPoint(place.left() + 10, place.center().y())));
			EXPECT_EVENTUALLY(isLocked() == bLocked);
		}
		const auto selected = m_pWindow->Context().GetSelectionManager()->Selection().Items();
		ASSERT_EQ(selected.size(), 2u);
		EXPECT_EQ(Names("sourceSegments").value(int(selected[0].m_ElementIndex)), "L_Humerus");
	}
	press("AlignToSource", "AlignKeep");
	EXPECT_EVENTUALLY(!m_pWindow->findChild<QWidget*>("AlignToSource"));
	m_pWindow->activateWindow();
	EXPECT_TRUE(QTest::qWaitForWindowActive(m_pWindow.get()));
	rOperator.Click("saveAs");
	rOperator.AnswerDialog(File("aligned.qrr"));
	EXPECT_EVENTUALLY(QFile::exists(File("aligned.qrr")));
	EXPECT_TRUE(Content("aligned.qrr")
	    == CommandLine({"edit", File("before.qrr"), "--source", File("performer.qrs"), "--root-height", "scale",
	        "--scale", scale, "--align"}));
	// The steps give the file again.
	rOperator.AnswerNextDialog(File("steps.json"));
	rOperator.ChooseInMenu("EditMenu", "SaveRecipe");
	EXPECT_EVENTUALLY(QFile::exists(File("steps.json")));
	Run({"build", File("steps.json"), "-o", File("built.qrr")});
	EXPECT_TRUE(Content("built.qrr") == Content("aligned.qrr")) << Content("steps.json").toStdString();
	rOperator.ChooseInMenu("EditMenu", "CopyCommands");
	QString commands = QGuiApplication::clipboard()->text();
	EXPECT_TRUE(commands.startsWith("retarget create") && commands.contains("--align"));
	commands.replace(0, 8, RETARGET_PROGRAM " -q");
	QFile::remove(File("aligned.qrr"));
	EXPECT_EQ(QProcess::execute("sh", {"-c", commands.trimmed() + " > /dev/null"}), 0) << commands.toStdString();
	EXPECT_TRUE(Content("built.qrr") == Content("aligned.qrr"));
	EXPECT_EQ(rOperator.ChooseInMenu("EditMenu", "Undo"), "&Undo Align to Source");
	EXPECT_EQ(rOperator.ChooseInMenu("EditMenu", "Undo"), "&Undo Propose Targets") << "one step";
	rOperator.AnswerNextDialog(File("steps.json"));
	rOperator.AnswerNextQuestion("steps.json is there already. Do you want to replace it?", QMessageBox::Yes);
	rOperator.ChooseInMenu("EditMenu", "SaveRecipe");
	EXPECT_EVENTUALLY(!Content("steps.json").contains("position")) << "what was undone is no step";
}

TEST_F(Job, OffersToReBindToAChangedFileAndToAnotherPerformer)
{
	VOperator& rOperator = *m_pOperator;
	CreateTargetSubject();
	for (const auto& [pSource, pTarget] : {std::pair("ThoraxHigh", "breast"), {"Cranium", "skull"}})
	{
		SelectPair(pSource, pTarget);
		rOperator.Click("addRotationTarget");
	}
	EXPECT_EVENTUALLY(Targets() == 2);
	rOperator.Click("saveAs");
	rOperator.AnswerDialog(File("before.qrr"));
	EXPECT_EVENTUALLY(QFile::exists(File("before.qrr")));
	const auto write = [this](const char* i_pName, const QByteArray& i_rContent)
	{
		QFile file(File(i_pName));
		return file.open(QIODevice::WriteOnly) && file.write(i_rContent) == i_rContent.size();
	};
	const auto shown = [&](const QString& i_rLine)
	{
		QWidget* pDialog = nullptr;
		EXPECT_EVENTUALLY(
		    (pDialog = m_pWindow->findChild<QWidget*>("Rebind")) && pDialog->windowHandle() && pDialog->isVisible());
		const auto* const pList = pDialog ? pDialog->findChild<QTreeWidget*>("RebindList") : nullptr;
		EXPECT_TRUE(pList && !pList->findItems(i_rLine, Qt::MatchContains | Qt::MatchRecursive).isEmpty())
		    << i_rLine.toStdString();
		return pDialog;
	};
	const auto press = [&](QWidget* i_pDialog, const char* i_pButton)
	{
		ASSERT_TRUE(i_pDialog && i_pDialog->windowHandle());
		EXPECT_EVENTUALLY(i_pDialog->windowHandle()->isExposed());
		const auto* const pButton = i_pDialog->findChild<QWidget*>(i_pButton);
		QTest::mouseClick(
		    i_pDialog->windowHandle(), Qt::LeftButton, {}, pButton->mapTo(i_pDialog, pButton->rect().center()));
		EXPECT_EVENTUALLY(!m_pWindow->findChild<QWidget*>("Rebind"));
		m_pWindow->activateWindow();
		EXPECT_TRUE(QTest::qWaitForWindowActive(m_pWindow.get()));
	};
	const auto saveAs = [&](const char* i_pName)
	{
		rOperator.Click("saveAs");
		rOperator.AnswerDialog(File(i_pName));
		EXPECT_EVENTUALLY(QFile::exists(File(i_pName)));
	};
	// A bone gets another name of as many letters.
	ASSERT_TRUE(write("character.fbx", Content("character.fbx").replace("breast", "thorax")));
	press(shown("breast is thorax, by its place"), "RebindDo");
	EXPECT_TRUE(Names("targetSegments").contains("thorax"));
	saveAs("rebound.qrr");
	EXPECT_TRUE(Content("rebound.qrr") == CommandLine({"rebind", File("before.qrr"), "--fbx", File("character.fbx")}));
	EXPECT_EQ(rOperator.ChooseInMenu("EditMenu", "Undo"), "&Undo Re-bind");
	EXPECT_TRUE(Names("targetSegments").contains("breast")) << "one step";
	rOperator.Key(Qt::Key_Y, Qt::ControlModifier);

	ASSERT_TRUE(write("second.qrs", Content("performer.qrs").replace("\"Cranium\"", "\"Kopf\"")));
	EXPECT_EVENTUALLY(rOperator.Property("SourceSkeleton", "count").toInt() > 1);
	rOperator.Choose("SourceSkeleton", "second");
	press(shown("Cranium is Kopf"), "RebindLeave");
	rOperator.ChooseInMenu("ToolsMenu", "RebindToPerformer");
	press(shown("Cranium is Kopf"), "RebindDo");
	saveAs("second.qrr");
	EXPECT_TRUE(Content("second.qrr") == CommandLine({"rebind", File("rebound.qrr"), "--source", File("second.qrs")}));
	// The steps since the character's file was written over give the file again.
	rOperator.AnswerNextDialog(File("steps.json"));
	rOperator.ChooseInMenu("EditMenu", "SaveRecipe");
	EXPECT_EVENTUALLY(Content("steps.json").contains("rebind-source"));
	Run({"build", File("steps.json"), "-o", File("built.qrr")});
	EXPECT_TRUE(Content("built.qrr") == Content("second.qrr")) << Content("steps.json").toStdString();

	EXPECT_EQ(rOperator.ChooseInMenu("EditMenu", "Undo"), "&Undo Re-bind");
	rOperator.ChooseInMenu("ToolsMenu", "RebindToPerformer");
	QWidget* const pDialog = shown("Cranium is Kopf");
	auto* const pMeasure = pDialog->findChild<QCheckBox*>("RebindMeasure");
	QTest::mouseClick(
	    pDialog->windowHandle(), Qt::LeftButton, {}, pMeasure->mapTo(pDialog, QPoint(10, pMeasure->height() / 2)));
	EXPECT_TRUE(pMeasure->isChecked());
	press(pDialog, "RebindDo");
	saveAs("measured.qrr");
	EXPECT_TRUE(Content("measured.qrr")
	    == CommandLine({"rebind", File("rebound.qrr"), "--source", File("second.qrs"), "--measure"}));
	rOperator.AnswerNextDialog(File("measured.json"));
	rOperator.ChooseInMenu("EditMenu", "SaveRecipe");
	EXPECT_EVENTUALLY(Content("measured.json").contains("rebind-source"));
	EXPECT_TRUE(Content("measured.json").contains("update-targets"));
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
