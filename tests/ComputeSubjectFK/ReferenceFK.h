#pragma once

#include "../Assertions.h"

#include "CoreOrlexTypes/Subject.h"
#include "numerics/Rotation.h"

#include <Eigen/Geometry>

#include <numbers>
#include <random>
#include <vector>

/// Subjects for the tests, and the same kinematics written down naively with 4x4 matrices, one segment at a time by
/// recursion to the root.
namespace Reference
{

using CoreOrlexTypes::c_NoParent;
using CoreOrlexTypes::VSubject;
using EJointType = CoreOrlexTypes::VSubjectParametrised::VJoint::EJointType;
using VJointTypes = CoreOrlexTypes::VSubjectParametrised::VJoint;

constexpr double c_Pi = std::numbers::pi;

VSubject::VSegment Segment(
    std::uint32_t i_Parent, EJointType i_Type, std::array<double, 3> i_PreTranslation = {0.0, 0.0, 0.0});
VSubject::VTarget Target(
    VSubject::VTarget::ETargetType i_Type, std::uint32_t i_Segment, std::vector<double> i_State, std::uint32_t i_Index);

/// Every joint type, every field of the chain set, parents anywhere before their children.
VSubject RandomSubject(std::mt19937& io_rRandom, std::size_t i_Segments);
std::vector<double> RandomState(std::mt19937& io_rRandom, const VSubject& i_rSubject, double i_Size);

Eigen::Isometry3d Pose(const std::array<double, 3>& i_rRotation, const std::array<double, 3>& i_rTranslation);

/// The segment frame in the world.
Eigen::Isometry3d SegmentPose(const VSubject& i_rSubject, const std::vector<double>& i_rState, std::size_t i_Segment);

/// The joint frame in the world: the segment frame with the post pose after it.
Eigen::Isometry3d WorldPose(const VSubject& i_rSubject, const std::vector<double>& i_rState, std::size_t i_Segment);

/// The largest difference between entries; translations are in mm, so that 1e-9 is far below any use.
double Difference(const Rotation::VPose<double>& i_rPose, const Eigen::Isometry3d& i_rExpected);
double Difference(const Rotation::VMatrix3& i_rMatrix, const Eigen::Matrix3d& i_rExpected);
double Difference(const Rotation::VVector3& i_rPoint, const Eigen::Vector3d& i_rExpected);

} // namespace Reference
