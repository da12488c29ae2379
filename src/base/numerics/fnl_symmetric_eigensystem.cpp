#include "numerics/fnl_symmetric_eigensystem.h"

#include <iostream>

void fnl_symmetric_eigensystem_report(int i_Error)
{
	if (i_Error != Lapack::c_NotLoaded)
		std::cerr << "fnl_symmetric_eigensystem: ierr = " + std::to_string(i_Error) + "\n";
}

bool fnl_symmetric_eigensystem_compute(
    std::vector<double> i_Matrix, std::vector<double>& o_rVectors, std::vector<double>& o_rValues)
{
	const auto size = static_cast<std::size_t>(std::lround(std::sqrt(static_cast<double>(i_Matrix.size()))));
	o_rValues.assign(size, 0.0);
	const int error =
	    size * size == i_Matrix.size() ? Lapack::Dsyevd(static_cast<int>(size), i_Matrix.data(), o_rValues.data()) : -3;
	o_rVectors = std::move(i_Matrix);
	if (error < 0)
		o_rValues.assign(size, std::numeric_limits<double>::quiet_NaN());
	if (error != 0)
		fnl_symmetric_eigensystem_report(error);
	return error == 0;
}
