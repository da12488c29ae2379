#include "Takes.h"

#include <numbers>

using Rotation::VMatrix3;
using Rotation::VPose;
using Rotation::VVector3;
using VJointType = VSubjectParametrised::VJoint;

namespace
{

/// A body that hangs its arm: hips 500 mm up, the leg reaching 400 mm below them, the arm 200 mm down from 100 mm above
/// them. In the second frame it stands at (10, 20), turned to the left by 90 degrees, with the arm raised to the side
/// by as much.
const std::string c_Hanging =
    "HIERARCHY\nROOT Hips\n{\nOFFSET 0 0 0\n"
    "CHANNELS 6 Xposition Yposition Zposition Zrotation Yrotation Xrotation\n"
    "JOINT ns:ARM\n{\nOFFSET 0 0 100\nCHANNELS 1 Yrotation\n"
    "JOINT Hand\n{\nOFFSET 0 0 -200\nCHANNELS 1 Xrotation\nEnd Site\n{\nOFFSET 0 0 -50\n}\n}\n}\n"
    "JOINT Foot\n{\nOFFSET 0 0 -400\nCHANNELS 1 Xrotation\n}\n"
    "JOINT Tail\n{\nOFFSET 0 0 0\n}\n}\n"
    "MOTION\nFrames: 2\nFrame Time: .01\n0 0 500 0 0 0 0 0 0\n10 20 500 90 0 0 -90 0 0\n";

/// The same body in a T-pose, of other lengths, with a hinge for the arm and a segment that the take does not have.
VSubject TPosed()
{
	VSubject subject;
	const auto add = [&](const char* i_pName, std::uint32_t i_Parent, VJointType::EJointType i_Type, VVector3 i_Place)
	{
		VSubject::VSegment segment;
		segment.m_Name = i_pName;
		segment.m_ParentSegmentIndex = i_Parent;
		segment.m_PreTranslation = i_Place;
		segment.m_Joint.m_JointType = i_Type;
		subject.m_Segments.push_back(segment);
	};
	add("Hips", CoreOrlexTypes::c_NoParent, VJointType::EFree, {});
	add("Arm", 0, VJointType::EHinge, {0, 0, 90});
	add("Hand", 1, VJointType::EBall, {150, 0, 0});
	add("Ring", 2, VJointType::EDummy, {0, 10, 0});
	add("Foot", 0, VJointType::EBall, {0, 0, -800});
	return subject;
}

void ExpectSound(const VSubjectParametrised& i_rSubject)
{
	for (const auto& rFinding : CoreOrlexTypesUtils::FindSubjectFaults(i_rSubject))
		ADD_FAILURE() << rFinding.m_Name << ": " << rFinding.m_Message;
}

const std::vector<double> c_TPose{0, 0, 0, 0, 0, 900};
constexpr VMatrix3 c_Quarter{0, -1, 0, 1, 0, 0, 0, 0, 1};
/// From the T-pose to the arm that hangs.
constexpr VMatrix3 c_Down{0, 0, 1, 0, 1, 0, -1, 0, 0};

} // namespace

