#include "OrlexGraphics/manipulator/RenderManipulator.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "CoreGraphics/ShapeBatch.h"
#include "OrlexGraphics/frame/SceneOptions.h"
#include "OrlexGraphics/manipulator/HandleSize.h"
#include "OrlexGraphics/manipulator/MeshFile.h"
#include "OrlexGraphics/picking/SelectionKinds.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "TesselPluginInterface/ISelectionManager.h"

#include <QOpenGLContext>

#include <algorithm>

namespace OrlexGraphics
{

using CoreGraphics::VRenderContext;
using CoreGraphics::VShape;

namespace
{

constexpr std::uint32_t c_Sides = 16;

// Sizes on the screen, in pixels at a scale of 1.
constexpr float c_ShaftLength = 80.0f;
constexpr float c_ShaftGap = 10.0f;
constexpr float c_ShaftRadius = 1.0f;
constexpr float c_HeadRadius = 10.0f;
constexpr float c_HeadLength = 30.0f;
constexpr float c_PlaneOffset = 25.0f;
constexpr float c_RingRadius = 50.0f;
constexpr float c_MarkerOffset = -50.0f;

const std::array<QVector4D, 3> c_AxisColours = {
    {{1.0f, 0.2f, 0.2f, 1.0f}, {0.2f, 1.0f, 0.2f, 1.0f}, {0.2f, 0.2f, 1.0f, 1.0f}}};
const QVector4D c_HighlightColour(1.0f, 1.0f, 0.0f, 1.0f);
const QVector4D c_MarkerColour(0.0f, 0.0f, 0.0f, 1.0f);

/// Takes Z to the axis.
QMatrix4x4 AxisRotation(std::uint32_t i_Axis)
{
	QMatrix4x4 rotation;
	if (i_Axis == 0)
		rotation.rotate(90.0f, 0.0f, 1.0f, 0.0f);
	else if (i_Axis == 1)
		rotation.rotate(-90.0f, 1.0f, 0.0f, 0.0f);
	return rotation;
}

CoreGraphics::VRenderState HandleState()
{
	CoreGraphics::VRenderState state;
	state.m_bDepthTest = true;
	state.m_Cull = CoreGraphics::ECullBack;
	return state;
}

} // namespace

NVX::ISelectionItem HandleItem(const VManipulatorHandle& i_rHandle)
{
	return {ESelectionManipulatorHandle, i_rHandle.m_Group, i_rHandle.m_Axis, {}};
}

struct VRenderManipulator::VDrawing
{
	explicit VDrawing(CoreGraphics::VShaderLibrary& io_rLibrary)
	    : m_pProgram(io_rLibrary.GetProgram("Placed", "Colour")), m_Cylinder(CoreGraphics::MakeCylinder(c_Sides, true)),
	      m_Cone(CoreGraphics::MakeCone(c_Sides, true)), m_Ring(ReadMeshFile(io_rLibrary, "ManipulatorRing.fbx"))
	{
	}

