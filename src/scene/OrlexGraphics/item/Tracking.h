#pragma once

#include <QObject>

#include <cstdint>

namespace OrlexGraphics
{

Q_NAMESPACE

/// What the camera follows by itself.
enum ETracking : std::uint32_t
{
	ETrackingNone,
	/// Frames the selection that there was when this was set.
	ETrackingSelectionThen,
	/// Frames the selection in every frame.
	ETrackingSelection,
	/// Follows the selected item as it moves and turns.
	ETrackingTransform
};
Q_ENUM_NS(ETracking)

} // namespace OrlexGraphics