/// Worked out by hand: the lowest joint of the take is 400 mm below the hips and that of the subject 800, so that the
/// way is doubled.
TEST(SourceMotion, PosesByHand)
{
	const auto pTake = TakeOf(c_Hanging);
	struct VCase
	{
		const char* m_pName;
		std::optional<std::size_t> m_RestFrame;
		std::size_t m_Frame;
		VMatrix3 m_Arm;
		VVector3 m_Hand;
		VVector3 m_Ring;
	};
	for (const VCase& rCase : std::vector<VCase>{
	         {"the arm hangs as the take's does", {}, 0, c_Down, {0, 0, 940}, {0, 10, 940}},
	         {"and is raised by the take", {}, 1, c_Quarter, {20, 190, 1090}, {10, 190, 1090}},
	         {"the first frame is the bind pose", 0, 0, Rotation::c_Identity3, {150, 0, 1090}, {150, 10, 1090}},
	         {"what follows is turned from there", 0, 1, Rotation::Product(c_Quarter, Rotation::Transposed(c_Down)),
	             {20, 40, 1240}, {10, 40, 1240}},
	     })
	{
		SCOPED_TRACE(rCase.m_pName);
		std::string error;
		const auto pMotion = TakeSolve::VSourceMotion::Make(TPosed(), c_TPose, pTake, {{}, rCase.m_RestFrame}, error);
		ASSERT_TRUE(pMotion) << error;
		EXPECT_NEAR(pMotion->Scale(), 2.0, 1e-12);
		EXPECT_EQ(pMotion->Joints(), (std::vector<std::int32_t>{0, 1, 2, -1, 3}));
		EXPECT_TRUE(Tells(pMotion->Findings(), "undriven", "Ring"));
		EXPECT_EQ(Tells(pMotion->Findings(), "rest-arc", "Arm by 90 degrees"), !rCase.m_RestFrame.has_value());
		std::vector<VPose<double>> joints;
		std::vector<VPose<double>> poses;
		pMotion->Poses(rCase.m_Frame, joints, poses);
		const VVector3 shoulder = rCase.m_Frame == 0 ? VVector3{0, 0, 1090} : VVector3{20, 40, 1090};
		ExpectPose(poses[1], rCase.m_Arm, shoulder, 1e-12, "arm");
		ExpectPose(poses[2], rCase.m_Arm, rCase.m_Hand, 1e-12, "hand");
		ExpectPose(poses[3], rCase.m_Arm, rCase.m_Ring, 1e-12, "ring, which goes along");
	}
}

TEST(SourceMotion, PairsAreToldAndRefused)
{
	const auto pTake = TakeOf(c_Hanging);
	struct VCase
	{
		TakeSolve::VSourceSettings m_Settings;
		std::vector<std::int32_t> m_Joints;
		/// What is told, or why it is refused.
		const char* m_pId;
		const char* m_pText;
	};
	for (const VCase& rCase : std::vector<VCase>{
	         {{{{"Tail", "ring"}}, {}}, {0, 1, 2, 4, 3}, "tree", "joint Tail drives the segment Ring"},
	         {{{{"ARM", "Hand"}, {"Hand", "Arm"}}, {}}, {0, 2, 1, -1, 3}, "tree", "joint ARM drives the segment Hand"},
	         {{{{"Elbow", "Arm"}}, {}}, {}, nullptr, "no joint \"Elbow\""},
	         {{{{"Hand", "Elbow"}}, {}}, {}, nullptr, "no segment \"Elbow\""},
	         {{{{"Hand", "Arm"}, {"Hand", "Hand"}}, {}}, {}, nullptr, "stands in two pairs"},
	         {{{}, 2}, {}, nullptr, "no frame 2: its last one is 1"},
	     })
	{
		SCOPED_TRACE(rCase.m_pText);
		std::string error;
		const auto pMotion = TakeSolve::VSourceMotion::Make(TPosed(), c_TPose, pTake, rCase.m_Settings, error);
		ASSERT_EQ(bool(pMotion), rCase.m_pId != nullptr) << error;
		if (!pMotion)
		{
			EXPECT_NE(error.find(rCase.m_pText), std::string::npos) << error;
			continue;
		}
		EXPECT_EQ(pMotion->Joints(), rCase.m_Joints);
		EXPECT_TRUE(Tells(pMotion->Findings(), rCase.m_pId, rCase.m_pText));
	}
}

