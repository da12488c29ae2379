#include "CommandLineText/Messages.h"
#include "CommandLineText/Parsing.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/Edits.h"
#include "retarget/subject/Session.h"
#include "retarget/text/OutputFile.h"

#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/FilePose.h"

namespace CommandLine
{
namespace
{

struct VCreateSettings
{
	std::string m_Fbx;
	std::string m_Source;
	std::optional<std::string> m_Root;
	VOutput m_Out;
	std::string m_RootHeight = "keep";
};

EExitStatus Create(const VCreateSettings& i_rSettings, const VEdits& i_rEdits)
{
	CheckOutput(i_rSettings.m_Out, c_RetargetSubjectFile, {i_rSettings.m_Fbx, i_rSettings.m_Source});
	VSession session;
	session.Document().SetScaleRootHeight(i_rSettings.m_RootHeight == c_pScaleRootHeight);
	// The target subject takes the source's name when it is made.
	if (!i_rSettings.m_Source.empty())
		session.LoadSource(i_rSettings.m_Source);
	session.CreateTarget(i_rSettings.m_Fbx, i_rSettings.m_Root, TakesProposal(i_rEdits));
	if (const auto worst = session.Document().DifferenceFromFile())
		NVX_LOG(c_pCategory, NVX::ELogWarning,
		    "The bind pose as built differs from the pose in the file, %1%; --match-file-pose mends it",
		    RetargetSetup::WorstText(session.Target(), *worst));
	ApplyEdits(session, i_rEdits);
	session.ForgetNamelessFiles();
	session.Save(i_rSettings.m_Out.m_Path);
	session.Report(i_rSettings.m_Out.m_Path);
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
	const auto pSettings = std::make_shared<VCreateSettings>();
	const auto pEdits = std::make_shared<VEdits>();
	pApp->add_option("--fbx", pSettings->m_Fbx, "The character's FBX file")->option_text("FILE")->required();
	pApp->add_option("--source", pSettings->m_Source, "The performer's skeleton; adding and updating targets needs it")
	    ->option_text("FILE.qrs")
	    ->check(NotEmpty());
	pApp->add_option("--root", pSettings->m_Root,
	        "The bone that becomes the root, by name or by index in the file; the first bone if left out")
	    ->option_text("NAME|INDEX");
	pApp->add_option(
	        "-o,--output", pSettings->m_Out.m_Path, "Where the retarget subject is saved; - is standard output")
	    ->option_text("OUT.qrr")
	    ->required();
	AddForceOption(*pApp, pSettings->m_Out);
	AddRootHeightOption(*pApp, pSettings->m_RootHeight);
	AddEditOptions(*pApp, pEdits, true);
	return {pApp, [pSettings, pEdits] { return Create(*pSettings, *pEdits); }};
}

} // namespace CommandLine
