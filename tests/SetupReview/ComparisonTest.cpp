#include "../CoreOrlexTypes/RandomValue.h"

#include "CoreOrlexQRTIO/FieldsOfExtras.h"
#include "SetupReview/compare/Comparison.h"

#include <gtest/gtest.h>

#include <cmath>

namespace
{

using namespace CoreOrlexTypes;
using SetupReview::VSetup;

template <typename T>
void Change(T& io_rValue)
{
	if constexpr (std::is_same_v<T, std::string>)
		io_rValue += "x";
	else if constexpr (std::is_same_v<T, double>)
		io_rValue = io_rValue == 1.0 ? 2.0 : 1.0;
	else if constexpr (std::is_same_v<T, bool>)
		io_rValue = !io_rValue;
	else if constexpr (std::is_enum_v<T>)
		io_rValue = T(int(io_rValue) + 1);
	else
		io_rValue = T(io_rValue ^ 5);
}

/// Calls the visitor after each change of one number, text or enumeration, or of the length of one list, which it then
/// takes back.
template <typename T, typename TVisitor>
void ChangeEach(T& io_rValue, const std::string& i_rPath, TVisitor&& i_rVisitor)
{
	if constexpr (CRecord<T>)
		ForEachField<T>([&](const auto& i_rField)
		    { ChangeEach(io_rValue.*i_rField.pMember, i_rPath + "." + std::string(i_rField.Key), i_rVisitor); });
	else if constexpr (requires { io_rValue.begin(); } && !std::is_same_v<T, std::string>)
	{
		for (auto& rElement : io_rValue)
			ChangeEach(rElement, i_rPath + "[]", i_rVisitor);
		if constexpr (requires { io_rValue.pop_back(); })
		{
			const T kept = io_rValue;
			io_rValue.pop_back();
			i_rVisitor(i_rPath);
			io_rValue = kept;
		}
	}
	else
	{
		const T kept = io_rValue;
		Change(io_rValue);
		i_rVisitor(i_rPath);
		io_rValue = kept;
	}
}

/// One that a file could hold: two of everything, references in range.
VSetup Sound()
{
	VSetup setup;
	VRandomValue random(3);
	random.Fill(setup.m_Record.m_SubjectParametrised);
	random.Fill(setup.m_Record.m_SubjectApplicationData);
	random.Fill(setup.m_Extras);
	VSubjectParametrised& rSubject = setup.m_Record.m_SubjectParametrised;
	VSubjectApplicationData& rData = setup.m_Record.m_SubjectApplicationData;
	const auto two = [](auto& io_rList, const std::string& i_rName)
	{
		io_rList.resize(2);
		io_rList[1] = io_rList[0];
		for (std::size_t i = 0; i < 2; ++i)
			if constexpr (requires { io_rList[i].m_Name; })
				io_rList[i].m_Name = i_rName + std::to_string(i);
	};
	two(rSubject.m_StaticParameters, "Length");
	two(rSubject.m_DynamicParameters, "GlobalScale");
	two(rSubject.m_Segments, "Segment");
	two(rSubject.m_Markers, "Marker");
	two(rSubject.m_Rotations, "Rotation");
	two(rSubject.m_Targets, "");
	two(rData.m_Markers, "");
	two(rData.m_Segments, "");
	two(rData.m_Targets, "Target");
	two(rData.m_Sticks, "");
	two(setup.m_Extras.m_Segments, "Segment");
	two(setup.m_Extras.m_Markers, "Marker");
	two(setup.m_Extras.m_Targets, "Target");
	two(setup.m_Extras.m_DynamicSubspaces, "Subspace");
	rData.m_Sticks[0].m_MarkerIndexA = rData.m_Sticks[0].m_MarkerIndexB = 0;
	for (std::uint32_t i = 0; i < 2; ++i)
	{
		rSubject.m_Segments[i].m_SegmentIndex = rSubject.m_Segments[i].m_TreeDepth = i;
		rSubject.m_Segments[i].m_ParentSegmentIndex = i == 0 ? c_NoParent : 0;
		rSubject.m_Segments[i].m_PreTranslation = {"1*GlobalScale0", "2", "3"};
		rSubject.m_Segments[i].m_Joint.m_JointType = VSubjectParametrised::VJoint::EBall;
		rSubject.m_Segments[i].m_Joint.m_BindPose = {0.1, 0.2, 0.3};
		rSubject.m_Targets[i].m_SegmentIndices = {i};
		rSubject.m_Targets[i].m_MarkerIndices = rSubject.m_Targets[i].m_RotationObservationIndices = {i};
		rSubject.m_Targets[i].m_Type = VSubjectParametrised::VTarget::ELocalRotationToWorldRotation;
		rSubject.m_Targets[i].m_StateExpressions = {"0.1", "0.2", "0.3"};
	}
	return setup;
}

TEST(Comparison, NothingThatDiffersGoesUnmentioned)
{
	const VSetup setup = Sound();
	EXPECT_TRUE(SetupReview::CompareSetups(setup, setup).empty());
	VSetup other = setup;
	std::size_t count = 0;
	const std::string before = SetupReview::DescribeSetup(setup);
	const auto look = [&](const std::string& i_rPath)
	{
		++count;
		const auto changes = SetupReview::CompareSetups(setup, other);
		EXPECT_FALSE(changes.empty()) << i_rPath;
		for (const auto& rChange : changes)
			EXPECT_FALSE(rChange.m_Words.empty()) << i_rPath;
		EXPECT_FALSE(SetupReview::CompareSetups(other, setup).empty()) << i_rPath << ", the other way";
		EXPECT_TRUE(SetupReview::DescribeSetup(other) != before) << i_rPath;
	};
	ChangeEach(other.m_Record, "Record", look);
	ChangeEach(other.m_Extras, "Extras", look);
	EXPECT_GT(count, 300u);
}

TEST(Comparison, AnotherOrderIsTold)
{
	const VSetup setup = Sound();
	VSetup other = setup;
	std::swap(other.m_Record.m_SubjectParametrised.m_Targets[0], other.m_Record.m_SubjectParametrised.m_Targets[1]);
	std::swap(
	    other.m_Record.m_SubjectApplicationData.m_Targets[0], other.m_Record.m_SubjectApplicationData.m_Targets[1]);
	const auto changes = SetupReview::CompareSetups(setup, other);
	ASSERT_EQ(changes.size(), 1u);
	EXPECT_EQ(SetupReview::ChangeLine(changes[0]), "subject: the targets stand in another order");
}

/// A root says only what it did: turned, moved, or both. Other joints do one of them.
TEST(Comparison, APoseIsToldAsItDiffers)
{
	using VJoint = VSubjectParametrised::VJoint;
	const double right = std::acos(0.0);
	const struct
	{
		VJoint::EJointType m_Type;
		std::vector<double> m_Before;
		std::vector<double> m_After;
		const char* m_pWords;
	} rows[] = {{VJoint::EFree, {0, 0, 0, 10, 20, 1000}, {0, 0, 0, 10, 50, 1040}, "moved by 50.0 mm"},
	    {VJoint::EFree, {0, 0, 0, 10, 20, 1000}, {0, 0, right, 10, 20, 1000}, "turned by 90.0 degrees"},
	    {VJoint::EFree, {0, 0, 0, 10, 20, 1000}, {0, right, 0, 10, 20, 1007},
	        "turned by 90.0 degrees and moved by 7.0 mm"},
	    {VJoint::EBall, {0, 0, 0}, {right, 0, 0}, "turned by 90.0 degrees"},
	    {VJoint::EHardySpicer, {0.25, 0}, {0, right}, "turned by 90.0 degrees"},
	    {VJoint::EHinge, {0}, {-right}, "turned by 90.0 degrees"}, {VJoint::ESlider, {3}, {-4}, "moved by 7.0 mm"}};
	for (const auto& rRow : rows)
	{
		const auto posed = [&](const std::vector<double>& i_rPose)
		{
			VSetup setup = Sound();
			VJoint& rJoint = setup.m_Record.m_SubjectParametrised.m_Segments[0].m_Joint;
			rJoint.m_JointType = rRow.m_Type;
			rJoint.m_Mean = rJoint.m_BindPose = i_rPose;
			return setup;
		};
		const auto changes = SetupReview::CompareSetups(posed(rRow.m_Before), posed(rRow.m_After));
		ASSERT_EQ(changes.size(), 1u) << rRow.m_pWords;
		EXPECT_EQ(SetupReview::ChangeLine(changes[0]),
		    std::string("segment \"Segment0\": bind pose and mean ") + rRow.m_pWords);
	}
}

} // namespace
