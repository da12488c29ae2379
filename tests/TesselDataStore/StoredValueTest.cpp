#include "CoreOrlexTypes/RandomValue.h"

#include "TesselDataStore/StoredValueOfFields.h"
#include "TesselDataStore/ValueText.h"

#include <gtest/gtest.h>

namespace
{

using namespace TesselDataStore;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using NVX::IO::EType;
using NVX::IO::VSchemaPointer;
using NVX::IO::VVariant;

std::string Hex(const std::string& i_rBytes)
{
	std::string text;
	for (const char byte : i_rBytes)
		((text += "0123456789abcdef"[byte >> 4 & 15]) += "0123456789abcdef"[byte & 15]);
	return text;
}

template <typename T>
void ExpectBytes(const T& i_rValue, EType i_Type, const char* i_pHex, const std::string& i_rText)
{
	const VVariant variant = ToVariant(i_rValue);
	EXPECT_EQ(variant.m_pSchema, NVX::IO::GetUniquePodSchema(i_Type));
	EXPECT_EQ(Hex(variant.m_Bytes), i_pHex);
	EXPECT_EQ(ValueText(variant), i_rText);
	T back{};
	EXPECT_TRUE(FromVariant(variant, back));
	EXPECT_EQ(back, i_rValue);
	EXPECT_EQ(NVX::IO::SizeOf(i_Type), i_Type == EType::EString ? 0 : variant.m_Bytes.size());
}

TEST(StoredValue, PlainTypesAreLittleEndian)
{
	ExpectBytes(true, EType::EBool, "01", "true");
	ExpectBytes<std::int8_t>(-2, EType::EInt8, "fe", "-2");
	ExpectBytes<std::int16_t>(-2, EType::EInt16, "feff", "-2");
	ExpectBytes<std::int32_t>(-2, EType::EInt32, "feffffff", "-2");
	ExpectBytes<std::int64_t>(-2, EType::EInt64, "feffffffffffffff", "-2");
	ExpectBytes<std::uint8_t>(200, EType::EUInt8, "c8", "200");
	ExpectBytes<std::uint16_t>(0x1234, EType::EUInt16, "3412", "4660");
	ExpectBytes<std::uint32_t>(0x12345678, EType::EUInt32, "78563412", "305419896");
	ExpectBytes<std::uint64_t>(1, EType::EUInt64, "0100000000000000", "1");
	ExpectBytes(1.5f, EType::EFloat32, "0000c03f", "1.5");
	ExpectBytes(-2.0, EType::EFloat64, "00000000000000c0", "-2");
	ExpectBytes<std::string>("", EType::EString, "00000000", "\"\"");
	ExpectBytes(std::string("a\0b", 3), EType::EString, "03000000610062", std::string("\"a\0b\"", 5));
	ExpectBytes<boost::filesystem::path>("/a/\xC3\xA4", EType::EString, "050000002f612fc3a4", "\"/a/\xC3\xA4\"");
}

TEST(StoredValue, RecordsFollowTheirFields)
{
	const VSchemaPointer& rpSchema = SchemaOf<VSubjectParametrised>();
	EXPECT_EQ(rpSchema->m_Type, EType::ENamedTuple);
	ASSERT_EQ(rpSchema->m_Children.size(), CoreOrlexTypes::c_FieldCount<VSubjectParametrised>);
	EXPECT_EQ(rpSchema->m_Children[0].m_Name, "Name");
	EXPECT_EQ(rpSchema->m_Children[0].m_Doc, "Subject name.");

	const CoreOrlexTypes::VColour colour{1, 2, 3, 255};
	const VVariant variant = ToVariant(colour);
	EXPECT_EQ(Hex(variant.m_Bytes), "010203ff");
	EXPECT_EQ(ValueText(variant), "{Red: 1, Green: 2, Blue: 3, Alpha: 255}");

	const VVariant kind = ToVariant(VSubjectParametrised::VJoint::EHinge);
	EXPECT_EQ(kind.m_pSchema->m_Type, EType::EEnum32);
	EXPECT_EQ(kind.m_pSchema->m_Name, "SubjectParametrised.Joint.EJointType");
	EXPECT_EQ(Hex(kind.m_Bytes), "03000000");
	EXPECT_EQ(ValueText(kind), "Hinge");
	VSubjectParametrised::VJoint::EJointType read = VSubjectParametrised::VJoint::EBall;
	EXPECT_FALSE(FromVariant({kind.m_pSchema, std::string("\x09\0\0\0", 4)}, read));
	EXPECT_EQ(read, VSubjectParametrised::VJoint::EBall);

	const VVariant lists = ToVariant(std::vector<std::array<std::uint16_t, 2>>{{1, 2}, {3, 4}});
	EXPECT_EQ(Hex(lists.m_Bytes), "020000000100020003000400");
	EXPECT_EQ(ValueText(lists), "[[1, 2], [3, 4]]");
}

template <typename T>
class StoredSubject : public testing::Test
{
};
using VSubjectTypes = testing::Types<VSubject, VSubjectParametrised, VSubjectApplicationData>;
TYPED_TEST_SUITE(StoredSubject, VSubjectTypes);

TYPED_TEST(StoredSubject, ComesBackEqual)
{
	for (unsigned seed = 0; seed < 20; ++seed)
	{
		TypeParam value;
		VRandomValue(seed).Fill(value);
		const VVariant variant = ToVariant(value);
		TypeParam back;
		ASSERT_TRUE(FromVariant(variant, back)) << seed;
		EXPECT_EQ(back, value) << seed;
		EXPECT_EQ(ToVariant(back), variant) << seed;
	}
}

TYPED_TEST(StoredSubject, IsRefusedAtEveryByte)
{
	TypeParam value;
	VRandomValue(3).Fill(value);
	const VVariant whole = ToVariant(value);
	TypeParam kept;
	VRandomValue(4).Fill(kept);
	TypeParam back = kept;
	for (std::size_t size = 0; size < whole.m_Bytes.size(); ++size)
	{
		const VVariant cut{whole.m_pSchema, whole.m_Bytes.substr(0, size)};
		ASSERT_FALSE(FromVariant(cut, back)) << size;
	}
	EXPECT_FALSE(FromVariant({whole.m_pSchema, whole.m_Bytes + '\0'}, back));
	EXPECT_EQ(back, kept);
	const std::string text = ValueText({whole.m_pSchema, whole.m_Bytes.substr(0, whole.m_Bytes.size() / 2 + 1)});
	EXPECT_TRUE(text.ends_with(" (Unexpected end of binary data)") || text.ends_with("(text is longer than the data)"));
}

TEST(StoredValue, CountsAreBoundedBeforeMemoryIsReserved)
{
	using VNumbers = std::vector<double>;
	const std::string most = "\xFF\xFF\xFF\xFF";
	VNumbers numbers{1.0};
	EXPECT_FALSE(FromVariant({SchemaOf<VNumbers>(), most + std::string(64, '\0')}, numbers));
	EXPECT_EQ(numbers, VNumbers{1.0});

	// Records of which no member is stored take no bytes, but memory.
	NVX::IO::ISchema empty;
	empty.m_Type = EType::ENamedTuple;
	const VSchemaPointer pEmpties = NVX::IO::ListSchema(GetUniqueSchema(empty));
	std::vector<VSubjectParametrised::VTarget> targets;
	EXPECT_FALSE(FromVariant({pEmpties, most}, targets));
	EXPECT_TRUE(FromVariant({pEmpties, std::string("\3\0\0\0", 4)}, targets));
	EXPECT_EQ(targets.size(), 3u);
	EXPECT_TRUE(FromVariant({pEmpties, std::string("\0\x10\0\0", 4)}, targets));
	EXPECT_FALSE(FromVariant({pEmpties, std::string("\1\x10\0\0", 4)}, targets));
	EXPECT_TRUE(ValueText({pEmpties, most}).ends_with("..."));
	EXPECT_LT(ValueText({pEmpties, most}).size(), 2 * c_MaxTextBytes);
}

TEST(StoredValue, AnotherTypeIsRefused)
{
	std::uint32_t number = 7;
	EXPECT_FALSE(FromVariant(ToVariant(1.0f), number));
	EXPECT_FALSE(FromVariant(ToVariant<std::int32_t>(1), number));
	EXPECT_FALSE(FromVariant(VVariant(), number));
	EXPECT_EQ(number, 7u);
	std::array<double, 3> three{};
	EXPECT_FALSE(FromVariant(ToVariant(std::array<double, 2>{}), three));
	EXPECT_FALSE(FromVariant(ToVariant(std::vector<double>(3)), three));
	std::vector<std::string> texts;
	EXPECT_FALSE(FromVariant(ToVariant(std::vector<double>()), texts));
	VSubject subject;
	EXPECT_FALSE(FromVariant(ToVariant(VSubjectParametrised()), subject));
}

} // namespace
