#include "RetargetSetupDocument/StaleSelection.h"

#include "RetargetSetupDocument/Identity.h"
#include "RetargetSetupDocument/RetargetSetup.h"
#include "TesselPluginInterface/ISelectionManager.h"

#include <algorithm>
#include <iterator>

namespace RetargetSetup
{

void DropStaleItems(const VRetargetSetup& i_rDocument, TesselPluginInterface::ISelectionManager& io_rManager,
    const VReplacedSubjects& i_rReplaced)
{
	const auto isStale = [&](const NVX::ISelectionItem& i_rItem)
	{
		const auto beyond = [&i_rItem](const QAbstractItemModel& i_rList)
		{ return i_rItem.m_ElementIndex >= std::uint32_t(i_rList.rowCount()); };
		if (i_rItem.m_SubjectId != c_SubjectId)
			return false;
		switch (i_rItem.m_Kind)
		{
		case NVX::ESelectionSourceSegment: return i_rReplaced.m_bSource || beyond(*i_rDocument.GetSourceSegmentModel());
		case NVX::ESelectionTargetSegment: return i_rReplaced.m_bTarget || beyond(*i_rDocument.GetTargetSegmentModel());
		case NVX::ESelectionTarget: return i_rReplaced.m_bTarget || beyond(*i_rDocument.GetTargetModel());
		default: return false;
		}
	};
	for (auto* const pSelection : {&io_rManager.Selection(), &io_rManager.PreSelection()})
	{
		std::vector<NVX::ISelectionItem> stale;
		std::copy_if(pSelection->Items().begin(), pSelection->Items().end(), std::back_inserter(stale), isStale);
		if (!stale.empty())
			pSelection->Remove(stale);
	}
}

} // namespace RetargetSetup
