#pragma once

#include <QSize>

#include <memory>

class QOpenGLFramebufferObjectFormat;
class QSGGeometryNode;

namespace OrlexGraphics
{

/// A framebuffer whose samples stay in a texture: what shows it takes the mean of each pixel's samples itself, instead
/// of a copy that the driver makes of them in between. With the context current; to be released in it.
class VSamples
{
public:
	/// Whether the current context has textures of samples, and shaders that read them.
	static bool AreReadable();

	VSamples() = default;
	VSamples(const VSamples&) = delete;
	VSamples& operator=(const VSamples&) = delete;

	/// Of this size, with colour and depth; none for a format of one sample a pixel, or where there is no room.
	void Make(const QSize& i_rSize, const QOpenGLFramebufferObjectFormat& i_rFormat);
	/// Needs the context that they were made in, where framebuffers have their names: what still holds them shows
	/// nothing.
	void Release();
	bool AreThere() const { return m_Framebuffer != 0; }
	const QSize& Size() const { return m_Size; }
	unsigned int Framebuffer() const { return m_Framebuffer; }
	unsigned int Texture() const { return m_Texture; }

private:
	QSize m_Size;
	unsigned int m_Framebuffer = 0;
	unsigned int m_Texture = 0;
	unsigned int m_Depth = 0;
};

/// Lets the node, which is textured, show the samples; what it shows by itself where there are none. On the thread and
/// at the time of updatePaintNode.
void ShowSamples(QSGGeometryNode& io_rNode, const std::shared_ptr<const VSamples>& i_rpSamples);

} // namespace OrlexGraphics
