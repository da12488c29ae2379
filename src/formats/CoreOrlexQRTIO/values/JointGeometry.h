#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"
#include "numerics/Rotation.h"

#include <span>

/// What files tell of joints and targets, and what subjects hold of them, there and back: axes and orientations, the
/// pose of the segment behind a joint and its inverse.
namespace CoreOrlexQRTIO
{

/// An angle-axis vector in radians, and millimetres.
struct VJointPose
{
	Rotation::VVector3 m_Rotation{};
	Rotation::VVector3 m_Translation{};

	bool operator==(const VJointPose&) const = default;
};

/// The inverse motion. The rotation loses nothing in it.
VJointPose Inverse(const VJointPose& i_rPose);

double Length(const Rotation::VVector3& i_rVector);

/// To length 1; a vector that has it but for rounding, or that has none, stays as it is, so that a normalised vector
/// can be normalised again.
Rotation::VVector3 Normalised(const Rotation::VVector3& i_rVector);

enum class EAxesResult
{
	Fine,
	/// Neither one axis nor a pair, as the case needs it.
	WrongCount,
	/// An axis without a direction.
	ZeroLength,
	NotOrthogonal
};

/// Number of values that a file has for the axes of a joint of this type: 6, 3 or 0.
std::size_t AxesSize(CoreOrlexTypes::VSubjectParametrised::VJoint::EJointType i_Type);

/// The angle-axis orientation of a joint. Hardy Spicer: the first axis of the pair is local Z, the second local Y.
/// Hinge: the axis is local Z, and the way back from the joint to the parent is local X where it is at right angles to
/// the axis. Slider: the axis is local Z.
/// @param i_rPrePose of the segment; a hinge needs it.
EAxesResult JointOrientation(CoreOrlexTypes::VSubjectParametrised::VJoint::EJointType i_Type,
    std::span<const double> i_Axes, const VJointPose& i_rPrePose, Rotation::VVector3& o_rOrientation);

/// The angle-axis orientation of a rotation target: one axis (3 values) is local Z, a pair (6 values) local Z and Y.
EAxesResult TargetOrientation(std::span<const double> i_Axes, Rotation::VVector3& o_rOrientation);

/// The axis (column 2), or the pair (columns 2 and 1), that an orientation stands for.
std::vector<double> AxesOfOrientation(const Rotation::VVector3& i_rOrientation, bool i_bPair);

} // namespace CoreOrlexQRTIO
