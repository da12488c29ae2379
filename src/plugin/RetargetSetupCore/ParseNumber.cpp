#include "RetargetSetupCore/ParseNumber.h"

#include "math/NumberText.h"

#include <cmath>
#include <limits>

namespace RetargetSetup
{

namespace
{

struct VSpelling
{
	std::string_view m_Text;
	double m_Value;
};

constexpr double c_Infinity = std::numeric_limits<double>::infinity();
constexpr double c_NaN = std::numeric_limits<double>::quiet_NaN();

const VSpelling c_OldSpellings[] = {{"1.#INF", c_Infinity}, {"-1.#INF", -c_Infinity},
    {"1.#IND", std::copysign(c_NaN, -1.0)}, {"-1.#IND", std::copysign(c_NaN, -1.0)},
    {"1.#QNAN", std::copysign(c_NaN, 1.0)}, {"-1.#QNAN", std::copysign(c_NaN, -1.0)}};

} // namespace

bool ParseNumber(std::string_view i_Text, double& io_rValue)
{
	const std::size_t first = i_Text.find_first_not_of(" \t");
	if (first == std::string_view::npos)
		return false;
	i_Text = i_Text.substr(first, i_Text.find_last_not_of(" \t") + 1 - first);
	if (NumberText::ScanReal(i_Text, io_rValue) == i_Text.size())
		return true;
	i_Text = i_Text.substr(0, i_Text.find_last_not_of('0') + 1);
	for (const VSpelling& rSpelling : c_OldSpellings)
		if (i_Text == rSpelling.m_Text)
		{
			io_rValue = rSpelling.m_Value;
			return true;
		}
	return false;
}

} // namespace RetargetSetup
