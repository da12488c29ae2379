#include "RandomValue.h"

#include "CoreOrlexTypes/Difference.h"

#include <gtest/gtest.h>

#include <limits>

namespace
{

using namespace CoreOrlexTypes;

/// The end of a struct that has exactly the described members in the described order: where a member is missing or
/// out of its place, this differs from the size of the type (or the type has padding there).
template <typename T>
constexpr std::size_t SizeOfFields()
{
	std::size_t end = 0;
	const auto place = [&](std::size_t i_Size, std::size_t i_Alignment)
	{ end = (end + i_Alignment - 1) / i_Alignment * i_Alignment + i_Size; };
	c_Fields<T>(
	    [&]<typename... TMember>(const VField<T, TMember>&...) { (place(sizeof(TMember), alignof(TMember)), ...); });
	place(0, alignof(T));
	return end;
}

template <typename... T>
constexpr bool c_bWhole = ((SizeOfFields<T>() == sizeof(T)) && ...);

static_assert(c_bWhole<VSubjectParametrised, VSubjectParametrised::VStaticParameter,
    VSubjectParametrised::VDynamicParameter, VSubjectParametrised::VSegment, VSubjectParametrised::VJoint,
    VSubjectParametrised::VMarker, VSubjectParametrised::VRotation, VSubjectParametrised::VTarget>);
static_assert(c_bWhole<VSubject, VSubject::VSegment, VSubject::VJoint, VSubject::VMarker, VSubject::VRotation,
    VSubject::VTarget>);
static_assert(c_bWhole<VSubjectApplicationData, VSubjectApplicationData::VMarker, VSubjectApplicationData::VJoint,
    VSubjectApplicationData::VSegment, VSubjectApplicationData::VStick, VSubjectApplicationData::VTarget, VColour,
    VSubjectRecord, VTextHeader>);

/// Calls the visitor once for each number, text or enumeration inside a value, and for each list.
template <typename T, typename TVisitor>
void ForEachLeaf(T& io_rValue, TVisitor&& i_rVisitor)
{
	if constexpr (CRecord<T>)
		ForEachField<T>([&](const auto& i_rField) { ForEachLeaf(io_rValue.*i_rField.pMember, i_rVisitor); });
	else if constexpr (requires { io_rValue.begin(); } && !std::is_same_v<T, std::string>)
	{
		for (auto& rElement : io_rValue)
			ForEachLeaf(rElement, i_rVisitor);
		if constexpr (requires { io_rValue.pop_back(); })
			i_rVisitor(io_rValue);
	}
	else
		i_rVisitor(io_rValue);
}

template <typename T>
class Equality : public testing::Test
{
};
using VTopLevelTypes = testing::Types<VSubjectParametrised, VSubject, VSubjectApplicationData, VSubjectRecord>;
TYPED_TEST_SUITE(Equality, VTopLevelTypes);

/// Each single difference counts, wherever it stands.
TYPED_TEST(Equality, SeesEveryLeaf)
{
	VRandomValue random(7);
	TypeParam value;
	random.Fill(value);
	TypeParam other = value;
	ASSERT_TRUE(value == other);
	std::size_t leaves = 0;
	ForEachLeaf(other,
	    [&](auto& io_rLeaf)
	    {
		    using VLeaf = std::remove_reference_t<decltype(io_rLeaf)>;
		    const VLeaf kept = io_rLeaf;
		    if constexpr (std::is_same_v<VLeaf, std::string>)
			    io_rLeaf += "x";
		    else if constexpr (requires { io_rLeaf.emplace_back(); })
			    io_rLeaf.emplace_back();
		    else if constexpr (std::is_same_v<VLeaf, double>)
			    io_rLeaf = std::isnan(kept) ? 0.0 : kept == 0.0 ? 1.0 : -kept;
		    else if constexpr (std::is_enum_v<VLeaf>)
			    io_rLeaf = VLeaf(int(kept) + 1);
		    else
			    io_rLeaf = VLeaf(kept ^ 1);
		    EXPECT_FALSE(value == other) << "leaf " << leaves;
		    io_rLeaf = kept;
		    ++leaves;
	    });
	EXPECT_TRUE(value == other);
	EXPECT_GT(leaves, 50u);
}

TEST(Equality, NotANumberEqualsItself)
{
	VSubjectParametrised a;
	a.m_TPoseConstraints = {std::numeric_limits<double>::quiet_NaN()};
	EXPECT_TRUE(a == VSubjectParametrised(a));
	VSubjectParametrised b = a;
	b.m_TPoseConstraints = {0.0};
	EXPECT_FALSE(a == b);
	EXPECT_FALSE(b == a);
}

TEST(Fields, EnumerationsAreSpeltByTheirNames)
{
	using VJoint = VSubjectParametrised::VJoint;
	EXPECT_EQ(c_Enumeration<VJoint::EJointType>.Name, "SubjectParametrised.Joint.EJointType");
	EXPECT_EQ(EnumeratorName(VJoint::EHardySpicer), "HardySpicer");
	EXPECT_EQ(EnumeratorName(VJoint::EJointType(7)), "");
	EXPECT_EQ(EnumeratorFromName<VJoint::EJointType>("BadJointType"), VJoint::EBadJointType);
	EXPECT_EQ(EnumeratorFromName<VJoint::EJointType>("ball"), std::nullopt);
	// The numbers are part of stored data.
	EXPECT_EQ(int(*EnumeratorFromName<VSubject::VTarget::ETargetType>("LocalRotationToWorldRotation")), 8);
	EXPECT_EQ(int(*EnumeratorFromName<VSubjectApplicationData::VJoint::EEulerOrder>("None")), 6);
}

TEST(Fields, DefaultsOfElements)
{
	const VSubjectParametrised::VSegment segment;
	EXPECT_EQ(segment.m_Joint.m_JointType, VSubjectParametrised::VJoint::EDummy);
	EXPECT_EQ(segment.m_ParentSegmentIndex, 0xFFFFFFFFu);
	for (const auto& rList : {segment.m_PreRotation, segment.m_PreTranslation})
		EXPECT_EQ(rList, (std::array<std::string, 3>{"0", "0", "0"}));
	EXPECT_EQ(segment.m_Bounds, (std::array<std::string, 6>{"0", "0", "0", "0", "0", "0"}));
	const VSubjectParametrised::VStaticParameter parameter;
	EXPECT_EQ(parameter.m_UserValue, std::numeric_limits<double>::max());
	EXPECT_EQ(parameter.m_Prior, std::numeric_limits<double>::max());
	EXPECT_EQ(VColour{}, ColourFromPattern(0xFF5D5D5Du));
	EXPECT_EQ(VSubjectApplicationData{}.m_SkinColourA, ColourFromPattern(0));
}

TEST(FirstDifference, NamesThePlace)
{
	VSubjectRecord record;
	record.m_SubjectParametrised.m_Segments.resize(4);
	record.m_SubjectParametrised.m_Segments[3].m_Joint.m_BindPose = {0.0, std::numeric_limits<double>::quiet_NaN()};
	VSubjectRecord other = record;
	EXPECT_EQ(FirstDifference(record, other), "");
	other.m_SubjectApplicationData.m_Colour.m_Alpha = 1;
	EXPECT_EQ(FirstDifference(record, other), "SubjectApplicationData.Colour.Alpha");
	other.m_SubjectParametrised.m_Segments[3].m_Joint.m_BindPose[1] = 0.0;
	EXPECT_EQ(FirstDifference(record, other), "SubjectParametrised.Segments[3].Joint.BindPose[1]");
	other.m_SubjectParametrised.m_Segments[2].m_PreRotation[1] = "0.0";
	EXPECT_EQ(FirstDifference(record, other), "SubjectParametrised.Segments[2].PreRotation[1]");
	other.m_SubjectParametrised.m_Segments.pop_back();
	EXPECT_EQ(FirstDifference(record, other), "SubjectParametrised.Segments");
}

} // namespace
