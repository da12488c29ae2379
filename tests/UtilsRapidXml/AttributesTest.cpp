#include "UtilsRapidXml/Attributes.h"
#include "UtilsRapidXml/ReaderNode.h"

#include <gtest/gtest.h>

#include <clocale>
#include <cmath>
#include <limits>
#include <locale>
#include <stdexcept>

namespace
{

using namespace UtilsRapidXml;

/// Reads attribute A of an element E with the given text; returns the errors, with "read" before them if it was read.
template <typename TRead>
std::string Read(const std::string& i_rText, const TRead& i_rRead)
{
	VDocument document;
	std::string error;
	EXPECT_TRUE(document.Parse("<E A='" + i_rText + "'/>", error)) << error;
	VReaderNode root(document, false);
	std::string result;
	root.DeclareElement("E", "", 1, 1);
	root.ProcessElements([&](INode& io_rNode) { result = i_rRead(io_rNode) ? "read" : ""; });
	for (const std::string& rError : root.GetGlobalInfo()->m_Errors.GetTexts())
		result += rError;
	return result;
}

const std::string c_NotInterpreted = "E node's A attribute could not be interpreted";
const std::string c_IncorrectCount = "E node's A attribute had incorrect number of components";

template <typename T>
void ExpectValue(const std::string& i_rText, T i_Untouched, T i_Expected, const std::string& i_rResult = "read")
{
	T value = i_Untouched;
	EXPECT_EQ(Read(i_rText,
	              [&](INode& io_rNode) {
		              return ReadAttribute(io_rNode, {"A", ""}, value);
	              }),
	    i_rResult)
	    << '"' << i_rText << '"';
	EXPECT_EQ(value, i_Expected) << '"' << i_rText << '"';
}

template <typename T>
void ExpectRefused(const std::string& i_rText)
{
	ExpectValue<T>(i_rText, T{}, T{}, c_NotInterpreted);
}

TEST(Attributes, Reals)
{
	ExpectValue("1.5", 0.0, 1.5);
	ExpectValue(" -2e3", 0.0, -2000.0);
	ExpectValue("+.5", 0.0, 0.5);
	ExpectValue("1e-400", 7.0, 0.0);
	ExpectValue("4.9406564584124654e-324", 0.0, std::numeric_limits<double>::denorm_min());
	ExpectValue("1.7976931348623157e308", 0.0, std::numeric_limits<double>::max());
	for (const char* pText :
	    {"", " ", "1 ", "1,5", "1.5x", "1 2", "abc", "nan", "NaN", "inf", "-inf", "Infinity", "1e400", "-1e400", "1e"})
		ExpectRefused<double>(pText);
}

/// In the language of the environment, which may write a comma and group digits.
TEST(Attributes, AreTheSameInEveryLanguage)
{
	const std::string before = std::setlocale(LC_ALL, nullptr);
	const std::locale global;
	try
	{
		std::locale::global(std::locale(""));
	}
	catch (const std::runtime_error&)
	{
		GTEST_SKIP() << "the environment's language is not installed";
	}
	ExpectValue("1234.5", 0.0, 1234.5);
	ExpectRefused<double>("1234,5");
	ExpectRefused<double>("1.234.5");
	ExpectValue<std::int32_t>("12345", 0, 12345);
	EXPECT_EQ(ToText({3000, 50000}), "3000.50000");
	VMessages messages;
	messages.Add("%1% of %2%", 1234567, 0.5);
	EXPECT_EQ(messages.GetTexts()[0], "1234567 of 0.5");
	std::locale::global(global);
	std::setlocale(LC_ALL, before.c_str());
}

TEST(Attributes, Integers)
{
	ExpectValue<std::int32_t>("-2147483648", 0, std::numeric_limits<std::int32_t>::min());
	ExpectValue<std::int32_t>(" +12", 0, 12);
	ExpectValue<std::uint32_t>("4294967295", 0, 0xFFFFFFFFu);
	ExpectValue<std::uint8_t>("255", 0, 255);
	for (const char* pText : {"", "2147483648", "1.0", "1 ", "0x10", "+-1", "++1", "+", "-"})
		ExpectRefused<std::int32_t>(pText);
	for (const char* pText : {"-1", "4294967296", ""})
		ExpectRefused<std::uint32_t>(pText);
	for (const char* pText : {"256", "-1"})
		ExpectRefused<std::uint8_t>(pText);
}

TEST(Attributes, BoolsVersionsTextsAndTables)
{
	ExpectValue("true", false, true);
	ExpectValue("false", true, false);
	for (const char* pText : {"True", "1", "", " true"})
		ExpectRefused<bool>(pText);

	ExpectValue("3.5", VVersion{}, VVersion{3, 5});
	ExpectValue("10.0", VVersion{}, VVersion{10, 0});
	for (const char* pText : {"", "3", "3.", ".5", "-1.0", "3.5.1", "3.5 ", "3.-5", "+3.5", "99999999999.0"})
		ExpectRefused<VVersion>(pText);

	ExpectValue<std::string>(" as it is ", "", " as it is ");

	enum EKind
	{
		EOne = 3,
		ETwo
	};
	static const VEnum<EKind> s_Kinds = VEnum<EKind>("TYPE_KIND").Add(EOne, "one").Add(ETwo, "two");
	EKind kind = EOne;
	const auto read = [&](INode& io_rNode) { return ReadAttribute(io_rNode, {"A", ""}, s_Kinds, kind); };
	EXPECT_EQ(Read("two", read), "read");
	EXPECT_EQ(kind, ETwo);
	EXPECT_EQ(Read("Two", read), c_NotInterpreted);
	EXPECT_EQ(kind, ETwo);
}

TEST(Attributes, AbsentOnesLeaveTheValueAlone)
{
	double value = 7.0;
	std::vector<double> list = {7.0};
	EXPECT_EQ(Read("1", [&](INode& io_rNode) { return ReadAttribute(io_rNode, {"B", ""}, value); }), "");
	EXPECT_EQ(Read("1",
	              [&](INode& io_rNode) {
		              return ReadList(io_rNode, {"B", "", "xsd:string", true}, 1, list);
	              }),
	    "E element missing required attribute B");
	EXPECT_EQ(value, 7.0);
	EXPECT_EQ(list, std::vector<double>{7.0});
}

TEST(Attributes, Lists)
{
	using VList = std::vector<double>;
	struct VRow
	{
		const char* m_pText;
		std::size_t m_Count;
		std::size_t m_Offset;
		VList m_Before;
		VList m_After;
		std::string m_Result;
	};
	const VRow c_Rows[] = {
	    {"1 2 3", 3, 0, {}, {1, 2, 3}, "read"},
	    {"  1   -2e0 &#9;&#10;3  ", 3, 0, {}, {1, -2, 3}, "read"},
	    {"1\n2", 2, 0, {9, 9, 9}, {1, 2, 9}, "read"},
	    {"1 2", 2, 3, {9}, {9, 0, 0, 1, 2}, "read"},
	    {"1 2", 2, 1, {9, 9, 9, 9}, {9, 1, 2, 9}, "read"},
	    {"", 0, 0, {9}, {9}, "read"},
	    {"", 1, 0, {9}, {9}, c_IncorrectCount},
	    {"1 2", 3, 0, {9}, {9}, c_IncorrectCount},
	    {"1 2 3 4", 3, 0, {9}, {9}, c_IncorrectCount},
	    {"1 x 3", 3, 0, {9}, {9}, c_NotInterpreted},
	    {"1 * 3", 3, 0, {9}, {9}, c_NotInterpreted},
	    {"1 1e999 3", 3, 0, {9}, {9}, c_NotInterpreted},
	    {"1,2,3", 1, 0, {9}, {9}, c_NotInterpreted},
	};
	for (const VRow& rRow : c_Rows)
	{
		VList list = rRow.m_Before;
		EXPECT_EQ(Read(rRow.m_pText,
		              [&](INode& io_rNode) {
			              return ReadList(io_rNode, {"A", ""}, rRow.m_Count, list, rRow.m_Offset);
		              }),
		    rRow.m_Result)
		    << rRow.m_pText;
		EXPECT_EQ(list, rRow.m_After) << rRow.m_pText;
	}

	std::vector<std::int32_t> integers;
	EXPECT_EQ(Read("1 -2 300", [&](INode& io_rNode) { return ReadList(io_rNode, {"A", ""}, 3, integers); }), "read");
	EXPECT_EQ(integers, (std::vector<std::int32_t>{1, -2, 300}));
	EXPECT_EQ(Read("1 2.5",
	              [&](INode& io_rNode) {
		              return ReadList(io_rNode, {"A", ""}, 2, integers);
	              }),
	    c_NotInterpreted);
	double array[2] = {};
	EXPECT_EQ(Read("1 2", [&](INode& io_rNode) { return ReadList(io_rNode, {"A", ""}, 2, array); }), "read");
	EXPECT_EQ(array[1], 2.0);
}

TEST(Attributes, Placeholders)
{
	constexpr double c_Unset = std::numeric_limits<double>::max();
	std::vector<double> list = {9};
	std::vector<bool> placeholders;
	const auto read = [&](INode& io_rNode) {
		return ReadListWithPlaceholders(io_rNode, {"A", ""}, 4, list, placeholders, 1);
	};
	EXPECT_EQ(Read("1 * ? 2", read), "read");
	EXPECT_EQ(list, (std::vector<double>{9, 1, c_Unset, c_Unset, 2}));
	EXPECT_EQ(placeholders, (std::vector<bool>{false, true, true, false}));
	EXPECT_EQ(Read("1 ** 2 3", read), c_NotInterpreted);
	EXPECT_EQ(Read("* *", read), c_IncorrectCount);
	EXPECT_EQ(list.size(), 5u);
	EXPECT_EQ(placeholders.size(), 4u);
}

} // namespace
