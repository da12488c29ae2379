#include "OrlexGraphics/manipulator/RenderVolumeManipulator.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/SelectableProgram.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "CoreGraphics/Shapes.h"
#include "OrlexGraphics/frame/SceneOptions.h"
#include "OrlexGraphics/manipulator/HandleSize.h"
#include "OrlexGraphics/picking/SelectionKinds.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "TesselPluginInterface/ISelectionManager.h"

#include <QOpenGLContext>

#include <algorithm>
#include <cmath>

namespace OrlexGraphics
{

using CoreGraphics::VRenderContext;
using CoreGraphics::VShape;

namespace
{

constexpr std::uint32_t c_VolumeSides = 16;

// Sizes on the screen, in pixels at a scale of 1.
constexpr float c_VolumeShaftLength = 30.0f;
constexpr float c_VolumeShaftRadius = 1.0f;
constexpr float c_VolumeHeadRadius = 6.0f;
constexpr float c_VolumeHeadLength = 18.0f;
constexpr float c_CornerSide = 10.0f;
constexpr float c_CentreSide = 14.0f;

// The angle to the view below which an arrow is hidden, in radians, and how fast it comes up beyond.
constexpr float c_LeastAngle = 0.1f;
constexpr float c_OpacityOfRadian = 5.0f;

const QVector3D c_VolumeHighlight(1.0f, 1.0f, 0.0f);

CoreGraphics::VRenderState VolumeState()
{
	CoreGraphics::VRenderState state;
	state.m_bDepthTest = true;
	state.m_Cull = CoreGraphics::ECullBack;
	state.m_ColourBlend = CoreGraphics::EColourBlendAlpha;
	return state;
}

/// Takes Z to a direction along an axis.
QMatrix4x4 TurnTo(const QVector3D& i_rDirection)
{
	return QMatrix4x4(QQuaternion::rotationTo(QVector3D(0.0f, 0.0f, 1.0f), i_rDirection).toRotationMatrix());
}

} // namespace

struct VRenderVolumeManipulator::VDrawing
{
	explicit VDrawing(CoreGraphics::VShaderLibrary& io_rLibrary)
	    : m_Program(CoreGraphics::VSelectableProgram::Make(io_rLibrary, "Simple3DModelColour", "Colour")),
	      m_pLines(io_rLibrary.GetProgram("Simple3DModelWireframe", "UniformColour")),
	      m_Cylinder(CoreGraphics::MakeCylinder(c_VolumeSides, true)),
	      m_Cone(CoreGraphics::MakeCone(c_VolumeSides, true)), m_Box(CoreGraphics::MakeBox(false)),
	      m_WireBox(CoreGraphics::MakeBox(true))
	{
	}

