#include "CommandLineText/Parsing.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/Making.h"
#include "retarget/text/OutputFile.h"

namespace CommandLine
{
namespace
{

EExitStatus Create(const VMaking& i_rMaking, const VOutput& i_rOut, const VEdits& i_rEdits)
{
	CheckOutput(i_rOut, c_RetargetSubjectFile, {i_rMaking.m_Fbx, i_rMaking.m_Source});
	VSession session;
	MakeSubject(session, i_rMaking, i_rEdits);
	session.Save(i_rOut.m_Path);
	session.Report(i_rOut.m_Path);
	return EFine;
}

} // namespace

VCommand AddCreateCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "create",
	    "Build a target subject from a character's FBX file, edit it, and save it as a retarget subject",
	    {"create --fbx hero.fbx -o hero.qrr",
	        "create --fbx hero.fbx --source performer.qrs --rotation Hips:Hips \\\n      --symmetry --position "
	        "LeftFoot:LeftFoot --rotation LeftArm:LeftArm \\\n      --prune-joints --match-file-pose --update-targets "
	        "-o "
	        "hero.qrr",
	        "create --fbx rig.fbx --root 'Bip001 Pelvis' --scale 0.9 -o small.qrr"});
	const auto pMaking = std::make_shared<VMaking>();
	pMaking->m_bTyped = true;
	const auto pOut = std::make_shared<VOutput>();
	const auto pEdits = std::make_shared<VEdits>();
	pApp->add_option("--fbx", pMaking->m_Fbx, "The character's FBX file")->option_text("FILE")->required();
	pApp->add_option("--source", pMaking->m_Source, "The performer's skeleton; adding and updating targets needs it")
	    ->option_text("FILE.qrs")
	    ->check(NotEmpty());
	pApp->add_option("--root", pMaking->m_Root,
	        "The bone that becomes the root, by name or by index in the file; the first bone if left out")
	    ->option_text("NAME|INDEX");
	pApp->add_option("-o,--output", pOut->m_Path, "Where the retarget subject is saved; - is standard output")
	    ->option_text("OUT.qrr")
	    ->required();
	AddForceOption(*pApp, *pOut);
	AddRootHeightOption(*pApp, pMaking->m_RootHeight);
	AddEditOptions(*pApp, pEdits, true);
	return {pApp, [pMaking, pOut, pEdits] { return Create(*pMaking, *pOut, *pEdits); }};
}

} // namespace CommandLine
