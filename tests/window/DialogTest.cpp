// The dialogs that propose, align and re-bind, by mouse and keyboard alone.

#include "WindowFixture.h"

#include "studio/host/Services.h"

#include <QApplication>
#include <QCheckBox>
#include <QClipboard>
#include <QComboBox>
#include <QFile>
#include <QGuiApplication>
#include <QLabel>
#include <QProcess>
#include <QRegularExpression>
#include <QTableWidget>
#include <QTest>
#include <QTreeWidget>
#include <QWindow>

namespace
{

class Dialogs : public Window
{
};

TEST_F(Dialogs, JudgesProposedTargets)
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
		for (int row = 0; row < rTable.rowCount(); ++row)
			rTable.item(row, 0)->setCheckState(Qt::Unchecked);
		EXPECT_FALSE(rDialog.findChild<QWidget*>("ProposeAdd")->isEnabled()) << "nothing is ticked";
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

TEST_F(Dialogs, AlignsToTheSourceWithAPreview)
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
	        "--scale", scale, "--skin", File("character.fbx"), "--align"}));
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

TEST_F(Dialogs, OffersToReBindToAChangedFileAndToAnotherPerformer)
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

} // namespace