	CoreGraphics::VSelectableProgram m_Program;
	std::shared_ptr<CoreGraphics::VShaderProgram> m_pLines;
	VShape m_Cylinder;
	VShape m_Cone;
	VShape m_Box;
	VShape m_WireBox;
	CoreGraphics::VUniform m_Model{"u_ModelTransform"};
	CoreGraphics::VUniform m_ModelColour{"u_ModelColour"};
	CoreGraphics::VUniform m_LineColour{"u_colour"};
};

VRenderVolumeManipulator::VRenderVolumeManipulator(CoreGraphics::VShaderLibrary& io_rLibrary,
    std::shared_ptr<VSelectionRegistry> i_pRegistry,
    std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pSelectionManager, std::string i_Name,
    const QVector3D& i_rColour, const VVolume& i_rVolume)
    : m_pRegistry(std::move(i_pRegistry)), m_pSelectionManager(std::move(i_pSelectionManager)),
      m_Name(std::move(i_Name)), m_Colour(i_rColour), m_State{false, false, i_rVolume},
      m_pDrawing(std::make_unique<VDrawing>(io_rLibrary))
{
}

VRenderVolumeManipulator::~VRenderVolumeManipulator() = default;

void VRenderVolumeManipulator::SetVisible(bool i_bVisible)
{
	m_State.m_bVisible = i_bVisible;
	if (!i_bVisible)
		Release();
}

void VRenderVolumeManipulator::SetVolume(const VVolume& i_rVolume)
{
	if (!IsDragging())
		m_State.m_Volume = i_rVolume;
}

NVX::ISelectionItem VRenderVolumeManipulator::HandleItem(const VVolumeHandle& i_rHandle) const
{
	return {ESelectionVolumeManipulatorHandle, i_rHandle.m_Group, i_rHandle.m_Index, m_Name};
}

std::optional<VVolumeHandle> VRenderVolumeManipulator::HoveredHandle() const
{
	if (!m_State.m_bVisible || !m_pSelectionManager)
		return {};
	for (const NVX::ISelectionItem& rItem :
	    m_pSelectionManager->PreSelection().ItemsOfKind(ESelectionVolumeManipulatorHandle))
	{
		if (rItem.m_Name == m_Name)
			return VVolumeHandle{rItem.m_SubjectId, rItem.m_ElementIndex};
	}
	return {};
}

bool VRenderVolumeManipulator::IsHovered() const
{
	return HoveredHandle().has_value();
}

void VRenderVolumeManipulator::Press(const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_Mouse)
{
	const std::optional<VVolumeHandle> handle = HoveredHandle();
	if (!handle || IsDragging())
		return;
	m_Drag = VVolumeDrag::Press(i_rCamera, i_Mouse, *handle, m_State.m_Volume);
	if (!m_Drag)
		return;
	m_Start = m_State.m_Volume;
	m_pSelectionManager->Selection().Add({HandleItem(*handle)});
}

void VRenderVolumeManipulator::Drag(
    const CoreGraphics::VCameraController& i_rCamera, const QPoint& i_Mouse, Qt::KeyboardModifiers /*i_Modifiers*/)
{
	const std::optional<VVolume> volume = m_Drag ? m_Drag->Drag(i_rCamera, i_Mouse) : std::nullopt;
	if (!volume)
		return;
	m_State.m_Volume = *volume;
	m_ChangedSignal.Fire(volume->m_Minimum, volume->m_Maximum);
}

void VRenderVolumeManipulator::Release()
{
	if (!m_Drag)
		return;
	const NVX::ISelectionItem item = HandleItem(m_Drag->Handle());
	m_Drag.reset();
	m_pSelectionManager->Selection().Remove({item});
}

void VRenderVolumeManipulator::Cancel()
{
	if (!m_Drag)
		return;
	m_State.m_Volume = m_Start;
	m_ChangedSignal.Fire(m_Start.m_Minimum, m_Start.m_Maximum);
	Release();
}

void VRenderVolumeManipulator::Synchronise()
{
	if (m_Brought && !IsDragging())
	{
		m_State.Take(*m_Brought);
		m_Brought.reset();
	}
	m_State.m_bDragged = IsDragging();
	m_Drawn = m_State;
}

void VRenderVolumeManipulator::VState::Take(const std::optional<VVolume>& i_rVolume)
{
	m_bVisible = i_rVolume.has_value();
	if (i_rVolume)
		m_Volume = *i_rVolume;
}

void VRenderVolumeManipulator::BringVolume(const std::optional<VVolume>& i_rVolume)
{
	m_Brought.emplace(i_rVolume && IsValid(*i_rVolume) ? i_rVolume : std::nullopt);
	if (!m_Drawn.m_bDragged)
		m_Drawn.Take(*m_Brought);
}

void VRenderVolumeManipulator::AllocateIds()
{
	std::size_t next = 0;
	for (std::uint32_t group = 0; group < EVolumeHandleCount; ++group)
	{
		for (std::uint32_t index = 0; index < VolumeHandleCount(group); ++index)
			m_Ids[next++] = m_pRegistry->GetId(HandleItem({group, index}));
	}
}

float VRenderVolumeManipulator::ArrowOpacity(float i_Cosine)
{
	const float angle = std::acos(std::min(std::abs(i_Cosine), 1.0f));
	return angle < c_LeastAngle ? 0.0f : std::min(1.0f, (angle - c_LeastAngle) * c_OpacityOfRadian);
}

void VRenderVolumeManipulator::Render(
    VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass)
{
	if (i_Pass != EPassOverlay || !m_Drawn.m_bVisible || !i_rOptions.m_bManipulator
	    || !i_rOptions.m_OverlayCamera.empty() || io_rContext.m_Mode == CoreGraphics::ERenderId)
		return;
	const bool bPick = io_rContext.m_Mode == CoreGraphics::ERenderPick;
	if (!bPick)
		RenderBox(io_rContext);
	if (!io_rContext.UseProgram(m_pDrawing->m_Program.Get(bPick)))
		return;
	io_rContext.ApplyState(bPick ? CoreGraphics::MakeSelectionState(VolumeState()) : VolumeState());
	std::size_t next = 0;
	for (std::uint32_t group = 0; group < EVolumeHandleCount; ++group)
	{
		for (std::uint32_t index = 0; index < VolumeHandleCount(group); ++index)
			RenderHandle(io_rContext, i_rOptions, {group, index}, m_Ids[next++]);
	}
}

void VRenderVolumeManipulator::RenderBox(VRenderContext& io_rContext)
{
	if (!io_rContext.UseProgram(m_pDrawing->m_pLines))
		return;
	CoreGraphics::VRenderState state;
	state.m_bDepthTest = true;
	io_rContext.ApplyState(state);
	io_rContext.SetUniform(m_pDrawing->m_Model, BoxTransform(m_Drawn.m_Volume));
	io_rContext.SetUniform(m_pDrawing->m_LineColour, QVector4D(m_Colour, 1.0f));
	io_rContext.BindVertices(m_pDrawing->m_WireBox.m_Vertices);
	io_rContext.DrawElements(GL_LINES, m_pDrawing->m_WireBox.m_Indices);
}

void VRenderVolumeManipulator::RenderHandle(VRenderContext& io_rContext, const VSceneOptions& i_rOptions,
    const VVolumeHandle& i_rHandle, const CoreGraphics::VSelectionId& i_rId)
{
	const bool bPick = io_rContext.m_Mode == CoreGraphics::ERenderPick;
	const QVector3D place = VolumeHandlePlace(m_Drawn.m_Volume, i_rHandle, io_rContext.m_bYUp);
	const std::optional<float> size = PixelSizeAt(io_rContext, place);
	if (!size || (bPick && m_pRegistry->IsHidden(i_rId, io_rContext.m_Mode)))
		return;
	VDrawing& rDrawing = *m_pDrawing;
	float opacity = 1.0f;
	QMatrix4x4 frame;
	frame.translate(place);
	if (i_rHandle.m_Group == EVolumeFace)
	{
		const QVector3D normal = VolumeFaceNormal(i_rHandle.m_Index);
		// From the eye to the handle; in a view without an eye that is the same everywhere.
		const QVector3D inView = io_rContext.m_View.map(place);
		const bool bOrthographic = io_rContext.m_Projection(3, 3) != 0.0f;
		const QVector3D view = bOrthographic ? QVector3D(0.0f, 0.0f, -1.0f) : inView.normalized();
		opacity = ArrowOpacity(QVector3D::dotProduct(view, io_rContext.m_View.mapVector(normal)));
		if (opacity == 0.0f)
			return;
		frame *= TurnTo(normal);
	}
	frame.scale(*size * i_rOptions.m_ManipulatorScale);

	if (bPick)
		rDrawing.m_Program.SetId(io_rContext, i_rId);
	else
	{
		const bool bHighlight =
		    (i_rId.m_Id & (CoreGraphics::ESelectionIdSelected | CoreGraphics::ESelectionIdPreselected)) != 0;
		io_rContext.SetUniform(rDrawing.m_ModelColour, QVector4D(bHighlight ? c_VolumeHighlight : m_Colour, opacity));
	}
	const auto draw = [&](VShape& io_rShape, float i_Z, const QVector3D& i_rScale)
	{
		QMatrix4x4 model = frame;
		model.translate(0.0f, 0.0f, i_Z);
		model.scale(i_rScale);
		io_rContext.SetUniform(rDrawing.m_Model, model);
		io_rContext.BindVertices(io_rShape.m_Vertices);
		io_rContext.DrawElements(GL_TRIANGLES, io_rShape.m_Indices);
	};
	if (i_rHandle.m_Group == EVolumeFace)
	{
		draw(rDrawing.m_Cylinder, 0.0f, QVector3D(c_VolumeShaftRadius, c_VolumeShaftRadius, c_VolumeShaftLength));
		draw(rDrawing.m_Cone, c_VolumeShaftLength,
		    QVector3D(c_VolumeHeadRadius, c_VolumeHeadRadius, c_VolumeHeadLength));
		return;
	}
	const float side = i_rHandle.m_Group == EVolumeCorner ? c_CornerSide : c_CentreSide;
	draw(rDrawing.m_Box, 0.0f, QVector3D(side, side, side));
}

} // namespace OrlexGraphics
