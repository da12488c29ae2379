#include "SetupProposal/NameWords.h"

#include "SetupProposal/PartWords.h"

#include <algorithm>
#include <cctype>
#include <map>
#include <utility>

namespace SetupProposal
{
namespace
{

/// Names longer than this, in bytes, are no names of bones: the rest is not looked at.
constexpr std::size_t c_LongestName = 200;
/// A word that this many of ten names begin with is a prefix.
constexpr std::size_t c_PrefixTenths = 8;
/// The same of one that is glued to words, how long it is at most, and how much behind it is looked at.
constexpr std::size_t c_GluedTenths = 3;
constexpr std::size_t c_LongestPrefix = 6;
constexpr std::size_t c_LongestGlued = 32;

/// Letters with accents, of two bytes in UTF-8 from 0xC3 on, as rigs write them without.
constexpr std::pair<std::string_view, std::string_view> c_Plain[] = {{"ä", "ae"}, {"ö", "oe"}, {"ü", "ue"}, {"ß", "ss"},
    {"Ä", "ae"}, {"Ö", "oe"}, {"Ü", "ue"}, {"é", "e"}, {"è", "e"}, {"ê", "e"}, {"É", "e"}, {"à", "a"}, {"á", "a"},
    {"â", "a"}, {"ã", "a"}, {"í", "i"}, {"î", "i"}, {"ó", "o"}, {"ô", "o"}, {"õ", "o"}, {"ú", "u"}, {"û", "u"},
    {"ç", "c"}, {"ñ", "n"}, {"œ", "oe"}};

std::string WithoutAccents(std::string_view i_Name)
{
	std::string plain;
	while (!i_Name.empty())
	{
		const auto found =
		    std::ranges::find_if(c_Plain, [&](const auto& i_rPair) { return i_Name.starts_with(i_rPair.first); });
		plain += found == std::end(c_Plain) ? i_Name.substr(0, 1) : found->second;
		i_Name.remove_prefix(found == std::end(c_Plain) ? 1 : found->first.size());
	}
	return plain;
}

enum class EKind
{
	Sign,
	Upper,
	Lower,
	Digit,
	Foreign
};

EKind KindOf(char i_Byte)
{
	const auto byte = static_cast<unsigned char>(i_Byte);
	if (byte >= 0x80)
		return EKind::Foreign;
	if (std::isdigit(byte))
		return EKind::Digit;
	if (byte >= 'A' && byte <= 'Z')
		return EKind::Upper;
	return byte >= 'a' && byte <= 'z' ? EKind::Lower : EKind::Sign;
}

/// Runs of letters, as "Left" "Fore" "Arm", and of digits.
std::vector<std::string> RunsOf(std::string_view i_Name)
{
	std::vector<std::string> runs;
	EKind before = EKind::Sign;
	for (std::size_t i = 0; i < i_Name.size(); ++i)
	{
		const EKind kind = KindOf(i_Name[i]);
		const bool bLowerFollows = i + 1 < i_Name.size() && KindOf(i_Name[i + 1]) == EKind::Lower;
		const bool bGoesOn =
		    kind == before ? kind != EKind::Upper || !bLowerFollows : before == EKind::Upper && kind == EKind::Lower;
		if (kind != EKind::Sign)
		{
			if (!bGoesOn || runs.empty())
				runs.emplace_back();
			runs.back() += kind == EKind::Upper ? char(i_Name[i] - 'A' + 'a') : i_Name[i];
		}
		before = kind;
	}
	return runs;
}

/// A run that is known words glued together becomes these; any other stays one. A single letter counts as a side only
/// where it stands first.
bool SplitGlued(std::string_view i_Run, bool i_bFirst, std::vector<std::string>& io_rWords)
{
	if (i_Run.empty())
		return true;
	for (std::size_t length = i_Run.size(); length > 0; --length)
	{
		const std::string_view word = i_Run.substr(0, length);
		bool bWeak = false;
		const bool bSide =
		    SideOfWord(word, &bWeak) != ESide::None && !bWeak && (length > 2 || (i_bFirst && length == 1));
		if (!bSide && (length < 3 || !IsKnownWord(word)))
			continue;
		io_rWords.emplace_back(word);
		if (SplitGlued(i_Run.substr(length), false, io_rWords))
			return true;
		io_rWords.pop_back();
	}
	return false;
}

/// The first run of a name, if it is one that tells nothing.
std::string UnknownFirstRun(std::string_view i_Bare)
{
	const std::vector<std::string> runs = RunsOf(WithoutAccents(i_Bare));
	std::vector<std::string> glued;
	if (runs.empty() || KindOf(runs.front().front()) == EKind::Digit || IsKnownWord(runs.front())
	    || SideOfWord(runs.front()) != ESide::None || SplitGlued(runs.front(), true, glued))
		return "";
	return runs.front();
}

std::string_view Bare(std::string_view i_Name)
{
	i_Name.remove_prefix(i_Name.rfind(':') + 1);
	i_Name.remove_prefix(i_Name.rfind('|') + 1);
	i_Name = i_Name.substr(0, c_LongestName);
	// ".001" tells copies apart.
	constexpr std::size_t c_Copy = 4;
	if (i_Name.size() > c_Copy)
	{
		const std::string_view end = i_Name.substr(i_Name.size() - c_Copy);
		if (end[0] == '.'
		    && std::ranges::all_of(end.substr(1), [](char i_Byte) { return KindOf(i_Byte) == EKind::Digit; }))
			i_Name.remove_suffix(c_Copy);
	}
	return i_Name;
}

/// A prefix that is glued to words, as "chr" in "chrpelvis" and "chrlthigh": the one without which most names are
/// known; empty if it helps few.
std::string GluedPrefix(const std::vector<std::string_view>& i_rNames)
{
	std::map<std::string, std::size_t> known;
	for (const std::string_view name : i_rNames)
	{
		const std::string run = UnknownFirstRun(Bare(name));
		for (std::size_t length = 1; length <= c_LongestPrefix && length + 3 <= run.size(); ++length)
		{
			const std::string rest = run.substr(length, c_LongestGlued);
			std::vector<std::string> glued;
			if (IsKnownWord(rest) || SplitGlued(rest, true, glued))
				++known[run.substr(0, length)];
		}
	}
	const auto best = std::ranges::max_element(known, {}, [](const auto& i_rCount) { return i_rCount.second; });
	return best != known.end() && 10 * best->second >= c_GluedTenths * i_rNames.size() && best->second > 4 ? best->first
	                                                                                                       : "";
}

/// All words, sides among them.
/// @param i_rPrefix in lower case, which the first may begin with; empty for none.
std::vector<std::string> AllWords(std::string_view i_Name, const std::string& i_rPrefix = "")
{
	std::vector<std::string> words;
	for (std::string& rRun : RunsOf(WithoutAccents(Bare(i_Name))))
	{
		std::vector<std::string> glued;
		if (words.empty() && !i_rPrefix.empty() && rRun.starts_with(i_rPrefix) && rRun.size() > i_rPrefix.size()
		    && !IsKnownWord(rRun))
			rRun.erase(0, i_rPrefix.size());
		const bool bKnown =
		    KindOf(rRun.front()) == EKind::Digit || IsKnownWord(rRun) || SideOfWord(rRun) != ESide::None;
		if (!bKnown && SplitGlued(rRun, true, glued))
			words.insert(words.end(), glued.begin(), glued.end());
		else
			words.push_back(rRun);
	}
	return words;
}

VNameWords Sorted(const std::vector<std::string>& i_rWords, bool i_bWeakSides)
{
	VNameWords name;
	bool bLeft = false;
	bool bRight = false;
	for (const std::string& rWord : i_rWords)
	{
		bool bWeak = false;
		const ESide side = SideOfWord(rWord, &bWeak);
		if (side != ESide::None && (!bWeak || i_bWeakSides))
			(side == ESide::Left ? bLeft : bRight) = true;
		else if (rWord.starts_with("left") || rWord.starts_with("right"))
		{
			// Glued to a word that is not known.
			const bool bOfLeft = rWord.starts_with("left");
			(bOfLeft ? bLeft : bRight) = true;
			name.m_Words.push_back(rWord.substr(bOfLeft ? 4 : 5));
		}
		else if (KindOf(rWord.front()) == EKind::Digit)
			name.m_Digits = rWord;
		else if (side == ESide::None || rWord.size() > 1)
			name.m_Words.push_back(rWord);
	}
	if (!name.m_Digits.empty() && name.m_Digits.size() < 6)
		name.m_Number = std::stoi(name.m_Digits);
	if (bLeft != bRight)
		name.m_Side = bLeft ? ESide::Left : ESide::Right;
	return name;
}

} // namespace

VNameWords WordsOf(std::string_view i_Name)
{
	return Sorted(AllWords(i_Name), false);
}

std::vector<VNameWords> WordsOf(const std::vector<std::string_view>& i_rNames)
{
	const std::string prefix = GluedPrefix(i_rNames);
	std::vector<std::vector<std::string>> all;
	std::map<std::string, std::size_t> first;
	for (const std::string_view name : i_rNames)
	{
		all.push_back(AllWords(name, prefix));
		if (!all.back().empty())
			++first[all.back().front()];
	}
	for (auto& rWords : all)
		if (rWords.size() > 1 && SideOfWord(rWords.front()) == ESide::None
		    && 10 * first[rWords.front()] >= c_PrefixTenths * i_rNames.size() && i_rNames.size() > 4)
			rWords.erase(rWords.begin());
	// The names that a weak word makes a side of, by what else is in them.
	std::map<std::pair<std::vector<std::string>, std::string>, int> weak;
	std::vector<VNameWords> names;
	for (const auto& rWords : all)
	{
		VNameWords& rName = names.emplace_back(Sorted(rWords, true));
		weak[{rName.m_Words, rName.m_Digits}] |= rName.m_Side == ESide::Left ? 1 : rName.m_Side == ESide::Right ? 2 : 0;
	}
	for (std::size_t i = 0; i < all.size(); ++i)
		if (weak[{names[i].m_Words, names[i].m_Digits}] != 3)
			names[i] = Sorted(all[i], false);
	return names;
}

} // namespace SetupProposal
