#include "RetargetSetupCore/Mirror.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "RetargetSetupCore/BindPose.h"

#include <algorithm>
#include <cmath>

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;

namespace RetargetSetup
{

namespace
{

/// Joints nearer than this, in mm, coincide.
constexpr double c_SamePlace = 1e-3;
/// Below this angle between a pose and its mirror image, in radians, nobody sees the difference.
constexpr double c_SameMirror = 1e-3;

/// The rotation of a segment's joint, taken in the world.
Rotation::VMatrix3 WorldTurn(
    const std::vector<Rotation::VPose<double>>& i_rPoses, const VSubject& i_rSubject, std::size_t i_SegmentIndex)
{
	const VSubject::VSegment& rSegment = i_rSubject.m_Segments[i_SegmentIndex];
	Rotation::VMatrix3 frame = Rotation::RotationMatrixFromAngleAxis(rSegment.m_PreRotation);
	if (rSegment.m_ParentSegmentIndex != CoreOrlexTypes::c_NoParent)
		frame = Rotation::Product(i_rPoses[rSegment.m_ParentSegmentIndex].R, frame);
	return Rotation::Product(i_rPoses[i_SegmentIndex].R, Rotation::Transposed(frame));
}

} // namespace

Rotation::VVector3 Mirrored(const Rotation::VVector3& i_rRotation, const Rotation::VVector3& i_rNormal)
{
	const double along = i_rRotation[0] * i_rNormal[0] + i_rRotation[1] * i_rNormal[1] + i_rRotation[2] * i_rNormal[2];
	Rotation::VVector3 mirrored{};
	for (std::size_t i = 0; i < mirrored.size(); ++i)
		mirrored[i] = 2.0 * along * i_rNormal[i] - i_rRotation[i];
	return mirrored;
}

Rotation::VVector3 MirrorNormal(const Rotation::VVector3& i_rA, const Rotation::VVector3& i_rB)
{
	Rotation::VVector3 normal{i_rA[0] - i_rB[0], i_rA[1] - i_rB[1], i_rA[2] - i_rB[2]};
	const double length = std::hypot(normal[0], normal[1], normal[2]);
	for (double& rValue : normal)
		rValue = length < c_SamePlace ? 0.0 : rValue / length;
	return normal;
}

bool AreMirrorImages(const VSubjectParametrised& i_rParametrised, const VSubject& i_rSubject,
    std::size_t i_SegmentIndex, std::size_t i_MirrorIndex)
{
	const auto pFK = KinematicsInBindPose(i_rParametrised, i_rSubject, "target");
	if (!pFK || std::max(i_SegmentIndex, i_MirrorIndex) >= pFK->NumberOfSegments())
		return true;
	const std::vector<Rotation::VPose<double>> poses = SegmentPoses(*pFK);
	const Rotation::VVector3 turn = Rotation::AngleAxisFromRotationMatrix(WorldTurn(poses, i_rSubject, i_SegmentIndex));
	const Rotation::VVector3 mirrored = Mirrored(turn, MirrorNormal(poses[i_SegmentIndex].t, poses[i_MirrorIndex].t));
	return AngleBetween(Rotation::RotationMatrixFromAngleAxis(mirrored), WorldTurn(poses, i_rSubject, i_MirrorIndex))
	    < c_SameMirror;
}

} // namespace RetargetSetup
