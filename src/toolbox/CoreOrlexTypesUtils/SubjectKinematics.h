#pragma once

#include "CoreOrlexTypesUtils/observations/Renumbering.h"
#include "numerics/Rotation.h"

#include <cstddef>
#include <memory>
#include <span>
#include <vector>

namespace ComputeSubject
{
class IComputeSegmentFK;
class ITargetFK;
class VComputeSubjectFK;
} // namespace ComputeSubject

namespace CoreOrlexTypes
{
struct VSubject;
}

namespace CoreOrlexTypesUtils
{

/// Forward kinematics of a subject as it is, by the subject's own indices. ComputeSubject::VComputeSubjectFK takes the
/// markers and rotation observations that targets name to be the first of their lists, and asserts and throws at
/// targets that have no kinematics: this builds it of the other targets, renumbered. Used by one thread at a time.
class VSubjectKinematics
{
public:
	explicit VSubjectKinematics(const CoreOrlexTypes::VSubject& i_rSubject);
	VSubjectKinematics(VSubjectKinematics&&) noexcept;
	~VSubjectKinematics();

	/// False if the segments make no tree, or more than one, or have a joint that does not fit its type. Only
	/// Target, which is null then, and MisfitTargets may be called then.
	bool IsBuilt() const { return m_pKinematics != nullptr; }

	/// The targets that do not fit their type or name a marker that the subject does not have.
	const std::vector<std::size_t>& MisfitTargets() const { return m_Misfits; }

	/// Null for a misfit, and for a target of a type that has no kinematics.
	const ComputeSubject::ITargetFK* Target(std::size_t i_Index) const;
	const ComputeSubject::IComputeSegmentFK& Segment(std::size_t i_Index) const;
	std::size_t NumberOfStates() const;

	/// Takes NumberOfStates() values in the order of the segments.
	void Update(const double* i_pState);

	/// ComputeSubject::VComputeSubjectFK::UpdateMany.
	void UpdateMany(
	    std::span<const double> i_States, std::span<Rotation::VPose<double>> o_Poses, unsigned i_Threads = 1) const;

	/// World positions of all markers, in millimetres, and world rotations of all observations, row by row; not valid,
	/// and zero or the identity, where no target with weight tells one.
	void ComputeMarkers(std::vector<Rotation::VVector3>& io_rPositions, std::vector<bool>& o_rValid) const;
	void ComputeRotations(std::vector<Rotation::VMatrix3>& io_rRotations, std::vector<bool>& o_rValid) const;

private:
	std::vector<std::size_t> m_Misfits;
	VRenumbering m_Targets{{}};
	VRenumbering m_Markers{{}};
	VRenumbering m_Rotations{{}};
	std::size_t m_MarkerCount = 0;
	std::size_t m_RotationCount = 0;
	/// Null if it cannot be built.
	std::unique_ptr<ComputeSubject::VComputeSubjectFK> m_pKinematics;
};

} // namespace CoreOrlexTypesUtils