	const std::shared_ptr<CoreGraphics::VShaderProgram> m_pProgram;
	VShape m_Cylinder;
	VShape m_Cone;
	/// Empty if its file cannot be read.
	std::optional<VShape> m_Ring;
	/// Of the picture, and of the pick.
	std::array<CoreGraphics::VShapeBatch, 2> m_Batches;
};

VRenderManipulator::VRenderManipulator(CoreGraphics::VShaderLibrary& io_rLibrary,
    std::shared_ptr<VSelectionRegistry> i_pRegistry,
    std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pSelectionManager)
    : m_pRegistry(std::move(i_pRegistry)), m_pSelectionManager(std::move(i_pSelectionManager)),
      m_pDrawing(std::make_unique<VDrawing>(io_rLibrary))
{
}

VRenderManipulator::~VRenderManipulator() = default;

void VRenderManipulator::SetVisible(bool i_bVisible)
{
	m_State.m_bVisible = i_bVisible;
	if (!i_bVisible)
		Release();
}

void VRenderManipulator::SetTransform(const QMatrix4x4& i_rTransform)
{
	if (IsDragging())
		return;
	m_GivenTransform = i_rTransform;
	m_State.m_Transform = i_rTransform;
}

bool VRenderManipulator::HasGroup(const VState& i_rState, std::uint32_t i_Group)
{
	return i_Group < EManipulatorMarker && (i_rState.m_ModeMask >> i_Group & 1) != 0;
}

std::optional<VManipulatorHandle> VRenderManipulator::HoveredHandle() const
{
	// A view can point at a handle that has gone since its last frame.
	if (!m_State.m_bVisible || !m_pSelectionManager)
		return {};
	const auto items = m_pSelectionManager->PreSelection().ItemsOfKind(ESelectionManipulatorHandle);
	if (items.empty() || !HasGroup(m_State, items.front().m_SubjectId))
		return {};
	return VManipulatorHandle{items.front().m_SubjectId, items.front().m_ElementIndex};
}

bool VRenderManipulator::IsHovered() const
{
	return HoveredHandle().has_value();
}

void VRenderManipulator::Press(const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_Mouse)
{
	const std::optional<VManipulatorHandle> handle = HoveredHandle();
	if (!handle || IsDragging())
		return;
	m_Drag = VManipulatorDrag::Press(i_rCamera, i_Mouse, *handle, m_State.m_Transform);
	if (!m_Drag)
		return;
	m_State.m_Dragged = *handle;
	m_pSelectionManager->Selection().Add({HandleItem(*handle)});
	m_BeginSignal.Fire();
}

void VRenderManipulator::Drag(
    const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_Mouse, Qt::KeyboardModifiers i_Modifiers)
{
	if (!m_Drag)
		return;
	const std::optional<QMatrix4x4> transform = m_Drag->Drag(i_rCamera, i_Mouse, i_Modifiers);
	if (!transform)
		return;
	m_State.m_Transform = *transform;
	m_ChangedSignal.Fire(*transform);
}

void VRenderManipulator::Release()
{
	if (!m_Drag)
		return;
	const NVX::ISelectionItem item = HandleItem(m_Drag->Handle());
	m_Drag.reset();
	m_State.m_Dragged.reset();
	m_pSelectionManager->Selection().Remove({item});
	m_EndSignal.Fire();
}

void VRenderManipulator::Cancel()
{
	if (!m_Drag)
		return;
	m_State.m_Transform = m_GivenTransform;
	m_CancelSignal.Fire();
	Release();
}

void VRenderManipulator::Synchronise()
{
	m_Drawn = m_State;
}

void VRenderManipulator::AllocateIds()
{
	for (std::uint32_t group = 0; group < EManipulatorGroupCount; ++group)
	{
		for (std::uint32_t axis = 0; axis < 3; ++axis)
			m_Ids[3 * group + axis] = m_pRegistry->GetId(HandleItem({group, axis}));
	}
}

const CoreGraphics::VSelectionId& VRenderManipulator::IdOf(std::uint32_t i_Group, std::uint32_t i_Axis) const
{
	return m_Ids[3 * i_Group + i_Axis];
}

void VRenderManipulator::Render(VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass)
{
	if (i_Pass != EPassOverlay || !m_Drawn.m_bVisible || !i_rOptions.m_bManipulator
	    || !i_rOptions.m_OverlayCamera.empty() || io_rContext.m_Mode == CoreGraphics::ERenderId)
		return;
	const std::optional<float> pixelSize = PixelSizeAt(io_rContext, m_Drawn.m_Transform.column(3).toVector3D());
	if (!pixelSize)
		return;
	const bool bPick = io_rContext.m_Mode == CoreGraphics::ERenderPick;
	CoreGraphics::VShapeBatch& rBatch = m_pDrawing->m_Batches[bPick];
	rBatch.Clear();
	const float size = i_rOptions.m_ManipulatorScale * *pixelSize;
	for (std::uint32_t axis = 0; axis < 3; ++axis)
		GatherAxis(rBatch, bPick, axis, size);
	if (rBatch.IsEmpty() || !io_rContext.UseProgram(m_pDrawing->m_pProgram))
		return;
	io_rContext.ApplyState(bPick ? CoreGraphics::MakeSelectionState(HandleState()) : HandleState());
	rBatch.Draw(io_rContext, GL_TRIANGLES);
}

void VRenderManipulator::GatherAxis(
    CoreGraphics::VShapeBatch& io_rBatch, bool i_bPick, std::uint32_t i_Axis, float i_Size)
{
	VDrawing& rDrawing = *m_pDrawing;
	const QMatrix4x4 frame = m_Drawn.m_Transform * AxisRotation(i_Axis);
	CoreGraphics::VColourBytes colour;

	/// Takes the group's id or colour; false for a group that is not drawn.
	const auto begin = [&](std::uint32_t i_Group)
	{
		if (!HasGroup(m_Drawn, i_Group))
			return false;
		const CoreGraphics::VSelectionId& rId = IdOf(i_Group, i_Axis);
		if (i_bPick && m_pRegistry->IsHidden(rId, CoreGraphics::ERenderPick))
			return false;
		const bool bHighlight =
		    (rId.m_Id & (CoreGraphics::ESelectionIdSelected | CoreGraphics::ESelectionIdPreselected)) != 0;
		colour = i_bPick ? CoreGraphics::ColourBytes(rId)
		                 : CoreGraphics::ColourBytes(bHighlight ? c_HighlightColour : c_AxisColours[i_Axis]);
		return true;
	};
	/// A shape at a place of the axis' frame, in pixels.
	const auto add = [&](const VShape& i_rShape, const QMatrix4x4& i_rPlace, const QVector3D& i_rScale)
	{
		QMatrix4x4 model = frame;
		model.scale(i_Size);
		model *= i_rPlace;
		model.scale(i_rScale);
		io_rBatch.Add(i_rShape, model, colour);
	};
	const auto at = [](float i_X, float i_Y, float i_Z)
	{
		QMatrix4x4 place;
		place.translate(i_X, i_Y, i_Z);
		return place;
	};
	const QVector3D head(c_HeadRadius, c_HeadRadius, c_HeadLength);

	if (begin(EManipulatorArrow))
	{
		add(rDrawing.m_Cylinder, at(0.0f, 0.0f, c_ShaftGap), QVector3D(c_ShaftRadius, c_ShaftRadius, c_ShaftLength));
		add(rDrawing.m_Cone, at(0.0f, 0.0f, c_ShaftLength + c_ShaftGap), head);
	}
	if (begin(EManipulatorPlane))
	{
		// The two far sides of a square between the other axes, where these are positive.
		const float x = i_Axis == 0 ? -c_PlaneOffset : c_PlaneOffset;
		const float y = i_Axis == 1 ? -c_PlaneOffset : c_PlaneOffset;
		const QVector3D side(c_ShaftRadius, c_ShaftRadius, c_PlaneOffset);
		add(rDrawing.m_Cylinder, at(std::min(x, 0.0f), y, 0.0f) * AxisRotation(0), side);
		add(rDrawing.m_Cylinder, at(x, std::min(y, 0.0f), 0.0f) * AxisRotation(1), side);
	}
	if (rDrawing.m_Ring && begin(EManipulatorRing))
		add(*rDrawing.m_Ring, QMatrix4x4(), QVector3D(c_RingRadius, c_RingRadius, c_RingRadius));
	if (!i_bPick && m_Drawn.m_Dragged && m_Drawn.m_Dragged->m_Axis == i_Axis)
	{
		colour = CoreGraphics::ColourBytes(c_MarkerColour);
		add(rDrawing.m_Cone, at(0.0f, 0.0f, c_MarkerOffset), head);
	}
}

} // namespace OrlexGraphics
