#include "Host.h"

#include "CommandLineText/Display.h"
#include "studio/host/QtDispatcher.h"
#include "studio/log/LogModel.h"
#include "studio/log/LogPanel.h"

#include <QAbstractItemModelTester>
#include <QApplication>
#include <QClipboard>
#include <QComboBox>
#include <QLineEdit>
#include <QPushButton>
#include <QTableView>
#include <QTest>

#include <thread>

namespace
{

using StudioHost::VLogModel;

class Log : public testing::Test
{
protected:
	void SetUp() override { NVX::GlobalLog::SetDefaultLevel(NVX::ELogDetail); }
	void TearDown() override { NVX::GlobalLog::SetDefaultLevel(NVX::ELogWarning); }

	static std::string Row(const QAbstractItemModel& i_rModel, int i_Row)
	{
		std::string text;
		for (int column = 0; column < i_rModel.columnCount(); ++column)
			text += (column ? "|" : "") + i_rModel.index(i_Row, column).data().toString().toStdString();
		return text;
	}

	const std::shared_ptr<StudioHost::VQtDispatcher> m_pDispatcher = std::make_shared<StudioHost::VQtDispatcher>();
};

TEST_F(Log, ShowsMessagesOfAnyThreadInTheirOrder)
{
	VLogModel model(m_pDispatcher);
	const QAbstractItemModelTester tester(&model, QAbstractItemModelTester::FailureReportingMode::Fatal);
	NVX_LOG("FBXIO", NVX::ELogError, "File %1% not found", "x.fbx");
	std::thread([] { NVX_LOG("System", NVX::ELogDetail, "from\nanother thread\n"); }).join();
	EXPECT_EQ(model.rowCount(), 0) << "rows come through the dispatcher";
	EXPECT_EQ(m_pDispatcher->PendingCount(), 1u) << "one callback brings all that waits";
	RunEvents();
	ASSERT_EQ(model.rowCount(), 2);
	EXPECT_EQ(Row(model, 0), "error|FBXIO|File x.fbx not found");
	EXPECT_EQ(Row(model, 1), "detail|System|from another thread");
	EXPECT_EQ(model.index(1, 2).data(VLogModel::EWholeTextRole).toString(), "from\nanother thread\n");
	EXPECT_EQ(model.Categories(), (QStringList{"FBXIO", "System"}));
	model.Clear();
	EXPECT_EQ(model.rowCount(), 0);
}

TEST_F(Log, CountsWhatIsRepeated)
{
	VLogModel model(m_pDispatcher);
	const QAbstractItemModelTester tester(&model, QAbstractItemModelTester::FailureReportingMode::Fatal);
	const auto log = [](int i_Level, const char* i_pText) { NVX_LOG("FBXIO", i_Level, "%1%", i_pText); };
	for (int i = 0; i < 3; ++i)
	{
		log(NVX::ELogError, "not found");
		log(NVX::ELogWarning, "not found");
		log(NVX::ELogError, "not opened");
		// Some have a row already, some wait with their like.
		if (i > 0)
			RunEvents();
	}
	log(NVX::ELogError, "not found");
	RunEvents();
	ASSERT_EQ(model.rowCount(), 3);
	EXPECT_EQ(Row(model, 0), "warning|FBXIO|not found (3 times)");
	EXPECT_EQ(Row(model, 1), "error|FBXIO|not opened (3 times)");
	EXPECT_EQ(Row(model, 2), "error|FBXIO|not found (4 times)");
}

TEST_F(Log, LeavesOutWhatQtSaysToItself)
{
	VLogModel model(m_pDispatcher);
	CommandLine::PrepareDisplay({"test", CommandLine::EBadInput, ""});
	QMessageLogger("", 0, "", "qt.qpa.xcb").warning("XCB error: 8");
	QMessageLogger("", 0, "", "qml").warning("of a panel");
	qInstallMessageHandler(nullptr);
	RunEvents();
	ASSERT_EQ(model.rowCount(), 2);
	EXPECT_EQ(Row(model, 0), "detail|Qt|XCB error: 8");
	EXPECT_EQ(Row(model, 1), "warning|Qt|of a panel");
}

TEST_F(Log, KeepsTheNewestRows)
{
	VLogModel model(m_pDispatcher, 100);
	const QAbstractItemModelTester tester(&model, QAbstractItemModelTester::FailureReportingMode::Fatal);
	for (int i = 0; i < 250; ++i)
	{
		NVX_LOG("System", NVX::ELogInformation, "%1%", i);
		// Sometimes many wait, sometimes one.
		if (i % 7 == 0 || (i > 180 && i < 240))
			RunEvents();
		EXPECT_LE(model.rowCount(), 100);
	}
	RunEvents();
	EXPECT_GE(model.rowCount(), 80);
	EXPECT_EQ(Row(model, model.rowCount() - 1), "information|System|249");
	for (int i = 0; i < 1000; ++i)
		NVX_LOG("System", NVX::ELogInformation, "flood %1%", i);
	RunEvents();
	EXPECT_EQ(model.rowCount(), 100);
	EXPECT_EQ(Row(model, 0), "information|System|flood 900");
}

TEST_F(Log, EndsBeforeItsDispatcher)
{
	auto pModel = std::make_unique<VLogModel>(m_pDispatcher);
	NVX_LOG("System", NVX::ELogInformation, "on its way");
	pModel.reset();
	RunEvents();
	EXPECT_EQ(m_pDispatcher->PendingCount(), 0u);
}

TEST_F(Log, IsFilteredAndCopied)
{
	VLogModel model(m_pDispatcher);
	StudioHost::VLogPanel panel(model);
	panel.show();
	NVX_LOG("FBXIO", NVX::ELogError, "broken mesh");
	NVX_LOG("FBXIO", NVX::ELogInformation, "Loading file a.fbx");
	NVX_LOG("System", NVX::ELogWarning, "no Mesh here");
	RunEvents();
	auto& rTable = *panel.findChild<QTableView*>("LogTable");
	auto& rLevel = *panel.findChild<QComboBox*>("LogLevel");
	auto& rCategory = *panel.findChild<QComboBox*>("LogCategory");
	auto& rFilter = *panel.findChild<QLineEdit*>("LogFilter");
	// At first what needs no attention is left out.
	EXPECT_EQ(rTable.model()->rowCount(), 2);

	const struct
	{
		int m_Level;
		const char* m_pCategory;
		const char* m_pText;
		const char* m_pShown;
	} rows[] = {
	    {0, "All categories", "", "error FBXIO: broken mesh\n"},
	    {1, "All categories", "", "error FBXIO: broken mesh\nwarning System: no Mesh here\n"},
	    {1, "System", "", "warning System: no Mesh here\n"},
	    {3, "FBXIO", "", "error FBXIO: broken mesh\ninformation FBXIO: Loading file a.fbx\n"},
	    {3, "All categories", "mesh", "error FBXIO: broken mesh\nwarning System: no Mesh here\n"},
	    {3, "All categories", "fbxio", "error FBXIO: broken mesh\ninformation FBXIO: Loading file a.fbx\n"},
	    {3, "All categories", "nothing", ""},
	};
	for (const auto& rRow : rows)
	{
		rLevel.setCurrentIndex(rRow.m_Level);
		rCategory.setCurrentText(rRow.m_pCategory);
		rFilter.clear();
		QTest::keyClicks(&rFilter, rRow.m_pText);
		EXPECT_EQ(panel.TextToCopy(), rRow.m_pShown);
	}

	rFilter.clear();
	rTable.selectRow(1);
	QTest::mouseClick(panel.findChild<QPushButton*>("LogCopy"), Qt::LeftButton);
	EXPECT_EQ(QApplication::clipboard()->text(), "information FBXIO: Loading file a.fbx\n");
	// A category that comes later leaves the choice as it is.
	rCategory.setCurrentText("System");
	NVX_LOG("Another", NVX::ELogError, "one more");
	RunEvents();
	EXPECT_EQ(rCategory.currentText(), "System");
	EXPECT_EQ(rTable.model()->rowCount(), 1);
}

} // namespace
