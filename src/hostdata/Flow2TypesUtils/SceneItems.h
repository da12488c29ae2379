#pragma once

#include <array>
#include <cstdint>
#include <map>
#include <utility>

/// What items of the scene itself carry through the flow. These flow types have no tag in the catalogue.
namespace Flow2TypesUtils
{

/// Where each subject stands, for scenes in which several stand side by side.
struct FlowSubjectSceneTransformItem
{
	static constexpr const char* c_pName = "FlowSubjectSceneTransform";

	/// Tag of the item that carries the subject, and the subject's id.
	using VKey = std::pair<std::uint32_t, std::uint32_t>;

	/// Millimetres.
	std::map<VKey, std::array<double, 3>> m_Translations;
	/// Of the floor below them: minimum x, maximum x, minimum row, maximum row, in millimetres. Rows lie along Y when
	/// Z is up, along Z when Y is up.
	std::array<std::int32_t, 4> m_Extents{};

	bool operator==(const FlowSubjectSceneTransformItem&) const = default;
};

/// Which axis of the world is up.
struct FlowUpAxisItem
{
	static constexpr const char* c_pName = "FlowUpAxis";
	static constexpr std::uint32_t c_Y = 1;

	/// c_Y, or anything else for Z.
	std::uint32_t m_Axis = 2;
};

/// The floor of the volume, which stays the same for as long as nobody measures it again.
struct FlowFloorItem
{
	static constexpr const char* c_pName = "FlowFloor";

	/// As FlowSubjectSceneTransformItem::m_Extents.
	std::array<std::int32_t, 4> m_Extents{};
};

} // namespace Flow2TypesUtils
