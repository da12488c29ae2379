#pragma once

#include "retarget/subject/Session.h"

#include "SetupReview/advice/PruneAdvice.h"
#include "SetupReview/advice/RangeOfMotion.h"

#include <optional>
#include <string>
#include <vector>

namespace CommandLine
{

struct VAdvice
{
	std::vector<SetupReview::VPruneAdvice> m_Prune;
	/// With a source only.
	std::optional<SetupReview::VRangeOfMotion> m_Range;
	/// False where it is not known which bones skin hangs on.
	bool m_bSkin = false;
};

/// Of the session's target subject, and its source if it has one.
/// @param i_rFbx the character's file, for the skin; empty for none. Throws VCommandError with EBadInput if it cannot
/// be read.
VAdvice AdviceOn(VSession& io_rSession, const std::string& i_rFbx);

/// "tail3 by 12.0 mm and 3.0 degrees", or that it stays.
std::string PoseChangeText(
    const SetupReview::VPruneAdvice& i_rAdvice, const CoreOrlexTypes::VSubjectParametrised& i_rSubject);
/// What was solved, and how much of it failed, a sentence.
std::string RangeSummary(const SetupReview::VRangeOfMotion& i_rRange);

} // namespace CommandLine
