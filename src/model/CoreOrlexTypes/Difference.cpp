#include "CoreOrlexTypes/Difference.h"

#include "CoreOrlexTypes/Fields.h"

#include <cmath>
#include <ranges>

namespace CoreOrlexTypes
{
namespace
{

/// Both return false and leave the path at the difference, or true and leave the path as it was.
template <typename T>
bool Compare(const T& i_rLeft, const T& i_rRight, std::string& io_rPath);

bool CompareItems(const auto& i_rLeft, const auto& i_rRight, std::string& io_rPath)
{
	if (i_rLeft.size() != i_rRight.size())
		return false;
	const std::size_t size = io_rPath.size();
	for (std::size_t i = 0; i < i_rLeft.size(); ++i)
	{
		((io_rPath += '[') += std::to_string(i)) += ']';
		if (!Compare(i_rLeft[i], i_rRight[i], io_rPath))
			return false;
		io_rPath.resize(size);
	}
	return true;
}

template <typename T>
bool Compare(const T& i_rLeft, const T& i_rRight, std::string& io_rPath)
{
	if constexpr (CRecord<T>)
	{
		const std::size_t size = io_rPath.size();
		const auto compareField = [&](const auto& i_rField)
		{
			(io_rPath += size ? "." : "") += i_rField.Key;
			if (!Compare(i_rLeft.*i_rField.pMember, i_rRight.*i_rField.pMember, io_rPath))
				return false;
			io_rPath.resize(size);
			return true;
		};
		return c_Fields<T>([&](const auto&... i_rField) { return (compareField(i_rField) && ...); });
	}
	else if constexpr (std::ranges::range<T> && !std::is_same_v<T, std::string>)
		return CompareItems(i_rLeft, i_rRight, io_rPath);
	else if constexpr (std::is_same_v<T, double>)
		return i_rLeft == i_rRight || (std::isnan(i_rLeft) && std::isnan(i_rRight));
	else
		return i_rLeft == i_rRight;
}

} // namespace

std::string FirstDifference(const VSubjectRecord& i_rLeft, const VSubjectRecord& i_rRight)
{
	std::string path;
	Compare(i_rLeft, i_rRight, path);
	return path;
}

} // namespace CoreOrlexTypes
