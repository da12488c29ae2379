#include "numerics/MatrixValidity.h"

#include <gtest/gtest.h>

#include <array>
#include <limits>

namespace
{

using namespace MatrixValidity;

constexpr double c_NotANumber = std::numeric_limits<double>::quiet_NaN();
constexpr double c_Infinity = std::numeric_limits<double>::infinity();

TEST(MatrixValidity, OfThreeByThree)
{
	const struct
	{
		const char* m_pName;
		std::array<double, 9> m_Matrix;
		EFault m_Semidefinite;
		EFault m_Definite;
	} rows[] = {
	    {"zero", {}, EFault::ENone, EFault::ENone},
	    {"negative zero", {-0.0}, EFault::ENone, EFault::ENone},
	    // Eigenvalues 1, 3 and 5.
	    {"definite", {2, 1, 0, 1, 2, 0, 0, 0, 5}, EFault::ENone, EFault::ENone},
	    {"huge", {1e300, 0, 0, 0, 1e300, 0, 0, 0, 1e300}, EFault::ENone, EFault::ENone},
	    {"an eigenvalue of 0", {1, 0, 0, 0, 0, 0, 0, 0, 1}, EFault::ENone, EFault::EEigenvalue},
	    {"a negative eigenvalue", {1, 0, 0, 0, -1e-9, 0, 0, 0, 1}, EFault::EEigenvalue, EFault::EEigenvalue},
	    // Eigenvalues -1, 3 and 1: not to be seen on the diagonal.
	    {"indefinite", {1, 2, 0, 2, 1, 0, 0, 0, 1}, EFault::EEigenvalue, EFault::EEigenvalue},
	    {"within the tolerance", {1, 0.9e-12, 0, 0, 1, 0, 0, 0, 1}, EFault::ENone, EFault::ENone},
	    {"beyond it", {1, 0, 0, 0, 1, 0, 1.1e-12, 0, 1}, EFault::ENotSymmetric, EFault::ENotSymmetric},
	    {"difference overflows", {1, 1e308, 0, -1e308, 1, 0, 0, 0, 1}, EFault::ENotSymmetric, EFault::ENotSymmetric},
	    {"NaN", {1, 0, 0, 0, c_NotANumber, 0, 0, 0, 1}, EFault::ENotFinite, EFault::ENotFinite},
	    {"only NaN", {0, 0, 0, 0, 0, 0, 0, 0, c_NotANumber}, EFault::ENotFinite, EFault::ENotFinite},
	    {"infinity", {c_Infinity, 0, 0, 0, 1, 0, 0, 0, 1}, EFault::ENotFinite, EFault::ENotFinite},
	};
	for (const auto& rRow : rows)
	{
		EXPECT_EQ(FaultAsSemidefinite<3>(rRow.m_Matrix), rRow.m_Semidefinite) << rRow.m_pName;
		EXPECT_EQ(FaultAsDefinite(rRow.m_Matrix, 3), rRow.m_Definite) << rRow.m_pName;
	}
}

TEST(MatrixValidity, OfOtherSizes)
{
	EXPECT_EQ(FaultAsDefinite({}, 0), EFault::ENone);
	const auto one = [](double i_Value) { return FaultAsDefinite(std::span(&i_Value, 1), 1); };
	EXPECT_EQ(one(0.0), EFault::ENone);
	EXPECT_EQ(one(1e-300), EFault::ENone);
	EXPECT_EQ(one(-1e-300), EFault::EEigenvalue);
	EXPECT_EQ(one(c_NotANumber), EFault::ENotFinite);
	std::array<double, 36> six{};
	for (std::size_t i = 0; i < 6; ++i)
		six[7 * i] = 1.0;
	EXPECT_EQ(FaultAsSemidefinite<6>(six), EFault::ENone);
	EXPECT_EQ(FaultAsDefinite(six, 6), EFault::ENone);
	// The corner block becomes indefinite.
	six[5] = six[30] = 2.0;
	EXPECT_EQ(FaultAsSemidefinite<6>(six), EFault::EEigenvalue);
	EXPECT_EQ(FaultAsDefinite(six, 6), EFault::EEigenvalue);
	std::array<double, 4> two{1, 2, 2, 5};
	EXPECT_EQ(FaultAsDefinite(two, 2), EFault::ENone);
	two[3] = 3;
	EXPECT_EQ(FaultAsDefinite(two, 2), EFault::EEigenvalue);
	std::array<double, 16> four{};
	for (std::size_t i = 0; i < 4; ++i)
		four[5 * i] = 1.0;
	EXPECT_EQ(FaultAsDefinite(four, 4), EFault::ENone);
	four[15] = -1.0;
	EXPECT_EQ(FaultAsDefinite(four, 4), EFault::EEigenvalue);
}

} // namespace
