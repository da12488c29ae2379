#include "numerics/fnl_svd_fixed.h"

#include "math/NumberText.h"
#include "numerics/AllFinite.h"

#include <iostream>

void fnl_svd_report(int i_Info, const double* i_pM, std::size_t i_Rows, std::size_t i_Columns)
{
	std::string text =
	    std::string(__FILE__ ": ") + "suspicious return value (" + std::to_string(i_Info) + ") from SVDC\n";
	if (!AllFinite({i_pM, i_Rows * i_Columns}))
	{
		text += std::string(__FILE__ ": ") + "M is " + std::to_string(i_Rows) + "x" + std::to_string(i_Columns)
		    + "\nM = [ ...\n";
		for (std::size_t row = 0; row < i_Rows; ++row)
			for (std::size_t column = 0; column < i_Columns; ++column)
			{
				NumberText::AppendG17(text, i_pM[row * i_Columns + column]);
				text += column + 1 < i_Columns ? " " : row + 1 < i_Rows ? "\n" : " ]\n";
			}
	}
	std::cerr << text;
}
