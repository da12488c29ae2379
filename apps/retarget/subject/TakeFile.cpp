#include "retarget/subject/TakeFile.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Messages.h"
#include "CommandLineText/Parsing.h"
#include "CommandLineText/ProgressBar.h"
#include "retarget/subject/SetupFile.h"
#include "retarget/text/InputFile.h"

#include "TakeIO/Limits.h"
#include "UtilsFileSystem/Paths.h"
#include "math/NumberText.h"

#include <algorithm>
#include <charconv>

namespace CommandLine
{
namespace
{

using namespace TakeIO;

constexpr std::pair<const char*, double> c_Units[]{{"mm", 1.0}, {"cm", 10.0}, {"m", 1000.0}, {"inch", 25.4}};

std::string ParseUnit(const std::string& i_rText, std::optional<double>& o_rUnit)
{
	const auto* const pFound =
	    std::ranges::find_if(c_Units, [&i_rText](const auto& i_rUnit) { return i_rUnit.first == i_rText; });
	if (pFound == std::end(c_Units))
		return ParseNumber(i_rText, Limits::c_LeastUnit, Limits::c_GreatestUnit, o_rUnit).empty()
		    ? std::string()
		    : "\"" + i_rText + "\" is none of mm, cm, m, inch, and no number of millimetres";
	o_rUnit = pFound->second;
	return {};
}

/// The last ":" splits, since names of joints may have a namespace.
std::string ParseJoint(const std::string& i_rText, std::vector<TakeSolve::VNamedPair>& io_rPairs)
{
	const std::size_t colon = i_rText.rfind(':');
	if (colon == std::string::npos || colon == 0 || colon + 1 == i_rText.size())
		return "\"" + i_rText + "\" is not JOINT:SEGMENT";
	io_rPairs.push_back({i_rText.substr(0, colon), i_rText.substr(colon + 1)});
	return {};
}

} // namespace

std::string ParseNumber(const std::string& i_rText, double i_Least, double i_Greatest, std::optional<double>& o_rNumber)
{
	double number = 0.0;
	if (!NumberText::ScanWholeReal(i_rText, number) || !(number >= i_Least && number <= i_Greatest))
	{
		std::string wrong = "\"" + i_rText + "\" is no number from ";
		NumberText::AppendG(wrong, i_Least, 6);
		NumberText::AppendG(wrong += " to ", i_Greatest, 6);
		return wrong;
	}
	o_rNumber = number;
	return {};
}

void AddParsedOption(CLI::App& io_rApp, const std::string& i_rName, const std::string& i_rType,
    const std::string& i_rHelp, const std::function<std::string(const std::string&)>& i_rParse)
{
	io_rApp
	    .add_option_function<std::string>(
	        i_rName,
	        [i_rName, i_rParse](const std::string& i_rText)
	        {
		        if (const std::string wrong = i_rParse(i_rText); !wrong.empty())
			        throw CLI::ValidationError(i_rName, wrong);
	        },
	        i_rHelp)
	    ->option_text(i_rType);
}

void AddTakeOptions(CLI::App& io_rApp, const std::shared_ptr<VTakeSettings>& i_rpSettings)
{
	io_rApp
	    .add_option_function<std::string>(
	        "--up",
	        [i_rpSettings](const std::string& i_rAxis) { i_rpSettings->m_Up = i_rAxis == "y" ? EUp::Y : EUp::Z; },
	        "The file's axis that points up: y or z; without it the one along which the skeleton reaches further")
	    ->check(CLI::IsMember({"y", "z"}))
	    ->option_text("y|z");
	io_rApp
	    .add_option_function<std::string>(
	        "--stack", [i_rpSettings](const std::string& i_rName) { i_rpSettings->m_Stack = i_rName; },
	        "Of an FBX file the animation stack of this name; without it the first")
	    ->option_text("STACK");
	AddParsedOption(io_rApp, "--unit", "UNIT",
	    "The file's unit: mm, cm, m, inch or a number of millimetres; without it the one that fits the hips",
	    [i_rpSettings](const std::string& i_rText) { return ParseUnit(i_rText, i_rpSettings->m_Unit); });
	AddParsedOption(io_rApp, "--rate", "HZ", "Frames a second that the take is brought to; without it the file's own",
	    [i_rpSettings](const std::string& i_rText)
	    { return ParseNumber(i_rText, Limits::c_LeastRate, Limits::c_GreatestRate, i_rpSettings->m_Rate); });
}

void AddPairOptions(CLI::App& io_rApp, const std::shared_ptr<VPairSettings>& i_rpSettings)
{
	io_rApp
	    .add_option_function<std::vector<std::string>>(
	        "--joint",
	        [i_rpSettings](const std::vector<std::string>& i_rTexts)
	        {
		        for (const std::string& rText : i_rTexts)
			        if (const std::string wrong = ParseJoint(rText, i_rpSettings->m_Joints); !wrong.empty())
				        throw CLI::ValidationError("--joint", wrong);
	        },
	        "The joint of the take drives this segment of the performer; any number of times. Without it names and the "
	        "shape of the body tell")
	    ->option_text("JOINT:SEGMENT")
	    ->expected(1)
	    ->multi_option_policy(CLI::MultiOptionPolicy::TakeAll);
	io_rApp
	    .add_option("--joints", i_rpSettings->m_File,
	        "Such pairs from a mapping, a JSON text: \"source\" is the joint, \"target\" the segment. \"retarget "
	        "schema "
	        "setup\" has its form")
	    ->option_text("FILE.json")
	    ->check(NotEmpty());
	AddParsedOption(io_rApp, "--rest-frame", "FRAME",
	    "In this frame the performer stands as in the bind pose. Without it the take's rest pose counts, each bone's "
	    "direction brought onto the performer's",
	    [i_rpSettings](const std::string& i_rText)
	    {
		    std::size_t frame = 0;
		    if (!ParseFrame(i_rText, frame))
			    return "\"" + i_rText + "\" is no number of a frame";
		    i_rpSettings->m_RestFrame = frame;
		    return std::string();
	    });
}

TakeSolve::VSourceSettings ReadPairs(const VPairSettings& i_rSettings)
{
	constexpr const char* c_pUse = "a mapping of joints";
	TakeSolve::VSourceSettings settings = i_rSettings;
	if (i_rSettings.m_File.empty())
		return settings;
	for (const SetupIO::VPair& rPair :
	    ParseSetup(ReadSetupText(i_rSettings.m_File, c_pUse), i_rSettings.m_File, {"pairs"}, c_pUse).m_Pairs)
	{
		if (rPair.m_Position || rPair.m_Rotation)
			throw VCommandError(EBadInput,
			    i_rSettings.m_File + ":" + std::to_string(rPair.m_Line.m_Value)
			        + ": A joint drives a segment whole: its pair has neither \"position\" nor \"rotation\"");
		settings.m_Joints.push_back({rPair.m_Source, rPair.m_Target});
	}
	return settings;
}

bool ParseFrame(std::string_view i_Text, std::size_t& o_rFrame)
{
	const auto [pEnd, error] = std::from_chars(i_Text.data(), i_Text.data() + i_Text.size(), o_rFrame);
	return error == std::errc() && pEnd == i_Text.data() + i_Text.size();
}

VTake ReadTakeFile(const std::string& i_rPath, const VTakeSettings& i_rSettings)
{
	VTake take;
	std::string error;
	VProgressBar bar("Reading");
	VTakeSettings settings = i_rSettings;
	settings.m_Progress = [&bar](double i_Part)
	{
		bar.Show(i_Part);
		return true;
	};
	if (!ReadTake(InputPath(i_rPath, Limits::c_FileBytes).string(), settings, take, error))
		throw VCommandError(EBadInput, "\"" + i_rPath + "\" could not be read as a take. " + error);
	RequireNoErrors();
	return take;
}

std::string StemOf(const std::string& i_rPath)
{
	return UtilsFileSystem::PathFromUtf8(i_rPath).stem().string();
}

} // namespace CommandLine
