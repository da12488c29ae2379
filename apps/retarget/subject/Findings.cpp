#include "retarget/subject/Findings.h"

#include "CoreOrlexTypesUtils/check/SubjectCheck.h"

namespace CommandLine
{

using CoreOrlexTypesUtils::VSubjectFinding;

VFindings FindingsOf(const CoreOrlexTypes::VSubjectRecord& i_rRecord)
{
	VFindings findings = CoreOrlexTypesUtils::FindSubjectFaults(i_rRecord.m_SubjectParametrised);
	const auto& rTargets = i_rRecord.m_SubjectApplicationData.m_Targets;
	for (VSubjectFinding& rFinding : findings)
		if (rFinding.m_Element == VSubjectFinding::ETarget && rFinding.m_Index < rTargets.size())
			rFinding.m_Name = rTargets[rFinding.m_Index].m_Name;
	return findings;
}

const char* KindOf(VSubjectFinding::EElement i_Element)
{
	switch (i_Element)
	{
	case VSubjectFinding::EStaticParameter: return "static parameter";
	case VSubjectFinding::EMarker: return "marker";
	case VSubjectFinding::ESegment: return "segment";
	case VSubjectFinding::ETarget: return "target";
	}
	return "";
}

} // namespace CommandLine
