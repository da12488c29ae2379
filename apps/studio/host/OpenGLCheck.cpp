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
	QOpenGLContext context;
	const bool bOpenGL = QQuickWindow::sceneGraphBackend() != QLatin1String("software") && context.create()
	    && context.makeCurrent(&surface);
	// Each blink draws a whole panel.
	if (!bOpenGL || CoreGraphics::IsSoftware(*context.functions()))
		QGuiApplication::styleHints()->setCursorFlashTime(0);
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
