#include "RetargetSetupCore/AngleAxis.h"

#include "../Matrices.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <numbers>

namespace
{

using Rotation::VVector3;

Rotation::VMatrix4 Turned(float i_Degrees, float i_X, float i_Y, float i_Z)
{
	Rotation::VMatrix4 matrix;
	Turn(matrix, i_Degrees, i_X, i_Y, i_Z);
	return matrix;
}

Rotation::VMatrix4 Scaled(Rotation::VMatrix4 i_Matrix, float i_X, float i_Y, float i_Z)
{
	Scale(i_Matrix, i_X, i_Y, i_Z);
	return i_Matrix;
}

TEST(MatrixToAngleAxis, Rows)
{
	Rotation::VMatrix4 sheared;
	sheared(0, 1) = 0.5f;
	// A column that leans by this angle leaves off-diagonal cosines c: 2 c c is the sum of squares that is tested.
	const auto leaning = [](float i_Cosine)
	{
		Rotation::VMatrix4 matrix;
		matrix(0, 1) = i_Cosine;
		matrix(1, 1) = std::sqrt(1.0f - i_Cosine * i_Cosine);
		return matrix;
	};
	Rotation::VMatrix4 notANumber;
	notANumber(1, 1) = std::numeric_limits<float>::quiet_NaN();
	Rotation::VMatrix4 moved = Turned(90, 1, 0, 0);
	moved(0, 3) = 1e6f;

	const struct
	{
		const char* m_pName;
		Rotation::VMatrix4 m_Matrix;
		bool m_bRotation;
		VVector3 m_Expected;
	} rows[] = {
	    {"identity", {}, true, {0, 0, 0}},
	    {"quarter about X", Turned(90, 1, 0, 0), true, {std::numbers::pi / 2, 0, 0}},
	    {"minus a third about Y", Turned(-120, 0, 1, 0), true, {0, -2 * std::numbers::pi / 3, 0}},
	    {"half about Z", Turned(180, 0, 0, 1), true, {0, 0, std::numbers::pi}},
	    {"270 degrees come back as minus 90", Turned(270, 0, 0, 1), true, {0, 0, -std::numbers::pi / 2}},
	    {"the translation does not matter", moved, true, {std::numbers::pi / 2, 0, 0}},
	    {"scale is taken out", Scaled(Turned(90, 1, 0, 0), 2, 0.01f, 700), true, {std::numbers::pi / 2, 0, 0}},
	    {"a mirror", Scaled(Turned(90, 1, 0, 0), -1, 1, 1), false, {}},
	    {"two mirrors are a turn", Scaled({}, -1, -1, 1), true, {0, 0, std::numbers::pi}},
	    {"a shear", sheared, false, {}},
	    {"a lean within the tolerance", leaning(0.07f), true, {0, 0, -0.0350179}},
	    {"a lean beyond the tolerance", leaning(0.0708f), false, {}},
	    {"a column of zeros", Scaled({}, 0, 1, 1), false, {}},
	    {"not a number", notANumber, false, {}},
	};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		EXPECT_EQ(RetargetSetup::RotationOf(rRow.m_Matrix).has_value(), rRow.m_bRotation);
		const VVector3 actual = RetargetSetup::MatrixToAngleAxis(rRow.m_Matrix);
		// A half turn may come back about either end of its axis.
		const bool bHalf = rRow.m_Expected[2] == std::numbers::pi;
		const double sign = bHalf && actual[2] < 0 ? -1.0 : 1.0;
		for (std::size_t i = 0; i < 3; ++i)
			EXPECT_NEAR(sign * actual[i], rRow.m_Expected[i], 1e-6) << i;
	}
}

TEST(AngleAxisToMatrix, IsTheWayBack)
{
	for (const VVector3& rVector : {VVector3{0, 0, 0}, {0.3, -0.2, 1.1}, {3.0, 0.5, 0.1}, {1e-17, 0, 0}})
	{
		const Rotation::VMatrix4 matrix = RetargetSetup::AngleAxisToMatrix(rVector);
		const VVector3 back = RetargetSetup::MatrixToAngleAxis(matrix);
		for (std::size_t i = 0; i < 3; ++i)
			EXPECT_NEAR(back[i], rVector[i], 2e-6);
		EXPECT_EQ(matrix.Translation(), (std::array<float, 3>{}));
	}
}

} // namespace
