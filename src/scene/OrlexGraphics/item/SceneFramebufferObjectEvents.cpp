#include "CoreGraphics/CameraController.h"
#include "CoreGraphics/InteractionMapper.h"
#include "CoreGraphics/RenderContext.h"
#include "OrlexGraphics/frame/OrlexScene.h"
#include "OrlexGraphics/item/SceneFramebufferObject.h"
#include "OrlexGraphics/manipulator/IManipulator.h"
#include "OrlexGraphics/picking/Picking.h"
#include "TesselPluginInterface/ISelectionManager.h"

#include <QHoverEvent>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QWheelEvent>

#include <cstdlib>

namespace OrlexGraphics
{

namespace
{

/// How far from where a handle was seen under the mouse a press still takes it, in pixels.
constexpr int c_HandleReach = 10;

std::uint32_t ModifierState(Qt::KeyboardModifiers i_Modifiers)
{
	const bool bShift = i_Modifiers.testFlag(Qt::ShiftModifier);
	const bool bControl = i_Modifiers.testFlag(Qt::ControlModifier);
	if (bControl)
		return bShift ? CoreGraphics::EModifierSubtract : CoreGraphics::EModifierToggle;
	return bShift ? CoreGraphics::EModifierAdd : CoreGraphics::EModifierNone;
}

bool IsSelecting(const QMouseEvent& i_rEvent)
{
	return CoreGraphics::VInteractionMapper::Test(CoreGraphics::EInteractionSelect,
	    static_cast<std::uint32_t>(i_rEvent.buttons()), static_cast<std::uint32_t>(i_rEvent.modifiers()));
}

} // namespace

void VSceneFramebufferObject::SetModifiers(Qt::KeyboardModifiers i_Modifiers)
{
	m_ModifierState = ModifierState(i_Modifiers);
}

IManipulator* VSceneFramebufferObject::FindManipulator(bool (IManipulator::*i_pCondition)() const) const
{
	if (!m_pScene)
		return nullptr;
	for (const auto* const pManipulator :
	    {&m_pScene->Manipulator(), &m_pScene->ReconstructionVolumeManipulator(), &m_pScene->HotspotVolumeManipulator()})
		if (*pManipulator && ((**pManipulator).*i_pCondition)())
			return pManipulator->get();
	return nullptr;
}

void VSceneFramebufferObject::mousePressEvent(QMouseEvent* io_pEvent)
{
	SetModifiers(io_pEvent->modifiers());
	SetMousePos(io_pEvent->pos());
	forceActiveFocus();
	// What was picked some frames ago may be far from the mouse by now.
	const bool bAtPick = (io_pEvent->pos() - m_PreviewPos).manhattanLength() <= c_HandleReach;
	if (IManipulator* const pManipulator = FindManipulator(&IManipulator::IsHovered);
	    pManipulator && bAtPick && io_pEvent->button() == Qt::LeftButton)
	{
		pManipulator->Press(*m_pCamera, io_pEvent->pos());
		m_MouseState = EMouseIdle;
	}
	else if (IsSelecting(*io_pEvent))
	{
		m_MouseState = EMouseDragging;
		m_PressPos = io_pEvent->pos();
	}
	else
	{
		m_MouseState = EMouseIdle;
		m_bPressPending = io_pEvent->button() == Qt::LeftButton;
		m_PressPos = io_pEvent->pos();
		m_pCamera->Press(io_pEvent->pos(), static_cast<std::uint32_t>(io_pEvent->buttons()),
		    static_cast<std::uint32_t>(io_pEvent->modifiers()));
	}
	update();
}

void VSceneFramebufferObject::mouseMoveEvent(QMouseEvent* io_pEvent)
{
	SetModifiers(io_pEvent->modifiers());
	const QPoint moved = io_pEvent->pos() - m_PressPos;
	if (IManipulator* const pManipulator = FindManipulator(&IManipulator::IsDragging))
		pManipulator->Drag(*m_pCamera, io_pEvent->pos(), io_pEvent->modifiers());
	else if (m_MouseState != EMouseDragging && !IsSelecting(*io_pEvent)
	    && !(m_bPressPending && std::abs(moved.x()) <= c_MouseTolerance && std::abs(moved.y()) <= c_MouseTolerance))
	{
		m_MouseState = EMouseIdle;
		m_bPressPending = false;
		ClearPreview();
		m_pCamera->Move(io_pEvent->pos());
		OnFrameChanged();
	}
	SetMousePos(io_pEvent->pos());
	update();
}

void VSceneFramebufferObject::mouseReleaseEvent(QMouseEvent* io_pEvent)
{
	SetModifiers(io_pEvent->modifiers());
	SetMousePos(io_pEvent->pos());
	if (io_pEvent->button() == Qt::LeftButton)
	{
		m_ReleasePos = io_pEvent->pos();
		m_ReleaseModifierState = m_ModifierState;
		if (m_MouseState == EMouseDragging)
			m_MouseState = EMouseDragged;
		else if (m_bPressPending)
			m_MouseState = EMouseClicked;
		m_bPressPending = false;
	}
	if (IManipulator* const pManipulator = FindManipulator(&IManipulator::IsDragging);
	    pManipulator && !io_pEvent->buttons().testFlag(Qt::LeftButton))
		pManipulator->Release();
	else
		m_pCamera->Release(
		    static_cast<std::uint32_t>(io_pEvent->buttons()), static_cast<std::uint32_t>(io_pEvent->modifiers()));
	update();
}

void VSceneFramebufferObject::mouseUngrabEvent()
{
	// Another item or a popup has taken the mouse in the middle of a press; after a release nothing is held any more.
	if (m_MouseState == EMouseDragging)
		m_MouseState = EMouseIdle;
	m_bPressPending = false;
	if (IManipulator* const pManipulator = FindManipulator(&IManipulator::IsDragging))
		pManipulator->Release();
	m_pCamera->Release(0, 0);
	update();
}

void VSceneFramebufferObject::mouseDoubleClickEvent(QMouseEvent* /*io_pEvent*/)
{
	if (IsCameraView() || !m_pScene)
		return;
	SetPreviewCamera(m_pScene->GetSelectedCamera());
}

void VSceneFramebufferObject::wheelEvent(QWheelEvent* io_pEvent)
{
	// Sideways only.
	if (io_pEvent->angleDelta().y() == 0)
		return;
	m_pCamera->Wheel(io_pEvent->angleDelta().y(), m_bWheelInFixedViews);
	OnFrameChanged();
	update();
}

void VSceneFramebufferObject::keyPressEvent(QKeyEvent* io_pEvent)
{
	SetModifiers(io_pEvent->modifiers());
	io_pEvent->setAccepted(io_pEvent->key() == Qt::Key_Escape && CancelDrag());
	update();
}

bool VSceneFramebufferObject::CancelDrag()
{
	if (IManipulator* const pManipulator = FindManipulator(&IManipulator::IsDragging))
	{
		pManipulator->Cancel();
		return true;
	}
	if (m_MouseState != EMouseDragging)
		return false;
	m_MouseState = EMouseIdle;
	ClearPreview();
	return true;
}

void VSceneFramebufferObject::keyReleaseEvent(QKeyEvent* io_pEvent)
{
	SetModifiers(io_pEvent->modifiers());
	io_pEvent->ignore();
	update();
}

void VSceneFramebufferObject::hoverEnterEvent(QHoverEvent* io_pEvent)
{
	hoverMoveEvent(io_pEvent);
}

void VSceneFramebufferObject::hoverMoveEvent(QHoverEvent* io_pEvent)
{
	// A commit is still to come.
	if (m_MouseState != EMouseClicked && m_MouseState != EMouseDragged)
		m_MouseState = EMouseHovering;
	if (m_pScene && m_pScene->PickingRests())
		ClearPreview();
	SetModifiers(io_pEvent->modifiers());
	SetMousePos(io_pEvent->pos());
	update();
}

void VSceneFramebufferObject::hoverLeaveEvent(QHoverEvent* /*io_pEvent*/)
{
	if (m_MouseState != EMouseDragged)
		m_MouseState = EMouseIdle;
	ClearPreview();
	update();
}

void VSceneFramebufferObject::ClearPreview()
{
	if (m_pScene && m_pScene->SelectionManager())
		m_pScene->SelectionManager()->PreSelection().Replace({});
	SetToolTipText(QString());
}

VPickRequest VSceneFramebufferObject::MakePickRequest(std::uint64_t i_Frame) const
{
	const bool bCommit = m_MouseState == EMouseClicked || m_MouseState == EMouseDragged;
	VPickRequest request;
	request.m_Mouse = bCommit ? m_ReleasePos : m_MousePos;
	request.m_bRectangle =
	    (m_MouseState == EMouseDragging || m_MouseState == EMouseDragged) && !IsPoint(m_PressPos, request.m_Mouse);
	if (request.m_bRectangle)
		request.m_Start = m_PressPos;
	request.m_View = m_pCamera->m_View;
	request.m_Projection = m_pCamera->m_Projection;
	request.m_Frame = i_Frame;
	return request;
}

} // namespace OrlexGraphics
