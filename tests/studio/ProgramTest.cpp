// The program as the shell meets it.

#include "Host.h"

#include <QImage>
#include <QProcess>
#include <QRegularExpression>

#include <map>

namespace
{

class Program : public testing::Test, protected VScratchSettings
{
protected:
	/// @return the exit status; -1 for a program that has crashed or does not end.
	int Run(const QStringList& i_rArguments, const std::map<QString, QString>& i_rEnvironment = {})
	{
		QProcess process;
		QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
		environment.insert("HOME", m_Folder.path());
		environment.insert("XDG_RUNTIME_DIR", m_Folder.path());
		environment.remove("XDG_CONFIG_HOME");
		environment.remove("QT_XCB_GL_INTEGRATION");
		// OpenGL drivers leak, and are gone with their names when a sanitized program looks for leaks.
		environment.insert("ASAN_OPTIONS", environment.value("ASAN_OPTIONS") + ":detect_leaks=0");
		for (const auto& [rName, rValue] : i_rEnvironment)
			environment.insert(rName, rValue);
		process.setProcessEnvironment(environment);
		process.start(STUDIO_PROGRAM, i_rArguments);
		const bool bEnded = process.waitForFinished(60000);
		m_Out = process.readAllStandardOutput();
		m_Err = process.readAllStandardError();
		return bEnded && process.exitStatus() == QProcess::NormalExit ? process.exitCode() : -1;
	}

	QStringList Picture(const QStringList& i_rMore, const QString& i_rPicture = "picture.png")
	{
		return QStringList{"--settings", Path("own.ini"), "--screenshot", Path(i_rPicture)} + i_rMore;
	}

	QString m_Out;
	QString m_Err;
};

TEST_F(Program, TellsItsVersionAndWrongUsageWithoutADisplay)
{
	const std::map<QString, QString> noDisplay = {{"DISPLAY", ""}, {"WAYLAND_DISPLAY", ""}, {"QT_QPA_PLATFORM", ""}};
	EXPECT_EQ(Run({"--version"}, noDisplay), 0);
	EXPECT_EQ(m_Out, "retarget-studio " RETARGET_VERSION "\n");
	EXPECT_EQ(Run({"--sise", "1x1"}, noDisplay), 2);
	EXPECT_EQ(m_Err,
	    "error retarget-studio: there is no option \"--sise\"; did you mean \"--size\"?; see \"retarget-studio "
	    "--help\"\n");
	EXPECT_EQ(Run({}, noDisplay), 3);
	EXPECT_EQ(m_Err,
	    "error retarget-studio: There is no display to show a window on: set DISPLAY, or use the program retarget\n");
	EXPECT_EQ(Run({}, {{"DISPLAY", ":32123"}, {"QT_QPA_PLATFORM", "xcb"}}), 3);
	EXPECT_TRUE(m_Err.endsWith("There is no display to show a window on: set DISPLAY, or use the program retarget\n"))
	    << m_Err.toStdString();
}

TEST_F(Program, TakesAPicture)
{
	EXPECT_EQ(Run(Picture({"--size", "1400x900", "--source", RETARGET_SOURCE "/demo/performer.qrs",
	              RETARGET_SOURCE "/demo/character.fbx"})),
	    0);
	EXPECT_EQ(m_Err, "");
	const QImage picture(Path("picture.png"));
	EXPECT_EQ(picture.size(), QSize(1400, 900));
	// The theme's ground, and the orange of buttons that are on.
	int window = 0, active = 0;
	for (int y = 0; y < picture.height(); ++y)
		for (int x = 0; x < picture.width(); ++x)
		{
			window += picture.pixel(x, y) == qRgb(0x2a, 0x2d, 0x30);
			active += picture.pixel(x, y) == qRgb(231, 101, 0);
		}
	EXPECT_GT(window, 10000);
	EXPECT_GT(active, 100);
	QSettings settings(Path("own.ini"), QSettings::IniFormat);
	EXPECT_EQ(
	    settings.value("Store/RetargetSetup/TargetFBX").toString(), "String " RETARGET_SOURCE "/demo/character.fbx");
	EXPECT_FALSE(QFileInfo::exists(Path(".config/RetargetSetup"))) << "the user's own settings are left alone";

	EXPECT_EQ(Run(Picture({"--size", "1400x900", "--open", "preferences"}, "preferences.png")), 0);
	const QImage withDialog(Path("preferences.png"));
	ASSERT_EQ(withDialog.size(), picture.size());
	// What is in it, not only its frame.
	int changed = 0;
	for (int y = 0; y < picture.height(); ++y)
		for (int x = 0; x < picture.width(); ++x)
			changed += picture.pixel(x, y) != withDialog.pixel(x, y);
	EXPECT_GT(changed, 50000);
}

TEST_F(Program, FailsWithItsReason)
{
	const QString broken = WriteFile(Path("broken.qrr"), "no xml");
	const struct
	{
		QStringList m_Arguments;
		int m_Status;
		const char* m_pMessage;
	} rows[] = {
	    {Picture({"--fbx", Path("none.fbx")}), 3, "error Import: .*/none.fbx does not exist\n"},
	    {Picture({broken}), 3, "warning Command: Load: "},
	    {Picture({"--module", broken}), 3, "error System: No module is loaded: .*broken.qrr is no library"},
	    {Picture({}, "none/picture.png"), 4, "error System: .*none/picture.png"},
	};
	for (const auto& rRow : rows)
	{
		EXPECT_EQ(Run(rRow.m_Arguments, {{"QT_XCB_GL_INTEGRATION", "none"}}), rRow.m_Status) << rRow.m_pMessage;
		EXPECT_TRUE(QRegularExpression(rRow.m_pMessage).match(m_Err).hasMatch()) << m_Err.toStdString();
	}
}

TEST_F(Program, WorksWithoutOpenGL)
{
	EXPECT_EQ(
	    Run(Picture({"--source", RETARGET_SOURCE "/demo/performer.qrs"}), {{"QT_XCB_GL_INTEGRATION", "none"}}), 0);
	EXPECT_TRUE(m_Err.contains("warning CoreGraphics: This display (xcb) has no OpenGL")) << m_Err.toStdString();
	EXPECT_EQ(QImage(Path("picture.png")).size(), QSize(1280, 800));
}

} // namespace
