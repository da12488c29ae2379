#include "SetupProposal/RestPoseVote.h"

#include "SetupProposal/Twins.h"

#include <algorithm>
#include <cmath>

namespace SetupProposal
{
namespace
{

/// Where a part stands, as means and deviations. Parts of the height of the skeleton, whose highest joint may be that
/// of the head or the tip of a hat.
struct VExpected
{
	double m_Up;
	double m_UpDeviation;
	/// From the mirror plane.
	double m_Out;
	double m_OutDeviation;
	/// Length of the bone; 0 if a part may have none.
	double m_Length;
	/// Cosines of the bone to up, out and front, summed with these.
	double m_TowardsUp;
	double m_TowardsOut;
	double m_TowardsFront;
};

constexpr VExpected c_Expected[] = {
    /* root */ {0.05, 0.25, 0.0, 0.03, 0.0, 0.0, 0.0, 0.0},
    /* pelvis */ {0.56, 0.10, 0.0, 0.025, 0.0, 0.0, 0.0, 0.0},
    /* spine */ {0.68, 0.10, 0.0, 0.025, 0.09, 1.0, 0.0, 0.0},
    /* neck */ {0.86, 0.09, 0.0, 0.03, 0.05, 1.0, 0.0, 0.0},
    /* head */ {0.92, 0.09, 0.0, 0.035, 0.13, 1.0, 0.0, 0.0},
    /* clavicle */ {0.84, 0.08, 0.03, 0.03, 0.09, 0.0, 1.0, 0.0},
    /* upper arm */ {0.83, 0.08, 0.12, 0.05, 0.17, -0.6, 0.8, 0.0},
    /* forearm */ {0.74, 0.12, 0.26, 0.10, 0.15, -0.6, 0.8, 0.0},
    /* hand */ {0.68, 0.17, 0.38, 0.14, 0.0, 0.0, 0.0, 0.0},
    /* thumb */ {0.66, 0.18, 0.40, 0.15, 0.02, 0.0, 0.0, 0.3},
    /* index */ {0.65, 0.18, 0.44, 0.15, 0.02, 0.0, 0.0, 0.0},
    /* middle */ {0.65, 0.18, 0.44, 0.15, 0.02, 0.0, 0.0, 0.0},
    /* ring */ {0.65, 0.18, 0.44, 0.15, 0.02, 0.0, 0.0, 0.0},
    /* little */ {0.65, 0.18, 0.44, 0.15, 0.02, 0.0, 0.0, 0.0},
    /* thigh */ {0.53, 0.09, 0.06, 0.03, 0.26, -1.0, 0.0, 0.0},
    /* shin */ {0.29, 0.08, 0.08, 0.06, 0.25, -1.0, 0.0, 0.0},
    /* foot */ {0.06, 0.065, 0.10, 0.07, 0.08, -0.6, 0.0, 0.8},
    /* toe */ {0.02, 0.045, 0.10, 0.07, 0.0, 0.0, 0.0, 1.0},
};

/// A part that a joint may be needs a child: what it costs not to have one.
constexpr double c_Childless = -2.0;
/// Heads as large as the body move everything.
constexpr double c_Lenient = 1.4;
constexpr double c_WorstPlace = -2.5;
constexpr double c_WorstBone = -1.5;
constexpr double c_WorstVote = -4.5;
/// What no part fits is something else.
constexpr double c_NoPart = -2.2;
constexpr double c_End = -1.0;

} // namespace

std::vector<VPartLogs> VoteByRestPose(const VRestSkeleton& i_rSkeleton, const VBodyFrame& i_rFrame)
{
	const std::vector<std::int64_t> children = MainChildren(i_rSkeleton);
	std::vector<VPartLogs> votes(i_rSkeleton.size());
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
	{
		const VBodyPlace place = PlaceIn(i_rFrame, i_rSkeleton[i].m_Place);
		const VBodyPlace end =
		    children[i] < 0 ? place : PlaceIn(i_rFrame, i_rSkeleton[std::size_t(children[i])].m_Place);
		const double length =
		    std::hypot(end.m_Left - place.m_Left, end.m_Forward - place.m_Forward, end.m_Up - place.m_Up);
		for (std::size_t part = 0; part < EOther; ++part)
		{
			const VExpected& rExpected = c_Expected[part];
			double score =
			    std::max(c_WorstPlace,
			        LogOfNormal(UsualUp(i_rFrame, place.m_Up), rExpected.m_Up, c_Lenient * rExpected.m_UpDeviation))
			    + std::max(
			        c_WorstPlace, LogOfNormal(std::abs(place.m_Left), rExpected.m_Out, rExpected.m_OutDeviation));
			if (children[i] < 0)
				score += part == EHead || part == EFoot || rExpected.m_Length < 0.03 ? 0.0 : c_Childless;
			else if (rExpected.m_Length > 0.0)
			{
				const double ratio = std::log(std::max(length, 1e-4) / rExpected.m_Length);
				score += std::max(c_WorstBone, -0.5 * ratio * ratio / 0.4);
			}
			if (children[i] >= 0 && length > 1e-4)
			{
				const double side = place.m_Left < 0.0 ? -1.0 : 1.0;
				const double cosine = (rExpected.m_TowardsUp * (end.m_Up - place.m_Up)
				                          + rExpected.m_TowardsOut * side * (end.m_Left - place.m_Left)
				                          + rExpected.m_TowardsFront * (end.m_Forward - place.m_Forward))
				    / length;
				const double most = std::hypot(rExpected.m_TowardsUp, rExpected.m_TowardsOut, rExpected.m_TowardsFront);
				score += std::max(c_WorstBone, -1.2 * (most - cosine));
			}
			votes[i][part] = std::max(c_WorstVote, score);
		}
		votes[i][EOther] = children[i] < 0 ? c_End : c_NoPart;
	}
	return votes;
}

} // namespace SetupProposal
