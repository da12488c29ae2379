#include "retarget/text/Completion.h"

#include "CommandLineText/Messages.h"
#include "retarget/subject/SubjectFile.h"
#include "retarget/text/Output.h"

#include "CoreOrlexQRTIO/FormatVersions.h"
#include "FBXIO/FBXReader.h"
#include "RetargetSetupCore/TargetConstruction.h"

#include <boost/algorithm/string/classification.hpp>
#include <boost/algorithm/string/split.hpp>
#include <boost/filesystem/operations.hpp>

#include <algorithm>
#include <charconv>
#include <map>
#include <string_view>

namespace CommandLine
{
namespace
{

using VCandidates = std::vector<VCandidate>;
using VNames = std::vector<std::string>;

/// The words before the one that is typed.
struct VTyped
{
	const CLI::App* m_pApp = nullptr;
	bool m_bCommand = false;
	/// Whose value comes next, or null.
	const CLI::Option* m_pOption = nullptr;
	bool m_bOptionsEnded = false;
	/// By long name, as "--source".
	std::map<std::string, std::string> m_Values;
	VNames m_Arguments;
};

const CLI::Option* FindOption(const CLI::App& i_rApp, const std::string& i_rWord)
{
	return i_rWord.starts_with('-') ? i_rApp.get_option_no_throw(i_rWord) : nullptr;
}

std::string LongName(const CLI::Option& i_rOption)
{
	return i_rOption.get_lnames().empty() ? "" : "--" + i_rOption.get_lnames().front();
}

std::vector<const CLI::App*> Commands(const CLI::App& i_rProgram)
{
	return i_rProgram.get_subcommands([](const CLI::App* i_pApp) { return !i_pApp->get_group().empty(); });
}

VTyped Read(const CLI::App& i_rProgram, const VNames& i_rWords)
{
	VTyped typed;
	typed.m_pApp = &i_rProgram;
	for (std::size_t i = 0; i + 1 < i_rWords.size(); ++i)
	{
		const std::string& rWord = i_rWords[i];
		if (const CLI::Option* const pOption = std::exchange(typed.m_pOption, nullptr))
			typed.m_Values[LongName(*pOption)] = rWord;
		else if (rWord == "--")
			typed.m_bOptionsEnded = true;
		else if (rWord.starts_with('-') && rWord.size() > 1 && !typed.m_bOptionsEnded)
		{
			const std::size_t split = rWord.find('=');
			const CLI::Option* const pFound = FindOption(*typed.m_pApp, rWord.substr(0, split));
			if (pFound && split != std::string::npos)
				typed.m_Values[LongName(*pFound)] = rWord.substr(split + 1);
			else if (pFound && pFound->get_expected_max() > 0)
				typed.m_pOption = pFound;
		}
		else if (typed.m_bCommand)
			typed.m_Arguments.push_back(rWord);
		else if (rWord != "help")
		{
			typed.m_bCommand = true;
			for (const CLI::App* pCommand : Commands(i_rProgram))
				if (pCommand->get_name() == rWord)
					typed.m_pApp = pCommand;
		}
	}
	return typed;
}

/// Only regular files are read: what a pipe holds belongs to the command.
bool IsFile(const std::string& i_rPath)
{
	boost::system::error_code error;
	return boost::filesystem::is_regular_file(i_rPath, error);
}

VSubjectFile ReadQuietly(const std::string& i_rPath)
{
	VSubjectFile file;
	if (IsFile(i_rPath))
		TryReadSubjectFile(i_rPath, file);
	return file;
}

VNames SegmentNames(const std::string& i_rPath)
{
	VNames names;
	for (const auto& rSegment : ReadQuietly(i_rPath).m_Record.m_SubjectParametrised.m_Segments)
		names.push_back(rSegment.m_Name);
	return names;
}

VNames BoneNames(const VTyped& i_rTyped)
{
	VNames names;
	const auto file = i_rTyped.m_Values.find("--fbx");
	FBXIO::FBXReader reader;
	if (file != i_rTyped.m_Values.end() && IsFile(file->second) && reader.LoadFile(file->second)
	    && reader.HasSkeleton())
		for (const FBXIO::VSkinBone& rBone : *reader.GetSkeleton())
			names.emplace_back(RetargetSetup::StripNamespace(rBone.m_Name));
	return names;
}

VNames SourceNames(const VTyped& i_rTyped)
{
	const auto file = i_rTyped.m_Values.find("--source");
	return file == i_rTyped.m_Values.end() ? VNames() : SegmentNames(file->second);
}

/// Of the character's FBX file where a subject is made, of the subject where one is edited.
VNames TargetNames(const VTyped& i_rTyped)
{
	return i_rTyped.m_Arguments.empty() ? BoneNames(i_rTyped) : SegmentNames(i_rTyped.m_Arguments.front());
}

/// The first half with its separator, and behind one that is typed the second halves.
VCandidates Pairs(const VNames& i_rFirst, const VNames& i_rSecond, const std::string& i_rTyped, char i_Separator)
{
	VCandidates pairs;
	for (const std::string& rFirst : i_rFirst)
	{
		const std::string begin = rFirst + i_Separator;
		if (!i_rTyped.starts_with(begin))
			pairs.push_back({begin, ""});
		else
			for (const std::string& rSecond : i_rSecond)
				pairs.push_back({begin + rSecond, ""});
	}
	return pairs;
}

VCandidates Words(const VNames& i_rNames, const std::string& i_rEnd = "")
{
	VCandidates words;
	for (const std::string& rName : i_rNames)
		words.push_back({rName + i_rEnd, ""});
	return words;
}

VCandidates Files(const VTyped&, const std::string&)
{
	return {{"", "files"}};
}

VCandidates Folders(const VTyped&, const std::string&)
{
	return {{"", "folders"}};
}

VCandidates Nothing(const VTyped&, const std::string&)
{
	return {};
}

VCandidates SourceAndTarget(const VTyped& i_rTyped, const std::string& i_rWord)
{
	return Pairs(SourceNames(i_rTyped), TargetNames(i_rTyped), i_rWord, ':');
}

VCandidates TwoSides(const VTyped& i_rTyped, const std::string& i_rWord)
{
	VNames names = TargetNames(i_rTyped);
	const VNames source = SourceNames(i_rTyped);
	names.insert(names.end(), source.begin(), source.end());
	return Pairs(names, names, i_rWord, ':');
}

VCandidates TargetSegment(const VTyped& i_rTyped, const std::string&)
{
	return Words(TargetNames(i_rTyped), "=");
}

VCandidates RootBone(const VTyped& i_rTyped, const std::string&)
{
	return Words(BoneNames(i_rTyped));
}

VCandidates Targets(const VTyped& i_rTyped, const std::string& i_rEnd)
{
	VCandidates targets;
	if (!i_rTyped.m_Arguments.empty())
		for (const auto& rTarget :
		    ReadQuietly(i_rTyped.m_Arguments.front()).m_Record.m_SubjectApplicationData.m_Targets)
			targets.push_back({std::to_string(targets.size()) + i_rEnd, rTarget.m_Name});
	return targets;
}

VCandidates TargetIndex(const VTyped& i_rTyped, const std::string&)
{
	return Targets(i_rTyped, "");
}

VCandidates TargetAndValue(const VTyped& i_rTyped, const std::string&)
{
	return Targets(i_rTyped, "=");
}

VCandidates CategoryAndLevel(const VTyped&, const std::string& i_rWord)
{
	VNames levels;
	for (const int level : {NVX::ELogError, NVX::ELogWarning, NVX::ELogInformation, NVX::ELogDetail})
		levels.push_back(LevelName(level));
	return Pairs(VNames(std::begin(c_Categories), std::end(c_Categories)), levels, i_rWord, '=');
}

VCandidates Versions(const VTyped&, const std::string&)
{
	VNames versions;
	const std::string texts = CoreOrlexQRTIO::AllVersionTexts();
	return Words(boost::algorithm::split(versions, texts, boost::algorithm::is_space()));
}

VCandidates PresetActions(const VTyped&, const std::string&)
{
	return Words({"save"});
}

VCandidates ScaleWords(const VTyped&, const std::string&)
{
	return Words({"fit", "keep"});
}

/// By what a value is called in the help.
struct VOptionValue
{
	std::string_view m_Name;
	VCandidates (*m_pCandidates)(const VTyped& i_rTyped, const std::string& i_rWord);
};

constexpr VOptionValue c_Values[] = {
    {"ACTION", PresetActions},
    {"BEFORE AFTER", Files},
    {"CATEGORY=LEVEL", CategoryAndLevel},
    {"DEG", Nothing},
    {"DEGREES", Nothing},
    {"EXPR", Nothing},
    {"FILE", Files},
    {"FILE...", Files},
    {"FILE.fbx", Files},
    {"FILE.json", Files},
    {"FILE.log", Files},
    {"FILE.qrr", Files},
    {"FILE.qrs", Files},
    {"FIRST:LAST", Nothing},
    {"FIRST:LAST:STEP", Nothing},
    {"FOLDER", Folders},
    {"FRAME", Nothing},
    {"HZ", Nothing},
    {"IN... OUT", Files},
    {"IN.qrr", Files},
    {"JOINT:SEGMENT", Nothing},
    {"LEFT:RIGHT", TwoSides},
    {"MM", Nothing},
    {"N", TargetIndex},
    {"N=W", TargetAndValue},
    {"N=X,Y,Z", TargetAndValue},
    {"NAME", Nothing},
    {"NAME=EXPR", Nothing},
    {"NAME=NUMBER", Nothing},
    {"NAME|INDEX", RootBone},
    {"OUT", Files},
    {"OUT.html", Files},
    {"OUT.json", Files},
    {"OUT.png", Files},
    {"OUT.qrr", Files},
    {"OUT.qrs", Files},
    {"OUT.svg", Files},
    {"RECIPE.json", Files},
    {"S|fit|keep", ScaleWords},
    {"SCORE", Nothing},
    {"SEG=RX,RY,RZ[,TX,TY,TZ]", TargetSegment},
    {"SEGMENT", TargetSegment},
    {"SRC:TGT", SourceAndTarget},
    {"STACK", Nothing},
    {"TAKE", Files},
    {"UNIT", Nothing},
    {"V,V,...", Nothing},
    {"WxH", Nothing},
    {"X.Y", Versions},
};

/// "bind|mean|tpose" are the words themselves.
bool IsListOfWords(std::string_view i_Name)
{
	return i_Name.find('|') != std::string_view::npos
	    && std::ranges::all_of(i_Name, [](char i_Byte) { return i_Byte == '|' || (i_Byte >= 'a' && i_Byte <= 'z'); });
}

VCandidates ValuesOf(const CLI::Option& i_rOption, const VTyped& i_rTyped, const std::string& i_rWord)
{
	const std::string name = ValueName(i_rOption);
	if (IsListOfWords(name))
	{
		VNames words;
		return Words(boost::algorithm::split(words, name, boost::algorithm::is_any_of("|")));
	}
	const auto* const pValue = std::ranges::find(c_Values, name, &VOptionValue::m_Name);
	return pValue == std::end(c_Values) ? VCandidates() : pValue->m_pCandidates(i_rTyped, i_rWord);
}

/// The first sentence, which is what fits into a line.
std::string Meaning(const std::string& i_rDescription)
{
	return i_rDescription.substr(0, i_rDescription.find_first_of(".:;"));
}

VCandidates OptionsOf(const CLI::App& i_rApp)
{
	VCandidates options;
	for (const CLI::Option* pOption : i_rApp.get_options())
		for (const auto& [rNames, pDashes] :
		    {std::pair<const VNames&, const char*>(pOption->get_lnames(), "--"), {pOption->get_snames(), "-"}})
			for (const std::string& rName : rNames)
				options.push_back({pDashes + rName, Meaning(pOption->get_description())});
	return options;
}

VCandidates ArgumentsOf(const VTyped& i_rTyped, const std::string& i_rWord)
{
	std::vector<const CLI::Option*> arguments =
	    i_rTyped.m_pApp->get_options([](const CLI::Option* i_pOption) { return i_pOption->get_positional(); });
	if (arguments.empty())
		return {};
	const bool bMany = arguments.back()->get_expected_max() > 1;
	const std::size_t place =
	    bMany ? std::min(i_rTyped.m_Arguments.size(), arguments.size() - 1) : i_rTyped.m_Arguments.size();
	return place < arguments.size() ? ValuesOf(*arguments[place], i_rTyped, i_rWord) : VCandidates();
}

VCandidates AllCandidates(const CLI::App& i_rProgram, const VNames& i_rWords)
{
	const std::string& rWord = i_rWords.back();
	const VTyped typed = Read(i_rProgram, i_rWords);
	if (typed.m_pOption)
		return ValuesOf(*typed.m_pOption, typed, rWord);
	const std::size_t split = rWord.find('=');
	if (rWord.starts_with("--") && split != std::string::npos && !typed.m_bOptionsEnded)
	{
		const CLI::Option* const pOption = FindOption(*typed.m_pApp, rWord.substr(0, split));
		VCandidates values = pOption ? ValuesOf(*pOption, typed, rWord.substr(split + 1)) : VCandidates();
		for (VCandidate& rValue : values)
			if (!rValue.m_Text.empty())
				rValue.m_Text.insert(0, rWord, 0, split + 1);
		return values;
	}
	if (rWord.starts_with('-') && !typed.m_bOptionsEnded)
		return OptionsOf(*typed.m_pApp);
	if (typed.m_bCommand)
		return ArgumentsOf(typed, rWord);
	VCandidates commands;
	for (const CLI::App* pCommand : Commands(i_rProgram))
		commands.push_back({pCommand->get_name(), Meaning(pCommand->get_description())});
	return commands;
}

/// The line that is typed in bash, up to the cursor.
struct VBashLine
{
	VNames m_Words;
	/// So much of the last word stays: bash replaces what is behind a sign that breaks words, or a quote.
	std::size_t m_Kept = 0;
	/// The quote that is open, or 0.
	char m_Quote = 0;
};

VBashLine SplitBashLine(std::string_view i_Line)
{
	constexpr std::string_view c_Breaks = "@=:";
	VBashLine line;
	std::string word;
	bool bWord = false;
	for (std::size_t i = 0; i < i_Line.size(); ++i)
	{
		const char byte = i_Line[i];
		const bool bBlank = byte == ' ' || byte == '\t' || byte == '\n';
		if (bBlank && line.m_Quote == 0)
		{
			if (bWord)
				line.m_Words.push_back(std::exchange(word, ""));
			bWord = false;
			line.m_Kept = 0;
			continue;
		}
		bWord = true;
		if (byte == '\\' && line.m_Quote != '\'' && i + 1 < i_Line.size())
			word += i_Line[++i];
		else if (line.m_Quote == 0 ? byte == '\'' || byte == '"' : byte == line.m_Quote)
		{
			line.m_Quote = line.m_Quote == 0 ? byte : '\0';
			line.m_Kept = word.size();
		}
		else
		{
			word += byte;
			if (line.m_Quote == 0 && c_Breaks.find(byte) != std::string_view::npos)
				line.m_Kept = word.size();
		}
	}
	line.m_Words.push_back(word);
	return line;
}

std::string QuotedForBash(std::string_view i_Text, char i_Quote)
{
	const std::string_view special = i_Quote == '\'' ? "" : i_Quote == '"' ? "\"$`\\" : " \t\"'\\$`&;|<>()*?[]{}#!~";
	std::string text;
	for (const char byte : i_Text)
	{
		if (special.find(byte) != std::string_view::npos)
			text += '\\';
		text += byte;
	}
	return text;
}

} // namespace

std::string ValueName(const CLI::Option& i_rOption)
{
	return i_rOption.get_option_text().empty() && i_rOption.get_positional() ? i_rOption.get_name(true, false)
	                                                                         : i_rOption.get_option_text();
}

bool IsKnownValue(const std::string& i_rName)
{
	return i_rName.empty() || IsListOfWords(i_rName)
	    || std::ranges::find(c_Values, i_rName, &VOptionValue::m_Name) != std::end(c_Values);
}

std::vector<VCandidate> Candidates(const CLI::App& i_rProgram, const std::vector<std::string>& i_rWords)
{
	VCandidates candidates;
	std::vector<std::string_view> taken;
	const VCandidates all = AllCandidates(i_rProgram, i_rWords);
	for (const VCandidate& rCandidate : all)
		if ((rCandidate.m_Text.empty() || rCandidate.m_Text.starts_with(i_rWords.back()))
		    && rCandidate.m_Text.find_first_of("\t\r\n") == std::string::npos
		    && std::ranges::find(taken, rCandidate.m_Text) == taken.end())
		{
			taken.push_back(rCandidate.m_Text);
			candidates.push_back(rCandidate);
		}
	return candidates;
}

void PrintCandidates(const CLI::App& i_rProgram, const std::vector<std::string>& i_rArguments)
{
	if (i_rArguments.size() < 3)
		return;
	VBashLine line;
	const bool bBash = i_rArguments[1] == "bash";
	if (bBash)
	{
		std::size_t cursor = std::string::npos;
		const std::string& rCursor = i_rArguments.back();
		std::from_chars(rCursor.data(), rCursor.data() + rCursor.size(), cursor);
		line = SplitBashLine(std::string_view(i_rArguments[2]).substr(0, cursor));
	}
	else
		line.m_Words = {i_rArguments.begin() + 1, i_rArguments.end()};
	// The program's own name, or what says that these are words.
	line.m_Words.erase(line.m_Words.begin());
	if (line.m_Words.empty())
		return;
	std::string text;
	for (const VCandidate& rCandidate : Candidates(i_rProgram, line.m_Words))
	{
		if (!rCandidate.m_Text.empty() && bBash)
			text += QuotedForBash(std::string_view(rCandidate.m_Text).substr(line.m_Kept), line.m_Quote);
		else
			text += rCandidate.m_Text;
		text += (rCandidate.m_Meaning.empty() ? "" : "\t" + rCandidate.m_Meaning) + "\n";
	}
	Print(text);
}

} // namespace CommandLine
