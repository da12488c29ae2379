#include "CommandLineText/Messages.h"
#include "CommandLineText/Parsing.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/Mapping.h"
#include "retarget/subject/Rebinding.h"
#include "retarget/text/InputFile.h"
#include "retarget/text/Output.h"
#include "retarget/text/OutputFile.h"

#include "DebugServices/GlobalLog.h"

namespace CommandLine
{
namespace
{

struct VRebindSettings
{
	std::string m_In;
	std::string m_Fbx;
	std::optional<std::string> m_Root;
	std::string m_Source;
	bool m_bMeasure = false;
	bool m_bAllowPartial = false;
	std::string m_MinimumScore;
	VOutput m_Out;
};

EExitStatus Rebind(const VRebindSettings& i_rSettings)
{
	if (i_rSettings.m_Fbx.empty() && i_rSettings.m_Source.empty())
		throw VCommandError(
		    EWrongUsage, "Give what is new: the character's file with --fbx, the performer's with --source, or both");
	if (i_rSettings.m_bMeasure && i_rSettings.m_Source.empty())
		throw VCommandError(EWrongUsage, "--measure needs the performer's skeleton: give it with --source FILE.qrs");
	if (i_rSettings.m_Root && i_rSettings.m_Fbx.empty())
		throw VCommandError(EWrongUsage, "--root is a bone of the new character: give its file with --fbx");
	const bool bWrite = !i_rSettings.m_Out.m_Path.empty();
	if (bWrite)
		CheckOutput(i_rSettings.m_Out, c_RetargetSubjectFile, {i_rSettings.m_Fbx, i_rSettings.m_Source});
	VSession session;
	if (!i_rSettings.m_MinimumScore.empty())
		session.m_MinimumScore = ParseScore(i_rSettings.m_MinimumScore);
	// Before the subject, which was made for another one.
	if (!i_rSettings.m_Source.empty())
		session.LoadSource(i_rSettings.m_Source);
	session.LoadTarget(i_rSettings.m_In);
	VRebinding told;
	if (!i_rSettings.m_Fbx.empty())
		RebindToCharacter(session, i_rSettings.m_Fbx, i_rSettings.m_Root, told);
	if (!i_rSettings.m_Source.empty())
		RebindToPerformer(session, told);
	if (i_rSettings.m_bMeasure)
		session.Document().UpdateTargets();
	session.Settle();
	TellLost(told);
	const bool bRefused = !told.m_Lost.empty() && !i_rSettings.m_bAllowPartial;
	RequireNoErrors();
	if (bWrite && !bRefused)
	{
		for (const std::string& rLost : told.m_Lost)
			NVX_LOG(c_pCategory, NVX::ELogWarning, "Not kept: %1%", rLost);
		session.Save(i_rSettings.m_Out.m_Path);
		told.m_Json["output"] = i_rSettings.m_Out.m_Path;
	}
	if (i_rSettings.m_Out.m_Path != c_pStandardStream)
		PrintResult(told.m_Json, told.m_Text);
	if (bRefused && bWrite)
		throw VCommandError(EFindings,
		    "\"" + i_rSettings.m_Out.m_Path + "\" is not written, since not all could be kept (" + told.m_Lost.front()
		        + "): --allow-partial writes it without");
	return told.m_Lost.empty() || i_rSettings.m_bAllowPartial ? EFine : EFindings;
}

} // namespace

VCommand AddRebindCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "rebind",
	    "Take a retarget subject over to a changed file of its character, or to another performer. Segments are "
	    "matched "
	    "by name, by place and by what they are of a body; targets, joints and poses are kept, offsets follow the new "
	    "lengths. What could not be kept is listed: then the exit status is 1, and nothing is written. Without -o it "
	    "is "
	    "only told what would come of it",
	    {"rebind hero.qrr --fbx hero-v2.fbx", "rebind hero.qrr --fbx hero-v2.fbx -o hero-v2.qrr",
	        "rebind hero.qrr --source other.qrs --measure -o other.qrr"});
	const auto pSettings = std::make_shared<VRebindSettings>();
	pApp->add_option("IN.qrr", pSettings->m_In, "The retarget subject, or a legacy one (.qrx); - is standard input")
	    ->required();
	pApp->add_option("--fbx", pSettings->m_Fbx, "The character's new FBX file")->option_text("FILE")->check(NotEmpty());
	pApp->add_option("--root", pSettings->m_Root,
	        "The bone of the new file that becomes the root; if left out the one of the old root's name, or the one "
	        "that "
	        "is the same of a body")
	    ->option_text("NAME|INDEX");
	pApp->add_option("--source", pSettings->m_Source, "The other performer's skeleton")
	    ->option_text("FILE.qrs")
	    ->check(NotEmpty());
	pApp->add_flag(
	    "--measure", pSettings->m_bMeasure, "Measure all offsets anew, in the bind poses as they stand then");
	pApp->add_option("--min-score", pSettings->m_MinimumScore,
	        "Match nothing as the same of a body that scores less: from 0 to 1, 0.5 if left out")
	    ->option_text("SCORE");
	pApp->add_flag("--allow-partial", pSettings->m_bAllowPartial, "Write it without what could not be kept");
	pApp->add_option("-o,--output", pSettings->m_Out.m_Path,
	        "Where the retarget subject is saved; may be IN.qrr itself, - is standard output")
	    ->option_text("OUT.qrr");
	AddForceOption(*pApp, pSettings->m_Out);
	return {pApp, [pSettings] { return Rebind(*pSettings); }};
}

} // namespace CommandLine
