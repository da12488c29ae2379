#include "CommandLineText/Messages.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/SubjectFile.h"
#include "retarget/subject/TakeFile.h"
#include "retarget/text/Output.h"
#include "retarget/text/OutputFile.h"

#include "CoreOrlexQRTIO/Writer.h"
#include "DebugServices/GlobalLog.h"
#include "TakeSolve/Performer.h"

#include <cmath>
#include <numbers>

namespace CommandLine
{
namespace
{

constexpr double c_ToDegrees = 180.0 / std::numbers::pi;

struct VPerformerSettings
{
	std::string m_Take;
	std::shared_ptr<TakeIO::VTakeSettings> m_pTake = std::make_shared<TakeIO::VTakeSettings>();
	bool m_bFeetAtRest = false;
	VOutput m_Out;
};

EExitStatus WritePerformer(const VPerformerSettings& i_rSettings)
{
	CheckOutput(i_rSettings.m_Out, c_PerformerFile, {i_rSettings.m_Take});
	const TakeIO::VTake take = ReadTakeFile(i_rSettings.m_Take, *i_rSettings.m_pTake);
	std::vector<TakeSolve::VFinding> findings;
	const TakeSolve::VStandingPose pose =
	    i_rSettings.m_bFeetAtRest ? TakeSolve::RestPose(take) : TakeSolve::StandingPose(take);
	auto record = TakeSolve::MakePerformer(take, pose, StemOf(i_rSettings.m_Take), findings);
	record.m_SubjectParametrised.m_Model = record.m_SubjectParametrised.m_Name;
	for (const TakeSolve::VFinding& rFinding : findings)
		NVX_LOG(c_pCategory, NVX::ELogWarning, "%1%", rFinding.m_Message);
	if (record.m_SubjectParametrised.m_Segments.empty())
		throw VCommandError(EBadInput, "\"" + i_rSettings.m_Take + "\" holds no joints");
	WriteSubjectFile(i_rSettings.m_Out.m_Path, record.m_SubjectParametrised, record.m_SubjectApplicationData, {},
	    CoreOrlexQRTIO::c_AutomaticVersion);
	const auto rounded = [](double i_Value) { return std::round(1e6 * i_Value) / 1e6; };
	VJson feet = VJson::array();
	for (const TakeSolve::VStandingFoot& rFoot : pose.m_Feet)
		feet.push_back({{"joint", take.m_Joints[rFoot.m_Joint].m_Name}, {"standing", rFoot.m_Frames},
		    {"turnDegrees", rounded(c_ToDegrees * rFoot.m_Turn)}, {"heightMm", rounded(rFoot.m_Height)}});
	const std::string text = TextOf(pose, take);
	PrintResult({{"output", i_rSettings.m_Out.m_Path}, {"segments", record.m_SubjectParametrised.m_Segments.size()},
	                {"markers", record.m_SubjectParametrised.m_Markers.size()}, {"feet", feet}},
	    text.empty() ? text : text + "\n");
	return EFine;
}

} // namespace

VCommand AddPerformerCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "performer",
	    "Make a performer's skeleton of a take: a segment for each joint, in the take's rest pose as bind pose but for "
	    "the feet, with the root free, the others as balls, and markers and sticks along the bones",
	    {"performer walk.bvh -o performer.qrs", "performer walk.bvh --unit cm --up z -o performer.qrs"});
	const auto pSettings = std::make_shared<VPerformerSettings>();
	pApp->add_option("TAKE", pSettings->m_Take, "Take: BVH or FBX file; - is standard input")->required();
	AddTakeOptions(*pApp, pSettings->m_pTake);
	pApp->add_option_function<std::string>(
	        "--feet", [pSettings](const std::string& i_rFeet) { pSettings->m_bFeetAtRest = i_rFeet == "rest"; },
	        "In the bind pose the feet stand as they do in the take, turned and raised from its rest pose "
	        "(standing, if left out), or as in that pose (rest)")
	    ->check(CLI::IsMember({"standing", "rest"}))
	    ->option_text("standing|rest");
	pApp->add_option(
	        "-o,--output", pSettings->m_Out.m_Path, "Where the performer's skeleton is saved; - is standard output")
	    ->option_text("OUT.qrs")
	    ->required();
	AddForceOption(*pApp, pSettings->m_Out);
	return {pApp, [pSettings] { return WritePerformer(*pSettings); }};
}

} // namespace CommandLine
