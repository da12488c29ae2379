#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"
#include "FBXIO/Mesh.h"
#include "RetargetSetupCore/BindPose.h"

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace SetupReview
{

enum class EPruneVerdict
{
	/// Nothing moves it.
	Go,
	/// Targets beneath it move it, and no skin that is known bends there.
	May,
	/// Targets beneath it move it, and skin bends there.
	Stay
};

/// "go", "may go", "stay".
const char* NameOf(EPruneVerdict i_Verdict);

/// A joint that carries no target of its own.
struct VPruneAdvice
{
	std::size_t m_Segment = 0;
	EPruneVerdict m_Verdict = EPruneVerdict::Go;
	/// Indices of the targets beneath it.
	std::vector<std::size_t> m_TargetsBelow;
	/// Of the skin, that are weighted to its bone.
	std::size_t m_Vertices = 0;
	/// What the bind pose would change if this joint alone were pruned, at the segment that changes most; nothing if it
	/// stayed, or if that is not known.
	std::optional<RetargetSetup::VPoseDifference> m_PoseChange;
	/// False for subjects of more than a thousand segments: it would take the square of their number.
	bool m_bPoseKnown = true;
	/// A sentence for the operator.
	std::string m_Words;
	/// Those of "retarget edit" that remove it, for a shell; empty where it is to stay.
	std::string m_Options;
};

/// For each segment how many vertices are weighted to the bone of its name.
std::vector<std::size_t> SkinVertices(
    const CoreOrlexTypes::VSubjectParametrised& i_rSubject, const FBXIO::VSkin& i_rSkin);

/// All joints but the root's that could be pruned, in the order of the segments.
/// @param i_rVertices from SkinVertices; empty if no skin is known.
std::vector<VPruneAdvice> AdvisePruning(
    const CoreOrlexTypes::VSubjectParametrised& i_rSubject, const std::vector<std::size_t>& i_rVertices);

} // namespace SetupReview
