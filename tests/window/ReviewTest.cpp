// What the studio tells of the target subject as it stands, by mouse, against what the command line tells of its file.

#include "WindowFixture.h"

#include "TesselPluginInterface/ISelectionManager.h"
#include "studio/host/Services.h"
#include "studio/panel/RetargetPanel.h"

#include <QAbstractItemView>
#include <QApplication>
#include <QClipboard>
#include <QFile>
#include <QJsonArray>
#include <QJsonDocument>
#include <QLabel>
#include <QMessageBox>
#include <QProcess>
#include <QQuickItem>
#include <QQuickWidget>
#include <QQuickWindow>
#include <QRegularExpression>
#include <QTest>
#include <QTreeWidget>
#include <QWindow>

namespace
{

class Review : public Window
{
protected:
	void SetUp() override
	{
		Window::SetUp();
		ASSERT_FALSE(HasFatalFailure());
		m_pOperator->Choose("SourceSkeleton", "performer");
		Run({"create", "--fbx", File("character.fbx"), "--source", File("performer.qrs"), "--auto", "-o",
		    File("hero.qrr")});
		m_pOperator->Choose("TargetFBX", "character");
		EXPECT_EVENTUALLY(m_pOperator->Property("TargetRoot", "currentText").toString() == "haunch");
		ASSERT_TRUE(m_pWindow->Open(File("hero.qrr")));
		EXPECT_EVENTUALLY(Targets() > 10 && m_pOperator->Property("sourceSegments", "count").toInt() > 20);
	}

