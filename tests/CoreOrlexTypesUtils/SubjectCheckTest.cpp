#include "CheckedSubject.h"

#include "CoreOrlexTypesUtils/SubjectCheck.h"

namespace Checked
{

using namespace CoreOrlexTypesUtils;
using VTarget = VSubject::VTarget;
using VJoint = VSubject::VJoint;
using EJointType = VSubjectParametrised::VJoint::EJointType;

/// What the messages about the sizes of a type of target ask for; the covariance's is null where any size is right.
struct VAsked
{
	const char* m_pName;
	const char* m_pMarkers;
	const char* m_pRotations;
	const char* m_pState;
	const char* m_pCovariance;

	std::string Message(const std::string& i_rWhat, const std::string& i_rExpected) const
	{
		return "Incorrect " + i_rWhat + ", " + m_pName + " type expects " + i_rExpected;
	}
};

/// From ELocalPointToWorldPoint on.
const VAsked c_Asked[] = {
    {"ELocalPointToWorldPoint", "1 marker", "no rotation observations", "3", nullptr},
    {"ELocalPointToWorldPointGaussian", "1 marker", "no rotation observations", "3", "9"},
    {"ELocalPlaneToWorldPoint", "1 marker", "no rotation observations", "6", nullptr},
    {"ELocalPlaneToWorldPointGaussian", "1 marker", "no rotation observations", "6", "1"},
    {"ELocalLineToWorldPoint", "1 marker", "no rotation observations", "6", nullptr},
    {"ELocalLineToWorldPointGaussian", "1 marker", "no rotation observations", "6", "4"},
    {"ERigidBody", "at least 3 markers", "no rotation observations", "3*(MarkerCount+2)", "36 + 9*MarkerCount"},
    {"ElocalRotationToWorldRotation", "no markers", "1 rotation observation", "3", "0"},
    {"ELocalDirectionToWorldDirection", "no markers", "1 rotation observation", "3", "0"},
};

class SubjectCheck : public CheckedSubject
{
protected:
	/// What is told of a target of this type once it has been changed; it must fail.
	template <typename TChange>
	VTexts TargetMessages(int i_Type, TChange&& i_rChange)
	{
		VSubject subject = GoodSubject();
		i_rChange(subject.m_Targets[i_Type]);
		return Failing([&] { return CheckTarget(subject, i_Type); });
	}
};

TEST_F(SubjectCheck, GoodSubjectsPassInSilence)
{
	ExpectPasses([] { return CheckSubject({}); });
	ExpectPasses([] { return CheckSubject(GoodSubject()); });
	VSubject subject = GoodSubject();
	subject.m_Targets[VTarget::ELocalPointToWorldPointGaussian].m_Covariance.assign(9, 0.0);
	subject.m_Targets[VTarget::ERigidBody].m_Covariance.assign(63, 0.0);
	// The pose's own block is anything.
	subject.m_Targets[VTarget::ERigidBody].m_Covariance[0] = c_NaN;
	subject.m_Targets[VTarget::EBadTargetType] = {};
	subject.m_Targets[VTarget::ELocalDirectionToWorldDirection].m_State = {0.9995, 0, 0};
	subject.m_Targets[VTarget::ELocalPointToWorldPoint].m_ViewNormals = {{0, 0.6, 0.8}};
	subject.m_Targets[VTarget::ELocalPlaneToWorldPoint].m_ViewNormals = {{1 + 0.9e-6, 0, 0}};
	ExpectPasses([&] { return CheckSubject(subject); });
}

/// The first wrong size is told; once it is mended, the next.
TEST_F(SubjectCheck, SizesOfTargetsInTheirOrder)
{
	for (int type = 1; type < 10; ++type)
		for (const int change : {-1, 1})
		{
			SCOPED_TRACE(testing::Message() << type << ", " << change);
			const VAsked& rAsked = c_Asked[type - 1];
			const VTarget good = GoodTarget(VTarget::ETargetType(type));
			VTarget bad = good;
			const auto damage = [&](auto&... io_rList)
			{ (io_rList.resize(io_rList.empty() ? 2 : io_rList.size() + change), ...); };
			damage(bad.m_SegmentIndices, bad.m_State, bad.m_Covariance, bad.m_ViewNormals);
			// A body may have more.
			if (type != VTarget::ERigidBody || change < 0)
				damage(bad.m_MarkerIndices);
			if (type < VTarget::ELocalRotationToWorldRotation)
				damage(bad.m_RotationObservationIndices);
			const auto expect = [&](auto VTarget::*i_pList, const std::string& i_rMessage)
			{
				if (bad.*i_pList == good.*i_pList)
					return;
				EXPECT_EQ(TargetMessages(type, [&](VTarget& io_rTarget) { io_rTarget = bad; }), VTexts{i_rMessage});
				bad.*i_pList = good.*i_pList;
			};
			const auto expectSegmentsAndState = [&]
			{
				expect(&VTarget::m_SegmentIndices, rAsked.Message("number of parent segments", "1 segment"));
				expect(&VTarget::m_State, rAsked.Message("state size", std::string("size ") + rAsked.m_pState));
			};
			if (type == VTarget::ELocalDirectionToWorldDirection)
				expectSegmentsAndState();
			expect(&VTarget::m_MarkerIndices, rAsked.Message("number of markers", rAsked.m_pMarkers));
			expect(&VTarget::m_RotationObservationIndices,
			    rAsked.Message("number of rotation observations", rAsked.m_pRotations));
			expectSegmentsAndState();
			if (rAsked.m_pCovariance)
				expect(&VTarget::m_Covariance,
				    rAsked.Message("covariance size", std::string("size ") + rAsked.m_pCovariance));
			expect(&VTarget::m_ViewNormals, "Invalid target view normals");
		}
	// A fourth marker asks for more values.
	const VAsked& rBody = c_Asked[VTarget::ERigidBody - 1];
	EXPECT_EQ(TargetMessages(VTarget::ERigidBody, [](VTarget& io_rTarget) { io_rTarget.m_MarkerIndices.push_back(2); }),
	    VTexts{rBody.Message("state size", std::string("size ") + rBody.m_pState)});
}

TEST_F(SubjectCheck, TypesThatAskForARotationOnlyComplainOfAnotherNumber)
{
	for (const int type : {VTarget::ELocalRotationToWorldRotation, VTarget::ELocalDirectionToWorldDirection})
		for (const std::size_t count : {0, 2})
		{
			VSubject subject = GoodSubject();
			subject.m_Targets[type].m_RotationObservationIndices.resize(count);
			TakeLog();
			EXPECT_TRUE(CheckTarget(subject, type));
			const VAsked& rAsked = c_Asked[type - 1];
			EXPECT_EQ(TakeLog(), VTexts{rAsked.Message("number of rotation observations", rAsked.m_pRotations)});
		}
}

TEST_F(SubjectCheck, ValuesOfTargets)
{
	const std::string covariance = "Invalid target covariance matrix";
	const std::string normals = "Invalid target view normals";
	const std::string unit = "Direction should be a unit vector";
	const struct
	{
		int m_Type;
		void (*m_pChange)(VTarget&);
		VTexts m_Messages;
	} rows[] = {
	    {1, [](VTarget& io_r) { io_r.m_Type = VTarget::ETargetType(10); }, {"Unknown target type"}},
	    {1, [](VTarget& io_r) { io_r.m_Type = VTarget::ETargetType(-1); }, {"Unknown target type"}},
	    {2, [](VTarget& io_r) { io_r.m_Covariance[4] = -1; }, {covariance}},
	    {7, [](VTarget& io_r) { io_r.m_Covariance[36] = -1; }, {covariance}},
	    {7, [](VTarget& io_r) { io_r.m_Covariance[62] = c_Infinity; }, {covariance}},
	    {8, [](VTarget& io_r) { io_r.m_RotationCalibrationBehaviour = VTarget::EBadBehaviourType; },
	        {"Invalid rotation calibration behaviour"}},
	    {8, [](VTarget& io_r) { io_r.m_RotationTargetOrientation.resize(3); },
	        {"Incorrect rotation target orientation size. Expected 0. Actual 3"}},
	    {8, [](VTarget& io_r) { io_r.m_RotationCalibrationBehaviour = VTarget::EHingeLike; },
	        {"Incorrect rotation target orientation size. Expected 3. Actual 0 "}},
	    {9, [](VTarget& io_r) { io_r.m_State[2] = 1.001; }, {unit}},
	    {9, [](VTarget& io_r) { io_r.m_State[2] = 0.999; }, {unit}},
	    {9, [](VTarget& io_r) { io_r.m_State[1] = c_NaN; }, {unit}},
	    {1, [](VTarget& io_r) { io_r.m_ViewNormals[0][1] = 1 + 2e-6; }, {normals}},
	    {1, [](VTarget& io_r) { io_r.m_ViewNormals[0][2] = c_NaN; }, {normals}},
	};
	for (const auto& rRow : rows)
		EXPECT_EQ(TargetMessages(rRow.m_Type, rRow.m_pChange), rRow.m_Messages) << "row " << &rRow - rows;
	EXPECT_EQ(Failing([] { return CheckTarget(GoodSubject(), 10); }), VTexts{"Out-of-range target index 10"});

	// Indices, and that they come before the view normals.
	VTarget bad;
	bad.m_MarkerIndices = {3, 4};
	bad.m_RotationObservationIndices = {2};
	bad.m_SegmentIndices = {0xFFFFFFFF};
	bad.m_ViewNormals.resize(7);
	for (const auto& [pIndices, message] : {std::pair{&VTarget::m_MarkerIndices, "Out of range marker index 4"},
	         {&VTarget::m_RotationObservationIndices, "Out of range rotation observation index 2"},
	         {&VTarget::m_SegmentIndices, "Out of range segment index 4294967295"},
	         {&VTarget::m_SegmentIndices, "Invalid target view normals"}})
	{
		EXPECT_EQ(TargetMessages(0, [&](VTarget& io_rTarget) { io_rTarget = bad; }), VTexts{message});
		(bad.*pIndices).clear();
	}
}

TEST_F(SubjectCheck, AllDuplicatesOfMarkersAreTold)
{
	std::vector<VSubject::VMarker> markers(4);
	for (std::uint32_t i = 0; i < 4; ++i)
	{
		markers[i].m_MarkerId = i;
		markers[i].m_Name = std::to_string(i);
	}
	ExpectPasses([&] { return CheckMarkers(markers); });
	markers[1].m_Name = "0";
	markers[2].m_MarkerId = 0;
	markers[3].m_MarkerId = 1;
	markers[3].m_Name = "2%1%";
	markers.push_back(markers[3]);
	EXPECT_EQ(Failing([&] { return CheckMarkers(markers); }),
	    (VTexts{"Marker duplicate name: 0", "Marker duplicate id: 0", "Marker duplicate id: 1",
	        "Marker duplicate id: 1", "Marker duplicate name: 2%1%"}));
}

TEST_F(SubjectCheck, JointsTellEverything)
{
	const struct
	{
		EJointType m_Type;
		std::size_t m_Size;
	} types[] = {{EJointType::EFree, 6}, {EJointType::EBall, 3}, {EJointType::EHardySpicer, 2}, {EJointType::EHinge, 1},
	    {EJointType::ESlider, 1}, {EJointType::EDummy, 0}, {EJointType::EBadJointType, 0}, {EJointType(99), 0}};
	for (const auto& [type, size] : types)
	{
		SCOPED_TRACE(type);
		const VJoint good{"", type, {}, Diagonal(size, 1.0), VNumbers(size), VNumbers(size), Diagonal(size, 2.0)};
		ExpectPasses([&] { return CheckJoint(good); });
		VJoint joint = good;
		joint.m_Covariance.assign(size * size, 0.0);
		joint.m_RangeCentringState.clear();
		joint.m_RangeMatrix.clear();
		ExpectPasses([&] { return CheckJoint(joint); });

		joint = good;
		joint.m_Mean.emplace_back();
		joint.m_Covariance.emplace_back();
		joint.m_RangeCentringState.emplace_back();
		joint.m_RangeMatrix.emplace_back();
		EXPECT_EQ(Failing([&] { return CheckJoint(joint); }),
		    (VTexts{"Incorrent 'Mean' vector size.", "Incorrect 'Covariance' vector size.",
		        "Incorrect 'RangeCenteringState' vector size.", "Incorrect 'RangeMatrix' size."}));
		if (size == 0)
			continue;
		for (const double bad : {0.0, -1.0, c_NaN, c_Infinity})
		{
			// One by one, 0 is the matrix of all zeros.
			if (size == 1 && bad == 0.0)
				continue;
			joint = good;
			joint.m_Covariance = joint.m_RangeMatrix = Diagonal(size, 1.0);
			joint.m_Covariance.back() = joint.m_RangeMatrix.back() = bad;
			EXPECT_EQ(Failing([&] { return CheckJoint(joint); }),
			    (VTexts{"Invalid joint covariance matrix", "Invalid joint range matrix"}));
		}
		joint = good;
		joint.m_Mean.clear();
		joint.m_Covariance.clear();
		joint.m_RangeCentringState.clear();
		EXPECT_EQ(Failing([&] { return CheckJoint(joint); }),
		    (VTexts{"Incorrent 'Mean' vector size.", "Incorrect 'Covariance' vector size.",
		        "Inconsistent range information."}));
		joint = good;
		joint.m_RangeMatrix.clear();
		EXPECT_EQ(Failing([&] { return CheckJoint(joint); }), VTexts{"Inconsistent range information."});
	}
}

TEST_F(SubjectCheck, PlacesOfSegments)
{
	constexpr std::uint32_t c_None = CoreOrlexTypes::c_NoParent;
	const struct
	{
		/// Index, parent and depth of the root and of its child.
		std::uint32_t m_Places[2][3];
		const char* m_pMessage;
	} rows[] = {
	    {{{0, c_None, 0}, {2, 0, 1}}, "Inconsistent segment index."},
	    {{{0, 0, 0}, {1, 0, 1}}, "The parent segment of the root segment must not be set."},
	    {{{0, c_None, 1}, {1, 0, 1}}, "The tree depth of the root must be equal to 0."},
	    {{{0, c_None, 0}, {1, c_None, 1}}, "The parent segment of a child segment must be set."},
	    {{{0, c_None, 0}, {1, 2, 1}}, "Out-of-range parent segment index."},
	    {{{0, c_None, 0}, {1, 1, 1}}, "The segments are not in depth-first order."},
	    {{{0, c_None, 0}, {1, 0, 2}}, "The tree depth of a child must be equal to the parent depth + 1"},
	    {{{0, c_None, 0}, {1, 0, 0}}, "The tree depth of a child must be equal to the parent depth + 1"},
	    // In the order in which they are looked for.
	    {{{1, 0, 1}, {1, 0, 1}}, "Inconsistent segment index."},
	    {{{0, 0, 1}, {1, 0, 1}}, "The parent segment of the root segment must not be set."},
	    {{{0, c_None, 0}, {7, 7, 7}}, "Inconsistent segment index."},
	};
	for (const auto& rRow : rows)
	{
		VSubject subject = GoodSubject();
		for (std::size_t i = 0; i < 2; ++i)
		{
			subject.m_Segments[i].m_SegmentIndex = rRow.m_Places[i][0];
			subject.m_Segments[i].m_ParentSegmentIndex = rRow.m_Places[i][1];
			subject.m_Segments[i].m_TreeDepth = rRow.m_Places[i][2];
		}
		EXPECT_EQ(Failing([&] { return CheckSubject(subject); }), VTexts{rRow.m_pMessage}) << "row " << &rRow - rows;
	}
}

TEST_F(SubjectCheck, EndsAtTheFirstElementThatFails)
{
	VSubject subject = GoodSubject();
	subject.m_Markers[1].m_Name = subject.m_Markers[2].m_Name = "A";
	subject.m_Targets[3].m_State.clear();
	subject.m_Targets[5].m_State.clear();
	subject.m_Segments[0].m_Joint.m_Mean.resize(1);
	subject.m_Segments[0].m_Joint.m_Covariance.resize(1);
	subject.m_Segments[1].m_SegmentIndex = 0;
	const auto check = [&] { return CheckSubject(subject); };
	EXPECT_EQ(Failing(check), (VTexts{"Marker duplicate name: A", "Marker duplicate name: A"}));
	subject.m_Markers = GoodSubject().m_Markers;
	EXPECT_EQ(Failing(check), VTexts{"Incorrect state size, ELocalPlaneToWorldPoint type expects size 6"});
	subject.m_Targets[3] = GoodTarget(VTarget::ELocalPlaneToWorldPoint);
	EXPECT_EQ(Failing(check), VTexts{"Incorrect state size, ELocalLineToWorldPoint type expects size 6"});
	subject.m_Targets.clear();
	EXPECT_EQ(Failing(check), (VTexts{"Incorrent 'Mean' vector size.", "Incorrect 'Covariance' vector size."}));
	subject.m_Segments[0].m_Joint = {};
	EXPECT_EQ(Failing(check), VTexts{"Inconsistent segment index."});
}

} // namespace Checked
