#include "SetupReview/rebind/Renaming.h"

#include "RetargetSetupCore/RetargetTargets.h"

#include <algorithm>

namespace SetupReview
{

namespace
{

using VTarget = CoreOrlexTypes::VSubjectParametrised::VTarget;

} // namespace

std::string TargetName(const CoreOrlexTypes::VSubjectParametrised& i_rSubject, std::size_t i_Target)
{
	const VTarget& rTarget = i_rSubject.m_Targets[i_Target];
	const std::string* const pSource = RetargetSetup::SourceName(i_rSubject, rTarget);
	const std::string* const pSegment = RetargetSetup::TargetSegmentName(i_rSubject, rTarget);
	if (!pSource || !pSegment)
		return "";
	return *pSource + (rTarget.m_Type == VTarget::ELocalPointToWorldPoint ? ">" : "}") + *pSegment;
}

std::vector<std::string> StandardTargetNames(const VSetup& i_rSetup)
{
	const auto& rTargets = i_rSetup.m_Record.m_SubjectApplicationData.m_Targets;
	std::vector<std::string> names(i_rSetup.m_Record.m_SubjectParametrised.m_Targets.size());
	for (std::size_t i = 0; i < std::min(names.size(), rTargets.size()); ++i)
		if (const std::string name = TargetName(i_rSetup.m_Record.m_SubjectParametrised, i); name == rTargets[i].m_Name)
			names[i] = name;
	return names;
}

void RenameTargets(VSetup& io_rSetup, const std::vector<std::string>& i_rBefore)
{
	auto& rTargets = io_rSetup.m_Record.m_SubjectApplicationData.m_Targets;
	VRenames renames;
	for (std::size_t i = 0; i < std::min(i_rBefore.size(), rTargets.size()); ++i)
		if (!i_rBefore[i].empty())
		{
			rTargets[i].m_Name = TargetName(io_rSetup.m_Record.m_SubjectParametrised, i);
			renames.emplace(i_rBefore[i], rTargets[i].m_Name);
		}
	for (auto& rTarget : io_rSetup.m_Extras.m_Targets)
		if (const auto found = renames.find(rTarget.m_Name); found != renames.end())
			rTarget.m_Name = found->second;
}

} // namespace SetupReview
