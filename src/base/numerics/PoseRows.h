#pragma once

#include "numerics/Lanes.h"
#include "numerics/Rotation.h"

#include <cstring>

namespace Rotation
{

/// A pose as the rows of the 3x4 matrix [R t], each in two pairs: the form in which composing keeps both lanes of the
/// registers busy.
struct VPoseRows
{
	explicit VPoseRows(const VPose<double>& i_rPose)
	{
		for (int row = 0; row < 3; ++row)
		{
			std::memcpy(&m_Left[row], &i_rPose.R[3 * row], sizeof(VPair));
			m_Right[row] = VPair{i_rPose.R[3 * row + 2], i_rPose.t[row]};
		}
	}

	/// First b, then a.
	VPoseRows(const VPose<double>& i_rA, const VPoseRows& i_rB)
	{
		for (int row = 0; row < 3; ++row)
		{
			const double* pRow = &i_rA.R[3 * row];
			const VPair x{pRow[0], pRow[0]};
			const VPair y{pRow[1], pRow[1]};
			const VPair z{pRow[2], pRow[2]};
			m_Left[row] = x * i_rB.m_Left[0] + y * i_rB.m_Left[1] + z * i_rB.m_Left[2];
			m_Right[row] = x * i_rB.m_Right[0] + y * i_rB.m_Right[1] + z * i_rB.m_Right[2] + VPair{0.0, i_rA.t[row]};
		}
	}

	void Store(VPose<double>& o_rPose) const
	{
		for (int row = 0; row < 3; ++row)
		{
			std::memcpy(&o_rPose.R[3 * row], &m_Left[row], sizeof(VPair));
			o_rPose.R[3 * row + 2] = m_Right[row][0];
			o_rPose.t[row] = m_Right[row][1];
		}
	}

	VPair m_Left[3];
	VPair m_Right[3];
};

} // namespace Rotation