	QWidget* Dialog(const char* i_pName) const { return m_pWindow->findChild<QWidget*>(i_pName); }
	void Press(const char* i_pDialog, const char* i_pButton) const
	{
		QWidget* pDialog = nullptr;
		EXPECT_EVENTUALLY(
		    (pDialog = Dialog(i_pDialog)) && pDialog->windowHandle() && pDialog->windowHandle()->isExposed());
		ASSERT_TRUE(pDialog);
		const auto* const pButton = pDialog->findChild<QWidget*>(i_pButton);
		QTest::mouseClick(
		    pDialog->windowHandle(), Qt::LeftButton, {}, pButton->mapTo(pDialog, pButton->rect().center()));
	}
	bool IsLookedAt(const char* i_pDialog) const
	{
		return Dialog(i_pDialog) && Dialog(i_pDialog)->findChild<QWidget*>("ReviewAgain")->isEnabled();
	}
	/// What the studio tells, as text.
	QString Copied(const char* i_pDialog) const
	{
		QApplication::clipboard()->clear();
		Press(i_pDialog, "ReviewCopy");
		return QApplication::clipboard()->text();
	}
	/// Clicks the first row with this text.
	/// @return the names of what is selected then, of the character.
	QStringList Choose(const char* i_pDialog, const QString& i_rText) const
	{
		QWidget& rDialog = *Dialog(i_pDialog);
		auto& rRows = *rDialog.findChild<QTreeWidget*>("ReviewRows");
		auto* const pRow = rRows.findItems(i_rText, Qt::MatchContains | Qt::MatchWildcard).value(0);
		if (!pRow)
			return {"no such row"};
		rRows.scrollToItem(pRow);
		QTest::mouseClick(rDialog.windowHandle(), Qt::LeftButton, {},
		    rRows.viewport()->mapTo(&rDialog, rRows.visualItemRect(pRow).topLeft() + QPoint(20, 8)));
		QStringList names;
		for (const auto& rItem : m_pWindow->Context().GetSelectionManager()->Selection().Items())
			names << Names("targetSegments").value(int(rItem.m_ElementIndex));
		return names;
	}
	void SaveAs(const char* i_pName)
	{
		m_pWindow->activateWindow();
		EXPECT_TRUE(QTest::qWaitForWindowActive(m_pWindow.get()));
		m_pOperator->Click("saveAs");
		m_pOperator->AnswerDialog(File(i_pName));
		EXPECT_EVENTUALLY(QFile::exists(File(i_pName)) && !m_pWindow->isWindowModified());
	}
};

TEST_F(Review, TellsWhatDiffersFromAFile)
{
	m_pOperator->ChooseInMenu("ToolsMenu", "CompareWithSaved");
	EXPECT_EQ(Copied("Compare"), "Nothing differs.");
	Press("Compare", "ReviewClose");
	EXPECT_EVENTUALLY(!Dialog("Compare"));
	m_pOperator->Click("removeUnnecessaryJoints");
	m_pOperator->Click("updateTargets");
	EXPECT_EVENTUALLY(m_pWindow->isWindowModified());
	m_pOperator->AnswerNextDialog(File("hero.qrr"));
	m_pOperator->ChooseInMenu("ToolsMenu", "CompareWith");
	const QString differs = Copied("Compare");
	EXPECT_EQ(Choose("Compare", "segment \"crest\"*joint pruned*"), QStringList("crest"));
	SaveAs("now.qrr");
	QProcess diff;
	diff.start(RETARGET_PROGRAM, {"diff", File("hero.qrr"), File("now.qrr")});
	EXPECT_TRUE(diff.waitForFinished(60000));
	EXPECT_EQ(differs.toUtf8(), diff.readAllStandardOutput()) << "what is not saved counts, too";
	EXPECT_TRUE(Dialog("Compare")->findChild<QLabel*>("ReviewSummary")->text().contains("look again"));
	Press("Compare", "ReviewAgain");
	EXPECT_EQ(Copied("Compare"), differs);
	// One that is none leaves the table.
	QFile(File("performer.qrs")).copy(File("none.qrr"));
	QFile none(File("none.qrr"));
	ASSERT_TRUE(none.resize(300));
	m_pOperator->AnswerNextDialog(File("none.qrr"));
	m_pOperator->ChooseInMenu("ToolsMenu", "CompareWith");
	EXPECT_FALSE(Dialog("Compare"));
}

TEST_F(Review, AdvisesOnJointsAndTargets)
{
	m_pOperator->ChooseInMenu("ToolsMenu", "ShowAdvice");
	EXPECT_EVENTUALLY(IsLookedAt("Advice"));
	const QStringList told = Copied("Advice").split('\n', Qt::SkipEmptyParts);
	const auto advice = QJsonDocument::fromJson(
	    Run({"advise", File("hero.qrr"), "--source", File("performer.qrs"), "--fbx", File("character.fbx"), "--json"}));
	const QJsonArray prune = advice["prune"].toArray();
	const QJsonArray conflicts = advice["range"]["conflicts"].toArray();
	ASSERT_EQ(told.size(), prune.size() + conflicts.size());
	for (int i = 0; i < prune.size(); ++i)
	{
		const QStringList cells = told[i].split('\t');
		EXPECT_EQ(cells.value(0), prune[i]["segment"].toString());
		EXPECT_EQ(cells.value(1), prune[i]["verdict"].toString());
		EXPECT_EQ(cells.value(3), prune[i]["words"].toString());
	}
	for (int i = 0; i < conflicts.size(); ++i)
		EXPECT_TRUE(told[prune.size() + i].endsWith(conflicts[i]["words"].toString())) << i;
	EXPECT_EQ(Choose("Advice", "cape2"), QStringList("cape2"));
	Choose("Advice", "target 22*");
	EXPECT_EVENTUALLY(m_pOperator->Property("removeTarget", "enabled").toBool());
	// One joint by the button, which then looks again.
	const auto* const pRemove = Dialog("Advice")->findChild<QWidget*>("ReviewAct");
	EXPECT_FALSE(pRemove->isEnabled()) << "a target is no joint";
	Choose("Advice", "cape2");
	Press("Advice", "ReviewAct");
	EXPECT_EVENTUALLY(IsLookedAt("Advice") && !Copied("Advice").contains("cape2\t"));
	EXPECT_TRUE(Copied("Advice").contains("cape3\t"));
	m_pOperator->ChooseInMenu("EditMenu", "Undo");
	Press("Advice", "ReviewAgain");
	EXPECT_EVENTUALLY(IsLookedAt("Advice") && Copied("Advice").contains("cape2\t"));
	// The button of the panel takes what could go.
	m_pOperator->Click("removeUnnecessaryJoints");
	Press("Advice", "ReviewAgain");
	EXPECT_EVENTUALLY(IsLookedAt("Advice"));
	EXPECT_FALSE(Copied("Advice").contains("\tgo\t"));
}

TEST_F(Review, ChecksThePose)
{
	m_pOperator->ChooseInMenu("ToolsMenu", "CheckPose");
	const QStringList told = Copied("PoseCheck").split('\n', Qt::SkipEmptyParts);
	const QJsonArray findings = QJsonDocument::fromJson(Run(
	    {"map", File("hero.qrr"), "--fbx", File("character.fbx"), "--source", File("performer.qrs"), "--json"}))["pose"]
	                                .toArray();
	ASSERT_EQ(told.size(), findings.size());
	for (int i = 0; i < findings.size(); ++i)
	{
		const QStringList cells = told[i].split('\t');
		EXPECT_EQ(cells.value(0), findings[i]["id"].toString());
		EXPECT_EQ(cells.value(2), findings[i]["message"].toString());
		EXPECT_TRUE(cells.value(3).endsWith(findings[i]["options"].toString()));
	}
	Press("PoseCheck", "ReviewAct");
	EXPECT_EVENTUALLY(Dialog("AlignToSource"));
	Press("AlignToSource", "AlignKeep");
	EXPECT_EVENTUALLY(!Dialog("AlignToSource"));
	Press("PoseCheck", "ReviewAgain");
	EXPECT_FALSE(Copied("PoseCheck").contains("\tlook\t"));
}

/// What can be read of a thing; what is typed into a field is the name itself.
QStringList Texts(const QObject& i_rThing)
{
	if (i_rThing.property("cursorPosition").isValid())
		return {};
	QStringList texts;
	for (const char* const pName : {"text", "displayText", "toolTip", "title", "windowTitle", "informativeText"})
		texts << i_rThing.property(pName).toString();
	const auto* const pView = qobject_cast<const QAbstractItemView*>(&i_rThing);
	const QAbstractItemModel* const pModel = pView ? pView->model() : nullptr;
	if (pModel)
		for (const QModelIndex& rIndex :
		    pModel->match(pModel->index(0, 0), Qt::DisplayRole, "*", -1, Qt::MatchWildcard | Qt::MatchRecursive))
			for (int column = 0; column < pModel->columnCount(); ++column)
				for (const int role : {Qt::DisplayRole, Qt::ToolTipRole})
					texts << rIndex.siblingAtColumn(column).data(role).toString();
	if (const auto* const pItem = qobject_cast<const QQuickItem*>(&i_rThing))
		for (const QQuickItem* const pChild : pItem->childItems())
			texts << Texts(*pChild);
	return texts;
}

TEST_F(Review, ShowsWhatIsHiddenInNames)
{
	const auto write = [this](const char* i_pFrom, const char* i_pTo)
	{
		QByteArray bytes = Content(i_pFrom);
		for (const char* const pName : {"Pelvis", "haunch", "performer"})
			for (const char* const pEnd : {"\"", "&gt;", "}"})
				bytes.replace(QByteArray(pName) + pEnd, QByteArray("&#x202E;&#9;") + pName + pEnd);
		QFile file(File(i_pTo));
		EXPECT_TRUE(file.open(QIODevice::WriteOnly) && file.write(bytes) == bytes.size()) << i_pTo;
		return file.fileName();
	};
	const char* const pFile = "\u202Exeh.qrr";
	write("performer.qrs", "\u202E\tperformer.qrs");
	EXPECT_EVENTUALLY(
	    m_pOperator->Property("SourceSkeleton", "model").toStringList().contains("[U+202E][U+09]performer"));
	ASSERT_TRUE(m_pWindow->Open(write("hero.qrr", pFile)));
	EXPECT_EVENTUALLY(Names("sourceSegments").value(0) == "[U+202E][U+09]Pelvis");
	SelectPair("[U+202E][U+09]Pelvis", "[U+202E][U+09]haunch");
	m_pOperator->Click("removeUnnecessaryJoints");
	m_pOperator->Hover("targetSegmentsRow0");
	for (const char* const pAction :
	    {"CompareWithSaved", "ShowAdvice", "CheckPose", "ProposeTargets", "RebindToFbx", "AlignToSourceAction"})
		m_pOperator->ChooseInMenu("ToolsMenu", pAction);
	EXPECT_EVENTUALLY(IsLookedAt("Advice"));
	QStringList texts =
	    Texts(*qobject_cast<QQuickWidget*>(m_pWindow->RetargetPanel()->Widget())->quickWindow()->contentItem());
	texts << Texts(*m_pWindow);
	for (const QObject* const pThing : m_pWindow->findChildren<QObject*>())
		texts << Texts(*pThing);
	EXPECT_GT(texts.filter("[U+202E][U+09]haunch").size(), 12);
	EXPECT_GT(texts.filter("[U+202E]xeh.qrr").size(), 3) << "title, panel, menus";
	for (const QString& rText : texts.filter(QRegularExpression("[\u202A-\u202E\u2066-\u2069\t]")))
		ADD_FAILURE() << rText.toStdString();
	// The names are what they were.
	EXPECT_EQ(m_pWindow->RetargetPanel()->ItemsNamedIn("'\u202E\thaunch'").size(), 1u);
	m_pWindow->RetargetPanel()->SaveTo(File(pFile));
	EXPECT_FALSE(m_pWindow->isWindowModified());
	EXPECT_TRUE(QString::fromUtf8(Content(pFile)).contains("\"\u202E&#9;haunch\""));
}

TEST_F(Review, WritesAReport)
{
	m_pOperator->AnswerNextDialog(File("hero"));
	m_pOperator->ChooseInMenu("ToolsMenu", "WriteReport");
	EXPECT_EVENTUALLY(QFile::exists(File("hero.html")));
	Run({"report", File("hero.qrr"), "--source", File("performer.qrs"), "--fbx", File("character.fbx"), "-o",
	    File("expected.html")});
	EXPECT_TRUE(Content("hero.html") == Content("expected.html"));
	EXPECT_EVENTUALLY(!m_pWindow->findChild<QObject*>("ReportRun"));
	// Of what is not saved; a page that stands there is asked about.
	m_pOperator->Click("removeUnnecessaryJoints");
	EXPECT_EVENTUALLY(m_pWindow->isWindowModified());
	m_pOperator->AnswerNextDialog(File("hero.html"));
	m_pOperator->AnswerNextQuestion("hero.html is there already. Do you want to replace it?", QMessageBox::Yes);
	m_pOperator->ChooseInMenu("ToolsMenu", "WriteReport");
	EXPECT_EVENTUALLY(Content("hero.html") != Content("expected.html"));
	EXPECT_TRUE(Content("hero.html").contains("</html>"));
}

} // namespace
