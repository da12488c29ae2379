#include "retarget/subject/Mapping.h"

#include "Rows.h"

#include "SetupProposal/BodyParts.h"
#include "SetupProposal/NameWords.h"
#include "SetupProposal/PartWords.h"
#include "SetupProposal/Partner.h"
#include "SetupProposal/PoseCheck.h"

#include <cmath>
#include <fstream>
#include <map>
#include <numbers>
#include <numeric>
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

/// What the families below name, as segments of the performer are called; what ends in "+" is the joint beneath. A back
/// of fewer bones takes the first names.
const std::vector<std::string> c_Body{"Hips", "LowerBack", "Spine", "Spine1", "Neck1", "Head", "{}Shoulder", "{}Arm",
    "{}ForeArm", "{}Hand", "{}Thumb", "{}Thumb+", "{}HandIndex1", "{}HandIndex1+", "{}UpLeg", "{}Leg", "{}Foot",
    "{}ToeBase"};
constexpr std::size_t c_FirstOfBack = 1;
constexpr std::size_t c_BonesOfBack = 3;

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
    {"romaji",
        {"koshi", "sebone1", "sebone2", "mune", "kubi", "atama", "{}_kata", "{}_ude", "{}_hiji", "{}_tekubi",
            "{}_oyayubi1", "{}_oyayubi2", "{}_hitosashiyubi1", "{}_hitosashiyubi2", "{}_momo", "{}_hiza", "{}_ashikubi",
            "{}_tsumasaki"},
        "hidari", "migi"},
    {"underlined biped",
        {"Bip001_Pelvis", "Bip001_Spine", "Bip001_Spine1", "Bip001_Spine2", "Bip001_Neck", "Bip001_Head",
            "Bip001_{}_Clavicle", "Bip001_{}_UpperArm", "Bip001_{}_Forearm", "Bip001_{}_Hand", "Bip001_{}_Finger0",
            "Bip001_{}_Finger01", "Bip001_{}_Finger1", "Bip001_{}_Finger11", "Bip001_{}_Thigh", "Bip001_{}_Calf",
            "Bip001_{}_Foot", "Bip001_{}_Toe0"},
        "L", "R"},
    {"scanned",
        {"pelvis", "spine1", "spine2", "spine3", "neck", "head", "{}_collar", "{}_shoulder", "{}_elbow", "{}_wrist",
            "{}_thumb1", "{}_thumb2", "{}_index1", "{}_index2", "{}_hip", "{}_knee", "{}_ankle", "{}_foot"},
        "left", "right"},
    {"jammed",
        {"chrpelvis", "chrspine1", "chrspine2", "chrspine3", "chrneck", "chrhead", "chr{}clav", "chr{}uparm",
            "chr{}lowarm", "chr{}hand", "chr{}thumb1", "chr{}thumb2", "chr{}index1", "chr{}index2", "chr{}upleg",
            "chr{}lowleg", "chr{}foot", "chr{}toe"},
        "l", "r"},
    {"Portuguese",
        {"quadril", "coluna1", "coluna2", "peito", "pescoço", "cabeça", "clavícula.{}", "braço.{}", "antebraço.{}",
            "mão.{}", "polegar1.{}", "polegar2.{}", "indicador1.{}", "indicador2.{}", "coxa.{}", "canela.{}", "pé.{}",
            "dedos.{}"},
        "E", "D"},
    {"none", {}, "", ""},
};

std::string Filled(std::string i_Pattern, const std::string& i_rSide)
{
	if (const std::size_t at = i_Pattern.find("{}"); at != std::string::npos)
		i_Pattern.replace(at, 2, i_rSide);
	return i_Pattern;
}

/// The joints of a rig that are some part of c_Body, by that with the side filled in.
using VParts = std::map<std::string, std::string>;

