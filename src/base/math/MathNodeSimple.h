#pragma once

#include "math/IMathFactory.h"

#include <set>
#include <string>

namespace Math
{

/// A value with the expression that gave it. The value is there at once; the readable text and the names are gathered
/// from the operands when they are asked for, so that making a node costs the same however long the expression is.
class VMathNodeSimple final : public IMathNode
{
public:
	enum EKind : std::uint8_t
	{
		/// A number without a text of its own.
		ENumber,
		/// Named or literally spelled, and of no further interest.
		EText,
		EVariable,
		EConstant,
		EAdd,
		EMultiply,
		EPower,
		ENegate,
		EInvert,
		/// The text is the function's name.
		EFunction
	};

	VMathNodeSimple() = default;
	VMathNodeSimple(EKind i_Kind, double i_Value, std::string_view i_Text = {}) : m_Value(i_Value), m_Kind(i_Kind)
	{
		m_Text = i_Text;
	}
	VMathNodeSimple(EKind i_Kind, double i_Value, VMathNodePointer i_pFirst, VMathNodePointer i_pSecond)
	    : m_Value(i_Value), m_Kind(i_Kind), m_pFirst(std::move(i_pFirst)), m_pSecond(std::move(i_pSecond))
	{
	}
	VMathNodeSimple(double i_Value, std::string_view i_Function, VMathNodePointer i_pArgument)
	    : m_Value(i_Value), m_Kind(EFunction), m_pFirst(std::move(i_pArgument))
	{
		m_Text = i_Function;
	}
	VMathNodeSimple(const VMathNodeSimple&) = default;
	VMathNodeSimple& operator=(const VMathNodeSimple&) = default;
	~VMathNodeSimple() override;

	void Reset() override;
	bool Assign(const IMathNode& i_rOther) override;

	double Value() const { return m_Value; }

	/// Fully parenthesised, with numbers in 53 significant digits.
	std::string Text() const;

	/// Adds the names of all constants and of all variables that the expression uses. Factories that do not tell them
	/// apart leave both empty.
	void GatherNames(std::set<std::string>& io_rConstants, std::set<std::string>& io_rVariables) const;

private:
	double m_Value = 0.0;
	EKind m_Kind = ENumber;
	std::string m_Text;
	/// Nodes of this class.
	VMathNodePointer m_pFirst;
	VMathNodePointer m_pSecond;
};

/// Null if the node is of another class.
const VMathNodeSimple* AsSimple(const IMathNode* i_pNode);

} // namespace Math
