#pragma once

#include "ComputeSubjectFK/ConstructionException.h"
#include "ComputeSubjectFK/SegmentFKInterfaces.h"

#include <cstddef>
#include <memory>
#include <span>
#include <vector>

namespace CoreOrlexTypes
{
struct VSubject;
}

namespace ComputeSubject
{

class ITargetFK;

/// Forward kinematics of a subject: built once, then one call of Update for each frame. Not thread safe; a copy is
/// deep and shares nothing, so that copies may run in parallel.
/// Positions are in millimetres, angles in radians.
class VComputeSubjectFK
{
public:
	/// A subject whose segments are not in parent-before-child order, or with a second root, gives an empty object.
	/// A target of a type that has no class is asserted and stays in the list as null.
	/// Throws VConstructionException for a joint or a target that does not fit its class.
	explicit VComputeSubjectFK(const CoreOrlexTypes::VSubject& i_rSubject);

	VComputeSubjectFK(const VComputeSubjectFK& i_rOther);
	VComputeSubjectFK& operator=(const VComputeSubjectFK&) = delete;
	virtual ~VComputeSubjectFK();

	virtual std::size_t NumberOfTargets() const;

	/// Null for a target of a type that has no class. An index out of range throws std::out_of_range.
	virtual const ITargetFK* Target(std::size_t i_Index) const;
	virtual ITargetFK* Target(std::size_t i_Index);

	virtual std::size_t NumberOfSegments() const;

	/// An index out of range throws std::out_of_range.
	virtual const IComputeSegmentFK& Segment(std::size_t i_Index) const;
	virtual IComputeSegmentFK& Segment(std::size_t i_Index);

	/// The sum of the joints' degrees of freedom.
	virtual std::size_t NumberOfStates() const;

	/// How many different markers, and rotation observations, the targets name.
	virtual std::size_t NumberOfMarkers() const;
	virtual std::size_t NumberOfRotations() const;

	/// True if every marker and rotation index of the targets is below NumberOfMarkers.
	virtual bool IsValid() const;

	/// Takes NumberOfStates() values in the order of the segments, and brings all segments and targets up to date.
	/// Allocates nothing.
	virtual void Update(const double* i_pState);

	/// The segment frames in the world in many frames, as Update and SegmentPose give them one after the other, but
	/// several at once. i_States holds NumberOfStates() values for each frame, o_Poses NumberOfSegments() poses; whole
	/// frames of both, as many as both hold, are computed. Segments and targets stay as they are, so that several
	/// threads may call it at a time; with i_Threads above 1 it uses so many itself.
	void UpdateMany(
	    std::span<const double> i_States, std::span<Rotation::VPose<double>> o_Poses, unsigned i_Threads = 1) const;

	/// The world position of each marker: the mean of its point and group targets, by their weights. A marker without
	/// weight is left at the origin; the result tells whether there is none. Indices beyond the list are left out.
	virtual bool ComputeMarkers(std::vector<Rotation::VVector3>& io_rPositions) const;

	/// The same, and of each marker whether it has weight.
	bool ComputeMarkers(std::vector<Rotation::VVector3>& io_rPositions, std::vector<bool>& o_rValid) const;

	/// The world rotation of each rotation observation, row by row; where several targets name one, the last holds.
	/// One without a target is the identity; the result tells whether there is none.
	virtual bool ComputeRotations(std::vector<Rotation::VMatrix3>& io_rRotations) const;

	/// The same, and of each observation whether it has a target.
	bool ComputeRotations(std::vector<Rotation::VMatrix3>& io_rRotations, std::vector<bool>& o_rValid) const;

	/// Wraps all angles of NumberOfStates() values into their principal range; the poses that they give stay.
	virtual void NormaliseState(double* io_pState) const;

private:
	VSegmentTree m_SegmentTree;
	std::vector<std::shared_ptr<ITargetFK>> m_Targets;
	std::size_t m_NumberOfStates = 0;
	std::size_t m_NumberOfMarkers = 0;
	std::size_t m_NumberOfRotations = 0;
};

} // namespace ComputeSubject
