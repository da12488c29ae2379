#pragma once

#include "SetupProposal/Side.h"

#include <string>
#include <string_view>
#include <vector>

namespace SetupProposal
{

/// What a name is made of. Namespaces, and a suffix as ".001" that tells copies apart, are left out.
struct VNameWords
{
	/// In lower case and without accents, split at case, digits and other signs, and where known words are glued
	/// together; sides and numbers are not among them.
	std::vector<std::string> m_Words;
	ESide m_Side = ESide::None;
	/// The last one in the name, -1 without one.
	int m_Number = -1;
	/// As the last number is written: "01" of "Finger01".
	std::string m_Digits;
};

VNameWords WordsOf(std::string_view i_Name);

/// The words of all names of a skeleton, without those that nearly all have at the beginning: a prefix tells nothing.
/// A side that only one of several languages would see in a name ("d", "g") counts if the name on the other side
/// exists.
std::vector<VNameWords> WordsOf(const std::vector<std::string_view>& i_rNames);

} // namespace SetupProposal
