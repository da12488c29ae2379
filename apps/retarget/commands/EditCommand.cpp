#include "CommandLineText/Parsing.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/Edits.h"
#include "retarget/subject/Session.h"
#include "retarget/text/OutputFile.h"

namespace CommandLine
{
namespace
{

struct VEditSettings
{
	std::string m_In;
	std::string m_Source;
	VOutput m_Out;
	std::string m_RootHeight = "keep";
};

EExitStatus Edit(const VEditSettings& i_rSettings, const VEdits& i_rEdits)
{
	CheckOutput(i_rSettings.m_Out, c_RetargetSubjectFile, {i_rSettings.m_Source});
	VSession session;
	session.Document().SetScaleRootHeight(i_rSettings.m_RootHeight == c_pScaleRootHeight);
	session.LoadTarget(i_rSettings.m_In);
	if (!i_rSettings.m_Source.empty())
		session.LoadSource(i_rSettings.m_Source);
	ApplyEdits(session, i_rEdits);
	session.Save(i_rSettings.m_Out.m_Path);
	session.Report(i_rSettings.m_Out.m_Path);
	return EFine;
}

} // namespace

VCommand AddEditCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "edit", "Edit a saved retarget subject",
	    {"edit hero.qrr --source performer.qrs --position Head:head --update-targets -o hero.qrr",
	        "edit hero.qrr --weight 3=2.5 --remove-target 0 -o hero.qrr",
	        "edit hero.qrr --source performer.qrs --pose LeftArm=0,0,-1.2 --update-targets -o posed.qrr"});
	const auto pSettings = std::make_shared<VEditSettings>();
	const auto pEdits = std::make_shared<VEdits>();
	pApp->add_option("IN.qrr", pSettings->m_In, "The retarget subject, or a legacy one (.qrx); - is standard input")
	    ->required();
	pApp->add_option("--source", pSettings->m_Source, "The performer's skeleton; adding and updating targets needs it")
	    ->option_text("FILE.qrs")
	    ->check(NotEmpty());
	pApp->add_option("-o,--output", pSettings->m_Out.m_Path,
	        "Where the retarget subject is saved; may be IN.qrr itself, - is standard output")
	    ->option_text("OUT.qrr")
	    ->required();
	AddForceOption(*pApp, pSettings->m_Out);
	AddRootHeightOption(*pApp, pSettings->m_RootHeight);
	AddEditOptions(*pApp, pEdits, false);
	return {pApp, [pSettings, pEdits] { return Edit(*pSettings, *pEdits); }};
}

} // namespace CommandLine
