#include "retarget/report/Report.h"

#include "CommandLineText/ExitStatus.h"
#include "retarget/report/Page.h"
#include "retarget/subject/Advice.h"
#include "retarget/subject/Findings.h"
#include "retarget/subject/PlayedTake.h"
#include "retarget/subject/Session.h"
#include "retarget/subject/SolvePlot.h"
#include "retarget/subject/TargetLines.h"
#include "retarget/text/InputFile.h"
#include "retarget/text/Table.h"

#include "FileDigest/FileDigest.h"
#include "RetargetSetupCore/FilePath.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "RetargetSetupCore/RestSkeletons.h"
#include "SetupProposal/BodyParts.h"
#include "UtilsFileSystem/Paths.h"
#include "numerics/Rotation.h"

#include <boost/filesystem/operations.hpp>

#include <algorithm>
#include <cmath>
#include <set>

namespace CommandLine
{
namespace
{

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;
using VTarget = VSubjectParametrised::VTarget;
using VRows = std::vector<std::vector<std::string>>;

/// Without the folder: the same files in another place give the same page.
std::string NameOfFile(const std::string& i_rPath)
{
	return i_rPath == c_pStandardStream ? "standard input"
	                                    : UtilsFileSystem::ToUtf8(UtilsFileSystem::PathFromUtf8(i_rPath).filename());
}

std::string DigestOf(const std::string& i_rPath)
{
	if (i_rPath == c_pStandardStream)
		return "not known, of a stream";
	std::string error;
	const std::optional<std::string> digest = FileDigest::Sha256(UtilsFileSystem::PathFromUtf8(i_rPath), error);
	if (!digest)
		throw VCommandError(EBadInput, error);
	return *digest;
}

void AddFiles(const VReportSettings& i_rSettings, VPage& io_rPage)
{
	VRows rows;
	for (const auto& [pWhat, pPath] : {std::pair{"Retarget subject", &i_rSettings.m_In},
	         {"Performer", &i_rSettings.m_Source}, {"Character", &i_rSettings.m_Fbx}, {"Take", &i_rSettings.m_Take}})
		if (!pPath->empty())
			rows.push_back({pWhat, NameOfFile(*pPath), DigestOf(*pPath)});
	io_rPage.Heading("Files");
	io_rPage.Table({"What", "File", "SHA-256"}, rows);
}

void AddFacts(VSession& io_rSession, VPage& io_rPage)
{
	const VSubjectParametrised& rSubject = io_rSession.Target();
	const auto pData = io_rSession.Document().TargetValues().m_pApplicationData;
	const auto joints = std::ranges::count_if(rSubject.m_Segments,
	    [](const auto& i_rSegment) { return i_rSegment.m_Joint.m_JointType != VSubjectParametrised::VJoint::EDummy; });
	io_rPage.Heading("At a glance");
	io_rPage.Table({"What", "Value"},
	    {{"Made of the character's file", pData->m_Skin}, {"Made for the performer", pData->m_RetargetSourceTemplate},
	        {"Scale", Shortest(RetargetSetup::GetGlobalScale(rSubject))},
	        {"Segments", std::to_string(rSubject.m_Segments.size())}, {"Joints", std::to_string(joints)},
	        {"Targets", std::to_string(rSubject.m_Targets.size())}, {"Written by", "retarget " RETARGET_VERSION}});
}

/// Front and side, with the skin where it is known which file it is in.
void AddPictures(const VReportSettings& i_rSettings, const VRender& i_rRender, const std::string& i_rSkin,
    VPage& io_rPage, VReport& io_rReport)
{
	io_rPage.Heading("Pictures");
	const bool bSkin = !i_rSettings.m_Fbx.empty() && i_rSettings.m_Fbx != c_pStandardStream
	    && RetargetSetup::FileStem(UtilsFileSystem::PathFromUtf8(i_rSettings.m_Fbx)) == i_rSkin;
	std::vector<std::string> captions;
	std::vector<std::string> pictures;
	if (!i_rSettings.m_bPictures)
		io_rReport.m_NoPictures = "Pictures were not asked for";
	else if (!i_rRender.m_Picture)
		io_rReport.m_NoPictures = "This program draws no pictures";
	else if (i_rSettings.m_In == c_pStandardStream || i_rSettings.m_Source == c_pStandardStream)
		io_rReport.m_NoPictures = "What came by standard input is not drawn";
	for (const bool bWithSkin : {false, true})
		for (const char* const pView : {"front", "left"})
		{
			if (!io_rReport.m_NoPictures.empty() || (bWithSkin && !bSkin))
				continue;
			VRenderSettings settings;
			settings.m_In = i_rSettings.m_In;
			settings.m_Source = i_rSettings.m_Source;
			settings.m_View = pView;
			settings.m_Width = 640;
			settings.m_Height = 560;
			if (bWithSkin)
			{
				const auto folder = UtilsFileSystem::PathFromUtf8(i_rSettings.m_Fbx).parent_path();
				settings.m_Skins = folder.empty() ? "." : UtilsFileSystem::ToUtf8(folder);
			}
			try
			{
				pictures.push_back(i_rRender.m_Picture(settings));
				captions.push_back(std::string(pView) + (bWithSkin ? ", with the skin" : ", without the skin"));
			}
			catch (const VCommandError& rError)
			{
				io_rReport.m_NoPictures = rError.what();
			}
		}
	io_rPage.Pictures(captions, pictures);
	io_rReport.m_Pictures = pictures.size();
	if (!io_rReport.m_NoPictures.empty())
		io_rPage.Paragraph("Pictures are left out. " + io_rReport.m_NoPictures + ".");
	else if (!bSkin)
		io_rPage.Paragraph("No pictures with the skin: the character's file was not given, or is not the one that the "
		                   "subject was made of.");
}

std::string OffsetText(const VSubject::VTarget& i_rTarget)
{
	const std::vector<double>& rState = i_rTarget.m_State;
	if (rState.size() == 3 && i_rTarget.m_Type == VSubject::VTarget::ELocalRotationToWorldRotation)
	{
		const Rotation::VVector3 turn = Rotation::CanonicalAngleAxis({rState[0], rState[1], rState[2]});
		return Fixed(AsDegrees(std::hypot(turn[0], turn[1], turn[2])), 1) + " deg";
	}
	std::string text;
	for (const double value : rState)
		text += (text.empty() ? "" : ", ") + Fixed(value, 1);
	return text.empty() ? "-" : text + " mm";
}

void AddTargets(VSession& io_rSession, bool i_bSource, VPage& io_rPage)
{
	const auto pSubject = io_rSession.Document().TargetValues().m_pSubject;
	const std::vector<VTargetLine> lines = TargetLines(io_rSession, i_bSource);
	std::vector<std::string> columns{"#No.", "Type", "Performer", "Character", "#Weight", "#Offset"};
	if (i_bSource)
		columns.push_back("#Residual");
	VRows rows;
	for (std::size_t i = 0; i < lines.size(); ++i)
	{
		rows.push_back({std::to_string(i), lines[i].m_Kind, lines[i].m_Source, lines[i].m_Target,
		    Shortest(lines[i].m_Weight), OffsetText(pSubject->m_Targets[i])});
		if (i_bSource)
			rows.back().push_back(ResidualText(lines[i].m_Residual.m_Offset));
	}
	io_rPage.Heading("Targets");
	if (rows.empty())
		return io_rPage.Paragraph("There is none.");
	io_rPage.Table(columns, rows);
	if (!i_bSource)
		io_rPage.Paragraph("Without the performer's skeleton there are no residuals.");
}

/// For each segment whether targets tie its position, and its rotation.
std::vector<std::pair<bool, bool>> TiedSegments(const VSubjectParametrised& i_rSubject)
{
	std::vector<std::pair<bool, bool>> tied(i_rSubject.m_Segments.size());
	for (const VTarget& rTarget : i_rSubject.m_Targets)
		for (const std::uint32_t segment : rTarget.m_SegmentIndices)
			if (segment < tied.size())
				(rTarget.m_Type == VTarget::ELocalRotationToWorldRotation ? tied[segment].second
				                                                          : tied[segment].first) = true;
	return tied;
}

void AddCoverage(VSession& io_rSession, VPage& io_rPage)
{
	const auto target = io_rSession.Document().TargetValues();
	const auto rest = RetargetSetup::RestOf(*target.m_pParametrised, *target.m_pSubject);
	const auto tied = TiedSegments(*target.m_pParametrised);
	io_rPage.Heading("Coverage by part of the body");
	if (rest.size() != tied.size() || rest.empty())
		return io_rPage.Paragraph("The segments make no tree.");
	const SetupProposal::VBodyReading reading = SetupProposal::ReadBody(rest);
	VRows rows;
	for (std::size_t part = 0; part < SetupProposal::c_BodyParts; ++part)
	{
		std::size_t segments = 0;
		std::size_t positions = 0;
		std::size_t rotations = 0;
		std::string without;
		for (std::size_t i = 0; i < tied.size(); ++i)
			if (reading.m_Joints[i].m_Part == part)
			{
				++segments;
				positions += tied[i].first;
				rotations += tied[i].second;
				if (!tied[i].first && !tied[i].second)
					without += (without.empty() ? "" : ", ") + rest[i].m_Name;
			}
		if (segments > 0)
			rows.push_back({SetupProposal::NameOf(SetupProposal::EBodyPart(part)), std::to_string(segments),
			    std::to_string(positions), std::to_string(rotations), without.empty() ? "-" : without});
	}
	io_rPage.Table({"Part", "#Segments", "#With position", "#With rotation", "Without a target"}, rows);
}

/// What the performer has and no target follows; what the character lacks stands in the table of coverage.
void AddUnmapped(VSession& io_rSession, VPage& io_rPage)
{
	const auto source = io_rSession.Document().SourceValues();
	io_rPage.Heading("Segments of the performer that nothing follows");
	if (!source.m_pParametrised)
		return io_rPage.Paragraph("The performer's skeleton was not given.");
	std::set<std::string> followed;
	for (const VTarget& rTarget : io_rSession.Target().m_Targets)
		for (const std::string& rName : FollowedNames(io_rSession.Target(), rTarget))
			followed.insert(rName);
	std::string names;
	for (const auto& rSegment : source.m_pParametrised->m_Segments)
		if (!followed.contains(rSegment.m_Name))
			names += (names.empty() ? "" : ", ") + rSegment.m_Name;
	io_rPage.Paragraph(names.empty() ? "There is none." : names);
}

void AddAdvice(VSession& io_rSession, const VReportSettings& i_rSettings, VPage& io_rPage)
{
	const SetupReview::VAdvice advice = AdviceOn(io_rSession, i_rSettings.m_Fbx);
	VRows rows;
	for (const SetupReview::VPruneAdvice& rAdvice : advice.m_Prune)
		rows.push_back(
		    {io_rSession.Target().m_Segments[rAdvice.m_Segment].m_Name, SetupReview::NameOf(rAdvice.m_Verdict),
		        SetupReview::PoseChangeText(rAdvice, io_rSession.Target()), rAdvice.m_Words});
	io_rPage.Heading("Joints without a target of their own");
	if (rows.empty())
		io_rPage.Paragraph("There is none.");
	else
		io_rPage.Table({"Joint", "Verdict", "Bind pose without it", "Why"}, rows);
	io_rPage.Heading("Range of motion");
	if (!advice.m_Range)
		return io_rPage.Paragraph("The performer's skeleton was not given.");
	io_rPage.Paragraph(SetupReview::RangeSummary(*advice.m_Range) + ".");
	VRows conflicts;
	for (const SetupReview::VRangeConflict& rConflict : advice.m_Range->m_Conflicts)
		conflicts.push_back({rConflict.m_AgainstName, rConflict.m_TargetName, rConflict.m_Words});
	if (!conflicts.empty())
		io_rPage.Table({"Pulls", "Against", "Which"}, conflicts);
}

/// What the targets are off by while a take plays, and what an animator would look for.
void AddTake(VSession& io_rSession, const VReportSettings& i_rSettings, VPage& io_rPage)
{
	if (i_rSettings.m_Take.empty())
		return;
	VTakeToPlay what;
	what.m_Subject = i_rSettings.m_In;
	what.m_Take = i_rSettings.m_Take;
	what.m_Source = i_rSettings.m_Source;
	const auto pPlayed = PlayTake(io_rSession, what);
	const VSolveResult result = pPlayed->Result();
	io_rPage.Heading("With the take " + NameOfFile(i_rSettings.m_Take));
	io_rPage.Drawing("What the targets are off by, over the frames; the worst of each kind are named. Solved by a "
	                 "stand-in for the host's solve.",
	    SolvePlot(result));
	VRows rows;
	for (std::size_t i = 0; i < result.m_rReport.m_Targets.size(); ++i)
	{
		const VSubject::VTarget& rTarget = result.m_rTarget.m_Targets[i];
		const TakeSolve::VTargetQuality& rQuality = result.m_rReport.m_Targets[i];
		const double factor = UnitFactor(rTarget);
		if (rQuality.m_Frames > 0)
			rows.push_back(
			    {std::to_string(i), SourceOf(result.m_rTarget, rTarget) + " to " + TargetOf(result.m_rTarget, rTarget),
			        Fixed(factor * rQuality.m_Rms, 1), Fixed(factor * rQuality.m_P95, 1),
			        Fixed(factor * rQuality.m_Max, 1), UnitOf(rTarget), std::to_string(rQuality.m_MaxFrame)});
	}
	io_rPage.Table({"#No.", "Target", "#Rms", "#95 %", "#Most", "Unit", "#In frame"}, rows);
	std::vector<std::string> findings;
	for (const TakeSolve::VFinding& rFinding : CommandLine::FindingsOf(result))
		findings.push_back(rFinding.m_Message);
	if (!findings.empty())
		io_rPage.List(findings);
}

void AddFindings(VSession& io_rSession, VPage& io_rPage, VReport& io_rReport)
{
	const auto target = io_rSession.Document().TargetValues();
	VRows rows;
	for (const auto& rFinding : FindingsOf({*target.m_pParametrised, *target.m_pApplicationData}))
		rows.push_back({KindOf(rFinding.m_Element), std::to_string(rFinding.m_Index), rFinding.m_Name,
		    rFinding.m_Message + (rFinding.m_bTolerated ? " (tolerated)" : ""), rFinding.m_Remedy});
	io_rReport.m_Findings = rows.size();
	io_rPage.Heading("Findings of the check");
	if (rows.empty())
		return io_rPage.Paragraph("There is none.");
	io_rPage.Table({"Kind", "#No.", "Name", "What", "Remedy"}, rows);
}

} // namespace

VReport MakeReport(const VReportSettings& i_rSettings, const VRender& i_rRender)
{
	VSession session;
	session.LoadTarget(i_rSettings.m_In);
	if (!i_rSettings.m_Source.empty())
		session.LoadSource(i_rSettings.m_Source);
	VReport report;
	report.m_Targets = session.Target().m_Targets.size();
	VPage page("Retarget subject " + NameOfFile(i_rSettings.m_In));
	AddFacts(session, page);
	AddFiles(i_rSettings, page);
	AddPictures(i_rSettings, i_rRender, session.Document().TargetValues().m_pApplicationData->m_Skin, page, report);
	AddTargets(session, !i_rSettings.m_Source.empty(), page);
	AddCoverage(session, page);
	AddUnmapped(session, page);
	AddAdvice(session, i_rSettings, page);
	AddTake(session, i_rSettings, page);
	AddFindings(session, page, report);
	report.m_Text = page.Text();
	return report;
}

} // namespace CommandLine
