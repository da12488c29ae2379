#include "SetupProposal/Assignment.h"

#include <algorithm>
#include <limits>

namespace SetupProposal
{

std::vector<std::int64_t> BestAssignment(const std::vector<std::vector<double>>& i_rGains)
{
	const std::size_t rows = i_rGains.size();
	if (rows == 0)
		return {};
	// A column for each row to stay alone with makes every row find one.
	const std::size_t real = i_rGains.front().size();
	const std::size_t columns = real + rows;
	const auto cost = [&](std::size_t i_Row, std::size_t i_Column)
	{ return i_Column < real ? std::min(0.0, -i_rGains[i_Row][i_Column]) : 0.0; };

	std::vector<double> ofRow(rows + 1);
	std::vector<double> ofColumn(columns + 1);
	// Row and column 0 are none.
	std::vector<std::size_t> rowOf(columns + 1);
	for (std::size_t row = 1; row <= rows; ++row)
	{
		std::vector<double> least(columns + 1, std::numeric_limits<double>::infinity());
		std::vector<std::size_t> from(columns + 1);
		std::vector<bool> bUsed(columns + 1);
		std::size_t column = 0;
		rowOf[0] = row;
		do
		{
			bUsed[column] = true;
			const std::size_t at = rowOf[column];
			double delta = std::numeric_limits<double>::infinity();
			std::size_t next = 0;
			for (std::size_t j = 1; j <= columns; ++j)
			{
				if (bUsed[j])
					continue;
				const double reduced = cost(at - 1, j - 1) - ofRow[at] - ofColumn[j];
				if (reduced < least[j])
				{
					least[j] = reduced;
					from[j] = column;
				}
				if (least[j] < delta)
				{
					delta = least[j];
					next = j;
				}
			}
			for (std::size_t j = 0; j <= columns; ++j)
				if (bUsed[j])
				{
					ofRow[rowOf[j]] += delta;
					ofColumn[j] -= delta;
				}
				else
					least[j] -= delta;
			column = next;
		} while (rowOf[column] != 0);
		for (; column != 0; column = from[column])
			rowOf[column] = rowOf[from[column]];
	}
	std::vector<std::int64_t> assignment(rows, -1);
	for (std::size_t j = 1; j <= real; ++j)
		if (rowOf[j] != 0 && i_rGains[rowOf[j] - 1][j - 1] > 0.0)
			assignment[rowOf[j] - 1] = std::int64_t(j - 1);
	return assignment;
}

} // namespace SetupProposal
