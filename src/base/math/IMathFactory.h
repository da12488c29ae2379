#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>
#include <string_view>
#include <vector>

/// A small expression compiler. The parser (MathParser.h) knows only grammar; what an expression means is up to the
/// factory that it is given, and to the nodes which that factory makes.
namespace Math
{

/// A list of numbers that its owner keeps in whatever form: how values are handed to a factory.
class IVector
{
public:
	virtual ~IVector() = default;
	virtual std::size_t Size() const = 0;
	virtual double Get(std::size_t i_Index) const = 0;
	virtual void Assign(const double* i_pValues, std::size_t i_Count) = 0;
};

/// The meaning of a part of an expression. Only the factory that made it knows what is inside.
class IMathNode
{
public:
	/// Lets go of all content, and of operands without deep recursion; what is left is as a new node.
	virtual void Reset() = 0;
	/// Takes over the content of a node of the same kind; another kind is refused with false and changes nothing.
	virtual bool Assign(const IMathNode& i_rOther) = 0;
	virtual ~IMathNode() = default;
};

using VMathNodePointer = std::shared_ptr<IMathNode>;

/// Made by a factory for one call; the receiver ends it with Release.
class IMathFunction
{
public:
	virtual void Release() = 0;
	virtual std::uint32_t NumberOfArguments() const = 0;
	/// Null if the arguments do not fit.
	virtual VMathNodePointer Evaluate(std::span<const VMathNodePointer> i_Arguments) const = 0;

protected:
	virtual ~IMathFunction() = default;
};

struct VMathFunctionRelease
{
	void operator()(IMathFunction* i_pFunction) const { i_pFunction->Release(); }
};

using VMathFunctionPointer = std::unique_ptr<IMathFunction, VMathFunctionRelease>;

/// Gives an expression its meaning. Operations return null where the operands do not fit; operands are handed over, so
/// that a factory may build on an operand that nobody else holds. Variables and constants are looked up by name and may
/// hold several components; they must not change while an expression is parsed.
class IMathFactory
{
public:
	virtual VMathNodePointer Add(VMathNodePointer i_pA, VMathNodePointer i_pB) = 0;
	virtual VMathNodePointer Multiply(VMathNodePointer i_pA, VMathNodePointer i_pB) = 0;
	virtual VMathNodePointer Power(VMathNodePointer i_pA, VMathNodePointer i_pB) = 0;
	virtual VMathNodePointer Negate(VMathNodePointer i_pA) = 0;
	virtual VMathNodePointer Invert(VMathNodePointer i_pA) = 0;
	virtual void SetVariable(std::string_view i_Name, const IVector& i_rValue) = 0;
	/// Null if no variable has this name.
	virtual VMathNodePointer GetVariable(std::string_view i_Name) = 0;
	virtual void ClearVariables() = 0;
	virtual void SetConstant(std::string_view i_Name, const IVector& i_rValue) = 0;
	/// Null if no constant has this name.
	virtual VMathNodePointer GetConstant(std::string_view i_Name) = 0;
	virtual void ClearConstants() = 0;
	virtual VMathNodePointer MakeNumber(double i_Value) = 0;
	virtual VMathNodePointer MakeNumberFromText(std::string_view i_Text) = 0;
	/// Null if no function has this name.
	virtual VMathFunctionPointer GetFunction(std::string_view i_Name) = 0;
	virtual ~IMathFactory() = default;
	virtual VMathNodePointer MakeVariable(std::string_view i_Name, const std::vector<double>& i_rValue) = 0;
	virtual VMathNodePointer MakeConstant(std::string_view i_Name, const std::vector<double>& i_rValue) = 0;
};

} // namespace Math
