#include "OrlexGraphics/item/Samples.h"

#include <QOpenGLContext>
#include <QOpenGLExtraFunctions>
#include <QOpenGLFramebufferObject>
#include <QOpenGLShaderProgram>
#include <QSGMaterial>
#include <QSGNode>

#include <functional>
#include <utility>

namespace OrlexGraphics
{

namespace
{

/// As many as the shader takes the mean of.
constexpr int c_MeanOf = 4;

constexpr const char* c_pVertexShader = R"(#version 150
uniform mat4 u_Matrix;
uniform vec2 u_Size;

in vec4 a_position;
in vec2 a_uv;

out vec2 v_Pixel;

void main()
{
	v_Pixel = a_uv * u_Size;
	gl_Position = u_Matrix * a_position;
}
)";

constexpr const char* c_pFragmentShader = R"(#version 150
uniform sampler2DMS t_Samples;
uniform float u_Opacity;

in vec2 v_Pixel;

out vec4 o_Colour;

void main()
{
	ivec2 pixel = ivec2(v_Pixel);
	vec4 sum = texelFetch(t_Samples, pixel, 0) + texelFetch(t_Samples, pixel, 1) + texelFetch(t_Samples, pixel, 2)
		+ texelFetch(t_Samples, pixel, 3);
	o_Colour = sum * (0.25 * u_Opacity);
}
)";

class VSamplesShader : public QSGMaterialShader
{
	const char* vertexShader() const override { return c_pVertexShader; }
	const char* fragmentShader() const override { return c_pFragmentShader; }
	const char* const* attributeNames() const override
	{
		static const char* const s_Names[] = {"a_position", "a_uv", nullptr};
		return s_Names;
	}
	void initialize() override
	{
		m_Matrix = program()->uniformLocation("u_Matrix");
		m_Opacity = program()->uniformLocation("u_Opacity");
		m_Size = program()->uniformLocation("u_Size");
	}
	void updateState(const RenderState& i_rState, QSGMaterial* i_pNew, QSGMaterial* i_pOld) override;

	int m_Matrix = -1;
	int m_Opacity = -1;
	int m_Size = -1;
};

class VSamplesMaterial : public QSGMaterial
{
public:
	VSamplesMaterial(std::shared_ptr<const VSamples> i_pSamples, QSGMaterial* i_pInstead, bool i_bBlended)
	    : m_pSamples(std::move(i_pSamples)), m_pInstead(i_pInstead)
	{
		setFlag(Blending, i_bBlended);
	}

	static QSGMaterialType* Type()
	{
		static QSGMaterialType s_Type;
		return &s_Type;
	}
	QSGMaterialType* type() const override { return Type(); }
	QSGMaterialShader* createShader() const override { return new VSamplesShader; }
	int compare(const QSGMaterial* i_pOther) const override
	{
		const VSamples* const pOther = static_cast<const VSamplesMaterial*>(i_pOther)->m_pSamples.get();
		return std::less<>()(m_pSamples.get(), pOther) ? -1 : m_pSamples.get() != pOther;
	}

	const std::shared_ptr<const VSamples> m_pSamples;
	/// What the node has by itself.
	QSGMaterial* const m_pInstead;
};

void VSamplesShader::updateState(const RenderState& i_rState, QSGMaterial* i_pNew, QSGMaterial* /*i_pOld*/)
{
	const VSamples& rSamples = *static_cast<VSamplesMaterial*>(i_pNew)->m_pSamples;
	i_rState.context()->functions()->glBindTexture(GL_TEXTURE_2D_MULTISAMPLE, rSamples.Texture());
	program()->setUniformValue(m_Size, QSizeF(rSamples.Size()));
	if (i_rState.isMatrixDirty())
		program()->setUniformValue(m_Matrix, i_rState.combinedMatrix());
	if (i_rState.isOpacityDirty())
		program()->setUniformValue(m_Opacity, i_rState.opacity());
}

} // namespace

