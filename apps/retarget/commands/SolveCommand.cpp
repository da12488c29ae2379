#include "CommandLineText/Messages.h"
#include "CommandLineText/Parsing.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/PlayedTake.h"
#include "retarget/subject/Session.h"
#include "retarget/subject/SolvePlot.h"
#include "retarget/subject/SolveText.h"
#include "retarget/subject/TakeFile.h"
#include "retarget/text/MotionFile.h"
#include "retarget/text/Output.h"
#include "retarget/text/OutputFile.h"

#include "DebugServices/GlobalLog.h"
#include "NVX/Status.h"
#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/SaveFile.h"

#include <boost/filesystem/operations.hpp>

namespace CommandLine
{
namespace
{

using CoreOrlexTypes::VSubject;

struct VSolveSettings
{
	VTakeToPlay m_What;
	std::optional<double> m_MaximumPosition;
	std::optional<double> m_MaximumRotation;
	bool m_bCsv = false;
	VOutput m_Plot;
	VMotionOutput m_Motion;
	/// Where the character's file lies, if it is not named.
	std::string m_Skins;
};

/// "A:B", where either may be left out, or one frame.
std::string ParseFrames(const std::string& i_rText, VSolveSettings& io_rSettings)
{
	const auto parse = [](std::string_view i_Text, std::optional<std::size_t>& o_rFrame)
	{
		if (std::size_t frame = 0; ParseFrame(i_Text, frame))
			o_rFrame = frame;
		return i_Text.empty() || o_rFrame.has_value();
	};
	const std::string_view text = i_rText;
	const std::size_t colon = text.find(':');
	const bool bFine = !text.empty() && parse(text.substr(0, colon), io_rSettings.m_What.m_FirstFrame)
	    && parse(text.substr(colon == std::string::npos ? 0 : colon + 1), io_rSettings.m_What.m_LastFrame);
	return bFine ? std::string() : "\"" + i_rText + "\" is not FIRST:LAST, two numbers of frames";
}

/// The targets that are off by more than they may.
std::string BeyondLimits(const VSolveSettings& i_rSettings, const VSolveResult& i_rResult)
{
	std::string text;
	for (std::size_t i = 0; i < i_rResult.m_rReport.m_Targets.size(); ++i)
	{
		const VSubject::VTarget& rTarget = i_rResult.m_rTarget.m_Targets[i];
		const TakeSolve::VTargetQuality& rQuality = i_rResult.m_rReport.m_Targets[i];
		const auto& rLimit = IsRotationTarget(rTarget) ? i_rSettings.m_MaximumRotation : i_rSettings.m_MaximumPosition;
		if (rLimit && UnitFactor(rTarget) * rQuality.m_Max > *rLimit)
			text += (text.empty() ? "" : ", ") + ("#" + std::to_string(i)) + " \"" + i_rResult.m_TargetNames[i]
			    + "\" in frame " + std::to_string(rQuality.m_MaxFrame);
	}
	return text;
}

/// Before anything is read: what is written, and that it is no input.
void CheckOutputs(VSolveSettings& io_rSettings)
{
	std::vector<std::string> inputs{io_rSettings.m_What.m_Subject, io_rSettings.m_What.m_Take,
	    io_rSettings.m_What.m_Source, io_rSettings.m_What.m_pPairs->m_File};
	if (!io_rSettings.m_Plot.m_Path.empty())
		CheckOutput(io_rSettings.m_Plot, c_DrawingFile, inputs);
	VMotionOutput& rMotion = io_rSettings.m_Motion;
	if (rMotion.m_Path.empty())
		return;
	rMotion.m_bForce = io_rSettings.m_Plot.m_bForce;
	rMotion.m_Name = StemOf(io_rSettings.m_What.m_Take);
	inputs.push_back(rMotion.m_Character);
	CheckMotionOutput(rMotion, inputs);
}

std::string CharacterIn(const std::string& i_rFolder, VSession& io_rSession)
{
	const std::string& rName = io_rSession.Document().TargetValues().m_pApplicationData->m_Skin;
	const boost::filesystem::path file = UtilsFileSystem::PathFromUtf8(i_rFolder) / (rName + ".fbx");
	boost::system::error_code error;
	if (rName.empty() || !boost::filesystem::is_regular_file(file, error))
		throw VCommandError(EBadInput,
		    rName.empty() ? "--skins: the retarget subject does not tell of what FBX file it was made: --fbx names it"
		                  : "--skins: there is no \"" + UtilsFileSystem::ToUtf8(file) + "\"");
	return UtilsFileSystem::ToUtf8(file);
}

EExitStatus Solve(VSolveSettings i_Settings)
{
	VSession session;
	if (!i_Settings.m_Skins.empty())
	{
		// Only the subject knows the name.
		session.LoadTarget(i_Settings.m_What.m_Subject);
		i_Settings.m_Motion.m_Character = CharacterIn(i_Settings.m_Skins, session);
	}
	CheckOutputs(i_Settings);
	const VSolveSettings& i_rSettings = i_Settings;
	if (i_rSettings.m_bCsv && JsonAsked())
		throw VCommandError(EWrongUsage, "--csv and --json both print the result: give one of them");

	if (i_rSettings.m_Skins.empty())
		session.LoadTarget(i_rSettings.m_What.m_Subject);
	const std::unique_ptr<const VPlayedTake> pPlayed = PlayTake(session, i_rSettings.m_What);
	const VSolveResult result = pPlayed->Result();

	if (!i_rSettings.m_Motion.m_Path.empty())
		WriteSolvedMotion(session, *pPlayed, i_rSettings.m_Motion);
	if (!i_rSettings.m_Plot.m_Path.empty())
	{
		RequireNoErrors();
		std::string reason;
		if (UtilsFileSystem::SaveFile(
		        UtilsFileSystem::PathFromUtf8(i_rSettings.m_Plot.m_Path), SolvePlot(result), reason)
		    != NVX::Status::c_Success)
			throw VCommandError(EBadOutput, reason);
	}
	if (i_rSettings.m_bCsv)
		Print(SolveToCsv(result));
	else
		PrintResult(SolveToJson(result), JsonAsked() ? std::string() : SolveToText(result));
	if (const std::string beyond = BeyondLimits(i_rSettings, result); !beyond.empty())
		throw VCommandError(EFindings, "Targets are off by more than they may: " + beyond);
	return EFine;
}

} // namespace

VCommand AddSolveCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "solve",
	    "Play a take through a retarget subject and tell how far each target is off, and what an animator would look "
	    "for: feet that slide or leave the floor, knees and elbows that bend otherwise, jumps, ends of ranges. The "
	    "solve is our own stand-in: the host's may weigh things differently",
	    {"solve hero.qrr --take walk.bvh --source performer.qrs",
	        "solve hero.qrr --take walk.bvh --source performer.qrs --frames 1:200 --plot walk.svg",
	        "solve hero.qrr --take walk.bvh --source performer.qrs --fbx hero.fbx -o hero_walk.fbx",
	        "solve hero.qrr --take walk.bvh --joints walk_joints.json --skins characters -o hero_walk.glb",
	        "solve hero.qrr --take walk.bvh --source performer.qrs --max-position 50 --max-rotation 20 -q",
	        "solve hero.qrr --take walk.bvh --source performer.qrs --json | jq '.targets[] | {name, p95}'"});
	const auto pSettings = std::make_shared<VSolveSettings>();
	pApp->add_option("FILE.qrr", pSettings->m_What.m_Subject, "The retarget subject, or a legacy one (.qrx)")
	    ->required();
	pApp->add_option("--take", pSettings->m_What.m_Take, "The performer's motion: BVH or FBX file")
	    ->option_text("TAKE")
	    ->required();
	pApp->add_option("--source", pSettings->m_What.m_Source,
	        "The performer's skeleton; without it one is made of the take, as \"retarget performer\" does")
	    ->option_text("FILE.qrs")
	    ->check(NotEmpty());
	AddParsedOption(*pApp, "--frames", "FIRST:LAST", "Only these frames; the take's first is 0",
	    [pSettings](const std::string& i_rText) { return ParseFrames(i_rText, *pSettings); });
	AddPairOptions(*pApp, pSettings->m_What.m_pPairs);
	AddTakeOptions(*pApp, pSettings->m_What.m_pTake);
	AddParsedOption(*pApp, "--max-position", "MM",
	    "Exit status 1, with their names, if a target is off by more in any frame",
	    [pSettings](const std::string& i_rText)
	    { return ParseNumber(i_rText, 0.0, 1e9, pSettings->m_MaximumPosition); });
	AddParsedOption(*pApp, "--max-rotation", "DEG", "The same for rotations, in degrees",
	    [pSettings](const std::string& i_rText)
	    { return ParseNumber(i_rText, 0.0, 1e9, pSettings->m_MaximumRotation); });
	pApp->add_flag("--csv", pSettings->m_bCsv,
	    "Print a line for each frame instead: number, seconds, converged, iterations, and how far each target is off");
	pApp->add_option("--plot", pSettings->m_Plot.m_Path, "Draw how far the targets are off over the frames")
	    ->option_text("OUT.svg")
	    ->check(NotEmpty());
	pApp->add_option("-o,--output", pSettings->m_Motion.m_Path,
	        "Where the character's motion is written: .bvh, .glb (glTF binary: the character with its skin) or .fbx "
	        "(the character's own binary file with one more animation stack)")
	    ->option_text("OUT")
	    ->check(NotEmpty());
	pApp->add_option("--fbx", pSettings->m_Motion.m_Character, "The character's FBX file, which .glb and .fbx need")
	    ->option_text("FILE.fbx")
	    ->check(NotEmpty());
	pApp->add_option("--skins", pSettings->m_Skins,
	        "The folder where that file lies, by the name that the retarget subject has of it")
	    ->option_text("FOLDER")
	    ->check(NotEmpty())
	    ->excludes("--fbx");
	AddForceOption(*pApp, pSettings->m_Plot);
	return {pApp, [pSettings] { return Solve(*pSettings); }};
}

} // namespace CommandLine
