#pragma once

#include "math/MathFactoryMaps.h"

#include <array>

namespace Math
{

/// A linear form with c_Rows components: the constant plus the sum of matrix times variable over the map.
template <std::size_t c_Rows>
class VMathNodeSymbolicLinear final : public IMathNode
{
public:
	void Reset() override
	{
		m_Constant = {};
		m_Matrices.clear();
	}

	bool Assign(const IMathNode& i_rOther) override
	{
		const auto* const pOther = dynamic_cast<const VMathNodeSymbolicLinear*>(&i_rOther);
		if (pOther)
			*this = *pOther;
		return pOther != nullptr;
	}

	std::array<double, c_Rows> m_Constant{};
	/// By name of the variable: c_Rows rows, row by row, and as many columns as the variable has components.
	std::map<std::string, std::vector<double>, std::less<>> m_Matrices;
};

template <std::size_t c_Rows>
class VMathFactorySymbolicLinear;

/// Represents expressions as linear forms of one row over their variables and refuses all that is not linear. The
/// function "vector" makes three components of which the argument is the first, "component" takes one out again:
/// component( vector( x ), 0 ) is x.
template <>
class VMathFactorySymbolicLinear<1> : public VMathFactoryMaps
{
public:
	VMathNodePointer Add(VMathNodePointer i_pA, VMathNodePointer i_pB) override;
	VMathNodePointer Multiply(VMathNodePointer i_pA, VMathNodePointer i_pB) override;
	VMathNodePointer Power(VMathNodePointer i_pA, VMathNodePointer i_pB) override;
	VMathNodePointer Negate(VMathNodePointer i_pA) override;
	VMathNodePointer Invert(VMathNodePointer i_pA) override;
	VMathNodePointer MakeNumber(double i_Value) override;
	VMathNodePointer MakeNumberFromText(std::string_view i_Text) override;
	VMathFunctionPointer GetFunction(std::string_view i_Name) override;
	VMathNodePointer MakeVariable(std::string_view i_Name, const std::vector<double>& i_rValue) override;
	VMathNodePointer MakeConstant(std::string_view i_Name, const std::vector<double>& i_rValue) override;
};

template <std::size_t c_Rows>
class VMathFunctionSymbolicLinear;

template <>
class VMathFunctionSymbolicLinear<1> final : public IMathFunction
{
public:
	enum EKind
	{
		EVector,
		EComponent
	};

	explicit VMathFunctionSymbolicLinear(EKind i_Kind) : m_Kind(i_Kind) {}

	void Release() override { delete this; }
	std::uint32_t NumberOfArguments() const override { return m_Kind == EVector ? 1 : 2; }
	VMathNodePointer Evaluate(std::span<const VMathNodePointer> i_Arguments) const override;

private:
	EKind m_Kind;
};

} // namespace Math
