#pragma once

#include <array>
#include <cstdint>

namespace CoreGraphics
{

class VShaderProgram;

/// A uniform by its name, with its places in the last programs that it was used with: two, for what is drawn and what
/// is picked. Looked up by name only when a program is new or was linked again. VRenderContext::SetUniform writes it.
class VUniform
{
public:
	/// @param i_pName a text that lives as long as this
	explicit constexpr VUniform(const char* i_pName) : m_pName(i_pName) {}

	/// -1 if the program does not use it.
	int LocationIn(const VShaderProgram& i_rProgram);

private:
	struct VPlace
	{
		std::uint64_t m_LinkNumber = 0;
		int m_Location = -1;
	};

	const char* m_pName;
	std::array<VPlace, 2> m_Places;
	std::uint32_t m_Next = 0;
};

} // namespace CoreGraphics
