#include "CommandLineText/Messages.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/SubjectFile.h"
#include "retarget/subject/TakeFile.h"
#include "retarget/text/Output.h"
#include "retarget/text/OutputFile.h"

#include "CoreOrlexQRTIO/Writer.h"
#include "DebugServices/GlobalLog.h"
#include "TakeSolve/Performer.h"

namespace CommandLine
{
namespace
{

struct VPerformerSettings
{
	std::string m_Take;
	std::shared_ptr<TakeIO::VTakeSettings> m_pTake = std::make_shared<TakeIO::VTakeSettings>();
	VOutput m_Out;
};

EExitStatus WritePerformer(const VPerformerSettings& i_rSettings)
{
	CheckOutput(i_rSettings.m_Out, c_PerformerFile, {i_rSettings.m_Take});
	const TakeIO::VTake take = ReadTakeFile(i_rSettings.m_Take, *i_rSettings.m_pTake);
	std::vector<TakeSolve::VFinding> findings;
	auto record = TakeSolve::MakePerformer(take, StemOf(i_rSettings.m_Take), findings);
	record.m_SubjectParametrised.m_Model = record.m_SubjectParametrised.m_Name;
	for (const TakeSolve::VFinding& rFinding : findings)
		NVX_LOG(c_pCategory, NVX::ELogWarning, "%1%", rFinding.m_Message);
	if (record.m_SubjectParametrised.m_Segments.empty())
		throw VCommandError(EBadInput, "\"" + i_rSettings.m_Take + "\" holds no joints");
	WriteSubjectFile(i_rSettings.m_Out.m_Path, record.m_SubjectParametrised, record.m_SubjectApplicationData, {},
	    CoreOrlexQRTIO::c_AutomaticVersion);
	PrintResult({{"output", i_rSettings.m_Out.m_Path}, {"segments", record.m_SubjectParametrised.m_Segments.size()},
	                {"markers", record.m_SubjectParametrised.m_Markers.size()}},
	    "");
	return EFine;
}

} // namespace

VCommand AddPerformerCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "performer",
	    "Make a performer's skeleton of a take: a segment for each joint, in the take's rest pose as bind pose, with "
	    "the root free, the others as balls, and markers and sticks along the bones",
	    {"performer walk.bvh -o performer.qrs", "performer walk.bvh --unit cm --up z -o performer.qrs"});
	const auto pSettings = std::make_shared<VPerformerSettings>();
	pApp->add_option("TAKE", pSettings->m_Take, "Take: BVH or FBX file; - is standard input")->required();
	AddTakeOptions(*pApp, pSettings->m_pTake);
	pApp->add_option(
	        "-o,--output", pSettings->m_Out.m_Path, "Where the performer's skeleton is saved; - is standard output")
	    ->option_text("OUT.qrs")
	    ->required();
	AddForceOption(*pApp, pSettings->m_Out);
	return {pApp, [pSettings] { return WritePerformer(*pSettings); }};
}

} // namespace CommandLine
