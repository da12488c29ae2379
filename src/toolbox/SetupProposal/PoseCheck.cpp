#include "SetupProposal/PoseCheck.h"

#include "SetupProposal/Sole.h"
#include "math/NumberText.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <map>
#include <optional>
#include <string_view>

namespace SetupProposal
{
namespace
{

/// Differences up to these are fine: degrees, a share of the height, parts of the body's height.
constexpr double c_FineFacing = 20.0;
constexpr double c_FineLimb = 12.0;
constexpr double c_FineScale = 0.02;
/// Where the lowest joint stands over the floor: a toe in a boot, or an ankle where there are no toes.
constexpr double c_FineToeAbove = 0.11;
constexpr double c_FineAnkleAbove = 0.15;
constexpr double c_FineBelow = 0.02;
/// Where the skin of the feet ends over or below it.
constexpr double c_FineSkin = 0.01;
/// What soles may lean in degrees, each by itself or one against the other.
constexpr double c_FineSole = 5.0;

/// Tenths of a millimetre of a leg.
constexpr int c_ScaleDigits = 4;

/// The lowest joint of the feet; nothing without feet.
std::optional<std::size_t> LowestOfFeet(const VRestSkeleton& i_rSkeleton, const VBodyReading& i_rBody)
{
	std::optional<std::size_t> lowest;
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
	{
		const EBodyPart part = i_rBody.m_Joints[i].m_Part;
		if ((part == EFoot || part == EToe) && (!lowest || i_rSkeleton[i].m_Place[2] < i_rSkeleton[*lowest].m_Place[2]))
			lowest = i;
	}
	return lowest;
}

struct VBody
{
	const VRestSkeleton& m_rSkeleton;
	const VBodyReading& m_rReading;

	/// Where the likeliest joint of a part and side stands.
	std::optional<std::size_t> Joint(EBodyPart i_Part, ESide i_Side = ESide::None) const
	{
		std::optional<std::size_t> best;
		for (std::size_t i = 0; i < m_rSkeleton.size(); ++i)
		{
			const VJointReading& rJoint = m_rReading.m_Joints[i];
			if (rJoint.m_Part == i_Part && (i_Side == ESide::None || rJoint.m_Side == i_Side)
			    && (!best || rJoint.m_Likely[i_Part] > m_rReading.m_Joints[*best].m_Likely[i_Part] + 0.2))
				best = i;
		}
		return best;
	}

	/// How far a limb is lowered from the horizontal, in degrees: the mean of both sides.
	std::optional<double> LimbAngle(EBodyPart i_From, EBodyPart i_To) const
	{
		double sum = 0.0;
		int sides = 0;
		for (const ESide side : {ESide::Left, ESide::Right})
		{
			const auto from = Joint(i_From, side);
			const auto to = Joint(i_To, side);
			if (!from || !to)
				continue;
			const auto& rFrom = m_rSkeleton[*from].m_Place;
			const auto& rTo = m_rSkeleton[*to].m_Place;
			sum +=
			    Rotation::c_Degrees * std::atan2(rFrom[2] - rTo[2], std::hypot(rTo[0] - rFrom[0], rTo[1] - rFrom[1]));
			++sides;
		}
		return sides == 0 ? std::nullopt : std::optional(sum / sides);
	}

