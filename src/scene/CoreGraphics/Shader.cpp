#include "CoreGraphics/Shader.h"

#include "DebugServices/GlobalLog.h"

#include <QDir>
#include <QFile>
#include <QOpenGLContext>
#include <QOpenGLShader>

namespace CoreGraphics
{

namespace
{

/// What all shaders of a type share, of the folder that the shader is in, or the resources' own.
std::string ReadShared(EShaderType i_Type, const std::string& i_rPath)
{
	const QString name =
	    i_Type == EShaderVertex ? QStringLiteral("Shared/Vertex.glsl") : QStringLiteral("Shared/Fragment.glsl");
	const QDir folder = QFileInfo(QString::fromStdString(i_rPath)).dir();
	for (const QString& rPath : {folder.filePath("../" + name), ":/" + name})
		if (QFile file(QDir::cleanPath(rPath)); file.open(QIODevice::ReadOnly))
			return file.readAll().toStdString();
	return {};
}

} // namespace

VShader::VShader(EShaderType i_Type, const std::string& i_rPath) : m_Type(i_Type), m_Path(i_rPath)
{
	Compile();
}

VShader::~VShader() = default;

std::string VShader::Header(bool i_bOpenGLES, const std::string& i_rShared)
{
	// In GLSL 1.20 the number is that of the directive's own line, so that the text begins at 1 in both. What is shared
	// counts as another file.
	const std::string line = i_bOpenGLES ? "#line 1" : "#line 0";
	return std::string(i_bOpenGLES ? "#version 100\n" : "#version 120\n")
	    + "#ifdef GL_ES\nprecision mediump float;\n#endif\n" + line + " 1\n" + i_rShared + line + " 0\n";
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
	const std::string header = Header(pContext && pContext->isOpenGLES(), ReadShared(m_Type, m_Path));
	if (!pShader->compileSourceCode(QByteArray::fromStdString(header) + file.readAll()))
	{
		NVX_LOG("CoreGraphics", NVX::ELogError, "Shader Failed To Compile<%1%> Log=<%2%>", m_Path,
		    pShader->log().toStdString());
		return;
	}
	m_pShader = std::move(pShader);
}

} // namespace CoreGraphics
