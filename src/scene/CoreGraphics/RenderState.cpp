#include "CoreGraphics/RenderState.h"

namespace CoreGraphics
{

VRenderState MakeSelectionState(const VRenderState& i_rState)
{
	VRenderState state;
	state.m_Cull = i_rState.m_Cull;
	state.m_ColourBlend = EColourBlendOff;
	state.m_AlphaBlend = EAlphaBlendAdd;
	state.m_bDepthTest = true;
	state.m_DepthFunction = EDepthLessEqual;
	return state;
}

} // namespace CoreGraphics
