#pragma once

#include <QPoint>
#include <QSize>
#include <Qt>

namespace CoreGraphics
{
class VCameraController;
}

namespace OrlexGraphics
{

/// Something in a scene with handles that the mouse can drag. It is a render type too, whose drawing reads what
/// Synchronise copied; all else runs on the user interface thread.
class IManipulator
{
public:
	virtual ~IManipulator() = default;

	/// The mouse points at a handle, and a press would begin to drag it.
	virtual bool IsHovered() const = 0;
	virtual bool IsDragging() const = 0;

	/// The handle becomes selected beside what is selected already, until the release.
	/// @param i_Mouse in pixels of the controller's viewport, from its upper left corner
	virtual void Press(const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_Mouse) = 0;
	virtual void Drag(
	    const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_Mouse, Qt::KeyboardModifiers i_Modifiers) = 0;
	virtual void Release() = 0;
	/// Ends a drag as if it had not begun.
	virtual void Cancel() = 0;

	/// Copies what the user interface thread has set to what the render thread draws, while the former waits.
	virtual void Synchronise() = 0;
};

} // namespace OrlexGraphics
