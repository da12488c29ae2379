#pragma once

#include "FBXIO/Mesh.h"
#include "numerics/Matrix4.h"

#include <QMatrix4x4>
#include <QVector3D>
#include <QVector4D>

/// The types of the libraries below, in those that are drawn with, and back.
namespace CoreGraphics
{

inline QMatrix4x4 ToQt(const Rotation::VMatrix4& i_rMatrix)
{
	return QMatrix4x4(i_rMatrix.data());
}

inline Rotation::VMatrix4 FromQt(const QMatrix4x4& i_rMatrix)
{
	Rotation::VMatrix4 matrix;
	for (int row = 0; row < 4; ++row)
		for (int column = 0; column < 4; ++column)
			matrix(row, column) = i_rMatrix(row, column);
	return matrix;
}

inline QVector3D ToQt(const std::array<float, 3>& i_rVector)
{
	return {i_rVector[0], i_rVector[1], i_rVector[2]};
}

inline QVector4D ToQt(const FBXIO::VColourAndFactor& i_rColour)
{
	return {i_rColour[0], i_rColour[1], i_rColour[2], i_rColour[3]};
}

} // namespace CoreGraphics
