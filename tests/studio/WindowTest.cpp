#include "../FindItem.h"
#include "../WaitFor.h"
#include "Host.h"

#include "NVX/IQuickWidget.h"
#include "TesselPluginInterface/IParameter.h"
#include "TesselPluginInterface/IParameterGroup.h"
#include "TesselPluginInterface/PathTypes.h"
#include "studio/host/Preferences.h"
#include "studio/host/Services.h"
#include "studio/log/LogModel.h"
#include "studio/motion/TakePlayer.h"
#include "studio/panel/RetargetPanel.h"
#include "studio/panel/WorkKeeper.h"
#include "studio/window/PreferencesDialog.h"
#include "studio/window/StudioWindow.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QAction>
#include <QApplication>
#include <QComboBox>
#include <QDialog>
#include <QDir>
#include <QDockWidget>
#include <QDropEvent>
#include <QFileDialog>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QMenuBar>
#include <QMessageBox>
#include <QMimeData>
#include <QQuickItem>
#include <QQuickWidget>
#include <QQuickWindow>
#include <QTableView>
#include <QTest>
#include <QTextBrowser>
#include <QTimer>

#include <algorithm>
#include <functional>
#include <map>

namespace
{

using StudioHost::VPreferencesDialog;
using StudioHost::VStudioWindow;

const QString c_Source = QStringLiteral(RETARGET_SOURCE "/demo/performer.qrs");
const QString c_Fbx = QStringLiteral(RETARGET_SOURCE "/demo/character.fbx");

/// The menu bar's menu for what does not fit.
bool IsExtension(const QWidget* i_pWidget)
{
	return qobject_cast<const QMenu*>(i_pWidget) && i_pWidget->objectName().isEmpty()
	    && qobject_cast<const QMenuBar*>(i_pWidget->parentWidget());
}

class Window : public testing::Test, protected VScratchSettings
{
protected:
	void SetUp() override { Restart(); }

	/// The next run of the program.
	void Restart()
	{
		m_pWindow.reset();
		m_pWindow = std::make_unique<VStudioWindow>(m_Settings);
		m_pWindow->show();
	}

	void LoadPanel() { ASSERT_TRUE(m_pWindow->LoadModule(RETARGET_MODULE)); }

	std::shared_ptr<TesselPluginInterface::IParameterGroup> Parameters()
	{
		return m_pWindow->Context().GetParameterRegistry()->Find("RetargetSetup", "Subject");
	}

	std::string Parameter(const char* i_pName)
	{
		const auto pGroup = Parameters();
		return pGroup ? pGroup->Find(i_pName)->GetValueText() : "no group";
	}

	QVariant RootProperty(const char* i_pName)
	{
		return qobject_cast<QQuickWidget*>(m_pWindow->RetargetPanel()->Widget())->rootObject()->property(i_pName);
	}

	QQuickItem* DropMark()
	{
		const auto& rPanel = *qobject_cast<QQuickWidget*>(m_pWindow->RetargetPanel()->Widget());
		return FindItem(rPanel.quickWindow()->contentItem(), "dropMark", true);
	}

	/// @return whether the files are taken on this part of the window.
	bool Drop(const QStringList& i_rFiles, QWidget& i_rPart, bool i_bMarked = true)
	{
		QMimeData data;
		QList<QUrl> urls;
		for (const QString& rFile : i_rFiles)
			urls << QUrl::fromLocalFile(rFile);
		data.setUrls(urls);
		// With Shift the other side offers to move them.
		QDragEnterEvent enter({10, 10}, Qt::CopyAction | Qt::MoveAction, &data, Qt::LeftButton, Qt::ShiftModifier);
		QApplication::sendEvent(&i_rPart, &enter);
		if (!enter.isAccepted())
			return false;
		const QQuickItem* const pMark = DropMark();
		EXPECT_EQ(pMark && pMark->isVisible(), i_bMarked);
		m_Marked = pMark ? pMark->property("text").toString() : QString();
		EXPECT_EQ(enter.dropAction(), Qt::CopyAction);
		QDropEvent drop({10, 10}, Qt::CopyAction | Qt::MoveAction, &data, Qt::LeftButton, Qt::ShiftModifier);
		QApplication::sendEvent(&i_rPart, &drop);
		EXPECT_FALSE(DropMark());
		RunEvents();
		return true;
	}
	bool Drop(const QStringList& i_rFiles) { return Drop(i_rFiles, *m_pWindow); }

