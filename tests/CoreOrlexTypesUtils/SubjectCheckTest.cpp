#include "CheckedSubject.h"

#include "CoreOrlexTypesUtils/check/SubjectCheck.h"

namespace Checked
{

using namespace CoreOrlexTypesUtils;
using VTarget = VSubject::VTarget;
using VJoint = VSubject::VJoint;
using EJointType = VSubjectParametrised::VJoint::EJointType;

/// Messages of a type whose number of markers, rotation observations, segments, state or covariance values is wrong;
/// empty where any number is right.
struct VSizeMessages
{
	std::string m_Markers;
	std::string m_Rotations;
	std::string m_Segments;
	std::string m_State;
	std::string m_Covariance;
};

VSizeMessages SizeMessages(int i_Type)
{
	constexpr const char* c_None = "no rotation observations";
	constexpr const char* c_One = "1 rotation observation";
	static constexpr struct
	{
		const char* m_pType;
		const char* m_pMarkers;
		const char* m_pRotations;
		const char* m_pState;
		const char* m_pCovariance;
	} c_Rows[] = {
	    {"ELocalPointToWorldPoint", "1 marker", c_None, "3", nullptr},
	    {"ELocalPointToWorldPointGaussian", "1 marker", c_None, "3", "9"},
	    {"ELocalPlaneToWorldPoint", "1 marker", c_None, "6", nullptr},
	    {"ELocalPlaneToWorldPointGaussian", "1 marker", c_None, "6", "1"},
	    {"ELocalLineToWorldPoint", "1 marker", c_None, "6", nullptr},
	    {"ELocalLineToWorldPointGaussian", "1 marker", c_None, "6", "4"},
	    {"ERigidBody", "at least 3 markers", c_None, "3*(MarkerCount+2)", "36 + 9*MarkerCount"},
	    {"ElocalRotationToWorldRotation", "no markers", c_One, "3", "0"},
	    {"ELocalDirectionToWorldDirection", "no markers", c_One, "3", "0"},
	};
	const auto& rRow = c_Rows[i_Type - 1];
	const std::string expects = std::string(", ") + rRow.m_pType + " type expects ";
	return {"Incorrect number of markers" + expects + rRow.m_pMarkers,
	    "Incorrect number of rotation observations" + expects + rRow.m_pRotations,
	    "Incorrect number of parent segments" + expects + "1 segment",
	    "Incorrect state size" + expects + "size " + rRow.m_pState,
	    rRow.m_pCovariance ? "Incorrect covariance size" + expects + "size " + rRow.m_pCovariance : ""};
}

VTarget GoodTarget(VTarget::ETargetType i_Type)
{
	VTarget target;
	target.m_Type = i_Type;
	const bool bRotation =
	    i_Type == VTarget::ELocalRotationToWorldRotation || i_Type == VTarget::ELocalDirectionToWorldDirection;
	if (i_Type == VTarget::ERigidBody)
		target.m_MarkerIndices = {0, 1, 3};
	else if (!bRotation)
		target.m_MarkerIndices = {1};
	if (bRotation)
		target.m_RotationObservationIndices = {1};
	target.m_SegmentIndices = {1};
	target.m_ViewNormals.resize(target.m_MarkerIndices.size());
	switch (i_Type)
	{
	case VTarget::ELocalPointToWorldPointGaussian: target.m_Covariance = Diagonal(3, 4.0); [[fallthrough]];
	case VTarget::ELocalPointToWorldPoint: target.m_State = {1, 2, 3}; break;
	case VTarget::ELocalRotationToWorldRotation:
	case VTarget::ELocalDirectionToWorldDirection: target.m_State = {0, 0, 1}; break;
	case VTarget::ELocalPlaneToWorldPointGaussian: target.m_Covariance = {-7}; [[fallthrough]];
	case VTarget::ELocalPlaneToWorldPoint: target.m_State = VNumbers(6, 1.0); break;
	case VTarget::ELocalLineToWorldPointGaussian: target.m_Covariance = {-7, 1, 2, 3}; [[fallthrough]];
	case VTarget::ELocalLineToWorldPoint: target.m_State = VNumbers(6, 1.0); break;
	case VTarget::ERigidBody:
		target.m_State = VNumbers(15, 1.0);
		target.m_Covariance = RigidBodyCovariance(3);
		break;
	default: break;
	}
	return target;
}

template <typename TList, typename... TValues>
void Set(TList& o_rList, TValues... i_Values)
{
	o_rList = TList{typename TList::value_type(i_Values)...};
}

/// Two segments, four markers, two rotations, one good target of each type.
VSubject GoodSubject()
{
	VSubject subject;
	subject.m_Segments.resize(2);
	subject.m_Segments[1].m_SegmentIndex = 1;
	subject.m_Segments[1].m_ParentSegmentIndex = 0;
	subject.m_Segments[1].m_TreeDepth = 1;
	subject.m_Markers.resize(4);
	for (std::uint32_t i = 0; i < 4; ++i)
	{
		subject.m_Markers[i].m_MarkerId = 100 + i;
		subject.m_Markers[i].m_Name = std::string(1, char('A' + i));
	}
	subject.m_Rotations.resize(2);
	for (int type = 0; type < 10; ++type)
		subject.m_Targets.push_back(GoodTarget(VTarget::ETargetType(type)));
	return subject;
}

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

TEST_F(SubjectCheck, SizesOfTargetsByType)
{
	const auto resize = [](auto& io_rList, int i_Step) { io_rList.resize(std::size_t(int(io_rList.size()) + i_Step)); };
	for (int type = 1; type < 10; ++type)
	{
		SCOPED_TRACE(type);
		const VSizeMessages messages = SizeMessages(type);
		const VTarget good = GoodTarget(VTarget::ETargetType(type));
		const auto expect = [&](auto VTarget::*i_pList, const std::string& i_rMessage)
		{
			for (const int step : {(good.*i_pList).empty() ? 2 : -1, 1})
				EXPECT_EQ(TargetMessages(type, [&](VTarget& io_rTarget) { resize(io_rTarget.*i_pList, step); }),
				    VTexts{i_rMessage});
		};
		if (type != VTarget::ERigidBody)
			expect(&VTarget::m_MarkerIndices, messages.m_Markers);
		if (type < VTarget::ELocalRotationToWorldRotation)
			expect(&VTarget::m_RotationObservationIndices, messages.m_Rotations);
		expect(&VTarget::m_SegmentIndices, messages.m_Segments);
		expect(&VTarget::m_State, messages.m_State);
		if (!messages.m_Covariance.empty())
			expect(&VTarget::m_Covariance, messages.m_Covariance);
		else
			EXPECT_EQ(TargetMessages(type,
			              [](VTarget& io_rTarget)
			              {
				              io_rTarget.m_Covariance.resize(5);
				              io_rTarget.m_ViewNormals.clear();
			              }),
			    VTexts{"Invalid target view normals"});
	}
	const VSizeMessages rigidBody = SizeMessages(VTarget::ERigidBody);
	EXPECT_EQ(TargetMessages(VTarget::ERigidBody, [](VTarget& io_rTarget) { io_rTarget.m_MarkerIndices.pop_back(); }),
	    VTexts{rigidBody.m_Markers});
	// A fourth marker asks for more values.
	EXPECT_EQ(TargetMessages(VTarget::ERigidBody, [](VTarget& io_rTarget) { io_rTarget.m_MarkerIndices.push_back(2); }),
	    VTexts{rigidBody.m_State});
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
			EXPECT_EQ(TakeLog(), VTexts{SizeMessages(type).m_Rotations});
		}
}

