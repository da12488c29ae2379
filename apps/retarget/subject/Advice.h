#pragma once

#include "retarget/subject/Session.h"

#include "SetupReview/advice/Advice.h"

#include <string>

namespace CommandLine
{

/// Of the session's target subject, and its source if it has one.
/// @param i_rFbx the character's file, for the skin; empty for none. Throws VCommandError with EBadInput if it cannot
/// be read.
SetupReview::VAdvice AdviceOn(VSession& io_rSession, const std::string& i_rFbx);

} // namespace CommandLine
