#include "numerics/Lapack.h"

#include "DebugServices/GlobalLog.h"
#include "numerics/AllFinite.h"

#include <boost/dll/shared_library.hpp>

#include <lapacke.h>

#include <algorithm>

namespace Lapack
{
namespace
{

/// LAPACK brings libraries of 40 MB, which every start of a program would wait for. They are loaded when the first
/// matrix is taken apart, and stay.
const boost::dll::shared_library& Library()
{
	static const boost::dll::shared_library s_Library = []
	{
		boost::dll::fs::error_code error;
		boost::dll::shared_library library(
		    RETARGET_LAPACKE, boost::dll::load_mode::rtld_now | boost::dll::load_mode::search_system_folders, error);
		if (error)
			NVX_LOG("System", NVX::ELogError,
			    "The library of matrices, %1%, cannot be loaded: %2%. No matrix can be checked. Install it",
			    RETARGET_LAPACKE, error.message());
		return library;
	}();
	return s_Library;
}

/// Null if it cannot be had.
template <typename TFunction>
TFunction* Routine(const char* i_pName)
{
	const boost::dll::shared_library& rLibrary = Library();
	return rLibrary.is_loaded() && rLibrary.has(i_pName) ? &rLibrary.get<TFunction>(i_pName) : nullptr;
}

} // namespace

bool IsLoaded()
{
	return Library().is_loaded();
}

int Dgesvd(int i_Rows, int i_Columns, double* io_pM, double* o_pW, double* o_pU, double* o_pVt, double* o_pWork,
    int i_WorkSize)
{
	static const auto s_pRoutine = Routine<decltype(LAPACKE_dgesvd_work)>("LAPACKE_dgesvd_work");
	if (!s_pRoutine)
		return c_NotLoaded;
	if (!AllFinite({io_pM, std::size_t(i_Rows * i_Columns)}))
		return -6;
	// Row by row, the matrix is its transpose column by column, and the two factors change places.
	const int smaller = std::min(i_Rows, i_Columns);
	return s_pRoutine(LAPACK_COL_MAJOR, 'S', 'S', i_Columns, i_Rows, io_pM, i_Columns, o_pW, o_pVt, i_Columns, o_pU,
	    smaller, o_pWork, i_WorkSize);
}

// The upper triangle row by row is the lower one column by column.

int Dsyev(int i_Size, double* io_pMatrix, double* o_pValues, double* o_pWork, int i_WorkSize)
{
	static const auto s_pRoutine = Routine<decltype(LAPACKE_dsyev_work)>("LAPACKE_dsyev_work");
	if (!s_pRoutine)
		return c_NotLoaded;
	if (!AllFinite({io_pMatrix, std::size_t(i_Size * i_Size)}))
		return -5;
	return s_pRoutine(
	    LAPACK_COL_MAJOR, 'V', 'L', i_Size, io_pMatrix, std::max(i_Size, 1), o_pValues, o_pWork, i_WorkSize);
}

int Dsyevd(int i_Size, double* io_pMatrix, double* o_pValues)
{
	static const auto s_pRoutine = Routine<decltype(LAPACKE_dsyevd)>("LAPACKE_dsyevd");
	if (!s_pRoutine)
		return c_NotLoaded;
	if (!AllFinite({io_pMatrix, std::size_t(i_Size * i_Size)}))
		return -5;
	return s_pRoutine(LAPACK_COL_MAJOR, 'V', 'L', i_Size, io_pMatrix, std::max(i_Size, 1), o_pValues);
}

} // namespace Lapack