bool VSamples::AreReadable()
{
	const QOpenGLContext& rContext = *QOpenGLContext::currentContext();
	const QSurfaceFormat format = rContext.format();
	return !rContext.isOpenGLES() && format.profile() != QSurfaceFormat::CoreProfile
	    && format.version() >= qMakePair(3, 2)
	    && (format.version() >= qMakePair(4, 3) || rContext.hasExtension("GL_ARB_texture_storage_multisample"));
}

void VSamples::Release()
{
	if (QOpenGLContext* const pContext = QOpenGLContext::currentContext())
	{
		QOpenGLFunctions& rGL = *pContext->functions();
		rGL.glDeleteFramebuffers(1, &m_Framebuffer);
		rGL.glDeleteTextures(1, &m_Texture);
		rGL.glDeleteRenderbuffers(1, &m_Depth);
	}
	m_Framebuffer = m_Texture = m_Depth = 0;
}

void VSamples::Make(const QSize& i_rSize, const QOpenGLFramebufferObjectFormat& i_rFormat)
{
	Release();
	if (i_rFormat.samples() != c_MeanOf)
		return;
	m_Size = i_rSize;
	QOpenGLExtraFunctions& rGL = *QOpenGLContext::currentContext()->extraFunctions();
	rGL.glGenTextures(1, &m_Texture);
	rGL.glBindTexture(GL_TEXTURE_2D_MULTISAMPLE, m_Texture);
	rGL.glTexStorage2DMultisample(
	    GL_TEXTURE_2D_MULTISAMPLE, c_MeanOf, GL_RGB8, i_rSize.width(), i_rSize.height(), GL_TRUE);
	rGL.glBindTexture(GL_TEXTURE_2D_MULTISAMPLE, 0);
	rGL.glGenRenderbuffers(1, &m_Depth);
	rGL.glBindRenderbuffer(GL_RENDERBUFFER, m_Depth);
	rGL.glRenderbufferStorageMultisample(
	    GL_RENDERBUFFER, c_MeanOf, GL_DEPTH_COMPONENT24, i_rSize.width(), i_rSize.height());
	rGL.glBindRenderbuffer(GL_RENDERBUFFER, 0);
	GLint before = 0;
	rGL.glGetIntegerv(GL_FRAMEBUFFER_BINDING, &before);
	rGL.glGenFramebuffers(1, &m_Framebuffer);
	rGL.glBindFramebuffer(GL_FRAMEBUFFER, m_Framebuffer);
	rGL.glFramebufferTexture2D(GL_FRAMEBUFFER, GL_COLOR_ATTACHMENT0, GL_TEXTURE_2D_MULTISAMPLE, m_Texture, 0);
	rGL.glFramebufferRenderbuffer(GL_FRAMEBUFFER, GL_DEPTH_ATTACHMENT, GL_RENDERBUFFER, m_Depth);
	const bool bComplete = rGL.glCheckFramebufferStatus(GL_FRAMEBUFFER) == GL_FRAMEBUFFER_COMPLETE;
	rGL.glBindFramebuffer(GL_FRAMEBUFFER, static_cast<GLuint>(before));
	if (!bComplete)
		Release();
}

void ShowSamples(QSGGeometryNode& io_rNode, const std::shared_ptr<const VSamples>& i_rpSamples)
{
	const bool bShown = io_rNode.material()->type() == VSamplesMaterial::Type();
	if (bShown == i_rpSamples->AreThere())
		return;
	const auto instead = [&](QSGMaterial* i_pMaterial, bool i_bBlended) -> QSGMaterial*
	{
		if (bShown)
			return static_cast<VSamplesMaterial*>(i_pMaterial)->m_pInstead;
		return new VSamplesMaterial(i_rpSamples, i_pMaterial, i_bBlended);
	};
	// A node deletes the material that it owns when it is given another.
	io_rNode.setMaterial(instead(io_rNode.material(), true));
	io_rNode.setOpaqueMaterial(instead(io_rNode.opaqueMaterial(), false));
	io_rNode.setFlags(QSGNode::OwnsMaterial | QSGNode::OwnsOpaqueMaterial, !bShown);
}

} // namespace OrlexGraphics
