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
	/// "--root-height"; empty, which is "keep", where it is not given.
	std::string m_RootHeight;
	/// An operator typed the edits: what is left open is chosen for the best, and told. Texts and programs say it all.
	bool m_bTyped = false;
	/// Where a text has the root, as "FILE:LINE: ".
	std::string m_RootWhere = {};
};

/// Reads the files and runs the edits. Throws VCommandError to fail.
void MakeSubject(VSession& io_rSession, const VMaking& i_rMaking, const VEdits& i_rEdits);

} // namespace CommandLine
