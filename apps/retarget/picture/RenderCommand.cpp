#include "retarget/picture/RenderCommand.h"

#include "CommandLineText/Parsing.h"
#include "retarget/commands/Commands.h"

#include <boost/filesystem/operations.hpp>

#include <algorithm>
#include <array>
#include <charconv>

namespace CommandLine
{
namespace
{

/// Pixels of a side. All that is drawn into takes some 50 bytes a pixel, 900 MB for the largest picture.
constexpr int c_SmallestSide = 16;
constexpr int c_LargestSide = 4096;

/// Reads "WxH". False for anything else, and for sides out of range.
bool ParseSize(const std::string& i_rText, VRenderSettings& o_rSettings)
{
	const char* pNext = i_rText.data();
	const char* const pEnd = pNext + i_rText.size();
	const auto side = [&](int& o_rSide)
	{
		const auto [pBehind, error] = std::from_chars(pNext, pEnd, o_rSide);
		pNext = pBehind;
		return error == std::errc() && o_rSide >= c_SmallestSide && o_rSide <= c_LargestSide;
	};
	return side(o_rSettings.m_Width) && pNext != pEnd && *pNext++ == 'x' && side(o_rSettings.m_Height) && pNext == pEnd;
}

/// Pictures of a strip.
constexpr std::size_t c_MostFrames = 64;

/// "A:B:STEP".
std::string ParseStrip(const std::string& i_rText, std::vector<std::size_t>& o_rFrames)
{
	std::array<std::size_t, 3> numbers{};
	std::string_view text = i_rText;
	for (std::size_t i = 0; i < numbers.size(); ++i)
	{
		const std::size_t colon = i + 1 < numbers.size() ? text.find(':') : text.size();
		if (colon == std::string_view::npos || !ParseFrame(text.substr(0, colon), numbers[i]))
			return "\"" + i_rText + "\" is not FIRST:LAST:STEP, three numbers";
		text.remove_prefix(std::min(colon + 1, text.size()));
	}
	const auto [first, last, step] = numbers;
	if (step == 0 || last < first || (last - first) / step >= c_MostFrames)
		return "\"" + i_rText + "\" makes no strip of 1 to " + std::to_string(c_MostFrames) + " frames";
	for (std::size_t i = 0; i <= (last - first) / step; ++i)
		o_rFrames.push_back(first + i * step);
	return {};
}

EExitStatus Render(const VRenderSettings& i_rSettings, const VRender& i_rRender)
{
	CheckOutput(i_rSettings.m_Out, c_PictureFile, {i_rSettings.m_In, i_rSettings.m_Source, i_rSettings.m_Take});
	if (i_rSettings.m_Take.empty() != i_rSettings.m_Frames.empty())
		throw VCommandError(EWrongUsage, "--take goes with --frame or --frames, which tell what of it is drawn");
	if (!i_rSettings.m_Take.empty() && i_rSettings.m_Source.empty())
		throw VCommandError(EWrongUsage, "--take needs --source, the performer that it poses");
	boost::system::error_code error;
	if (!i_rSettings.m_Skins.empty() && !boost::filesystem::is_directory(i_rSettings.m_Skins, error))
		throw VCommandError(EBadInput, "There is no folder \"" + i_rSettings.m_Skins + "\" to look for skins in");
	return i_rRender.m_Command(i_rSettings);
}

} // namespace

VCommand AddRenderCommand(CLI::App& io_rProgram, const VRender& i_rRender)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "render",
	    "Draw the preview of a retarget subject as a picture: both skeletons in their bind poses, and the targets. The "
	    "only command that needs a display with OpenGL",
	    {"render hero.qrr -o hero.png",
	        "render hero.qrr --source performer.qrs --view front --size 1920x1080 -o front.png",
	        "render hero.qrr --source performer.qrs --take walk.bvh --frames 0:200:40 --size 320x480 -o strip.png",
	        "render hero.qrr -o - >hero.png"});
	const auto pSettings = std::make_shared<VRenderSettings>();
	pSettings->m_View = c_Views.front();
	pApp->add_option("FILE.qrr", pSettings->m_In, "The retarget subject, or a legacy one (.qrx); - is standard input")
	    ->required();
	pApp->add_option("--source", pSettings->m_Source, "The performer's skeleton, to be drawn with it")
	    ->option_text("FILE.qrs")
	    ->check(NotEmpty());
	pApp->add_option("--skins", pSettings->m_Skins, "Where the target's FBX lies, whose skin is drawn on the bones")
	    ->option_text("FOLDER")
	    ->check(NotEmpty());
	std::string views;
	for (const char* pView : c_Views)
		views += (views.empty() ? "" : "|") + std::string(pView);
	pApp->add_option("--view", pSettings->m_View, "From where (default: perspective)")
	    ->option_text(views)
	    ->check(OneOf(std::vector<std::string>(c_Views.begin(), c_Views.end())));
	pApp->add_option_function<std::string>(
	        "--size",
	        [pSettings](const std::string& i_rText)
	        {
		        if (!ParseSize(i_rText, *pSettings))
			        throw CLI::ValidationError("--size",
			            "\"" + i_rText + "\" is not WIDTHxHEIGHT with " + std::to_string(c_SmallestSide) + " to "
			                + std::to_string(c_LargestSide) + " pixels each");
	        },
	        "Pixels of the picture (default: 1280x720)")
	    ->option_text("WxH");
	pApp->add_option("-o,--output", pSettings->m_Out.m_Path, "Where the picture is saved; - is standard output")
	    ->option_text("OUT.png")
	    ->required();
	AddForceOption(*pApp, pSettings->m_Out);
	pApp->add_option("--take", pSettings->m_Take,
	        "Draw both as they stand in frames of this motion (BVH or FBX file), the target as our own solve has it; "
	        "the host's may weigh things differently")
	    ->option_text("TAKE")
	    ->check(NotEmpty());
	AddParsedOption(*pApp, "--frame", "FRAME", "The frame of the take; the first is 0",
	    [pSettings](const std::string& i_rText)
	    {
		    pSettings->m_Frames.assign(1, 0);
		    return ParseFrame(i_rText, pSettings->m_Frames.front()) ? std::string()
		                                                            : "\"" + i_rText + "\" is no number of a frame";
	    });
	AddParsedOption(*pApp, "--frames", "FIRST:LAST:STEP", "A strip of frames, one beside the other, each of the --size",
	    [pSettings](const std::string& i_rText)
	    {
		    pSettings->m_Frames.clear();
		    return ParseStrip(i_rText, pSettings->m_Frames);
	    });
	AddTakeOptions(*pApp, pSettings->m_pTake);
	AddPairOptions(*pApp, pSettings->m_pPairs);
	return {pApp, [pSettings, i_rRender] { return Render(*pSettings, i_rRender); }};
}

} // namespace CommandLine
