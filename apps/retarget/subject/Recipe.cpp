#include "retarget/subject/Recipe.h"

#include "retarget/subject/Aligning.h"
#include "retarget/subject/Residuals.h"
#include "retarget/text/Table.h"

#include "CoreOrlexTypesUtils/check/SubjectCheck.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace CommandLine
{
namespace
{

void CheckCount(const char* i_pWhat, const std::optional<std::size_t>& i_rWanted, std::size_t i_Count,
    std::vector<std::string>& io_rBroken)
{
	if (i_rWanted && *i_rWanted != i_Count)
		io_rBroken.push_back(
		    "there are " + std::to_string(i_Count) + " " + i_pWhat + ", not " + std::to_string(*i_rWanted));
}

void CheckResiduals(VSession& io_rSession, const SetupIO::VChecks& i_rChecks, std::vector<std::string>& io_rBroken)
{
	if (!i_rChecks.m_ResidualMm && !i_rChecks.m_ResidualDegrees)
		return;
	io_rSession.Source("A check of residuals");
	const auto target = io_rSession.Document().TargetValues();
	const std::vector<VTargetResidual> residuals = Residuals(io_rSession.Document().SourceValues(), target);
	const auto check =
	    [&](std::size_t i_Index, const std::optional<double>& i_rLimit, double i_Value, const char* i_pUnit)
	{
		// A residual that is no number meets no limit.
		if (i_rLimit && !(i_Value <= *i_rLimit))
			io_rBroken.push_back("target #" + std::to_string(i_Index) + " \""
			    + target.m_pApplicationData->m_Targets[i_Index].m_Name + "\" is " + Fixed(i_Value, 3) + " " + i_pUnit
			    + " from what it asks for, more than " + Shortest(*i_rLimit));
	};
	for (std::size_t i = 0; i < residuals.size(); ++i)
	{
		const VResidual& rResidual = residuals[i].m_Offset;
		if (rResidual.m_Distance)
			check(i, i_rChecks.m_ResidualMm, *rResidual.m_Distance, "mm");
		if (rResidual.m_Angle)
			check(i, i_rChecks.m_ResidualDegrees, *rResidual.m_Angle * 180.0 / std::numbers::pi, "degrees");
	}
}

void CheckPoses(VSession& io_rSession, const std::vector<std::string>& i_rIds, std::vector<std::string>& io_rBroken)
{
	if (i_rIds.empty())
		return;
	io_rSession.Source("A check of the pose");
	const auto findings = PoseFindingsOf(io_rSession);
	for (const std::string& rId : i_rIds)
	{
		const auto found = std::ranges::find_if(
		    findings, [&](const SetupProposal::VPoseFinding& i_rFinding) { return rId == i_rFinding.m_pId; });
		if (found == findings.end())
			io_rBroken.push_back("nothing is known of the pose's \"" + rId + "\"");
		else if (!found->m_bFine)
			io_rBroken.push_back(found->m_Message);
	}
}

} // namespace

std::vector<std::string> BrokenChecks(VSession& io_rSession, const SetupIO::VChecks& i_rChecks)
{
	std::vector<std::string> broken;
	const CoreOrlexTypes::VSubjectParametrised& rSubject = io_rSession.Target();
	CheckCount("segments", i_rChecks.m_Segments, rSubject.m_Segments.size(), broken);
	CheckCount("joints", i_rChecks.m_Joints, io_rSession.CountJoints(), broken);
	CheckCount("targets", i_rChecks.m_Targets, rSubject.m_Targets.size(), broken);
	if (i_rChecks.m_bSound)
		for (const auto& rFinding : CoreOrlexTypesUtils::FindSubjectFaults(rSubject))
			broken.push_back("the subject is not sound: " + rFinding.m_Message);
	CheckResiduals(io_rSession, i_rChecks, broken);
	CheckPoses(io_rSession, i_rChecks.m_Pose, broken);
	return broken;
}

} // namespace CommandLine
