#include "CoreOrlexTypesUtils/joints/RestPose.h"

#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypesUtils/Expectation.h"
#include "CoreOrlexTypesUtils/joints/EulerToAngleAxis.h"
#include "CoreOrlexTypesUtils/joints/JointStatistics.h"

#include "numerics/AllFinite.h"
#include "numerics/UnscentedTransform.h"
#include "numerics/fnl_svd_fixed.h"

#include <cmath>

namespace CoreOrlexTypesUtils::TemplateSubjectUtils
{

namespace
{

/// The logarithms of the smallest and the largest standard deviation.
struct VStiffnessRule
{
	double Lower;
	double Upper;
};

constexpr VStiffnessRule c_Rotational{-6.907755278982137, 3.912023005428146};
constexpr VStiffnessRule c_Translational{-4.605170185988091, 13.815510557964274};

double StiffnessOf(const VStiffnessRule& i_rRule, double i_Variance)
{
	const double logarithm = std::clamp(std::log(std::sqrt(std::max(i_Variance, 0.0))), i_rRule.Lower, i_rRule.Upper);
	return (1.0 - (logarithm - i_rRule.Lower) / (i_rRule.Upper - i_rRule.Lower)) * 100.0;
}

double VarianceOf(const VStiffnessRule& i_rRule, double i_Stiffness)
{
	const double deviation =
	    std::exp(i_rRule.Upper - (i_rRule.Upper - i_rRule.Lower) * std::clamp(i_Stiffness, 0.0, 100.0) * 0.01);
	return deviation * deviation;
}

constexpr const char* c_pStatisticNotFinite = "Cannot convert statistics: a value is not finite";

/// Relative to the larger of the largest eigenvalue and 1: a rotation that is more certain than that in some direction
/// is the work of a gimbal lock, where the angles leave one direction out, and rounding would make it negative.
constexpr double c_SmallestEigenvalue = 1e-12;

/// Below this singular value two Euler angles turn about the same axis.
constexpr double c_GimbalLock = 1e-7;

/// The turn that one radian of each Euler angle makes about the axes at rest, as columns.
VMatrix3 TurnsOfAngles(const VVector3& i_rRestPose)
{
	const VEulerToAABall EulerToAA(i_rRestPose);
	VMatrix3 turns;
	for (std::size_t column = 0; column < 3; ++column)
	{
		VVector3 angles = i_rRestPose;
		angles[column] += 1.0;
		const VVector3 turn = EulerToAA(angles);
		for (std::size_t row = 0; row < 3; ++row)
			turns[3 * row + column] = turn[row];
	}
	return turns;
}

template <std::size_t t_Size>
VMatrix3 RotationBlock(const VNumbers& i_rCovariance)
{
	VMatrix3 block;
	for (std::size_t i = 0; i < 9; ++i)
		block[i] = i_rCovariance[i / 3 * t_Size + i % 3];
	return block;
}

/// Of a ball joint (3) or a free joint (6): the inverse of what FromRestPose does, which the unscented transform cannot
/// run backwards without a bias that grows with the variance.
template <std::size_t t_Size>
bool ToRestPose(const VNumbers& i_rMean, const VNumbers& i_rCovariance, VNumbers& o_rRestPose, VNumbers& o_rStiffness)
{
	bool bFits = ExpectSize(i_rMean, "i_rMean", t_Size);
	bFits &= ExpectSize(i_rCovariance, "i_rCovariance", t_Size * t_Size);
	bFits &= ExpectSize(o_rRestPose, "o_rRestPose", t_Size);
	bFits &= ExpectSize(o_rStiffness, "o_rStiffness", t_Size);
	if (!bFits)
		return false;

	VVector3 angles;
	Rotation::EulerFromRotationMatrix(
	    Rotation::RotationMatrixFromAngleAxis({i_rMean[0], i_rMean[1], i_rMean[2]}), c_EditedEulerOrder, angles);
	o_rRestPose = i_rMean;
	std::copy(angles.begin(), angles.end(), o_rRestPose.begin());
	if (!AllFinite(o_rRestPose))
		return Refuse(c_pStatisticNotFinite);

	const VMatrix3 inverse = fnl_svd_fixed<3, 3>(TurnsOfAngles(angles)).Inverse(c_GimbalLock);
	const VMatrix3 ofAngles = Rotation::Product(
	    inverse, Rotation::Product(RotationBlock<t_Size>(i_rCovariance), Rotation::Transposed(inverse)));
	for (std::size_t i = 0; i < t_Size; ++i)
		o_rStiffness[i] = i < 3 ? StiffnessOf(c_Rotational, ofAngles[4 * i])
		                        : StiffnessOf(c_Translational, i_rCovariance[i * (t_Size + 1)]);
	return true;
}

/// Raises eigenvalues of the rotation that are no more than rounding.
template <std::size_t t_Size>
void KeepPositive(VNumbers& io_rCovariance)
{
	const fnl_symmetric_eigensystem<3> eigen(RotationBlock<t_Size>(io_rCovariance));
	const double smallest = c_SmallestEigenvalue * std::max(1.0, eigen.Values()[2]);
	if (eigen.Values()[0] >= smallest)
		return;
	const VMatrix3 raised = eigen.WithValuesOfAtLeast(smallest);
	for (std::size_t i = 0; i < 9; ++i)
		io_rCovariance[i / 3 * t_Size + i % 3] = raised[i];
}

template <std::size_t t_Size, typename TEulerToAA>
bool FromRestPose(const VNumbers& i_rRestPose, const VNumbers& i_rStiffness, VNumbers& o_rMean, VNumbers& o_rCovariance)
{
	bool bFits = ExpectSize(i_rRestPose, "i_rRestPose", t_Size);
	bFits &= ExpectSize(i_rStiffness, "i_rStiffness", t_Size);
	bFits &= ExpectSize(o_rMean, "o_rMean", t_Size);
	bFits &= ExpectSize(o_rCovariance, "o_rCovariance", t_Size * t_Size);
	if (!bFits)
		return false;

	std::array<double, t_Size> restPose;
	std::copy(i_rRestPose.begin(), i_rRestPose.end(), restPose.begin());
	std::array<double, t_Size * t_Size> covariance{};
	for (std::size_t i = 0; i < t_Size; ++i)
		covariance[i * (t_Size + 1)] = VarianceOf(i < 3 ? c_Rotational : c_Translational, i_rStiffness[i]);
	std::array<double, t_Size> AAMean;
	std::array<double, t_Size * t_Size> AACovariance;
	UnscentedTransform(TEulerToAA(restPose), restPose, covariance, AAMean, AACovariance);
	// The rest pose is where the state is measured from, so the mean is already known.
	Expect(std::hypot(AAMean[0], AAMean[1], AAMean[2]) < 1e-2, "AAMean.magnitude() < 1e-2");

	const VVector3 mean = Rotation::AngleAxisFromRotationMatrix(
	    Rotation::RotationMatrixFromEuler({restPose[0], restPose[1], restPose[2]}, c_EditedEulerOrder));
	o_rMean = i_rRestPose;
	std::copy(mean.begin(), mean.end(), o_rMean.begin());
	o_rCovariance.assign(AACovariance.begin(), AACovariance.end());
	if (!AllFinite(o_rCovariance))
		return Refuse(c_pStatisticNotFinite);
	KeepPositive<t_Size>(o_rCovariance);
	return true;
}

} // namespace

bool MeanCovarianceToRestPoseStiffness(VJoint::EJointType i_JointType, const VNumbers& i_rMeanPose,
    const VNumbers& i_rCovariance, VNumbers& o_rRestPose, VNumbers& o_rStiffness)
{
	const std::size_t Dof = CoreOrlexTypes::StateSize(i_JointType);
	bool bFits = Expect(Dof == i_rMeanPose.size(), "Dof == i_rMeanPose.size()");
	bFits &= Expect((Dof * Dof) == i_rCovariance.size(), "( Dof*Dof ) == i_rCovariance.size()");
	if (!CoreOrlexTypes::IsJointType(i_JointType))
		return Refuse("Cannot convert statistics: unsupported joint type");
	if (bFits && (!AllFinite(i_rMeanPose) || !AllFinite(i_rCovariance)))
		return Refuse(c_pStatisticNotFinite);

	o_rRestPose.assign(Dof, 0.0);
	o_rStiffness.assign(Dof, 0.0);
	if (i_JointType == VJoint::EFree)
		return ToRestPose<6>(i_rMeanPose, i_rCovariance, o_rRestPose, o_rStiffness);
	if (i_JointType == VJoint::EBall)
		return ToRestPose<3>(i_rMeanPose, i_rCovariance, o_rRestPose, o_rStiffness);
	if (!bFits)
		return false;
	o_rRestPose = i_rMeanPose;
	for (std::size_t i = 0; i < Dof; ++i)
		o_rStiffness[i] =
		    StiffnessOf(i_JointType == VJoint::ESlider ? c_Translational : c_Rotational, i_rCovariance[i * (Dof + 1)]);
	return true;
}

bool RestPoseStiffnessToMeanCovariance(VJoint::EJointType i_JointType, const VNumbers& i_rRestPose,
    const VNumbers& i_rStiffness, VNumbers& o_rMean, VNumbers& o_rCovariance)
{
	const std::size_t DoF = CoreOrlexTypes::StateSize(i_JointType);
	bool bFits = Expect(i_rRestPose.size() == DoF, "i_rRestPose.size() == DoF");
	bFits &= Expect(i_rStiffness.size() == DoF, "i_rStiffness.size() == DoF");
	if (!CoreOrlexTypes::IsJointType(i_JointType))
		return Refuse("Cannot convert stats: unsupported joint type");
	if (bFits && (!AllFinite(i_rRestPose) || !AllFinite(i_rStiffness)))
		return Refuse(c_pStatisticNotFinite);

	o_rMean.assign(DoF, 0.0);
	o_rCovariance.assign(DoF * DoF, 0.0);
	if (i_JointType == VJoint::EFree)
		return FromRestPose<6, VEulerToAAFree>(i_rRestPose, i_rStiffness, o_rMean, o_rCovariance);
	if (i_JointType == VJoint::EBall)
		return FromRestPose<3, VEulerToAABall>(i_rRestPose, i_rStiffness, o_rMean, o_rCovariance);
	if (!bFits)
		return false;
	o_rMean = i_rRestPose;
	for (std::size_t i = 0; i < DoF; ++i)
		o_rCovariance[i * (DoF + 1)] =
		    VarianceOf(i_JointType == VJoint::ESlider ? c_Translational : c_Rotational, i_rStiffness[i]);
	return true;
}

} // namespace CoreOrlexTypesUtils::TemplateSubjectUtils
