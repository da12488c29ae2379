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
