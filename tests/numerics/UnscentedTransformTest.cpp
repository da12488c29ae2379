#include "numerics/UnscentedTransform.h"
#include "numerics/Rotation.h"

#include <Eigen/Dense>
#include <gtest/gtest.h>

#include <algorithm>

namespace
{

using Eigen::Matrix3d;
using Eigen::Vector3d;
using VArray3 = std::array<double, 3>;
using VArray9 = std::array<double, 9>;

/// Symmetric, so that row by row and column by column are the same.
VArray9 Entries(const Matrix3d& i_rMatrix)
{
	VArray9 entries;
	Matrix3d::Map(entries.data()) = i_rMatrix;
	return entries;
}

const Matrix3d c_Factor = (Matrix3d() << 0.2, 0.05, 0, -0.1, 0.15, 0.02, 0.03, 0, 0.1).finished();
const Matrix3d c_Covariance = c_Factor * c_Factor.transpose();
const VArray3 c_Mean{0.4, -0.3, 0.2};

TEST(UnscentedTransform, IdentityGivesItsInputBack)
{
	for (const double scale : {1.0, 1e8, 0.0})
	{
		VArray3 mean;
		VArray9 covariance;
		UnscentedTransform([](const VArray3& x) { return x; }, c_Mean, Entries(scale * c_Covariance), mean, covariance);
		const double size = std::sqrt(scale);
		EXPECT_LT((Vector3d(mean.data()) - Vector3d(c_Mean.data())).norm(), 1e-11 * std::max(size, 1.0));
		EXPECT_LT((Matrix3d(covariance.data()) - scale * c_Covariance).norm(), 1e-11 * std::max(scale, 1.0)) << scale;
	}
}

TEST(UnscentedTransform, LinearMapIsExact)
{
	const Matrix3d a = (Matrix3d() << 1, 2, 0, -1, 0.5, 3, 0, 1, -2).finished();
	VArray3 mean;
	VArray9 covariance;
	UnscentedTransform(
	    [&](const VArray3& x) -> VArray3
	    {
		    const Vector3d y = a * Vector3d(x.data()) + Vector3d(10, 20, 30);
		    return {y[0], y[1], y[2]};
	    },
	    c_Mean, Entries(c_Covariance), mean, covariance);
	// The rounding of images near 30, times the weight of 1.25e5.
	EXPECT_LT((Vector3d(mean.data()) - (a * Vector3d(c_Mean.data()) + Vector3d(10, 20, 30))).norm(), 1e-8);
	EXPECT_LT((Matrix3d(covariance.data()) - a * c_Covariance * a.transpose()).norm(), 1e-10);
}

TEST(UnscentedTransform, SquareOfOneVariable)
{
	// x ~ N(m, v): x^2 has the mean m^2 + v and the variance 4 m^2 v + 2 v^2. The scaled transform with one dimension
	// gives the same mean, and for beta 2 a variance that lacks only terms of alpha^2.
	std::array<double, 1> mean;
	std::array<double, 1> variance;
	using VOne = std::array<double, 1>;
	UnscentedTransform([](const VOne& x) { return VOne{x[0] * x[0]}; }, VOne{3.0}, VOne{0.5}, mean, variance);
	EXPECT_NEAR(mean[0], 9.5, 1e-9);
	EXPECT_NEAR(variance[0], 4 * 9 * 0.5 + 2 * 0.25, 1e-5);
}

TEST(UnscentedTransform, NegativeEigenvaluesCountAsZero)
{
	VArray3 mean;
	VArray9 covariance;
	UnscentedTransform([](const VArray3& x) { return x; }, c_Mean, {4, 0, 0, 0, -1, 0, 0, 0, 9}, mean, covariance);
	const VArray9 expected{4, 0, 0, 0, 0, 0, 0, 0, 9};
	for (int i = 0; i < 9; ++i)
		EXPECT_NEAR(covariance[i], expected[i], 1e-10) << i;
}

/// Euler angles of a ball joint to its angle-axis state, against a dense grid over the Gaussian.
TEST(UnscentedTransform, BallJointAgreesWithDenseSampling)
{
	const auto toAngleAxis = [](const VArray3& x)
	{ return Rotation::AngleAxisFromRotationMatrix(Rotation::RotationMatrixFromEuler(x, Rotation::EXYZ)); };
	const Matrix3d factor = 0.5 * c_Factor;
	VArray3 mean;
	VArray9 covariance;
	UnscentedTransform(toAngleAxis, c_Mean, Entries(factor * factor.transpose()), mean, covariance);

	double total = 0.0;
	Vector3d sum = Vector3d::Zero();
	Matrix3d squares = Matrix3d::Zero();
	constexpr double c_Step = 0.25;
	for (double x = -5.0; x <= 5.0; x += c_Step)
		for (double y = -5.0; y <= 5.0; y += c_Step)
			for (double z = -5.0; z <= 5.0; z += c_Step)
			{
				const Vector3d point = Vector3d(c_Mean.data()) + factor * Vector3d(x, y, z);
				const VArray3 image = toAngleAxis({point[0], point[1], point[2]});
				const Vector3d value(image.data());
				const double weight = std::exp(-0.5 * (x * x + y * y + z * z));
				total += weight;
				sum += weight * value;
				squares += weight * value * value.transpose();
			}
	const Vector3d denseMean = sum / total;
	const Matrix3d denseCovariance = squares / total - denseMean * denseMean.transpose();
	// Beyond the second order of the map the two differ.
	EXPECT_LT((Vector3d(mean.data()) - denseMean).norm(), 2e-5);
	EXPECT_LT((Matrix3d(covariance.data()) - denseCovariance).norm(), 0.01 * denseCovariance.norm());
	// Far closer than the image of the mean, which leaves the curvature out.
	const VArray3 image = toAngleAxis(c_Mean);
	EXPECT_GT((Vector3d(image.data()) - denseMean).norm(), 20 * (Vector3d(mean.data()) - denseMean).norm());
}

} // namespace
