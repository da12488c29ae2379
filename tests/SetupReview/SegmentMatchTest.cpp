#include "SetupReview/rebind/SegmentMatch.h"

#include "CoreOrlexTypes/Subject.h"

#include <gtest/gtest.h>

namespace
{

using SetupReview::ERebindRule;

struct VBone
{
	std::string m_Name;
	std::uint32_t m_Parent = CoreOrlexTypes::c_NoParent;
	Rotation::VVector3 m_Offset{};
};

using VBones = std::vector<VBone>;

/// "2n" for the third by name, "p" by place, "b" as a part of a body, "-" for none: one for each old bone.
std::string Matches(const VBones& i_rOld, const VBones& i_rNew, bool i_bRest = false, double i_LeastScore = 0.5)
{
	CoreOrlexTypes::VSubjectParametrised subjects[2];
	std::vector<SetupReview::VMatchSide> sides;
	for (const VBones* const pBones : {&i_rOld, &i_rNew})
	{
		auto& rSubject = subjects[sides.size()];
		SetupReview::VMatchSide side{rSubject, {}, {}};
		for (const VBone& rBone : *pBones)
		{
			auto& rSegment = rSubject.m_Segments.emplace_back();
			rSegment.m_Name = rBone.m_Name;
			rSegment.m_ParentSegmentIndex = rBone.m_Parent;
			side.m_Offsets.push_back(rBone.m_Offset);
			const bool bRoot = rBone.m_Parent == CoreOrlexTypes::c_NoParent;
			SetupProposal::VRestJoint joint{rBone.m_Name, bRoot ? -1 : std::int64_t(rBone.m_Parent), rBone.m_Offset};
			for (std::size_t k = 0; k < 3 && !bRoot && i_bRest; ++k)
				joint.m_Place[k] += side.m_Rest[rBone.m_Parent].m_Place[k];
			if (i_bRest)
				side.m_Rest.push_back(joint);
		}
		sides.push_back(side);
	}
	std::string text;
	for (const auto& rMatch : SetupReview::MatchSegments(sides[0], sides[1], i_LeastScore))
		text += (text.empty() ? "" : " ")
		    + (rMatch.m_New < 0 ? "-" : std::to_string(rMatch.m_New) + "-npb"[std::size_t(rMatch.m_Rule)]);
	return text;
}

TEST(SegmentMatch, ByNamesAndPlaces)
{
	struct VRow
	{
		const char* m_pWhat;
		VBones m_Old;
		VBones m_New;
		const char* m_pMatches;
	};
	const VBone hips{"Hips"};
	const Rotation::VVector3 up{0.0, 0.0, 100.0};
	const VRow rows[]{
	    {"a name wherever it stands", {hips, {"A", 0, up}}, {hips, {"B", 0, up}, {"A", 1}}, "0n 2n"},
	    {"of two of one name each beneath its own parent", {hips, {"L", 0}, {"M", 0}, {"T", 1}, {"T", 2}},
	        {hips, {"M", 0}, {"L", 0}, {"T", 1}, {"T", 2}}, "0n 2n 1n 4n 3n"},
	    {"the one that is left goes to its own parent", {hips, {"L", 0}, {"M", 0}, {"T", 1}, {"T", 2}},
	        {hips, {"L", 0}, {"M", 0}, {"T", 2}}, "0n 1n 2n - 3n"},
	    {"a child that was a root", {{"A"}, {"B", 0, up}}, {{"B"}, {"A", 0, up}}, "1n 0n"},
	    {"the first after a root that was put above", {{"A"}, {"T", 0}}, {{"R"}, {"A", 0}, {"T", 0}, {"T", 1}},
	        "1n 3n"},
	    {"another name at the same place, and beneath it", {hips, {"A", 0, up}, {"B", 1, up}},
	        {{"Root"}, {"C", 0, up}, {"D", 1, up}}, "0p 1p 2p"},
	    {"within a millimetre and a hundredth", {hips, {"A", 0, up}}, {hips, {"B", 0, {1.9, 0.0, 100.0}}}, "0n 1p"},
	    {"farther", {hips, {"A", 0, up}}, {hips, {"B", 0, {0.0, 0.0, 102.1}}}, "0n -"},
	    {"close to the parent", {hips, {"A", 0}}, {hips, {"B", 0, {0.0, -1.0, 0.0}}}, "0n 1p"},
	    {"two new ones at the place", {hips, {"A", 0, up}}, {hips, {"B", 0, up}, {"C", 0, up}}, "0n -"},
	    {"two old ones at the place", {hips, {"A", 0, up}, {"B", 0, up}}, {hips, {"C", 0, up}}, "0n - -"},
	    {"one between two", {hips, {"A", 0, up}, {"B", 0, {0.0, 3.0, 100.0}}}, {hips, {"C", 0, {0.0, 1.5, 100.0}}},
	        "0n - -"},
	    {"two at the place of which one has its name", {hips, {"A", 0, up}, {"B", 0, up}},
	        {hips, {"B", 0, up}, {"C", 0, up}}, "0n 2p 1n"},
	    {"each its own place", {hips, {"A", 0, up}, {"B", 0}}, {hips, {"C", 0}, {"D", 0, up}}, "0n 2p 1p"},
	    {"at the place beneath another parent", {hips, {"A", 0}, {"B", 1, up}}, {hips, {"A", 0}, {"C", 0, up}},
	        "0n 1n -"},
	    {"fewer bones", {hips, {"A", 0, up}, {"B", 1, up}}, {{"B"}}, "- - 0n"},
	    {"nothing new", {hips, {"A", 0}}, {}, "- -"},
	    {"nothing old", {}, {hips}, ""},
	};
	for (const VRow& rRow : rows)
		EXPECT_EQ(Matches(rRow.m_Old, rRow.m_New), rRow.m_pMatches) << rRow.m_pWhat;
}

/// Legs that are as long as they like to be; what hangs at a knee is found by its place, once the knee is.
TEST(SegmentMatch, AsPartsOfABody)
{
	VBones bones[2];
	for (const bool bNew : {false, true})
	{
		VBones& rBones = bones[bNew];
		rBones.push_back({bNew ? "Pelvis" : "Hips", CoreOrlexTypes::c_NoParent, {0.0, 0.0, 900.0}});
		for (const double side : {1.0, -1.0})
		{
			const std::string name = side > 0.0 ? (bNew ? "L_" : "Left") : bNew ? "R_" : "Right";
			const auto parent = std::uint32_t(rBones.size());
			const double length = bNew ? 430.0 : 350.0;
			rBones.push_back({name + (bNew ? "Thigh" : "UpLeg"), 0, {0.0, bNew ? 120.0 * side : 90.0 * side, 0.0}});
			rBones.push_back({name + (bNew ? "Calf" : "Leg"), parent, {0.0, 0.0, -length}});
			rBones.push_back({name + (bNew ? "Ankle" : "Foot"), parent + 1, {0.0, 0.0, -length}});
			rBones.push_back({name + (bNew ? "Pad" : "Guard"), parent + 1, {60.0, 0.0, 0.0}});
		}
	}
	EXPECT_EQ(Matches(bones[0], bones[1], true), "0p 1b 2b 3b 4p 5b 6b 7b 8p");
	EXPECT_EQ(Matches(bones[0], bones[1], true, 1.1), "0p - - - - - - - -") << "less alike than what is asked";
	EXPECT_EQ(Matches(bones[0], bones[1], false), "0p - - - - - - - -") << "where it stands is not known";
	EXPECT_EQ(Matches(bones[0], bones[0], true), "0n 1n 2n 3n 4n 5n 6n 7n 8n");
}

} // namespace
