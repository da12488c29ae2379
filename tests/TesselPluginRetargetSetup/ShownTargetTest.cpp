#include "TesselPluginRetargetSetup/ShownTarget.h"

#include <gtest/gtest.h>

#include <functional>

namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using RetargetSetup::VShownTarget;

/// A position target and a rotation target of a subject of scale 2.
VSubjectParametrised TargetSubject()
{
	VSubjectParametrised subject;
	subject.m_DynamicParameters.resize(1);
	subject.m_DynamicParameters[0].m_Name = "GlobalScale";
	subject.m_DynamicParameters[0].m_Value = 2.0;
	subject.m_Targets.resize(2);
	subject.m_Targets[0].m_Type = VSubjectParametrised::VTarget::ELocalPointToWorldPoint;
	subject.m_Targets[0].m_Weight = 0.5;
	subject.m_Targets[0].m_StateExpressions = {"12.25*GlobalScale", "nonsense(", "0.1"};
	subject.m_Targets[1].m_Type = VSubjectParametrised::VTarget::ELocalRotationToWorldRotation;
	subject.m_Targets[1].m_StateExpressions = {"0.25", "1", "-1"};
	return subject;
}

TEST(ShownTarget, TellsNumbersWhereTheFileHoldsExpressions)
{
	const VShownTarget position = RetargetSetup::ShowTarget(TargetSubject(), 0);
	EXPECT_EQ(position.m_Index, 0);
	EXPECT_EQ(position.m_Weight, 0.5) << "below what could be typed, and shown as it is";
	EXPECT_EQ(position.m_State, (std::array<std::string, 3>{"24.5", "0", "0.10000000000000001"}));
	EXPECT_FALSE(position.m_bStateHidden);
	EXPECT_TRUE(RetargetSetup::ShowTarget(TargetSubject(), 1).m_bStateHidden);
	for (const std::int32_t index : {-1, 2})
		EXPECT_EQ(RetargetSetup::ShowTarget(TargetSubject(), index).m_Index, -1) << index;
}

TEST(ShownTarget, OnlyWhatWasEditedIsWritten)
{
	struct VCase
	{
		const char* m_pName;
		std::function<void(VShownTarget&)> m_Edit;
		bool m_bChanged;
		double m_Weight;
		std::vector<std::string> m_State;
	};
	const std::vector<std::string> before = TargetSubject().m_Targets[0].m_StateExpressions;
	const VCase cases[] = {
	    {"nothing", [](VShownTarget&) {}, false, 0.5, before},
	    {"weight", [](VShownTarget& io_rTarget) { io_rTarget.m_Weight = 7.0; }, true, 7.0, before},
	    {"state Z", [](VShownTarget& io_rTarget) { io_rTarget.m_State[2] = "3"; }, true, 0.5,
	        {"12.25*GlobalScale", "nonsense(", "1.500000*GlobalScale"}},
	    {"a text that is no number", [](VShownTarget& io_rTarget) { io_rTarget.m_State[0] = "twelve"; }, true, 0.5,
	        before},
	};
	for (const VCase& rCase : cases)
	{
		SCOPED_TRACE(rCase.m_pName);
		VSubjectParametrised subject = TargetSubject();
		const VShownTarget shown = RetargetSetup::ShowTarget(subject, 0);
		VShownTarget edited = shown;
		rCase.m_Edit(edited);
		EXPECT_EQ(RetargetSetup::ApplyEdits(subject, shown, edited), rCase.m_bChanged);
		EXPECT_EQ(subject.m_Targets[0].m_Weight, rCase.m_Weight);
		EXPECT_EQ(subject.m_Targets[0].m_StateExpressions, rCase.m_State);
	}
	VSubjectParametrised subject = TargetSubject();
	VShownTarget shown = RetargetSetup::ShowTarget(subject, 1);
	subject.m_Targets.pop_back();
	VShownTarget edited = shown;
	edited.m_Weight = 9.0;
	EXPECT_FALSE(RetargetSetup::ApplyEdits(subject, shown, edited)) << "the target has gone";
}

} // namespace
