#include <QCoreApplication>
#include <QProcess>
#include <gtest/gtest.h>

namespace
{

/// Qt takes its render loop and its scale once for a process, so each of them is a process of its own.
TEST(RenderLoops, ShowAndPickTheSame)
{
	if (qEnvironmentVariableIsSet("TSAN_OPTIONS"))
		GTEST_SKIP() << "as windows in this process";
	constexpr const char* c_pTests = "VViewTest.Selects*:VViewTest.Shows*:VViewTest.Ends*";
	const struct
	{
		const char* m_pName;
		std::vector<std::pair<const char*, const char*>> m_Variables;
		const char* m_pTests = c_pTests;
	} rows[] = {
	    {"window, drawn on this thread", {{"RETARGET_TEST_VIEW", "1"}, {"QSG_RENDER_LOOP", "basic"}}},
	    {"window, drawn on another thread", {{"RETARGET_TEST_VIEW", "1"}, {"QSG_RENDER_LOOP", "threaded"}}},
	    {"no OpenGL", {{"QT_QUICK_BACKEND", "software"}}, "VViewTest.DISABLED_Says*"},
	    {"display of double resolution", {{"QT_SCALE_FACTOR", "2"}}},
	};
	for (const auto& rRow : rows)
	{
		QProcess process;
		QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
		for (const auto& [pName, pValue] : rRow.m_Variables)
			environment.insert(pName, pValue);
		process.setProcessEnvironment(environment);
		process.setProcessChannelMode(QProcess::MergedChannels);
		process.start(QCoreApplication::applicationFilePath(),
		    {QString("--gtest_filter=") + rRow.m_pTests, "--gtest_also_run_disabled_tests"});
		ASSERT_TRUE(process.waitForFinished(300000)) << rRow.m_pName;
		EXPECT_EQ(process.exitCode(), 0) << rRow.m_pName << "\n" << process.readAll().toStdString();
		EXPECT_EQ(process.exitStatus(), QProcess::NormalExit) << rRow.m_pName;
	}
}

} // namespace
