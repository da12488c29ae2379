#include "CommandLineText/Messages.h"
#include "CommandLineText/Parsing.h"
#include "retarget/commands/Commands.h"
#include "retarget/report/Report.h"
#include "retarget/text/InputFile.h"
#include "retarget/text/Output.h"
#include "retarget/text/OutputFile.h"

#include "DebugServices/GlobalLog.h"
#include "NVX/Status.h"
#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/SaveFile.h"

namespace CommandLine
{
namespace
{

struct VReportCommandSettings : VReportSettings
{
	bool m_bNoPictures = false;
	VOutput m_Out;
};

EExitStatus Report(VReportCommandSettings& io_rSettings, const VRender& i_rRender)
{
	const std::string& rPath = io_rSettings.m_Out.m_Path;
	CheckOutput(io_rSettings.m_Out, c_PageFile,
	    {io_rSettings.m_In, io_rSettings.m_Source, io_rSettings.m_Fbx, io_rSettings.m_Take});
	io_rSettings.m_bPictures = !io_rSettings.m_bNoPictures;
	const VReport report = MakeReport(io_rSettings, i_rRender);
	if (!report.m_NoPictures.empty() && io_rSettings.m_bPictures)
		NVX_LOG(c_pCategory, NVX::ELogInformation, "The report has no pictures: %1%", report.m_NoPictures);
	RequireNoErrors();
	std::string error;
	if (rPath == c_pStandardStream)
		Print(report.m_Text);
	else if (UtilsFileSystem::SaveFile(UtilsFileSystem::PathFromUtf8(rPath), report.m_Text, error)
	    != NVX::Status::c_Success)
		throw VCommandError(EBadOutput, error);
	PrintResult({{"output", rPath}, {"targets", report.m_Targets}, {"findings", report.m_Findings},
	                {"pictures", report.m_Pictures},
	                {"noPictures", report.m_NoPictures.empty() ? VJson() : VJson(report.m_NoPictures)}},
	    "");
	return EFine;
}

} // namespace

VCommand AddReportCommand(CLI::App& io_rProgram, const VRender& i_rRender)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "report",
	    "Write a page for the hand-over of a retarget subject, which needs nothing beside itself and can be printed: "
	    "pictures from the front and the side, targets with offsets and residuals, coverage by part of the body, what "
	    "nothing follows, joints that could go, range of motion, findings, and the files with their hashes. Without a "
	    "display with OpenGL it has no pictures, which it says",
	    {"report hero.qrr -o hero.html", "report hero.qrr --source performer.qrs --fbx hero.fbx -o hero.html",
	        "report hero.qrr --source performer.qrs --take walk.bvh -o hero.html",
	        "report hero.qrr --no-pictures -o - | lp"});
	const auto pSettings = std::make_shared<VReportCommandSettings>();
	pApp->add_option("FILE.qrr", pSettings->m_In, "The retarget subject, or a legacy one (.qrx); - is standard input")
	    ->required();
	pApp->add_option("--source", pSettings->m_Source, "The performer's skeleton, for residuals and range of motion")
	    ->option_text("FILE.qrs")
	    ->check(NotEmpty());
	pApp->add_option("--fbx", pSettings->m_Fbx, "The character's FBX file, for its skin")
	    ->option_text("FILE")
	    ->check(NotEmpty());
	pApp->add_option("--take", pSettings->m_Take,
	        "A BVH or FBX file that the performer plays: plots of what the targets are off by over its frames")
	    ->option_text("TAKE")
	    ->check(NotEmpty());
	pApp->add_flag("--no-pictures", pSettings->m_bNoPictures,
	    "Draw none, so that the same files give the same bytes "
	    "on every machine");
	pApp->add_option("-o,--output", pSettings->m_Out.m_Path, "Where the page is saved; - is standard output")
	    ->option_text("OUT.html")
	    ->required();
	AddForceOption(*pApp, pSettings->m_Out);
	return {pApp, [pSettings, i_rRender] { return Report(*pSettings, i_rRender); }};
}

} // namespace CommandLine
