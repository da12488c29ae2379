#include "CommandLineText/Parsing.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/Making.h"
#include "retarget/text/OutputFile.h"

namespace CommandLine
{
namespace
{

EExitStatus Edit(const VMaking& i_rMaking, const VOutput& i_rOut, const VEdits& i_rEdits)
{
	CheckOutput(i_rOut, c_RetargetSubjectFile, {i_rMaking.m_Source});
	VSession session;
	MakeSubject(session, i_rMaking, i_rEdits);
	session.Save(i_rOut.m_Path);
	session.Report(i_rOut.m_Path);
	return EFine;
}

} // namespace

VCommand AddEditCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "edit", "Edit a saved retarget subject",
	    {"edit hero.qrr --source performer.qrs --position Head:head --update-targets -o hero.qrr",
	        "edit hero.qrr --weight 3=2.5 --remove-target 0 -o hero.qrr",
	        "edit hero.qrr --source performer.qrs --pose LeftArm=0,0,-1.2 --update-targets -o posed.qrr"});
	const auto pMaking = std::make_shared<VMaking>();
	pMaking->m_bTyped = true;
	const auto pOut = std::make_shared<VOutput>();
	const auto pEdits = std::make_shared<VEdits>();
	pApp->add_option("IN.qrr", pMaking->m_Subject, "The retarget subject, or a legacy one (.qrx); - is standard input")
	    ->required();
	pApp->add_option("--source", pMaking->m_Source, "The performer's skeleton; adding and updating targets needs it")
	    ->option_text("FILE.qrs")
	    ->check(NotEmpty());
	pApp->add_option("-o,--output", pOut->m_Path,
	        "Where the retarget subject is saved; may be IN.qrr itself, - is standard output")
	    ->option_text("OUT.qrr")
	    ->required();
	AddForceOption(*pApp, *pOut);
	AddRootHeightOption(*pApp, pMaking->m_RootHeight);
	AddEditOptions(*pApp, pEdits, false);
	return {pApp, [pMaking, pOut, pEdits] { return Edit(*pMaking, *pOut, *pEdits); }};
}

} // namespace CommandLine
