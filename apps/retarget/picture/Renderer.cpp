#include "retarget/picture/Renderer.h"

#include "UtilsFileSystem/Paths.h"

#include <boost/dll/runtime_symbol_info.hpp>
#include <boost/filesystem/operations.hpp>
#include <boost/process/args.hpp>
#include <boost/process/child.hpp>

#include <sys/wait.h>

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
		if (const boost::filesystem::path program = (here / pPlace).lexically_normal(); is_regular_file(program, error))
			return program;
	return {};
}

} // namespace

EExitStatus RunRenderer(const std::vector<std::string>& i_rArguments)
{
	const boost::filesystem::path program = FindRenderer();
	if (program.empty())
		throw VCommandError(EBadOutput,
		    "The program that draws, retarget-render, is not in its place: install it, or build it, which takes Qt");
	std::error_code error;
	// It has the same standard input, which the subject may come from.
	boost::process::child child(program, boost::process::args(i_rArguments), error);
	if (!error)
		child.wait(error);
	if (error)
		throw VCommandError(EBadOutput, "\"" + UtilsFileSystem::ToUtf8(program) + "\" cannot be started");
	if (!WIFEXITED(child.native_exit_code()))
		throw VCommandError(
		    EBadOutput, "The display's OpenGL failed while it drew; LIBGL_ALWAYS_SOFTWARE=1 draws without its driver");
	return static_cast<EExitStatus>(child.exit_code());
}

} // namespace CommandLine
