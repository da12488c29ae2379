#include "retarget/subject/SolveText.h"

#include "CommandLineText/HelpFormatter.h"
#include "CommandLineText/Messages.h"
#include "CommandLineText/System.h"
#include "numerics/Rotation.h"
#include "retarget/text/Table.h"

#include <cmath>
#include <unistd.h>

namespace CommandLine
{
namespace
{

using namespace TakeSolve;
using CoreOrlexTypes::VSubject;
using Rotation::c_Degrees;
using SetupProposal::ESide;

/// A foot may slide by this beyond the performer's, and stand so far from the floor, in mm.
constexpr double c_FineSlide = 30.0;
constexpr double c_FineHeight = 30.0;
/// What the floor of a take may be off, in mm.
constexpr double c_FineFloor = 10.0;
/// Degrees. Feet roll by half of that from stance to stance.
constexpr double c_FineLean = 10.0;
/// A knee may differ so much, in radians.
constexpr double c_FineFlexion = 16.0 / c_Degrees;
constexpr double c_FineAxis = 20.0 / c_Degrees;

const char* SideWord(ESide i_Side)
{
	return i_Side == ESide::Left ? "left" : "right";
}

double Rounded(double i_Value)
{
	return std::round(1e6 * i_Value) / 1e6;
}

std::string FrameText(std::size_t i_Frame)
{
	return "frame " + std::to_string(i_Frame);
}

/// "3, 7 and 12 more".
std::string FramesText(const std::vector<std::size_t>& i_rFrames)
{
	constexpr std::size_t c_Named = 10;
	std::string text;
	for (std::size_t i = 0; i < std::min(i_rFrames.size(), c_Named); ++i)
		text += (i == 0 ? "" : ", ") + std::to_string(i_rFrames[i]);
	if (i_rFrames.size() > c_Named)
		text += " and " + std::to_string(i_rFrames.size() - c_Named) + " more";
	return text;
}

void AddTargetRow(const VSolveResult& i_rResult, std::size_t i_Target, VTable& io_rTable)
{
	const VSubject::VTarget& rTarget = i_rResult.m_rTarget.m_Targets[i_Target];
	const VTargetQuality& rQuality = i_rResult.m_rReport.m_Targets[i_Target];
	const double factor = UnitFactor(rTarget);
	const auto number = [&](double i_Value)
	{ return rQuality.m_Frames == 0 ? std::string("-") : Fixed(factor * i_Value, 2); };
	io_rTable.AddRow({std::to_string(i_Target), number(rQuality.m_Rms), number(rQuality.m_P95), number(rQuality.m_Max),
	    rQuality.m_Frames == 0 ? "-" : std::to_string(rQuality.m_MaxFrame), UnitOf(rTarget),
	    SourceOf(i_rResult.m_rTarget, rTarget), TargetOf(i_rResult.m_rTarget, rTarget),
	    i_rResult.m_TargetNames[i_Target]});
}

std::string TargetTable(const VSolveResult& i_rResult)
{
	VTable table;
	for (const char* pTitle : {"INDEX", "RMS", "P95", "MAX", "AT FRAME"})
		table.AddColumn(pTitle, VTable::ERight);
	for (const char* pTitle : {"UNIT", "SOURCE", "TARGET", "NAME"})
		table.AddColumn(pTitle, VTable::ELeft);
	for (std::size_t i = 0; i < i_rResult.m_rReport.m_Targets.size(); ++i)
		AddTargetRow(i_rResult, i, table);
	return table.Text(HasColours(STDOUT_FILENO), TerminalWidth());
}

std::string FeetTable(const VSolveResult& i_rResult)
{
	VTable table;
	table.AddColumn("FOOT", VTable::ELeft);
	for (const char* pTitle : {"STANDS, FRAMES", "SLIDES", "PERFORMER'S", "AT FRAME", "HIGHEST", "AT FRAME", "LOWEST",
	         "OF ALL FRAMES", "AT FRAME"})
		table.AddColumn(pTitle, VTable::ERight);
	for (const VFootQuality& rFoot : i_rResult.m_rReport.m_Feet)
		table.AddRow({i_rResult.m_rTarget.m_Segments[rFoot.m_Target].m_Name, std::to_string(rFoot.m_StandingFrames),
		    Fixed(rFoot.m_Slide, 1), Fixed(rFoot.m_SourceSlide, 1), std::to_string(rFoot.m_SlideFrame),
		    Fixed(rFoot.m_Highest, 1), std::to_string(rFoot.m_HighestFrame), Fixed(rFoot.m_LowestStanding, 1),
		    Fixed(rFoot.m_Lowest, 1), std::to_string(rFoot.m_LowestFrame)});
	return table.Text(HasColours(STDOUT_FILENO), TerminalWidth());
}

std::string BendTable(const VSolveResult& i_rResult)
{
	VTable table;
	table.AddColumn("JOINT", VTable::ELeft);
	table.AddColumn("BENT OTHERWISE, P95 DEG", VTable::ERight);
	table.AddColumn("ABOUT ANOTHER AXIS, P95 DEG", VTable::ERight);
	for (const VBendQuality& rBend : i_rResult.m_rReport.m_Bends)
		table.AddRow({std::string(SideWord(rBend.m_Side)) + " " + rBend.m_Name, Fixed(c_Degrees * rBend.m_Flexion, 1),
		    rBend.m_AxisFrames == 0 ? "-" : Fixed(c_Degrees * rBend.m_Axis, 1)});
	return table.Text(HasColours(STDOUT_FILENO), TerminalWidth());
}

std::string LeansText(const std::vector<VFootQuality>& i_rFeet)
{
	std::string text;
	for (const VFootQuality& rFoot : i_rFeet)
		text += (text.empty() ? "" : " and ") + Fixed(c_Degrees * rFoot.m_SourceLean, 0);
	return text;
}

} // namespace

std::vector<VFinding> FindingsOf(const VSolveResult& i_rResult)
{
	const VSolveReport& rReport = i_rResult.m_rReport;
	const auto& rSegments = i_rResult.m_rTarget.m_Segments;
	std::vector<VFinding> findings;
	for (const auto& rPose : rReport.m_BindPoses)
		if (!rPose.m_bFine)
			findings.push_back({"bind-pose", "The bind poses do not match: " + rPose.m_Message});
	findings.insert(
	    findings.end(), i_rResult.m_rSolve.Source().Findings().begin(), i_rResult.m_rSolve.Source().Findings().end());
	findings.insert(findings.end(), i_rResult.m_rSolve.Findings().begin(), i_rResult.m_rSolve.Findings().end());
	if (std::abs(rReport.m_Floor) > c_FineFloor)
		findings.push_back({"take-floor",
		    "By the take the performer's feet stand " + Fixed(std::abs(rReport.m_Floor), 0) + " mm "
		        + (rReport.m_Floor < 0.0 ? "lower" : "higher")
		        + " than in the bind pose, and the character's go along. See where the floor of the take is, and that "
		          "of the performer; heights of feet are told from where the performer's stand."});
	if (std::ranges::any_of(rReport.m_Feet,
	        [](const VFootQuality& i_rFoot) { return std::abs(c_Degrees * i_rFoot.m_SourceLean) > c_FineLean; }))
		findings.push_back({"lean",
		    "Where the performer's feet stand in the take, their soles are turned towards each other by "
		        + LeansText(rReport.m_Feet)
		        + " degrees against the bind pose: there they most likely lean with splayed legs. A character whose "
		          "feet "
		          "are level in its bind pose stands on their edges then; --feet shins before --align lets them lean "
		          "alike."});
	for (const VFootQuality& rFoot : rReport.m_Feet)
	{
		const std::string& rName = rSegments[rFoot.m_Target].m_Name;
		if (rFoot.m_Slide > rFoot.m_SourceSlide + c_FineSlide)
			findings.push_back({"slide",
			    "The foot " + rName + " slides by " + Fixed(rFoot.m_Slide, 0) + " mm up to "
			        + FrameText(rFoot.m_SlideFrame) + " while the performer's stands and moves by "
			        + Fixed(rFoot.m_SourceSlide, 0) + " mm."});
		if (rFoot.m_StandingFrames > 0 && rFoot.m_Highest > c_FineHeight)
			findings.push_back({"hangs",
			    "The foot " + rName + " hangs " + Fixed(rFoot.m_Highest, 0) + " mm above the floor in "
			        + FrameText(rFoot.m_HighestFrame) + ", where the performer's stands."});
		if (rFoot.m_Lowest < -c_FineHeight)
			findings.push_back({"floor",
			    "The foot " + rName + " goes " + Fixed(-rFoot.m_Lowest, 0) + " mm through the floor in "
			        + FrameText(rFoot.m_LowestFrame) + "."});
	}
	for (const VBendQuality& rBend : rReport.m_Bends)
		if (rBend.m_Flexion > c_FineFlexion || rBend.m_Axis > c_FineAxis)
			findings.push_back({"bend",
			    std::string("The ") + SideWord(rBend.m_Side) + " " + rBend.m_Name
			        + " does not bend as the performer's does: by up to " + Fixed(c_Degrees * rBend.m_Flexion, 0)
			        + " degrees more or less, and about an axis that is up to " + Fixed(c_Degrees * rBend.m_Axis, 0)
			        + " degrees off, in 95 % of the frames."});
	for (const VUnequalSides& rSides : rReport.m_Sides)
		findings.push_back({"sides",
		    "Left and right differ: target #" + std::to_string(rSides.m_Worse) + " \""
		        + i_rResult.m_TargetNames[rSides.m_Worse] + "\" is met much worse than #"
		        + std::to_string(rSides.m_Better) + " \"" + i_rResult.m_TargetNames[rSides.m_Better]
		        + "\" on the other side."});
	for (const VRangeQuality& rRange : rReport.m_Ranges)
		findings.push_back({"range",
		    "The joint of " + rSegments[rRange.m_Segment].m_Name + " is at the end of its range in "
		        + std::to_string(rRange.m_Frames) + " of " + std::to_string(i_rResult.m_rSolved.m_Frames)
		        + " frames."});
	for (const VJump& rJump : rReport.m_Jumps)
		findings.push_back({"jump",
		    "The segment " + rSegments[rJump.m_Segment].m_Name + " jumps by " + Fixed(c_Degrees * rJump.m_Angle, 0)
		        + " degrees to " + FrameText(rJump.m_Frame) + ", where no segment of the performer turns by more than "
		        + Fixed(c_Degrees * rJump.m_SourceAngle, 1) + "."});
	if (!rReport.m_NotConverged.empty())
		findings.push_back({"not-converged",
		    std::to_string(rReport.m_NotConverged.size()) + " of " + std::to_string(i_rResult.m_rSolved.m_Frames)
		        + " frames did not converge, and show the best that was found: " + FramesText(rReport.m_NotConverged)
		        + "."});
	return findings;
}

VJson SolveToJson(const VSolveResult& i_rResult)
{
	const VSolveReport& rReport = i_rResult.m_rReport;
	const auto& rSegments = i_rResult.m_rTarget.m_Segments;
	VJson targets = VJson::array();
	for (std::size_t i = 0; i < rReport.m_Targets.size(); ++i)
	{
		const VSubject::VTarget& rTarget = i_rResult.m_rTarget.m_Targets[i];
		const VTargetQuality& rQuality = rReport.m_Targets[i];
		const double factor = UnitFactor(rTarget);
		VJson item{{"index", i}, {"name", i_rResult.m_TargetNames[i]},
		    {"source", SourceOf(i_rResult.m_rTarget, rTarget)}, {"target", TargetOf(i_rResult.m_rTarget, rTarget)},
		    {"unit", UnitOf(rTarget)}, {"solved", rQuality.m_Frames > 0}};
		if (rQuality.m_Frames > 0)
			item.update({{"rms", Rounded(factor * rQuality.m_Rms)}, {"p95", Rounded(factor * rQuality.m_P95)},
			    {"max", Rounded(factor * rQuality.m_Max)}, {"maxFrame", rQuality.m_MaxFrame}});
		targets.push_back(std::move(item));
	}
	VJson feet = VJson::array();
	for (const VFootQuality& rFoot : rReport.m_Feet)
		feet.push_back({{"name", rSegments[rFoot.m_Target].m_Name}, {"side", SideWord(rFoot.m_Side)},
		    {"standing", rFoot.m_StandingFrames}, {"slide", Rounded(rFoot.m_Slide)},
		    {"performerSlide", Rounded(rFoot.m_SourceSlide)},
		    {"performerLean", Rounded(c_Degrees * rFoot.m_SourceLean)}, {"slideFrame", rFoot.m_SlideFrame},
		    {"highest", Rounded(rFoot.m_Highest)}, {"highestFrame", rFoot.m_HighestFrame},
		    {"lowestStanding", Rounded(rFoot.m_LowestStanding)}, {"lowest", Rounded(rFoot.m_Lowest)},
		    {"lowestFrame", rFoot.m_LowestFrame}});
	VJson bends = VJson::array();
	for (const VBendQuality& rBend : rReport.m_Bends)
		bends.push_back({{"name", rBend.m_Name}, {"side", SideWord(rBend.m_Side)},
		    {"flexion", Rounded(c_Degrees * rBend.m_Flexion)},
		    {"axis", rBend.m_AxisFrames > 0 ? VJson(Rounded(c_Degrees * rBend.m_Axis)) : VJson()}});
	VJson findings = VJson::array();
	for (const VFinding& rFinding : FindingsOf(i_rResult))
		findings.push_back({{"id", rFinding.m_pId}, {"message", rFinding.m_Message}});
	return {{"first", i_rResult.m_rSolved.m_First}, {"frames", i_rResult.m_rSolved.m_Frames},
	    {"rate", i_rResult.m_rSolve.Source().Take().m_Rate}, {"scale", Rounded(i_rResult.m_rSolve.Source().Scale())},
	    {"findings", std::move(findings)}, {"targets", std::move(targets)}, {"floor", Rounded(rReport.m_Floor)},
	    {"feet", std::move(feet)}, {"bends", std::move(bends)}, {"notConverged", rReport.m_NotConverged},
	    {"frameTime", {{"median", Rounded(rReport.m_MedianTime)}, {"p95", Rounded(rReport.m_P95Time)}}}};
}

std::string SolveToText(const VSolveResult& i_rResult)
{
	const VSolveReport& rReport = i_rResult.m_rReport;
	const VSolvedTake& rSolved = i_rResult.m_rSolved;
	const double rate = i_rResult.m_rSolve.Source().Take().m_Rate;
	std::string text = "Frames " + std::to_string(rSolved.m_First) + " to "
	    + std::to_string(rSolved.m_First + rSolved.m_Frames - 1) + " at " + Shortest(std::round(1e3 * rate) / 1e3)
	    + " Hz, by our own solve: the host's may weigh things differently.\n";
	text = FitTerminal(text, 2);
	for (const VFinding& rFinding : FindingsOf(i_rResult))
		text += FitTerminal("- " + Printable(rFinding.m_Message), 2) + "\n";
	text += "\nTargets, how far they are off\n" + TargetTable(i_rResult);
	if (!rReport.m_Feet.empty())
		text += "\nFeet, in mm: while the performer's stand, over the floor and below it\n" + FeetTable(i_rResult);
	if (!rReport.m_Bends.empty())
		text += "\nKnees and elbows against the performer's\n" + BendTable(i_rResult);
	text += "\n" + std::to_string(rReport.m_NotConverged.size()) + " of " + std::to_string(rSolved.m_Frames)
	    + " frames without convergence; a frame took " + Fixed(rReport.m_MedianTime, 2) + " ms, the slowest twentieth "
	    + Fixed(rReport.m_P95Time, 2) + " ms and more\n";
	return text;
}

std::string SolveToCsv(const VSolveResult& i_rResult)
{
	const auto quoted = [](const std::string& i_rText)
	{
		std::string text = "\"";
		for (const char byte : Printable(i_rText))
			text += byte == '"' ? std::string("\"\"") : std::string(1, byte);
		return text + "\"";
	};
	const VSolvedTake& rSolved = i_rResult.m_rSolved;
	std::string csv = "frame,seconds,converged,iterations";
	for (std::size_t i = 0; i < rSolved.m_NumberOfTargets; ++i)
		csv += ","
		    + quoted("#" + std::to_string(i) + " " + i_rResult.m_TargetNames[i] + " ("
		        + UnitOf(i_rResult.m_rTarget.m_Targets[i]) + ")");
	csv += "\n";
	for (std::size_t i = 0; i < rSolved.m_Frames; ++i)
	{
		const std::size_t frame = rSolved.m_First + i;
		csv += std::to_string(frame) + "," + Fixed(double(frame) / i_rResult.m_rSolve.Source().Take().m_Rate, 6) + ","
		    + (rSolved.m_Converged[i] ? "1," : "0,") + std::to_string(rSolved.m_Iterations[i]);
		for (std::size_t k = 0; k < rSolved.m_NumberOfTargets; ++k)
		{
			const double residual = rSolved.Residuals(i)[k];
			csv += ",";
			if (std::isfinite(residual))
				csv += Fixed(UnitFactor(i_rResult.m_rTarget.m_Targets[k]) * residual, 6);
		}
		csv += "\n";
	}
	return csv;
}

} // namespace CommandLine
