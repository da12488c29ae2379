#include "retarget/subject/Mapping.h"

#include "Rows.h"

#include "SetupProposal/Partner.h"
#include "SetupProposal/PoseCheck.h"

#include <cmath>
#include <fstream>
#include <map>
#include <set>
#include <tuple>

namespace
{

using CommandLine::VMapped;
using SetupProposal::VProposal;
using SetupProposal::VRestJoint;
using SetupProposal::VRestSkeleton;
using VPairs = std::set<std::pair<std::string, std::string>>;

struct VRig
{
	std::string m_Name;
	std::string m_Fbx;
};

const std::vector<VRig> c_Rigs{{"kestrel", RETARGET_SOURCE "/demo/character.fbx"},
    {"heaps_biped", RETARGET_TEST_DATA "/fbx/heaps_biped_zup_a7100.fbx"},
    {"kenney_medium", RETARGET_TEST_DATA "/fbx/kenney_medium_b7400.fbx"},
    {"own_game", RETARGET_TEST_DATA "/fbx/own_game_zup_m_b7400.fbx"},
    {"own_ns", RETARGET_TEST_DATA "/fbx/own_ns_yup_cm_b7400.fbx"},
    {"pab_arnaud", RETARGET_TEST_DATA "/fbx/pab_arnaud_b7500.fbx"},
    {"maya_human_ik", RETARGET_TEST_DATA "/fbx/ufbx_maya_human_ik_7400_binary.fbx"}};

const std::vector<VRig> c_Performers{{"performer", RETARGET_TEST_DATA "/qrt/performer.qrs"},
    {"kestrel_performer", RETARGET_SOURCE "/demo/performer.qrs"}};

VMapped MapFiles(const VRig& i_rRig, const VRig& i_rPerformer)
{
	CommandLine::VSession session;
	session.LoadSource(i_rPerformer.m_Fbx);
	session.LoadFbx(i_rRig.m_Fbx);
	return CommandLine::ProposeForFile(session);
}

VPairs TruePairs(const VRig& i_rRig, const VRig& i_rPerformer)
{
	std::ifstream file(RETARGET_TEST_DATA "/mappings/" + i_rRig.m_Name + "-" + i_rPerformer.m_Name + ".json");
	VPairs pairs;
	const VJson mapping = VJson::parse(file);
	for (const VJson& rPair : mapping.at("pairs"))
		pairs.emplace(rPair.at("source").get<std::string>(), rPair.at("target").get<std::string>());
	return pairs;
}

/// What of a proposal is right, by the names that the target had.
struct VFigures
{
	std::size_t m_Proposed = 0;
	std::size_t m_True = 0;
	std::size_t m_Right = 0;

