#pragma once

#include "RetargetSetupCore/RetargetSetupCore.h"
#include "SetupReview/advice/PruneAdvice.h"
#include "SetupReview/advice/RangeOfMotion.h"

#include <boost/filesystem/path.hpp>

#include <optional>
#include <string>
#include <vector>

namespace SetupReview
{

struct VAdvice
{
	std::vector<VPruneAdvice> m_Prune;
	/// With a source only.
	std::optional<VRangeOfMotion> m_Range;
	/// False where it is not known which bones skin hangs on.
	bool m_bSkin = false;
};

/// On any thread.
/// @param i_rSource what the target subject follows, may be empty.
/// @param i_rTarget whole.
/// @param i_rFbx the character's file, for the skin; empty for none.
/// @return nothing if that cannot be read whole.
std::optional<VAdvice> AdviceOn(const VRetargetSetupCore::VSubjectValues& i_rSource,
    const VRetargetSetupCore::VSubjectValues& i_rTarget, const boost::filesystem::path& i_rFbx);

/// "tail3 by 12.0 mm and 3.0 degrees", or that it stays.
std::string PoseChangeText(const VPruneAdvice& i_rAdvice, const CoreOrlexTypes::VSubjectParametrised& i_rSubject);
/// What was solved, and how much of it failed, a sentence.
std::string RangeSummary(const VRangeOfMotion& i_rRange);

} // namespace SetupReview
