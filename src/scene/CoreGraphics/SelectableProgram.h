#pragma once

#include "CoreGraphics/SelectionId.h"
#include "CoreGraphics/Uniform.h"

#include <memory>
#include <string>

namespace CoreGraphics
{

class VRenderContext;
class VShaderLibrary;
class VShaderProgram;

/// A program, and its partner that writes selection ids where the program writes colours.
class VSelectableProgram
{
public:
	/// Programs of unknown names are empty; VRenderContext::UseProgram is false for them.
	static VSelectableProgram Make(
	    VShaderLibrary& io_rLibrary, const std::string& i_rVertex, const std::string& i_rFragment);

	const std::shared_ptr<VShaderProgram>& Get(bool i_bSelection) const
	{
		return i_bSelection ? m_pSelection : m_pNormal;
	}

	/// For the draws that follow, with the selection program in use.
	void SetId(VRenderContext& io_rContext, const VSelectionId& i_rId);

private:
	std::shared_ptr<VShaderProgram> m_pNormal;
	std::shared_ptr<VShaderProgram> m_pSelection;
	VUniform m_SelectionId{"u_SelectionId"};
};

} // namespace CoreGraphics
