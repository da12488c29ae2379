#include "ComputeSubjectFK/Targets.h"

#include "ComputeSubjectFK/ComputeSegmentFK.h"
#include "ComputeSubjectFK/ConstructionException.h"
#include "DebugServices/Assert.h"

#include <algorithm>
#include <cmath>

namespace ComputeSubject
{
namespace
{

using CoreOrlexTypes::VSubject;
using Rotation::VVector3;

void Require(bool i_bFits)
{
	if (!i_bFits)
		throw VConstructionException();
}

std::uint32_t SingleMarker(const VSubject::VTarget& i_rTarget)
{
	Require(i_rTarget.m_MarkerIndices.size() == 1);
	return i_rTarget.m_MarkerIndices.front();
}

/// i_Triple counts vectors of three. The state must hold it.
VVector3 StateVector(const VSubject::VTarget& i_rTarget, std::size_t i_Triple)
{
	const double* pFirst = i_rTarget.m_State.data() + 3 * i_Triple;
	return {pFirst[0], pFirst[1], pFirst[2]};
}

void RequireStateSize(const VSubject::VTarget& i_rTarget, std::size_t i_Size)
{
	Require(i_rTarget.m_State.size() == i_Size);
}

double Dot(const VVector3& i_rA, const VVector3& i_rB)
{
	return i_rA[0] * i_rB[0] + i_rA[1] * i_rB[1] + i_rA[2] * i_rB[2];
}

} // namespace

VTargetFKBase::VTargetFKBase(
    const VTarget& i_rTarget, const VSegmentTree& i_rSegments, std::initializer_list<VTarget::ETargetType> i_Types)
    : m_Type(i_rTarget.m_Type), m_Weight(i_rTarget.m_Weight)
{
	Require(std::find(i_Types.begin(), i_Types.end(), m_Type) != i_Types.end());
	Require(i_rTarget.m_SegmentIndices.size() == 1);
	m_ParentSegmentIndex = i_rTarget.m_SegmentIndices.front();
	Bind(i_rSegments);
}

void VTargetFKBase::Bind(const VSegmentTree& i_rSegments)
{
	Require(m_ParentSegmentIndex < i_rSegments.size());
	const VComputeSegmentFK& rParent = *i_rSegments[m_ParentSegmentIndex];
	m_pWorldPose = &rParent.WorldPose();
	m_pPostPose = &rParent.PostPose();
}

VTargetFKLocalPointToWorldPoint::VTargetFKLocalPointToWorldPoint(
    const VTarget& i_rTarget, const VSegmentTree& i_rSegments)
    : VTargetFKBase(
        i_rTarget, i_rSegments, {VTarget::ELocalPointToWorldPoint, VTarget::ELocalPointToWorldPointGaussian}),
      m_MarkerIdx(SingleMarker(i_rTarget))
{
	RequireStateSize(i_rTarget, 3);
	m_Point = Rotation::Apply(Post(), StateVector(i_rTarget, 0));
}

void VTargetFKLocalPointToWorldPoint::Update()
{
	m_WorldPoint = Rotation::Apply(World(), m_Point);
}

VTargetFKLocalLineToWorldPoint::VTargetFKLocalLineToWorldPoint(
    const VTarget& i_rTarget, const VSegmentTree& i_rSegments)
    : VTargetFKBase(i_rTarget, i_rSegments, {VTarget::ELocalLineToWorldPoint, VTarget::ELocalLineToWorldPointGaussian}),
      m_MarkerIdx(SingleMarker(i_rTarget))
{
	RequireStateSize(i_rTarget, 6);
	m_Point1 = Rotation::Apply(Post(), StateVector(i_rTarget, 0));
	m_Point2 = Rotation::Apply(Post(), StateVector(i_rTarget, 1));
}

void VTargetFKLocalLineToWorldPoint::Update()
{
	m_WorldPoint1 = Rotation::Apply(World(), m_Point1);
	m_WorldPoint2 = Rotation::Apply(World(), m_Point2);
}

VTargetFKLocalPlaneToWorldPoint::VTargetFKLocalPlaneToWorldPoint(
    const VTarget& i_rTarget, const VSegmentTree& i_rSegments)
    : VTargetFKBase(
        i_rTarget, i_rSegments, {VTarget::ELocalPlaneToWorldPoint, VTarget::ELocalPlaneToWorldPointGaussian}),
      m_MarkerIdx(SingleMarker(i_rTarget))
{
	Require(i_rTarget.m_State.size() >= 6);
	auto StateIter = i_rTarget.m_State.begin();
	VVector3 origin;
	for (double& rValue : origin)
		rValue = *StateIter++;
	VVector3 normal;
	for (double& rValue : normal)
		rValue = *StateIter++;
	NVX_ASSERT(StateIter == i_rTarget.m_State.end());
	Require(StateIter == i_rTarget.m_State.end());

	const double length = std::hypot(normal[0], normal[1], normal[2]);
	if (length > 0.0)
		for (double& rValue : normal)
			rValue /= length;
	m_Normal = Rotation::Product(Post().R, normal);
	m_Offset = -Dot(normal, origin) - Dot(m_Normal, Post().t);
}

void VTargetFKLocalPlaneToWorldPoint::Update()
{
	m_WorldNormal = Rotation::Product(World().R, m_Normal);
	m_WorldOffset = m_Offset - Dot(m_WorldNormal, World().t);
}

VTargetFKRigidBody::VTargetFKRigidBody(const VTarget& i_rTarget, const VSegmentTree& i_rSegments)
    : VTargetFKBase(i_rTarget, i_rSegments, {VTarget::ERigidBody}), m_MarkerIndices(i_rTarget.m_MarkerIndices)
{
	const std::size_t markers = m_MarkerIndices.size();
	Require(markers >= 2);
	RequireStateSize(i_rTarget, 3 * (markers + 2));
	m_Body =
	    Rotation::Compose(Post(), Rotation::PoseFromAngleAxis(StateVector(i_rTarget, 1), StateVector(i_rTarget, 0)));
	m_Points.reserve(markers);
	for (std::size_t i = 0; i < markers; ++i)
		m_Points.push_back(Rotation::Apply(m_Body, StateVector(i_rTarget, 2 + i)));
	m_WorldPoints.resize(markers);
}

void VTargetFKRigidBody::Update()
{
	for (std::size_t i = 0; i < m_Points.size(); ++i)
		m_WorldPoints[i] = Rotation::Apply(World(), m_Points[i]);
	m_WorldOrigin = Rotation::Apply(World(), m_Body.t);
}

VTargetFKLocalRotationToWorldRotation::VTargetFKLocalRotationToWorldRotation(
    const VTarget& i_rTarget, const VSegmentTree& i_rSegments)
    : VTargetFKBase(i_rTarget, i_rSegments, {VTarget::ELocalRotationToWorldRotation})
{
	const std::vector<double>& rOrientation = i_rTarget.m_RotationTargetOrientation;
	Require(i_rTarget.m_MarkerIndices.empty() && i_rTarget.m_RotationObservationIndices.size() == 1);
	Require(rOrientation.empty() || rOrientation.size() == 3);
	RequireStateSize(i_rTarget, 3);
	m_RotationIdx = i_rTarget.m_RotationObservationIndices.front();

	VVector3 orientation{};
	std::copy(rOrientation.begin(), rOrientation.end(), orientation.begin());
	m_Rotation = Rotation::Product(Rotation::Transposed(Post().R),
	    Rotation::Product(Rotation::RotationMatrixFromAngleAxis(orientation),
	        Rotation::RotationMatrixFromAngleAxis(StateVector(i_rTarget, 0))));
}

void VTargetFKLocalRotationToWorldRotation::Update()
{
	m_WorldRotation = Rotation::Product(World().R, m_Rotation);
}

} // namespace ComputeSubject
