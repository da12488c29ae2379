#pragma once

#include "CoreOrlexTypes/Subject.h"

#include "numerics/Rotation.h"

#include <array>
#include <vector>

/// A rigid body is a prop or a cluster of markers, modelled as a subject: a free root and dummy segments below it, with
/// either one target of type ERigidBody or several point targets on the root. The state of an ERigidBody target is the
/// body's position (mm), its orientation as an angle-axis vector (radians), and the markers' positions in the body's
/// frame; its covariance is the 6x6 matrix of the pose, position first, and a 3x3 matrix for each marker, row by row.
/// Functions for both subject types take TSubject or its target. They log to the category "RigidBodyUtils" and return
/// false for what does not fit, with nothing changed.
namespace CoreOrlexTypesUtils::RigidBodyUtils
{

using VPoseCovariance = std::array<double, 36>;

/// A marker without covariance gets 5 on the diagonal (told as a warning), so that all are of use. The expressions of a
/// parametrised target may use no parameters.
template <typename TTarget>
bool ReadRigidBody(const TTarget& i_rTarget, Rotation::VPose<double>& o_rPose,
    std::vector<Rotation::VVector3>& o_rLocalPositions, VPoseCovariance& o_rPoseCovariance,
    std::vector<Rotation::VMatrix3>& o_rMarkerCovariance);

/// The numbers of states and covariances, in the layout that ReadRigidBody reads. The target's marker indices are the
/// caller's.
template <typename TTarget>
bool WriteRigidBody(TTarget& io_rTarget, const Rotation::VPose<double>& i_rPose,
    const std::vector<Rotation::VVector3>& i_rLocalPositions, const VPoseCovariance& i_rPoseCovariance,
    const std::vector<Rotation::VMatrix3>& i_rMarkerCovariance);

} // namespace CoreOrlexTypesUtils::RigidBodyUtils