VParts PartsOf(const VRestSkeleton& i_rRig, const VPairs& i_rTrue)
{
	VParts parts;
	for (const auto& [source, target] : i_rTrue)
		parts[source] = target;
	// "LThumb" stands beside "LeftHand".
	for (const auto& [pShort, pLong] : {std::pair("LThumb", "LeftThumb"), {"RThumb", "RightThumb"}})
		if (auto thumb = parts.extract(pShort))
		{
			thumb.key() = pLong;
			parts.insert(std::move(thumb));
		}
	for (const char* const pName : {"LeftThumb", "RightThumb", "LeftHandIndex1", "RightHandIndex1"})
		for (const VRestJoint& rJoint : i_rRig)
			if (rJoint.m_Parent >= 0 && parts.contains(pName)
			    && i_rRig[std::size_t(rJoint.m_Parent)].m_Name == parts[pName])
				parts.emplace(std::string(pName) + "+", rJoint.m_Name);
	return parts;
}

void Rename(VRestSkeleton& io_rSkeleton, const VFamily& i_rFamily, const VParts& i_rParts)
{
	std::map<std::string, std::string> names;
	std::size_t back = c_FirstOfBack;
	for (std::size_t i = 0; i < i_rFamily.m_Names.size(); ++i)
		for (const bool bLeft : {true, false})
			if (const auto part = i_rParts.find(Filled(c_Body[i], bLeft ? "Left" : "Right")); part != i_rParts.end())
			{
				const bool bBack = i >= c_FirstOfBack && i < c_FirstOfBack + c_BonesOfBack;
				if (!names.contains(part->second))
					names[part->second] =
					    Filled(i_rFamily.m_Names[bBack ? back++ : i], bLeft ? i_rFamily.m_Left : i_rFamily.m_Right);
			}
	for (std::size_t i = 0; i < io_rSkeleton.size(); ++i)
		io_rSkeleton[i].m_Name =
		    names.contains(io_rSkeleton[i].m_Name) ? names[io_rSkeleton[i].m_Name] : "Bone_" + std::to_string(i);
}

VRestJoint& Joint(VRestSkeleton& io_rSkeleton, const std::string& i_rName)
{
	return *std::ranges::find(io_rSkeleton, i_rName, &VRestJoint::m_Name);
}

/// All places, of joints and of what they move of the skin.
template <typename F>
void ForEachPlace(VRestSkeleton& io_rSkeleton, const F& i_rFunction)
{
	for (VRestJoint& rJoint : io_rSkeleton)
	{
		i_rFunction(rJoint.m_Place);
		if (rJoint.m_Skin)
			i_rFunction(rJoint.m_Skin->m_Centre);
	}
}

void Turn(VRestSkeleton& io_rSkeleton, double i_Degrees)
{
	const double angle = i_Degrees * std::acos(-1.0) / 180.0;
	ForEachPlace(io_rSkeleton,
	    [angle](Rotation::VVector3& io_rPlace)
	    {
		    io_rPlace = {std::cos(angle) * io_rPlace[0] - std::sin(angle) * io_rPlace[1],
		        std::sin(angle) * io_rPlace[0] + std::cos(angle) * io_rPlace[1], io_rPlace[2]};
	    });
}

/// What is done to a rig, on top of a family's names.
struct VVariation
{
	const char* m_pName;
	void (*m_pChange)(VRestSkeleton& io_rSkeleton, const VParts& i_rParts);
	/// What is left to tell the pairs: without names nothing outvotes a tree that is wrong.
	enum ETree
	{
		ERight,
		EWrong,
		ENone
	} m_Tree = ERight;
	/// Names of a side are those of the other.
	bool m_bSidesSwapped = false;
};

void Scale(VRestSkeleton& io_rSkeleton, double i_Factor)
{
	ForEachPlace(io_rSkeleton,
	    [i_Factor](Rotation::VVector3& io_rPlace)
	    {
		    for (double& rValue : io_rPlace)
			    rValue *= i_Factor;
	    });
	for (VRestJoint& rJoint : io_rSkeleton)
		if (rJoint.m_Skin)
			rJoint.m_Skin->m_Spread *= i_Factor;
}