	VFigures& operator+=(const VFigures& i_rOther)
	{
		m_Proposed += i_rOther.m_Proposed;
		m_True += i_rOther.m_True;
		m_Right += i_rOther.m_Right;
		return *this;
	}
	double Precision() const { return double(m_Right) / double(m_Proposed); }
	double Found() const { return double(m_Right) / double(m_True); }
};

VFigures FiguresOf(const VProposal& i_rProposal, const VRestSkeleton& i_rSource, const VRestSkeleton& i_rNamed,
    const VPairs& i_rTrue, const std::string& i_rWhat)
{
	VFigures figures{i_rProposal.m_Pairs.size(), i_rTrue.size(), 0};
	std::string wrong;
	for (const auto& rPair : i_rProposal.m_Pairs)
	{
		const std::pair pair{i_rSource[rPair.m_Source].m_Name, i_rNamed[rPair.m_Target].m_Name};
		if (i_rTrue.contains(pair))
			++figures.m_Right;
		else
			wrong += " " + pair.first + ":" + pair.second;
	}
	std::printf("%-34s %3zu proposed, %5.1f %% right, %5.1f %% found%s\n", i_rWhat.c_str(), figures.m_Proposed,
	    100.0 * figures.Precision(), 100.0 * figures.Found(), (wrong.empty() ? "" : ", wrong" + wrong).c_str());
	return figures;
}

TEST(Map, FindsTheTruePairsOfEveryCharacter)
{
	VFigures all;
	for (const VRig& rRig : c_Rigs)
		for (const VRig& rPerformer : c_Performers)
		{
			const std::string what = rRig.m_Name + "-" + rPerformer.m_Name;
			const VMapped mapped = MapFiles(rRig, rPerformer);
			const VFigures figures =
			    FiguresOf(mapped.m_Proposal, mapped.m_Source, mapped.m_Target, TruePairs(rRig, rPerformer), what);
			EXPECT_GE(figures.Precision(), 0.9) << what;
			EXPECT_GE(figures.Found(), 0.8) << what;
			EXPECT_EQ(mapped.m_Target[std::size_t(mapped.m_Root)].m_Parent, -1) << what;
			all += figures;
		}
	EXPECT_GE(all.Precision(), 0.97);
	EXPECT_GE(all.Found(), 0.9);
}

/// How other rigs call the demo character's bones, in this order.
const std::vector<std::string> c_Kestrel{"haunch", "loin", "ribs", "breast", "nape", "skull", "collar{}", "upperArm{}",
    "foreArm{}", "palm{}", "thumb1{}", "thumb2{}", "point1{}", "point2{}", "thigh{}", "shin{}", "hock{}", "claw{}"};

struct VFamily
{
	const char* m_pName;
	std::vector<std::string> m_Names;
	std::string m_Left;
	std::string m_Right;
};

const std::vector<VFamily> c_Families{
    {"biped",
        {"Bip01 Pelvis", "Bip01 Spine", "Bip01 Spine1", "Bip01 Spine2", "Bip01 Neck", "Bip01 Head", "Bip01 {} Clavicle",
            "Bip01 {} UpperArm", "Bip01 {} Forearm", "Bip01 {} Hand", "Bip01 {} Finger0", "Bip01 {} Finger01",
            "Bip01 {} Finger1", "Bip01 {} Finger11", "Bip01 {} Thigh", "Bip01 {} Calf", "Bip01 {} Foot",
            "Bip01 {} Toe0"},
        "L", "R"},
    {"game",
        {"pelvis", "spine_01", "spine_02", "spine_03", "neck_01", "head", "clavicle_{}", "upperarm_{}", "lowerarm_{}",
            "hand_{}", "thumb_01_{}", "thumb_02_{}", "index_01_{}", "index_02_{}", "thigh_{}", "calf_{}", "foot_{}",
            "ball_{}"},
        "l", "r"},
    {"motion library",
        {"mixed:Hips", "mixed:Spine", "mixed:Spine1", "mixed:Spine2", "mixed:Neck", "mixed:Head", "mixed:{}Shoulder",
            "mixed:{}Arm", "mixed:{}ForeArm", "mixed:{}Hand", "mixed:{}HandThumb1", "mixed:{}HandThumb2",
            "mixed:{}HandIndex1", "mixed:{}HandIndex2", "mixed:{}UpLeg", "mixed:{}Leg", "mixed:{}Foot",
            "mixed:{}ToeBase"},
        "Left", "Right"},
    {"copies",
        {"DEF-hips.001", "DEF-spine.001", "DEF-spine.002", "DEF-spine.003", "DEF-neck", "DEF-head",
            "DEF-shoulder.{}.001", "DEF-upper_arm.{}.001", "DEF-forearm.{}.001", "DEF-hand.{}", "DEF-thumb.01.{}",
            "DEF-thumb.02.{}", "DEF-f_index.01.{}", "DEF-f_index.02.{}", "DEF-thigh.{}", "DEF-shin.{}.001",
            "DEF-foot.{}", "DEF-toe.{}"},
        "L", "R"},
    {"figure",
        {"hip", "abdomenLower", "abdomenUpper", "chest", "neckLower", "head", "{}Collar", "{}ShldrBend",
            "{}ForearmBend", "{}Hand", "{}Thumb1", "{}Thumb2", "{}Index1", "{}Index2", "{}ThighBend", "{}Shin",
            "{}Foot", "{}Toe"},
        "l", "r"},
    {"joints",
        {"Hips", "Waist", "Torso", "Chest", "Neck", "Head", "{}Collar", "{}Shoulder", "{}Elbow", "{}Wrist", "{}Finger0",
            "{}Finger01", "{}Finger1", "{}Finger11", "{}Hip", "{}Knee", "{}Ankle", "{}Toe"},
        "Left", "Right"},
    {"capitals",
        {"PELVIS", "SPINE1", "SPINE2", "SPINE3", "NECK", "HEAD", "{}CLAVICLE", "{}UPPERARM", "{}LOWERARM", "{}HAND",
            "{}THUMB1", "{}THUMB2", "{}INDEX1", "{}INDEX2", "{}UPPERLEG", "{}LOWERLEG", "{}FOOT", "{}TOE"},
        "LEFT", "RIGHT"},
    {"German",
        {"Becken", "Wirbel1", "Wirbel2", "Brust", "Hals", "Kopf", "Schlüsselbein_{}", "Oberarm_{}", "Unterarm_{}",
            "Hand_{}", "Daumen1_{}", "Daumen2_{}", "Zeigefinger1_{}", "Zeigefinger2_{}", "Oberschenkel_{}",
            "Unterschenkel_{}", "Fuß_{}", "Zehen_{}"},
        "links", "rechts"},
    {"French",
        {"bassin", "colonne1", "colonne2", "poitrine", "cou", "tête", "clavicule_{}", "bras_{}", "avant_bras_{}",
            "main_{}", "pouce1_{}", "pouce2_{}", "index1_{}", "index2_{}", "cuisse_{}", "jambe_{}", "pied_{}",
            "orteils_{}"},
        "G", "D"},
    {"Spanish",
        {"cadera", "columna1", "columna2", "pecho", "cuello", "cabeza", "clavicula_{}", "brazo_{}", "antebrazo_{}",
            "mano_{}", "pulgar1_{}", "pulgar2_{}", "indice1_{}", "indice2_{}", "muslo_{}", "pierna_{}", "pie_{}",
            "punta_{}"},
        "izq", "der"},
    {"Italian",
        {"Bacino", "Spina1", "Spina2", "Petto", "Collo", "Testa", "Clavicola{}", "Braccio{}", "Avambraccio{}", "Mano{}",
            "Pollice1{}", "Pollice2{}", "Indice1{}", "Indice2{}", "Coscia{}", "Gamba{}", "Piede{}", "Punta{}"},
        "Sx", "Dx"},
    {"Japanese",
        {"下半身", "上半身", "上半身2", "胸", "首", "頭", "{}肩", "{}腕", "{}ひじ", "{}手首", "{}親指1", "{}親指2",
            "{}人指1", "{}人指2", "{}足", "{}ひざ", "{}足首", "{}つま先"},
        "左", "右"},
    {"anatomy",
        {"sacrum", "lumbar", "thorax1", "thorax2", "cervical", "cranium", "{}_clavicula", "{}_humerus", "{}_ulna",
            "{}_carpus", "{}_pollex1", "{}_pollex2", "{}_index1", "{}_index2", "{}_femur", "{}_tibia", "{}_tarsus",
            "{}_toes"},
        "l", "r"},
    {"none", {}, "", ""},
};

std::string Filled(std::string i_Pattern, const std::string& i_rSide)
{
	if (const std::size_t at = i_Pattern.find("{}"); at != std::string::npos)
		i_Pattern.replace(at, 2, i_rSide);
	return i_Pattern;
}

void Rename(VRestSkeleton& io_rSkeleton, const VFamily& i_rFamily)
{
	std::map<std::string, std::string> names;
	for (std::size_t i = 0; i < i_rFamily.m_Names.size(); ++i)
	{
		names[Filled(c_Kestrel[i], "Left")] = Filled(i_rFamily.m_Names[i], i_rFamily.m_Left);
		names[Filled(c_Kestrel[i], "Right")] = Filled(i_rFamily.m_Names[i], i_rFamily.m_Right);
	}
	for (std::size_t i = 0; i < io_rSkeleton.size(); ++i)
		io_rSkeleton[i].m_Name =
		    names.contains(io_rSkeleton[i].m_Name) ? names[io_rSkeleton[i].m_Name] : "Bone" + std::to_string(i);
}

VRestJoint& Joint(VRestSkeleton& io_rSkeleton, const std::string& i_rName)
{
	return *std::ranges::find(io_rSkeleton, i_rName, &VRestJoint::m_Name);
}

void Reparent(VRestSkeleton& io_rSkeleton, const std::string& i_rChild, const std::string& i_rParent)
{
	Joint(io_rSkeleton, i_rChild).m_Parent = &Joint(io_rSkeleton, i_rParent) - io_rSkeleton.data();
}

void Turn(VRestSkeleton& io_rSkeleton, double i_Degrees)
{
	const double angle = i_Degrees * std::acos(-1.0) / 180.0;
	for (VRestJoint& rJoint : io_rSkeleton)
		rJoint.m_Place = {std::cos(angle) * rJoint.m_Place[0] - std::sin(angle) * rJoint.m_Place[1],
		    std::sin(angle) * rJoint.m_Place[0] + std::cos(angle) * rJoint.m_Place[1], rJoint.m_Place[2]};
}

/// What is done to the demo's character, on top of a family's names.
struct VVariation
{
	const char* m_pName;
	void (*m_pChange)(VRestSkeleton& io_rSkeleton);
};

const std::vector<VVariation> c_Variations{
    {"as it is", [](VRestSkeleton&) {}},
    {"turned by 90", [](VRestSkeleton& io_rSkeleton) { Turn(io_rSkeleton, 90.0); }},
    {"turned by 215", [](VRestSkeleton& io_rSkeleton) { Turn(io_rSkeleton, 215.0); }},
    {"in metres taken for mm",
        [](VRestSkeleton& io_rSkeleton)
        {
	        for (VRestJoint& rJoint : io_rSkeleton)
		        for (double& rValue : rJoint.m_Place)
			        rValue *= 0.001;
        }},
    {"head at the chest",
        [](VRestSkeleton& io_rSkeleton)
        { Joint(io_rSkeleton, "skull").m_Place = Joint(io_rSkeleton, "ribs").m_Place; }},
    {"thighs on the chest, a hand on the pelvis",
        [](VRestSkeleton& io_rSkeleton)
        {
	        Reparent(io_rSkeleton, "thighLeft", "ribs");
	        Reparent(io_rSkeleton, "thighRight", "ribs");
	        Reparent(io_rSkeleton, "palmLeft", "haunch");
        }},
    {"a root on the ground",
        [](VRestSkeleton& io_rSkeleton)
        {
	        for (VRestJoint& rJoint : io_rSkeleton)
		        ++rJoint.m_Parent;
	        io_rSkeleton.insert(io_rSkeleton.begin(), VRestJoint{"root", -1, {}, true});
        }},
};

TEST(Map, FindsThePairsWhateverTheNamesTheTreeAndTheFacing)
{
	const VMapped demo = MapFiles(c_Rigs[0], c_Performers[0]);
	const VPairs truePairs = TruePairs(c_Rigs[0], c_Performers[0]);
	VFigures all;
	for (const VFamily& rFamily : c_Families)
		for (const VVariation& rVariation : c_Variations)
		{
			VRestSkeleton named = demo.m_Target;
			rVariation.m_pChange(named);
			VRestSkeleton skeleton = named;
			Rename(skeleton, rFamily);
			const std::string what = std::string(rFamily.m_pName) + ", " + rVariation.m_pName;
			const VFigures figures =
			    FiguresOf(SetupProposal::Propose(demo.m_Source, skeleton), demo.m_Source, named, truePairs, what);
			// Without names nothing is left that could outvote what is wrong in the other two.
			const bool bNames = !rFamily.m_Names.empty();
			EXPECT_GE(figures.Precision(), bNames ? 0.9 : 0.7) << what;
			EXPECT_GE(figures.Found(), bNames ? 0.8 : 0.6) << what;
			if (bNames)
				all += figures;
		}
	EXPECT_GE(all.Precision(), 0.97);
	EXPECT_GE(all.Found(), 0.9);
}

/// A back that lies, with a head before and a tail behind it, on four legs: names in the order of the joints.
VRestSkeleton Beast(const std::vector<std::string>& i_rNames)
{
	VRestSkeleton beast;
	const auto add = [&](std::int64_t i_Parent, double i_X, double i_Y, double i_Z)
	{
		const std::string name =
		    beast.size() < i_rNames.size() ? i_rNames[beast.size()] : "Bone" + std::to_string(beast.size());
		beast.push_back({name, i_Parent, {i_X, i_Y, i_Z}, true});
		return std::int64_t(beast.size()) - 1;
	};
	const std::int64_t hips = add(-1, 0.0, 500.0, 1000.0);
	const std::int64_t chest = add(add(hips, 0.0, 150.0, 1020.0), 0.0, -400.0, 1000.0);
	add(add(chest, 0.0, -650.0, 1250.0), 0.0, -800.0, 1450.0);
	add(add(hips, 0.0, 700.0, 950.0), 0.0, 950.0, 700.0);
	for (const auto& [parent, y] : {std::pair(hips, 480.0), std::pair(chest, -420.0)})
		for (const double x : {150.0, -150.0})
			add(add(add(add(parent, x, y, 900.0), x, y + 20.0, 500.0), x, y + 40.0, 120.0), x, y - 60.0, 20.0);
	return beast;
}

TEST(Map, ProposesNothingForWhatIsNoBody)
{
	const VRestSkeleton performer = MapFiles(c_Rigs[0], c_Performers[0]).m_Source;
	const std::vector<std::string> names{"Pelvis", "Spine", "Chest", "Neck", "Head", "Tail1", "Tail2", "LeftHindThigh",
	    "LeftHindShin", "LeftHindFoot", "LeftHindToe", "RightHindThigh", "RightHindShin", "RightHindFoot",
	    "RightHindToe", "LeftFrontThigh", "LeftFrontShin", "LeftFrontFoot", "LeftFrontToe", "RightFrontThigh",
	    "RightFrontShin", "RightFrontFoot", "RightFrontToe"};
	for (const VRestSkeleton& rBeast : {Beast({}), Beast(names)})
	{
		const VProposal proposal = SetupProposal::Propose(performer, rBeast);
		EXPECT_TRUE(proposal.m_Pairs.empty());
		EXPECT_FALSE(proposal.m_Alternatives.empty()) << "what is left to the operator";
		EXPECT_NE(proposal.m_NoBody.find("stands on four legs"), std::string::npos) << proposal.m_NoBody;
	}
	RunRows({{"a prop", {"map", "--source", c_Performer, "--fbx", Data("fbx/ufbx_maya_transformed_skin_a6100.fbx")}, 0,
	             "neither arms nor legs on both sides", ""},
	    {"a prop is not tied",
	        {"create", "--fbx", Data("fbx/ufbx_max_transformed_skin_zup_b6100.fbx"), "--source", c_Performer, "--auto",
	            "-o", "x.qrr"},
	        1, "", "--auto: nothing is proposed. The character's skeleton is not taken for a body"}});
}

TEST(Map, TellsWhatOfTheRestPoseDiffers)
{
	const VMapped demo = MapFiles(c_Rigs[0], c_Performers[1]);
	struct VDifference
	{
		std::string m_Id;
		void (*m_pChange)(VRestSkeleton& io_rSkeleton);
		const char* m_pNumber;
		double m_Value;
		const char* m_pOptions;
	};
	const std::vector<VDifference> rows{
	    {"facing", [](VRestSkeleton& io_rSkeleton) { Turn(io_rSkeleton, 90.0); }, "turnDegrees", -90.0, "--turn -90 "},
	    {"scale",
	        [](VRestSkeleton& io_rSkeleton)
	        {
		        for (VRestJoint& rJoint : io_rSkeleton)
			        for (double& rValue : rJoint.m_Place)
				        rValue *= 2.0;
	        },
	        // 965.51 - 16.99 over twice 780 - 37.83 mm.
	        "scale", 948.52 / (2.0 * 742.17), "--root-height scale --scale 0.639 "},
	    {"floor",
	        [](VRestSkeleton& io_rSkeleton)
	        {
		        for (VRestJoint& rJoint : io_rSkeleton)
			        rJoint.m_Place[2] += 100.0;
	        },
	        "lowestMm", 137.83, "--lift -137.8 "},
	    {"arms",
	        [](VRestSkeleton& io_rSkeleton)
	        {
		        for (const char* const pSide : {"Left", "Right"})
			        Joint(io_rSkeleton, std::string("palm") + pSide).m_Place[2] = 1250.1;
	        },
	        "targetDegrees", 0.0, "--pose upperArmLeft=RX,RY,RZ "},
	    {"sides",
	        [](VRestSkeleton& io_rSkeleton)
	        {
		        for (VRestJoint& rJoint : io_rSkeleton)
			        rJoint.m_Place[0] = -rJoint.m_Place[0];
	        },
	        nullptr, 0.0, ""},
	};
	const auto find = [&](const VRestSkeleton& i_rTarget, const std::string& i_rId)
	{
		const auto findings =
		    SetupProposal::CheckPose(demo.m_Source, i_rTarget, SetupProposal::Propose(demo.m_Source, i_rTarget));
		return *std::ranges::find(findings, i_rId, &SetupProposal::VPoseFinding::m_pId);
	};
	for (const VDifference& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_Id);
		VRestSkeleton changed = demo.m_Target;
		rRow.m_pChange(changed);
		// The demo's two differ in nothing but their size.
		EXPECT_EQ(find(demo.m_Target, rRow.m_Id).m_bFine, rRow.m_Id != "scale");
		const auto finding = find(changed, rRow.m_Id);
		EXPECT_FALSE(finding.m_bFine);
		EXPECT_TRUE(finding.m_Options.starts_with(rRow.m_pOptions)) << finding.m_Options;
		for (const auto& [pName, value] : finding.m_Numbers)
			if (rRow.m_pNumber && std::string(rRow.m_pNumber) == pName)
			{
				EXPECT_NEAR(value, rRow.m_Value, 0.01);
			}
	}
}

