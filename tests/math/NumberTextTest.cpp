#include "math/NumberText.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <bit>
#include <cctype>
#include <clocale>
#include <cmath>
#include <cstdio>
#include <limits>
#include <random>
#include <string>
#include <utility>

namespace
{

/// The C library's number text is the oracle, and it follows the language of the process.
class NumberText : public testing::Test
{
protected:
	void SetUp() override { std::setlocale(LC_NUMERIC, "C"); }
	void TearDown() override { std::setlocale(LC_NUMERIC, ""); }
};

/// What the C library reads.
/// The standard calls an exponent letter or a hexadecimal mark without digits a matching failure; glibc takes the
/// number before it. This is told apart by what glibc's last byte is.
std::size_t LibraryScan(const std::string& i_rText, double& o_rValue)
{
	int read = 0;
	const double before = o_rValue;
	if (std::sscanf(i_rText.c_str(), "%lf%n", &o_rValue, &read) != 1)
		return 0;
	const std::string taken = i_rText.substr(0, read);
	const bool bHexadecimal = taken.find_first_of("xX") != std::string::npos;
	const bool bHasDigit = taken.find_first_of("0123456789abcdefABCDEF", bHexadecimal ? taken.find_first_of("xX") : 0)
	    != std::string::npos;
	const bool bWord = taken.find_first_of("nN") != std::string::npos;
	if (bWord || (bHasDigit && taken.find_last_of(bHexadecimal ? "pP+-" : "eE+-") != taken.size() - 1))
		return std::size_t(read);
	o_rValue = before;
	return 0;
}

void ExpectSameScan(const std::string& i_rText)
{
	double expected = 7.0;
	double value = 7.0;
	const std::size_t expectedRead = LibraryScan(i_rText, expected);
	EXPECT_EQ(::NumberText::ScanReal(i_rText, value), expectedRead) << '"' << i_rText << '"';
	if (std::isnan(expected))
		EXPECT_TRUE(std::isnan(value)) << '"' << i_rText << '"';
	else
		EXPECT_EQ(std::bit_cast<std::uint64_t>(value), std::bit_cast<std::uint64_t>(expected)) << '"' << i_rText << '"';
	// A list goes on behind finite numbers that white space or the end follows.
	const bool bOne = expectedRead > 0 && std::isfinite(expected)
	    && (expectedRead == i_rText.size() || std::isspace(static_cast<unsigned char>(i_rText[expectedRead])));
	std::string_view rest = i_rText;
	EXPECT_EQ(::NumberText::ScanReals(rest, {&value, 1}), bOne) << '"' << i_rText << '"';
	const std::size_t next = i_rText.find_first_not_of(" \t\n\v\f\r", bOne ? expectedRead : 0);
	EXPECT_EQ(rest, i_rText.substr(std::min(next, i_rText.size()))) << '"' << i_rText << '"';
}

TEST_F(NumberText, ScansWhatTheLibraryScans)
{
	for (const char* pText :
	    {"1", " \t\n\v\f\r1", "+1", "-1", "+-1", "", " ", ".", "-.", "1.", ".5", "1.5.2", "1e5", "1e+5", "2e", "2e+",
	        "2ex", "1e400", "-1e400", "1e-400", "4e-320", "1,5", "0x10", "0x", "0x.8p1", "0x1p-1080", "0x1p5000",
	        "0x1p", "inf", "INFINITY", "infinit", "infx", "nan", "-NaN", "na", "1e5000000000", "00012", "-0"})
		ExpectSameScan(pText);
}

/// Also where the C library takes no such texts.
TEST_F(NumberText, ReadsWhatIsOutOfRangeAsInfiniteOrZero)
{
	const std::string zeros(400, '0');
	const std::pair<std::string, double> c_Rows[] = {{"0x1p5000", HUGE_VAL}, {"-0x1p5000", -HUGE_VAL},
	    {"0x1p-1075", 0.0}, {"0x1.8p-1075", 0x1p-1074}, {"0x1p-5000", 0.0}, {"1e400", HUGE_VAL}, {"1e+400", HUGE_VAL},
	    {"-1e-400", -0.0}, {"1" + zeros, HUGE_VAL}, {"1" + zeros + "e-400", 1.0}, {"0." + zeros + "1", 0.0},
	    {"0." + zeros + "1e401", 1.0}, {"0." + zeros + "1e5", 0.0}, {"1" + zeros + ".5e-5", HUGE_VAL},
	    {"0x1" + zeros + "p-9", HUGE_VAL}, {"0x." + zeros + "1p9", 0.0}, {"1e99999999999999999999", HUGE_VAL},
	    {"0.1e-99999999999999999999", 0.0}};
	for (const auto& [text, expected] : c_Rows)
	{
		double value = 7.0;
		EXPECT_EQ(::NumberText::ScanReal(text, value), text.size()) << text;
		EXPECT_EQ(std::bit_cast<std::uint64_t>(value), std::bit_cast<std::uint64_t>(expected)) << text;
	}
}

TEST_F(NumberText, ScansRandomTextAsTheLibraryDoes)
{
	std::mt19937 generator(20);
	// Of anything; and plain numbers of up to more digits than any double needs, also nearly halfway between two.
	const std::string c_Alphabets[] = {"0123456789..ee+-xXpPaf inI", "0123456789", "0009"};
	for (int round = 0; round < 200000; ++round)
	{
		const std::string& rAlphabet = c_Alphabets[round % 3];
		std::string text(generator() % (round % 3 == 0 ? 9 : 27), ' ');
		for (char& rByte : text)
			rByte = rAlphabet[generator() % rAlphabet.size()];
		if (round % 3 != 0)
			text.insert(generator() % (text.size() + 1), 1, '.');
		ExpectSameScan(text);
	}
	for (int round = 0; round < 40000; ++round)
	{
		const std::uint64_t even = (std::uint64_t(1) << 53) + 2 * (generator() % (std::uint64_t(1) << 31));
		ExpectSameScan(std::to_string(even + generator() % 3));
		ExpectSameScan(std::to_string(even / 2) + (round % 2 == 0 ? ".5" : ".49999"));
	}
}

TEST_F(NumberText, PrintsAsPrintf)
{
	std::mt19937_64 generator(21);
	for (int round = 0; round < 150000; ++round)
	{
		// Of all sizes, ties of few bits, and of the sizes that files are full of.
		const double value = round % 3 == 0 ? std::bit_cast<double>(generator())
		    : round % 3 == 1                ? std::ldexp(double(generator() % 2000001) - 1e6, -int(generator() % 70))
		                                    : std::pow(10.0, double(generator() % 22000) / 1000.0 - 5.0);
		if (!std::isfinite(value))
			continue;
		char buffer[512];
		std::snprintf(buffer, sizeof(buffer), "%.17g", value);
		ASSERT_EQ(::NumberText::PrintG17(value), buffer);
		double back = 0.0;
		ASSERT_TRUE(::NumberText::ScanWholeReal(buffer, back));
		ASSERT_EQ(back, value);
		std::snprintf(buffer, sizeof(buffer), "%f", value);
		ASSERT_EQ(::NumberText::PrintF(value), buffer);
	}
}

TEST_F(NumberText, PrintsWhatIsNotFiniteAsExpressionsReadIt)
{
	const double infinity = std::numeric_limits<double>::infinity();
	const double notANumber = std::numeric_limits<double>::quiet_NaN();
	EXPECT_EQ(::NumberText::PrintG17(infinity), "1.#INF");
	EXPECT_EQ(::NumberText::PrintF(-infinity), "-1.#INF");
	EXPECT_EQ(::NumberText::PrintG17(notANumber), "1.#IND");
	EXPECT_EQ(::NumberText::PrintF(std::copysign(notANumber, -1.0)), "-1.#IND");
}

} // namespace
