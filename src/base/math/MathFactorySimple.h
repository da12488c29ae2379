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
	/// Without expressions, nodes hold values only: an expression of any length costs no more memory than its depth,
	/// and its node tells no text but the value's and no names.
	void SetKeepsExpressions(bool i_bKeeps) { m_bKeepsExpressions = i_bKeeps; }

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

protected:
	VMathNodePointer MakeNamed(
	    VMathNodeSimple::EKind i_Kind, std::string_view i_Name, const std::vector<double>& i_rValue) const;

private:
	template <typename... TExpression>
	VMathNodePointer Make(VMathNodeSimple::EKind i_Kind, double i_Value, TExpression&&... i_rExpression) const;
	template <typename TOperation>
	VMathNodePointer Unary(VMathNodeSimple::EKind i_Kind, VMathNodePointer i_pA, TOperation i_Operation) const;
	template <typename TOperation>
	VMathNodePointer Binary(
	    VMathNodeSimple::EKind i_Kind, VMathNodePointer i_pA, VMathNodePointer i_pB, TOperation i_Operation) const;

	bool m_bKeepsExpressions = true;
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

	/// @param i_bKeepsExpression as VMathFactorySimple::SetKeepsExpressions.
	explicit VMathFunctionSimple(EKind i_Kind, bool i_bKeepsExpression = true)
	    : m_Kind(i_Kind), m_bKeepsExpression(i_bKeepsExpression)
	{
	}

	void Release() override { delete this; }
	std::uint32_t NumberOfArguments() const override { return 1; }
	VMathNodePointer Evaluate(std::span<const VMathNodePointer> i_Arguments) const override;

private:
	EKind m_Kind;
	bool m_bKeepsExpression;
};

} // namespace Math
