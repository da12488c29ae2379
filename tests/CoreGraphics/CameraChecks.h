#pragma once

#include "CoreGraphics/CameraController.h"

#include <gtest/gtest.h>

namespace GraphicsTest
{

/// Pixels from the upper left corner.
inline QPointF OnScreen(const CoreGraphics::VCameraController& i_rCamera, const QVector3D& i_rPoint)
{
	const QVector3D place = (i_rCamera.m_Projection * i_rCamera.m_View).map(i_rPoint);
	return {0.5 * (1.0 + place.x()) * i_rCamera.m_Size.width(), 0.5 * (1.0 - place.y()) * i_rCamera.m_Size.height()};
}

inline void ExpectNear(
    const QMatrix4x4& i_rActual, const QMatrix4x4& i_rExpected, float i_Rotation, float i_Translation)
{
	for (int row = 0; row < 4; ++row)
	{
		for (int column = 0; column < 4; ++column)
			EXPECT_NEAR(i_rActual(row, column), i_rExpected(row, column), column == 3 ? i_Translation : i_Rotation)
			    << row << ", " << column;
	}
}

} // namespace GraphicsTest
