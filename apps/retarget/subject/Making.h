#pragma once

#include "retarget/subject/Edits.h"

#include <optional>
#include <string>

namespace CommandLine
{

/// What a target subject is made of. Paths are words of a command line: "-" is standard input.
struct VMaking
{
	/// The character's FBX file, or else a retarget subject.
	std::string m_Fbx;
	std::string m_Subject;
	/// The performer's skeleton; empty for none.
	std::string m_Source;
	std::optional<std::string> m_Root;
	/// "--root-height".
	std::string m_RootHeight = "keep";
};

/// Reads the files and runs the edits. Throws VCommandError to fail.
void MakeSubject(VSession& io_rSession, const VMaking& i_rMaking, const VEdits& i_rEdits);

} // namespace CommandLine