	QObject& Document()
	{
		return *dynamic_cast<NVX::IQuickWidget*>(m_pWindow->RetargetPanel()->Widget())
		            ->contextProperty("ContextRetargetSetup")
		            .value<QObject*>();
	}

	/// Runs what asks, and answers, with yes where that is no answer and with m_SaveAs where a name is wanted; a test
	/// failure if nothing asks.
	/// @return what is asked, a line for each question.
	QString Answer(QMessageBox::StandardButton i_Button, const std::function<void()>& i_rAsk)
	{
		QString asked;
		QTimer timer;
		QObject::connect(&timer, &QTimer::timeout,
		    [&]
		    {
			    QWidget* const pDialog = QApplication::activeModalWidget();
			    if (qobject_cast<QFileDialog*>(pDialog))
			    {
				    pDialog->findChild<QLineEdit*>("fileNameEdit")->setText(m_SaveAs);
				    QMetaObject::invokeMethod(pDialog, "accept");
			    }
			    auto* const pBox = qobject_cast<QMessageBox*>(pDialog);
			    if (!pBox)
				    return;
			    asked += (asked.isEmpty() ? "" : "\n") + pBox->text();
			    (pBox->button(i_Button) ? pBox->button(i_Button) : pBox->button(QMessageBox::Yes))->click();
		    });
		timer.start(0);
		i_rAsk();
		EXPECT_FALSE(asked.isEmpty());
		return asked;
	}

	QStringList RecentFiles() { return m_Settings.value("RecentFiles").toStringList(); }

	QAction& Action(const char* i_pName) { return *m_pWindow->findChild<QAction*>(i_pName); }

