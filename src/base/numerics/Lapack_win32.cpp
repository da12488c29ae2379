// LAPACK's routines by Eigen: no library of it is to be had here by its own name.
#include "numerics/AllFinite.h"
#include "numerics/Lapack.h"

#include <Eigen/Eigenvalues>
#include <Eigen/SVD>

#include <algorithm>

namespace Lapack
{
namespace
{

using VMatrix = Eigen::Matrix<double, Eigen::Dynamic, Eigen::Dynamic, Eigen::RowMajor>;

} // namespace

bool IsLoaded()
{
	return true;
}

int Dgesvd(
    int i_Rows, int i_Columns, double* io_pM, double* o_pW, double* o_pU, double* o_pVt, double* /*o_pWork*/, int)
{
	if (!AllFinite({io_pM, std::size_t(i_Rows * i_Columns)}))
		return -6;
	const Eigen::JacobiSVD<VMatrix> svd(
	    Eigen::Map<const VMatrix>(io_pM, i_Rows, i_Columns), Eigen::ComputeThinU | Eigen::ComputeThinV);
	const int smaller = std::min(i_Rows, i_Columns);
	Eigen::Map<Eigen::VectorXd>(o_pW, smaller) = svd.singularValues();
	Eigen::Map<VMatrix>(o_pU, i_Rows, smaller) = svd.matrixU();
	Eigen::Map<VMatrix>(o_pVt, smaller, i_Columns) = svd.matrixV().transpose();
	return svd.info() == Eigen::Success ? 0 : 1;
}

int Dsyev(int i_Size, double* io_pMatrix, double* o_pValues, double* /*o_pWork*/, int)
{
	return Dsyevd(i_Size, io_pMatrix, o_pValues);
}

int Dsyevd(int i_Size, double* io_pMatrix, double* o_pValues)
{
	Eigen::Map<VMatrix> matrix(io_pMatrix, i_Size, i_Size);
	if (!AllFinite({io_pMatrix, std::size_t(i_Size * i_Size)}))
		return -5;
	if (i_Size == 0)
		return 0;
	// It reads the lower triangle.
	const Eigen::SelfAdjointEigenSolver<VMatrix> solver(matrix.transpose());
	Eigen::Map<Eigen::VectorXd>(o_pValues, i_Size) = solver.eigenvalues();
	matrix = solver.eigenvectors().transpose();
	return solver.info() == Eigen::Success ? 0 : 1;
}

} // namespace Lapack
