#pragma once

#include <cstddef>

/// Thin wrappers of the LAPACK routines in use. Matrices are row by row. A result other than 0 is the routine's: above
/// 0 it did not converge, below 0 an argument was bad; -5 and -6 stand for a matrix that is not finite, which the
/// routine never sees, and c_NotLoaded for LAPACK itself missing. It is loaded when it is called first.
namespace Lapack
{

/// Told once in the log category "System".
inline constexpr int c_NotLoaded = -1000;

/// Loads LAPACK if it is not there yet. Without it nothing can be said about a matrix.
bool IsLoaded();

/// Doubles of work space that Dgesvd needs.
constexpr std::size_t DgesvdWork(std::size_t i_Rows, std::size_t i_Columns)
{
	const std::size_t smaller = i_Rows < i_Columns ? i_Rows : i_Columns;
	const std::size_t larger = i_Rows < i_Columns ? i_Columns : i_Rows;
	return 3 * smaller + larger > 5 * smaller ? 3 * smaller + larger : 5 * smaller;
}

/// M = U diag(W) Vt, with K the smaller of rows and columns: U is rows x K, W has K values in descending order, Vt is
/// K x columns. M is destroyed.
int Dgesvd(int i_Rows, int i_Columns, double* io_pM, double* o_pW, double* o_pU, double* o_pVt, double* o_pWork,
    int i_WorkSize);

/// Of a symmetric matrix: eigenvalues in ascending order; the rows of the matrix become the eigenvectors.
/// Only the upper triangle is read.
int Dsyev(int i_Size, double* io_pMatrix, double* o_pValues, double* o_pWork, int i_WorkSize);

/// The same by divide and conquer; allocates its own work space.
int Dsyevd(int i_Size, double* io_pMatrix, double* o_pValues);

} // namespace Lapack
