#pragma once

#include "CoreOrlexTypesUtils/check/SubjectCheck.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "CoreOrlexTypesUtils/joints/PoseVector.h"
#include "TakeIO/ReadTake.h"
#include "TakeSolve/Performer.h"
#include "TakeSolve/SourceMotion.h"

#include <gtest/gtest.h>

#include <memory>

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;

/// Of millimetres with Z up.
inline std::shared_ptr<const TakeIO::VTake> TakeOf(const std::string& i_rText)
{
	const auto pTake = std::make_shared<TakeIO::VTake>();
	std::string error;
	EXPECT_TRUE(TakeIO::ReadTakeFrom(i_rText, {TakeIO::EUp::Z, 1.0, {}}, *pTake, error)) << error;
	return pTake;
}

inline std::shared_ptr<const TakeIO::VTake> ChestTake()
{
	const auto pTake = std::make_shared<TakeIO::VTake>();
	std::string error;
	EXPECT_TRUE(
	    TakeIO::ReadTake(RETARGET_TEST_DATA "/motion/chest_yxz_120fps.bvh", {TakeIO::EUp::Y, 10.0, {}}, *pTake, error))
	    << error;
	return pTake;
}

/// A performer of a take in numbers, with its bind pose.
struct VTakePerformer
{
	explicit VTakePerformer(const TakeIO::VTake& i_rTake)
	    : m_Record(TakeSolve::MakePerformer(i_rTake, TakeSolve::StandingPose(i_rTake), "performer", m_Findings)),
	      m_BindPose(CoreOrlexTypesUtils::PoseVector(
	          m_Record.m_SubjectParametrised, &VSubjectParametrised::VJoint::m_BindPose))
	{
		EXPECT_TRUE(CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(
		    m_Record.m_SubjectParametrised, m_Subject));
	}

	std::vector<TakeSolve::VFinding> m_Findings;
	CoreOrlexTypes::VSubjectRecord m_Record;
	std::vector<double> m_BindPose;
	VSubject m_Subject;
};

inline void ExpectPose(const Rotation::VPose<double>& i_rActual, const Rotation::VMatrix3& i_rRotation,
    const Rotation::VVector3& i_rPlace, double i_Within, const std::string& i_rWhat)
{
	for (std::size_t i = 0; i < 9; ++i)
		EXPECT_NEAR(i_rActual.R[i], i_rRotation[i], i_Within) << i_rWhat << ", rotation " << i;
	for (std::size_t i = 0; i < 3; ++i)
		EXPECT_NEAR(i_rActual.t[i], i_rPlace[i], 1e3 * i_Within) << i_rWhat << ", axis " << i;
}

/// Whether one is told with this word, and these words in its sentence.
inline bool Tells(
    const std::vector<TakeSolve::VFinding>& i_rFindings, const std::string& i_rId, const std::string& i_rPart)
{
	for (const auto& rFinding : i_rFindings)
		if (rFinding.m_pId == i_rId && rFinding.m_Message.find(i_rPart) != std::string::npos)
			return true;
	return false;
}