/// Two schools of names that overlap: LeftShoulder is the clavicle of one and the upper arm of the other.
TEST(SourceMotion, NamesMayMislead)
{
	const auto pTake = ChestTake();
	VTakePerformer performer(*pTake);
	const auto rename = [&](const std::string& i_rFrom, const std::string& i_rTo)
	{
		for (auto& rSegment : performer.m_Subject.m_Segments)
			if (rSegment.m_Name == i_rFrom)
			{
				rSegment.m_Name = i_rTo;
				return;
			}
		FAIL() << i_rFrom;
	};
	for (const std::string side : {"Left", "Right"})
	{
		rename(side + "Shoulder", side + "Arm");
		rename(side + "Collar", side + "Shoulder");
		rename(side + "Elbow", side + "ForeArm");
		rename(side + "Wrist", side + "Hand");
	}
	std::string error;
	const auto pMotion = TakeSolve::VSourceMotion::Make(performer.m_Subject, performer.m_BindPose, pTake, {}, error);
	ASSERT_TRUE(pMotion) << error;
	for (std::size_t i = 0; i < pMotion->Joints().size(); ++i)
		EXPECT_EQ(pMotion->Joints()[i], std::int32_t(i)) << pMotion->SegmentNames()[i];
	EXPECT_TRUE(Tells(pMotion->Findings(), "name", "LeftShoulder is driven by the joint LeftCollar"));
}

/// The performer that a take makes stands where the take's own joints do.
TEST(SourceMotion, PerformerOfTheTakeFollowsIt)
{
	const auto pTake = ChestTake();
	const VTakePerformer performer(*pTake);
	ExpectSound(performer.m_Record.m_SubjectParametrised);
	EXPECT_TRUE(performer.m_Findings.empty());
	ASSERT_EQ(performer.m_Subject.m_Segments.size(), pTake->m_Joints.size());
	std::string error;
	const auto pMotion = TakeSolve::VSourceMotion::Make(performer.m_Subject, performer.m_BindPose, pTake, {}, error);
	ASSERT_TRUE(pMotion) << error;
	EXPECT_NEAR(pMotion->Scale(), 1.0, 1e-9);
	double lowest = 1e9;
	for (const auto& rPose : pMotion->BindPoses())
		lowest = std::min(lowest, rPose.t[2]);
	EXPECT_GT(lowest, 0.0) << "it stands on the floor";
	EXPECT_LT(lowest, 100.0);
	std::vector<VPose<double>> joints;
	std::vector<VPose<double>> poses;
	for (std::size_t frame = 0; frame < pTake->m_Frames; frame += 10)
	{
		pMotion->Poses(frame, joints, poses);
		for (std::size_t i = 0; i < poses.size(); ++i)
			ExpectPose(poses[i], joints[i].R, joints[i].t, 1e-9, pTake->m_Joints[i].m_Name);
	}
}

