#include "RetargetSetupCore/Partner.h"

#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/RestSkeletons.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "SetupProposal/Partner.h"

namespace RetargetSetup
{

std::int32_t FindPartner(const CoreOrlexTypes::VSubjectParametrised& i_rParametrised,
    const CoreOrlexTypes::VSubject& i_rSubject, std::size_t i_SegmentIndex)
{
	if (const std::int32_t mirror = FindMirrorSegment(i_rParametrised, i_SegmentIndex); mirror != -1)
		return mirror;
	const SetupProposal::VPartner partner =
	    SetupProposal::FindPartner(RestOf(i_rParametrised, i_rSubject), i_SegmentIndex);
	if (partner.m_Rule != SetupProposal::EPartnerRule::None)
		NVX_LOG(c_LogCategory, NVX::ELogInformation, "The partner of segment '%1%' is '%2%', by %3%",
		    i_rParametrised.m_Segments[i_SegmentIndex].m_Name,
		    i_rParametrised.m_Segments[std::size_t(partner.m_Joint)].m_Name,
		    partner.m_Rule == SetupProposal::EPartnerRule::Names ? "the words for sides in their names"
		                                                         : "their places in the bind pose");
	return std::int32_t(partner.m_Joint);
}

} // namespace RetargetSetup
