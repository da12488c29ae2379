#include "CoreOrlexTypes/Fields.h"

#include <algorithm>
#include <cmath>

namespace
{

using namespace CoreOrlexTypes;

template <typename T>
bool Equal(const T& i_rLeft, const T& i_rRight)
{
	return i_rLeft == i_rRight;
}

bool Equal(double i_Left, double i_Right)
{
	return i_Left == i_Right || (std::isnan(i_Left) && std::isnan(i_Right));
}

template <CRecord T>
bool Equal(const T& i_rLeft, const T& i_rRight);

template <typename T, std::size_t c_Count>
bool Equal(const std::array<T, c_Count>& i_rLeft, const std::array<T, c_Count>& i_rRight)
{
	return std::equal(i_rLeft.begin(), i_rLeft.end(), i_rRight.begin(),
	    [](const T& i_rA, const T& i_rB) { return Equal(i_rA, i_rB); });
}

template <typename T>
bool Equal(const std::vector<T>& i_rLeft, const std::vector<T>& i_rRight)
{
	return std::equal(i_rLeft.begin(), i_rLeft.end(), i_rRight.begin(), i_rRight.end(),
	    [](const T& i_rA, const T& i_rB) { return Equal(i_rA, i_rB); });
}

template <CRecord T>
bool Equal(const T& i_rLeft, const T& i_rRight)
{
	return c_Fields<T>(
	    [&](const auto&... i_rField) { return (Equal(i_rLeft.*i_rField.pMember, i_rRight.*i_rField.pMember) && ...); });
}

} // namespace

bool CoreOrlexTypes::operator==(const VSubject& i_rLeft, const VSubject& i_rRight)
{
	return Equal(i_rLeft, i_rRight);
}

bool CoreOrlexTypes::operator==(const VSubjectParametrised& i_rLeft, const VSubjectParametrised& i_rRight)
{
	return Equal(i_rLeft, i_rRight);
}

bool CoreOrlexTypes::operator==(const VSubjectApplicationData& i_rLeft, const VSubjectApplicationData& i_rRight)
{
	return Equal(i_rLeft, i_rRight);
}

bool CoreOrlexTypes::operator==(const VSubjectRecord& i_rLeft, const VSubjectRecord& i_rRight)
{
	return Equal(i_rLeft, i_rRight);
}
