#pragma once

#include "numerics/Rotation.h"

#include <algorithm>

namespace CoreOrlexTypesUtils
{

/// The order of the angles in which people edit ball and free joints.
inline constexpr Rotation::EEulerOrder c_EditedEulerOrder = Rotation::EXYZ;

/// Maps the Euler angles of a ball joint (radians) to the angle-axis state that is measured from a rest pose: the axes
/// are those of the joint at rest, and the rest pose itself is 0. A change of one angle alone is a turn about a fixed
/// axis, so along each angle the map is linear.
struct VEulerToAABall
{
	using VState = std::array<double, 3>;

	explicit VEulerToAABall(const VState& i_rRestPose)
	    : m_InverseRest(Rotation::Transposed(Rotation::RotationMatrixFromEuler(i_rRestPose, c_EditedEulerOrder)))
	{
	}

	VState operator()(const VState& i_rAngles) const
	{
		return Rotation::AngleAxisFromRotationMatrix(
		    Rotation::Product(m_InverseRest, Rotation::RotationMatrixFromEuler(i_rAngles, c_EditedEulerOrder)));
	}

private:
	Rotation::VMatrix3 m_InverseRest;
};

/// The same of a free joint, whose angles are followed by a translation (mm) that stays as it is.
struct VEulerToAAFree
{
	using VState = std::array<double, 6>;

	explicit VEulerToAAFree(const VState& i_rRestPose) : m_Ball({i_rRestPose[0], i_rRestPose[1], i_rRestPose[2]}) {}

	VState operator()(const VState& i_rAnglesAndTranslation) const
	{
		VState state = i_rAnglesAndTranslation;
		const VEulerToAABall::VState rotation = m_Ball({state[0], state[1], state[2]});
		std::copy(rotation.begin(), rotation.end(), state.begin());
		return state;
	}

private:
	VEulerToAABall m_Ball;
};

} // namespace CoreOrlexTypesUtils
