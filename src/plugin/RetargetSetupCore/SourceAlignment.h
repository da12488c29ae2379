#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "SetupProposal/Alignment.h"

#include <cstddef>
#include <optional>
#include <set>
#include <string>

/// A target subject that takes the bind pose of its source.
namespace RetargetSetup
{

struct VAlignmentChoice
{
	bool m_bSpine = true;
	bool m_bArms = true;
	bool m_bLegs = true;
	/// What is no part of a body.
	bool m_bOthers = true;
	/// Whether feet lean as the shins do.
	bool m_bFeetWithShins = false;
	/// The document begins with no other pose than the one that stands there.
	bool m_bAsItStands = false;
	/// Segments of the target whose joints stay as they are.
	std::set<std::size_t> m_Locked;
};

struct VAligned
{
	/// With bind poses that are means, too, and with the offsets of all targets measured anew: one edit of the
	/// document.
	CoreOrlexTypes::VSubjectParametrised m_Subject;
	/// Which joints were turned, by how much, and which chains were refused.
	SetupProposal::VAlignment m_Alignment;
};

/// Brings each segment that a target ties to a source segment to where that points, see SetupProposal::Align. Only
/// ball joints and the free joint of a root turn.
/// @param i_rSource converted from i_rSourceParametrised, as i_rTarget is from i_rTargetParametrised.
/// @param o_rReason if nothing comes back: why, as a sentence for the operator.
std::optional<VAligned> AlignToSource(const CoreOrlexTypes::VSubjectParametrised& i_rSourceParametrised,
    const CoreOrlexTypes::VSubject& i_rSource, const CoreOrlexTypes::VSubjectParametrised& i_rTargetParametrised,
    const CoreOrlexTypes::VSubject& i_rTarget, const VAlignmentChoice& i_rChoice, std::string& o_rReason);

} // namespace RetargetSetup
