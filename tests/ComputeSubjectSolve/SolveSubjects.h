#pragma once

#include "../ComputeSubjectFK/ReferenceFK.h"

#include "ComputeSubjectSolve/ComputeSubjectSolve.h"

#include <string>

/// Subjects whose targets determine them, for the tests and benchmarks of the solve.
namespace SolveSubjects
{

using Reference::VSubject;

enum class ETargets
{
	/// A point and a rotation on each segment.
	EPointsAndRotations,
	/// Three points on each segment, as a rigid body, and nothing that tells a joint's rotation at once.
	EPoints,
	/// These on one segment, those on the next.
	EMixed
};

/// A free root; below it a tree of chains, of all joint types or of ball joints alone.
VSubject Tree(std::mt19937& io_rRandom, std::size_t i_Segments, bool i_bBallsOnly);

/// A subject of the skeleton of an FBX file in tests/data/fbx, with its bind pose.
struct VCharacter
{
	std::string m_Name;
	VSubject m_Subject;
	std::vector<double> m_BindPose;
};
std::vector<VCharacter> Characters();

/// Replaces the targets.
void SetTargets(std::mt19937& io_rRandom, ETargets i_Targets, VSubject& io_rSubject);

/// What the targets of the subject would observe exactly in a pose.
struct VExactObservations
{
	std::vector<double> m_Positions;
	std::vector<double> m_Rotations;

	ComputeSubject::VObservations Spans() const { return {m_Positions, m_Rotations}; }
};
VExactObservations Observe(const VSubject& i_rSubject, const std::vector<double>& i_rStates);

} // namespace SolveSubjects
