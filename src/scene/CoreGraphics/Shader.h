#pragma once

#include <cstdint>
#include <memory>
#include <string>

class QOpenGLShader;

namespace CoreGraphics
{

enum EShaderType : std::uint32_t
{
	EShaderVertex = 0,
	EShaderFragment = 1
};

/// One shader, compiled from the text of a file. Every method needs the OpenGL context to be current.
class VShader
{
public:
	/// Compiles at once. What fails is told in the log category "CoreGraphics" and leaves the shader empty.
	/// @param i_rPath a file, or a Qt resource (":/...")
	VShader(EShaderType i_Type, const std::string& i_rPath);
	~VShader();

	/// Compiles the file as it is now, in the context that is current now.
	void Compile();

	/// What stands before the text of every file: the language's version, what all shaders of its type share, and lines
	/// that count from the file's first.
	static std::string Header(bool i_bOpenGLES, const std::string& i_rShared);

	bool IsEmpty() const { return !m_pShader; }
	EShaderType Type() const { return m_Type; }
	const std::string& Path() const { return m_Path; }
	/// Null if empty.
	QOpenGLShader* Get() const { return m_pShader.get(); }

private:
	EShaderType m_Type;
	std::string m_Path;
	std::unique_ptr<QOpenGLShader> m_pShader;
};

} // namespace CoreGraphics
