#include "retarget/subject/Aligning.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Messages.h"
#include "retarget/subject/Mapping.h"
#include "retarget/text/PoseFindings.h"
#include "retarget/text/Table.h"

#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/RestSkeletons.h"

#include <algorithm>
#include <cmath>
#include <iterator>
#include <sstream>
#include <string_view>
#include <unistd.h>
#include <utility>

namespace CommandLine
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using SetupProposal::VAlignment;

/// To so many decimals, and never a zero with a sign.
double Rounded(double i_Value, int i_Decimals)
{
	const double unit = std::pow(10.0, i_Decimals);
	return std::round(unit * i_Value) / unit + 0.0;
}

/// What the target subject was scaled by before, and why.
std::string ScaleText(const SetupProposal::VPoseFinding& i_rFinding, double i_Scale)
{
	return i_rFinding.m_Message + ": it is scaled by " + Shortest(SetupProposal::SuggestedScale(i_rFinding))
	    + ", as --root-height scale --scale " + Shortest(i_Scale)
	    + " before --align does; --scale keep leaves its size";
}

VJson ToJson(
    const VAlignment& i_rAlignment, const VSubjectParametrised& i_rSource, const VSubjectParametrised& i_rTarget)
{
	VJson joints = VJson::array();
	for (const auto& rJoint : i_rAlignment.m_Joints)
	{
		joints.push_back({{"target", i_rTarget.m_Segments[rJoint.m_Target].m_Name},
		    {"source", i_rSource.m_Segments[rJoint.m_Source].m_Name}, {"beforeDegrees", Rounded(rJoint.m_Before, 3)},
		    {"afterDegrees", Rounded(rJoint.m_After, 3)}});
		if (!rJoint.m_Note.empty())
			joints.back()["note"] = rJoint.m_Note;
	}
	VJson refused = VJson::array();
	for (const auto& rChain : i_rAlignment.m_Refused)
		refused.push_back({{"chain", rChain.m_Chain}, {"reason", rChain.m_Reason}});
	const Rotation::VVector3& rMove = i_rAlignment.m_MoveMm;
	return {{"turnDegrees", Rounded(i_rAlignment.m_TurnDegrees, 3)},
	    {"moveMm", {Rounded(rMove[0], 3), Rounded(rMove[1], 3)}}, {"liftMm", Rounded(rMove[2], 3)}, {"joints", joints},
	    {"refused", refused}};
}

std::string ToText(
    const VAlignment& i_rAlignment, const VSubjectParametrised& i_rSource, const VSubjectParametrised& i_rTarget)
{
	const Rotation::VVector3& rMove = i_rAlignment.m_MoveMm;
	VTable table;
	table.AddColumn("TARGET", VTable::ELeft);
	table.AddColumn("SOURCE", VTable::ELeft);
	table.AddColumn("BEFORE", VTable::ERight);
	table.AddColumn("AFTER", VTable::ERight);
	table.AddColumn("NOTE", VTable::ELeft);
	for (const auto& rJoint : i_rAlignment.m_Joints)
		table.AddRow({i_rTarget.m_Segments[rJoint.m_Target].m_Name, i_rSource.m_Segments[rJoint.m_Source].m_Name,
		    Fixed(rJoint.m_Before, 1), Fixed(rJoint.m_After, 1), rJoint.m_Note});
	return "Degrees between the directions of segments\n" + table.Text(HasColours(STDOUT_FILENO)) + "Turned by "
	    + Fixed(Rounded(i_rAlignment.m_TurnDegrees, 1), 1) + " degrees as a whole, moved by "
	    + Fixed(std::hypot(rMove[0], rMove[1]), 1) + " mm along the floor, lifted by " + Fixed(Rounded(rMove[2], 1), 1)
	    + " mm\n";
}

} // namespace

void ChooseChain(VSession& io_rSession, const std::string& i_rChains)
{
	RetargetSetup::VAlignmentChoice& rChoice = io_rSession.m_Alignment;
	const std::pair<const char*, bool*> chains[] = {{"spine", &rChoice.m_bSpine}, {"arms", &rChoice.m_bArms},
	    {"legs", &rChoice.m_bLegs}, {"others", &rChoice.m_bOthers}};
	for (const auto& [pName, pWanted] : chains)
		*pWanted = i_rChains == "all";
	if (i_rChains == "all")
		return;
	std::istringstream words(i_rChains + ",");
	for (std::string word; std::getline(words, word, ',');)
	{
		const auto found =
		    std::ranges::find(chains, word, [](const auto& i_rChain) { return std::string(i_rChain.first); });
		if (found == std::end(chains))
			throw VCommandError(
			    EWrongUsage, "--chain: a chain is arms, legs, spine, others or all, not \"" + word + "\"");
		*found->second = true;
	}
}

