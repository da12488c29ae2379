#include "studio/DarkStyle.h"

#include <QApplication>
#include <QQuickWindow>
#include <gtest/gtest.h>

#include <memory>

namespace
{

/// One for all tests of the process, which ends before Qt's own statics do. Drawn without OpenGL, which is slow in
/// software; runs of the program have it.
class VApplication : public testing::Environment
{
public:
	void SetUp() override
	{
		qputenv("QT_XCB_GL_INTEGRATION", "none");
		QQuickWindow::setSceneGraphBackend(QSGRendererInterface::Software);
		m_pApplication = std::make_unique<QApplication>(m_Count, m_pArguments);
		StudioHost::ApplyDarkStyle(*m_pApplication);
	}
	void TearDown() override { m_pApplication.reset(); }

private:
	int m_Count = 1;
	char m_Name[5] = "test";
	char* m_pArguments[2] = {m_Name, nullptr};
	std::unique_ptr<QApplication> m_pApplication;
};

testing::Environment* const g_pApplication = testing::AddGlobalTestEnvironment(new VApplication);

} // namespace
