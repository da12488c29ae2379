#pragma once

#include "retarget/text/OutputFile.h"

#include "TakeIO/Take.h"

#include <optional>

namespace CommandLine
{

/// Where a motion goes, and of what character it is.
struct VMotionOutput : VOutput
{
	/// Empty for none.
	std::string m_Character;
	/// Of the animation in the file.
	std::string m_Name;
	/// How many times larger than the character's file the one that moves is.
	double m_Scale = 1.0;
};

/// To be called before the work, as CheckOutput: throws VCommandError for an output that cannot be written to, that no
/// form of motion has the name of, or that needs a character which is not given.
void CheckMotionOutput(const VMotionOutput& i_rOutput, const std::vector<std::string>& i_rInputs);

/// Writes a motion in the form that the output's name asks for. Throws VCommandError if that fails: EBadInput for the
/// character, EBadOutput for what cannot be written; nothing is written then.
void WriteMotionFile(const TakeIO::VTake& i_rMotion, const VMotionOutput& i_rOutput);

} // namespace CommandLine
