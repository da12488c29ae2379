#pragma once

#include <boost/filesystem/path.hpp>

#include <cstdint>
#include <string>

namespace CommandLine
{

/// The word that means standard input where a file is read, and standard output where one is written.
inline constexpr const char* c_pStandardStream = "-";

/// The largest FBX file that is read; larger than anything else.
inline constexpr std::uint64_t c_LargestInput = std::uint64_t(2) << 30;

/// Where the file lies that a word of the command line names. Standard input is copied into a temporary file without a
/// name, since readers look into a file more than once. Throws VCommandError with EWrongUsage where it has been copied
/// before, with EBadInput where that fails.
/// @param i_MaximumBytes that the reader takes: no more is copied than shows that there are more.
boost::filesystem::path InputPath(const std::string& i_rWord, std::uint64_t i_MaximumBytes = c_LargestInput);

} // namespace CommandLine
