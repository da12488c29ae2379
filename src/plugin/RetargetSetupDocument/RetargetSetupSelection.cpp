#include "RetargetSetupDocument/RetargetSetupSelection.h"

#include "RetargetSetupDocument/Identity.h"
#include "TesselPluginInterface/IDispatcher.h"
#include "TesselPluginInterface/ISelectionManager.h"

#include <utility>

namespace
{

/// -1 unless exactly one item of the kind belongs to the document.
std::int32_t OnlySelected(const TesselPluginInterface::ISelection& i_rSelection, NVX::ESelectionKind i_Kind)
{
	std::int32_t selected = -1;
	for (const NVX::ISelectionItem& rItem : i_rSelection.ItemsOfKind(i_Kind))
		if (rItem.m_SubjectId == RetargetSetup::c_SubjectId)
		{
			if (selected != -1)
				return -1;
			selected = std::int32_t(rItem.m_ElementIndex);
		}
	return selected;
}

} // namespace

VRetargetSetupSelection::VRetargetSetupSelection(std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher,
    std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pSelectionManager)
    : m_pDispatcher(std::move(i_pDispatcher)), m_pSelectionManager(std::move(i_pSelectionManager))
{
}

void VRetargetSetupSelection::OnShared()
{
	m_pSelectionManager->Selection().ChangedSignal().Connect(WeakBind(&VRetargetSetupSelection::Update), m_pDispatcher);
}

void VRetargetSetupSelection::Update()
{
	const TesselPluginInterface::ISelection& rSelection = m_pSelectionManager->Selection();
	const std::array<std::int32_t, 3> selected{OnlySelected(rSelection, NVX::ESelectionSourceSegment),
	    OnlySelected(rSelection, NVX::ESelectionTargetSegment), OnlySelected(rSelection, NVX::ESelectionTarget)};
	if (std::exchange(m_Selected, selected) != selected)
		emit Changed();
}

void VRetargetSetupSelection::Set(std::size_t i_Which, std::int32_t i_Index)
{
	if (std::exchange(m_Selected[i_Which], i_Index) != i_Index)
		emit Changed();
}
