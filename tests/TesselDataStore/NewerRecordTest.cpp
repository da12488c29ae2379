#include "TesselDataStore/StoredValueOfFields.h"

#include <gtest/gtest.h>

namespace
{

enum class EColourOld : std::uint8_t
{
	ERed,
	EBlue
};

enum class EColourNew : std::uint8_t
{
	EBlue,
	EGreen,
	ERed
};

struct VPartOld
{
	std::string m_Name = "unset";
	double m_Length = -1.0;
	bool operator==(const VPartOld&) const = default;
};

/// A member more at the end, at the start and in the middle.
struct VPartNew
{
	std::vector<std::string> m_Tags;
	std::string m_Name;
	std::uint16_t m_Flags = 0;
	std::array<double, 3> m_Place{};
	double m_Length = 0.0;
	std::vector<double> m_Curve;
	bool operator==(const VPartNew&) const = default;
};

struct VOld
{
	std::uint32_t m_Id = 0;
	std::vector<VPartOld> m_Parts;
	EColourOld m_Colour = EColourOld::ERed;
	bool operator==(const VOld&) const = default;
};

struct VNew
{
	std::vector<VPartNew> m_Parts;
	EColourNew m_Colour = EColourNew::EGreen;
	std::uint32_t m_Id = 0;
	VPartNew m_Main;
	bool operator==(const VNew&) const = default;
};

} // namespace

namespace CoreOrlexTypes
{

template <>
inline constexpr auto c_Enumeration<EColourOld> = VEnumeration<EColourOld, 2>(
    "EColour", "", {{EColourOld::ERed, "Red"}, {EColourOld::EBlue, "Blue"}});
template <>
inline constexpr auto c_Enumeration<EColourNew> = VEnumeration<EColourNew, 3>(
    "EColour", "", {{EColourNew::EBlue, "Blue"}, {EColourNew::EGreen, "Green"}, {EColourNew::ERed, "Red"}});
template <>
inline constexpr auto c_Fields<VPartOld> = Fields(
    VField("Name", &VPartOld::m_Name), VField("Length", &VPartOld::m_Length));
template <>
inline constexpr auto c_Fields<VPartNew> = Fields(VField("Tags", &VPartNew::m_Tags), VField("Name", &VPartNew::m_Name),
    VField("Flags", &VPartNew::m_Flags), VField("Place", &VPartNew::m_Place), VField("Length", &VPartNew::m_Length),
    VField("Curve", &VPartNew::m_Curve));
template <>
inline constexpr auto c_Fields<VOld> = Fields(
    VField("Id", &VOld::m_Id), VField("Parts", &VOld::m_Parts), VField("Colour", &VOld::m_Colour));
template <>
inline constexpr auto c_Fields<VNew> = Fields(VField("Parts", &VNew::m_Parts), VField("Colour", &VNew::m_Colour),
    VField("Id", &VNew::m_Id), VField("Main", &VNew::m_Main));

} // namespace CoreOrlexTypes

namespace
{

using TesselDataStore::FromVariant;
using TesselDataStore::ToVariant;

VNew New()
{
	const VPartNew first{{"a", ""}, "hip", 3, {1, 2, 3}, 4.5, {6, 7}};
	const VPartNew second{{}, "", 0, {}, -1.5, {8}};
	return {{first, second}, EColourNew::EBlue, 42, first};
}

TEST(NewerRecord, MembersMatchByName)
{
	VOld old;
	ASSERT_TRUE(FromVariant(ToVariant(New()), old));
	EXPECT_EQ(old, (VOld{42, {{"hip", 4.5}, {"", -1.5}}, EColourOld::EBlue}));
}

TEST(NewerRecord, AnOlderOneLeavesDefaults)
{
	VNew read = New();
	ASSERT_TRUE(FromVariant(ToVariant(VOld{7, {{"toe", 2.0}}, EColourOld::ERed}), read));
	VPartNew part;
	part.m_Name = "toe";
	part.m_Length = 2.0;
	EXPECT_EQ(read, (VNew{{part}, EColourNew::ERed, 7, {}}));
}

TEST(NewerRecord, CutAnywhereIsRefused)
{
	const NVX::IO::VVariant whole = ToVariant(New());
	VOld old;
	for (std::size_t size = 0; size < whole.m_Bytes.size(); ++size)
		EXPECT_FALSE(FromVariant({whole.m_pSchema, whole.m_Bytes.substr(0, size)}, old)) << size;
	EXPECT_EQ(old, VOld());
}

TEST(NewerRecord, ANameThatIsUnknownHereIsNoValue)
{
	VNew value = New();
	value.m_Colour = EColourNew::EGreen;
	VOld old;
	EXPECT_FALSE(FromVariant(ToVariant(value), old));
}

TEST(NewerRecord, AMemberThatChangedItsTypeIsRefused)
{
	NVX::IO::ISchema schema = *TesselDataStore::SchemaOf<VPartOld>();
	schema.m_Children[1].m_pSchema = TesselDataStore::SchemaOf<std::uint64_t>();
	VPartOld part;
	EXPECT_FALSE(FromVariant({GetUniqueSchema(schema), ToVariant(VPartOld()).m_Bytes}, part));
}

TEST(NewerRecord, UnknownNeighboursAreSkippedInOneMove)
{
	const auto pReader = TesselDataStore::Detail::MakeReader<VPartOld>(*TesselDataStore::SchemaOf<VPartNew>());
	const auto& rRecord = dynamic_cast<const TesselDataStore::Detail::VReadRecord&>(*pReader);
	// Tags, Name, Flags with Place, Length, Curve.
	EXPECT_EQ(rRecord.m_Steps.size(), 5u);
}

} // namespace
