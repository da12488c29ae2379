#include "CommandLineText/HelpFormatter.h"
#include "CommandLineText/Messages.h"
#include "CommandLineText/System.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/TakeFile.h"
#include "retarget/text/MotionFile.h"
#include "retarget/text/Output.h"
#include "retarget/text/Table.h"

#include "math/NumberText.h"

#include <algorithm>
#include <cmath>
#include <unistd.h>

namespace CommandLine
{
namespace
{

using namespace TakeIO;

struct VTakeCommand
{
	std::string m_File;
	std::shared_ptr<VTakeSettings> m_pSettings = std::make_shared<VTakeSettings>();
	VMotionOutput m_Output;
};

std::string SixDigits(double i_Number)
{
	std::string text;
	NumberText::AppendG(text, i_Number, 6);
	return text;
}

const char* UpText(const VTake& i_rTake)
{
	return i_rTake.m_FileUp == EUp::Y ? "y" : "z";
}

VJson TakeToJson(const VTake& i_rTake)
{
	VJson json{{"frames", i_rTake.m_Frames}, {"rate", i_rTake.m_Rate}, {"channels", i_rTake.m_Channels},
	    {"up", UpText(i_rTake)}, {"unit", i_rTake.m_FileUnit}, {"joints", VJson::array()}};
	for (const VJoint& rJoint : i_rTake.m_Joints)
	{
		VJson channels = VJson::array();
		for (const EChannel channel : rJoint.m_Channels)
			channels.push_back(c_ChannelNames[std::size_t(channel)]);
		json["joints"].push_back({{"name", rJoint.m_Name}, {"parent", rJoint.m_Parent}, {"rest", rJoint.m_Rest.t},
		    {"channels", std::move(channels)}, {"ends", rJoint.m_Ends}});
	}
	return json;
}

/// "position, rotation ZYX", with one axis or two where there are no more.
std::string ChannelText(const VJoint& i_rJoint)
{
	std::string axes[2];
	for (const EChannel channel : i_rJoint.m_Channels)
		axes[IsRotation(channel) ? 1 : 0] += char('X' + AxisOf(channel));
	std::string text = axes[0].empty() ? "" : "position " + axes[0];
	if (!axes[1].empty())
		text += (text.empty() ? "rotation " : ", rotation ") + axes[1];
	return text;
}

std::string TakeText(const VTake& i_rTake)
{
	const double seconds = double(i_rTake.m_Frames) / i_rTake.m_Rate;
	const std::string text = std::to_string(i_rTake.m_Frames) + " frames at " + SixDigits(i_rTake.m_Rate) + " Hz ("
	    + Fixed(seconds, 2) + " s), " + std::to_string(i_rTake.m_Joints.size()) + " joints, "
	    + std::to_string(i_rTake.m_Channels) + " channels; in the file " + UpText(i_rTake) + " is up and a unit "
	    + Fixed(i_rTake.m_FileUnit, 3) + " mm";
	VTable table;
	table.AddColumn("INDEX", VTable::ERight);
	table.AddColumn("NAME", VTable::ELeft);
	table.AddColumn("LENGTH", VTable::ERight);
	table.AddColumn("CHANNELS", VTable::ELeft);
	std::vector<std::size_t> depths;
	for (const VJoint& rJoint : i_rTake.m_Joints)
	{
		depths.push_back(rJoint.m_Parent < 0 ? 0 : depths[std::size_t(rJoint.m_Parent)] + 1);
		const auto [x, y, z] = rJoint.m_Rest.t;
		// A deep tree is one of the hostile; its names are to be read all the same.
		table.AddRow({std::to_string(depths.size() - 1),
		    std::string(2 * std::min<std::size_t>(depths.back(), 40), ' ') + rJoint.m_Name,
		    Fixed(rJoint.m_Parent < 0 ? 0.0 : std::hypot(x, y, z), 1), ChannelText(rJoint)});
	}
	return FitTerminal(text, 2) + "\n" + table.Text(HasColours(STDOUT_FILENO), TerminalWidth());
}

EExitStatus RunTake(VTakeCommand i_Command)
{
	VMotionOutput& rOutput = i_Command.m_Output;
	// An FBX file with a take holds its character, too.
	if (rOutput.m_Character.empty() && LowerExtension(i_Command.m_File) == ".fbx")
		rOutput.m_Character = i_Command.m_File;
	if (!rOutput.m_Path.empty())
		CheckMotionOutput(rOutput, {i_Command.m_File, rOutput.m_Character});
	const VTake take = ReadTakeFile(i_Command.m_File, *i_Command.m_pSettings);
	if (rOutput.m_Path.empty())
	{
		PrintResult(TakeToJson(take), TakeText(take));
		return EFine;
	}
	rOutput.m_Name = StemOf(i_Command.m_File);
	WriteMotionFile(take, rOutput);
	PrintResult({{"output", rOutput.m_Path}}, "");
	return EFine;
}

} // namespace

VCommand AddTakeCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "take",
	    "Show what recorded motion (BVH, FBX 6 and 7) holds: frames and rate, and the joints as a tree with length in "
	    "mm "
	    "from the parent and channels, in our axes (Z up). What the file does not tell is guessed from its rest pose, "
	    "and told. With -o it is written: as BVH, or on a character whose bones have the names of its joints",
	    {"take walk.bvh", "take walk.bvh --unit cm --up z", "take hero.fbx --stack run --rate 30",
	        "take walk.bvh --json | jq .rate", "take hero.fbx --stack run -o run.glb",
	        "take solved.bvh --fbx hero.fbx -o hero_solved.fbx"});
	const auto pCommand = std::make_shared<VTakeCommand>();
	pApp->add_option("FILE", pCommand->m_File, "Take: BVH or FBX file; - is standard input")->required();
	AddTakeOptions(*pApp, pCommand->m_pSettings);
	VMotionOutput& rOutput = pCommand->m_Output;
	pApp->add_option("-o,--output", rOutput.m_Path,
	        "Where the motion is written: .bvh, .glb (glTF binary: the character with its skin) or .fbx (the "
	        "character's own binary file with one more animation stack)")
	    ->option_text("OUT");
	pApp->add_option("--fbx", rOutput.m_Character,
	        "The character's FBX file, whose bones have the names of the joints; without it FILE itself, if that is "
	        "one")
	    ->option_text("FILE.fbx");
	AddForceOption(*pApp, rOutput);
	return {pApp, [pCommand] { return RunTake(*pCommand); }};
}

} // namespace CommandLine
