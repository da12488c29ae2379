#include "SetupProposal/PairScore.h"

#include "math/NumberText.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdlib>
#include <tuple>

namespace SetupProposal
{
namespace
{

/// Shares of a score that likeness beyond the part itself has.
constexpr double c_ShareOfPlace = 0.12;
constexpr double c_ShareOfName = 0.10;
/// What it costs in a back if only one of the two carries the arms.
constexpr double c_OnlyOneCarriesArms = 0.3;
/// What each joint of a chain that stands above one and not above the other costs.
constexpr double c_OtherOrdinal = 0.45;
/// A vote of the rest pose or the skin this far below its best speaks against a part.
constexpr double c_ClearlyWorse = 1.5;

double NameLikeness(const VNameWords& i_rA, const VNameWords& i_rB)
{
	if (i_rA.m_Words.empty() || i_rB.m_Words.empty())
		return 0.0;
	std::size_t common = 0;
	for (const std::string& rWord : i_rA.m_Words)
		common += std::ranges::count(i_rB.m_Words, rWord) > 0;
	const double words = double(common) / double(std::max(i_rA.m_Words.size(), i_rB.m_Words.size()));
	return i_rA.m_Number == i_rB.m_Number ? words : 0.5 * words;
}

/// 1 for the same place in both bodies.
double PlaceLikeness(const VBodyPlace& i_rA, const VBodyPlace& i_rB)
{
	const double away = std::hypot(
	    std::abs(i_rA.m_Left) - std::abs(i_rB.m_Left), i_rA.m_Up - i_rB.m_Up, i_rA.m_Forward - i_rB.m_Forward);
	return std::exp(-4.0 * away);
}

/// @param i_bBothBacks the arms hang on the back in both bodies.
double ChainLikeness(const VJointReading& i_rA, const VJointReading& i_rB, EBodyPart i_Part, bool i_bBothBacks)
{
	if (i_Part == ESpine)
		return 1.0 - std::abs(i_rA.m_Along - i_rB.m_Along)
		    - (i_bBothBacks && i_rA.m_bCarriesArms != i_rB.m_bCarriesArms ? c_OnlyOneCarriesArms : 0.0);
	if (!IsFinger(i_Part) && i_Part != ENeck && i_Part != EToe)
		return 1.0;
	return 1.0 - c_OtherOrdinal * std::abs(i_rA.m_Ordinal - i_rB.m_Ordinal);
}

/// Of one voter on one joint.
enum class EVerdict
{
	Silent,
	For,
	Against
};

EVerdict ByName(const VJointReading& i_rJoint, EBodyPart i_Part)
{
	if (!i_rJoint.m_ByName)
		return EVerdict::Silent;
	return (*i_rJoint.m_ByName)[i_Part] > 0.0 ? EVerdict::For : EVerdict::Against;
}

EVerdict ByTree(const VJointReading& i_rJoint)
{
	return i_rJoint.m_bUsualParent ? EVerdict::For : EVerdict::Against;
}

EVerdict ByLogs(const VPartLogs& i_rLogs, EBodyPart i_Part)
{
	return i_rLogs[i_Part] > *std::ranges::max_element(i_rLogs) - c_ClearlyWorse ? EVerdict::For : EVerdict::Against;
}

EVerdict BySkin(const VJointReading& i_rJoint, EBodyPart i_Part)
{
	return i_rJoint.m_BySkin ? ByLogs(*i_rJoint.m_BySkin, i_Part) : EVerdict::Silent;
}

/// What one of the voters says of both joints.
struct VVoice
{
	const char* m_pName;
	EVerdict m_Source;
	EVerdict m_Target;
};

constexpr std::size_t c_Voices = 4;

/// The voices with this verdict on one of the two or both, as "the name of the target, the rest pose".
std::string Voices(const std::array<VVoice, c_Voices>& i_rVoices, EVerdict i_Verdict)
{
	std::string text;
	for (const VVoice& rVoice : i_rVoices)
		if (rVoice.m_Source == i_Verdict || rVoice.m_Target == i_Verdict)
			text += (text.empty() ? "" : ", ") + std::string(rVoice.m_pName)
			    + (rVoice.m_Source == rVoice.m_Target  ? ""
			            : rVoice.m_Source == i_Verdict ? " of the source"
			                                           : " of the target");
	return text;
}

} // namespace

double PairScore(const VBodyReading& i_rSource, std::size_t i_Source, const VBodyReading& i_rTarget,
    std::size_t i_Target, EBodyPart i_Part)
{
	const VJointReading& rSource = i_rSource.m_Joints[i_Source];
	const VJointReading& rTarget = i_rTarget.m_Joints[i_Target];
	if (HasSides(i_Part) && rSource.m_Side != rTarget.m_Side)
		return 0.0;
	const double likeness = 1.0 - c_ShareOfPlace - c_ShareOfName
	    + c_ShareOfPlace * PlaceLikeness(rSource.m_Place, rTarget.m_Place)
	    + c_ShareOfName * NameLikeness(i_rSource.m_Names[i_Source], i_rTarget.m_Names[i_Target]);
	return std::max(0.0,
	    std::sqrt(rSource.m_Likely[i_Part] * rTarget.m_Likely[i_Part]) * likeness
	        * ChainLikeness(rSource, rTarget, i_Part, i_rSource.m_bBackCarriesArms && i_rTarget.m_bBackCarriesArms));
}

std::vector<std::string> PairReasons(const VBodyReading& i_rSource, std::size_t i_Source, const VBodyReading& i_rTarget,
    std::size_t i_Target, EBodyPart i_Part)
{
	const VJointReading& rSource = i_rSource.m_Joints[i_Source];
	const VJointReading& rTarget = i_rTarget.m_Joints[i_Target];
	// Two decimals of a number from 0 to 1.
	const auto hundredths = [](double i_Value) { return NumberText::PrintF(i_Value).substr(0, 4); };
	const std::string side = !HasSides(i_Part) || rSource.m_Side == ESide::None ? ""
	    : rSource.m_Side == ESide::Left                                         ? "left "
	                                                                            : "right ";
	const std::array<VVoice, c_Voices> voices{{{"the name", ByName(rSource, i_Part), ByName(rTarget, i_Part)},
	    {"the place in the tree", ByTree(rSource), ByTree(rTarget)},
	    {"the rest pose", ByLogs(rSource.m_ByRestPose, i_Part), ByLogs(rTarget.m_ByRestPose, i_Part)},
	    {"the skin", BySkin(rSource, i_Part), BySkin(rTarget, i_Part)}}};
	std::vector<std::string> reasons{side + NameOf(i_Part)};
	if (const std::string text = Voices(voices, EVerdict::For); !text.empty())
		reasons.push_back("for it: " + text);
	if (const std::string text = Voices(voices, EVerdict::Against); !text.empty())
		reasons.push_back("outvoted: " + text);
	if (HasSides(i_Part))
		for (const auto& [pBody, joint, pOf] :
		    {std::tuple(&i_rSource, i_Source, "source"), std::tuple(&i_rTarget, i_Target, "target")})
			if (const ESide named = pBody->m_Names[joint].m_Side;
			    named != ESide::None && named != pBody->m_Joints[joint].m_Side)
				reasons.push_back("outvoted: the side that the name of the " + std::string(pOf) + " tells");
	if (const std::string text = Voices(voices, EVerdict::Silent); !text.empty())
		reasons.push_back("tells nothing: " + text);
	if (i_Part == ESpine)
		reasons.push_back(hundredths(rSource.m_Along) + " and " + hundredths(rTarget.m_Along)
		    + " of the way from the pelvis to the neck"
		    + (rSource.m_bCarriesArms && rTarget.m_bCarriesArms ? ", both carry the arms" : ""));
	return reasons;
}

} // namespace SetupProposal
