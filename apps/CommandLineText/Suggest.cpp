#include "CommandLineText/Suggest.h"

#include <algorithm>
#include <tuple>

namespace CommandLine
{
namespace
{

std::string Lower(std::string_view i_Text)
{
	std::string text(i_Text);
	for (char& rByte : text)
		if (rByte >= 'A' && rByte <= 'Z')
			rByte = char(rByte - 'A' + 'a');
	return text;
}

/// Names are cut here: beyond it nobody mistypes, and the comparison stays cheap whatever a file holds.
constexpr std::size_t c_MaximumLength = 128;

} // namespace

std::size_t EditDistance(std::string_view i_A, std::string_view i_B)
{
	const std::string a = Lower(i_A.substr(0, c_MaximumLength));
	const std::string b = Lower(i_B.substr(0, c_MaximumLength));
	std::vector<std::size_t> before(b.size() + 1);
	std::vector<std::size_t> last(b.size() + 1);
	std::vector<std::size_t> row(b.size() + 1);
	for (std::size_t j = 0; j <= b.size(); ++j)
		last[j] = j;
	for (std::size_t i = 1; i <= a.size(); ++i)
	{
		row[0] = i;
		for (std::size_t j = 1; j <= b.size(); ++j)
		{
			row[j] = std::min({last[j] + 1, row[j - 1] + 1, last[j - 1] + (a[i - 1] != b[j - 1])});
			if (i > 1 && j > 1 && a[i - 1] == b[j - 2] && a[i - 2] == b[j - 1])
				row[j] = std::min(row[j], before[j - 2] + 1);
		}
		std::swap(before, last);
		std::swap(last, row);
	}
	return last[b.size()];
}

std::vector<std::string> Closest(std::string_view i_Text, const std::vector<std::string>& i_rNames, std::size_t i_Count)
{
	const std::string text = Lower(i_Text);
	std::vector<std::tuple<std::size_t, std::size_t, std::string>> found;
	for (std::size_t i = 0; i < i_rNames.size(); ++i)
	{
		const std::string name = Lower(i_rNames[i]);
		const bool bPart = !text.empty() && !name.empty()
		    && (name.find(text) != std::string::npos || text.find(name) != std::string::npos);
		const std::size_t distance = EditDistance(text, name);
		found.emplace_back(bPart ? distance / 2 : distance, i, i_rNames[i]);
	}
	std::sort(found.begin(), found.end());
	std::vector<std::string> closest;
	for (const auto& [distance, index, rName] : found)
		if (closest.size() < i_Count && std::find(closest.begin(), closest.end(), rName) == closest.end())
			closest.push_back(rName);
	return closest;
}

std::string DidYouMean(std::string_view i_Text, const std::vector<std::string>& i_rNames)
{
	const std::vector<std::string> closest = Closest(i_Text, i_rNames);
	if (closest.empty())
		return "";
	std::string text = "; did you mean ";
	for (std::size_t i = 0; i < closest.size(); ++i)
		text += (i == 0 ? "\"" : i + 1 == closest.size() ? " or \"" : ", \"") + closest[i] + "\"";
	return text + "?";
}

std::string Meant(const std::string& i_rText, const std::vector<std::string>& i_rNames)
{
	const std::vector<std::string> closest = Closest(i_rText, i_rNames, 1);
	if (closest.empty() || EditDistance(i_rText, closest.front()) > std::max<std::size_t>(1, i_rText.size() / 3))
		return "";
	return "; did you mean \"" + closest.front() + "\"?";
}

} // namespace CommandLine