	std::unique_ptr<VStudioWindow> m_pWindow;
	QString m_SaveAs;
	/// What was shown while files hung over the window.
	QString m_Marked;
	VMessages m_Messages;
};

TEST_F(Window, TakesDroppedFilesByKind)
{
	LoadPanel();
	const QString note = WriteFile(Path("note.txt"), "no model");
	const QString broken = WriteFile(Path("broken.qrr"), "no xml");
	const QString target = Path("performer.qrr");
	ASSERT_TRUE(QFile::copy(c_Source, target));

	EXPECT_FALSE(Drop({note}));
	QDialog dialog(m_pWindow.get());
	dialog.setModal(true);
	dialog.show();
	EXPECT_FALSE(Drop({c_Source})) << "a dialog is answered first";
	QLineEdit field(&dialog);
	QMimeData text;
	text.setText("a");
	QDragEnterEvent enter({1, 1}, Qt::CopyAction, &text, Qt::LeftButton, {});
	QApplication::sendEvent(&field, &enter);
	EXPECT_TRUE(enter.isAccepted()) << "what comes over a field of it is the field's";
	dialog.hide();
	EXPECT_TRUE(Drop({target, note, c_Fbx, c_Source}));
	EXPECT_EQ(m_Marked,
	    "performer.qrs opens as the performer's skeleton\ncharacter.fbx opens as the character's FBX file\n"
	    "performer.qrr opens as the retarget subject\nnote.txt cannot be opened");
	EXPECT_EQ(m_Messages.Take(),
	    "2 Import: " + note.toStdString() + " is of no kind that can be opened: .qrs, .fbx, .qrr, .qrx or .bvh");
	EXPECT_EQ(Parameter("SourceSkeleton"), c_Source.toStdString());
	EXPECT_EQ(Parameter("TargetFBX"), c_Fbx.toStdString());
	EXPECT_EQ(RootProperty("currentTargetSubjectURL").toUrl(), QUrl::fromLocalFile(target));
	EXPECT_EQ(RecentFiles(), (QStringList{target, c_Fbx, c_Source}));

	// Wherever they are let go: not even a field takes them for text.
	auto* const pField = m_pWindow->findChild<QLineEdit*>("LogFilter");
	for (QWidget* pPart : {m_pWindow->RetargetPanel()->Widget(), static_cast<QWidget*>(pField)})
	{
		EXPECT_TRUE(Drop({c_Source}, *pPart)) << pPart->objectName().toStdString();
		EXPECT_EQ(RecentFiles().value(0), c_Source);
		EXPECT_TRUE(Drop({c_Fbx}, *pPart));
		EXPECT_EQ(RecentFiles().value(0), c_Fbx);
	}
	EXPECT_EQ(pField->text(), "");
	// On the dock that plays takes it is motion, of which the character has none.
	EXPECT_TRUE(Drop({c_Fbx}, *m_pWindow->findChild<QDockWidget*>("MotionDock"), false));
	EXPECT_TRUE(WaitFor([&] { return !m_pWindow->Motion().IsReading(); }, 60000));
	EXPECT_NE(m_Messages.Take().find("is not opened as a take"), std::string::npos);

	// What cannot be loaded is told, and never becomes the file that is saved to.
	EXPECT_TRUE(Drop({broken}));
	EXPECT_NE(m_Messages.Take().find("Command: Load: "), std::string::npos);
	EXPECT_EQ(RootProperty("currentTargetSubjectURL").toUrl(), QUrl::fromLocalFile(target));
	EXPECT_TRUE(Drop({Path("gone.fbx")}));
	EXPECT_EQ(m_Messages.Take(), "2 Import: " + Path("gone.fbx").toStdString() + " does not exist");
	EXPECT_EQ(RecentFiles().size(), 3);
}

TEST_F(Window, OpensFilesUsedLast)
{
	LoadPanel();
	const QString source = Path("a & b.qrs");
	QFile::copy(c_Source, source);
	m_pWindow->Open(source);
	m_pWindow->Open(c_Fbx);
	RunEvents();
	Restart();
	LoadPanel();
	QMenu& rMenu = *m_pWindow->findChild<QMenu*>("RecentMenu");
	ASSERT_GE(rMenu.actions().size(), 2);
	EXPECT_EQ(rMenu.actions()[0]->text(), "&1  " + c_Fbx);
	EXPECT_TRUE(rMenu.actions()[1]->text().endsWith("a && b.qrs")) << "no mnemonic";
	rMenu.actions()[1]->trigger();
	EXPECT_EQ(RecentFiles(), (QStringList{source, c_Fbx}));
	Action("ClearRecentFiles").trigger();
	EXPECT_FALSE(rMenu.isEnabled());
}

TEST_F(Window, KeepsWhatThePanelWasSetTo)
{
	LoadPanel();
	m_pWindow->Open(c_Source);
	RunEvents();
	Restart();
	LoadPanel();
	RunEvents();
	EXPECT_EQ(Parameter("SourceSkeleton"), c_Source.toStdString());
}

TEST_F(Window, ExplainsSilentCommands)
{
	LoadPanel();
	Action("FrameSelected").trigger();
	Action("ScaleUpManipulator").trigger();
	EXPECT_EQ(m_Messages.Take(), "") << "the panel knows these";
	EXPECT_TRUE(Action("ScaleUpManipulator").shortcuts().contains(QKeySequence("Ctrl+="))) << "without Shift";
	auto* const pPanel = dynamic_cast<NVX::IQuickWidget*>(m_pWindow->RetargetPanel()->Widget());
	QMetaObject::invokeMethod(pPanel->contextProperty("ContextRetargetSetup").value<QObject*>(), "CreateTargetSubject");
	RunEvents();
	const std::string message = m_Messages.Take();
	EXPECT_EQ(message.find("3 Command: Create Target Subject: No skeleton has been read"), 0u) << message;
	const QAbstractItemModel& rLog = m_pWindow->Log();
	const int last = rLog.rowCount() - 1;
	EXPECT_EQ(rLog.index(last, StudioHost::VLogModel::ECategory).data().toString(), "Command");
}

TEST_F(Window, SelectsWhatAMessageIsAbout)
{
	LoadPanel();
	const QString target = Path("performer.qrr");
	ASSERT_TRUE(QFile::copy(c_Source, target));
	m_pWindow->Open(c_Source);
	m_pWindow->Open(target);
	RunEvents();
	auto& rTable = *m_pWindow->findChild<QTableView*>("LogTable");
	const TesselPluginInterface::ISelection& rSelection = m_pWindow->Context().GetSelectionManager()->Selection();
	const auto selected = [&rSelection](NVX::ESelectionKind i_Kind) { return rSelection.ItemsOfKind(i_Kind).size(); };
	const struct
	{
		const char* m_pMessage;
		std::size_t m_Segments, m_Targets;
	} rows[] = {{"Segment 'L_Hand' does not follow", 1, 0}, {"The Pelvis is no name in quotes", 1, 0},
	    {"State X of target 3 stays as it was", 0, 1}, {"\"L_Hand\" and 'Pelvis', target #2", 2, 1}};
	for (const auto& rRow : rows)
	{
		NVX_LOG("Test", NVX::ELogError, "%1%", rRow.m_pMessage);
		RunEvents();
		const QModelIndex last = rTable.model()->index(rTable.model()->rowCount() - 1, 2);
		QTest::mouseClick(rTable.viewport(), Qt::LeftButton, {}, rTable.visualRect(last).topLeft() + QPoint(5, 5));
		EXPECT_EQ(selected(NVX::ESelectionSourceSegment), rRow.m_Segments) << rRow.m_pMessage;
		EXPECT_EQ(selected(NVX::ESelectionTargetSegment), rRow.m_Segments) << rRow.m_pMessage;
		EXPECT_EQ(selected(NVX::ESelectionTarget), rRow.m_Targets) << rRow.m_pMessage;
	}
}

TEST_F(Window, TheMenuTellsWhatSaveDoes)
{
	LoadPanel();
	const auto shown = [this](const char* i_pName)
	{
		QMenu& rMenu = *m_pWindow->findChild<QMenu*>("FileMenu");
		emit rMenu.aboutToShow();
		const QString text = Action(i_pName).text() + (Action(i_pName).isEnabled() ? "" : " off");
		emit rMenu.aboutToHide();
		EXPECT_TRUE(Action(i_pName).isEnabled()) << "its shortcut tells why";
		return text;
	};
	EXPECT_EQ(shown("Save"), "&Save Retarget Subject (there is no target subject yet) off");
	Action("Save").trigger();
	EXPECT_EQ(m_Messages.Take(), "3 Command: Save: There is no target subject yet.");
	const QString target = Path("performer.qrr");
	ASSERT_TRUE(QFile::copy(c_Source, target));
	m_pWindow->Open(target);
	RunEvents();
	EXPECT_EQ(shown("Save"), "&Save Retarget Subject (performer.qrr)");
	EXPECT_EQ(shown("SaveAs"), "Save Retarget Subject &As...");
	Action("New").trigger();
	RunEvents();
	EXPECT_TRUE(m_pWindow->RetargetPanel()->CurrentFile().isEmpty());
	EXPECT_FALSE(m_pWindow->RetargetPanel()->HasUnsavedChanges());
	EXPECT_EQ(shown("New"), "&New Retarget Subject (there is no target subject yet) off");

	Action("OperatorPage").trigger();
	auto* const pPage = m_pWindow->findChild<QTextBrowser*>("OperatorPageText");
	ASSERT_TRUE(pPage && pPage->isVisible());
	EXPECT_TRUE(pPage->toPlainText().contains("A good bind pose"));
	// By the keyboard: its one link leads to the page on motion.
	pPage->setFocus();
	QTest::keyClick(pPage, Qt::Key_Tab);
	QTest::keyClick(pPage, Qt::Key_Return);
	EXPECT_EQ(pPage->source().fileName(), "motion.md");
}

TEST_F(Window, SaysWhyThereIsNoPanel)
{
	EXPECT_FALSE(m_pWindow->LoadModule(Path("None.so")));
	const auto& rNotice = *m_pWindow->findChild<QLabel*>("Notice");
	EXPECT_TRUE(rNotice.isVisible());
	EXPECT_EQ(rNotice.text(), "No module is loaded: " + Path("None.so") + " does not exist");
	Action("FrameSelected").trigger();
	EXPECT_NE(m_Messages.Take().find("Command: Frame Selected: No panel is open"), std::string::npos);
}

TEST_F(Window, KeepsItsLayout)
{
	LoadPanel();
	auto* const pLog = m_pWindow->findChild<QDockWidget*>("LogDock");
	EXPECT_TRUE(pLog->isVisible());
	RunEvents();
	const auto& rTable = *m_pWindow->findChild<QTableView*>("LogTable");
	EXPECT_EQ(rTable.viewport()->height() / rTable.verticalHeader()->defaultSectionSize(), 4) << "lines of it";
	pLog->toggleViewAction()->trigger();
	m_pWindow->resize(1500, 950);
	RunEvents();
	const QSize size = m_pWindow->size();
	m_pWindow->close();
	Restart();
	LoadPanel();
	m_pWindow->RestoreLayout();
	m_pWindow->show();
	RunEvents();
	EXPECT_FALSE(m_pWindow->findChild<QDockWidget*>("LogDock")->isVisible());
	EXPECT_EQ(m_pWindow->size(), size);
	EXPECT_TRUE(m_pWindow->RetargetPanel()->Widget()->isVisible());
}

TEST_F(Window, TellsWhatTheMouseDoes)
{
	const char* const selects = "<td>Alt and left button, dragged</td><td>selects all in a rectangle</td>";
	const char* const turns = "<td>Alt and left button, dragged</td><td>turns the view</td>";
	for (const int number : {1, 0})
	{
		m_pWindow->Context().Preferences().SetNumber(TesselPluginInterface::c_NavigationAltKey, number);
		QString text;
		QTimer::singleShot(0, m_pWindow.get(),
		    [&]
		    {
			    auto* const pBox = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
			    ASSERT_TRUE(pBox);
			    text = pBox->text();
			    EXPECT_EQ(pBox->textFormat(), Qt::RichText);
			    pBox->button(QMessageBox::Close)->click();
		    });
		m_pWindow->findChild<QAction*>("MouseAndKeys")->trigger();
		EXPECT_EQ(text.contains(selects), number == 1) << text.toStdString();
		EXPECT_EQ(text.contains(turns), number == 0);
	}
}

TEST_F(Window, AsksBeforeUnsavedChangesAreLost)
{
	LoadPanel();
	const QString target = Path("performer.qrr");
	ASSERT_TRUE(QFile::copy(c_Source, target));
	const QByteArray before = ReadFile(target);
	ASSERT_TRUE(m_pWindow->Open(target));
	EXPECT_TRUE(m_pWindow->close()) << "nothing has changed yet";

	m_pWindow->show();
	RunEvents();
	// What was set just now counts, though nothing has heard of it.
	const QString asked = "performer.qrr has changes that are not saved.";
	EXPECT_EQ(Parameters()->Find("TargetScale")->SetValueText("2"), "");
	EXPECT_EQ(Answer(QMessageBox::Discard, [&] { m_pWindow->Open(target); }), asked);
	RunEvents();
	EXPECT_EQ(Parameters()->Find("TargetScale")->SetValueText("3"), "");
	EXPECT_EQ(Answer(QMessageBox::Cancel, [&] { m_pWindow->close(); }), asked);
	QMetaObject::invokeMethod(&Document(), "RemoveUnnecessaryJoints");
	const struct
	{
		QMessageBox::StandardButton m_Answer;
		bool m_bCloses;
		bool m_bSaves;
	} rows[] = {
	    {QMessageBox::Cancel, false, false}, {QMessageBox::Discard, true, false}, {QMessageBox::Save, true, true}};
	for (const auto& rRow : rows)
	{
		m_pWindow->show();
		EXPECT_EQ(Answer(rRow.m_Answer, [&] { EXPECT_EQ(m_pWindow->close(), rRow.m_bCloses); }), asked);
		EXPECT_EQ(ReadFile(target) != before, rRow.m_bSaves);
	}
	m_pWindow->show();
	EXPECT_TRUE(m_pWindow->close()) << "all is saved";
}

TEST_F(Window, OffersWhatACrashHasLeft)
{
	const QString file = Path("a.qrr");
	const QString folder = Path("unsaved-work");
	ASSERT_TRUE(QFile::copy(c_Source, file));
	const QByteArray saved = ReadFile(file);
	const auto content = [&] { return QDir(folder).entryList(QDir::Files); };
	const auto offer = [this] { m_pWindow->OfferLeftWork(); };

	LoadPanel();
	ASSERT_TRUE(m_pWindow->Open(file) && m_pWindow->Open(c_Fbx));
	offer();
	EXPECT_TRUE(content().isEmpty()) << "nothing is unsaved";
	QMetaObject::invokeMethod(&Document(), "RemoveUnnecessaryJoints");
	m_pWindow->WorkKeeper()->Keep();
	EXPECT_TRUE(m_pWindow->WorkKeeper()->Left().empty()) << "it is this program's own";
	// Whoever removes the lock does not get the work of a program that runs, nor does the whole folder stay away.
	static QString s_QtSaid;
	qInstallMessageHandler([](QtMsgType, const QMessageLogContext&, const QString& i_rText) { s_QtSaid += i_rText; });
	for (const bool bFolder : {false, true})
	{
		for (const QString& rName : content())
			if (bFolder || rName.endsWith(".lock"))
				QFile::remove(folder + '/' + rName);
		EXPECT_EQ(QDir().rmdir(folder), bFolder);
		m_pWindow->WorkKeeper()->Keep();
		EXPECT_EQ(content().filter(".lock").size(), 1);
		EXPECT_TRUE(StudioHost::VUnsavedWorkFolder(folder).Left().empty()) << "another program asks";
	}
	qInstallMessageHandler(nullptr);
	EXPECT_FALSE(s_QtSaid.contains("lock")) << s_QtSaid.toStdString();
	// The process is gone, its files are not.
	std::map<QString, QByteArray> left;
	for (const QString& rName : content())
		if (!rName.endsWith(".lock"))
			left[rName] = ReadFile(folder + '/' + rName);
	ASSERT_EQ(left.size(), 2u);
	const QByteArray work = left.begin()->second;
	const auto restart = [&]
	{
		Restart();
		EXPECT_FALSE(QDir(folder).exists()) << "a clean end leaves nothing";
		QDir().mkpath(folder);
		for (const auto& [rName, rBytes] : left)
			WriteFile(folder + '/' + rName, rBytes);
		LoadPanel();
	};

	restart();
	const QString asked = "Retarget Studio did not end cleanly, and work was not saved: " + file;
	EXPECT_EQ(Answer(QMessageBox::Cancel, offer), asked);
	EXPECT_EQ(content().size(), 2) << "it is asked again";
	EXPECT_EQ(Answer(QMessageBox::Open, offer), asked);
	RunEvents();
	EXPECT_EQ(m_pWindow->windowTitle(), "a.qrr[*] - Retarget Studio");
	EXPECT_TRUE(m_pWindow->isWindowModified());
	EXPECT_EQ(Parameter("TargetFBX"), c_Fbx.toStdString());
	EXPECT_EQ(ReadFile(file), saved);
	ASSERT_EQ(m_pWindow->WorkKeeper()->Left().size(), 0u);
	EXPECT_EQ(content().filter(".qrr").size(), 1) << "kept again under this program's name";
	Action("Save").trigger();
	EXPECT_EQ(ReadFile(file), work);
	EXPECT_FALSE(QDir(folder).exists()) << "nothing is unsaved any more";

	// Another program has written the file since.
	restart();
	WriteFile(file, saved + "\n");
	QFile later(file);
	ASSERT_TRUE(later.open(QIODevice::ReadWrite)
	    && later.setFileTime(QDateTime::currentDateTime().addSecs(60), QFileDevice::FileModificationTime));
	Answer(QMessageBox::Open, offer);
	EXPECT_EQ(Answer(QMessageBox::Cancel, [this] { Action("Save").trigger(); }),
	    file + " was changed by another program since it was last loaded or saved here. Overwrite it?");
	EXPECT_EQ(ReadFile(file), saved + "\n");

	// Whatever stands there is no way to another file, and what cannot be read stays.
	for (auto& [rName, rBytes] : left)
		if (rName.endsWith(".json"))
			rBytes.replace("\"copy\": \"", "\"copy\": \"../../");
		else
			rBytes = "rubbish";
	restart();
	Answer(QMessageBox::Open, offer);
	EXPECT_EQ(content().size(), 2);
	EXPECT_FALSE(m_pWindow->isWindowModified());
	Answer(QMessageBox::Discard, offer);
	EXPECT_FALSE(QDir(folder).exists());
}

TEST_F(Window, AsksBeforeAnotherSubjectTakesThePlace)
{
	LoadPanel();
	const QString a = Path("a.qrr");
	const QString b = Path("b.qrr");
	ASSERT_TRUE(QFile::copy(c_Source, a) && QFile::copy(c_Source, b));
	const auto edit = [this] { QMetaObject::invokeMethod(&Document(), "RemoveUnnecessaryJoints"); };
	const auto create = [this] { QMetaObject::invokeMethod(&Document(), "CreateTargetSubject"); };
	const auto state = [this]
	{
		RunEvents();
		return m_pWindow->windowTitle() + (m_pWindow->isWindowModified() ? " unsaved" : "");
	};
	EXPECT_EQ(state(), "Retarget Studio");
	ASSERT_TRUE(m_pWindow->Open(a) && m_pWindow->Open(c_Fbx));
	EXPECT_EQ(state(), "a.qrr[*] - Retarget Studio");
	edit();
	EXPECT_EQ(state(), "a.qrr[*] - Retarget Studio unsaved");
	const QString asked = "a.qrr has changes that are not saved.";
	EXPECT_EQ(Answer(QMessageBox::Cancel, [&] { m_pWindow->Open(b); }), asked);
	EXPECT_EQ(state(), "a.qrr[*] - Retarget Studio unsaved");
	EXPECT_EQ(RecentFiles(), (QStringList{c_Fbx, a}));
	EXPECT_EQ(Answer(QMessageBox::Cancel, create), asked);
	EXPECT_EQ(Answer(QMessageBox::Discard, [&] { Drop({b}); }), asked);
	EXPECT_EQ(state(), "b.qrr[*] - Retarget Studio");
	EXPECT_EQ(ReadFile(a), ReadFile(b));
	edit();
	Answer(QMessageBox::Save, [this] { m_pWindow->findChild<QMenu*>("RecentMenu")->actions()[2]->trigger(); });
	EXPECT_EQ(state(), "a.qrr[*] - Retarget Studio");
	EXPECT_NE(ReadFile(a), ReadFile(b));
	create();
	EXPECT_EQ(state(), "New retarget subject[*] - Retarget Studio unsaved");
	EXPECT_FALSE(RootProperty("currentTargetSubjectURL").toUrl().isValid()) << "it is no longer of the file";
	create();
	edit();
	EXPECT_EQ(Answer(QMessageBox::Discard, [&] { m_pWindow->Open(b); }),
	    "The retarget subject has changes that are in no file.");
	create();
	edit();
	m_SaveAs = Path("a");
	EXPECT_EQ(Answer(QMessageBox::Save, [&] { m_pWindow->Open(b); }),
	    "The retarget subject has changes that are in no file.\n"
	    "a.qrr is there already. Do you want to replace it?");
	EXPECT_FALSE(QFile::exists(m_SaveAs)) << "a name that no dialog shows";
}

TEST_F(Window, AFailedSaveIsShown)
{
	LoadPanel();
	const QString file = Path("a.qrr");
	ASSERT_TRUE(QFile::copy(c_Source, file) && m_pWindow->Open(file));
	QMetaObject::invokeMethod(&Document(), "RemoveUnnecessaryJoints");
	ASSERT_TRUE(QFile::remove(file) && QDir().mkdir(file));
	const QStringList recent = RecentFiles();
	const auto failure = [this] { return m_pWindow->findChild<QMessageBox*>("SaveFailure"); };
	Action("Save").trigger();
	ASSERT_TRUE(failure());
	EXPECT_TRUE(failure()->informativeText().contains("it is a folder")) << failure()->informativeText().toStdString();
	for (const QLabel* const pLabel : failure()->findChildren<QLabel*>())
		EXPECT_EQ(pLabel->textFormat(), Qt::PlainText) << "names of files may look like markup";
	delete failure();
	m_pWindow->RetargetPanel()->SaveTo(Path("none/b.qrr"));
	ASSERT_TRUE(failure());
	delete failure();
	EXPECT_EQ(RecentFiles(), recent);
	EXPECT_EQ(RootProperty("currentTargetSubjectURL").toUrl(), QUrl::fromLocalFile(file));
	EXPECT_TRUE(m_pWindow->isWindowModified());
	Answer(QMessageBox::Save, [this] { EXPECT_FALSE(m_pWindow->close()) << "what was not saved is not lost"; });
	delete failure();
}

TEST_F(Window, PreferencesHaveARowForEachFolder)
{
	StudioHost::VPreferences& rPreferences = m_pWindow->Context().Preferences();
	std::vector<std::string> keys(
	    TesselPluginInterface::c_FolderKeys.begin(), TesselPluginInterface::c_FolderKeys.end());
	keys.insert(keys.end(), {"ProductFolderOrlexRally", "ProductFolderOrlexStage"});
	{
		VPreferencesDialog dialog(rPreferences);
		dialog.show();
		const auto count = [&dialog, &keys]
		{
			return std::ranges::count_if(keys,
			    [&dialog](const std::string& i_rKey)
			    { return dialog.findChild<QLineEdit*>(QString::fromStdString(i_rKey))->isVisible(); });
		};
		EXPECT_EQ(count(), 4) << "those that count";
		QTest::mouseClick(dialog.findChild<QAbstractButton*>("More"), Qt::LeftButton);
		EXPECT_EQ(count(), 11);
		for (const std::string& rKey : keys)
		{
			auto* const pEdit = dialog.findChild<QLineEdit*>(QString::fromStdString(rKey));
			ASSERT_TRUE(pEdit) << rKey;
			EXPECT_TRUE(pEdit->text().isEmpty());
			QTest::keyClicks(pEdit, QString::fromStdString("/none/" + rKey));
			EXPECT_TRUE(
			    dialog.findChild<QLabel*>(QString::fromStdString(rKey + "Warning"))->text().contains("not there"));
		}
		auto* const pAlt = dialog.findChild<QComboBox*>(TesselPluginInterface::c_NavigationAltKey);
		EXPECT_EQ(pAlt->currentData(), 1);
		pAlt->setCurrentIndex(1);
		EXPECT_TRUE(m_pWindow->Context().Application().Rules().m_bPoseFromFile);
		QTest::mouseClick(dialog.findChild<QAbstractButton*>("PoseFromFBX"), Qt::LeftButton);
		EXPECT_TRUE(rPreferences.Folder(keys.front()).empty()) << "nothing is taken over before it is asked for";
		QTest::mouseClick(dialog.findChild<QAbstractButton*>("PreferencesOk"), Qt::LeftButton);
		EXPECT_EQ(dialog.result(), QDialog::Accepted);
	}
	for (const std::string& rKey : keys)
		EXPECT_EQ(rPreferences.Folder(rKey), "/none/" + rKey);
	EXPECT_EQ(rPreferences.Number(TesselPluginInterface::c_NavigationAltKey, 1), 0);

	// The next run has them, and an empty field takes a folder away.
	Restart();
	EXPECT_FALSE(m_pWindow->Context().Application().Rules().m_bPoseFromFile);
	VPreferencesDialog dialog(m_pWindow->Context().Preferences());
	auto* const pSkins = dialog.findChild<QLineEdit*>("FolderSkins");
	EXPECT_EQ(pSkins->text(), "/none/FolderSkins");
	pSkins->clear();
	dialog.Apply();
	EXPECT_TRUE(m_pWindow->Context().Preferences().Folder("FolderSkins").empty());
}

TEST_F(Window, AllControlsAreNamed)
{
	LoadPanel();
	VPreferencesDialog dialog(m_pWindow->Context().Preferences());
	int count = 0;
	for (const QWidget* pRoot : {static_cast<QWidget*>(m_pWindow.get()), static_cast<QWidget*>(&dialog)})
	{
		for (const QWidget* pWidget : pRoot->findChildren<QWidget*>())
		{
			const bool bControl = qobject_cast<const QAbstractButton*>(pWidget)
			    || qobject_cast<const QLineEdit*>(pWidget) || qobject_cast<const QComboBox*>(pWidget)
			    || qobject_cast<const QAbstractItemView*>(pWidget) || qobject_cast<const QDockWidget*>(pWidget)
			    || qobject_cast<const QMenu*>(pWidget);
			// Parts of Qt's own controls.
			const QWidget* const pParent = pWidget->parentWidget();
			const bool bPart = pWidget->objectName().startsWith("qt_") || pWidget->inherits("QLineEditIconButton")
			    || pWidget->inherits("QTableCornerButton") || pWidget->inherits("QHeaderView") || IsExtension(pWidget)
			    || (pParent
			        && (pParent->inherits("QComboBoxPrivateContainer") || pParent->objectName().startsWith("qt_")));
			if (!bControl || bPart)
				continue;
			++count;
			EXPECT_FALSE(pWidget->objectName().isEmpty()) << pWidget->metaObject()->className();
			EXPECT_FALSE(pWidget->accessibleName().isEmpty()) << pWidget->objectName().toStdString();
		}
	}
	EXPECT_GT(count, 30);
}

} // namespace
