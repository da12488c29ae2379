#pragma once

#include "numerics/Matrix4.h"
#include "numerics/Rotation.h"

#include <numbers>

/// The matrix with a motion that comes before all that it has already.
inline void Move(Rotation::VMatrix4& io_rMatrix, float i_X, float i_Y, float i_Z)
{
	Rotation::VMatrix4 move;
	move(0, 3) = i_X;
	move(1, 3) = i_Y;
	move(2, 3) = i_Z;
	io_rMatrix = io_rMatrix * move;
}

/// The same with a turn about an axis, whose length does not matter.
inline void Turn(Rotation::VMatrix4& io_rMatrix, double i_Degrees, double i_X, double i_Y, double i_Z)
{
	const double factor = i_Degrees * std::numbers::pi / 180.0 / std::hypot(i_X, i_Y, i_Z);
	const Rotation::VMatrix3 rotation =
	    Rotation::RotationMatrixFromAngleAxis({factor * i_X, factor * i_Y, factor * i_Z});
	Rotation::VMatrix4 turn;
	for (int row = 0; row < 3; ++row)
		for (int column = 0; column < 3; ++column)
			turn(row, column) = float(rotation[std::size_t(3 * row + column)]);
	io_rMatrix = io_rMatrix * turn;
}

/// The same with a scale.
inline void Scale(Rotation::VMatrix4& io_rMatrix, float i_X, float i_Y, float i_Z)
{
	Rotation::VMatrix4 scale;
	scale(0, 0) = i_X;
	scale(1, 1) = i_Y;
	scale(2, 2) = i_Z;
	io_rMatrix = io_rMatrix * scale;
}
