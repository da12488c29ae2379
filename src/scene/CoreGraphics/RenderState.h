#pragma once

#include <cstdint>

namespace CoreGraphics
{

/// Sources and destinations of colours.
enum EColourBlend : std::uint32_t
{
	/// GL_ONE, GL_ZERO
	EColourBlendOff,
	/// GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA
	EColourBlendAlpha,
	/// GL_SRC_ALPHA, GL_ONE
	EColourBlendAdd,
	/// GL_CONSTANT_ALPHA, GL_ONE
	EColourBlendAddConstant,
	/// GL_ONE, GL_ONE_MINUS_SRC_ALPHA
	EColourBlendPremultiplied
};

enum EAlphaBlend : std::uint32_t
{
	/// GL_ZERO, GL_ONE
	EAlphaBlendKeep,
	/// GL_ONE, GL_ONE
	EAlphaBlendAdd,
	/// GL_ONE, GL_ZERO
	EAlphaBlendReplace
};

enum ECull : std::uint32_t
{
	ECullOff,
	ECullFront,
	ECullBack
};

enum EDepthFunction : std::uint32_t
{
	EDepthLess,
	EDepthLessEqual,
	EDepthGreater,
	EDepthGreaterEqual,
	EDepthNotEqual,
	EDepthEqual
};

/// What VRenderContext::ApplyState sets: plain values, numbers beyond the enumerations included.
struct VRenderState
{
	/// EColourBlend.
	std::uint32_t m_ColourBlend = EColourBlendOff;
	/// EAlphaBlend.
	std::uint32_t m_AlphaBlend = EAlphaBlendKeep;
	/// ECull.
	std::uint32_t m_Cull = ECullOff;
	/// EDepthFunction.
	std::uint32_t m_DepthFunction = EDepthLess;
	/// Of EColourBlendAddConstant.
	float m_BlendConstant = 1.0f;
	bool m_bDepthTest = false;
	bool m_bDepthWrite = true;
	bool m_bColourWrite = true;
	bool m_bAlphaWrite = false;

	bool operator==(const VRenderState&) const = default;
};

/// For drawing ids where the state draws colours: it culls the same, overwrites, and tests and writes depth.
VRenderState MakeSelectionState(const VRenderState& i_rState);

} // namespace CoreGraphics
