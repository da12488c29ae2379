#include "numerics/fnl_svd_fixed.h"
#include "numerics/fnl_symmetric_eigensystem.h"

#include <Eigen/Dense>
#include <gtest/gtest.h>

#include <random>
#include <string>

namespace
{

constexpr double c_NaN = std::numeric_limits<double>::quiet_NaN();

/// Of sizes that are not known to the compiler, which would be busy with each of them for seconds.
template <typename TEntries>
Eigen::MatrixXd Rows(int i_Rows, int i_Columns, const TEntries& i_rEntries)
{
	using VRowMajor = Eigen::Matrix<double, Eigen::Dynamic, Eigen::Dynamic, Eigen::RowMajor>;
	return Eigen::Map<const VRowMajor>(i_rEntries.data(), i_Rows, i_Columns);
}

/// What the library writes to the standard error stream while i_rAction runs.
template <typename TAction>
std::string Reported(const TAction& i_rAction)
{
	testing::internal::CaptureStderr();
	i_rAction();
	return testing::internal::GetCapturedStderr();
}

void ExpectFactors(const Eigen::MatrixXd& m, const Eigen::MatrixXd& u, const Eigen::VectorXd& w,
    const Eigen::MatrixXd& vt, const Eigen::MatrixXd& inverse)
{
	const Eigen::MatrixXd one = Eigen::MatrixXd::Identity(w.size(), w.size());
	EXPECT_LT((u * w.asDiagonal() * vt - m).cwiseAbs().maxCoeff(), 1e-13);
	EXPECT_LT((u.transpose() * u - one).norm(), 1e-13);
	EXPECT_LT((vt * vt.transpose() - one).norm(), 1e-13);
	EXPECT_LT((w - Eigen::JacobiSVD<Eigen::MatrixXd>(m).singularValues()).norm(), 1e-13);
	EXPECT_LT((m * inverse * m - m).cwiseAbs().maxCoeff(), 1e-12);
}

template <int t_Rows, int t_Columns>
void ExpectDecomposes(const std::array<double, std::size_t(t_Rows* t_Columns)>& i_rM)
{
	const int smaller = std::min(t_Rows, t_Columns);
	const fnl_svd_fixed<t_Rows, t_Columns> svd(i_rM);
	EXPECT_TRUE(std::is_sorted(svd.W().rbegin(), svd.W().rend()));
	ExpectFactors(Rows(t_Rows, t_Columns, i_rM), Rows(t_Rows, smaller, svd.U()), Rows(smaller, 1, svd.W()),
	    Rows(smaller, t_Columns, svd.Vt()), Rows(t_Columns, t_Rows, svd.Inverse(1e-12)));
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
		std::array<double, 36> entries;
		for (std::size_t row = 0; row < 6; ++row)
			for (std::size_t column = 0; column <= row; ++column)
				entries[6 * row + column] = entries[6 * column + row] = value(random);
		const Eigen::MatrixXd matrix = Rows(6, 6, entries);
		const auto rebuilt = [](const auto& i_rVectors, const auto& i_rValues) -> Eigen::MatrixXd
		{
			const Eigen::MatrixXd vectors = Rows(6, 6, i_rVectors);
			const Eigen::VectorXd values = Rows(6, 1, i_rValues);
			return vectors.transpose() * values.asDiagonal() * vectors;
		};

		const fnl_symmetric_eigensystem<6> fixed(entries);
		EXPECT_LT((rebuilt(fixed.Vectors(), fixed.Values()) - matrix).norm(), 1e-13);
		EXPECT_TRUE(std::is_sorted(fixed.Values().begin(), fixed.Values().end()));

		std::vector<double> generalVectors;
		std::vector<double> generalValues;
		ASSERT_TRUE(fnl_symmetric_eigensystem_compute({entries.begin(), entries.end()}, generalVectors, generalValues));
		EXPECT_LT((rebuilt(generalVectors, generalValues) - matrix).norm(), 1e-13);
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