/// Parents that stand behind their children are brought before them, as readers of files have them.
void Reparent(VRestSkeleton& io_rSkeleton, const std::string& i_rChild, const std::string& i_rParent)
{
	const auto parent = &Joint(io_rSkeleton, i_rParent) - io_rSkeleton.data();
	const auto child = &Joint(io_rSkeleton, i_rChild) - io_rSkeleton.data();
	if (parent < child)
		io_rSkeleton[std::size_t(child)].m_Parent = parent;
}

const std::vector<VVariation> c_Variations{
    {"as it is", [](VRestSkeleton&, const VParts&) {}},
    {"turned by 90", [](VRestSkeleton& io_rSkeleton, const VParts&) { Turn(io_rSkeleton, 90.0); }},
    {"turned by 180", [](VRestSkeleton& io_rSkeleton, const VParts&) { Turn(io_rSkeleton, 180.0); }},
    {"turned by 215", [](VRestSkeleton& io_rSkeleton, const VParts&) { Turn(io_rSkeleton, 215.0); }},
    {"in metres taken for mm", [](VRestSkeleton& io_rSkeleton, const VParts&) { Scale(io_rSkeleton, 0.001); }},
    {"a hundred times as large", [](VRestSkeleton& io_rSkeleton, const VParts&) { Scale(io_rSkeleton, 100.0); }},
    {"head at the chest",
        [](VRestSkeleton& io_rSkeleton, const VParts& i_rParts)
        { Joint(io_rSkeleton, i_rParts.at("Head")).m_Place = Joint(io_rSkeleton, i_rParts.at("Spine")).m_Place; }},
    {"thighs on the chest, a hand on the pelvis",
        [](VRestSkeleton& io_rSkeleton, const VParts& i_rParts)
        {
	        Reparent(io_rSkeleton, i_rParts.at("LeftUpLeg"), i_rParts.at("Spine"));
	        Reparent(io_rSkeleton, i_rParts.at("RightUpLeg"), i_rParts.at("Spine"));
	        Reparent(io_rSkeleton, i_rParts.at("LeftHand"), i_rParts.at("Hips"));
        },
        VVariation::EWrong},
    {"feet on the pelvis",
        [](VRestSkeleton& io_rSkeleton, const VParts& i_rParts)
        {
	        Reparent(io_rSkeleton, i_rParts.at("LeftFoot"), i_rParts.at("Hips"));
	        Reparent(io_rSkeleton, i_rParts.at("RightFoot"), i_rParts.at("Hips"));
        },
        VVariation::EWrong},
    {"arms on the pelvis",
        [](VRestSkeleton& io_rSkeleton, const VParts& i_rParts)
        {
	        Reparent(io_rSkeleton, i_rParts.at("LeftShoulder"), i_rParts.at("Hips"));
	        Reparent(io_rSkeleton, i_rParts.at("RightShoulder"), i_rParts.at("Hips"));
        },
        VVariation::EWrong},
    {"all on the first",
        [](VRestSkeleton& io_rSkeleton, const VParts&)
        {
	        for (std::size_t i = 1; i < io_rSkeleton.size(); ++i)
		        io_rSkeleton[i].m_Parent = 0;
        },
        VVariation::ENone},
    {"a root on the ground",
        [](VRestSkeleton& io_rSkeleton, const VParts&)
        {
	        for (VRestJoint& rJoint : io_rSkeleton)
		        ++rJoint.m_Parent;
	        io_rSkeleton.insert(io_rSkeleton.begin(), VRestJoint{"root", -1, {}, true});
        }},
    {"names of the sides swapped", [](VRestSkeleton&, const VParts&) {}, VVariation::ERight, true},
};

/// Right and found at least; without names nothing outvotes a tree that is wrong.
std::pair<double, double> LeastOf(const VFamily& i_rFamily, const VVariation& i_rVariation)
{
	if (i_rFamily.m_Names.empty() && i_rVariation.m_Tree != VVariation::ERight)
		return {0.7, 0.0};
	if (i_rVariation.m_Tree == VVariation::ENone)
		return {0.85, 0.6};
	return {i_rFamily.m_Names.empty() ? 0.85 : 0.9, 0.8};
}

