#include "studio/host/OpenGLCheck.h"

#include "CoreGraphics/RenderContext.h"
#include "DebugServices/GlobalLog.h"

#include <QGuiApplication>
#include <QOffscreenSurface>
#include <QOpenGLContext>
#include <QQuickWindow>
#include <QStyleHints>

namespace StudioHost
{

bool CheckOpenGL()
{
	QOffscreenSurface surface;
	surface.create();
	// One that is there already costs nothing.
	QOpenGLContext own;
	QOpenGLContext* const pShared = QOpenGLContext::globalShareContext();
	QOpenGLContext& rContext = pShared ? *pShared : own;
	const bool bOpenGL = QQuickWindow::sceneGraphBackend() != QLatin1String("software") && (pShared || own.create())
	    && rContext.isValid() && rContext.makeCurrent(&surface);
	// Each blink draws a whole panel.
	if (!bOpenGL || CoreGraphics::IsSoftware(*rContext.functions()))
		QGuiApplication::styleHints()->setCursorFlashTime(0);
	rContext.doneCurrent();
	if (bOpenGL)
		return true;
	NVX_LOG("CoreGraphics", NVX::ELogWarning,
	    "This display (%1%) has no OpenGL: the preview stays empty, all else works. On a remote screen, "
	    "LIBGL_ALWAYS_SOFTWARE=1 may help",
	    QGuiApplication::platformName().toStdString());
	QQuickWindow::setSceneGraphBackend(QSGRendererInterface::Software);
	return false;
}

} // namespace StudioHost
