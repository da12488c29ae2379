#include "math/MathNodeSimple.h"

#include "math/NumberText.h"

#include <typeinfo>

namespace Math
{

namespace
{

/// As many as a double can need, so that the text tells the exact value.
constexpr int c_NumberDigits = 53;

} // namespace

const VMathNodeSimple* AsSimple(const IMathNode* i_pNode)
{
	return i_pNode && typeid(*i_pNode) == typeid(VMathNodeSimple) ? static_cast<const VMathNodeSimple*>(i_pNode)
	                                                              : nullptr;
}

VMathNodeSimple::~VMathNodeSimple()
{
	if (m_pFirst || m_pSecond)
		Reset();
}

void VMathNodeSimple::Reset()
{
	// A sum of many terms is a chain as deep as it is long: nodes that nobody else holds are taken apart one by one.
	std::vector<VMathNodePointer> held;
	const auto takeOperands = [&](VMathNodeSimple& io_rNode)
	{
		for (VMathNodePointer* pOperand : {&io_rNode.m_pFirst, &io_rNode.m_pSecond})
		{
			if (pOperand->use_count() == 1)
			{
				const auto& rOperand = static_cast<const VMathNodeSimple&>(**pOperand);
				if (rOperand.m_pFirst || rOperand.m_pSecond)
					held.push_back(std::move(*pOperand));
			}
			pOperand->reset();
		}
	};
	takeOperands(*this);
	while (!held.empty())
	{
		const VMathNodePointer pNode = std::move(held.back());
		held.pop_back();
		takeOperands(static_cast<VMathNodeSimple&>(*pNode));
	}
	m_Value = 0.0;
	m_Kind = ENumber;
	m_Text.clear();
}

bool VMathNodeSimple::Assign(const IMathNode& i_rOther)
{
	const VMathNodeSimple* const pOther = AsSimple(&i_rOther);
	if (!pOther)
		return false;
	VMathNodeSimple copy(*pOther);
	Reset();
	*this = copy;
	return true;
}

std::string VMathNodeSimple::Text() const
{
	std::string text;
	// What is still to be written, the next at the back: a node or, where that is null, a literal.
	struct VPart
	{
		const VMathNodeSimple* pNode;
		std::string_view Literal;
	};
	std::vector<VPart> parts{{this, {}}};
	const auto push = [&](const VMathNodePointer& i_rpNode) {
		parts.push_back({static_cast<const VMathNodeSimple*>(i_rpNode.get()), {}});
	};
	const auto pushBinary = [&](const VMathNodeSimple& i_rNode, std::string_view i_Operator)
	{
		parts.push_back({nullptr, " )"});
		push(i_rNode.m_pSecond);
		parts.push_back({nullptr, i_Operator});
		push(i_rNode.m_pFirst);
		text += "( ";
	};
	while (!parts.empty())
	{
		const auto [pNode, literal] = parts.back();
		parts.pop_back();
		if (!pNode)
		{
			text += literal;
			continue;
		}
		switch (pNode->m_Kind)
		{
		case ENumber: NumberText::AppendG(text, pNode->m_Value, c_NumberDigits); break;
		case EText:
		case EVariable:
		case EConstant: text += pNode->m_Text; break;
		case EAdd: pushBinary(*pNode, " + "); break;
		case EMultiply: pushBinary(*pNode, " * "); break;
		case EPower: pushBinary(*pNode, " ^ "); break;
		case ENegate:
			text += '-';
			push(pNode->m_pFirst);
			break;
		case EInvert:
			text += "1/";
			push(pNode->m_pFirst);
			break;
		case EFunction:
			text.append(pNode->m_Text).append("( ");
			parts.push_back({nullptr, " )"});
			push(pNode->m_pFirst);
			break;
		}
	}
	return text;
}

void VMathNodeSimple::GatherNames(std::set<std::string>& io_rConstants, std::set<std::string>& io_rVariables) const
{
	std::vector<const VMathNodeSimple*> nodes{this};
	while (!nodes.empty())
	{
		const VMathNodeSimple& rNode = *nodes.back();
		nodes.pop_back();
		if (rNode.m_Kind == EConstant)
			io_rConstants.insert(rNode.m_Text);
		else if (rNode.m_Kind == EVariable)
			io_rVariables.insert(rNode.m_Text);
		for (const VMathNodePointer* pOperand : {&rNode.m_pFirst, &rNode.m_pSecond})
			if (*pOperand)
				nodes.push_back(static_cast<const VMathNodeSimple*>(pOperand->get()));
	}
}

} // namespace Math