/// Adds what is found of each family, and of each variation with names and without.
void FindInRig(const VRig& i_rRig, std::map<std::string, VFigures>& io_rFigures)
{
	// All variations of these, and of the others the rig as it is.
	const std::set<std::string> varied{"biped", "French", "none"};
	const VMapped mapped = MapFiles(i_rRig, c_Performers[0]);
	const VPairs truePairs = TruePairs(i_rRig, c_Performers[0]);
	const VParts parts = PartsOf(mapped.m_Target, truePairs);
	for (const VFamily& rFamily : c_Families)
		for (const VVariation& rVariation : c_Variations)
		{
			if (&rVariation != &c_Variations.front() && !varied.contains(rFamily.m_pName))
				continue;
			VRestSkeleton named = mapped.m_Target;
			rVariation.m_pChange(named, parts);
			VRestSkeleton skeleton = named;
			VFamily family = rFamily;
			if (rVariation.m_bSidesSwapped)
				std::swap(family.m_Left, family.m_Right);
			Rename(skeleton, family, parts);
			const std::string what = i_rRig.m_Name + ", " + rFamily.m_pName + ", " + rVariation.m_pName;
			const VFigures figures =
			    FiguresOf(SetupProposal::Propose(mapped.m_Source, skeleton), mapped.m_Source, named, truePairs, what);
			for (const SetupProposal::VJointReading& rReading : SetupProposal::ReadBody(skeleton).m_Joints)
				ASSERT_NEAR(std::reduce(rReading.m_Likely.begin(), rReading.m_Likely.end()), 1.0, 1e-9) << what;
			const auto [right, found] = LeastOf(rFamily, rVariation);
			if (figures.m_Proposed > 0 || found > 0.0)
			{
				EXPECT_GE(figures.Precision(), right) << what;
				EXPECT_GE(figures.Found(), found) << what;
			}
			if (&rVariation == &c_Variations.front())
				io_rFigures[std::string("names: ") + rFamily.m_pName] += figures;
			io_rFigures[std::string(rFamily.m_Names.empty() ? "no names: " : "varied: ") + rVariation.m_pName] +=
			    figures;
		}
}

TEST(Map, FindsThePairsWhateverTheNamesTheTreeAndTheFacing)
{
	std::map<std::string, VFigures> figures;
	for (const VRig& rRig : c_Rigs)
		FindInRig(rRig, figures);
	VFigures all;
	for (const auto& [name, rFigures] : figures)
	{
		std::printf("%-60s %5.1f %5.1f\n", name.c_str(), 100.0 * rFigures.Precision(), 100.0 * rFigures.Found());
		if (name.starts_with("names: "))
			all += rFigures;
	}
	EXPECT_GE(all.Precision(), 0.97);
	EXPECT_GE(all.Found(), 0.9);
}

/// A word that is known stays whole, though it begins as the others' prefix does.
TEST(Map, TakesAGluedPrefixOffNames)
{
	std::string words;
	for (const SetupProposal::VNameWords& rName :
	    SetupProposal::WordsOf({"hepelvis", "hespine", "hechest", "heneck", "head", "hethigh", "heknee", "hefoot"}))
		for (const std::string& rWord : rName.m_Words)
			words += rWord + " ";
	EXPECT_EQ(words, "pelvis spine chest neck head thigh knee foot ");
}

TEST(Map, OfTwoPartsInANameTheLastCounts)
{
	const auto scores = SetupProposal::PartsByName(SetupProposal::WordsOf("SpineNeck"));
	ASSERT_TRUE(scores);
	EXPECT_GT((*scores)[SetupProposal::ENeck], (*scores)[SetupProposal::ESpine]);
}

