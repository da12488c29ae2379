#include "SetupProposal/PartWords.h"

#include <algorithm>
#include <string>
#include <unordered_map>

namespace SetupProposal
{
namespace
{

/// A word may mean either of two parts, the first more likely.
struct VMeaning
{
	EBodyPart m_First;
	EBodyPart m_Second;
};

struct VWordRow
{
	/// Separated by blanks: English, the anatomist's Latin, German, French, Spanish, Italian, Portuguese, Japanese, and
	/// the abbreviations of rigs.
	const char* m_pWords;
	VMeaning m_Meaning;
};

constexpr VWordRow c_Rows[] = {
    {"root master global world reference trajectory ground armature origin bip biped cog centre center centro wurzel "
     "racine raiz radice センター 全ての親",
        {ERoot, EPelvis}},
    {"pelvis hips haunch sacrum becken huefte hueften bassin hanches cadera caderas bacino quadril koshi 下半身 腰",
        {EPelvis, EPelvis}},
    {"hip hanche hueft anca", {EPelvis, EThigh}},
    {"waist taille cintura", {ESpine, EPelvis}},
    {"spine chest thorax rib ribs ribcage breast torso abdomen belly back lumbar loin lowerback upperback upperchest "
     "lowerchest vertebra vertebrae spn stomach trunk wirbel wirbelsaeule ruecken brust brustkorb bauch rumpf colonne "
     "echine dos "
     "poitrine torse buste ventre columna espalda pecho espina schiena spina petto torace colonna coluna peito costas "
     "sebone senaka mune hara 上半身 胸",
        {ESpine, ESpine}},
    {"neck nape cervical throat hals nacken cou nuque cuello collo pescoco kubi 首", {ENeck, ENeck}},
    {"head skull cranium kopf schaedel tete crane cabeza testa cabeca atama 頭", {EHead, EHead}},
    {"clavicle collar collarbone clav schluesselbein clavicule clavicula clavicola sakotsu", {EClavicle, EClavicle}},
    {"shoulder schulter epaule hombro spalla ombro kata 肩", {EClavicle, EUpperArm}},
    {"upperarm uparm humerus oberarm upperlimb uarm 腕 jowan", {EUpperArm, EUpperArm}},
    {"arm shldr bras brazo braccio braco ude", {EUpperArm, EForeArm}},
    {"forearm lowerarm lowarm radius ulna elbow farm unterarm ellbogen ellenbogen avantbras coude antebrazo codo "
     "avambraccio gomito antebraco cotovelo hiji maeude ひじ",
        {EForeArm, EForeArm}},
    {"hand wrist palm carpus fist handgelenk main poignet mano muneca polso mao pulso tekubi 手首", {EHand, EHand}},
    {"thumb pollex daumen pouce pulgar pollice polegar oyayubi 親指", {EThumb, EThumb}},
    {"index point pointer forefinger indexfinger zeigefinger indice indicador hitosashiyubi hitosashi 人指 人差指",
        {EIndexFinger, EIndexFinger}},
    {"middle middlefinger mid mittelfinger majeur medio corazon nakayubi 中指", {EMiddleFinger, EMiddleFinger}},
    {"ring ringfinger annulaire anular anulare kusuriyubi 薬指", {ERingFinger, ERingFinger}},
    {"pinky pinkie pink little littlefinger kleinfinger kleinerfinger auriculaire menique mignolo minimo mindinho "
     "koyubi 小指",
        {ELittleFinger, ELittleFinger}},
    {"thigh femur upleg upperleg uleg oberschenkel cuisse muslo coscia coxa momo", {EThigh, EThigh}},
    {"leg jambe pierna gamba perna bein ashi 足", {EShin, EThigh}},
    {"shin calf tibia fibula crus shank knee lowerleg lowleg unterschenkel schienbein wade knie genou mollet "
     "rodilla espinilla pantorrilla ginocchio stinco joelho canela hiza sune ひざ",
        {EShin, EShin}},
    {"hock", {EFoot, EShin}},
    {"foot feet ankle tarsus fuss knoechel pied cheville pie tobillo piede caviglia pe tornozelo ashikubi 足首",
        {EFoot, EFoot}},
    {"toe toes toebase ball claw metatarsal zehe zehen zeh ballen orteil orteils puntera punta dedos tsumasaki つま先",
        {EToe, EToe}},
    {"twist roll nub end tip ik fk ctrl ctl control pole target effector prop weapon sword gun shield tail cape cloak "
     "hair "
     "jaw eye brow eyebrow lid eyelid ear tongue lip mouth cheek tooth teeth nose face skirt cloth wing pony ponytail "
     "helper aux dummy offset null socket attach slot bag belt holster muscle bicep biceps tricep triceps corrective "
     "jiggle crest feather fin site top heel locator marker camera props hat scarf collider physics "
     "metacarpal hipjoint kiefer auge zunge haare schwanz umhang oeil machoire cheveux queue ojo pelo cola occhio "
     "capelli coda olho cabelo 目",
        {EOther, EOther}},
};

/// Every finger alike: the number or the rest pose tells which.
constexpr const char* c_pFingerWords = "finger fing digit phalanx doigt dedo dito yubi 指";
/// Words that tell which of several, and no part alone.
constexpr const char* c_pModifiers = "upper lower low up fore base joint bone jnt bend";

constexpr double c_SecondMeaning = 0.5;
constexpr double c_ClearlyHelper = 0.95;

using VVocabulary = std::unordered_map<std::string, VMeaning>;

template <typename F>
void ForEachWord(std::string_view i_Words, const F& i_rFunction)
{
	while (!i_Words.empty())
	{
		const std::size_t end = std::min(i_Words.find(' '), i_Words.size());
		if (end > 0)
			i_rFunction(std::string(i_Words.substr(0, end)));
		i_Words.remove_prefix(std::min(end + 1, i_Words.size()));
	}
}

const VVocabulary& Vocabulary()
{
	static const VVocabulary c_Vocabulary = []
	{
		VVocabulary vocabulary;
		for (const VWordRow& rRow : c_Rows)
			ForEachWord(rRow.m_pWords, [&](std::string i_Word) { vocabulary.emplace(i_Word, rRow.m_Meaning); });
		// The two meanings that no part has tell a finger, and a modifier.
		ForEachWord(c_pFingerWords, [&](std::string i_Word) { vocabulary.emplace(i_Word, VMeaning{EThumb, EOther}); });
		ForEachWord(c_pModifiers, [&](std::string i_Word) { vocabulary.emplace(i_Word, VMeaning{EOther, ERoot}); });
		return vocabulary;
	}();
	return c_Vocabulary;
}

bool IsAnyFinger(const VMeaning& i_rMeaning)
{
	return i_rMeaning.m_First == EThumb && i_rMeaning.m_Second == EOther;
}

bool IsModifier(const VMeaning& i_rMeaning)
{
	return i_rMeaning.m_First == EOther && i_rMeaning.m_Second == ERoot;
}

/// The meanings of a name's words in their order; two words that are one in the vocabulary ("upper arm", "arm_upper")
/// count as that.
std::vector<VMeaning> MeaningsOf(const std::vector<std::string>& i_rWords)
{
	const VVocabulary& rVocabulary = Vocabulary();
	std::vector<VMeaning> meanings;
	for (std::size_t i = 0; i < i_rWords.size(); ++i)
	{
		auto found = rVocabulary.end();
		if (i + 1 < i_rWords.size())
		{
			found = rVocabulary.find(i_rWords[i] + i_rWords[i + 1]);
			if (found == rVocabulary.end())
				found = rVocabulary.find(i_rWords[i + 1] + i_rWords[i]);
		}
		if (found != rVocabulary.end())
			++i;
		else
			found = rVocabulary.find(i_rWords[i]);
		if (found != rVocabulary.end() && !IsModifier(found->second))
			meanings.push_back(found->second);
	}
	return meanings;
}

/// The more a part is at the end of a limb the more it counts: a "LeftHandThumb1" is a thumb.
int Rank(const VMeaning& i_rMeaning)
{
	if (i_rMeaning.m_First == EOther)
		return 4;
	if (IsFinger(i_rMeaning.m_First))
		return IsAnyFinger(i_rMeaning) ? 2 : 3;
	return i_rMeaning.m_First == ERoot ? 0 : 1;
}

} // namespace

bool IsKnownWord(std::string_view i_Word)
{
	return Vocabulary().contains(std::string(i_Word));
}

std::optional<VPartScores> PartsByName(const VNameWords& i_rName)
{
	const std::vector<VMeaning> meanings = MeaningsOf(i_rName.m_Words);
	if (meanings.empty())
		return std::nullopt;
	VMeaning best = meanings.front();
	for (const VMeaning& rMeaning : meanings)
		if (Rank(rMeaning) >= Rank(best))
			best = rMeaning;
	const bool bOfFoot = std::ranges::any_of(
	    meanings, [](const VMeaning& i_rMeaning) { return i_rMeaning.m_First == EFoot || i_rMeaning.m_First == EToe; });
	if (bOfFoot && IsFinger(best.m_First))
		best = {EToe, EToe};
	// A hip or a breast has a side only where it is the joint of a limb, or flesh.
	if (i_rName.m_Side != ESide::None && best.m_First == EPelvis)
		best = {EThigh, best.m_Second == EThigh ? EPelvis : EOther};
	if (i_rName.m_Side != ESide::None && best.m_First == ESpine)
		best = {EOther, EOther};
	VPartScores scores{};
	if (IsAnyFinger(best))
	{
		std::fill(scores.begin() + EThumb, scores.begin() + ELittleFinger + 1, c_SecondMeaning);
		return scores;
	}
	scores[best.m_Second] = c_SecondMeaning;
	scores[best.m_First] = best.m_First == EOther ? c_ClearlyHelper : 1.0;
	return scores;
}

} // namespace SetupProposal
