#pragma once

#include <QApplication>
#include <QQuickWindow>
#include <gtest/gtest.h>

#include <memory>

/// The one application of a test process, which ends before Qt's own statics and OpenGL's contexts do.
class VQtApplication : public testing::Environment
{
public:
	using VPrepare = void();
	using VDress = void(QApplication& io_rApplication);

	/// @param i_pPrepare runs before the application is made, i_pDress after it. Either may be null.
	explicit VQtApplication(VPrepare* i_pPrepare = nullptr, VDress* i_pDress = nullptr)
	    : m_pPrepare(i_pPrepare), m_pDress(i_pDress)
	{
	}

	void SetUp() override
	{
		if (m_pPrepare)
			m_pPrepare();
		m_pApplication = std::make_unique<QApplication>(m_Count, m_pArguments);
		if (m_pDress)
			m_pDress(*m_pApplication);
	}
	void TearDown() override { m_pApplication.reset(); }

private:
	VPrepare* const m_pPrepare;
	VDress* const m_pDress;
	int m_Count = 1;
	char m_Name[5] = "test";
	char* m_pArguments[2] = {m_Name, nullptr};
	std::unique_ptr<QApplication> m_pApplication;
};

/// To prepare an application that draws without OpenGL, which is slow in software.
inline void DrawWithoutOpenGL()
{
	qputenv("QT_XCB_GL_INTEGRATION", "none");
	QQuickWindow::setSceneGraphBackend(QSGRendererInterface::Software);
}
