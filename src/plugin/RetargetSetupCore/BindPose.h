#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "numerics/Rotation.h"

#include <cstddef>
#include <memory>
#include <optional>
#include <string_view>
#include <vector>

namespace ComputeSubject
{
class VComputeSubjectFK;
}

namespace RetargetSetup
{

/// The kinematics of a subject's segments, without its targets, at rest in the bind pose.
/// @param i_rSubject converted from i_rParametrised.
/// @param i_Which "source" or "target", for the message.
/// @return null, which is told, if the segments make no tree: the subject is then as good as missing.
std::unique_ptr<ComputeSubject::VComputeSubjectFK> KinematicsInBindPose(
    const CoreOrlexTypes::VSubjectParametrised& i_rParametrised, const CoreOrlexTypes::VSubject& i_rSubject,
    std::string_view i_Which);

/// World poses of all segments, in order.
std::vector<Rotation::VPose<double>> SegmentPoses(const ComputeSubject::VComputeSubjectFK& i_rFK);

/// Of the rotation from one to the other, in radians from 0 to pi.
double AngleBetween(const Rotation::VMatrix3& i_rA, const Rotation::VMatrix3& i_rB);

struct VPoseDifference
{
	std::size_t m_SegmentIndex = 0;
	/// Between the origins, in mm.
	double m_Distance = 0.0;
	/// Of the rotation between the two, in radians.
	double m_Angle = 0.0;
};

/// Below these two poses count as the same: what six printed digits of a file leave open over a chain of bones.
inline constexpr double c_SamePoseDistance = 0.05;
inline constexpr double c_SamePoseAngle = 1e-4;

/// The segment that is farthest from where it was, or if none is away by c_SamePoseDistance the one that is turned
/// most; nothing if all are the same. Two lists of different length are compared over the shorter one.
std::optional<VPoseDifference> WorstPoseDifference(
    const std::vector<Rotation::VPose<double>>& i_rBefore, const std::vector<Rotation::VPose<double>>& i_rAfter);

} // namespace RetargetSetup
