#pragma once

#include <boost/filesystem/path.hpp>

#include <cstddef>
#include <cstdio>
#include <string>
#include <string_view>

/// What a program of the command line asks of the system. One file for each system implements it.
namespace CommandLine
{

/// Columns of the terminal that standard output goes to; 0 if it is none.
std::size_t TerminalWidth();

/// From here on standard input and output carry bytes as they are, and a terminal shows them as UTF-8.
void PrepareStreams();

/// Opens a file, made if it is not there, whose writes each go to its end in one piece, whoever else writes to it.
/// @return a descriptor; -1 with errno set.
int OpenToAppend(const std::string& i_rFile);

/// Writes a text in one piece, without what the standard streams keep back: also for handlers of signals.
/// @return whether all of it was written; if not, errno tells why.
bool WriteAtOnce(int i_Descriptor, std::string_view i_Text);

/// A file that is written once, and goes when the process ends; there is one at a time.
/// @return null with errno set.
std::FILE* OpenScratchFile();
/// Ends the writing.
/// @return by what this process can read the file from now on; empty, with errno set, if not all could be written.
boost::filesystem::path FinishScratchFile(std::FILE* io_pFile);

/// Whether a process that left this exit code came to its end by itself, instead of by a crash.
/// @param i_Code as the system gives it.
bool HasEndedItself(int i_Code);

} // namespace CommandLine
