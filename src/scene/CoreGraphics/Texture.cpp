#include "CoreGraphics/Texture.h"

#include "CoreGraphics/RenderContext.h"

#include <QImage>
#include <QOpenGLContext>
#include <QOpenGLFunctions>
#include <QPointer>

#include <algorithm>
#include <array>
#include <mutex>
#include <utility>
#include <vector>

#ifndef GL_R8
#define GL_R8 0x8229
#endif
#ifndef GL_R32F
#define GL_R32F 0x822E
#endif
#ifndef GL_RGB565
#define GL_RGB565 0x8D62
#endif
#ifndef GL_RGB8
#define GL_RGB8 0x8051
#endif
#ifndef GL_RGBA8
#define GL_RGBA8 0x8058
#endif
#ifndef GL_RED
#define GL_RED 0x1903
#endif
#ifndef GL_TEXTURE_MAX_ANISOTROPY_EXT
#define GL_TEXTURE_MAX_ANISOTROPY_EXT 0x84FE
#endif

namespace CoreGraphics
{

namespace
{

struct VUpload
{
	GLenum m_Format;
	GLenum m_Type;
};

VUpload UploadOf(std::uint32_t i_InternalFormat)
{
	switch (i_InternalFormat)
	{
	case GL_RGB8: return {GL_RGB, GL_UNSIGNED_BYTE};
	case GL_RGBA8: return {GL_RGBA, GL_UNSIGNED_BYTE};
	case GL_RGB565: return {GL_RGB, GL_UNSIGNED_SHORT_5_6_5};
	case GL_R32F: return {GL_RED, GL_FLOAT};
	default: return {GL_LUMINANCE, GL_UNSIGNED_BYTE};
	}
}

constexpr std::array<GLint, 4> c_Minifications = {
    GL_NEAREST_MIPMAP_NEAREST, GL_LINEAR_MIPMAP_NEAREST, GL_LINEAR_MIPMAP_LINEAR, GL_NEAREST};

QOpenGLFunctions& Functions()
{
	return *QOpenGLContext::currentContext()->functions();
}

} // namespace

VTextureForm FormOf(EPixelFormat i_Format)
{
	const auto format = static_cast<std::uint32_t>(i_Format);
	if ((format >= 1 && format <= 5) || (format >= 14 && format <= 17))
		return {GL_R8, 1};
	if (format == 6)
		return {GL_RGB565, 1};
	if (format == 7 || format == 8)
		return {GL_RGB8, 1};
	if (format == 9 || format == 10)
		return {GL_RGBA8, 1};
	if (format >= 11 && format <= 13)
		return {GL_RGBA8, 2};
	return {};
}

struct VTexture::VObject
{
	GLuint m_Texture = 0;
	QPointer<QOpenGLContextGroup> m_pGroup;
};

namespace
{

/// Textures whose owners had no context when they let go of them.
struct VReleased
{
	std::mutex m_Mutex;
	std::vector<std::pair<QPointer<QOpenGLContextGroup>, GLuint>> m_Textures;
};

VReleased& Released()
{
	static VReleased s_Released;
	return s_Released;
}

} // namespace

void VTexture::DeleteReleased()
{
	VReleased& rReleased = Released();
	const std::lock_guard lock(rReleased.m_Mutex);
	// Those of a group that is gone went with it.
	std::erase_if(rReleased.m_Textures,
	    [&](const auto& i_rTexture)
	    {
		    const bool bHere = i_rTexture.first == QOpenGLContext::currentContext()->shareGroup();
		    if (bHere)
			    Functions().glDeleteTextures(1, &i_rTexture.second);
		    return bHere || !i_rTexture.first;
	    });
}

VTexture::VTexture(std::uint32_t i_InternalFormat, const QSize& i_Size, bool i_bMipmaps)
    : m_pObject(std::make_unique<VObject>()), m_InternalFormat(i_InternalFormat), m_Size(i_Size), m_bMipmaps(i_bMipmaps)
{
	DeleteReleased();
	QOpenGLContext* const pContext = QOpenGLContext::currentContext();
	QOpenGLFunctions& rGL = Functions();
	m_pObject->m_pGroup = pContext->shareGroup();
	rGL.glGenTextures(1, &m_pObject->m_Texture);
	if (pContext->isOpenGLES())
		return;
	rGL.glBindTexture(GL_TEXTURE_2D, m_pObject->m_Texture);
	const VUpload upload = UploadOf(m_InternalFormat);
	// OpenGL 2.1 itself has no textures of one channel.
	const bool bOneChannel = pContext->format().majorVersion() >= 3 || pContext->hasExtension("GL_ARB_texture_rg");
	const GLenum internalFormat = m_InternalFormat == GL_R8 && !bOneChannel ? GL_LUMINANCE : m_InternalFormat;
	rGL.glTexImage2D(GL_TEXTURE_2D, 0, static_cast<GLint>(internalFormat), m_Size.width(), m_Size.height(), 0,
	    upload.m_Format, upload.m_Type, nullptr);
}

VTexture::~VTexture()
{
	if (IsUsable())
	{
		Functions().glDeleteTextures(1, &m_pObject->m_Texture);
		return;
	}
	const std::lock_guard lock(Released().m_Mutex);
	Released().m_Textures.emplace_back(m_pObject->m_pGroup, m_pObject->m_Texture);
}

bool VTexture::IsUsable() const
{
	const QOpenGLContext* const pContext = QOpenGLContext::currentContext();
	return pContext && m_pObject->m_pGroup == pContext->shareGroup();
}

std::shared_ptr<VTexture> VTexture::FromImage(const QImage& i_rImage)
{
	if (i_rImage.isNull())
		return {};
	QImage image = i_rImage.convertToFormat(QImage::Format_RGBA8888);
	GLint largest = 0;
	Functions().glGetIntegerv(GL_MAX_TEXTURE_SIZE, &largest);
	if (image.width() > largest || image.height() > largest)
		image = image.scaled(
		    image.size().boundedTo(QSize(largest, largest)), Qt::IgnoreAspectRatio, Qt::SmoothTransformation);
	auto pTexture = std::make_shared<VTexture>(GL_RGBA8, image.size(), true);
	// Rows of four-byte texels have no padding.
	pTexture->Upload(image.constBits());
	return pTexture;
}

void VTexture::Upload(const void* i_pTexels)
{
	QOpenGLFunctions& rGL = Functions();
	const VUpload upload = UploadOf(m_InternalFormat);
	rGL.glBindTexture(GL_TEXTURE_2D, m_pObject->m_Texture);
	rGL.glPixelStorei(GL_UNPACK_ALIGNMENT, 1);
	// OpenGL ES 2.0 takes its internal format from the texels.
	if (QOpenGLContext::currentContext()->isOpenGLES())
		rGL.glTexImage2D(GL_TEXTURE_2D, 0, static_cast<GLint>(upload.m_Format), m_Size.width(), m_Size.height(), 0,
		    upload.m_Format, upload.m_Type, i_pTexels);
	else
		rGL.glTexSubImage2D(
		    GL_TEXTURE_2D, 0, 0, 0, m_Size.width(), m_Size.height(), upload.m_Format, upload.m_Type, i_pTexels);
	rGL.glPixelStorei(GL_UNPACK_ALIGNMENT, 4);
	if (m_bMipmaps)
		rGL.glGenerateMipmap(GL_TEXTURE_2D);
}

void VTexture::Bind(VRenderContext& io_rContext, unsigned int i_Unit, const VTextureSampling& i_rSampling)
{
	QOpenGLFunctions& rGL = *io_rContext.m_pFunctions;
	rGL.glActiveTexture(GL_TEXTURE0 + i_Unit);
	rGL.glBindTexture(GL_TEXTURE_2D, m_pObject->m_Texture);
	if (m_bSampled && i_rSampling == m_Sampling)
		return;
	m_Sampling = i_rSampling;
	m_bSampled = true;
	const auto set = [&](GLenum i_Name, GLint i_Value) { rGL.glTexParameteri(GL_TEXTURE_2D, i_Name, i_Value); };
	set(GL_TEXTURE_MIN_FILTER,
	    c_Minifications[i_rSampling.m_Minification < c_Minifications.size() ? i_rSampling.m_Minification : 0]);
	set(GL_TEXTURE_MAG_FILTER, i_rSampling.m_bMagnificationLinear ? GL_LINEAR : GL_NEAREST);
	set(GL_TEXTURE_WRAP_S, i_rSampling.m_bClampS ? GL_CLAMP_TO_EDGE : GL_REPEAT);
	set(GL_TEXTURE_WRAP_T, i_rSampling.m_bClampT ? GL_CLAMP_TO_EDGE : GL_REPEAT);
	if (io_rContext.m_MostAnisotropy > 1.0f)
		rGL.glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_MAX_ANISOTROPY_EXT,
		    std::clamp(i_rSampling.m_Anisotropy, 1.0f, io_rContext.m_MostAnisotropy));
}

} // namespace CoreGraphics
