#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace CommandLine
{

/// Number of bytes to insert, remove, replace or swap with their neighbour to make one text out of the other
/// (optimal string alignment), upper and lower case being the same.
std::size_t EditDistance(std::string_view i_A, std::string_view i_B);

/// The names closest to a text, the closest first, each once and at most i_Count. A name that holds the text, or is
/// held by it, counts as half as far.
std::vector<std::string> Closest(
    std::string_view i_Text, const std::vector<std::string>& i_rNames, std::size_t i_Count = 3);

/// `; did you mean "A", "B" or "C"?`, or nothing if there are no names.
std::string DidYouMean(std::string_view i_Text, const std::vector<std::string>& i_rNames);

/// `; did you mean "A"?` for the closest name, if the text can be a slip of the hand for it.
std::string Meant(const std::string& i_rText, const std::vector<std::string>& i_rNames);

} // namespace CommandLine
