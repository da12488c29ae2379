#include "SetupProposal/SkinVote.h"

#include <algorithm>
#include <cmath>

namespace SetupProposal
{
namespace
{

/// Where the skin of a part is, as means and deviations in parts of the height of the skeleton, and how far it spreads.
struct VExpectedSkin
{
	double m_Up;
	double m_UpDeviation;
	/// From the mirror plane.
	double m_Out;
	double m_OutDeviation;
	double m_Spread;
};

constexpr VExpectedSkin c_ExpectedSkin[] = {
    /* root */ {0.30, 0.30, 0.0, 0.04, 0.10},
    /* pelvis */ {0.54, 0.09, 0.0, 0.03, 0.09},
    /* spine */ {0.70, 0.11, 0.0, 0.03, 0.09},
    /* neck */ {0.86, 0.08, 0.0, 0.03, 0.05},
    /* head */ {0.95, 0.08, 0.0, 0.03, 0.09},
    /* clavicle */ {0.83, 0.07, 0.07, 0.04, 0.05},
    /* upper arm */ {0.80, 0.09, 0.18, 0.06, 0.06},
    /* forearm */ {0.73, 0.13, 0.31, 0.11, 0.05},
    /* hand */ {0.67, 0.17, 0.41, 0.14, 0.03},
    /* thumb */ {0.65, 0.18, 0.41, 0.14, 0.01},
    /* index */ {0.65, 0.18, 0.45, 0.15, 0.01},
    /* middle */ {0.65, 0.18, 0.45, 0.15, 0.01},
    /* ring */ {0.65, 0.18, 0.45, 0.15, 0.01},
    /* little */ {0.65, 0.18, 0.45, 0.15, 0.01},
    /* thigh */ {0.42, 0.09, 0.07, 0.04, 0.09},
    /* shin */ {0.18, 0.08, 0.09, 0.06, 0.08},
    /* foot */ {0.04, 0.06, 0.10, 0.07, 0.04},
    /* toe */ {0.02, 0.05, 0.10, 0.07, 0.02},
};

constexpr double c_WorstSkinPlace = -2.0;
constexpr double c_WorstSkinSpread = -2.0;
constexpr double c_WorstSkin = -4.0;
/// A part may lend its skin to others, but mostly what moves nothing is a helper.
constexpr double c_MovesNothing = -1.0;
/// What no part's skin fits is something else.
constexpr double c_OtherSkin = -2.2;
/// Less than this share of all weights is as good as nothing.
constexpr double c_LeastShare = 1e-4;

} // namespace

std::vector<VPartLogs> VoteBySkin(const VRestSkeleton& i_rSkeleton, const VBodyFrame& i_rFrame)
{
	std::vector<VPartLogs> votes(i_rSkeleton.size());
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
	{
		if (!i_rSkeleton[i].m_Skin)
			continue;
		const VRestSkin& rSkin = *i_rSkeleton[i].m_Skin;
		const bool bNothing = rSkin.m_Share < c_LeastShare;
		const VBodyPlace centre = PlaceIn(i_rFrame, rSkin.m_Centre);
		const double up = UsualUp(i_rFrame, centre.m_Up);
		const double spread = std::max(rSkin.m_Spread / i_rFrame.m_Height, 1e-4);
		for (std::size_t part = 0; part < EOther; ++part)
		{
			const VExpectedSkin& rExpected = c_ExpectedSkin[part];
			if (bNothing)
			{
				votes[i][part] = part == ERoot ? 0.0 : c_MovesNothing;
				continue;
			}
			const double ratio = std::log(spread / rExpected.m_Spread);
			const double out = std::abs(centre.m_Left);
			const double fit = std::max(c_WorstSkinPlace, LogOfNormal(up, rExpected.m_Up, rExpected.m_UpDeviation))
			    + std::max(c_WorstSkinPlace, LogOfNormal(out, rExpected.m_Out, rExpected.m_OutDeviation))
			    + std::max(c_WorstSkinSpread, -0.5 * ratio * ratio / 0.6);
			votes[i][part] = std::max(c_WorstSkin, fit);
		}
		votes[i][EOther] = bNothing ? 0.0 : c_OtherSkin;
	}
	return votes;
}

} // namespace SetupProposal
