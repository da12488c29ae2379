#include "CoreOrlexQRTIO/values/JointGeometry.h"

#include "CoreOrlexTypesUtils/rigidbody/AxisOrientation.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace CoreOrlexQRTIO
{
namespace
{

using Rotation::VVector3;
using VJoint = CoreOrlexTypes::VSubjectParametrised::VJoint;

constexpr double c_LargestPairDot = 0.001;
constexpr double c_ShortestReference = 0.001;
constexpr double c_LargestReferenceDot = 0.000001;

double Dot(const VVector3& i_rA, const VVector3& i_rB)
{
	return i_rA[0] * i_rB[0] + i_rA[1] * i_rB[1] + i_rA[2] * i_rB[2];
}

/// Without negative zeros, which would show in files.
VVector3 Negated(const VVector3& i_rVector)
{
	return {0.0 - i_rVector[0], 0.0 - i_rVector[1], 0.0 - i_rVector[2]};
}

VVector3 Axis(std::span<const double> i_Axes, std::size_t i_Offset)
{
	return {i_Axes[i_Offset], i_Axes[i_Offset + 1], i_Axes[i_Offset + 2]};
}

EAxesResult PairOrientation(std::span<const double> i_Pair, VVector3& o_rOrientation)
{
	if (i_Pair.size() != 6)
		return EAxesResult::WrongCount;
	const VVector3 first = Normalised(Axis(i_Pair, 0));
	const VVector3 second = Normalised(Axis(i_Pair, 3));
	if (Length(first) == 0.0 || Length(second) == 0.0)
		return EAxesResult::ZeroLength;
	if (std::abs(Dot(first, second)) > c_LargestPairDot)
		return EAxesResult::NotOrthogonal;
	o_rOrientation = CoreOrlexTypesUtils::TwoAxisOrientation(first, second, 2, 1);
	return EAxesResult::Fine;
}

VVector3 HingeOrientation(const VVector3& i_rAxis, const VJointPose& i_rPrePose)
{
	const VVector3 reference = Inverse(i_rPrePose).m_Translation;
	if (Length(reference) >= c_ShortestReference)
	{
		const VVector3 direction = Normalised(reference);
		if (std::abs(Dot(i_rAxis, direction)) < c_LargestReferenceDot)
			return CoreOrlexTypesUtils::TwoAxisOrientation(i_rAxis, direction, 2, 0);
	}
	return CoreOrlexTypesUtils::SingleAxisOrientation(i_rAxis, 2);
}

} // namespace

VJointPose Inverse(const VJointPose& i_rPose)
{
	const Rotation::VMatrix3 back = Rotation::Transposed(Rotation::RotationMatrixFromAngleAxis(i_rPose.m_Rotation));
	return {Negated(i_rPose.m_Rotation), Negated(Rotation::Product(back, i_rPose.m_Translation))};
}

double Length(const VVector3& i_rVector)
{
	return std::hypot(i_rVector[0], i_rVector[1], i_rVector[2]);
}

VVector3 Normalised(const VVector3& i_rVector)
{
	double length = Length(i_rVector);
	if (length == 0.0 || std::abs(length - 1.0) <= 4.0 * std::numeric_limits<double>::epsilon())
		return i_rVector;
	VVector3 vector = i_rVector;
	if (!std::isfinite(length))
	{
		for (double& rComponent : vector)
			rComponent *= 0.25;
		length = Length(vector);
	}
	return {vector[0] / length, vector[1] / length, vector[2] / length};
}

std::size_t AxesSize(VJoint::EJointType i_Type)
{
	switch (i_Type)
	{
	case VJoint::EHardySpicer: return 6;
	case VJoint::EHinge:
	case VJoint::ESlider: return 3;
	default: return 0;
	}
}

EAxesResult JointOrientation(
    VJoint::EJointType i_Type, std::span<const double> i_Axes, const VJointPose& i_rPrePose, VVector3& o_rOrientation)
{
	if (i_Axes.empty() || i_Axes.size() != AxesSize(i_Type))
		return EAxesResult::WrongCount;
	if (i_Type == VJoint::EHardySpicer)
		return PairOrientation(i_Axes, o_rOrientation);
	const VVector3 axis = Normalised(Axis(i_Axes, 0));
	if (Length(axis) == 0.0)
		return EAxesResult::ZeroLength;
	o_rOrientation = i_Type == VJoint::EHinge ? HingeOrientation(axis, i_rPrePose)
	                                          : CoreOrlexTypesUtils::SingleAxisOrientation(axis, 2);
	return EAxesResult::Fine;
}

EAxesResult TargetOrientation(std::span<const double> i_Axes, VVector3& o_rOrientation)
{
	if (i_Axes.size() != 3)
		return PairOrientation(i_Axes, o_rOrientation);
	return JointOrientation(VJoint::ESlider, i_Axes, {}, o_rOrientation);
}

std::vector<double> AxesOfOrientation(const VVector3& i_rOrientation, bool i_bPair)
{
	const Rotation::VMatrix3 m = Rotation::RotationMatrixFromAngleAxis(i_rOrientation);
	std::vector<double> axes{m[2], m[5], m[8]};
	if (i_bPair)
		axes.insert(axes.end(), {m[1], m[4], m[7]});
	return axes;
}

} // namespace CoreOrlexQRTIO
