#include "math/MathFactorySimple.h"

#include "math/NumberText.h"

#include <cmath>

namespace Math
{

using VNode = VMathNodeSimple;

template <typename... TExpression>
VMathNodePointer VMathFactorySimple::Make(VNode::EKind i_Kind, double i_Value, TExpression&&... i_rExpression) const
{
	return m_bKeepsExpressions ? std::make_shared<VNode>(i_Kind, i_Value, std::forward<TExpression>(i_rExpression)...)
	                           : std::make_shared<VNode>(VNode::ENumber, i_Value);
}

template <typename TOperation>
VMathNodePointer VMathFactorySimple::Unary(VNode::EKind i_Kind, VMathNodePointer i_pA, TOperation i_Operation) const
{
	const VNode* const pA = AsSimple(i_pA.get());
	if (!pA)
		return nullptr;
	const double value = i_Operation(pA->Value());
	return Make(i_Kind, value, std::move(i_pA), nullptr);
}

template <typename TOperation>
VMathNodePointer VMathFactorySimple::Binary(
    VNode::EKind i_Kind, VMathNodePointer i_pA, VMathNodePointer i_pB, TOperation i_Operation) const
{
	const VNode* const pA = AsSimple(i_pA.get());
	const VNode* const pB = AsSimple(i_pB.get());
	if (!pA || !pB)
		return nullptr;
	const double value = i_Operation(pA->Value(), pB->Value());
	return Make(i_Kind, value, std::move(i_pA), std::move(i_pB));
}

VMathNodePointer VMathFactorySimple::MakeNamed(
    VNode::EKind i_Kind, std::string_view i_Name, const std::vector<double>& i_rValue) const
{
	return Make(i_Kind, i_rValue.empty() ? 0.0 : i_rValue.front(), i_Name);
}

VMathNodePointer VMathFactorySimple::Add(VMathNodePointer i_pA, VMathNodePointer i_pB)
{
	return Binary(VNode::EAdd, std::move(i_pA), std::move(i_pB), [](double i_A, double i_B) { return i_A + i_B; });
}

VMathNodePointer VMathFactorySimple::Multiply(VMathNodePointer i_pA, VMathNodePointer i_pB)
{
	return Binary(VNode::EMultiply, std::move(i_pA), std::move(i_pB), [](double i_A, double i_B) { return i_A * i_B; });
}

VMathNodePointer VMathFactorySimple::Power(VMathNodePointer i_pA, VMathNodePointer i_pB)
{
	return Binary(
	    VNode::EPower, std::move(i_pA), std::move(i_pB), [](double i_A, double i_B) { return std::pow(i_A, i_B); });
}

VMathNodePointer VMathFactorySimple::Negate(VMathNodePointer i_pA)
{
	return Unary(VNode::ENegate, std::move(i_pA), [](double i_A) { return -i_A; });
}

VMathNodePointer VMathFactorySimple::Invert(VMathNodePointer i_pA)
{
	return Unary(VNode::EInvert, std::move(i_pA), [](double i_A) { return 1.0 / i_A; });
}

VMathNodePointer VMathFactorySimple::MakeNumber(double i_Value)
{
	return std::make_shared<VNode>(VNode::ENumber, i_Value);
}

VMathNodePointer VMathFactorySimple::MakeNumberFromText(std::string_view i_Text)
{
	double value = 0.0;
	NumberText::ScanReal(i_Text, value);
	return Make(VNode::EText, value, i_Text);
}

VMathFunctionPointer VMathFactorySimple::GetFunction(std::string_view i_Name)
{
	if (i_Name == "sin" || i_Name == "SIN")
		return VMathFunctionPointer(new VMathFunctionSimple(VMathFunctionSimple::ESine, m_bKeepsExpressions));
	if (i_Name == "cos" || i_Name == "COS")
		return VMathFunctionPointer(new VMathFunctionSimple(VMathFunctionSimple::ECosine, m_bKeepsExpressions));
	if (i_Name == "tan" || i_Name == "TAN")
		return VMathFunctionPointer(new VMathFunctionSimple(VMathFunctionSimple::ETangent, m_bKeepsExpressions));
	return nullptr;
}

VMathNodePointer VMathFactorySimple::MakeVariable(std::string_view i_Name, const std::vector<double>& i_rValue)
{
	return MakeNamed(VNode::EText, i_Name, i_rValue);
}

VMathNodePointer VMathFactorySimple::MakeConstant(std::string_view i_Name, const std::vector<double>& i_rValue)
{
	return MakeNamed(VNode::EText, i_Name, i_rValue);
}

VMathNodePointer VMathFactorySimpleLinear::Power(VMathNodePointer, VMathNodePointer)
{
	return nullptr;
}

VMathFunctionPointer VMathFactorySimpleLinear::GetFunction(std::string_view)
{
	return nullptr;
}

VMathNodePointer VMathFactorySimpleLinear::MakeVariable(std::string_view i_Name, const std::vector<double>& i_rValue)
{
	return MakeNamed(VNode::EVariable, i_Name, i_rValue);
}

VMathNodePointer VMathFactorySimpleLinear::MakeConstant(std::string_view i_Name, const std::vector<double>& i_rValue)
{
	return MakeNamed(VNode::EConstant, i_Name, i_rValue);
}

VMathNodePointer VMathFunctionSimple::Evaluate(std::span<const VMathNodePointer> i_Arguments) const
{
	const VNode* const pArgument = i_Arguments.empty() ? nullptr : AsSimple(i_Arguments[0].get());
	if (!pArgument)
		return nullptr;
	double value = 0.0;
	std::string_view name = "fn";
	switch (m_Kind)
	{
	case ESine:
		value = std::sin(pArgument->Value());
		name = "sin";
		break;
	case ECosine:
		value = std::cos(pArgument->Value());
		name = "cos";
		break;
	case ETangent:
		value = std::tan(pArgument->Value());
		name = "tan";
		break;
	}
	return m_bKeepsExpression ? std::make_shared<VNode>(value, name, i_Arguments[0])
	                          : std::make_shared<VNode>(VNode::ENumber, value);
}

} // namespace Math
