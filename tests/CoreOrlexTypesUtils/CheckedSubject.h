#pragma once

#include "CoreOrlexTypes/Subject.h"

#include "DebugServices/GlobalLog.h"

#include <gtest/gtest.h>

#include <limits>

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;
using VTexts = std::vector<std::string>;
using VNumbers = std::vector<double>;

inline constexpr double c_NaN = std::numeric_limits<double>::quiet_NaN();
inline constexpr double c_Infinity = std::numeric_limits<double>::infinity();

/// A diagonal matrix, row by row.
inline VNumbers Diagonal(std::size_t i_Size, double i_Value)
{
	VNumbers matrix(i_Size * i_Size, 0.0);
	for (std::size_t i = 0; i < i_Size; ++i)
		matrix[i * i_Size + i] = i_Value;
	return matrix;
}

/// The covariance of a rigid body: its pose's block, then one for each marker.
inline VNumbers RigidBodyCovariance(std::size_t i_MarkerCount)
{
	VNumbers values = Diagonal(6, 2.0);
	for (std::size_t i = 0; i < i_MarkerCount; ++i)
	{
		const VNumbers block = Diagonal(3, 1.0);
		values.insert(values.end(), block.begin(), block.end());
	}
	return values;
}

inline VSubject::VTarget GoodTarget(VSubject::VTarget::ETargetType i_Type)
{
	using VTarget = VSubject::VTarget;
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

/// Two segments, four markers, two rotations, one good target of each type.
inline VSubject GoodSubject()
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
		subject.m_Targets.push_back(GoodTarget(VSubject::VTarget::ETargetType(type)));
	return subject;
}

/// Messages as "category: text" in their order; all are errors.
class CheckedSubject : public testing::Test
{
protected:
	VTexts TakeLog() { return std::exchange(m_Log, {}); }

	/// What is told while a check fails, and that it fails.
	template <typename TCheck>
	VTexts Failing(TCheck&& i_rCheck)
	{
		m_Log.clear();
		EXPECT_FALSE(i_rCheck());
		return TakeLog();
	}

	template <typename TCheck>
	void ExpectPasses(TCheck&& i_rCheck)
	{
		m_Log.clear();
		EXPECT_TRUE(i_rCheck());
		EXPECT_EQ(TakeLog(), VTexts{});
	}

private:
	VTexts m_Log;
	std::shared_ptr<void> m_pSink = NVX::GlobalLog::AddSink(
	    [this](const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rMessage)
	    {
		    EXPECT_EQ(i_Level, 2);
		    m_Log.push_back((i_rCategory.Name() == "SubjectCheck" ? "" : i_rCategory.Name() + ": ") + i_rMessage);
	    });
};
