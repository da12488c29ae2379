#include "CoreGraphics/ShaderLibrary.h"

#include "CoreGraphics/ResourceRoot.h"
#include "CoreGraphics/Shader.h"
#include "CoreGraphics/ShaderProgram.h"
#include "DebugServices/Assert.h"

#include <QDirIterator>
#include <QFileInfo>
#include <QOpenGLContext>
#include <QPointer>

static void InitialiseShaderResources()
{
	// A static library's resources are linked only if they are asked for, and asked for outside of any namespace.
	Q_INIT_RESOURCE(Shaders);
}

namespace CoreGraphics
{

namespace
{

template <typename TMap>
std::vector<std::string> Names(const TMap& i_rMap)
{
	std::vector<std::string> names;
	names.reserve(i_rMap.size());
	for (const auto& [rName, rValue] : i_rMap)
		names.push_back(rName);
	return names;
}

} // namespace

struct VShaderLibrary::VGroup
{
	QPointer<QOpenGLContextGroup> m_pGroup;
};

VShaderLibrary::VShaderLibrary() : VShaderLibrary(VSettings{}) {}

VShaderLibrary::VShaderLibrary(VSettings i_Settings)
    : m_Settings(std::move(i_Settings)), m_pGroup(std::make_unique<VGroup>())
{
	if (m_Settings.m_ResourceRoot.empty())
		m_Settings.m_ResourceRoot = FindResourceRoot();
}

VShaderLibrary::~VShaderLibrary() = default;

void VShaderLibrary::InitialiseGL()
{
	QOpenGLContext* pContext = QOpenGLContext::currentContext();
	NVX_ASSERT(pContext != nullptr);
	if (!pContext || m_pGroup->m_pGroup == pContext->shareGroup())
		return;
	m_pGroup->m_pGroup = pContext->shareGroup();
	if (!m_VertexShaders.empty())
	{
		MakeAgain();
		return;
	}
	InitialiseShaderResources();
	if (m_Settings.m_bDevelopment)
	{
		for (const std::string& rFolder : m_Settings.m_SourceFolders)
			LoadAll(rFolder, false);
		LoadAll(":", true);
	}
	if (m_VertexShaders.empty())
		LoadAll(":", false);
}

void VShaderLibrary::LoadAll(const std::string& i_rFolder, bool i_bOnlyMissing)
{
	const auto load = [&](VShaders& io_rShaders, EShaderType i_Type, const char* i_pFolder)
	{
		QDirIterator files(QString::fromStdString(i_rFolder + i_pFolder), QDir::Files);
		while (files.hasNext())
		{
			const QFileInfo file(files.next());
			if (file.suffix() != QLatin1String("glsl"))
				continue;
			std::shared_ptr<VShader>& rpShader = io_rShaders[file.baseName().toStdString()];
			if (!rpShader || !i_bOnlyMissing)
				rpShader = std::make_shared<VShader>(i_Type, file.filePath().toStdString());
		}
	};
	load(m_VertexShaders, EShaderVertex, "/VertexShaders");
	load(m_FragmentShaders, EShaderFragment, "/FragmentShaders");
}

void VShaderLibrary::MakeAgain()
{
	for (VShaders* pShaders : {&m_VertexShaders, &m_FragmentShaders})
	{
		for (auto& [rName, rpShader] : *pShaders)
			rpShader->Compile();
	}
	for (auto& [rNames, rpProgram] : m_Programs)
		rpProgram->Link();
}

void VShaderLibrary::Reload()
{
	if (m_Settings.m_bDevelopment)
		MakeAgain();
}

std::shared_ptr<VShaderProgram> VShaderLibrary::GetProgram(const std::string& i_rVertex, const std::string& i_rFragment)
{
	const auto key = std::make_pair(i_rVertex, i_rFragment);
	if (const auto found = m_Programs.find(key); found != m_Programs.end())
		return found->second;
	const auto vertex = m_VertexShaders.find(i_rVertex);
	const auto fragment = m_FragmentShaders.find(i_rFragment);
	if (vertex == m_VertexShaders.end() || fragment == m_FragmentShaders.end())
		return {};
	return m_Programs[key] = std::make_shared<VShaderProgram>(vertex->second, fragment->second);
}

std::vector<std::string> VShaderLibrary::GetVertexShaderNames() const
{
	return Names(m_VertexShaders);
}

std::vector<std::string> VShaderLibrary::GetFragmentShaderNames() const
{
	return Names(m_FragmentShaders);
}

} // namespace CoreGraphics
