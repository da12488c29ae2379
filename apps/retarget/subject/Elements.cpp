#include "retarget/subject/Elements.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Suggest.h"

#include "math/NumberText.h"

#include <algorithm>
#include <charconv>
#include <cmath>

namespace CommandLine
{
namespace
{

[[noreturn]] void Refuse(const std::string& i_rMessage)
{
	throw VCommandError(EWrongUsage, i_rMessage);
}

/// True if the text is decimal digits only; a number too large to hold counts as the largest one.
bool ParseDigits(std::string_view i_Text, std::size_t& o_rValue)
{
	if (i_Text.empty()
	    || !std::all_of(i_Text.begin(), i_Text.end(), [](char i_Byte) { return i_Byte >= '0' && i_Byte <= '9'; }))
		return false;
	if (std::from_chars(i_Text.data(), i_Text.data() + i_Text.size(), o_rValue).ec != std::errc())
		o_rValue = static_cast<std::size_t>(-1);
	return true;
}

bool ParseHashIndex(const std::string& i_rWord, std::size_t& o_rIndex)
{
	return i_rWord.size() > 1 && i_rWord[0] == '#' && ParseDigits(std::string_view(i_rWord).substr(1), o_rIndex);
}

/// True for a word that means something, be it ambiguous or out of range.
bool Exists(const std::string& i_rWord, const VElements& i_rElements)
{
	std::size_t index = 0;
	return ParseHashIndex(i_rWord, index)
	    || std::find(i_rElements.m_Names.begin(), i_rElements.m_Names.end(), i_rWord) != i_rElements.m_Names.end();
}

std::string RangeText(std::size_t i_Count, const std::string& i_rKind)
{
	if (i_Count == 0)
		return "there is no " + i_rKind + " at all";
	return "they go from #0 to #" + std::to_string(i_Count - 1);
}

} // namespace

VElements SegmentsOf(const CoreOrlexTypes::VSubjectParametrised& i_rSubject, const std::string& i_rKind)
{
	VElements elements{i_rKind, {}};
	for (const auto& rSegment : i_rSubject.m_Segments)
		elements.m_Names.push_back(rSegment.m_Name);
	return elements;
}

std::size_t FindElement(const std::string& i_rWord, const VElements& i_rElements)
{
	const std::vector<std::string>& rNames = i_rElements.m_Names;
	std::size_t index = 0;
	if (ParseHashIndex(i_rWord, index))
	{
		if (index >= rNames.size())
			Refuse("there is no " + i_rElements.m_Kind + " " + i_rWord + "; "
			    + RangeText(rNames.size(), i_rElements.m_Kind)
			    + (rNames.empty() ? "" : ", the last is \"" + rNames.back() + "\""));
		return index;
	}
	std::vector<std::size_t> found;
	for (std::size_t i = 0; i < rNames.size(); ++i)
		if (rNames[i] == i_rWord)
			found.push_back(i);
	if (found.empty())
		Refuse("there is no " + i_rElements.m_Kind + " \"" + i_rWord + "\"" + DidYouMean(i_rWord, rNames));
	if (found.size() > 1)
	{
		std::string places;
		for (const std::size_t i : found)
			places += (places.empty() ? "#" : ", #") + std::to_string(i);
		Refuse("more than one " + i_rElements.m_Kind + " is called \"" + i_rWord + "\": name one by its index ("
		    + places + ")");
	}
	return found.front();
}

std::pair<std::size_t, std::size_t> FindPair(
    const std::string& i_rWord, const VElements& i_rSource, const VElements& i_rTarget)
{
	std::vector<std::pair<std::string, std::string>> splits;
	std::vector<std::pair<std::string, std::string>> halves;
	for (std::size_t at = i_rWord.find(':'); at != std::string::npos; at = i_rWord.find(':', at + 1))
	{
		std::pair<std::string, std::string> split(i_rWord.substr(0, at), i_rWord.substr(at + 1));
		const bool bSource = Exists(split.first, i_rSource);
		const bool bTarget = Exists(split.second, i_rTarget);
		if (bSource && bTarget)
			splits.push_back(split);
		else if (bSource || bTarget || halves.empty())
			halves.push_back(split);
	}
	if (splits.size() > 1)
		Refuse("\"" + i_rWord + "\" can be split in more than one way: name a segment by its index, as #3");
	if (splits.empty() && halves.empty())
		Refuse("\"" + i_rWord + "\" is not SOURCE:TARGET");
	// Without a split where both exist, one where one of them does tells best what is wrong.
	const auto& rSplit = splits.empty() ? halves.back() : splits.front();
	return {FindElement(rSplit.first, i_rSource), FindElement(rSplit.second, i_rTarget)};
}

std::size_t ParseIndex(const std::string& i_rWord, const std::string& i_rKind, std::size_t i_Count)
{
	std::size_t index = 0;
	if (!ParseHashIndex(i_rWord, index) && !ParseDigits(i_rWord, index))
		Refuse("\"" + i_rWord + "\" is not the index of a " + i_rKind);
	if (index >= i_Count)
		Refuse(
		    "there is no " + i_rKind + " #" + i_rWord.substr(i_rWord[0] == '#') + "; " + RangeText(i_Count, i_rKind));
	return index;
}

double ParseFinite(const std::string& i_rWord, const std::string& i_rWhat)
{
	double value = 0.0;
	if (!NumberText::ScanWholeReal(i_rWord, value) || !std::isfinite(value))
		Refuse(i_rWhat + ": \"" + i_rWord + "\" is not a finite number");
	return value;
}

std::vector<double> ParseList(const std::string& i_rWord, const std::string& i_rWhat)
{
	std::vector<double> values;
	for (std::size_t begin = 0; begin <= i_rWord.size();)
	{
		const std::size_t end = std::min(i_rWord.find(',', begin), i_rWord.size());
		values.push_back(ParseFinite(i_rWord.substr(begin, end - begin), i_rWhat));
		begin = end + 1;
	}
	return values;
}

std::pair<std::string, std::string> SplitAssignment(const std::string& i_rWord, const std::string& i_rForm)
{
	const std::size_t at = i_rWord.rfind('=');
	if (at == std::string::npos || at == 0)
		Refuse("\"" + i_rWord + "\" is not " + i_rForm);
	return {i_rWord.substr(0, at), i_rWord.substr(at + 1)};
}

} // namespace CommandLine
