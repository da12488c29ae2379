#include "CommandLineText/System.h"
#include "retarget/Program.h"
#include "retarget/picture/Renderer.h"

int main(int i_Count, char** i_ppArguments)
{
	CommandLine::PrepareStreams();
	const std::vector<std::string> arguments(i_ppArguments + 1, i_ppArguments + i_Count);
	return CommandLine::Run(arguments,
	    {[&](const CommandLine::VRenderSettings&) { return CommandLine::RunRenderer(arguments); },
	        CommandLine::RenderedPicture});
}
