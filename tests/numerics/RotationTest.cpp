#include "numerics/Rotation.h"
#include "numerics/FastRotation.h"

#include <Eigen/Geometry>
#include <gtest/gtest.h>

#include <limits>
#include <numbers>
#include <random>

namespace
{

using namespace Rotation;
constexpr double c_Pi = std::numbers::pi;

using VRowMajor = Eigen::Matrix<double, 3, 3, Eigen::RowMajor>;

double Difference(const VMatrix3& i_rMatrix, const Eigen::Matrix3d& i_rExpected)
{
	return (VRowMajor(i_rMatrix.data()) - i_rExpected).cwiseAbs().maxCoeff();
}

VMatrix3 FromEigen(const Eigen::Matrix3d& i_rMatrix)
{
	VMatrix3 result;
	VRowMajor::Map(result.data()) = i_rMatrix;
	return result;
}

Eigen::Matrix3d Expected(const VVector3& i_rAngleAxis)
{
	const Eigen::Vector3d v(i_rAngleAxis.data());
	return Eigen::AngleAxisd(v.norm(), v.normalized()).toRotationMatrix();
}

struct VAngleAxisRow
{
	const char* m_pName;
	VVector3 m_AngleAxis;
	/// What comes back, where it differs.
	VVector3 m_Back;
};

const VAngleAxisRow c_AngleAxes[] = {
    {"QuarterTurn", {0, 0, c_Pi / 2}, {0, 0, c_Pi / 2}},
    {"AboutAnything", {0.3, -1.2, 0.7}, {0.3, -1.2, 0.7}},
    {"HalfTurnX", {c_Pi, 0, 0}, {c_Pi, 0, 0}},
    {"HalfTurnY", {0, c_Pi, 0}, {0, c_Pi, 0}},
    {"HalfTurnZ", {0, 0, c_Pi}, {0, 0, c_Pi}},
    {"JustBelowHalfATurn", {0, c_Pi - 1e-7, 0}, {0, c_Pi - 1e-7, 0}},
    {"Small", {1e-9, 0, -1e-9}, {1e-9, 0, -1e-9}},
    {"JustAboveTheSmallest", {5e-15, 0, 0}, {5e-15, 0, 0}},
    {"LastThatIsFitted", {0, 3.16227766016837, 0}, {0, 3.16227766016837 - 2 * c_Pi, 0}},
    {"FirstThatIsNot", {0, 3.16227766016839, 0}, {0, 3.16227766016839 - 2 * c_Pi, 0}},
    {"BeyondHalfATurn", {0, 0, 3 * c_Pi / 2}, {0, 0, -c_Pi / 2}},
};

TEST(Rotation, AngleAxisToMatrixAndBack)
{
	for (const VAngleAxisRow& rRow : c_AngleAxes)
	{
		SCOPED_TRACE(rRow.m_pName);
		const VMatrix3 matrix = RotationMatrixFromAngleAxis(rRow.m_AngleAxis);
		EXPECT_LT(Difference(matrix, Expected(rRow.m_AngleAxis)), 1e-15);
		EXPECT_LT(Difference(FastRotationMatrix(rRow.m_AngleAxis), Expected(rRow.m_AngleAxis)), 1e-15);
		EXPECT_TRUE(IsRotationMatrix(matrix, 1e-14));
		const VVector3 back = CanonicalAngleAxis(AngleAxisFromRotationMatrix(matrix));
		for (int i = 0; i < 3; ++i)
			EXPECT_NEAR(back[i], rRow.m_Back[i], 1e-15 + 1e-14 * std::abs(rRow.m_Back[i])) << i;
	}
}

TEST(Rotation, BelowTheSmallestAngleIsExactlyTheIdentity)
{
	EXPECT_EQ(RotationMatrixFromAngleAxis({0, 0, 0}), c_Identity3);
	EXPECT_EQ(RotationMatrixFromAngleAxis({1e-15, -1e-15, 1e-15}), c_Identity3);
	EXPECT_EQ(FastRotationMatrix(VVector3{1e-15, -1e-15, 1e-15}), c_Identity3);
	EXPECT_EQ(AngleAxisFromRotationMatrix(c_Identity3), (VVector3{}));
}

TEST(Rotation, RandomRotationsComeBack)
{
	std::mt19937 random(17);
	std::normal_distribution<double> value;
	for (int i = 0; i < 2000; ++i)
	{
		const Eigen::Quaterniond q =
		    Eigen::Quaterniond(value(random), value(random), value(random), value(random)).normalized();
		const VMatrix3 matrix = FromEigen(q.toRotationMatrix());
		const VVector3 angleAxis = AngleAxisFromRotationMatrix(matrix);
		ASSERT_LT(Difference(matrix, Expected(angleAxis)), 1e-14);
	}
}

TEST(Rotation, CanonicalAngleAxis)
{
	const struct
	{
		double m_Length;
		double m_Expected;
	} rows[] = {{0, 0}, {3, 3}, {c_Pi, c_Pi}, {4, 4 - 2 * c_Pi}, {2 * c_Pi + 0.1, 0.1}, {20, 20 - 6 * c_Pi}};
	for (const auto& rRow : rows)
		EXPECT_NEAR(CanonicalAngleAxis({0, -rRow.m_Length, 0})[1], -rRow.m_Expected, 1e-14) << rRow.m_Length;
}

TEST(Rotation, PosesComposeAsHomogeneousMatrices)
{
	const VPose<double> a = PoseFromAngleAxis({0.3, -1.2, 0.7}, {10, 20, 30});
	const VPose<double> b = PoseFromAngleAxis({-2.0, 0.1, 0.4}, {-5, 60, 7});
	const auto eigen = [](const VPose<double>& i_rPose)
	{
		Eigen::Isometry3d pose = Eigen::Isometry3d::Identity();
		pose.linear() = VRowMajor(i_rPose.R.data());
		pose.translation() = Eigen::Vector3d(i_rPose.t.data());
		return pose;
	};
	const auto expectEqual = [&](const VPose<double>& i_rPose, const Eigen::Isometry3d& i_rExpected)
	{ EXPECT_LT((eigen(i_rPose).matrix() - i_rExpected.matrix()).cwiseAbs().maxCoeff(), 1e-13); };
	expectEqual(Compose(a, b), eigen(a) * eigen(b));
	expectEqual(Relative(a, b), eigen(a).inverse() * eigen(b));
	expectEqual(Inverse(a), eigen(a).inverse());
	const VVector3 applied = Apply(a, {1, 2, 3});
	EXPECT_LT((Eigen::Vector3d(applied.data()) - eigen(a) * Eigen::Vector3d(1, 2, 3)).cwiseAbs().maxCoeff(), 1e-13);
}

struct VIsRotationRow
{
	const char* m_pName;
	VMatrix3 m_Matrix;
	double m_Tolerance;
	bool m_bRotation;
};

const VIsRotationRow c_IsRotation[] = {
    {"Identity", c_Identity3, 0.0, true},
    {"Mirror", {1, 0, 0, 0, 1, 0, 0, 0, -1}, 0.1, false},
    {"OneEntryWithin", {1, 0.009, 0, 0, 1, 0, 0, 0, 1}, 0.01, true},
    {"OneEntryBeyond", {1, 0.011, 0, 0, 1, 0, 0, 0, 1}, 0.01, false},
    {"ManyEntriesWithin", {1, 0.004, 0.004, 0.004, 1, 0.004, 0.004, 0.004, 1}, 0.01, true},
    {"DeterminantBeyond", {1.004, 0, 0, 0, 1.004, 0, 0, 0, 1.004}, 0.01, false},
    {"NotANumber", {1, 0, 0, 0, std::numeric_limits<double>::quiet_NaN(), 0, 0, 0, 1}, 1e9, false},
    {"Infinite", {1, 0, 0, 0, std::numeric_limits<double>::infinity(), 0, 0, 0, 1}, 1e9, false},
};

TEST(Rotation, IsRotationMatrix)
{
	for (const VIsRotationRow& rRow : c_IsRotation)
		EXPECT_EQ(IsRotationMatrix(rRow.m_Matrix, rRow.m_Tolerance), rRow.m_bRotation) << rRow.m_pName;
}

struct VEulerRow
{
	EEulerOrder m_Order;
	int m_Axes[3];
};

const VEulerRow c_Orders[] = {
    {EXYZ, {0, 1, 2}}, {EXZY, {0, 2, 1}}, {EYXZ, {1, 0, 2}}, {EYZX, {1, 2, 0}}, {EZXY, {2, 0, 1}}, {EZYX, {2, 1, 0}}};

/// R_A R_B R_C with the axes of the order.
Eigen::Matrix3d Composed(const VEulerRow& i_rOrder, const VVector3& i_rAngles)
{
	Eigen::Matrix3d matrix = Eigen::Matrix3d::Identity();
	for (int i = 0; i < 3; ++i)
		matrix = matrix * Eigen::AngleAxisd(i_rAngles[i], Eigen::Vector3d::Unit(i_rOrder.m_Axes[i])).toRotationMatrix();
	return matrix;
}

TEST(Rotation, EulerAnglesComeBack)
{
	std::mt19937 random(23);
	std::uniform_real_distribution<double> outer(-3.1, 3.1);
	std::uniform_real_distribution<double> middle(-1.5, 1.5);
	for (const VEulerRow& rOrder : c_Orders)
		for (int i = 0; i < 200; ++i)
		{
			const VVector3 angles{outer(random), middle(random), outer(random)};
			const Eigen::Matrix3d expected = Composed(rOrder, angles);
			ASSERT_LT(Difference(RotationMatrixFromEuler(angles, rOrder.m_Order), expected), 1e-15);
			VVector3 back;
			EulerFromRotationMatrix(FromEigen(expected), rOrder.m_Order, back);
			for (int k = 0; k < 3; ++k)
				ASSERT_NEAR(back[k], angles[k], 1e-13) << rOrder.m_Order << ": " << k;
		}
}

TEST(Rotation, GimbalLockHasFirstAngleZeroAndStillRebuilds)
{
	for (const VEulerRow& rOrder : c_Orders)
		for (const double middle : {c_Pi / 2, -c_Pi / 2})
			for (const double first : {0.0, 0.4, -2.5})
			{
				SCOPED_TRACE(testing::Message() << rOrder.m_Order << ", " << middle << ", " << first);
				// The cosine of the nearest double to a quarter turn is not quite 0: the exact matrix is rounded.
				const Eigen::Matrix3d quarter = Composed(rOrder, {0.0, middle, 0.0}).array().round();
				const Eigen::Matrix3d locked =
				    Composed(rOrder, {first, 0.0, 0.0}) * quarter * Composed(rOrder, {0.0, 0.0, 1.1});
				VVector3 angles;
				EulerFromRotationMatrix(FromEigen(locked), rOrder.m_Order, angles);
				EXPECT_EQ(angles[0], 0.0);
				EXPECT_NEAR(angles[1], middle, 1e-15);
				EXPECT_LT((Composed(rOrder, angles) - locked).cwiseAbs().maxCoeff(), 1e-15);

				// A last bit beside the lock the arcsine has only half of the digits.
				const Eigen::Matrix3d beside = Composed(rOrder, {first, middle, 1.1});
				EulerFromRotationMatrix(FromEigen(beside), rOrder.m_Order, angles);
				EXPECT_LT((Composed(rOrder, angles) - beside).cwiseAbs().maxCoeff(), 1e-7);
			}
}

TEST(Rotation, SineBeyondOneIsClamped)
{
	VVector3 angles;
	EulerFromRotationMatrix({0, 0, 1.0 + 1e-12, 0, 1, 0, -1, 0, 0}, EXYZ, angles);
	EXPECT_EQ(angles, (VVector3{0.0, c_Pi / 2, 0.0}));
}

} // namespace