TEST(Map, IsTakenOver)
{
	const VScratchFolder folder;
	const auto targets = [&](const std::vector<std::string>& i_rEdits)
	{
		std::vector<std::string> arguments{
		    "create", "--fbx", c_Rigs[2].m_Fbx, "--source", c_Performers[1].m_Fbx, "-o", "x.qrr", "--json", "-q"};
		arguments.insert(arguments.end(), i_rEdits.begin(), i_rEdits.end());
		return RunJson(arguments, folder);
	};
	// Eighteen of the 24 pairs have a rotation alone; the body's root is the third of the file's. Again adds none.
	EXPECT_EQ(targets({"--auto", "--auto"}).at("targets"), 30);
	EXPECT_EQ(targets({"--auto"}).at("segments"), 40);
	EXPECT_LT(targets({"--min-score", "0.9", "--auto"}).at("targets"), 20);
	RunRows(
	    {{"nothing to compare", {"map", "--source", c_Performer}, 2, "", "either --fbx FILE or a retarget subject"},
	        {"no source", {"create", "--fbx", c_Fbx, "--auto", "-o", "x.qrr", "--force"}, 2, "",
	            "needs the performer's skeleton"},
	        {"no score", {"map", "--source", c_Performer, "--fbx", c_Fbx, "--min-score", "2"}, 2, "", "from 0 to 1"}},
	    folder);
	// Turned and lifted, it is what a look at it tells to mend; lengths are the file's but for a thousandth.
	targets({"--auto", "--match-file-pose", "--turn", "90", "--lift", "50"});
	const VJson map = RunJson({"map", "x.qrr", "--source", c_Performers[1].m_Fbx, "--json"}, folder);
	EXPECT_EQ(map.at("pairs").size(), 24u);
	EXPECT_NEAR(map.at("pose")[0].at("numbers").at("turnDegrees").get<double>(), -90.0, 1.0);
	EXPECT_NEAR(map.at("pose").back().at("numbers").at("lowestMm").get<double>(), 63.15, 0.2);
}