void ChooseFeet(VSession& io_rSession, const std::string& i_rFeet)
{
	if (i_rFeet != "level" && i_rFeet != "shins")
		throw VCommandError(EWrongUsage, "--feet: feet go level or with the shins, not \"" + i_rFeet + "\"");
	io_rSession.m_Alignment.m_bFeetWithShins = i_rFeet == "shins";
}

void LockSegment(VSession& io_rSession, const std::string& i_rSegment)
{
	io_rSession.m_Alignment.m_Locked.insert(
	    FindElement(i_rSegment, SegmentsOf(io_rSession.Target(), "target segment")));
}

void UnlockSegment(VSession& io_rSession, const std::string& i_rSegment)
{
	io_rSession.m_Alignment.m_Locked.erase(FindElement(i_rSegment, SegmentsOf(io_rSession.Target(), "target segment")));
}

void StandOnJoints(VSession& io_rSession, const std::string&)
{
	io_rSession.m_Alignment.m_bOnJoints = true;
}

void AlignAsItStands(VSession& io_rSession, const std::string&)
{
	io_rSession.m_Alignment.m_bAsItStands = true;
}

void AlignTarget(VSession& io_rSession)
{
	const VSubjectParametrised& rSource = io_rSession.Source("--align");
	VRetargetSetupCore& rDocument = io_rSession.Document();
	RetargetSetup::VAlignmentChoice choice = io_rSession.m_Alignment;
	choice.m_bFitScale = io_rSession.m_bFitsScale && rDocument.GetTargetScale() == 1.0;
	const bool bFromFile = !io_rSession.m_Alignment.m_bAsItStands && rDocument.AlignsFromFilePose();
	const auto aligned = rDocument.AlignToSource(choice);
	if (!aligned)
		throw VCommandError(EBadInput, "--align: " + io_rSession.WhyIgnored());
	if (bFromFile)
		io_rSession.TookFilePose();
	const VSubjectParametrised& rTarget = io_rSession.Target();
	const VAlignment& rAlignment = aligned->m_Alignment;
	for (const auto& rChain : rAlignment.m_Refused)
		NVX_LOG(c_pCategory, NVX::ELogWarning, "--align: the %1% stays as it is: %2%", rChain.m_Chain, rChain.m_Reason);
	io_rSession.m_ReportJson["aligned"] = ToJson(rAlignment, rSource, rTarget);
	io_rSession.m_ReportText += ToText(rAlignment, rSource, rTarget);
	if (aligned->m_bScaled)
	{
		const std::string text = ScaleText(*aligned->m_Scale, rDocument.GetTargetScale());
		NVX_LOG(c_pCategory, NVX::ELogInformation, "%1%", text);
		io_rSession.m_ReportJson["aligned"]["scaledBy"] = SetupProposal::SuggestedScale(*aligned->m_Scale);
		io_rSession.m_ReportText += text + "\n";
	}
	io_rSession.m_bAligned = true;
}

std::vector<SetupProposal::VPoseFinding> PoseFindingsOf(VSession& io_rSession)
{
	const auto source = io_rSession.Document().SourceValues();
	const auto sourceRest = RetargetSetup::RestOf(*source.m_pParametrised, *source.m_pSubject);
	const auto targetRest = io_rSession.Document().TargetSkeleton();
	return SetupProposal::CheckPose(sourceRest, targetRest, SetupProposal::Propose(sourceRest, targetRest));
}

void ReportPose(VSession& io_rSession)
{
	if (!io_rSession.m_bAligned)
		return;
	const auto findings = PoseFindingsOf(io_rSession);
	io_rSession.m_ReportJson["pose"] = PoseJson(findings);
	io_rSession.m_ReportText += PoseText(findings);
}

double ScaleThatFits(VSession& io_rSession)
{
	io_rSession.Source("--scale fit");
	VRetargetSetupCore& rDocument = io_rSession.Document();
	std::vector<SetupProposal::VPoseFinding> findings;
	double scale = 1.0;
	if (rDocument.AlignsFromFilePose())
	{
		// A bind pose that nobody has made yet tells no heights.
		const VMapped mapped = ProposeForFile(io_rSession, io_rSession.m_Root);
		findings = SetupProposal::CheckPose(mapped.m_Source, mapped.m_Target, mapped.m_Proposal);
	}
	else
	{
		findings = PoseFindingsOf(io_rSession);
		scale = rDocument.GetTargetScale();
	}
	for (const SetupProposal::VPoseFinding& rFinding : findings)
		for (const auto& [pName, value] : rFinding.m_Numbers)
			if (std::string_view(pName) == "scale")
				return value * scale;
	throw VCommandError(
	    EFindings, "--scale fit: no hips and feet were found in both skeletons; --scale takes a number, too");
}

} // namespace CommandLine
