#include "RetargetSetupDocument/StaleSelection.h"

#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/RetargetSetupCore.h"
#include "TesselPluginInterface/ISelectionManager.h"

#include <algorithm>
#include <iterator>

namespace RetargetSetup
{

using CoreOrlexTypes::VSubjectParametrised;

void DropStaleItems(const VRetargetSetupCore& i_rDocument, TesselPluginInterface::ISelectionManager& io_rManager,
    const VReplacedSubjects& i_rReplaced)
{
	const auto pSource = i_rDocument.SourceValues().m_pParametrised;
	const auto pTarget = i_rDocument.TargetValues().m_pParametrised;
	const auto isStale = [&](const NVX::ISelectionItem& i_rItem)
	{
		const auto beyond = [&i_rItem](const auto& i_rpSubject, auto i_pList)
		{ return !i_rpSubject || i_rItem.m_ElementIndex >= ((*i_rpSubject).*i_pList).size(); };
		if (i_rItem.m_SubjectId != c_SubjectId)
			return false;
		switch (i_rItem.m_Kind)
		{
		case NVX::ESelectionSourceSegment:
			return i_rReplaced.m_bSource || beyond(pSource, &VSubjectParametrised::m_Segments);
		case NVX::ESelectionTargetSegment:
			return i_rReplaced.m_bTarget || beyond(pTarget, &VSubjectParametrised::m_Segments);
		case NVX::ESelectionTarget: return i_rReplaced.m_bTarget || beyond(pTarget, &VSubjectParametrised::m_Targets);
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
