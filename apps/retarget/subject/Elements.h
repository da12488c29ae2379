#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"

#include <cstddef>
#include <optional>
#include <string>
#include <utility>
#include <vector>

/// How the words of a command line name segments, bones and targets.
namespace CommandLine
{

/// The named things that a word may mean.
struct VElements
{
	/// What one of them is called, as "source segment".
	std::string m_Kind;
	std::vector<std::string> m_Names;
};

VElements SegmentsOf(const CoreOrlexTypes::VSubjectParametrised& i_rSubject, const std::string& i_rKind);

/// The element with this name, or "#index". Throws VCommandError with EWrongUsage for a name that none has (with the
/// closest ones) or more than one has, and for an index out of range.
std::size_t FindElement(const std::string& i_rWord, const VElements& i_rElements);

/// "SOURCE:TARGET" as two indices. Names may hold ":" themselves: the split is the one where both names exist. Throws
/// as FindElement does, and if several splits are possible.
std::pair<std::size_t, std::size_t> FindPair(
    const std::string& i_rWord, const VElements& i_rSource, const VElements& i_rTarget);

/// A plain index below i_Count, given as "3" or "#3". Throws VCommandError with EWrongUsage.
std::size_t ParseIndex(const std::string& i_rWord, const std::string& i_rKind, std::size_t i_Count);

/// A finite number; i_rWhat tells what it is for. Throws VCommandError with EWrongUsage.
double ParseFinite(const std::string& i_rWord, const std::string& i_rWhat);

/// Finite numbers, separated by ",".
std::vector<double> ParseList(const std::string& i_rWord, const std::string& i_rWhat);

/// "NAME=VALUE" at the last "=": values are numbers, which hold none. Throws VCommandError with EWrongUsage.
std::pair<std::string, std::string> SplitAssignment(const std::string& i_rWord, const std::string& i_rForm);

} // namespace CommandLine
