#include "numerics/fnl_svd_fixed.h"
#include "numerics/fnl_symmetric_eigensystem.h"

#include <Eigen/Dense>
#include <gtest/gtest.h>

#include <random>
#include <string>

namespace
{

constexpr double c_NaN = std::numeric_limits<double>::quiet_NaN();

template <int t_Rows, int t_Columns>
using VRows = Eigen::Matrix<double, t_Rows, t_Columns, t_Columns == 1 ? Eigen::ColMajor : Eigen::RowMajor>;

/// What the library writes to the standard error stream while i_rAction runs.
template <typename TAction>
std::string Reported(const TAction& i_rAction)
{
	testing::internal::CaptureStderr();
	i_rAction();
	return testing::internal::GetCapturedStderr();
}

template <int t_Rows, int t_Columns>
void ExpectDecomposes(const std::array<double, std::size_t(t_Rows* t_Columns)>& i_rM)
{
	constexpr int c_Smaller = std::min(t_Rows, t_Columns);
	const fnl_svd_fixed<t_Rows, t_Columns> svd(i_rM);
	const VRows<t_Rows, t_Columns> m(i_rM.data());
	const VRows<t_Rows, c_Smaller> u(svd.U().data());
	const VRows<c_Smaller, t_Columns> vt(svd.Vt().data());
	const Eigen::Map<const Eigen::Vector<double, c_Smaller>> w(svd.W().data());
	EXPECT_LT((u * w.asDiagonal() * vt - m).cwiseAbs().maxCoeff(), 1e-13);
	EXPECT_LT((u.transpose() * u - Eigen::Matrix<double, c_Smaller, c_Smaller>::Identity()).norm(), 1e-13);
	EXPECT_LT((vt * vt.transpose() - Eigen::Matrix<double, c_Smaller, c_Smaller>::Identity()).norm(), 1e-13);
	EXPECT_TRUE(std::is_sorted(svd.W().rbegin(), svd.W().rend()));
	EXPECT_LT((w - Eigen::JacobiSVD<Eigen::MatrixXd>(m).singularValues()).norm(), 1e-13);
	const VRows<t_Columns, t_Rows> inverse(svd.Inverse(1e-12).data());
	EXPECT_LT((m * inverse * m - m).cwiseAbs().maxCoeff(), 1e-12);
}

TEST(SingularValues, FactorsGiveTheMatrixBack)
{
	std::mt19937 random(31);
	std::normal_distribution<double> value;
	const auto fill = [&](auto i_Matrix)
	{
		for (double& rEntry : i_Matrix)
			rEntry = value(random);
		return i_Matrix;
	};
	for (int i = 0; i < 20; ++i)
	{
		ExpectDecomposes<3, 3>(fill(std::array<double, 9>{}));
		ExpectDecomposes<6, 6>(fill(std::array<double, 36>{}));
		ExpectDecomposes<4, 2>(fill(std::array<double, 8>{}));
		ExpectDecomposes<2, 5>(fill(std::array<double, 10>{}));
	}
	ExpectDecomposes<3, 3>({1, 2, 3, 2, 4, 6, 0, 0, 1});
	ExpectDecomposes<3, 3>({});
}

TEST(SingularValues, ThresholdCutsTheInverse)
{
	const fnl_svd_fixed<2, 2> svd({4, 0, 0, 1e-10});
	EXPECT_NEAR(svd.Inverse(1e-20)[3], 1e10, 1e-3);
	EXPECT_EQ(svd.Inverse(1e-9)[3], 0.0);
	EXPECT_NEAR(svd.Inverse(1e-9)[0], 0.25, 1e-15);
}

TEST(SingularValues, BadMatrixIsReported)
{
	const std::string text = Reported(
	    []
	    {
		    const fnl_svd_fixed<2, 2> svd({1, c_NaN, 0.5, 2});
		    EXPECT_TRUE(std::isnan(svd.W()[0]) && std::isnan(svd.U()[3]) && std::isnan(svd.Inverse(1e-20)[0]));
	    });
	EXPECT_NE(text.find("suspicious return value (-6) from SVDC\n"), std::string::npos) << text;
	EXPECT_NE(text.find("M is 2x2\nM = [ ...\n1 1.#IND\n0.5 2 ]\n"), std::string::npos) << text;
	// A finite matrix is not printed.
	const double fine[] = {1.0};
	EXPECT_EQ(Reported([&] { fnl_svd_report(3, fine, 1, 1); }).find("M is "), std::string::npos);
}

TEST(Eigensystem, KnownValues)
{
	// Eigenvalues 1 and 3 of [2 1; 1 2]; 2 - sqrt 2, 2, 2 + sqrt 2 of the second difference matrix.
	const fnl_symmetric_eigensystem<2> two({2, 1, 1, 2});
	EXPECT_NEAR(two.Values()[0], 1.0, 1e-15);
	EXPECT_NEAR(two.Values()[1], 3.0, 1e-15);
	EXPECT_NEAR(two.Vectors()[2] - two.Vectors()[3], 0.0, 1e-15);
	const fnl_symmetric_eigensystem<3> three({2, -1, 0, -1, 2, -1, 0, -1, 2});
	EXPECT_NEAR(three.Values()[0], 2.0 - std::sqrt(2.0), 1e-15);
	EXPECT_NEAR(three.Values()[1], 2.0, 1e-15);
	EXPECT_NEAR(three.Values()[2], 2.0 + std::sqrt(2.0), 1e-15);
}

TEST(Eigensystem, FixedAndGeneralFormsRebuildTheMatrix)
{
	std::mt19937 random(37);
	std::normal_distribution<double> value;
	for (int i = 0; i < 50; ++i)
	{
		VRows<6, 6> matrix;
		for (double& rEntry : matrix.reshaped())
			rEntry = value(random);
		matrix = (matrix + matrix.transpose()).eval();
		std::array<double, 36> entries;
		VRows<6, 6>::Map(entries.data()) = matrix;

		const fnl_symmetric_eigensystem<6> fixed(entries);
		const VRows<6, 6> vectors(fixed.Vectors().data());
		const Eigen::Vector<double, 6> values(fixed.Values().data());
		EXPECT_LT((vectors.transpose() * values.asDiagonal() * vectors - matrix).norm(), 1e-13);
		EXPECT_TRUE(std::is_sorted(fixed.Values().begin(), fixed.Values().end()));

		std::vector<double> generalVectors;
		std::vector<double> generalValues;
		ASSERT_TRUE(fnl_symmetric_eigensystem_compute({entries.begin(), entries.end()}, generalVectors, generalValues));
		const VRows<6, 6> v(generalVectors.data());
		EXPECT_LT(
		    (v.transpose() * Eigen::Map<Eigen::VectorXd>(generalValues.data(), 6).asDiagonal() * v - matrix).norm(),
		    1e-13);
	}
}

TEST(Eigensystem, BadMatricesAreReported)
{
	std::vector<double> vectors;
	std::vector<double> values;
	EXPECT_TRUE(fnl_symmetric_eigensystem_compute({}, vectors, values));
	EXPECT_EQ(Reported(
	              [&] {
		              EXPECT_TRUE(std::isnan(fnl_symmetric_eigensystem<2>({1, 0, 0, c_NaN}).Values()[0]));
	              }),
	    "fnl_symmetric_eigensystem: ierr = -5\n");
	EXPECT_EQ(Reported(
	              [&] {
		              EXPECT_FALSE(fnl_symmetric_eigensystem_compute({1, 0, 0, 1.0 / 0.0}, vectors, values));
	              }),
	    "fnl_symmetric_eigensystem: ierr = -5\n");
	EXPECT_EQ(Reported(
	              [&] {
		              EXPECT_FALSE(fnl_symmetric_eigensystem_compute({1, 2, 3}, vectors, values));
	              }),
	    "fnl_symmetric_eigensystem: ierr = -3\n");
}

} // namespace
