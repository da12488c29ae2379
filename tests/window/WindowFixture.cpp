#include "WindowFixture.h"

#include "../QtApplication.h"
#include "studio/host/OpenGLCheck.h"
#include "studio/host/Preferences.h"
#include "studio/host/Services.h"
#include "studio/panel/RetargetPanel.h"
#include "studio/window/DarkStyle.h"

#include <QAbstractItemModel>
#include <QFile>
#include <QProcess>
#include <QQuickWidget>
#include <QStyleHints>
#include <QTest>

namespace
{

[[maybe_unused]] auto* const s_pEnvironment = testing::AddGlobalTestEnvironment(
    new VQtApplication([] { QCoreApplication::setAttribute(Qt::AA_ShareOpenGLContexts); }, StudioHost::ApplyDarkStyle));

} // namespace

void Window::SetUp()
{
	StudioHost::CheckOpenGL();
	// Each blink of a text cursor would draw the whole panel.
	if (qEnvironmentVariableIsSet("LIBGL_ALWAYS_SOFTWARE"))
	{
		ASSERT_EQ(QGuiApplication::styleHints()->cursorFlashTime(), 0);
	}
	const std::string folder = m_Folder.path().toStdString();
	QFile::copy(RETARGET_SOURCE "/demo/performer.qrs", m_Folder.filePath("performer.qrs"));
	QFile::copy(RETARGET_SOURCE "/demo/character.fbx", m_Folder.filePath("character.fbx"));
	m_pSettings = std::make_unique<QSettings>(m_Folder.filePath("studio.ini"), QSettings::IniFormat);
	m_pWindow = std::make_unique<StudioHost::VStudioWindow>(*m_pSettings);
	for (const char* const pKey : {"FolderSubjects", "FolderSkins", "FolderRetargets"})
		m_pWindow->Context().Preferences().SetFolder(pKey, folder);
	ASSERT_TRUE(m_pWindow->LoadModule(RETARGET_MODULE));
	m_pWindow->resize(1100, 750);
	m_pWindow->show();
	m_pWindow->activateWindow();
	ASSERT_TRUE(QTest::qWaitForWindowActive(m_pWindow.get()));
	auto* const pPanel = qobject_cast<QQuickWidget*>(m_pWindow->RetargetPanel()->Widget());
	ASSERT_TRUE(pPanel && pPanel->rootObject());
	m_pOperator = std::make_unique<VOperator>(*m_pWindow, *pPanel);
}

QByteArray Window::Content(const char* i_pName) const
{
	QFile file(File(i_pName));
	EXPECT_TRUE(file.open(QIODevice::ReadOnly)) << i_pName;
	return file.readAll();
}

QByteArray Window::Run(const QStringList& i_rArguments) const
{
	QProcess process;
	process.start(RETARGET_PROGRAM, QStringList{"-q"} + i_rArguments);
	EXPECT_TRUE(process.waitForFinished(60000));
	EXPECT_EQ(process.exitCode(), 0) << process.readAllStandardError().toStdString();
	return process.readAllStandardOutput();
}

QByteArray Window::CommandLine(const QStringList& i_rArguments) const
{
	Run(i_rArguments + QStringList{"-o", File("expected.qrr")});
	return Content("expected.qrr");
}

void Window::CreateTargetSubject()
{
	m_pOperator->Choose("SourceSkeleton", "performer");
	EXPECT_EVENTUALLY(m_pOperator->Property("sourceSegments", "count").toInt() > 20);
	m_pOperator->Choose("TargetFBX", "character");
	EXPECT_EVENTUALLY(m_pOperator->Property("TargetRoot", "currentText").toString() == "haunch");
	m_pOperator->Click("createTargetSubject");
	EXPECT_EVENTUALLY(m_pOperator->Property("targetSegments", "count").toInt() > 20);
}

QStringList Window::Names(const char* i_pList) const
{
	QStringList names;
	QObject* const pModel = m_pOperator->Property(i_pList, "model").value<QObject*>();
	const auto* const pItems = qobject_cast<QAbstractItemModel*>(pModel);
	for (int row = 0; pItems && row < pItems->rowCount(); ++row)
		names << pItems->data(pItems->index(row, 0), Qt::UserRole + 1).toString();
	return names;
}

void Window::SelectPair(const char* i_pSource, const char* i_pTarget)
{
	m_pOperator->ClickRow("sourceSegments", RowOf("sourceSegments", i_pSource));
	m_pOperator->ClickRow("targetSegments", RowOf("targetSegments", i_pTarget));
	EXPECT_EVENTUALLY(m_pOperator->Property("addPositionTarget", "enabled").toBool());
}

int Window::RowOf(const char* i_pList, const char* i_pName) const
{
	const int row = Names(i_pList).indexOf(i_pName);
	EXPECT_NE(row, -1) << i_pName;
	return row;
}
