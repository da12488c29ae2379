#include "RetargetSetupCore/RetargetTargets.h"

#include "TestSubjects.h"

#include <gtest/gtest.h>

#include <limits>

namespace
{

using namespace RetargetSetup;
using CoreOrlexTypes::VSubjectParametrised;
using VTarget = CoreOrlexTypes::VSubjectParametrised::VTarget;

VSubjectParametrised SubjectWithTarget(VTarget::ETargetType i_Type, double i_Scale = 2.0)
{
	VSubjectParametrised subject = MakeSubject({{"a", -1}});
	subject.m_DynamicParameters.insert(subject.m_DynamicParameters.begin(), {"First", 0, 0, 100.0, false});
	subject.m_DynamicParameters.back().m_Value = i_Scale;
	auto& rParameter = subject.m_StaticParameters.emplace_back();
	rParameter.m_Name = "Arm";
	rParameter.m_UserValue = 0.5;
	VTarget& rTarget = subject.m_Targets.emplace_back();
	rTarget.m_Type = i_Type;
	rTarget.m_StateExpressions = {"x", "y", "z"};
	return subject;
}

TEST(SetStateExpression, Rows)
{
	constexpr auto position = VTarget::ELocalPointToWorldPoint;
	constexpr auto gaussian = VTarget::ELocalPointToWorldPointGaussian;
	constexpr auto rotation = VTarget::ELocalRotationToWorldRotation;
	const struct
	{
		const char* m_pText;
		VTarget::ETargetType m_Type;
		/// Null: nothing is stored.
		const char* m_pStored;
		const char* m_pTold;
	} rows[] = {
	    {"100", position, "50.000000*GlobalScale", ""},
	    {" -1e1\t", gaussian, "-5.000000*GlobalScale", ""},
	    {"", position, "0.000000*GlobalScale", ""},
	    {" \t\n", position, "0.000000*GlobalScale", ""},
	    {"1+1", position, nullptr, "State Y of target 0 stays as it was: '1+1' is not a number"},
	    {"1,5", position, nullptr, "State Y of target 0 stays as it was: '1,5' is not a number"},
	    {"inf", position, nullptr, "State Y of target 0 stays as it was: 1.#INF over the scale 2 is not finite"},
	    {"1.#QNAN", position, nullptr, "State Y of target 0 stays as it was: 1.#IND over the scale 2 is not finite"},
	    {"0.1", rotation, "0.1", ""},
	    {"", rotation, "0", ""},
	    {" 2 * Arm + GlobalScale ", rotation, "2*Arm+GlobalScale", ""},
	    {"1 2", rotation, nullptr,
	        "State Y of target 0 stays as it was: '1 2' means something else without its blanks"},
	    {"*2", rotation, nullptr, "State Y of target 0 stays as it was: Parse Error"},
	    {"2*Leg", rotation, nullptr, "State Y of target 0 stays as it was: Parse Error"},
	    {"1/0", rotation, nullptr, "State Y of target 0 stays as it was: "},
	    {"1", VTarget::EBadTargetType, nullptr, ""},
	    {"1", VTarget::ELocalLineToWorldPoint, nullptr, ""},
	    {"1", VTarget::ERigidBody, nullptr, ""},
	    {"1", VTarget::ELocalDirectionToWorldDirection, nullptr, ""},
	};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pText);
		VSubjectParametrised subject = SubjectWithTarget(rRow.m_Type);
		VSubjectParametrised wanted = subject;
		if (rRow.m_pStored)
			wanted.m_Targets[0].m_StateExpressions[1] = rRow.m_pStored;
		VLogRecorder log;
		EXPECT_EQ(SetStateExpression(subject, rRow.m_pText, 0, 1), rRow.m_pStored != nullptr);
		EXPECT_EQ(subject.m_Targets[0].m_StateExpressions, wanted.m_Targets[0].m_StateExpressions);
		EXPECT_EQ(subject, wanted);
		const std::string told = log.Take();
		if (*rRow.m_pTold)
			EXPECT_EQ(told.find("3 RetargetSetup: " + std::string(rRow.m_pTold)), 0u) << told;
		else
			EXPECT_EQ(told, "");
	}
}

TEST(SetStateExpression, NothingHappensOutOfRangeOrWithoutDynamicParameters)
{
	VSubjectParametrised subject = SubjectWithTarget(VTarget::ELocalRotationToWorldRotation);
	const VSubjectParametrised before = subject;
	VLogRecorder log;
	EXPECT_FALSE(SetStateExpression(subject, "1", 1, 0));
	EXPECT_FALSE(SetStateExpression(subject, "1", std::size_t(-1), 0));
	EXPECT_FALSE(SetStateExpression(subject, "1", 0, 3));
	EXPECT_EQ(subject, before);
	EXPECT_EQ(log.Take(), "");
	subject.m_DynamicParameters.clear();
	EXPECT_FALSE(SetStateExpression(subject, "1", 0, 0));
	EXPECT_EQ(subject.m_Targets[0].m_StateExpressions, before.m_Targets[0].m_StateExpressions);
	EXPECT_EQ(log.Take(),
	    "3 RetargetSetup: State of target 0 stays as it was: the target subject has no dynamic parameter "
	    "to scale it by");
}

TEST(SetStateExpression, AShortListGrows)
{
	for (const std::size_t length : {0, 1, 2})
	{
		VSubjectParametrised subject = SubjectWithTarget(VTarget::ELocalPointToWorldPoint);
		subject.m_Targets[0].m_StateExpressions.resize(length);
		EXPECT_TRUE(SetStateExpression(subject, "8", 0, 2));
		ASSERT_EQ(subject.m_Targets[0].m_StateExpressions.size(), 3u);
		EXPECT_EQ(subject.m_Targets[0].m_StateExpressions[2], "4.000000*GlobalScale");
		EXPECT_EQ(subject.m_Targets[0].m_StateExpressions[1], length == 2 ? "y" : "0");
	}
}

TEST(SetStateExpression, AScaleOfZeroGivesNoFiniteQuotient)
{
	VSubjectParametrised subject = SubjectWithTarget(VTarget::ELocalPointToWorldPoint, 0.0);
	VLogRecorder log;
	EXPECT_FALSE(SetStateExpression(subject, "1", 0, 0));
	EXPECT_EQ(subject.m_Targets[0].m_StateExpressions[0], "x");
	EXPECT_EQ(log.Take(), "3 RetargetSetup: State X of target 0 stays as it was: 1 over the scale 0 is not finite");
}

TEST(UpdateTargetState, APoseThatIsNotFiniteLeavesTheOffset)
{
	Rotation::VPose<double> relative;
	relative.t = {1, std::numeric_limits<double>::quiet_NaN(), 3};
	VSubjectParametrised subject = SubjectWithTarget(VTarget::ELocalPointToWorldPoint);
	VLogRecorder log;
	UpdateTargetState(subject, relative, 0);
	EXPECT_EQ(subject.m_Targets[0].m_StateExpressions,
	    (std::vector<std::string>{"0.500000*GlobalScale", "y", "1.500000*GlobalScale"}));
	EXPECT_NE(log.Take(), "");
	relative.R.fill(std::numeric_limits<double>::quiet_NaN());
	subject = SubjectWithTarget(VTarget::ELocalRotationToWorldRotation);
	UpdateTargetState(subject, relative, 0);
	EXPECT_EQ(subject.m_Targets[0].m_StateExpressions, (std::vector<std::string>{"x", "y", "z"}));
}

} // namespace
