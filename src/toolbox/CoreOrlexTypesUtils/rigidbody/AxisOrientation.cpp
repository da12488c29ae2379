#include "CoreOrlexTypesUtils/rigidbody/AxisOrientation.h"

#include "DebugServices/Assert.h"

#include <cmath>

namespace CoreOrlexTypesUtils
{

namespace
{

using Rotation::VVector3;

double Dot(const VVector3& i_rA, const VVector3& i_rB)
{
	return i_rA[0] * i_rB[0] + i_rA[1] * i_rB[1] + i_rA[2] * i_rB[2];
}

bool Normalise(VVector3& io_rVector)
{
	const double length = std::hypot(io_rVector[0], io_rVector[1], io_rVector[2]);
	if (!(length > 0.0 && std::isfinite(length)))
		return false;
	for (double& rComponent : io_rVector)
		rComponent /= length;
	return true;
}

} // namespace

VVector3 TwoAxisOrientation(
    const VVector3& i_rA, const VVector3& i_rB, std::size_t i_FirstDesiredAxis, std::size_t i_SecondDesiredAxis)
{
	NVX_ASSERT(i_FirstDesiredAxis < 3);
	NVX_ASSERT(i_SecondDesiredAxis < 3);
	NVX_ASSERT(i_SecondDesiredAxis != i_FirstDesiredAxis);
	if (i_FirstDesiredAxis >= 3 || i_SecondDesiredAxis >= 3 || i_SecondDesiredAxis == i_FirstDesiredAxis)
		return {};

	VVector3 a = i_rA;
	VVector3 b = i_rB;
	if (!Normalise(a))
		return {};
	const double along = Dot(a, b);
	for (std::size_t i = 0; i < 3; ++i)
		b[i] -= along * a[i];
	if (!Normalise(b))
		return {};

	// The determinant is that of the three directions in cyclic order of their columns.
	const double sign = i_SecondDesiredAxis == (i_FirstDesiredAxis + 1) % 3 ? 1.0 : -1.0;
	const std::size_t third = 3 - i_FirstDesiredAxis - i_SecondDesiredAxis;
	Rotation::VMatrix3 matrix;
	for (std::size_t row = 0; row < 3; ++row)
	{
		const std::size_t next = (row + 1) % 3;
		const std::size_t last = (row + 2) % 3;
		matrix[3 * row + i_FirstDesiredAxis] = a[row];
		matrix[3 * row + i_SecondDesiredAxis] = b[row];
		matrix[3 * row + third] = sign * (a[next] * b[last] - a[last] * b[next]);
	}
	return Rotation::AngleAxisFromRotationMatrix(matrix);
}

VVector3 SingleAxisOrientation(const VVector3& i_rA, std::size_t i_FirstDesiredAxis)
{
	const auto [x, y, z] = i_rA;
	VVector3 second{z - y, x - z, y - x};
	// Near the line where all components are equal the difference is too short to tell a direction.
	if (Dot(second, second) < 0.000001)
		second = {0.0, -z, y};
	Normalise(second);
	return TwoAxisOrientation(i_rA, second, i_FirstDesiredAxis, (i_FirstDesiredAxis + 1) % 3);
}

} // namespace CoreOrlexTypesUtils
