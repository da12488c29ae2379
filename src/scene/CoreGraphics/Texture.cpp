#include "CoreGraphics/Texture.h"

#include "CoreGraphics/RenderContext.h"

#include <QImage>
#include <QOpenGLContext>
#include <QOpenGLFunctions>
#include <QPointer>

#include <algorithm>
#include <array>

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
#define GL_MAX_TEXTURE_MAX_ANISOTROPY_EXT 0x84FF
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

VTexture::VTexture(std::uint32_t i_InternalFormat, const QSize& i_Size, bool i_bMipmaps)
    : m_pObject(std::make_unique<VObject>()), m_InternalFormat(i_InternalFormat), m_Size(i_Size), m_bMipmaps(i_bMipmaps)
{
	QOpenGLContext* pContext = QOpenGLContext::currentContext();
	QOpenGLFunctions& rGL = Functions();
	m_pObject->m_pGroup = pContext->shareGroup();
	rGL.glGenTextures(1, &m_pObject->m_Texture);
	if (pContext->isOpenGLES())
		return;
	rGL.glBindTexture(GL_TEXTURE_2D, m_pObject->m_Texture);
	const VUpload upload = UploadOf(m_InternalFormat);
	rGL.glTexImage2D(GL_TEXTURE_2D, 0, static_cast<GLint>(m_InternalFormat), m_Size.width(), m_Size.height(), 0,
	    upload.m_Format, upload.m_Type, nullptr);
}

VTexture::~VTexture()
{
	const QOpenGLContext* pContext = QOpenGLContext::currentContext();
	if (pContext && m_pObject->m_pGroup == pContext->shareGroup())
		Functions().glDeleteTextures(1, &m_pObject->m_Texture);
}

std::shared_ptr<VTexture> VTexture::FromImage(const QImage& i_rImage)
{
	if (i_rImage.isNull())
		return {};
	const QImage image = i_rImage.convertToFormat(QImage::Format_RGBA8888);
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
	if (i_rSampling.m_Anisotropy > 1.0f && io_rContext.m_pContext->hasExtension("GL_EXT_texture_filter_anisotropic"))
	{
		float most = 1.0f;
		rGL.glGetFloatv(GL_MAX_TEXTURE_MAX_ANISOTROPY_EXT, &most);
		rGL.glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_MAX_ANISOTROPY_EXT, std::min(i_rSampling.m_Anisotropy, most));
	}
}

} // namespace CoreGraphics
