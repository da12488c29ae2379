#include "numerics/Rotation.h"

#include "numerics/PoseRows.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace Rotation
{

VMatrix3 Transposed(const VMatrix3& i_rMatrix)
{
	const VMatrix3& m = i_rMatrix;
	return {m[0], m[3], m[6], m[1], m[4], m[7], m[2], m[5], m[8]};
}

double Determinant(const VMatrix3& i_rMatrix)
{
	const VMatrix3& m = i_rMatrix;
	return m[0] * (m[4] * m[8] - m[5] * m[7]) - m[1] * (m[3] * m[8] - m[5] * m[6]) + m[2] * (m[3] * m[7] - m[4] * m[6]);
}

VPose<double> Compose(const VPose<double>& i_rA, const VPose<double>& i_rB)
{
	VPose<double> pose;
	VPoseRows(i_rA, VPoseRows(i_rB)).Store(pose);
	return pose;
}

VPose<double> Inverse(const VPose<double>& i_rPose)
{
	const VMatrix3 transposed = Transposed(i_rPose.R);
	const VVector3 t = Product(transposed, i_rPose.t);
	return {transposed, {-t[0], -t[1], -t[2]}};
}

VPose<double> Relative(const VPose<double>& i_rA, const VPose<double>& i_rB)
{
	const VMatrix3 transposed = Transposed(i_rA.R);
	const VVector3 difference{i_rB.t[0] - i_rA.t[0], i_rB.t[1] - i_rA.t[1], i_rB.t[2] - i_rA.t[2]};
	return {Product(transposed, i_rB.R), Product(transposed, difference)};
}

VPose<double> PoseFromAngleAxis(const VVector3& i_rRotation, const VVector3& i_rTranslation)
{
	return {RotationMatrixFromAngleAxis(i_rRotation), i_rTranslation};
}

VVector3 AngleAxisFromRotationMatrix(const VMatrix3& i_rRotation)
{
	// The quaternion's largest component is found first, so that no root of a small number is divided by
	// (S. W. Shepperd, "Quaternion from rotation matrix", J. Guidance and Control 1, 1978).
	const VMatrix3& m = i_rRotation;
	const double trace = m[0] + m[4] + m[8];
	double x, y, z, w;
	if (trace >= m[0] && trace >= m[4] && trace >= m[8])
	{
		w = 0.5 * std::sqrt(1.0 + trace);
		x = (m[7] - m[5]) / (4.0 * w);
		y = (m[2] - m[6]) / (4.0 * w);
		z = (m[3] - m[1]) / (4.0 * w);
	}
	else if (m[0] >= m[4] && m[0] >= m[8])
	{
		x = 0.5 * std::sqrt(1.0 + m[0] - m[4] - m[8]);
		y = (m[1] + m[3]) / (4.0 * x);
		z = (m[2] + m[6]) / (4.0 * x);
		w = (m[7] - m[5]) / (4.0 * x);
	}
	else if (m[4] >= m[8])
	{
		y = 0.5 * std::sqrt(1.0 - m[0] + m[4] - m[8]);
		x = (m[1] + m[3]) / (4.0 * y);
		z = (m[5] + m[7]) / (4.0 * y);
		w = (m[2] - m[6]) / (4.0 * y);
	}
	else
	{
		z = 0.5 * std::sqrt(1.0 - m[0] - m[4] + m[8]);
		x = (m[2] + m[6]) / (4.0 * z);
		y = (m[5] + m[7]) / (4.0 * z);
		w = (m[3] - m[1]) / (4.0 * z);
	}
	const double s = std::hypot(x, y, z);
	if (s < c_SmallestAngle)
		return {x, y, z};
	const double scale = 2.0 * std::atan2(s, w) / s;
	return {x * scale, y * scale, z * scale};
}

bool IsRotationMatrix(const VMatrix3& i_rMatrix, double i_Tolerance)
{
	const VMatrix3 product = Product(Transposed(i_rMatrix), i_rMatrix);
	bool bWithin = std::abs(Determinant(i_rMatrix) - 1.0) <= i_Tolerance;
	for (int i = 0; i < 9; ++i)
		bWithin = bWithin && std::abs(product[i] - c_Identity3[i]) <= i_Tolerance;
	return bWithin;
}

namespace
{

/// The three axes of an order, and the sign of their permutation.
struct VEulerAxes
{
	explicit VEulerAxes(EEulerOrder i_Order)
	    : m_First(i_Order >> 4), m_Second(i_Order >> 2 & 3), m_Third(i_Order & 3),
	      m_Sign((m_First + 1) % 3 == m_Second ? 1.0 : -1.0)
	{
	}
	int m_First;
	int m_Second;
	int m_Third;
	double m_Sign;
};

} // namespace

void EulerFromRotationMatrix(const VMatrix3& i_rRotation, EEulerOrder i_Order, VVector3& o_rAngles)
{
	const auto [first, second, third, sign] = VEulerAxes(i_Order);
	const auto entry = [&](int i_Row, int i_Column) { return i_rRotation[3 * i_Row + i_Column]; };
	const double sine = std::clamp(sign * entry(first, third), -1.0, 1.0);
	// The cosine is taken from the matrix too: the arcsine of a sine near 1 has lost half of its digits.
	if (std::hypot(entry(first, first), entry(first, second)) > c_SmallestAngle)
		o_rAngles = {std::atan2(-sign * entry(second, third), entry(third, third)), std::asin(sine), 0.0};
	else
		o_rAngles = {0.0, std::copysign(std::numbers::pi / 2.0, sine), 0.0};
	// With the first turn undone the third stands alone in the row of the second axis. Beside a lock this keeps the
	// product right, where the first angle follows from rounding errors.
	const double c = std::cos(o_rAngles[0]);
	const double s = sign * std::sin(o_rAngles[0]);
	o_rAngles[2] = std::atan2(sign * (c * entry(second, first) + s * entry(third, first)),
	    c * entry(second, second) + s * entry(third, second));
}

VMatrix3 RotationMatrixFromEuler(const VVector3& i_rAngles, EEulerOrder i_Order)
{
	const VEulerAxes axes(i_Order);
	const auto about = [](int i_Axis, double i_Angle)
	{
		VVector3 angleAxis{};
		angleAxis[i_Axis] = i_Angle;
		return RotationMatrixFromAngleAxis(angleAxis);
	};
	return Product(about(axes.m_First, i_rAngles[0]),
	    Product(about(axes.m_Second, i_rAngles[1]), about(axes.m_Third, i_rAngles[2])));
}

VVector3 CanonicalAngleAxis(const VVector3& i_rAngleAxis)
{
	const double length = std::hypot(i_rAngleAxis[0], i_rAngleAxis[1], i_rAngleAxis[2]);
	if (!(length > std::numbers::pi))
		return i_rAngleAxis;
	const double turn = 2.0 * std::numbers::pi;
	const double scale = (length - turn * std::round(length / turn)) / length;
	return {i_rAngleAxis[0] * scale, i_rAngleAxis[1] * scale, i_rAngleAxis[2] * scale};
}

} // namespace Rotation
