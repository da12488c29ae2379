#pragma once

#include <CLI/CLI.hpp>

#include <string>
#include <vector>

/// What the shells offer while a command line is typed. The shells' scripts ask "retarget complete", so that everything
/// comes from the option table: what a value is called in the help tells what it may be.
namespace CommandLine
{

struct VCandidate
{
	/// The whole word; empty where the shell is to offer names of files or folders.
	std::string m_Text;
	/// A few words for shells that show them; "files" or "folders" where the text is empty.
	std::string m_Meaning;
};

/// @param i_rWords of the line behind the program's name; the last is the one that is being typed, up to the cursor
std::vector<VCandidate> Candidates(const CLI::App& i_rProgram, const std::vector<std::string>& i_rWords);

/// What the value of an option, or an argument, is called in the help; empty for a flag.
std::string ValueName(const CLI::Option& i_rOption);

/// Whether the candidates of a value with this name in the help are known; "" has none.
bool IsKnownValue(const std::string& i_rName);

/// "retarget complete words WORD..." or "retarget complete bash LINE CURSOR", which is split as bash does: prints the
/// candidates one to a line, with their meaning behind a tab. For bash they are quoted, and begin where it would
/// replace. Tells nothing else, whatever is wrong.
void PrintCandidates(const CLI::App& i_rProgram, const std::vector<std::string>& i_rArguments);

} // namespace CommandLine
