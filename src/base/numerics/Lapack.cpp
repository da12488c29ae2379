#include "numerics/Lapack.h"

#include "numerics/AllFinite.h"

#include <lapacke.h>

namespace Lapack
{
int Dgesvd(int i_Rows, int i_Columns, double* io_pM, double* o_pW, double* o_pU, double* o_pVt, double* o_pWork,
    int i_WorkSize)
{
	if (!AllFinite({io_pM, std::size_t(i_Rows * i_Columns)}))
		return -6;
	// Row by row, the matrix is its transpose column by column, and the two factors change places.
	const int smaller = std::min(i_Rows, i_Columns);
	return LAPACKE_dgesvd_work(LAPACK_COL_MAJOR, 'S', 'S', i_Columns, i_Rows, io_pM, i_Columns, o_pW, o_pVt, i_Columns,
	    o_pU, smaller, o_pWork, i_WorkSize);
}

// The upper triangle row by row is the lower one column by column.

int Dsyev(int i_Size, double* io_pMatrix, double* o_pValues, double* o_pWork, int i_WorkSize)
{
	if (!AllFinite({io_pMatrix, std::size_t(i_Size * i_Size)}))
		return -5;
	return LAPACKE_dsyev_work(
	    LAPACK_COL_MAJOR, 'V', 'L', i_Size, io_pMatrix, std::max(i_Size, 1), o_pValues, o_pWork, i_WorkSize);
}

int Dsyevd(int i_Size, double* io_pMatrix, double* o_pValues)
{
	if (!AllFinite({io_pMatrix, std::size_t(i_Size * i_Size)}))
		return -5;
	return LAPACKE_dsyevd(LAPACK_COL_MAJOR, 'V', 'L', i_Size, io_pMatrix, std::max(i_Size, 1), o_pValues);
}

} // namespace Lapack
