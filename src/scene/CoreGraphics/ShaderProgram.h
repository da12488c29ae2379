#pragma once

#include "CoreGraphics/VertexFormat.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>

class QOpenGLShaderProgram;

namespace CoreGraphics
{

class VShader;

/// The uniforms that VRenderContext::UseProgram writes, in the order of VShaderProgram's table.
enum EStandardUniform : std::size_t
{
	EUniformViewProjection,
	EUniformView,
	EUniformProjection,
	EUniformView2D,
	EUniformViewportSize,
	EUniformViewportOffset,
	EUniformFrameSize,
	EUniformLightVector,
	EUniformUp,
	EUniformGlobalTime,
	EUniformCameraPosition,
	EUniformRadialDistortionCentre,
	EUniformRadialDistortionParameters,
	EUniformSensorSize,
	EStandardUniformCount
};

extern const std::array<const char*, EStandardUniformCount> c_StandardUniformNames;
extern const std::array<const char*, EAttributeCount> c_AttributeNames;

/// A vertex and a fragment shader linked together. Every method that is not a getter needs the OpenGL context.
class VShaderProgram
{
public:
	/// Links at once. Stays empty if a shader is empty or the link fails; the latter is told in the log.
	VShaderProgram(std::shared_ptr<VShader> i_pVertex, std::shared_ptr<VShader> i_pFragment);
	~VShaderProgram();

	/// Links what the shaders are now, in the context that is current now.
	void Link();

	bool IsEmpty() const { return !m_pProgram; }
	/// Null if empty.
	QOpenGLShaderProgram* Get() const { return m_pProgram.get(); }
	/// -1 if this program does not use it.
	int UniformLocation(EStandardUniform i_Uniform) const { return m_UniformLocations[i_Uniform]; }
	/// @param i_Attribute EAttribute
	/// @return -1 if this program does not use it, or if there is no such attribute
	int AttributeLocation(std::size_t i_Attribute) const
	{
		return i_Attribute < EAttributeCount ? m_AttributeLocations[i_Attribute] : -1;
	}
	/// Of any uniform, looked up by name: once per step at most, see VUniform. -1 if this program does not use it.
	int GetUniformLocation(const char* i_pName) const;

	/// A number that no other link of the process has; 0 if empty. Locations hold for as long as it stays.
	std::uint64_t LinkNumber() const { return m_LinkNumber; }

private:
	std::unique_ptr<QOpenGLShaderProgram> m_pProgram;
	std::shared_ptr<VShader> m_pVertex;
	std::shared_ptr<VShader> m_pFragment;
	std::array<int, EStandardUniformCount> m_UniformLocations;
	std::array<int, EAttributeCount> m_AttributeLocations;
	std::uint64_t m_LinkNumber = 0;
};

} // namespace CoreGraphics
