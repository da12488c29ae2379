#include "numerics/FindTransformBetweenPointsRobust.h"

#include "DebugServices/Assert.h"
#include "DebugServices/GlobalLog.h"
#include "math/NumberText.h"
#include "numerics/AllFinite.h"
#include "numerics/fnl_svd_fixed.h"

#include <algorithm>
#include <optional>
#include <random>

namespace
{

using namespace Rotation;
using VPoints = std::vector<VVector3>;

constexpr int c_Trials = 500;

VVector3 Minus(const VVector3& i_rA, const VVector3& i_rB)
{
	return {i_rA[0] - i_rB[0], i_rA[1] - i_rB[1], i_rA[2] - i_rB[2]};
}

VVector3 Mean(const VPoints& i_rPoints, const std::vector<std::size_t>& i_rChosen)
{
	VVector3 mean{};
	for (const std::size_t index : i_rChosen)
		for (int i = 0; i < 3; ++i)
			mean[i] += i_rPoints[index][i] / static_cast<double>(i_rChosen.size());
	return mean;
}

/// Least squares over the chosen pairs (W. Kabsch, Acta Crystallographica A32, 1976). None if the points lie on a line,
/// for then the turn about it is free.
std::optional<VPose<double>> Fit(
    const VPoints& i_rPoints1, const VPoints& i_rPoints2, const std::vector<std::size_t>& i_rChosen)
{
	constexpr double c_Flat = 1e-9;
	const VVector3 mean1 = Mean(i_rPoints1, i_rChosen);
	const VVector3 mean2 = Mean(i_rPoints2, i_rChosen);
	VMatrix3 correlation{};
	for (const std::size_t index : i_rChosen)
	{
		const VVector3 d1 = Minus(i_rPoints1[index], mean1);
		const VVector3 d2 = Minus(i_rPoints2[index], mean2);
		for (int row = 0; row < 3; ++row)
			for (int column = 0; column < 3; ++column)
				correlation[3 * row + column] += d2[row] * d1[column];
	}
	if (!AllFinite(correlation))
		return {};
	const fnl_svd_fixed<3, 3> svd(correlation);
	if (!(svd.W()[1] > c_Flat * svd.W()[0]))
		return {};
	VMatrix3 u = svd.U();
	if (Determinant(Product(u, svd.Vt())) < 0.0)
		for (int row = 0; row < 3; ++row)
			u[3 * row + 2] = -u[3 * row + 2];
	VPose<double> pose{Product(u, svd.Vt()), {}};
	pose.t = Minus(mean2, Product(pose.R, mean1));
	return pose;
}

std::vector<double> SquaredResiduals(const VPoints& i_rPoints1, const VPoints& i_rPoints2, const VPose<double>& i_rPose)
{
	std::vector<double> squares;
	for (std::size_t i = 0; i < i_rPoints1.size(); ++i)
	{
		const VVector3 d = Minus(Apply(i_rPose, i_rPoints1[i]), i_rPoints2[i]);
		squares.push_back(d[0] * d[0] + d[1] * d[1] + d[2] * d[2]);
	}
	return squares;
}

double Median(std::vector<double> i_Values)
{
	const auto middle = i_Values.begin() + static_cast<std::ptrdiff_t>(i_Values.size() / 2);
	// A pair that is not finite must not confuse the order.
	std::nth_element(i_Values.begin(), middle, i_Values.end(),
	    [](double a, double b) { return std::isnan(b) ? !std::isnan(a) : a < b; });
	return *middle;
}

} // namespace

bool FindTransformBetweenPointsRobust(const VPoints& a_rPoints1, const VPoints& a_rPoints2, VPose<double>& o_rPose)
{
	NVX_ASSERT(a_rPoints1.size() == a_rPoints2.size());
	const std::size_t count = a_rPoints1.size();
	if (count != a_rPoints2.size() || count < 3)
		return false;

	std::mt19937 random(1);
	std::uniform_int_distribution<std::size_t> anyPair(0, count - 1);
	std::optional<VPose<double>> best;
	double medsq = 0.0;
	for (int trial = 0; trial < c_Trials; ++trial)
	{
		const std::vector<std::size_t> triple{anyPair(random), anyPair(random), anyPair(random)};
		if (triple[0] == triple[1] || triple[1] == triple[2] || triple[0] == triple[2])
			continue;
		const auto candidate = Fit(a_rPoints1, a_rPoints2, triple);
		if (!candidate)
			continue;
		const double median = Median(SquaredResiduals(a_rPoints1, a_rPoints2, *candidate));
		if (!best || median < medsq)
		{
			best = candidate;
			medsq = median;
		}
	}
	if (!best)
		return false;
	NVX_LOG("System", NVX::ELogDetail, "FindTransformBetweenPointsRobust Medsq %1%", NumberText::PrintG17(medsq));

	// The estimate of the good pairs' deviation from the median, after the book; the rest lies within 2.5 of it.
	const double deviation = 1.4826 * (1.0 + 5.0 / std::max(static_cast<double>(count) - 3.0, 1.0)) * std::sqrt(medsq);
	const double limit = 2.5 * 2.5 * deviation * deviation;
	const std::vector<double> squares = SquaredResiduals(a_rPoints1, a_rPoints2, *best);
	std::vector<std::size_t> inliers;
	for (std::size_t i = 0; i < count; ++i)
		if (squares[i] <= limit)
			inliers.push_back(i);
	o_rPose = inliers.size() < 3 ? *best : Fit(a_rPoints1, a_rPoints2, inliers).value_or(*best);
	return true;
}
