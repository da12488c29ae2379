#include "retarget/picture/Renderer.h"

#include "CommandLineText/System.h"

#include "NVX/Status.h"
#include "UtilsFileSystem/Files.h"
#include "UtilsFileSystem/Paths.h"

#include <boost/algorithm/string/trim.hpp>
#include <boost/dll/runtime_symbol_info.hpp>
#include <boost/filesystem/operations.hpp>
#include <boost/process/args.hpp>
#include <boost/process/child.hpp>
#include <boost/process/io.hpp>

namespace CommandLine
{
namespace
{

/// Where it stands as seen from this one; empty if it does not.
boost::filesystem::path FindRenderer()
{
	boost::dll::fs::error_code error;
	const boost::filesystem::path here = boost::dll::program_location(error).parent_path();
	for (const char* const pPlace : {RETARGET_RENDER_IN_BUILD, RETARGET_RENDER_INSTALLED})
		if (boost::filesystem::path program = (here / pPlace).lexically_normal(); is_regular_file(program, error))
			return program;
	return {};
}

boost::filesystem::path Renderer()
{
	boost::filesystem::path program = FindRenderer();
	if (program.empty())
		throw VCommandError(EBadOutput,
		    "The program that draws, retarget-render, is not in its place: install it, or build it, which takes Qt");
	return program;
}

[[noreturn]] void FailToStart(const boost::filesystem::path& i_rProgram)
{
	throw VCommandError(EBadOutput, "\"" + UtilsFileSystem::ToUtf8(i_rProgram) + "\" cannot be started");
}

constexpr const char* c_pCrashed =
    "The display's OpenGL failed while it drew; LIBGL_ALWAYS_SOFTWARE=1 draws without its driver";

/// A folder that goes with all that is in it.
struct VTemporaryFolder
{
	VTemporaryFolder() { boost::filesystem::create_directory(m_Path); }
	~VTemporaryFolder()
	{
		boost::system::error_code error;
		boost::filesystem::remove_all(m_Path, error);
	}

	const boost::filesystem::path m_Path =
	    boost::filesystem::temp_directory_path() / boost::filesystem::unique_path("retarget-%%%%%%%%%%%%");
};

std::string ReadIfThere(const boost::filesystem::path& i_rPath)
{
	std::string text;
	std::string reason;
	return UtilsFileSystem::ReadWholeFile(i_rPath, text.max_size() / 2, text, reason) == NVX::Status::c_Success ? text
	                                                                                                            : "";
}

/// The last message that it told, without its level and category.
std::string LastMessage(std::string i_Messages)
{
	boost::algorithm::trim_right(i_Messages);
	i_Messages.erase(0, i_Messages.rfind('\n') + 1);
	const std::size_t text = i_Messages.find(": ");
	return text == std::string::npos ? i_Messages : i_Messages.substr(text + 2);
}

} // namespace

EExitStatus RunRenderer(const std::vector<std::string>& i_rArguments)
{
	const boost::filesystem::path program = Renderer();
	std::error_code error;
	// It has the same standard input, which the subject may come from.
	boost::process::child child(program, boost::process::args(i_rArguments), error);
	if (!error)
		child.wait(error);
	if (error)
		FailToStart(program);
	if (!HasEndedItself(child.native_exit_code()))
		throw VCommandError(EBadOutput, c_pCrashed);
	return static_cast<EExitStatus>(child.exit_code());
}

std::string RenderedPicture(const VRenderSettings& i_rSettings)
{
	const boost::filesystem::path program = Renderer();
	const VTemporaryFolder folder;
	const boost::filesystem::path picture = folder.m_Path / "picture.png";
	const boost::filesystem::path messages = folder.m_Path / "messages";
	std::vector<std::string> arguments{"render", "-q", "--view", i_rSettings.m_View, "--size",
	    std::to_string(i_rSettings.m_Width) + "x" + std::to_string(i_rSettings.m_Height), "-o", picture.string()};
	for (const auto& [pOption, pValue] :
	    {std::pair{"--source", &i_rSettings.m_Source}, {"--skins", &i_rSettings.m_Skins}})
		if (!pValue->empty())
			arguments.insert(arguments.end(), {pOption, *pValue});
	arguments.insert(arguments.end(), {"--", i_rSettings.m_In});
	std::error_code error;
	boost::process::child child(program, boost::process::args(arguments),
	    boost::process::std_in<boost::process::null, boost::process::std_out> boost::process::null,
	    boost::process::std_err > messages, error);
	if (!error)
		child.wait(error);
	if (error)
		FailToStart(program);
	if (!HasEndedItself(child.native_exit_code()))
		throw VCommandError(EBadOutput, c_pCrashed);
	if (child.exit_code() != EFine)
		throw VCommandError(EBadOutput, LastMessage(ReadIfThere(messages)));
	return ReadIfThere(picture);
}

} // namespace CommandLine
