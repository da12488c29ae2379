#include "CoreGraphics/RenderContext.h"
#include "OrlexGraphics/frame/OrlexScene.h"
#include "OrlexGraphics/item/SceneFramebufferObject.h"
#include "OrlexGraphics/picking/Picking.h"
#include "OrlexGraphics/picking/SelectionKinds.h"
#include "TesselPluginInterface/ISelectionManager.h"
#include "math/VisibleText.h"

#include <algorithm>

// What becomes of a pick. It is decided while the user interface thread waits, so that the state of the mouse is that
// of the pick; the selection and QML are told afterwards, on that thread.

namespace OrlexGraphics
{

namespace
{

using VItems = std::vector<NVX::ISelectionItem>;

bool Contains(const VItems& i_rItems, const NVX::ISelectionItem& i_rItem)
{
	return std::find(i_rItems.begin(), i_rItems.end(), i_rItem) != i_rItems.end();
}

/// What the picked items would do with the selection.
VItems PreselectionOf(const VItems& i_rPicked, const VItems& i_rSelected, std::uint32_t i_ModifierState)
{
	VItems items = i_rPicked;
	const auto keep = [&](bool i_bSelected)
	{
		std::erase_if(
		    items, [&](const NVX::ISelectionItem& i_rItem) { return Contains(i_rSelected, i_rItem) != i_bSelected; });
	};
	if (i_ModifierState == CoreGraphics::EModifierAdd)
		keep(false);
	else if (i_ModifierState == CoreGraphics::EModifierSubtract)
		keep(true);
	return items;
}

void Apply(TesselPluginInterface::ISelection& io_rSelection, VItems i_Picked, std::uint32_t i_ModifierState,
    bool i_bCameraView)
{
	// In camera view they belong to the view, not to what is picked.
	VItems kept;
	if (i_bCameraView)
		kept = io_rSelection.ItemsOfKind(ESelectionKeptInCameraView);
	switch (i_ModifierState)
	{
	case CoreGraphics::EModifierAdd: io_rSelection.Add(i_Picked); break;
	case CoreGraphics::EModifierSubtract:
		std::erase_if(i_Picked, [&](const NVX::ISelectionItem& i_rItem) { return Contains(kept, i_rItem); });
		io_rSelection.Remove(i_Picked);
		break;
	case CoreGraphics::EModifierToggle:
		std::erase_if(i_Picked, [&](const NVX::ISelectionItem& i_rItem) { return Contains(kept, i_rItem); });
		io_rSelection.Toggle(i_Picked);
		break;
	default:
		i_Picked.insert(i_Picked.end(), kept.begin(), kept.end());
		io_rSelection.Replace(i_Picked);
		break;
	}
}

} // namespace

void VSceneFramebufferObject::PreviewPick(const VPick& i_rPick)
{
	const auto& rpManager = m_pScene->SelectionManager();
	VItems items = PreselectionOf(i_rPick.m_Items, rpManager->Selection().Items(), m_ModifierState);
	const bool bNumbers = std::any_of(i_rPick.m_Items.begin(), i_rPick.m_Items.end(),
	    [](const NVX::ISelectionItem& i_rItem) { return i_rItem.m_Kind == ESelectionCamera; });
	QString toolTip = QString::fromStdString(VisibleText::OnOneLine(ToolTip(i_rPick.m_Names)));
	const bool bItems = items != rpManager->PreSelection().Items();
	const QPoint place = i_rPick.m_Request.m_Mouse;
	if (!bItems && toolTip == m_ToolTipText && bNumbers == m_bShowCameraNumbers)
	{
		m_PreviewPos = place;
		return;
	}
	QMetaObject::invokeMethod(
	    this,
	    [this, pManager = rpManager, items = std::move(items), toolTip = std::move(toolTip), bNumbers, place]
	    {
		    // The mouse may have left since.
		    if (m_MouseState == EMouseIdle)
			    return;
		    m_PreviewPos = place;
		    pManager->PreSelection().Replace(items);
		    SetToolTipText(toolTip);
		    SetShowCameraNumbers(bNumbers);
	    },
	    Qt::QueuedConnection);
}

void VSceneFramebufferObject::CommitPick(const VPick& i_rPick, const VPickRequest& i_rWanted)
{
	if (!m_pScene || !m_pScene->SelectionManager())
		return;
	if (m_MouseState == EMouseHovering || m_MouseState == EMouseDragging)
		PreviewPick(i_rPick);
	if ((m_MouseState != EMouseClicked && m_MouseState != EMouseDragged) || i_rPick.m_Request != i_rWanted)
		return;
	m_MouseState = EMouseIdle;
	QMetaObject::invokeMethod(
	    this,
	    [this, pManager = m_pScene->SelectionManager(), items = i_rPick.m_Items, modifiers = m_ReleaseModifierState,
	        bCameraView = IsCameraView()]
	    {
		    // A click that was faster than the hovering before it would take the selection from under the manipulator.
		    if (std::none_of(items.begin(), items.end(),
		            [](const NVX::ISelectionItem& i_rItem) { return IsHandle(i_rItem.m_Kind); }))
			    Apply(pManager->Selection(), items, modifiers, bCameraView);
		    pManager->PreSelection().Replace({});
		    SetToolTipText(QString());
		    SetShowCameraNumbers(false);
	    },
	    Qt::QueuedConnection);
}

} // namespace OrlexGraphics