/// At rest the legs are splayed by 20 degrees, soles along. In the take they stand straight, ankles 100 mm up, so that
/// the feet of the bind pose are turned by as much, about the way that they point, and the hips are at 100 + 800
/// cos 20. The performer stands where the take's joints do all the same.
TEST(Performer, FeetStandAsInTheTake)
{
	const auto joint = [](const std::string& i_rName, const std::string& i_rOffset, const std::string& i_rBelow)
	{
		return "JOINT " + i_rName + "\n{\nOFFSET " + i_rOffset + "\nCHANNELS 1 Yrotation\n"
		    + (i_rBelow.empty() ? "End Site\n{\nOFFSET 0 0 1\n}\n" : i_rBelow) + "}\n";
	};
	std::string body = joint("Spine", "0 0 200", joint("Head", "0 0 400", ""));
	for (const auto& [rSide, rOut] : {std::pair<std::string, std::string>{"Left", ""}, {"Right", "-"}})
		body += joint(rSide + "UpLeg", rOut + "100 0 0",
		    joint(rSide + "Leg", rOut + "136.80805733 0 -375.87704831",
		        joint(rSide + "Foot", rOut + "136.80805733 0 -375.87704831", joint(rSide + "Toe", "0 -150 -50", ""))));
	std::string text = "HIERARCHY\nROOT Hips\n{\nOFFSET 0 0 0\nCHANNELS 3 Xposition Yposition Zposition\n" + body
	    + "}\nMOTION\nFrames: 12\nFrame Time: .01\n";
	for (int i = 0; i < 12; ++i)
		text += "0 0 900 0 0 20 0 0 0 -20 0 0 0\n";
	const auto pTake = TakeOf(text);
	const VTakePerformer performer(*pTake);
	ExpectSound(performer.m_Record.m_SubjectParametrised);
	std::string error;
	const auto pMotion = TakeSolve::VSourceMotion::Make(performer.m_Subject, performer.m_BindPose, pTake, {}, error);
	ASSERT_TRUE(pMotion) << error;
	EXPECT_TRUE(pMotion->Findings().empty());
	const double c = std::cos(std::numbers::pi / 9.0);
	const double s = std::sin(std::numbers::pi / 9.0);
	const double ankle = 100.0 + 800.0 * s;
	ExpectPose(pMotion->BindPoses()[0], Rotation::c_Identity3, {0, 0, 100 + 800 * c}, 1e-9, "hips");
	ExpectPose(pMotion->BindPoses()[5], {c, 0, s, 0, 1, 0, -s, 0, c}, {ankle, 0, 100}, 1e-9, "left foot");
	ExpectPose(pMotion->BindPoses()[10], {c, 0, -s, 0, 1, 0, s, 0, c}, {50 * s - ankle, -150, 100 - 50 * c}, 1e-9,
	    "right toe");
	std::vector<VPose<double>> joints;
	std::vector<VPose<double>> poses;
	pMotion->Poses(7, joints, poses);
	for (std::size_t i = 0; i < poses.size(); ++i)
		ExpectPose(poses[i], joints[i].R, joints[i].t, 1e-9, pTake->m_Joints[i].m_Name);
	const TakeSolve::VStandingPose pose = TakeSolve::StandingPose(*pTake);
	EXPECT_NE(TextOf(pose, *pTake).find("LeftFoot is turned by 20 degrees"), std::string::npos);
}

/// Names that no file may hold or that stand there twice, a joint without channels and length, a second skeleton.
TEST(Performer, OddJoints)
{
	const auto pTake =
	    TakeOf("HIERARCHY\nROOT Prop\n{\nOFFSET 0 0 0\nCHANNELS 1 Xrotation\nEnd Site\n{\nOFFSET 0 0 1\n}\n}\n"
	           "ROOT a:Spine\n{\nOFFSET 0 0 5\nCHANNELS 3 Xposition Yposition Zposition\n"
	           "JOINT b:Spine\n{\nOFFSET 0 0 7\n"
	           "JOINT Fixed\n{\nOFFSET 0 0 0\nEnd Site\n{\nOFFSET 0 3 -30\n}\n}\n}\n}\n"
	           "MOTION\nFrames: 1\nFrame Time: .01\n0 1 2 3\n");
	const VTakePerformer performer(*pTake);
	EXPECT_TRUE(Tells(performer.m_Findings, "trees", "begins at a:Spine; left out is what begins at Prop"));
	const auto& rSubject = performer.m_Record.m_SubjectParametrised;
	ExpectSound(rSubject);
	ASSERT_EQ(rSubject.m_Segments.size(), 3u);
	const std::pair<const char*, VJointType::EJointType> expected[] = {
	    {"Spine", VJointType::EFree}, {"Spine_2", VJointType::EBall}, {"Fixed", VJointType::EDummy}};
	for (std::size_t i = 0; i < 3; ++i)
	{
		EXPECT_EQ(rSubject.m_Segments[i].m_Name, expected[i].first);
		EXPECT_EQ(rSubject.m_Segments[i].m_Joint.m_JointType, expected[i].second);
	}
	// The end is at 5 + 7 - 30: raised by 18.
	EXPECT_EQ(performer.m_BindPose, (std::vector<double>{0, 0, 0, 0, 0, 23, 0, 0, 0}));
	EXPECT_EQ(performer.m_Record.m_SubjectApplicationData.m_Sticks.size(), 2u);
}
