#include "CommandLineText/Messages.h"
#include "CommandLineText/Parsing.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/SubjectFile.h"
#include "retarget/text/Output.h"
#include "retarget/text/OutputFile.h"

#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/Presets.h"
#include "SetupIO/WriteSetup.h"

namespace CommandLine
{
namespace
{

EExitStatus SavePreset(const std::string& i_rSubject, const VOutput& i_rOut)
{
	CheckOutput(i_rOut, c_SetupFile, {i_rSubject});
	const VSubjectFile file = ReadSubjectFile(i_rSubject);
	std::vector<std::string> leftOut;
	const SetupIO::VSetup preset =
	    RetargetSetup::PresetOf(file.m_Record.m_SubjectParametrised, file.m_Record.m_SubjectApplicationData, leftOut);
	for (const std::string& rSentence : leftOut)
		NVX_LOG(c_pCategory, NVX::ELogWarning, "%1%", rSentence);
	if (preset.m_Pairs.empty())
		throw VCommandError(
		    EFindings, "\"" + i_rSubject + "\" has no position or rotation target that a preset could hold");
	WriteText(SetupIO::WriteSetup(preset), i_rOut.m_Path);
	PrintResult({{"output", i_rOut.m_Path}, {"pairs", preset.m_Pairs.size()}, {"leftOut", leftOut}}, "");
	return EFine;
}

} // namespace

VCommand AddPresetCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "preset",
	    "Save which segments the targets of a retarget subject tie, with their weights, as a preset: a text that "
	    "\"create\" and \"edit --preset\" apply to another character",
	    {"preset save hero.qrr -o biped.json",
	        "create --fbx other.fbx --source performer.qrs --preset biped.json --align -o other.qrr"});
	const auto pAction = std::make_shared<std::string>();
	const auto pSubject = std::make_shared<std::string>();
	const auto pOut = std::make_shared<VOutput>();
	pApp->add_option("ACTION", *pAction, "What is done: save")->required()->check(CLI::IsMember({"save"}));
	pApp->add_option("IN.qrr", *pSubject, "The retarget subject; - is standard input")->required();
	pApp->add_option("-o,--output", pOut->m_Path, "Where the preset is saved; - is standard output")
	    ->option_text("OUT.json")
	    ->required();
	AddForceOption(*pApp, *pOut);
	return {pApp, [pAction, pSubject, pOut] { return SavePreset(*pSubject, *pOut); }};
}

} // namespace CommandLine
