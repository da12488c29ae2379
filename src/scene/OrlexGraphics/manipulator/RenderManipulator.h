#pragma once

#include "CoreGraphics/SelectionId.h"
#include "NVX/ISelectionItem.h"
#include "NVX/Signal.h"
#include "OrlexGraphics/frame/IRenderType.h"
#include "OrlexGraphics/manipulator/IManipulator.h"
#include "OrlexGraphics/manipulator/ManipulatorDrag.h"

#include <QMatrix4x4>

#include <array>
#include <cstdint>
#include <memory>
#include <optional>

namespace CoreGraphics
{
class VShaderLibrary;
class VShapeBatch;
} // namespace CoreGraphics

namespace TesselPluginInterface
{
class ISelectionManager;
}

namespace OrlexGraphics
{

class VSelectionRegistry;

/// The item of a handle, as it is picked and selected.
NVX::ISelectionItem HandleItem(const VManipulatorHandle& i_rHandle);

/// Arrows, plane handles and rings about a transform, by which the mouse moves and turns it. The handles keep their
/// size on the screen and show through all else. The signals fire on the user interface thread, in the mouse's event.
class VRenderManipulator : public IRenderType, public IManipulator
{
public:
	/// With the context current, while the user interface thread waits. Without the ring's mesh there are no rings, and
	/// the log says so.
	/// @param i_pRegistry of the scene
	VRenderManipulator(CoreGraphics::VShaderLibrary& io_rLibrary, std::shared_ptr<VSelectionRegistry> i_pRegistry,
	    std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pSelectionManager);
	~VRenderManipulator() override;

	// For the user interface thread.

	bool IsVisible() const { return m_State.m_bVisible; }
	/// Hidden it takes no press; hidden in the middle of a drag, the drag ends.
	void SetVisible(bool i_bVisible);
	/// Bit 0 arrows, bit 1 plane handles, bit 2 rings.
	void SetModeMask(std::uint32_t i_Mask) { m_State.m_ModeMask = i_Mask; }
	/// The transform to be moved: rotation and translation in millimetres. Nothing while it is dragged.
	void SetTransform(const QMatrix4x4& i_rTransform);
	/// As it is now.
	const QMatrix4x4& Transform() const { return m_State.m_Transform; }
	/// As it was given to SetTransform last.
	const QMatrix4x4& GivenTransform() const { return m_GivenTransform; }

	NVX::VSignal<>& BeginSignal() { return m_BeginSignal; }
	NVX::VSignal<QMatrix4x4>& ChangedSignal() { return m_ChangedSignal; }
	/// What ChangedSignal has changed since BeginSignal is to be as it was. EndSignal follows.
	NVX::VSignal<>& CancelSignal() { return m_CancelSignal; }
	NVX::VSignal<>& EndSignal() { return m_EndSignal; }

	bool IsHovered() const override;
	bool IsDragging() const override { return m_Drag.has_value(); }
	void Press(const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_Mouse) override;
	void Drag(const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_Mouse,
	    Qt::KeyboardModifiers i_Modifiers) override;
	void Release() override;
	void Cancel() override;
	void Synchronise() override;

	// For the render thread.

	/// The ids of the handles in the frame that is being made: in each frame update, after the registry's Reset.
	void AllocateIds();

	void Render(
	    CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass) override;

private:
	struct VDrawing;

	/// What is drawn.
	struct VState
	{
		bool m_bVisible = false;
		std::uint32_t m_ModeMask = 0xff;
		QMatrix4x4 m_Transform;
		std::optional<VManipulatorHandle> m_Dragged;
	};

	static bool HasGroup(const VState& i_rState, std::uint32_t i_Group);
	std::optional<VManipulatorHandle> HoveredHandle() const;
	const CoreGraphics::VSelectionId& IdOf(std::uint32_t i_Group, std::uint32_t i_Axis) const;
	void GatherAxis(CoreGraphics::VShapeBatch& io_rBatch, bool i_bPick, std::uint32_t i_Axis, float i_Size);

	const std::shared_ptr<VSelectionRegistry> m_pRegistry;
	const std::shared_ptr<TesselPluginInterface::ISelectionManager> m_pSelectionManager;
	NVX::VSignal<> m_BeginSignal;
	NVX::VSignal<QMatrix4x4> m_ChangedSignal;
	NVX::VSignal<> m_CancelSignal;
	NVX::VSignal<> m_EndSignal;

	// Of the user interface thread.
	VState m_State;
	QMatrix4x4 m_GivenTransform;
	std::optional<VManipulatorDrag> m_Drag;

	// Of the render thread.
	VState m_Drawn;
	std::array<CoreGraphics::VSelectionId, EManipulatorGroupCount * 3> m_Ids{};
	const std::unique_ptr<VDrawing> m_pDrawing;
};

} // namespace OrlexGraphics
