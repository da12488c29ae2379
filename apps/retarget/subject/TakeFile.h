#pragma once

#include "TakeIO/ReadTake.h"
#include "TakeSolve/SourceMotion.h"

#include <CLI/CLI.hpp>

#include <functional>
#include <memory>
#include <string>

namespace CommandLine
{

/// Adds --up, --stack, --unit and --rate.
void AddTakeOptions(CLI::App& io_rApp, const std::shared_ptr<TakeIO::VTakeSettings>& i_rpSettings);

struct VPairSettings : TakeSolve::VSourceSettings
{
	/// A mapping of joints; empty for none.
	std::string m_File;
};

/// Adds --joint, --joints and --rest-frame.
void AddPairOptions(CLI::App& io_rApp, const std::shared_ptr<VPairSettings>& i_rpSettings);

/// With the pairs of the file. Throws VCommandError with EBadInput for one that is no mapping of joints.
TakeSolve::VSourceSettings ReadPairs(const VPairSettings& i_rSettings);

/// Throws VCommandError with EBadInput for a file that cannot be read as a take.
TakeIO::VTake ReadTakeFile(const std::string& i_rPath, const TakeIO::VTakeSettings& i_rSettings);

/// An option whose text is parsed while the command line is read: the function tells what is wrong with it, or nothing.
void AddParsedOption(CLI::App& io_rApp, const std::string& i_rName, const std::string& i_rType,
    const std::string& i_rHelp, const std::function<std::string(const std::string&)>& i_rParse);

/// What is wrong with a text that should be a number in a range; empty if nothing is.
std::string ParseNumber(
    const std::string& i_rText, double i_Least, double i_Greatest, std::optional<double>& o_rNumber);

/// A whole number from 0 on.
bool ParseFrame(std::string_view i_Text, std::size_t& o_rFrame);

/// The file's name without folder and extension.
std::string StemOf(const std::string& i_rPath);

} // namespace CommandLine
