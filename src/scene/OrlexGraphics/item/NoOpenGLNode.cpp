#include "OrlexGraphics/item/NoOpenGLNode.h"

#include <QImage>
#include <QPainter>
#include <QQuickWindow>
#include <QSGImageNode>
#include <QSGRendererInterface>

namespace OrlexGraphics
{

namespace
{

constexpr const char* c_pSentence = "The 3D view needs OpenGL, which is not available on this display.";

} // namespace

bool HasOpenGL(QQuickWindow& i_rWindow)
{
	return i_rWindow.rendererInterface()->graphicsApi() == QSGRendererInterface::OpenGL;
}

QSGNode* UpdateNoOpenGLNode(QSGNode* io_pNode, QQuickWindow& i_rWindow, const QSizeF& i_rSize)
{
	auto* pNode = static_cast<QSGImageNode*>(io_pNode);
	if (i_rSize.isEmpty())
	{
		delete pNode;
		return nullptr;
	}
	if (pNode && pNode->rect().size() == i_rSize)
		return pNode;
	if (!pNode)
	{
		pNode = i_rWindow.createImageNode();
		pNode->setOwnsTexture(true);
	}
	const double ratio = i_rWindow.effectiveDevicePixelRatio();
	QImage image((i_rSize * ratio).toSize().expandedTo(QSize(1, 1)), QImage::Format_RGB32);
	image.setDevicePixelRatio(ratio);
	image.fill(QColor(0x20, 0x20, 0x20));
	QPainter painter(&image);
	painter.setPen(QColor(0xc0, 0xc0, 0xc0));
	painter.drawText(QRectF(QPointF(), i_rSize).adjusted(8, 8, -8, -8), Qt::AlignCenter | Qt::TextWordWrap,
	    QString::fromLatin1(c_pSentence));
	painter.end();
	pNode->setTexture(i_rWindow.createTextureFromImage(image));
	pNode->setRect(QRectF(QPointF(), i_rSize));
	return pNode;
}

} // namespace OrlexGraphics
