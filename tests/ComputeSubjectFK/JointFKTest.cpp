#include "ReferenceFK.h"

#include "ComputeSubjectFK/ConstructionException.h"
#include "ComputeSubjectFK/JointFK.h"

#include <gtest/gtest.h>

#include <numbers>

namespace
{

using namespace ComputeSubject;
using Reference::c_Pi;
using Reference::VJointTypes;

CoreOrlexTypes::VSubject::VJoint Joint(Reference::EJointType i_Type)
{
	CoreOrlexTypes::VSubject::VJoint joint;
	joint.m_JointType = i_Type;
	return joint;
}

std::shared_ptr<IJointFK> Create(const CoreOrlexTypes::VSubject::VJoint& i_rJoint)
{
	return JointFKFactory(i_rJoint.m_JointType)->Create(i_rJoint);
}

struct VMotionRow
{
	const char* m_pName;
	Reference::EJointType m_Type;
	std::vector<double> m_State;
	Rotation::VPose<double> m_Expected;
};

// sin and cos of pi/6 and pi/3 by hand.
const double c_Half = 0.5;
const double c_Root = std::sqrt(3.0) / 2.0;

const VMotionRow c_Motions[] = {
    {"FreeTurnsAndMoves", VJointTypes::EFree, {0, 0, c_Pi / 2, 1, 2, 3}, {{0, -1, 0, 1, 0, 0, 0, 0, 1}, {1, 2, 3}}},
    {"BallAboutX", VJointTypes::EBall, {c_Pi / 6, 0, 0}, {{1, 0, 0, 0, c_Root, -c_Half, 0, c_Half, c_Root}, {0, 0, 0}}},
    {"BallThirdOfATurnAboutTheDiagonal", VJointTypes::EBall,
        {2 * c_Pi / 3 / std::sqrt(3.0), 2 * c_Pi / 3 / std::sqrt(3.0), 2 * c_Pi / 3 / std::sqrt(3.0)},
        {{0, 0, 1, 1, 0, 0, 0, 1, 0}, {0, 0, 0}}},
    {"BallHalfTurn", VJointTypes::EBall, {0, c_Pi, 0}, {{-1, 0, 0, 0, 1, 0, 0, 0, -1}, {0, 0, 0}}},
    {"HardySpicerFirstAboutZ", VJointTypes::EHardySpicer, {c_Pi / 6, 0},
        {{c_Root, -c_Half, 0, c_Half, c_Root, 0, 0, 0, 1}, {0, 0, 0}}},
    {"HardySpicerBoth", VJointTypes::EHardySpicer, {c_Pi / 2, c_Pi / 6},
        {{0, -1, 0, c_Root, 0, c_Half, -c_Half, 0, c_Root}, {0, 0, 0}}},
    {"Hinge", VJointTypes::EHinge, {c_Pi / 3}, {{c_Half, -c_Root, 0, c_Root, c_Half, 0, 0, 0, 1}, {0, 0, 0}}},
    {"Slider", VJointTypes::ESlider, {-12.5}, {{1, 0, 0, 0, 1, 0, 0, 0, 1}, {0, 0, -12.5}}},
    {"Dummy", VJointTypes::EDummy, {}, {{1, 0, 0, 0, 1, 0, 0, 0, 1}, {0, 0, 0}}},
};

TEST(JointFK, Motion)
{
	for (const VMotionRow& rRow : c_Motions)
	{
		SCOPED_TRACE(rRow.m_pName);
		const auto pJoint = Create(Joint(rRow.m_Type));
		IComputeJointFK& rJoint = pJoint->ComputeJointFK();
		EXPECT_EQ(rJoint.NumberOfStates(), rRow.m_State.size());
		// A value behind the joint's own must not be touched.
		std::vector<double> state = rRow.m_State;
		state.push_back(77.0);
		const double* pState = state.data();
		rJoint.SetState(pState);
		EXPECT_EQ(pState, state.data() + rRow.m_State.size());
		Rotation::VPose<double> pose{{9, 9, 9, 9, 9, 9, 9, 9, 9}, {9, 9, 9}};
		rJoint.GetPose(pose);
		for (int i = 0; i < 9; ++i)
			EXPECT_NEAR(pose.R[i], rRow.m_Expected.R[i], 1e-15) << i;
		EXPECT_EQ(pose.t, rRow.m_Expected.t);
	}
}

struct VNormaliseRow
{
	const char* m_pName;
	Reference::EJointType m_Type;
	std::vector<double> m_State;
	std::vector<double> m_Expected;
};

const VNormaliseRow c_Normalised[] = {
    {"BallBeyondATurn", VJointTypes::EBall, {0, 0, 2 * c_Pi + 0.1}, {0, 0, 0.1}},
    {"BallBeyondHalfATurnTurnsRound", VJointTypes::EBall, {0, c_Pi + 0.1, 0}, {0, -c_Pi + 0.1, 0}},
    {"BallUpToHalfATurnStays", VJointTypes::EBall, {0, -c_Pi, 0}, {0, -c_Pi, 0}},
    {"FreeLeavesTheTranslation", VJointTypes::EFree, {4 * c_Pi - 0.25, 0, 0, 100, 200, 300},
        {-0.25, 0, 0, 100, 200, 300}},
    {"HardySpicer", VJointTypes::EHardySpicer, {2 * c_Pi + 0.5, -3 * c_Pi / 2}, {0.5, c_Pi / 2}},
    {"Hinge", VJointTypes::EHinge, {-7 * c_Pi / 2}, {c_Pi / 2}},
    {"Slider", VJointTypes::ESlider, {1234.5}, {1234.5}},
    {"Dummy", VJointTypes::EDummy, {}, {}},
};

TEST(JointFK, NormaliseState)
{
	for (const VNormaliseRow& rRow : c_Normalised)
	{
		SCOPED_TRACE(rRow.m_pName);
		std::vector<double> state = rRow.m_State;
		state.push_back(77.0);
		double* pState = state.data();
		Create(Joint(rRow.m_Type))->ComputeJointConstraints().NormaliseState(pState);
		EXPECT_EQ(pState, state.data() + rRow.m_State.size());
		for (std::size_t i = 0; i < rRow.m_Expected.size(); ++i)
			EXPECT_NEAR(state[i], rRow.m_Expected[i], 1e-14) << i;
		EXPECT_EQ(state.back(), 77.0);
	}
}

TEST(JointFK, WrongTypesAreRefused)
{
	for (const auto type : {VJointTypes::EBadJointType, static_cast<Reference::EJointType>(7),
	         static_cast<Reference::EJointType>(-1), static_cast<Reference::EJointType>(INT32_MAX)})
		EXPECT_EQ(JointFKFactory(type), nullptr) << type;
	EXPECT_THROW(JointFKFactory(VJointTypes::EBall)->Create(Joint(VJointTypes::EHinge)), VConstructionException);
	EXPECT_THROW(JointFKFactory(VJointTypes::EFree)->Create(Joint(VJointTypes::EBadJointType)), VConstructionException);
}

TEST(JointFK, CloneHoldsItsOwnState)
{
	const auto pJoint = Create(Joint(VJointTypes::ESlider));
	const double values[] = {1.0, 2.0};
	const double* pState = values;
	pJoint->ComputeJointFK().SetState(pState);
	const auto pClone = pJoint->Clone();
	pJoint->ComputeJointFK().SetState(pState);
	Rotation::VPose<double> pose;
	pClone->ComputeJointFK().GetPose(pose);
	EXPECT_EQ(pose.t[2], 1.0);
}

} // namespace
