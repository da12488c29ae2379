#pragma once

/// What the solve of a frame minimises, over the states of the joints at or above a target that is solved; all other
/// joints stay in the bind pose:
///
///   sum over targets of weight * r^2  +  prior * sum over joints of x' C^-1 x  +  pull * sum over joints of y' y
///       +  range * sum over joints of e^2                                                    in square millimetres.
///
/// r is the residual of a target. Solved are points (distance of the observed position from the point), lines and
///   planes (from the line, the plane), plain and Gaussian alike, rigid bodies (a residual for each marker) and
///   rotations (the shortest angle to the observed rotation times c_RotationLength). Left out, and listed, are
///   directions, targets that do not fit their type, and weights that are not above 0. A target whose observation is
///   missing in a frame has no part in it.
/// x is the deviation of a joint from its mean: of rotations the angle-axis vector of the turn from the mean, about the
///   joint's axes at the mean; of other states the difference, of angles the shortest. C is the joint's covariance, of
///   which eigenvalues of 0 say nothing. A joint without the two has no prior.
/// y is the same deviation from the state in the frame before, in the first frame from the seed; lengths in it count as
///   the angles that they are at c_RotationLength.
/// e is how far a joint is beyond its range, the ellipsoid x' M^-1 x <= 1 about the centring state with the range
/// matrix
///   M: the length of the part of x outside, a length counted as in y. A range is thus a stiff penalty and no wall: a
///   joint that the targets push against its end goes beyond it by fractions of a degree.
namespace ComputeSubject
{

/// What a radian weighs against millimetres, about the length of a hand or a foot: an error of the wrist's angle counts
/// as what it does at the finger tips.
inline constexpr double c_RotationLength = 200.0;

/// Square millimetres for a squared Mahalanobis distance of 1. Subjects are made with covariances of 10, which weigh
/// next to nothing then: they decide where no target does, and cost no target its millimetre. Priors that were ten
/// thousand times stronger would make the residuals of a walk a third larger.
inline constexpr double c_PriorScale = 1.0;

/// Square millimetres for a squared radian between frames. Joints that no target decides, a spine below a driven chest,
/// would turn from frame to frame by up to a right angle without it; a driven joint weighs 10,000 and more and does not
/// feel it.
inline constexpr double c_PullScale = 100.0;

/// Square millimetres for a squared radian beyond a range: some ten targets at an arm's length together.
inline constexpr double c_RangeScale = 1e7;

/// Each may be 0, which leaves the term out.
struct VSolveScales
{
	double m_Prior = c_PriorScale;
	double m_Pull = c_PullScale;
	double m_Range = c_RangeScale;
};

} // namespace ComputeSubject
