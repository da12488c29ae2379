#include "retarget/subject/RecordKinematics.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Messages.h"

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "DebugServices/GlobalLog.h"

#include <algorithm>

namespace CommandLine
{

namespace SubjectParametrisedConverter = CoreOrlexTypesUtils::SubjectParametrisedConverter;

CoreOrlexTypesUtils::VSubjectKinematics KinematicsOf(
    const std::string& i_rFile, const CoreOrlexTypes::VSubjectRecord& i_rRecord)
{
	CoreOrlexTypes::VSubject subject;
	const auto failures = SubjectParametrisedConverter::ConvertAllOfSubject(i_rRecord.m_SubjectParametrised, subject);
	const auto leaveOut = [&](std::size_t i_Index, const std::string& i_rReason)
	{
		const auto& rNamed = i_rRecord.m_SubjectApplicationData.m_Targets;
		NVX_LOG(c_pCategory, NVX::ELogWarning, "Target #%1% \"%2%\" is left out: %3%", i_Index,
		    i_Index < rNamed.size() ? rNamed[i_Index].m_Name : std::string(), i_rReason);
	};
	for (const auto& rFailure : failures)
	{
		leaveOut(rFailure.m_Index, "its state does not evaluate: " + rFailure.m_Reason);
		subject.m_Targets[rFailure.m_Index].m_Type = CoreOrlexTypes::VSubject::VTarget::EBadTargetType;
	}
	CoreOrlexTypesUtils::VSubjectKinematics kinematics(subject);
	if (!kinematics.IsBuilt())
		throw VCommandError(
		    EBadInput, "\"" + i_rFile + "\" has segments that make no tree, or more than one: they have no kinematics");
	for (std::size_t i = 0; i < subject.m_Targets.size(); ++i)
		if (!kinematics.Target(i)
		    && std::ranges::find(failures, i, &SubjectParametrisedConverter::VTargetFailure::m_Index) == failures.end())
			leaveOut(i, "it does not fit its type, or has one without kinematics");
	return kinematics;
}

} // namespace CommandLine
