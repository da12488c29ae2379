#pragma once

#include "CoreOrlexTypes/Subject.h"

#include "math/NumberText.h"

#include <string>
#include <vector>

namespace CoreOrlexTypesUtils
{

/// Where the two subject types differ: the state of a target is numbers or expressions.
template <typename TSubject>
struct VSubjectKind;

template <>
struct VSubjectKind<CoreOrlexTypes::VSubject>
{
	static constexpr const char* c_LogCategory = "SubjectUtils";
	using VState = double;
	static std::vector<double>& State(CoreOrlexTypes::VSubject::VTarget& io_rTarget) { return io_rTarget.m_State; }
	static const std::vector<double>& State(const CoreOrlexTypes::VSubject::VTarget& i_rTarget)
	{
		return i_rTarget.m_State;
	}
	static double ToState(double i_Value) { return i_Value; }
};

template <>
struct VSubjectKind<CoreOrlexTypes::VSubjectParametrised>
{
	static constexpr const char* c_LogCategory = "SubjectParametrisedUtils";
	using VState = std::string;
	static std::vector<std::string>& State(CoreOrlexTypes::VSubjectParametrised::VTarget& io_rTarget)
	{
		return io_rTarget.m_StateExpressions;
	}
	static const std::vector<std::string>& State(const CoreOrlexTypes::VSubjectParametrised::VTarget& i_rTarget)
	{
		return i_rTarget.m_StateExpressions;
	}
	static std::string ToState(double i_Value) { return NumberText::PrintG17(i_Value); }
};

} // namespace CoreOrlexTypesUtils
