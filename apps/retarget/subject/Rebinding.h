#pragma once

#include "retarget/subject/Session.h"

#include <optional>
#include <string>
#include <vector>

/// A target subject taken over to a changed file of its character, or to another performer. All throw VCommandError to
/// fail.
namespace CommandLine
{

/// What is told, in both forms, of all that was done.
struct VRebinding
{
	VJson m_Json = VJson::object();
	std::string m_Text;
	/// What could not be kept.
	std::vector<std::string> m_Lost;
};

/// @param i_rRoot of the new file; without it the one of the old root's name, or that is the same of a body.
void RebindToCharacter(
    VSession& io_rSession, const std::string& i_rFbx, const std::optional<std::string>& i_rRoot, VRebinding& io_rTold);

/// To the session's source.
void RebindToPerformer(VSession& io_rSession, VRebinding& io_rTold);

/// At the end of what is told.
void TellLost(VRebinding& io_rTold);

/// "--rebind-fbx" and "--rebind-source": with what came of it in what the session reports.
void RebindFbx(VSession& io_rSession, const std::string& i_rFbx);
void RebindSource(VSession& io_rSession, const std::string&);

} // namespace CommandLine