TEST(Map, FindsPartnersByWordsForSidesAndByPlaces)
{
	using enum SetupProposal::EPartnerRule;
	const VRestSkeleton demo = MapFiles(c_Rigs[0], c_Performers[0]).m_Target;
	const auto indexOf = [&](const char* i_pName)
	{ return std::ranges::find(demo, i_pName, &VRestJoint::m_Name) - demo.begin(); };
	for (const VFamily& rFamily : c_Families)
	{
		SCOPED_TRACE(rFamily.m_pName);
		VRestSkeleton skeleton = demo;
		Rename(skeleton, rFamily);
		const auto rule = rFamily.m_Names.empty() ? Places : Names;
		for (const auto& [pLeft, pRight, expected] : {std::tuple{"palmLeft", "palmRight", rule},
		         {"thighRight", "thighLeft", rule}, {"grip1Left", "grip1Right", Places}})
		{
			const auto partner = SetupProposal::FindPartner(skeleton, std::size_t(indexOf(pLeft)));
			EXPECT_EQ(partner.m_Joint, indexOf(pRight)) << pLeft;
			EXPECT_EQ(partner.m_Rule, expected) << pLeft;
		}
		EXPECT_EQ(SetupProposal::FindPartner(skeleton, std::size_t(indexOf("ribs"))).m_Joint, -1);
	}
}

} // namespace
