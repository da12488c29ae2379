#pragma once

#include "ComputeSubjectFK/SegmentFKInterfaces.h"
#include "CoreOrlexTypes/Subject.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>
#include <vector>

namespace ComputeSubject
{

class IComputeTargetFK
{
public:
	virtual ~IComputeTargetFK() = default;
	virtual CoreOrlexTypes::VSubject::VTarget::ETargetType TargetType() const = 0;

	/// Brings the results up to the parent segment's present WorldPose.
	virtual void Update() = 0;

	virtual double Weight() const = 0;
};

class IComputeTargetSingleMarker
{
public:
	virtual ~IComputeTargetSingleMarker() = default;
	virtual std::uint32_t MarkerIdx() const = 0;
};

class IComputeTargetSingleRotationObservation
{
public:
	virtual ~IComputeTargetSingleRotationObservation() = default;
	virtual std::uint32_t RotationIdx() const = 0;
};

class IComputeTargetMarkerGroup
{
public:
	virtual ~IComputeTargetMarkerGroup() = default;
	virtual std::span<const std::uint32_t> MarkerIndices() const = 0;
};

class IComputeTargetFromLocalPoint
{
public:
	virtual ~IComputeTargetFromLocalPoint() = default;
	virtual const Rotation::VVector3& WorldPoint() const = 0;
};

class IComputeTargetFromLocalLine
{
public:
	virtual ~IComputeTargetFromLocalLine() = default;
	virtual const Rotation::VVector3& WorldPoint1() const = 0;
	virtual const Rotation::VVector3& WorldPoint2() const = 0;
};

/// A point x lies on the plane if WorldNormal . x + WorldOffset is 0.
class IComputeTargetFromLocalPlane
{
public:
	virtual ~IComputeTargetFromLocalPlane() = default;
	virtual const Rotation::VVector3& WorldNormal() const = 0;
	virtual double WorldOffset() const = 0;
};

class IComputeTargetFromLocalRotation
{
public:
	virtual ~IComputeTargetFromLocalRotation() = default;
	virtual const Rotation::VMatrix3& WorldRotation() const = 0;
};

class IComputeTargetFromPointGroup
{
public:
	virtual ~IComputeTargetFromPointGroup() = default;

	/// i_Marker counts within the group.
	virtual const Rotation::VVector3& WorldPoint(std::size_t i_Marker) const = 0;

	/// The body's position in the world.
	virtual const Rotation::VVector3& WorldOrigin() const = 0;

	/// The markers in the parent's joint frame, parallel to the group's marker indices.
	virtual std::span<const Rotation::VVector3> LocalPoints() const = 0;
};

/// One target of a subject, as the interfaces that its class offers; those that it does not offer are null.
class ITargetFK
{
public:
	virtual ~ITargetFK() = default;

	/// The same target on the segments of another instance; shares nothing with this one.
	virtual std::shared_ptr<ITargetFK> Clone(const VSegmentTree& i_rSegments) const = 0;

	const std::shared_ptr<IComputeTargetFK>& ComputeTargetFK() const { return m_pTargetFK; }
	const std::shared_ptr<IComputeTargetSingleMarker>& SingleMarker() const { return m_pSingleMarker; }
	const std::shared_ptr<IComputeTargetSingleRotationObservation>& SingleRotationObservation() const
	{
		return m_pSingleRotationObservation;
	}
	const std::shared_ptr<IComputeTargetMarkerGroup>& MarkerGroup() const { return m_pMarkerGroup; }
	const std::shared_ptr<IComputeTargetFromLocalPoint>& FromLocalPoint() const { return m_pFromLocalPoint; }
	const std::shared_ptr<IComputeTargetFromLocalLine>& FromLocalLine() const { return m_pFromLocalLine; }
	const std::shared_ptr<IComputeTargetFromLocalPlane>& FromLocalPlane() const { return m_pFromLocalPlane; }
	const std::shared_ptr<IComputeTargetFromLocalRotation>& FromLocalRotation() const { return m_pFromLocalRotation; }
	const std::shared_ptr<IComputeTargetFromPointGroup>& FromPointGroup() const { return m_pFromPointGroup; }

protected:
	std::shared_ptr<IComputeTargetFK> m_pTargetFK;
	std::shared_ptr<IComputeTargetSingleMarker> m_pSingleMarker;
	std::shared_ptr<IComputeTargetSingleRotationObservation> m_pSingleRotationObservation;
	std::shared_ptr<IComputeTargetMarkerGroup> m_pMarkerGroup;
	std::shared_ptr<IComputeTargetFromLocalPoint> m_pFromLocalPoint;
	std::shared_ptr<IComputeTargetFromLocalLine> m_pFromLocalLine;
	std::shared_ptr<IComputeTargetFromLocalPlane> m_pFromLocalPlane;
	std::shared_ptr<IComputeTargetFromLocalRotation> m_pFromLocalRotation;
	std::shared_ptr<IComputeTargetFromPointGroup> m_pFromPointGroup;
};

} // namespace ComputeSubject