TEST(Map, TellsWhoWasOutvoted)
{
	const VMapped mapped = MapFiles(c_Rigs[0], c_Performers[0]);
	const VParts parts = PartsOf(mapped.m_Target, TruePairs(c_Rigs[0], c_Performers[0]));
	struct VOutvoted
	{
		const char* m_pVariation;
		const char* m_pSource;
		const char* m_pReason;
	};
	for (const auto& [pVariation, pSource, pReason] :
	    {VOutvoted{"head at the chest", "Head", "outvoted: the rest pose of the target"},
	        {"head at the chest", "Head",
	            "for it: the name, the place in the tree, the rest pose of the source, the skin"},
	        {"thighs on the chest, a hand on the pelvis", "LeftHand", "outvoted: the place in the tree of the target"},
	        {"names of the sides swapped", "LeftArm", "outvoted: the side that the name of the target tells"}})
	{
		SCOPED_TRACE(pReason);
		const auto variation = std::ranges::find(c_Variations, std::string_view(pVariation), &VVariation::m_pName);
		VRestSkeleton skeleton = mapped.m_Target;
		variation->m_pChange(skeleton, parts);
		VFamily family = c_Families.front();
		if (variation->m_bSidesSwapped)
			std::swap(family.m_Left, family.m_Right);
		Rename(skeleton, family, parts);
		std::string reasons;
		for (const auto& rPair : SetupProposal::Propose(mapped.m_Source, skeleton).m_Pairs)
			for (const std::string& rReason : rPair.m_Reasons)
				reasons += mapped.m_Source[rPair.m_Source].m_Name == pSource ? rReason + "; " : "";
		EXPECT_NE(reasons.find(pReason), std::string::npos) << reasons;
	}
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
	// Knees far in front of the hips are no second pair of legs.
	VRestSkeleton crouching{
	    {"Hips", -1, {0.0, 0.0, 900.0}}, {"Spine", 0, {0.0, 0.0, 1200.0}}, {"Head", 1, {0.0, 0.0, 1500.0}}};
	for (const auto& [side, x] : {std::pair("Left", 100.0), std::pair("Right", -100.0)})
		for (const auto& [name, y, z] : {std::tuple("Thigh", 0.0, 880.0), std::tuple("Shin", -420.0, 600.0),
		         std::tuple("Foot", -400.0, 60.0), std::tuple("Toe", -470.0, 20.0)})
			crouching.push_back(
			    {std::string(side) + name, y == 0.0 ? std::int64_t(0) : std::int64_t(crouching.size()) - 1, {x, y, z}});
	EXPECT_EQ(SetupProposal::Propose(performer, crouching).m_NoBody, "");

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
	        // The skin of its feet ends 13.35 mm over the floor of the file.
	        "lowestMm", 113.35, "--lift -113.3 "},
	    {"soles",
	        [](VRestSkeleton& io_rSkeleton)
	        {
		        auto& rSkin = *Joint(io_rSkeleton, "hockLeft").m_Skin;
		        const auto turn = Rotation::RotationMatrixFromAngleAxis({0.35, 0.0, 0.0});
		        rSkin.m_Axes = Rotation::Product(turn, rSkin.m_Axes);
		        rSkin.m_BoundUp = Rotation::Product(turn, rSkin.m_BoundUp);
	        },
	        "leftDegrees", 0.35 * 180.0 / std::numbers::pi, "--chain legs --align"},
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
		// The demo's two differ in nothing but their size and what they stand on.
		EXPECT_EQ(find(demo.m_Target, rRow.m_Id).m_bFine, rRow.m_Id != "scale" && rRow.m_Id != "floor");
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
	    {{"nothing to compare", {"map", "--source", c_Performer}, 2, "", "--fbx FILE, a retarget subject, or both"},
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
	const VParts parts = PartsOf(demo, TruePairs(c_Rigs[0], c_Performers[0]));
	const auto indexOf = [&](const char* i_pName)
	{ return std::ranges::find(demo, i_pName, &VRestJoint::m_Name) - demo.begin(); };
	for (const VFamily& rFamily : c_Families)
	{
		SCOPED_TRACE(rFamily.m_pName);
		VRestSkeleton skeleton = demo;
		Rename(skeleton, rFamily, parts);
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
