#include "OrlexGraphics/frame/FrameRenderer.h"
#include "OrlexGraphics/frame/OrlexScene.h"
#include "OrlexGraphics/picking/SelectionKinds.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "OrlexGraphics/stage/SphereHelper.h"

#include <QColor>
#include <QOpenGLFramebufferObject>

#include <algorithm>

// The id buffer picks: things are drawn with their ids for colours, into a framebuffer that nobody sees.

namespace OrlexGraphics
{

namespace
{

/// The most that is picked from. Only the rectangle of the pick is ever cleared, drawn and read, but all of it takes
/// memory: it is made with the first pick, no larger than the item.
constexpr QSize c_PickSize(4096, 4096);

/// Things that lie behind each other are found by drawing again without what was found.
constexpr int c_MaxLayers = 16;
constexpr double c_RectangleScale = 0.5;

} // namespace

void VFrameRenderer::Pick(const VPickRequest& i_rRequest, VPick& o_rPick)
{
	if (!m_pPickFramebuffer)
		m_pPickFramebuffer =
		    std::make_unique<QOpenGLFramebufferObject>(m_Size.boundedTo(c_PickSize), QOpenGLFramebufferObject::Depth);
	BeginFrame();
	m_Context.m_Mode = CoreGraphics::ERenderPick;
	m_Context.BindFramebuffer(m_pPickFramebuffer.get());
	m_Context.SetClearColour(QColor(0, 0, 0, 0));

	const double ratio = m_Input.m_PixelRatio;
	const auto devicePixel = [&](const QPoint& i_rPoint)
	{ return QPoint(qRound(i_rPoint.x() * ratio), qRound(i_rPoint.y() * ratio)); };
	const QPoint mouse = devicePixel(i_rRequest.m_Mouse);
	m_PickedIds.clear();
	if (!i_rRequest.m_bRectangle)
	{
		if (const std::uint32_t id = PickPoint(mouse))
			m_PickedIds.push_back(id);
	}
	else if (m_pScene->ExactPick())
	{
		const double zoom = static_cast<double>(m_Context.m_Projection(0, 0) + m_Context.m_Projection(1, 1));
		PickRect(devicePixel(i_rRequest.m_Start), mouse, zoom > 2.0 ? 2.0 / zoom : 1.0, 1);
	}
	else
		PickRect(devicePixel(i_rRequest.m_Start), mouse, c_RectangleScale, c_MaxLayers);
	m_Context.ResetScissor();

	o_rPick.m_Request = i_rRequest;
	o_rPick.m_Request.m_Frame = m_UpdateCount;
	o_rPick.m_Names.clear();
	o_rPick.m_Items = m_pScene->MakeSelection(m_PickedIds, o_rPick.m_Names);
	if (i_rRequest.m_bRectangle)
		std::erase_if(o_rPick.m_Items, [](const NVX::ISelectionItem& i_rItem) { return IsHandle(i_rItem.m_Kind); });
}

void VFrameRenderer::ReadIds(const QRect& i_rRectangle)
{
	m_Context.SetScissor(i_rRectangle);
	m_Context.ClearBuffers(true, true);
	m_pScene->SphereHelper()->Clear();
	if (!m_Input.m_Options.m_bCameraView)
		RenderPasses();
	m_Context.ReadPixels(i_rRectangle, m_Pixels);
}

std::uint32_t VFrameRenderer::PickPoint(const QPoint& i_rMouse)
{
	const QRect rectangle = PointPickRectangle(i_rMouse, m_Size.height(), m_pPickFramebuffer->size());
	if (rectangle.isEmpty())
		return 0;
	VSelectionRegistry& rRegistry = m_pScene->Registry();
	rRegistry.ClearExcluded();
	rRegistry.ExcludeOutside(MakePickFrustum(m_Context.m_Projection * m_Context.m_View, rectangle, m_Size));
	ReadIds(rectangle);
	return NearestId(m_Pixels.data(), rectangle.size(),
	    QPoint(i_rMouse.x(), m_Size.height() - 1 - i_rMouse.y()) - rectangle.topLeft());
}

void VFrameRenderer::PickRect(const QPoint& i_rA, const QPoint& i_rB, double i_Scale, int i_MaxPasses)
{
	const QSize scaled(qRound(m_Size.width() * i_Scale), qRound(m_Size.height() * i_Scale));
	const QRect rectangle =
	    RectanglePickRectangle(i_rA, i_rB, i_Scale, m_Size) & QRect(QPoint(), m_pPickFramebuffer->size());
	if (rectangle.isEmpty())
		return;
	const QRect viewport = m_Context.m_Viewport;
	m_Context.SetViewport(QRect(QPoint(), scaled));
	m_Context.m_FrameSize = scaled;

	VSelectionRegistry& rRegistry = m_pScene->Registry();
	rRegistry.ClearExcluded();
	rRegistry.ExcludeOutside(MakePickFrustum(m_Context.m_Projection * m_Context.m_View, rectangle, scaled));
	m_Found.clear();
	for (int i = 0; i < i_MaxPasses; ++i)
	{
		const std::size_t before = m_PickedIds.size();
		ReadIds(rectangle);
		const bool bPixels = CollectIds(m_Pixels.data(), m_Pixels.size() / 4, m_Found, m_PickedIds);
		if (!m_pScene->SphereHelper()->PickRectangle(rectangle, scaled, m_Found, m_PickedIds) && !bPixels)
			break;
		std::for_each(m_PickedIds.begin() + static_cast<std::ptrdiff_t>(before), m_PickedIds.end(),
		    [&](std::uint32_t i_Id) { rRegistry.Exclude(i_Id); });
	}
	m_Context.SetViewport(viewport);
	m_Context.m_FrameSize = m_Size;
}

} // namespace OrlexGraphics
