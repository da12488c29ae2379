#pragma once

#include "SetupProposal/BodyFrame.h"
#include "SetupProposal/BodyPart.h"

#include <optional>
#include <vector>

namespace SetupProposal
{

/// How well each part would fit a joint, as logarithms: 0 is as good as it gets.
using VPartLogs = VPartScores;

/// Of the normal distribution's density, without its factor: 0 at the mean.
inline double LogOfNormal(double i_Value, double i_Mean, double i_Deviation)
{
	const double away = (i_Value - i_Mean) / i_Deviation;
	return -0.5 * away * away;
}

/// What each of the voters says of a joint, and what they say together.
struct VJointReading
{
	/// Nothing if the name tells none.
	std::optional<VPartScores> m_ByName;
	VPartLogs m_ByRestPose{};
	/// Nothing if no skin is known.
	std::optional<VPartLogs> m_BySkin;
	/// Probabilities of the parts by names, rest pose, skin and the place in the tree together; they sum to 1.
	VPartScores m_Likely{};
	EBodyPart m_Part = EOther;
	ESide m_Side = ESide::None;
	/// Of the one to the part that stands above it, whether such a thing is usual: an arm beneath a spine.
	bool m_bUsualParent = false;
	EBodyPart m_ParentPart = EOther;
	/// For a part of which there are several in a chain: how many of it stand above this one, and where it is along
	/// the chain, from 0 to 1: a back from the pelvis to the neck.
	int m_Ordinal = 0;
	double m_Along = 0.0;
	/// Of the back: carries the arms.
	bool m_bCarriesArms = false;
	VBodyPlace m_Place;
	/// The joint on the other side by the tree, -1 for none.
	std::int64_t m_Twin = -1;
};

struct VBodyReading
{
	VBodyFrame m_Frame;
	std::vector<VNameWords> m_Names;
	std::vector<VJointReading> m_Joints;
	/// Whether the arms hang on any joint of the back at all.
	bool m_bBackCarriesArms = false;
};

/// What each joint of a skeleton is. Names, tree, rest pose and skin vote, and any two of them may outvote another.
VBodyReading ReadBody(const VRestSkeleton& i_rSkeleton);

} // namespace SetupProposal
