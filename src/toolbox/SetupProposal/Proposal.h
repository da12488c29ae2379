#pragma once

#include "SetupProposal/BodyParts.h"

#include <string>
#include <vector>

/// Which segment of a performer belongs to which of a character, and how the two stand at rest. Free functions on
/// values, for any thread.
namespace SetupProposal
{

struct VProposedPair
{
	/// Indices of the joints.
	std::size_t m_Source = 0;
	std::size_t m_Target = 0;
	/// From 0 to 1.
	double m_Score = 0.0;
	/// Phrases for the operator: what names, tree and rest pose say, and which of them was outvoted.
	std::vector<std::string> m_Reasons;
	/// Suggested weights of the targets of either kind; 0 for none. Pelvis and ends of limbs get both, inner joints the
	/// rotation.
	double m_PositionWeight = 0.0;
	double m_RotationWeight = 0.0;
};

/// A joint that has no pair, and why.
struct VUnmapped
{
	std::size_t m_Joint = 0;
	std::string m_Reason;
};

struct VProposal
{
	/// In the order of the source. A joint stands in one pair at most.
	std::vector<VProposedPair> m_Pairs;
	/// Pairs that would do nearly as well as the one that one of the two stands in, or that are too poor to be
	/// proposed.
	std::vector<VProposedPair> m_Alternatives;
	/// Why nothing is proposed, as a sentence: one of the two is no body. What pairs there would be stand with the
	/// alternatives. Empty otherwise.
	std::string m_NoBody;
	std::vector<VUnmapped> m_UnmappedSources;
	std::vector<VUnmapped> m_UnmappedTargets;
	/// What each joint was taken for.
	VBodyReading m_Source;
	VBodyReading m_Target;
};

/// A pair that scores less is not proposed.
inline constexpr double c_DefaultLeastScore = 0.5;

/// One to one. The joints may stand in any order and in several trees; joints of the source that do not move get none.
VProposal Propose(
    const VRestSkeleton& i_rSource, const VRestSkeleton& i_rTarget, double i_LeastScore = c_DefaultLeastScore);

/// The root above the joint that was taken for the body's pelvis or, without a pelvis, that most pairs hang on; -1 for
/// no pairs.
std::int64_t BodyRoot(const VProposal& i_rProposal, const VRestSkeleton& i_rTarget);

} // namespace SetupProposal
