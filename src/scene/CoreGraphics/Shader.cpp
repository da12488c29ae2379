#include "CoreGraphics/Shader.h"

#include "DebugServices/GlobalLog.h"

#include <QFile>
#include <QOpenGLContext>
#include <QOpenGLShader>

namespace CoreGraphics
{

VShader::VShader(EShaderType i_Type, const std::string& i_rPath) : m_Type(i_Type), m_Path(i_rPath)
{
	Compile();
}

VShader::~VShader() = default;

const char* VShader::Header(bool i_bOpenGLES)
{
	// In GLSL 1.20 the number is that of the directive's own line, so that the text begins at 1 in both.
	return i_bOpenGLES ? "#version 100\n#ifdef GL_ES\nprecision mediump float;\n#endif\n#line 1\n"
	                   : "#version 120\n#ifdef GL_ES\nprecision mediump float;\n#endif\n#line 0\n";
}

void VShader::Compile()
{
	m_pShader.reset();
	NVX_LOG("CoreGraphics", NVX::ELogDetail, "Loading shader file %1%", m_Path);
	QFile file(QString::fromStdString(m_Path));
	if (!file.open(QIODevice::ReadOnly))
	{
		NVX_LOG("CoreGraphics", NVX::ELogError, "Failed to open %1%", m_Path);
		return;
	}
	const QOpenGLContext* pContext = QOpenGLContext::currentContext();
	auto pShader =
	    std::make_unique<QOpenGLShader>(m_Type == EShaderVertex ? QOpenGLShader::Vertex : QOpenGLShader::Fragment);
	const QByteArray source = Header(pContext && pContext->isOpenGLES()) + file.readAll();
	if (!pShader->compileSourceCode(source))
	{
		NVX_LOG("CoreGraphics", NVX::ELogError, "Shader Failed To Compile<%1%> Log=<%2%>", m_Path,
		    pShader->log().toStdString());
		return;
	}
	m_pShader = std::move(pShader);
}

} // namespace CoreGraphics
