#pragma once

class QQuickWindow;
class QSGNode;
class QSizeF;

namespace OrlexGraphics
{

/// Whether Qt Quick draws this window with OpenGL. Without it a view has nothing to draw with.
bool HasOpenGL(QQuickWindow& i_rWindow);

/// A sentence that says so, in the middle of a view. On the thread and at the time of updatePaintNode.
/// @param io_pNode what this gave the last time, null for none
QSGNode* UpdateNoOpenGLNode(QSGNode* io_pNode, QQuickWindow& i_rWindow, const QSizeF& i_rSize);

} // namespace OrlexGraphics