TEST_F(SubjectCheck, TheFirstWrongSizeOfATargetIsTold)
{
	for (int type = 1; type < 10; ++type)
	{
		SCOPED_TRACE(type);
		const VSizeMessages messages = SizeMessages(type);
		VTarget bad = GoodTarget(VTarget::ETargetType(type));
		bad.m_MarkerIndices.resize(2);
		bad.m_RotationObservationIndices.resize(2);
		bad.m_SegmentIndices.resize(2);
		bad.m_State.resize(1);
		bad.m_Covariance.resize(2);
		bad.m_ViewNormals.resize(7);
		// What stands in the way is mended one after the other.
		VTexts order;
		const VTarget good = GoodTarget(VTarget::ETargetType(type));
		const auto step = [&](auto VTarget::*i_pList)
		{
			order.push_back(TargetMessages(type, [&](VTarget& io_rTarget) { io_rTarget = bad; }).back());
			bad.*i_pList = good.*i_pList;
		};
		const bool bDirection = type == VTarget::ELocalDirectionToWorldDirection;
		const bool bRotation = bDirection || type == VTarget::ELocalRotationToWorldRotation;
		if (bDirection)
		{
			step(&VTarget::m_SegmentIndices);
			step(&VTarget::m_State);
		}
		step(&VTarget::m_MarkerIndices);
		if (!bRotation)
			step(&VTarget::m_RotationObservationIndices);
		if (!bDirection)
		{
			step(&VTarget::m_SegmentIndices);
			step(&VTarget::m_State);
		}
		if (!messages.m_Covariance.empty())
			step(&VTarget::m_Covariance);
		step(&VTarget::m_ViewNormals);
		VTexts expected = bDirection
		    ? VTexts{messages.m_Segments, messages.m_State, messages.m_Markers, messages.m_Covariance}
		    : VTexts{
		        messages.m_Markers, messages.m_Rotations, messages.m_Segments, messages.m_State, messages.m_Covariance};
		if (bRotation && !bDirection)
			expected.erase(expected.begin() + 1);
		std::erase(expected, "");
		expected.push_back("Invalid target view normals");
		EXPECT_EQ(order, expected);
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
	    {2, [](VTarget& io_r) { io_r.m_Covariance[1] = 1e-11; }, {covariance}},
	    {2, [](VTarget& io_r) { io_r.m_Covariance[8] = c_NaN; }, {covariance}},
	    {7, [](VTarget& io_r) { io_r.m_Covariance[36] = -1; }, {covariance}},
	    {7, [](VTarget& io_r) { io_r.m_Covariance[62] = c_Infinity; }, {covariance}},
	    {8, [](VTarget& io_r) { io_r.m_RotationCalibrationBehaviour = VTarget::EBadBehaviourType; },
	        {"Invalid rotation calibration behaviour"}},
	    {8, [](VTarget& io_r) { io_r.m_RotationTargetOrientation.resize(3); },
	        {"Incorrect rotation target orientation size. Expected 0. Actual 3"}},
	    {8,
	        [](VTarget& io_r)
	        {
		        io_r.m_RotationCalibrationBehaviour = VTarget::EHingeLike;
		        io_r.m_RotationTargetOrientation.resize(2);
	        },
	        {"Incorrect rotation target orientation size. Expected 3. Actual 2 "}},
	    {8, [](VTarget& io_r) { io_r.m_RotationCalibrationBehaviour = VTarget::ERotationCalibrationBehaviourType(9); },
	        {"Incorrect rotation target orientation size. Expected 3. Actual 0 "}},
	    {9, [](VTarget& io_r) { Set(io_r.m_State, 1.0006, 0, 0); }, {unit}},
	    {9, [](VTarget& io_r) { Set(io_r.m_State, 0.9994, 0, 0); }, {unit}},
	    {9, [](VTarget& io_r) { Set(io_r.m_State, 0, c_NaN, 1); }, {unit}},
	    {9, [](VTarget& io_r) { Set(io_r.m_State, 0, 1e200, 0); }, {unit}},
	    {1, [](VTarget& io_r) { io_r.m_MarkerIndices = {4}; }, {"Out of range marker index 4"}},
	    {0, [](VTarget& io_r) { Set(io_r.m_MarkerIndices, 3, 0xFFFFFFFF); }, {"Out of range marker index 4294967295"}},
	    {8, [](VTarget& io_r) { io_r.m_RotationObservationIndices = {2}; },
	        {"Out of range rotation observation index 2"}},
	    {1, [](VTarget& io_r) { io_r.m_SegmentIndices = {2}; }, {"Out of range segment index 2"}},
	    {0,
	        [](VTarget& io_r)
	        {
		        io_r.m_MarkerIndices = {9};
		        io_r.m_RotationObservationIndices = {9};
		        io_r.m_SegmentIndices = {9};
	        },
	        {"Out of range marker index 9"}},
	    {0,
	        [](VTarget& io_r)
	        {
		        io_r.m_RotationObservationIndices = {9};
		        io_r.m_SegmentIndices = {9};
	        },
	        {"Out of range rotation observation index 9"}},
	    {0,
	        [](VTarget& io_r)
	        {
		        io_r.m_SegmentIndices = {9};
		        io_r.m_ViewNormals.resize(1);
	        },
	        {"Out of range segment index 9"}},
	    {1, [](VTarget& io_r) { io_r.m_ViewNormals.clear(); }, {normals}},
	    {1, [](VTarget& io_r) { io_r.m_ViewNormals.resize(2); }, {normals}},
	    {1, [](VTarget& io_r) { Set(io_r.m_ViewNormals[0], 0.5, 0, 0); }, {normals}},
	    {1, [](VTarget& io_r) { Set(io_r.m_ViewNormals[0], 0, 1 + 2e-6, 0); }, {normals}},
	    {1, [](VTarget& io_r) { Set(io_r.m_ViewNormals[0], 0, 0, c_NaN); }, {normals}},
	    {8, [](VTarget& io_r) { Set(io_r.m_RotationObservationIndices, 0, 2); },
	        {"Incorrect number of rotation observations, ElocalRotationToWorldRotation type expects 1 rotation "
	         "observation",
	            "Out of range rotation observation index 2"}},
	};
	for (const auto& rRow : rows)
		EXPECT_EQ(TargetMessages(rRow.m_Type, rRow.m_pChange), rRow.m_Messages) << "row " << &rRow - rows;
	EXPECT_EQ(Failing([] { return CheckTarget(GoodSubject(), 10); }), VTexts{"Out-of-range target index 10"});
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
	const struct
	{
		void (*m_pChange)(std::vector<VSubject::VSegment>&);
		const char* m_pMessage;
	} rows[] = {
	    {[](auto& io_r) { io_r[1].m_SegmentIndex = 2; }, "Inconsistent segment index."},
	    {[](auto& io_r) { io_r[0].m_ParentSegmentIndex = 0; },
	        "The parent segment of the root segment must not be set."},
	    {[](auto& io_r) { io_r[0].m_TreeDepth = 1; }, "The tree depth of the root must be equal to 0."},
	    {[](auto& io_r) { io_r[1].m_ParentSegmentIndex = CoreOrlexTypes::c_NoParent; },
	        "The parent segment of a child segment must be set."},
	    {[](auto& io_r) { io_r[1].m_ParentSegmentIndex = 2; }, "Out-of-range parent segment index."},
	    {[](auto& io_r) { io_r[1].m_ParentSegmentIndex = 1; }, "The segments are not in depth-first order."},
	    {[](auto& io_r) { io_r[1].m_TreeDepth = 2; },
	        "The tree depth of a child must be equal to the parent depth + 1"},
	    {[](auto& io_r) { io_r[1].m_TreeDepth = 0; },
	        "The tree depth of a child must be equal to the parent depth + 1"},
	    // In the order in which they are looked for.
	    {[](auto& io_r)
	        {
		        io_r[0].m_SegmentIndex = 1;
		        io_r[0].m_ParentSegmentIndex = 0;
	        },
	        "Inconsistent segment index."},
	    {[](auto& io_r)
	        {
		        io_r[0].m_ParentSegmentIndex = 0;
		        io_r[0].m_TreeDepth = 1;
	        },
	        "The parent segment of the root segment must not be set."},
	    {[](auto& io_r)
	        {
		        io_r[1].m_SegmentIndex = 7;
		        io_r[1].m_ParentSegmentIndex = 7;
	        },
	        "Inconsistent segment index."},
	    {[](auto& io_r)
	        {
		        io_r[0].m_SegmentIndex = 3;
		        io_r[0].m_Joint.m_Mean.resize(1);
	        },
	        "Incorrent 'Mean' vector size."},
	};
	for (const auto& rRow : rows)
	{
		VSubject subject = GoodSubject();
		rRow.m_pChange(subject.m_Segments);
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
