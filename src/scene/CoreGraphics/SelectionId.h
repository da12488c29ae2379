#pragma once

#include <cstdint>

namespace CoreGraphics
{

/// A selection id: the id itself, 0 for nothing, and flags that the outlines are drawn from.
enum ESelectionIdBits : std::uint32_t
{
	ESelectionIdMask = 0x1fffff,
	ESelectionIdSelected = 0x200000,
	/// Under the mouse.
	ESelectionIdPreselected = 0x400000,
	ESelectionIdPrimary = 0x800000
};

/// A selection id as a shader takes it: its low three bytes as a colour.
struct VSelectionId
{
	float m_Red = 0.0f;
	float m_Green = 0.0f;
	float m_Blue = 0.0f;
	std::uint32_t m_Id = 0;

	bool operator==(const VSelectionId&) const = default;
};
static_assert(sizeof(VSelectionId) == 16);

/// From the id with its flags.
VSelectionId MakeSelectionId(std::uint32_t i_Id);

} // namespace CoreGraphics
