#include "TakeSolve/Stands.h"

#include "TakeSolve/Vectors.h"

namespace TakeSolve
{
namespace
{

constexpr double c_StandingSpeed = 200.0;
constexpr double c_StandingHeight = 30.0;
constexpr double c_ShortestStand = 0.1;

} // namespace

std::vector<VStand> FindStands(const std::vector<VVector3>& i_rPlaces, double i_Rate)
{
	std::vector<VStand> stands;
	if (i_rPlaces.size() < 2)
		return stands;
	double lowest = i_rPlaces.front()[2];
	for (const VVector3& rPlace : i_rPlaces)
		lowest = std::min(lowest, rPlace[2]);
	const auto bStands = [&](std::size_t i_Frame)
	{
		const std::size_t from = i_Frame == 0 ? 0 : i_Frame - 1;
		const std::size_t to = std::min(i_Frame + 1, i_rPlaces.size() - 1);
		const double speed = Length(Difference(i_rPlaces[to], i_rPlaces[from])) * i_Rate / double(to - from);
		return speed < c_StandingSpeed && i_rPlaces[i_Frame][2] < lowest + c_StandingHeight;
	};
	for (std::size_t i = 0; i < i_rPlaces.size();)
	{
		const std::size_t first = i;
		while (i < i_rPlaces.size() && bStands(i))
			++i;
		if (i > first && double(i - first) >= c_ShortestStand * i_Rate)
			stands.push_back({first, i});
		if (i == first)
			++i;
	}
	return stands;
}

} // namespace TakeSolve
