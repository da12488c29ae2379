#include "SetupReview/rebind/RebindDocument.h"

#include "RetargetSetupCore/RestSkeletons.h"
#include "RetargetSetupCore/StepNames.h"
#include "UtilsFileSystem/Paths.h"

namespace SetupReview
{

std::optional<VRebound> ReboundOf(const VRetargetSetupCore& i_rDocument, bool i_bPerformer, double i_LeastScore)
{
	const auto source = i_rDocument.SourceValues();
	const auto target = i_rDocument.TargetValues();
	const auto pSkeleton = i_rDocument.GetFBXSkeleton();
	if (!target.m_pParametrised || !target.m_pApplicationData || !target.m_pSubject
	    || (i_bPerformer ? !source.m_pParametrised : !pSkeleton))
		return std::nullopt;
	const VSetup setup{{*target.m_pParametrised, *target.m_pApplicationData}, i_rDocument.GetTargetExtras()};
	if (i_bPerformer)
		return RebindPerformer(setup, RetargetSetup::RestOf(*source.m_pParametrised, *source.m_pSubject),
		    RetargetSetup::RestOf(*target.m_pParametrised, *target.m_pSubject), i_rDocument.GetShownSourceName(),
		    i_LeastScore);
	return RebindCharacter(
	    setup, {*pSkeleton, i_rDocument.GetTargetAxisMatrix(), i_rDocument.GetTargetName(), {}}, i_LeastScore);
}

bool TakeOver(VRetargetSetupCore& io_rDocument, const VRebound& i_rRebound, bool i_bPerformer, bool i_bMeasure)
{
	RetargetSetup::VEdit edit{RetargetSetup::Steps::c_Rebind};
	if (!i_rRebound.m_Lost.empty())
		edit.m_Commands.push_back({"allow-partial", {}, {}, {}});
	if (i_bPerformer)
		edit.m_Commands.push_back({"rebind-source", {}, {}, {}});
	else
		edit.m_Commands.push_back(
		    {RetargetSetup::c_RebindFbxCommand, UtilsFileSystem::ToUtf8(io_rDocument.GetTargetFBXPath()), {}, {}});
	// A file that was written over cannot be read as it was.
	if (!i_bPerformer && io_rDocument.StepsReadAgain(io_rDocument.GetTargetFBXPath()))
		edit.m_Commands.clear();
	bool bTaken = false;
	io_rDocument.RunStep({RetargetSetup::Steps::c_Rebind},
	    [&]
	    {
		    const auto& rRecord = i_rRebound.m_Setup.m_Record;
		    bTaken = io_rDocument.SetTargetSubject(
		        rRecord.m_SubjectParametrised, rRecord.m_SubjectApplicationData, i_rRebound.m_Setup.m_Extras, edit);
		    if (bTaken && i_bMeasure)
			    io_rDocument.UpdateTargets();
	    });
	return bTaken;
}

} // namespace SetupReview
