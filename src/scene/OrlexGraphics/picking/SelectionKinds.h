#pragma once

#include <cstdint>

namespace OrlexGraphics
{

/// Kinds of NVX::ISelectionItem that the scene itself knows, beside those of the panel's lists.
enum ESceneSelectionKind : std::uint32_t
{
	/// By device URN.
	ESelectionCamera = 1,
	ESelectionSubject = 7,
	/// Stays when the selection is replaced in camera view.
	ESelectionKeptInCameraView = 27,
	/// Group and axis of a handle of the manipulator.
	ESelectionManipulatorHandle = 28,
	ESelectionVolumeManipulatorHandle = 34,
	ESelectionForcePlate = 36
};

/// Handles are for the mouse to drag: they are picked by a point alone, and are neither selected with other things nor
/// outlined.
constexpr bool IsHandle(std::uint32_t i_Kind)
{
	return i_Kind == ESelectionManipulatorHandle || i_Kind == ESelectionVolumeManipulatorHandle;
}

/// Whether items of a kind take one id for each of their children, whose number the picked item carries.
constexpr bool HasChildren(std::uint32_t i_Kind)
{
	return i_Kind == 2 || i_Kind == 3 || i_Kind == 5 || i_Kind == 31;
}

} // namespace OrlexGraphics
