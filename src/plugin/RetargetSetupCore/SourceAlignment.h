#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "FBXIO/SkinSkeleton.h"
#include "SetupProposal/Alignment.h"
#include "SetupProposal/PoseCheck.h"

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
	/// The document lets the target stand on its joints, even if the skin of its file is known.
	bool m_bOnJoints = false;
	/// The document first scales the target, with the height of its root, so that its hips come to stand as high above
	/// its feet as the source's. What differs by little stays.
	bool m_bFitScale = false;
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

/// What the document has to tell of an alignment.
struct VAlignedToSource
{
	SetupProposal::VAlignment m_Alignment;
	/// What the pose check tells of the scale that the target had, "scale"; nothing where hips or feet are not known.
	std::optional<SetupProposal::VPoseFinding> m_Scale;
	/// The target has the scale that it suggests.
	bool m_bScaled = false;
};

/// Of two subjects, each converted from its parametrised one.
std::optional<SetupProposal::VPoseFinding> ScaleFinding(
    const CoreOrlexTypes::VSubjectParametrised& i_rSourceParametrised, const CoreOrlexTypes::VSubject& i_rSource,
    const CoreOrlexTypes::VSubjectParametrised& i_rTargetParametrised, const CoreOrlexTypes::VSubject& i_rTarget);

/// Brings each segment that a target ties to a source segment to where that points, see SetupProposal::Align. Only
/// ball joints and the free joint of a root turn.
/// @param i_rSource converted from i_rSourceParametrised, as i_rTarget is from i_rTargetParametrised.
/// @param i_rBones that the target's segments were made of, for the skin that it stands on; empty if not known.
/// @param o_rReason if nothing comes back: why, as a sentence for the operator.
std::optional<VAligned> AlignToSource(const CoreOrlexTypes::VSubjectParametrised& i_rSourceParametrised,
    const CoreOrlexTypes::VSubject& i_rSource, const CoreOrlexTypes::VSubjectParametrised& i_rTargetParametrised,
    const CoreOrlexTypes::VSubject& i_rTarget, const FBXIO::VSkinSkeleton& i_rBones, const VAlignmentChoice& i_rChoice,
    std::string& o_rReason);

} // namespace RetargetSetup
