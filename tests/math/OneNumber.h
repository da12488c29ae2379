#pragma once

#include "math/IMathFactory.h"

#include <cstddef>

namespace MathTest
{

/// A number as what a name stands for.
class VOneNumber final : public Math::IVector
{
public:
	explicit VOneNumber(double i_Value) : m_Value(i_Value) {}
	std::size_t Size() const override { return 1; }
	double Get(std::size_t) const override { return m_Value; }
	void Assign(const double* i_pValues, std::size_t) override { m_Value = *i_pValues; }

private:
	double m_Value;
};

} // namespace MathTest
