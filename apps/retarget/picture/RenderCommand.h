#pragma once

#include "CommandLineText/ExitStatus.h"
#include "retarget/subject/TakeFile.h"
#include "retarget/text/OutputFile.h"

#include <array>
#include <cstdint>
#include <functional>
#include <string>

namespace CommandLine
{

/// What "retarget render" is asked for.
struct VRenderSettings
{
	std::string m_In;
	/// Empty for none.
	std::string m_Source;
	/// Folder; empty for none.
	std::string m_Skins;
	VOutput m_Out;
	std::string m_View;
	int m_Width = 1280;
	int m_Height = 720;
	/// Empty for the bind poses.
	std::string m_Take;
	std::shared_ptr<TakeIO::VTakeSettings> m_pTake = std::make_shared<TakeIO::VTakeSettings>();
	std::shared_ptr<VPairSettings> m_pPairs = std::make_shared<VPairSettings>();
	/// One beside the other.
	std::vector<std::size_t> m_Frames;
};

/// The views by name, in the order of the preview's camera types.
inline constexpr std::array c_Views = {"perspective", "front", "back", "left", "right", "top", "bottom"};

/// Draws the picture. Only this needs a display, and libraries that would make every start of the program longer: so
/// "retarget" has another program do it, which is made of the same commands.
struct VRender
{
	/// The command "render", as its line was given.
	std::function<EExitStatus(const VRenderSettings&)> m_Command;
	/// The bytes of a picture for another command. Throws VCommandError with the reason where none can be drawn.
	std::function<std::string(const VRenderSettings&)> m_Picture;
};

} // namespace CommandLine
