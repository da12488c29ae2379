#include "SolveSubjects.h"

#include "ComputeSubjectSolve/ComputeSubjectSolve.h"

#include <gtest/gtest.h>

#include <cstdlib>

namespace
{

using namespace ComputeSubject;
using namespace SolveSubjects;

constexpr VSolveScales c_TargetsAlone{0.0, 0.0, 0.0};

struct VTargetsRow
{
	const char* m_pName;
	ETargets m_Targets;
};

constexpr VTargetsRow c_Rows[] = {{"a point and a rotation each", ETargets::EPointsAndRotations},
    {"three points each", ETargets::EPoints}, {"these and those in turn", ETargets::EMixed}};

/// Six characters and fourteen trees of all kinds of joints. RETARGET_SOLVE_POSES=500 takes half a minute of a
/// processor.
TEST(ExactPoses, AreFoundAgainFromTheirObservations)
{
	const char* const pCount = std::getenv("RETARGET_SOLVE_POSES");
#ifdef RETARGET_SANITIZED
	constexpr int c_FewPoses = 1;
#else
	constexpr int c_FewPoses = 5;
#endif
	const int poses = pCount ? std::atoi(pCount) : c_FewPoses;
	std::mt19937 random(1);
	std::vector<VCharacter> subjects = Characters();
	ASSERT_EQ(subjects.size(), 6u);
	for (const bool bBalls : {false, true})
		for (std::size_t segments = 12; segments < 47; segments += 5)
			subjects.push_back(
			    {std::to_string(segments) + (bBalls ? " balls" : " joints"), Tree(random, segments, bBalls), {}});
	for (auto& [rName, rSubject, rBindPose] : subjects)
		for (const VTargetsRow& rRow : c_Rows)
		{
			SCOPED_TRACE(rName + ", " + rRow.m_pName);
			SetTargets(random, rRow.m_Targets, rSubject);
			VComputeSubjectSolve solve(rSubject, rBindPose, c_TargetsAlone);
			int found = 0;
			for (int pose = 0; pose < poses; ++pose)
			{
				std::vector<double> states = Reference::RandomState(random, rSubject, 0.3);
				for (std::size_t i = 0; i < rBindPose.size(); ++i)
					states[i] += rBindPose[i];
				const VExactObservations exact = Observe(rSubject, states);
				solve.Restart();
				const VSolvedFrame& rFrame = solve.Solve(exact.Spans());
				EXPECT_TRUE(rFrame.m_bSeeded);
				bool bMet = rFrame.m_bConverged;
				for (std::size_t i = 0; i < rFrame.m_Residuals.size(); ++i)
					bMet &= rFrame.m_Residuals[i] < (rSubject.m_Targets[i].m_MarkerIndices.empty() ? 1e-8 : 1e-6);
				found += bMet;
			}
			EXPECT_EQ(found, poses);
		}
}

} // namespace
