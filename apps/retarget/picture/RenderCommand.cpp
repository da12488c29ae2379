#include "retarget/picture/RenderCommand.h"

#include "CommandLineText/Parsing.h"
#include "retarget/commands/Commands.h"

#include <boost/filesystem/operations.hpp>

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

EExitStatus Render(const VRenderSettings& i_rSettings, const VRender& i_rRender)
{
	CheckOutput(i_rSettings.m_Out, c_PictureFile, {i_rSettings.m_In, i_rSettings.m_Source});
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
	return {pApp, [pSettings, i_rRender] { return Render(*pSettings, i_rRender); }};
}

} // namespace CommandLine
