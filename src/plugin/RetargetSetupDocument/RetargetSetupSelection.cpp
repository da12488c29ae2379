#include "RetargetSetupDocument/RetargetSetupSelection.h"

#include "RetargetSetupCore/Identity.h"
#include "TesselPluginInterface/IDispatcher.h"
#include "TesselPluginInterface/ISelectionManager.h"

#include <utility>

namespace
{

constexpr std::array c_Kinds{NVX::ESelectionSourceSegment, NVX::ESelectionTargetSegment, NVX::ESelectionTarget};

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

void VRetargetSetupSelection::SelectTarget(int i_Index)
{
	TesselPluginInterface::ISelection& rSelection = m_pSelectionManager->Selection();
	rSelection.Remove(rSelection.ItemsOfKind(NVX::ESelectionTarget));
	rSelection.Add({{NVX::ESelectionTarget, RetargetSetup::c_SubjectId, std::uint32_t(i_Index), {}}});
}

void VRetargetSetupSelection::Update()
{
	const TesselPluginInterface::ISelection& rSelection = m_pSelectionManager->Selection();
	std::array<std::int32_t, 3> selected{-1, -1, -1};
	std::array<std::int32_t, 3> counts{};
	for (std::size_t i = 0; i < c_Kinds.size(); ++i)
		for (const NVX::ISelectionItem& rItem : rSelection.ItemsOfKind(c_Kinds[i]))
			if (rItem.m_SubjectId == RetargetSetup::c_SubjectId)
				selected[i] = ++counts[i] == 1 ? std::int32_t(rItem.m_ElementIndex) : -1;
	if (std::exchange(m_Counts, counts) != counts)
		emit countsChanged();
	if (std::exchange(m_Selected, selected) != selected)
		emit Changed();
}

void VRetargetSetupSelection::Set(std::size_t i_Which, std::int32_t i_Index)
{
	if (std::exchange(m_Selected[i_Which], i_Index) != i_Index)
		emit Changed();
}

#include "moc_RetargetSetupSelection.cpp"
