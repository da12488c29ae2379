#include "CoreGraphics/ShaderProgram.h"

#include "CoreGraphics/Shader.h"
#include "DebugServices/GlobalLog.h"

#include <QOpenGLShader>
#include <QOpenGLShaderProgram>

#include <atomic>

namespace CoreGraphics
{

const std::array<const char*, EStandardUniformCount> c_StandardUniformNames = {"u_ViewProjection", "u_View",
    "u_Projection", "u_View2D", "u_ViewportSize", "u_ViewportOffset", "u_FrameSize", "u_LightVector", "u_Up",
    "u_GlobalTime", "u_CameraPosition", "u_RadialDistortionCentre", "u_RadialDistortionParameters", "u_SensorSize"};

const std::array<const char*, EAttributeCount> c_AttributeNames = {
    "a_position", "a_normal", "a_colour", "a_uv", "a_BoneIndices", "a_BoneWeights"};

VShaderProgram::VShaderProgram(std::shared_ptr<VShader> i_pVertex, std::shared_ptr<VShader> i_pFragment)
    : m_pVertex(std::move(i_pVertex)), m_pFragment(std::move(i_pFragment))
{
	Link();
}

VShaderProgram::~VShaderProgram() = default;

void VShaderProgram::Link()
{
	static std::atomic<std::uint64_t> s_LinkNumber{0};

	m_pProgram.reset();
	m_LinkNumber = 0;
	m_UniformLocations.fill(-1);
	m_AttributeLocations.fill(-1);
	if (m_pVertex->IsEmpty() || m_pFragment->IsEmpty())
		return;
	auto pProgram = std::make_unique<QOpenGLShaderProgram>();
	pProgram->addShader(m_pVertex->Get());
	pProgram->addShader(m_pFragment->Get());
	// One place for each attribute in all programs: what is enabled for one serves the next.
	for (std::size_t attribute = 0; attribute < EAttributeCount; ++attribute)
		pProgram->bindAttributeLocation(c_AttributeNames[attribute], static_cast<int>(attribute));
	if (!pProgram->link() || !pProgram->bind())
	{
		NVX_LOG("CoreGraphics", NVX::ELogError, "Shaders <%1%> and <%2%> cannot be linked: %3%", m_pVertex->Path(),
		    m_pFragment->Path(), pProgram->log().toStdString());
		return;
	}
	for (std::size_t uniform = 0; uniform < EStandardUniformCount; ++uniform)
		m_UniformLocations[uniform] = pProgram->uniformLocation(c_StandardUniformNames[uniform]);
	for (std::size_t attribute = 0; attribute < EAttributeCount; ++attribute)
		m_AttributeLocations[attribute] = pProgram->attributeLocation(c_AttributeNames[attribute]);
	pProgram->release();
	m_pProgram = std::move(pProgram);
	m_LinkNumber = ++s_LinkNumber;
}

int VShaderProgram::GetUniformLocation(const char* i_pName) const
{
	return m_pProgram ? m_pProgram->uniformLocation(i_pName) : -1;
}

} // namespace CoreGraphics
