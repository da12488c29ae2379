#pragma once

#include <cstdint>
#include <string>

namespace NVX
{

/// What can be selected or pointed at: a row of a list and the object in the preview that it stands for are one item.
struct ISelectionItem
{
	/// What the element index counts, see ESelectionKind.
	std::uint32_t m_Kind = 0;
	std::uint32_t m_SubjectId = 0;
	std::uint32_t m_ElementIndex = 0;
	std::string m_Name;

	bool operator==(const ISelectionItem&) const = default;
};

enum ESelectionKind : std::uint32_t
{
	ESelectionSourceSegment = 11,
	ESelectionTargetSegment = 14,
	ESelectionTarget = 16
};

} // namespace NVX
