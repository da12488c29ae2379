#include "../UtilsFileSystem/Log.h"

#include "fbxsdk/container/Arrays.h"
#include "fbxsdk/container/FileKind.h"
#include "fbxsdk/scene/ArraySource.h"

#include "FbxFileBuilder.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <numeric>

using namespace FbxFormat;
using namespace FbxTest;
using namespace std::string_literals;

namespace
{

/// A file with one record "A" with that value, and its tree.
struct VArrayFile
{
	VArrayFile(const VTestForm& i_rForm, const VTestValue& i_rValue) : m_Bytes(Write(i_rForm, {{"A", {i_rValue}, {}}}))
	{
		m_Tree.Read(m_Bytes, DetectFileKind(m_Bytes));
	}
	template <typename T>
	bool Read(VArrayNumbers<T>& o_rNumbers, std::uint64_t i_Budget = Limits::c_DecodedBytes) const
	{
		VDecodeBudget budget{i_Budget};
		return ReadArray(m_Tree, m_Tree.Find(VElementTree::c_Root, "A"), budget, o_rNumbers);
	}
	std::string m_Bytes;
	VElementTree m_Tree;
};

template <typename T>
std::string ArrayHeader(char i_Type, T i_Count, std::uint32_t i_Encoding, std::size_t i_Size)
{
	return Bytes(i_Type, std::uint32_t(i_Count), i_Encoding, std::uint32_t(i_Size));
}

TEST(Arrays, GiveTheSameNumbersFromEveryForm)
{
	VNumbers numbers(5000);
	std::iota(numbers.begin(), numbers.end(), -2000.0);
	for (const VTestForm& rForm : c_Forms)
	{
		const VArrayFile file(rForm, numbers);
		VArrayNumbers<double> reals;
		EXPECT_TRUE(file.Read(reals)) << rForm.m_pName;
		EXPECT_EQ(VNumbers(reals.begin(), reals.end()), numbers) << rForm.m_pName;
		VArrayNumbers<std::int32_t> integers;
		EXPECT_TRUE(file.Read(integers)) << rForm.m_pName;
		EXPECT_EQ(std::vector<double>(integers.begin(), integers.end()), numbers) << rForm.m_pName;
	}
}

TEST(Arrays, ConvertEveryType)
{
	const auto plain = [](char i_Type, const std::string& i_rItems, std::size_t i_Count)
	{ return VRaw{ArrayHeader(i_Type, i_Count, 0, i_rItems.size()) + i_rItems}; };
	const std::pair<VRaw, VNumbers> rows[]{{plain('f', Bytes(1.5f, -2.0f), 2), {1.5, -2.0}},
	    {plain('i', Bytes(7, -8), 2), {7.0, -8.0}}, {plain('l', Bytes(std::int64_t(1) << 40), 1), {1099511627776.0}},
	    {plain('b', "\1\xff"s, 2), {1.0, -1.0}}, {plain('c', "\3", 1), {3.0}}, {plain('z', "\4", 1), {4.0}},
	    {plain('y', Bytes(std::int16_t(-300)), 1), {-300.0}}, {plain('d', "", 0), {}}};
	for (const auto& [value, expected] : rows)
	{
		VArrayNumbers<double> numbers;
		EXPECT_TRUE(VArrayFile(c_Forms[2], value).Read(numbers)) << value.m_Bytes[0];
		EXPECT_EQ(VNumbers(numbers.begin(), numbers.end()), expected) << value.m_Bytes[0];
	}
	VArrayNumbers<std::int32_t> integers;
	EXPECT_TRUE(VArrayFile(c_Forms[4], VNumbers{1e300, -3.7, 2147483647.0}).Read(integers));
	EXPECT_EQ(integers, (VArrayNumbers<std::int32_t>{0, -3, 2147483647}));
}

struct VDamageRow
{
	const char* m_pName;
	VTestValue m_Value;
	/// Refused when the file is read already, not only when the array is.
	bool m_bAtOnce;
	std::uint64_t m_Budget = Limits::c_DecodedBytes;
};

void PrintTo(const VDamageRow& i_rRow, std::ostream* o_pStream)
{
	*o_pStream << i_rRow.m_pName;
}

class DamagedArray : public testing::TestWithParam<VDamageRow>
{
};

TEST_P(DamagedArray, IsRefused)
{
	const VArrayFile file(c_Forms[1], GetParam().m_Value);
	EXPECT_EQ(!file.m_Tree.Error().empty(), GetParam().m_bAtOnce);
	VArrayNumbers<double> numbers{1.0};
	// What was refused at once counts as a record without values.
	EXPECT_EQ(file.Read(numbers, GetParam().m_Budget), GetParam().m_bAtOnce);
	EXPECT_TRUE(numbers.empty());
	EXPECT_LT(numbers.capacity() * sizeof(double), 2'000'000u);
}

const std::string c_Zeros = Deflate(std::string(1'000'000, '\0'));

INSTANTIATE_TEST_SUITE_P(Rows, DamagedArray,
    testing::Values(VDamageRow{"FourBillionPlain", VRaw{ArrayHeader('d', -1, 0, 8) + Bytes(1.0)}, true},
        VDamageRow{"FourBillionDeflated", VRaw{ArrayHeader('d', -1, 1, c_Zeros.size()) + c_Zeros}, true},
        VDamageRow{"BytesBeyondRecord", VRaw{ArrayHeader('d', 2, 0, 16) + Bytes(1.0)}, true},
        VDamageRow{"UnknownEncoding", VRaw{ArrayHeader('d', 1, 2, 8) + Bytes(1.0)}, true},
        VDamageRow{"BombOfMoreThanItClaims", VRaw{ArrayHeader('d', 10, 1, c_Zeros.size()) + c_Zeros}, false},
        VDamageRow{"LessThanItClaims", VRaw{ArrayHeader('d', 125'001, 1, c_Zeros.size()) + c_Zeros}, false},
        VDamageRow{"NoStream", VRaw{ArrayHeader('d', 1, 1, 8) + "notdefla"}, false},
        VDamageRow{"BeyondBudget", VRaw{ArrayHeader('d', 125'000, 1, c_Zeros.size()) + c_Zeros}, false, 999'999},
        VDamageRow{
            "ConvertedBeyondBudget", VRaw{ArrayHeader('i', 250'000, 1, c_Zeros.size()) + c_Zeros}, false, 2'500'000},
        VDamageRow{"TextAsNumber", VTestValue("12"s), false}),
    [](const auto& i_rInfo) { return i_rInfo.param.m_pName; });

TEST(Arrays, OfTextMustHoldTheirCount)
{
	for (const char* pText : {"*3 { a: 1,2 }", "*1 { a: 1,2 }", "*2 { a: 1,x }"})
	{
		const std::string bytes = "; FBX 7.4.0\nA: "s + pText;
		VElementTree tree;
		ASSERT_TRUE(tree.Read(bytes, DetectFileKind(bytes)));
		VDecodeBudget budget;
		VArrayNumbers<double> numbers;
		EXPECT_FALSE(ReadArray(tree, 1, budget, numbers)) << pText;
	}
}

/// Each spelling as if the general scanner had read it.
TEST(Arrays, OfTextHaveNumbersOfEverySpelling)
{
	const std::string numbers = " 7,-8 ,2147483648,+3,.5,5.,-0,1e2,0x1p4,1e400,-1.#INF,1e-400,-2.9999999";
	for (const std::string& rText : {"*13 { a:" + numbers + " }", numbers})
	{
		const std::string bytes = "; FBX 7.4.0\nA:" + rText + "\n";
		VElementTree tree;
		ASSERT_TRUE(tree.Read(bytes, DetectFileKind(bytes))) << tree.Error();
		VDecodeBudget budget;
		VArrayNumbers<double> reals;
		EXPECT_TRUE(ReadArray(tree, 1, budget, reals));
		const double infinity = std::numeric_limits<double>::infinity();
		EXPECT_EQ(VNumbers(reals.begin(), reals.end()),
		    (VNumbers{7, -8, 2147483648, 3, 0.5, 5, 0, 100, 16, infinity, -infinity, 0, -2.9999999}));
		EXPECT_FALSE(std::signbit(reals[6])) << "a whole number has no sign when it is 0";
		VArrayNumbers<std::int32_t> integers;
		EXPECT_TRUE(ReadArray(tree, 1, budget, integers));
		EXPECT_EQ(integers, (VArrayNumbers<std::int32_t>{7, -8, INT32_MIN, 3, 0, 5, 0, 100, 16, 0, 0, 0, -2}));
	}
}

/// Enough for two threads: the same as one after another, whichever is faster.
TEST(Arrays, TogetherAreReadAsOneByOne)
{
	std::vector<VTestRecord> records;
	for (int i = 0; i < 40; ++i)
	{
		VNumbers numbers(2000);
		for (std::size_t k = 0; k < numbers.size(); ++k)
			numbers[k] = std::sin(double(k * (i + 1)));
		VRaw raw = PackedArray('d', 2000, true, {reinterpret_cast<const char*>(numbers.data()), 16'000});
		if (i % 7 == 3)
			raw.m_Bytes.back() ^= 1;
		records.push_back({"A" + std::to_string(i), {raw}, {}});
	}
	const std::string bytes = Write(c_Forms[1], records);
	VElementTree tree;
	ASSERT_TRUE(tree.Read(bytes, DetectFileKind(bytes)));
	// The last two are beyond the budget.
	VDecodeBudget budget{38 * 16'000};
	VDecodeBudget other = budget;
	std::vector<VArrayNumbers<double>> numbers(records.size());
	std::vector<VDecodeJob> jobs;
	for (std::size_t i = 0; i < records.size(); ++i)
		jobs.push_back({{&tree, &budget, VElementIndex(i + 1)}, "owner", &numbers[i]});
	VTestLog log("FBXIO");
	Decode(jobs);
	std::vector<std::string> messages;
	for (std::size_t i = 0; i < records.size(); ++i)
	{
		VArrayNumbers<double> expected;
		EXPECT_EQ(jobs[i].m_bSound, ReadArray(tree, VElementIndex(i + 1), other, expected)) << i;
		EXPECT_EQ(jobs[i].m_bSound, i % 7 != 3 && i < 38) << i;
		EXPECT_EQ(numbers[i], expected) << i;
		if (!jobs[i].m_bSound)
			messages.push_back(
			    "3 Array " + records[i].m_Name + " of owner left out because it is damaged or too large");
	}
	EXPECT_EQ(log.Take(), messages);
	EXPECT_EQ(budget.m_BytesLeft, 0u);
}

} // namespace
