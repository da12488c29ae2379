#include "RetargetSetupCore/ParseNumber.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace
{

TEST(ParseNumber, Rows)
{
	constexpr double inf = std::numeric_limits<double>::infinity();
	constexpr double nan = std::numeric_limits<double>::quiet_NaN();
	constexpr double before = 7.0;
	const struct
	{
		const char* m_pText;
		bool m_bNumber;
		double m_Value;
		bool m_bNegative = false;
	} rows[] = {
	    {"1.5", true, 1.5},
	    {" \t-2e3\t ", true, -2000.0, true},
	    {"0x10", true, 16.0},
	    {"+.5", true, 0.5},
	    {"inf", true, inf},
	    {"1+1", false, 1.0},
	    {"1.5x", false, 1.5},
	    {"1 2", false, 1.0},
	    {"1\n", false, 1.0},
	    {"\n1", true, 1.0},
	    {"", false, before},
	    {" \t ", false, before},
	    {"abc", false, before},
	    {"1,5", false, 1.0},
	    {"1.#INF", true, inf},
	    {"1.#INF00", true, inf},
	    {"-1.#INF00", true, -inf, true},
	    {"1.#IND", true, nan, true},
	    {"-1.#IND", true, nan, true},
	    {"1.#QNAN", true, nan, false},
	    {"-1.#QNAN0", true, nan, true},
	    {"1.#inf", false, 1.0},
	    {"+1.#INF", false, 1.0},
	};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pText);
		double value = before;
		EXPECT_EQ(RetargetSetup::ParseNumber(rRow.m_pText, value), rRow.m_bNumber);
		if (std::isnan(rRow.m_Value))
			EXPECT_TRUE(std::isnan(value));
		else
			EXPECT_EQ(value, rRow.m_Value);
		EXPECT_EQ(std::signbit(value), rRow.m_bNegative);
	}
}

} // namespace
