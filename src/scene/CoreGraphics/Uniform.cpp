#include "CoreGraphics/Uniform.h"

#include "CoreGraphics/ShaderProgram.h"

namespace CoreGraphics
{

int VUniform::LocationIn(const VShaderProgram& i_rProgram)
{
	for (const VPlace& rPlace : m_Places)
	{
		if (rPlace.m_LinkNumber == i_rProgram.LinkNumber())
			return rPlace.m_Location;
	}
	VPlace& rPlace = m_Places[m_Next];
	m_Next = std::uint32_t((m_Next + 1) % m_Places.size());
	rPlace = {i_rProgram.LinkNumber(), i_rProgram.GetUniformLocation(m_pName)};
	return rPlace.m_Location;
}

} // namespace CoreGraphics
