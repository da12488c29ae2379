#pragma once

#include "ComputeSubjectFK/TargetFKInterfaces.h"

#include <initializer_list>

namespace ComputeSubject
{

/// What all target classes share. Everything that they store was carried into the parent segment's joint frame when
/// they were built, so that a frame costs the application of one pose.
/// Constructors throw VConstructionException for a target whose type, state size, parent index or number of markers
/// or rotation observations does not fit the class.
class VTargetFKBase : public IComputeTargetFK
{
public:
	using VTarget = CoreOrlexTypes::VSubject::VTarget;

	VTarget::ETargetType TargetType() const override { return m_Type; }
	double Weight() const override { return m_Weight; }

	/// Follows the same segment of another tree; throws VConstructionException if it has none of the index.
	void Bind(const VSegmentTree& i_rSegments);

protected:
	VTargetFKBase(
	    const VTarget& i_rTarget, const VSegmentTree& i_rSegments, std::initializer_list<VTarget::ETargetType> i_Types);

	const Rotation::VPose<double>& World() const { return *m_pWorldPose; }
	const Rotation::VPose<double>& Post() const { return *m_pPostPose; }

private:
	VTarget::ETargetType m_Type;
	double m_Weight;
	std::uint32_t m_ParentSegmentIndex = 0;
	/// Of the parent segment, which the subject keeps alive.
	const Rotation::VPose<double>* m_pWorldPose = nullptr;
	const Rotation::VPose<double>* m_pPostPose = nullptr;
};

/// State: the point in the segment frame.
class VTargetFKLocalPointToWorldPoint : public VTargetFKBase,
                                        public IComputeTargetSingleMarker,
                                        public IComputeTargetFromLocalPoint
{
public:
	VTargetFKLocalPointToWorldPoint(const VTarget& i_rTarget, const VSegmentTree& i_rSegments);
	void Update() override;
	std::uint32_t MarkerIdx() const override { return m_MarkerIdx; }
	const Rotation::VVector3& WorldPoint() const override { return m_WorldPoint; }

private:
	std::uint32_t m_MarkerIdx;
	Rotation::VVector3 m_Point;
	Rotation::VVector3 m_WorldPoint{};
};

/// State: two points in the segment frame.
class VTargetFKLocalLineToWorldPoint : public VTargetFKBase,
                                       public IComputeTargetSingleMarker,
                                       public IComputeTargetFromLocalLine
{
public:
	VTargetFKLocalLineToWorldPoint(const VTarget& i_rTarget, const VSegmentTree& i_rSegments);
	void Update() override;
	std::uint32_t MarkerIdx() const override { return m_MarkerIdx; }
	const Rotation::VVector3& WorldPoint1() const override { return m_WorldPoint1; }
	const Rotation::VVector3& WorldPoint2() const override { return m_WorldPoint2; }

private:
	std::uint32_t m_MarkerIdx;
	Rotation::VVector3 m_Point1;
	Rotation::VVector3 m_Point2;
	Rotation::VVector3 m_WorldPoint1{};
	Rotation::VVector3 m_WorldPoint2{};
};

/// State: a point on the plane and its normal, of any length, in the segment frame. A zero normal stays zero.
class VTargetFKLocalPlaneToWorldPoint : public VTargetFKBase,
                                        public IComputeTargetSingleMarker,
                                        public IComputeTargetFromLocalPlane
{
public:
	VTargetFKLocalPlaneToWorldPoint(const VTarget& i_rTarget, const VSegmentTree& i_rSegments);
	void Update() override;
	std::uint32_t MarkerIdx() const override { return m_MarkerIdx; }
	const Rotation::VVector3& WorldNormal() const override { return m_WorldNormal; }
	double WorldOffset() const override { return m_WorldOffset; }

private:
	std::uint32_t m_MarkerIdx;
	Rotation::VVector3 m_Normal;
	double m_Offset;
	Rotation::VVector3 m_WorldNormal{};
	double m_WorldOffset = 0.0;
};

/// State: position and angle-axis of the body in the segment frame, then the markers, at least two, in the body frame.
class VTargetFKRigidBody : public VTargetFKBase, public IComputeTargetMarkerGroup, public IComputeTargetFromPointGroup
{
public:
	VTargetFKRigidBody(const VTarget& i_rTarget, const VSegmentTree& i_rSegments);
	void Update() override;
	std::span<const std::uint32_t> MarkerIndices() const override { return m_MarkerIndices; }
	const Rotation::VVector3& WorldPoint(std::size_t i_Marker) const override { return m_WorldPoints.at(i_Marker); }
	const Rotation::VVector3& WorldOrigin() const override { return m_WorldOrigin; }
	std::span<const Rotation::VVector3> LocalPoints() const override { return m_Points; }

private:
	std::vector<std::uint32_t> m_MarkerIndices;
	Rotation::VPose<double> m_Body;
	std::vector<Rotation::VVector3> m_Points;
	std::vector<Rotation::VVector3> m_WorldPoints;
	Rotation::VVector3 m_WorldOrigin{};
};

/// State: an angle-axis in the segment frame, turned further by RotationTargetOrientation if that is given.
class VTargetFKLocalRotationToWorldRotation : public VTargetFKBase,
                                              public IComputeTargetSingleRotationObservation,
                                              public IComputeTargetFromLocalRotation
{
public:
	VTargetFKLocalRotationToWorldRotation(const VTarget& i_rTarget, const VSegmentTree& i_rSegments);
	void Update() override;
	std::uint32_t RotationIdx() const override { return m_RotationIdx; }
	const Rotation::VMatrix3& WorldRotation() const override { return m_WorldRotation; }

private:
	std::uint32_t m_RotationIdx;
	Rotation::VMatrix3 m_Rotation;
	Rotation::VMatrix3 m_WorldRotation = Rotation::c_Identity3;
};

} // namespace ComputeSubject