	/// Of the thighs over the lowest joint of the legs: a pelvis may stand above them.
	std::optional<double> HipHeight() const
	{
		const auto lowest = LowestOfFeet(m_rSkeleton, m_rReading);
		const auto left = Joint(EThigh, ESide::Left);
		const auto right = Joint(EThigh, ESide::Right);
		if (!lowest || !left || !right)
			return std::nullopt;
		const double height =
		    0.5 * (m_rSkeleton[*left].m_Place[2] + m_rSkeleton[*right].m_Place[2]) - m_rSkeleton[*lowest].m_Place[2];
		return height > 0.0 ? std::optional(height) : std::nullopt;
	}
};

std::string Rounded(double i_Value, double i_Step)
{
	// No zero with a sign.
	std::string text = NumberText::PrintF(std::round(i_Value / i_Step) * i_Step + 0.0);
	text.erase(text.find_last_not_of('0') + 1);
	return text.ends_with('.') ? text.substr(0, text.size() - 1) : text;
}

VPoseFinding Facing(const VBody& i_rSource, const VBody& i_rTarget)
{
	const auto& rSource = i_rSource.m_rReading.m_Frame.m_Forward;
	const auto& rTarget = i_rTarget.m_rReading.m_Frame.m_Forward;
	// To the left, seen from above, of what turns the target to the source.
	const double turn = Rotation::c_Degrees
	    * std::atan2(
	        rTarget[0] * rSource[1] - rTarget[1] * rSource[0], rTarget[0] * rSource[0] + rTarget[1] * rSource[1]);
	VPoseFinding finding{"facing", std::abs(turn) <= c_FineFacing, "", {{"turnDegrees", turn}}, ""};
	finding.m_Message = finding.m_bFine
	    ? "Both face the same way"
	    : "The character faces another way than the performer: it is to turn by " + Rounded(turn, 1.0) + " degrees";
	if (!finding.m_bFine)
		finding.m_Options = "--turn " + Rounded(turn, 0.1) + " --update-targets";
	return finding;
}

VPoseFinding Sides(const VBody& i_rSource, const VBody& i_rTarget)
{
	const bool bSource = i_rSource.m_rReading.m_Frame.m_bContradiction;
	const bool bTarget = i_rTarget.m_rReading.m_Frame.m_bContradiction;
	VPoseFinding finding{"sides", !bSource && !bTarget, "Left is on the left of both", {}, ""};
	if (!finding.m_bFine)
		finding.m_Message = std::string("By the way that the feet point, the names of the ")
		    + (bSource && bTarget ? "performer and the character"
		            : bSource     ? "performer"
		                          : "character")
		    + " tell left on the right: look whether they are exchanged, or the feet stand backwards";
	return finding;
}

VPoseFinding Limbs(const char* i_pId, const char* i_pWhat, double i_Source, double i_Target,
    const std::vector<std::string>& i_rSegments)
{
	VPoseFinding finding{i_pId, std::abs(i_Source - i_Target) <= c_FineLimb, "",
	    {{"sourceDegrees", i_Source}, {"targetDegrees", i_Target}}, ""};
	finding.m_Message = std::string("The ") + i_pWhat + " of the performer are lowered by " + Rounded(i_Source, 1.0)
	    + " degrees from the horizontal, those of the character by " + Rounded(i_Target, 1.0);
	if (finding.m_bFine)
		return finding;
	for (const std::string& rSegment : i_rSegments)
	{
		// As a shell takes it.
		const char* const pQuote = rSegment.find(' ') == std::string::npos ? "" : "'";
		finding.m_Options += std::string("--pose ") + pQuote + rSegment + "=RX,RY,RZ" + pQuote + " ";
	}
	finding.m_Options += "--update-targets";
	return finding;
}

VPoseFinding Scale(double i_Source, double i_Target)
{
	const double scale = i_Source / i_Target;
	VPoseFinding finding{"scale", std::abs(scale - 1.0) <= c_FineScale, "",
	    {{"sourceHipHeightMm", i_Source}, {"targetHipHeightMm", i_Target}, {"scale", scale}}, ""};
	finding.m_Message = "The hips of the performer stand " + Rounded(i_Source, 1.0)
	    + " mm over the lowest joint of the feet, those of the character " + Rounded(i_Target, 1.0) + " mm";
	if (!finding.m_bFine)
		finding.m_Options =
		    "--root-height scale --scale " + NumberText::PrintShortest(SuggestedScale(finding)) + " --update-targets";
	return finding;
}

VPoseFinding Floor(const VBody& i_rTarget, const VStand& i_rStand)
{
	const double lift = LiftToFloor(i_rTarget.m_rSkeleton, i_rTarget.m_rReading);
	VPoseFinding finding{"floor", lift == 0.0, "", {{"lowestMm", i_rStand.m_Height}}, ""};
	const std::string height = Rounded(std::abs(i_rStand.m_Height), 0.1);
	finding.m_Message = (i_rStand.m_bSkin ? "The lowest point of the skin of the character's feet, at \""
	                                      : "The lowest joint of the character's feet, \"")
	    + i_rTarget.m_rSkeleton[i_rStand.m_Joint].m_Name + "\", stands "
	    + (height == "0" ? "on" : height + " mm " + (i_rStand.m_Height < 0.0 ? "below" : "above")) + " the floor";
	if (!finding.m_bFine)
		finding.m_Options = "--lift " + Rounded(lift, 0.1) + " --update-targets";
	return finding;
}

/// How far the foot of a side is from where it was held when its skin was bound, if its sole was more level then.
std::optional<double> Lean(const VBody& i_rTarget, ESide i_Side)
{
	const auto foot = i_rTarget.Joint(EFoot, i_Side);
	const auto level = foot ? LevelAsBound(i_rTarget.m_rSkeleton[*foot]) : std::nullopt;
	return level ? std::optional(Rotation::c_Degrees * std::acos(std::clamp((*level)[8], -1.0, 1.0))) : std::nullopt;
}

std::optional<VPoseFinding> Soles(const VBody& i_rTarget)
{
	const auto left = Lean(i_rTarget, ESide::Left);
	const auto right = Lean(i_rTarget, ESide::Right);
	if (!left || !right)
		return std::nullopt;
	VPoseFinding finding{"soles", std::max(*left, *right) <= c_FineSole,
	    "Both feet are held as level as when their skin was bound", {{"leftDegrees", *left}, {"rightDegrees", *right}},
	    ""};
	if (finding.m_bFine)
		return finding;
	finding.m_Message =
	    "The character does not stand on its soles: from how it was held when its skin was bound, the left "
	    "foot leans by "
	    + Rounded(*left, 1.0) + " degrees, and the right by " + Rounded(*right, 1.0);
	finding.m_Options = "--chain legs --align";
	return finding;
}

} // namespace

std::vector<VPoseFinding> CheckPose(
    const VRestSkeleton& i_rSource, const VRestSkeleton& i_rTarget, const VProposal& i_rProposal)
{
	const VBody source{i_rSource, i_rProposal.m_Source};
	const VBody target{i_rTarget, i_rProposal.m_Target};
	std::vector<VPoseFinding> findings;
	if (i_rProposal.m_Pairs.empty())
		return findings;
	findings.push_back(Facing(source, target));
	findings.push_back(Sides(source, target));
	struct VLimbs
	{
		const char* m_pId;
		const char* m_pWhat;
		EBodyPart m_From;
		EBodyPart m_To;
	};
	for (const VLimbs& rLimbs : {VLimbs{"arms", "arms", EUpperArm, EHand}, VLimbs{"legs", "legs", EThigh, EFoot}})
	{
		const auto ofSource = source.LimbAngle(rLimbs.m_From, rLimbs.m_To);
		const auto ofTarget = target.LimbAngle(rLimbs.m_From, rLimbs.m_To);
		if (!ofSource || !ofTarget)
			continue;
		std::vector<std::string> segments;
		for (const ESide side : {ESide::Left, ESide::Right})
			if (const auto joint = target.Joint(rLimbs.m_From, side))
				segments.push_back(i_rTarget[*joint].m_Name);
		findings.push_back(Limbs(rLimbs.m_pId, rLimbs.m_pWhat, *ofSource, *ofTarget, segments));
	}
	const auto sourceHips = source.HipHeight();
	const auto targetHips = target.HipHeight();
	if (sourceHips && targetHips)
		findings.push_back(Scale(*sourceHips, *targetHips));
	if (targetHips)
		findings.push_back(Floor(target, *StandOf(i_rTarget, i_rProposal.m_Target)));
	if (auto soles = Soles(target))
		findings.push_back(std::move(*soles));
	return findings;
}

double SuggestedScale(const VPoseFinding& i_rFinding)
{
	for (const auto& [pName, value] : i_rFinding.m_Numbers)
		if (std::string_view(pName) == "scale")
		{
			std::string text;
			NumberText::AppendG(text, value, c_ScaleDigits);
			double scale = value;
			NumberText::ScanReal(text, scale);
			return scale;
		}
	return 1.0;
}

std::optional<VStand> StandOf(const VRestSkeleton& i_rSkeleton, const VBodyReading& i_rBody)
{
	const auto lowest = LowestOfFeet(i_rSkeleton, i_rBody);
	if (!lowest)
		return std::nullopt;
	/// For each joint the one that its foot begins with, -1 for what is none.
	std::vector<std::int64_t> feet(i_rSkeleton.size(), -1);
	std::map<std::int64_t, std::optional<double>> heights;
	VStand onSkin{0, std::numeric_limits<double>::max(), true};
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
	{
		const std::int64_t parent = i_rSkeleton[i].m_Parent;
		if (parent >= 0 && feet[std::size_t(parent)] >= 0)
			feet[i] = feet[std::size_t(parent)];
		else if (const EBodyPart part = i_rBody.m_Joints[i].m_Part; part == EFoot || part == EToe)
			feet[i] = std::int64_t(i);
		else
			continue;
		auto& rHeight = heights[feet[i]];
		const auto height = LowestPoint(i_rSkeleton[i]);
		if (!height)
			continue;
		rHeight = rHeight ? std::min(*rHeight, *height) : *height;
		if (*height < onSkin.m_Height)
			onSkin = {i, *height, true};
	}
	const bool bSkin = std::ranges::all_of(heights, [](const auto& i_rFoot) { return i_rFoot.second.has_value(); });
	return bSkin ? onSkin : VStand{*lowest, i_rSkeleton[*lowest].m_Place[2], false};
}

double LiftToFloor(const VRestSkeleton& i_rSkeleton, const VBodyReading& i_rBody)
{
	const auto hips = VBody{i_rSkeleton, i_rBody}.HipHeight();
	if (!hips)
		return 0.0;
	const VStand stand = *StandOf(i_rSkeleton, i_rBody);
	const double fineAbove = stand.m_bSkin               ? c_FineSkin
	    : i_rBody.m_Joints[stand.m_Joint].m_Part == EToe ? c_FineToeAbove
	                                                     : c_FineAnkleAbove;
	const double fineBelow = stand.m_bSkin ? c_FineSkin : c_FineBelow;
	return stand.m_Height <= fineAbove * *hips && stand.m_Height >= -fineBelow * *hips ? 0.0 : -stand.m_Height;
}

} // namespace SetupProposal
