#pragma once

#include "math/MathFactoryMaps.h"
#include "math/MathNodeSimple.h"

namespace Math
{

/// Computes values (VMathNodeSimple) in double precision, with powers and the functions sin, cos and tan of radians.
/// A division by zero gives an infinity. Of a value with several components the first counts.
class VMathFactorySimple : public VMathFactoryMaps
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

/// Without powers and functions; its nodes tell which variables and constants an expression depends on. A product of
/// two variables is not refused.
class VMathFactorySimpleLinear : public VMathFactorySimple
{
public:
	VMathNodePointer Power(VMathNodePointer i_pA, VMathNodePointer i_pB) override;
	VMathFunctionPointer GetFunction(std::string_view i_Name) override;
	VMathNodePointer MakeVariable(std::string_view i_Name, const std::vector<double>& i_rValue) override;
	VMathNodePointer MakeConstant(std::string_view i_Name, const std::vector<double>& i_rValue) override;
};

class VMathFunctionSimple final : public IMathFunction
{
public:
	enum EKind
	{
		ESine,
		ECosine,
		ETangent
	};

	explicit VMathFunctionSimple(EKind i_Kind) : m_Kind(i_Kind) {}

	void Release() override { delete this; }
	std::uint32_t NumberOfArguments() const override { return 1; }
	VMathNodePointer Evaluate(std::span<const VMathNodePointer> i_Arguments) const override;

private:
	EKind m_Kind;
};

} // namespace Math
