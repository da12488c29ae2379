#pragma once

#include "CoreGraphics/SelectionId.h"
#include "NVX/ISelectionItem.h"
#include "NVX/Signal.h"
#include "OrlexGraphics/frame/IRenderType.h"
#include "OrlexGraphics/manipulator/IManipulator.h"
#include "OrlexGraphics/manipulator/VolumeDrag.h"

#include <QVector4D>

#include <array>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>

namespace CoreGraphics
{
class VShaderLibrary;
}

namespace TesselPluginInterface
{
class ISelectionManager;
}

namespace OrlexGraphics
{

class VSelectionRegistry;

/// A box in the scene, whose sides and place the mouse can drag. It is hidden until it is shown, or a frame brings it.
/// The signal fires on the user interface thread, in the mouse's event.
class VRenderVolumeManipulator : public IRenderType, public IManipulator
{
public:
	/// With the context current, while the user interface thread waits.
	/// @param i_Name told apart by it are the handles of several volumes
	VRenderVolumeManipulator(CoreGraphics::VShaderLibrary& io_rLibrary, std::shared_ptr<VSelectionRegistry> i_pRegistry,
	    std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pSelectionManager, std::string i_Name,
	    const QVector3D& i_rColour, const VVolume& i_rVolume);
	~VRenderVolumeManipulator() override;

	// For the user interface thread.

	const std::string& Name() const { return m_Name; }
	const QVector3D& Colour() const { return m_Colour; }
	bool IsVisible() const { return m_State.m_bVisible; }
	void SetVisible(bool i_bVisible);
	/// Nothing while it is dragged.
	void SetVolume(const VVolume& i_rVolume);
	const VVolume& Volume() const { return m_State.m_Volume; }
	/// As it is picked and selected.
	NVX::ISelectionItem HandleItem(const VVolumeHandle& i_rHandle) const;
	/// The least corner, and the greatest one.
	NVX::VSignal<QVector3D, QVector3D>& ChangedSignal() { return m_ChangedSignal; }

	bool IsHovered() const override;
	bool IsDragging() const override { return m_Drag.has_value(); }
	void Press(const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_Mouse) override;
	void Drag(const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_Mouse,
	    Qt::KeyboardModifiers i_Modifiers) override;
	void Release() override;
	void Cancel() override;
	void Synchronise() override;

	// For the render thread.

	/// What a frame brings: shown from this frame on, or hidden if there is none or it has no inside. During a drag it
	/// waits for its end.
	void BringVolume(const std::optional<VVolume>& i_rVolume);

	/// The ids of the handles in the frame that is being made: in each frame update, after the registry's Reset.
	void AllocateIds();

	void Render(
	    CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass) override;

	/// How much of an arrow is seen: less the more it points at the eye, where it could not be dragged.
	/// @param i_Cosine of the angle between the view and the arrow
	static float ArrowOpacity(float i_Cosine);

private:
	struct VDrawing;

	struct VState
	{
		bool m_bVisible = false;
		bool m_bDragged = false;
		VVolume m_Volume;

		void Take(const std::optional<VVolume>& i_rVolume);
	};

	static constexpr std::size_t c_Handles = 11;

	std::optional<VVolumeHandle> HoveredHandle() const;
	void RenderBox(CoreGraphics::VRenderContext& io_rContext);
	void RenderHandle(CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& i_rOptions,
	    const VVolumeHandle& i_rHandle, const CoreGraphics::VSelectionId& i_rId);

	const std::shared_ptr<VSelectionRegistry> m_pRegistry;
	const std::shared_ptr<TesselPluginInterface::ISelectionManager> m_pSelectionManager;
	const std::string m_Name;
	const QVector3D m_Colour;
	NVX::VSignal<QVector3D, QVector3D> m_ChangedSignal;

	// Of the user interface thread.
	VState m_State;
	std::optional<VVolumeDrag> m_Drag;
	/// Before the drag.
	VVolume m_Start;

	// Of the render thread.
	VState m_Drawn;
	/// By a frame since the last exchange, or during a drag.
	std::optional<std::optional<VVolume>> m_Brought;
	std::array<CoreGraphics::VSelectionId, c_Handles> m_Ids{};
	const std::unique_ptr<VDrawing> m_pDrawing;
};

} // namespace OrlexGraphics
