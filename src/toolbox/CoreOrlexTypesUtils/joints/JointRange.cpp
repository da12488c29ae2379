#include "CoreOrlexTypesUtils/joints/JointRange.h"

#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypesUtils/Expectation.h"
#include "CoreOrlexTypesUtils/joints/EulerToAngleAxis.h"
#include "CoreOrlexTypesUtils/joints/JointStatistics.h"

#include "numerics/AllFinite.h"
#include "numerics/fnl_symmetric_eigensystem.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace CoreOrlexTypesUtils::TemplateSubjectUtils
{

namespace
{

struct VCosSin
{
	double Cos;
	double Sin;
};

/// 64 directions, a list for each quadrant and an empty one that ends them. Quadrants are exact turns of the first, so
/// that a symmetric range has symmetric extremes.
using VCosSinSamples = std::array<std::vector<VCosSin>, 5>;

VCosSinSamples MakeCosSinSamples()
{
	constexpr int c_InQuadrant = 16;
	VCosSinSamples CosSinSamples;
	for (int i = 0; i < c_InQuadrant; ++i)
	{
		const double angle = i * (std::numbers::pi / 2) / c_InQuadrant;
		const double c = std::cos(angle);
		const double s = std::sin(angle);
		CosSinSamples[0].push_back({c, s});
		CosSinSamples[1].push_back({-s, c});
		CosSinSamples[2].push_back({-c, -s});
		CosSinSamples[3].push_back({s, -c});
	}
	Expect(CosSinSamples[4].empty(), "CosSinSamples[ 4 ].empty()");
	return CosSinSamples;
}

/// The angle of a whole turn apart that lies nearest.
double Next(double i_Angle, double i_Centre)
{
	return i_Angle - 2 * std::numbers::pi * std::round((i_Angle - i_Centre) / (2 * std::numbers::pi));
}

double Distance(const VVector3& i_rA, const VVector3& i_rB)
{
	return std::hypot(i_rA[0] - i_rB[0], i_rA[1] - i_rB[1], i_rA[2] - i_rB[2]);
}

/// Every rotation has two triples of Euler angles, up to whole turns: the one next to i_rCentre.
VVector3 EulerNextTo(const VMatrix3& i_rRotation, const VVector3& i_rCentre)
{
	VVector3 angles;
	Rotation::EulerFromRotationMatrix(i_rRotation, c_EditedEulerOrder, angles);
	VVector3 other{angles[0] + std::numbers::pi, std::numbers::pi - angles[1], angles[2] + std::numbers::pi};
	for (std::size_t i = 0; i < 3; ++i)
	{
		angles[i] = Next(angles[i], i_rCentre[i]);
		other[i] = Next(other[i], i_rCentre[i]);
	}
	return Distance(other, i_rCentre) < Distance(angles, i_rCentre) ? other : angles;
}

/// Of a ball joint (3) or a free joint (6).
template <std::size_t t_Size>
void SampleBoundary(const VNumbers& i_rCentre, const VNumbers& i_rMatrix, VNumbers& o_rMin, VNumbers& o_rMax)
{
	static const VCosSinSamples CosSinSamples = MakeCosSinSamples();
	std::array<double, t_Size * t_Size> matrix;
	std::copy(i_rMatrix.begin(), i_rMatrix.end(), matrix.begin());
	const fnl_symmetric_eigensystem<t_Size> eigen(matrix);
	std::array<double, t_Size> extents;
	for (std::size_t k = 0; k < t_Size; ++k)
		extents[k] = std::sqrt(std::max(eigen.Values()[k], 0.0));

	const VMatrix3 centre = Rotation::RotationMatrixFromAngleAxis({i_rCentre[0], i_rCentre[1], i_rCentre[2]});
	VVector3 centreAngles;
	Rotation::EulerFromRotationMatrix(centre, c_EditedEulerOrder, centreAngles);

	std::array<VNumbers, t_Size> EulerData;
	const auto sample = [&](std::size_t i_A, std::size_t i_B, const VCosSin& i_rDirection)
	{
		std::array<double, t_Size> state;
		for (std::size_t i = 0; i < t_Size; ++i)
			state[i] = i_rDirection.Cos * extents[i_A] * eigen.Vectors()[i_A * t_Size + i]
			    + i_rDirection.Sin * extents[i_B] * eigen.Vectors()[i_B * t_Size + i];
		const VMatrix3 turn = Rotation::RotationMatrixFromAngleAxis({state[0], state[1], state[2]});
		const VVector3 angles = EulerNextTo(Rotation::Product(centre, turn), centreAngles);
		for (std::size_t i = 0; i < 3; ++i)
			EulerData[i].push_back(angles[i]);
		for (std::size_t i = 3; i < t_Size; ++i)
			EulerData[i].push_back(i_rCentre[i] + state[i]);
	};
	for (std::size_t a = 0; a < t_Size; ++a)
		for (std::size_t b = a + 1; b < t_Size; ++b)
			for (std::size_t quadrant = 0; !CosSinSamples[quadrant].empty(); ++quadrant)
				for (const VCosSin& rDirection : CosSinSamples[quadrant])
					sample(a, b, rDirection);

	for (std::size_t i = 0; i < t_Size; ++i)
	{
		if (!Expect(EulerData[i].size() > 2, "EulerData[ i ].size() > 2"))
			continue;
		const auto [least, greatest] = std::minmax_element(EulerData[i].begin(), EulerData[i].end());
		o_rMin[i] = *least;
		o_rMax[i] = *greatest;
	}
}

/// How far the ellipse of a Hardy Spicer joint reaches along each angle.
std::array<double, 2> EllipseExtents(const VNumbers& i_rEllipseMat)
{
	if (!Expect(i_rEllipseMat.size() == 4, "i_rEllipseMat.size() == 4"))
		return {};
	return {std::sqrt(std::max(i_rEllipseMat[0], 0.0)), std::sqrt(std::max(i_rEllipseMat[3], 0.0))};
}

constexpr const char* c_pUnknownType = "Cannot convert ranges: unsupported joint type";
constexpr const char* c_pRangeNotFinite = "Cannot convert ranges: a value is not finite";

} // namespace

bool RangeToMinMax(VJoint::EJointType i_JointType, const VNumbers& i_rRangeCenteringState,
    const VNumbers& i_rRangeMatrix, VNumbers& o_rMin, VNumbers& o_rMax)
{
	const std::size_t DoF = CoreOrlexTypes::StateSize(i_JointType);
	bool bFits = Expect(DoF == i_rRangeCenteringState.size(), "DoF == i_rRangeCenteringState.size()");
	bFits &= Expect((DoF * DoF) == i_rRangeMatrix.size(), "( DoF*DoF ) == i_rRangeMatrix.size()");
	if (!CoreOrlexTypes::IsJointType(i_JointType))
		return Refuse(c_pUnknownType);
	const std::array<double, 2> ellipse =
	    i_JointType == VJoint::EHardySpicer ? EllipseExtents(i_rRangeMatrix) : std::array<double, 2>{};
	if (!bFits)
		return false;
	if (!AllFinite(i_rRangeCenteringState) || !AllFinite(i_rRangeMatrix))
		return Refuse(c_pRangeNotFinite);

	o_rMin.assign(DoF, 0.0);
	o_rMax.assign(DoF, 0.0);
	if (i_JointType == VJoint::EFree)
		SampleBoundary<6>(i_rRangeCenteringState, i_rRangeMatrix, o_rMin, o_rMax);
	else if (i_JointType == VJoint::EBall)
		SampleBoundary<3>(i_rRangeCenteringState, i_rRangeMatrix, o_rMin, o_rMax);
	else
	{
		const std::array<double, 2> extents = i_JointType == VJoint::EHardySpicer
		    ? ellipse
		    : std::array<double, 2>{DoF ? std::sqrt(std::max(i_rRangeMatrix[0], 0.0)) : 0.0, 0.0};
		for (std::size_t i = 0; i < DoF; ++i)
		{
			o_rMin[i] = i_rRangeCenteringState[i] - extents[i];
			o_rMax[i] = i_rRangeCenteringState[i] + extents[i];
		}
	}
	return (AllFinite(o_rMin) && AllFinite(o_rMax)) || Refuse(c_pRangeNotFinite);
}

bool MinMaxToRange(VJoint::EJointType i_JointType, const VNumbers& i_rMin, const VNumbers& i_rMax,
    VNumbers& o_rRangeCenteringState, VNumbers& o_rRangeMatrix)
{
	const std::size_t DoFCount = CoreOrlexTypes::StateSize(i_JointType);
	bool bFits = Expect(i_rMin.size() == DoFCount, "i_rMin.size() == DoFCount");
	bFits &= Expect(i_rMax.size() == DoFCount, "i_rMax.size() == DoFCount");
	if (i_JointType == VJoint::EBall)
	{
		NVX_ASSERT(!"Range conversion from MinMax to axis angle not supported on a ball joint");
		return Refuse("Range conversion from MinMax to axis angle not supported on a ball joint");
	}
	if (i_JointType == VJoint::EFree)
	{
		NVX_ASSERT(!"Range conversion from MinMax to axis angle not supported on a free joint");
		return Refuse("Range conversion from MinMax to axis angle not supported on a free joint");
	}
	if (!CoreOrlexTypes::IsJointType(i_JointType))
		return Refuse(c_pUnknownType);
	if (!bFits)
		return false;
	if (!AllFinite(i_rMin) || !AllFinite(i_rMax))
		return Refuse(c_pRangeNotFinite);

	o_rRangeCenteringState.assign(DoFCount, 0.0);
	o_rRangeMatrix.assign(DoFCount * DoFCount, 0.0);
	for (std::size_t i = 0; i < DoFCount; ++i)
	{
		const double d = i_rMax[i] - i_rMin[i];
		o_rRangeCenteringState[i] = i_rMin[i] + d * 0.5;
		o_rRangeMatrix[i * (DoFCount + 1)] = d * d * 0.25;
	}
	return (AllFinite(o_rRangeCenteringState) && AllFinite(o_rRangeMatrix)) || Refuse(c_pRangeNotFinite);
}

} // namespace CoreOrlexTypesUtils::TemplateSubjectUtils
