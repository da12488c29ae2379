#include "numerics/Rotation.h"

#include <cmath>
#include <numbers>

namespace Rotation
{

VMatrix3 Product(const VMatrix3& i_rA, const VMatrix3& i_rB)
{
	VMatrix3 result;
	for (int row = 0; row < 3; ++row)
		for (int column = 0; column < 3; ++column)
			result[3 * row + column] = i_rA[3 * row] * i_rB[column] + i_rA[3 * row + 1] * i_rB[3 + column]
			    + i_rA[3 * row + 2] * i_rB[6 + column];
	return result;
}

VMatrix3 Transposed(const VMatrix3& i_rMatrix)
{
	const VMatrix3& m = i_rMatrix;
	return {m[0], m[3], m[6], m[1], m[4], m[7], m[2], m[5], m[8]};
}

VVector3 Product(const VMatrix3& i_rA, const VVector3& i_rVector)
{
	const auto& [x, y, z] = i_rVector;
	return {i_rA[0] * x + i_rA[1] * y + i_rA[2] * z, i_rA[3] * x + i_rA[4] * y + i_rA[5] * z,
	    i_rA[6] * x + i_rA[7] * y + i_rA[8] * z};
}

double Determinant(const VMatrix3& i_rMatrix)
{
	const VMatrix3& m = i_rMatrix;
	return m[0] * (m[4] * m[8] - m[5] * m[7]) - m[1] * (m[3] * m[8] - m[5] * m[6]) + m[2] * (m[3] * m[7] - m[4] * m[6]);
}

VVector3 Apply(const VPose<double>& i_rPose, const VVector3& i_rPoint)
{
	VVector3 point = Product(i_rPose.R, i_rPoint);
	for (int i = 0; i < 3; ++i)
		point[i] += i_rPose.t[i];
	return point;
}

VPose<double> Compose(const VPose<double>& i_rA, const VPose<double>& i_rB)
{
	return {Product(i_rA.R, i_rB.R), Apply(i_rA, i_rB.t)};
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

VMatrix3 RotationMatrixFromAngleAxis(const VVector3& i_rAngleAxis)
{
	const double angle = std::hypot(i_rAngleAxis[0], i_rAngleAxis[1], i_rAngleAxis[2]);
	if (angle < c_SmallestAngle)
		return c_Identity3;
	const double x = i_rAngleAxis[0] / angle;
	const double y = i_rAngleAxis[1] / angle;
	const double z = i_rAngleAxis[2] / angle;
	const double c = std::cos(angle);
	const double s = std::sin(angle);
	const double C = 1.0 - c;
	return {C * x * x + c, C * x * y - s * z, C * x * z + s * y, C * y * x + s * z, C * y * y + c, C * y * z - s * x,
	    C * z * x - s * y, C * z * y + s * x, C * z * z + c};
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
