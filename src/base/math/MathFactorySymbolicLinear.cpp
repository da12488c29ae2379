#include "math/MathFactorySymbolicLinear.h"

#include "math/NumberText.h"

#include <cmath>

namespace Math
{

namespace
{

using VScalar = VMathNodeSymbolicLinear<1>;
using VTriple = VMathNodeSymbolicLinear<3>;

/// Null if the node is of another class.
template <typename TNode>
std::shared_ptr<TNode> As(const VMathNodePointer& i_rpNode)
{
	return std::dynamic_pointer_cast<TNode>(i_rpNode);
}

std::shared_ptr<VScalar> MakeScalar(double i_Value)
{
	auto pNode = std::make_shared<VScalar>();
	pNode->m_Constant[0] = i_Value;
	return pNode;
}

/// The operand itself if nobody else holds it, otherwise a copy. With it a sum of many variables stays linear.
/// @param io_rpNode holds the operand as well and lets go of it.
std::shared_ptr<VScalar> Own(std::shared_ptr<VScalar> i_pScalar, VMathNodePointer& io_rpNode)
{
	io_rpNode.reset();
	return i_pScalar.use_count() == 1 ? std::move(i_pScalar) : std::make_shared<VScalar>(*i_pScalar);
}

void Scale(VScalar& io_rNode, double i_Factor)
{
	io_rNode.m_Constant[0] *= i_Factor;
	for (auto& [name, matrix] : io_rNode.m_Matrices)
		for (double& rValue : matrix)
			rValue *= i_Factor;
}

} // namespace

VMathNodePointer VMathFactorySymbolicLinear<1>::Add(VMathNodePointer i_pA, VMathNodePointer i_pB)
{
	std::shared_ptr<VScalar> pA = As<VScalar>(i_pA);
	std::shared_ptr<VScalar> pB = As<VScalar>(i_pB);
	if (!pA || !pB)
		return nullptr;
	if (pA->m_Matrices.size() < pB->m_Matrices.size())
	{
		std::swap(pA, pB);
		std::swap(i_pA, i_pB);
	}
	const std::shared_ptr<VScalar> pSum = Own(std::move(pA), i_pA);
	pSum->m_Constant[0] += pB->m_Constant[0];
	for (const auto& [name, matrix] : pB->m_Matrices)
	{
		const auto [found, bNew] = pSum->m_Matrices.try_emplace(name, matrix);
		if (!bNew)
			found->second[0] += matrix[0];
	}
	return pSum;
}

VMathNodePointer VMathFactorySymbolicLinear<1>::Multiply(VMathNodePointer i_pA, VMathNodePointer i_pB)
{
	std::shared_ptr<VScalar> pA = As<VScalar>(i_pA);
	std::shared_ptr<VScalar> pB = As<VScalar>(i_pB);
	if (!pA || !pB)
		return nullptr;
	if (!pB->m_Matrices.empty())
	{
		std::swap(pA, pB);
		std::swap(i_pA, i_pB);
	}
	if (!pB->m_Matrices.empty())
		return nullptr;
	const std::shared_ptr<VScalar> pProduct = Own(std::move(pA), i_pA);
	Scale(*pProduct, pB->m_Constant[0]);
	return pProduct;
}

VMathNodePointer VMathFactorySymbolicLinear<1>::Power(VMathNodePointer, VMathNodePointer)
{
	return nullptr;
}

VMathNodePointer VMathFactorySymbolicLinear<1>::Negate(VMathNodePointer i_pA)
{
	std::shared_ptr<VScalar> pA = As<VScalar>(i_pA);
	if (!pA)
		return nullptr;
	const std::shared_ptr<VScalar> pNegative = Own(std::move(pA), i_pA);
	Scale(*pNegative, -1.0);
	return pNegative;
}

VMathNodePointer VMathFactorySymbolicLinear<1>::Invert(VMathNodePointer i_pA)
{
	const std::shared_ptr<VScalar> pA = As<VScalar>(i_pA);
	return pA && pA->m_Matrices.empty() ? MakeScalar(1.0 / pA->m_Constant[0]) : nullptr;
}

VMathNodePointer VMathFactorySymbolicLinear<1>::MakeNumber(double i_Value)
{
	return MakeScalar(i_Value);
}

VMathNodePointer VMathFactorySymbolicLinear<1>::MakeNumberFromText(std::string_view i_Text)
{
	double value = 0.0;
	NumberText::ScanReal(i_Text, value);
	return MakeScalar(value);
}

VMathFunctionPointer VMathFactorySymbolicLinear<1>::GetFunction(std::string_view i_Name)
{
	using VFunction = VMathFunctionSymbolicLinear<1>;
	if (i_Name == "vector" || i_Name == "VECTOR")
		return VMathFunctionPointer(new VFunction(VFunction::EVector));
	if (i_Name == "component" || i_Name == "COMPONENT")
		return VMathFunctionPointer(new VFunction(VFunction::EComponent));
	return nullptr;
}

VMathNodePointer VMathFactorySymbolicLinear<1>::MakeVariable(std::string_view i_Name, const std::vector<double>&)
{
	auto pNode = std::make_shared<VScalar>();
	pNode->m_Matrices.emplace(i_Name, std::vector<double>{1.0});
	return pNode;
}

VMathNodePointer VMathFactorySymbolicLinear<1>::MakeConstant(std::string_view, const std::vector<double>& i_rValue)
{
	return MakeScalar(i_rValue.empty() ? 0.0 : i_rValue.front());
}

VMathNodePointer VMathFunctionSymbolicLinear<1>::Evaluate(std::span<const VMathNodePointer> i_Arguments) const
{
	if (i_Arguments.size() != NumberOfArguments())
		return nullptr;
	if (m_Kind == EVector)
	{
		const std::shared_ptr<VScalar> pFirst = As<VScalar>(i_Arguments[0]);
		if (!pFirst)
			return nullptr;
		auto pVector = std::make_shared<VTriple>();
		pVector->m_Constant[0] = pFirst->m_Constant[0];
		for (const auto& [name, matrix] : pFirst->m_Matrices)
			pVector->m_Matrices.emplace(name, std::vector<double>{matrix[0], 0.0, 0.0});
		return pVector;
	}

	const std::shared_ptr<VTriple> pVector = As<VTriple>(i_Arguments[0]);
	const std::shared_ptr<VScalar> pRow = As<VScalar>(i_Arguments[1]);
	if (!pVector || !pRow || !pRow->m_Matrices.empty())
		return nullptr;
	const double row = std::trunc(pRow->m_Constant[0]);
	if (!(row >= 0.0 && row < 3.0))
		return nullptr;
	const std::shared_ptr<VScalar> pComponent = MakeScalar(pVector->m_Constant[std::size_t(row)]);
	for (const auto& [name, matrix] : pVector->m_Matrices)
		pComponent->m_Matrices.emplace(name, std::vector<double>{matrix[std::size_t(row)]});
	return pComponent;
}

} // namespace Math
