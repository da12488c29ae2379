#include "CoreOrlexTypesUtils/convert/StaticExpressionParser.h"

#include "DebugServices/Assert.h"
#include "math/MathTokenizer.h"

#include <charconv>

namespace CoreOrlexTypesUtils
{

namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using Math::AsSimple;
using Math::VMathNodePointer;

class VValueResult final : public Math::IMathResult
{
public:
	void Receive(const VMathNodePointer& i_rpNode) override
	{
		if (const Math::VMathNodeSimple* const pNode = AsSimple(i_rpNode.get()))
			m_Value = pNode->Value();
	}

	double m_Value = 0.0;
};

class VNamesResult final : public Math::IMathResult
{
public:
	explicit VNamesResult(std::set<std::string>& io_rNames) : m_rNames(io_rNames) {}

	void Receive(const VMathNodePointer& i_rpNode) override
	{
		if (const Math::VMathNodeSimple* const pNode = AsSimple(i_rpNode.get()))
			pNode->GatherNames(m_rNames, m_rNames);
	}

private:
	std::set<std::string>& m_rNames;
};

class VTextResult final : public Math::IMathResult
{
public:
	void Receive(const VMathNodePointer& i_rpNode) override
	{
		if (const Math::VMathNodeSimple* const pNode = AsSimple(i_rpNode.get()))
			m_Text = pNode->Text();
	}

	std::string m_Text;
};

class VKeepExpressions
{
public:
	explicit VKeepExpressions(Math::VMathFactorySimple& io_rFactory) : m_rFactory(io_rFactory)
	{
		m_rFactory.SetKeepsExpressions(true);
	}
	~VKeepExpressions() { m_rFactory.SetKeepsExpressions(false); }
	VKeepExpressions(const VKeepExpressions&) = delete;
	VKeepExpressions& operator=(const VKeepExpressions&) = delete;

private:
	Math::VMathFactorySimple& m_rFactory;
};

/// Empties the error text on success: a parser says something then too.
bool Parse(const Math::VMathParser& i_rParser, std::string_view i_Expression, Math::IMathResult& o_rResult,
    std::string& o_rError)
{
	const bool bGood = i_Expression.empty() || i_rParser.Parse(i_Expression, o_rResult, o_rError);
	if (bGood)
		o_rError.clear();
	return bGood;
}

} // namespace

void VStaticExpressionParser::VSingleElementIVector::Assign(const double* i_pValues, std::size_t i_Count)
{
	NVX_ASSERT(i_Count == 1);
	if (i_Count == 1)
		m_Value = *i_pValues;
}

VStaticExpressionParser::VStaticExpressionParser() : m_StaticParser(m_StaticFactory)
{
	m_StaticFactory.SetKeepsExpressions(false);
}

VStaticExpressionParser::~VStaticExpressionParser() = default;

void VStaticExpressionParser::Reset()
{
	m_IndexByName.clear();
	m_Parameters.clear();
	m_StaticFactory.ClearVariables();
	m_StaticFactory.ClearConstants();
}

void VStaticExpressionParser::OnStaticParameterAdded(const std::string&, double) {}

void VStaticExpressionParser::OnStaticParameterChanged(const std::string&, double) {}

bool VStaticExpressionParser::AddStaticParameter(
    const std::string& i_rName, const std::string& i_rExpression, std::string& o_rError)
{
	double value = 0.0;
	if (!IsNew(i_rName, o_rError) || !Validate(i_rName, i_rExpression, value, o_rError))
		return false;
	Add({i_rName, i_rExpression, value, true});
	return true;
}

bool VStaticExpressionParser::AddStaticParameter(const std::string& i_rName, double i_Value, std::string& o_rError)
{
	if (!IsNew(i_rName, o_rError))
		return false;
	Add({i_rName, {}, i_Value, false});
	return true;
}

bool VStaticExpressionParser::SetStaticParameter(
    const std::string& i_rName, const std::string& i_rExpression, std::string& o_rError)
{
	VParameter* const pParameter = Find(i_rName, o_rError);
	double value = 0.0;
	if (!pParameter || !Validate(i_rName, i_rExpression, value, o_rError))
		return false;
	pParameter->Expression = i_rExpression;
	pParameter->bHasExpression = true;
	EvaluateAgain();
	return true;
}

bool VStaticExpressionParser::SetStaticParameter(const std::string& i_rName, double i_Value, std::string& o_rError)
{
	VParameter* const pParameter = Find(i_rName, o_rError);
	if (!pParameter)
		return false;
	pParameter->bHasExpression = false;
	Change(*pParameter, i_Value);
	EvaluateAgain();
	return true;
}

bool VStaticExpressionParser::GetStaticParameter(const std::string& i_rName, double& o_rValue) const
{
	const auto found = m_IndexByName.find(i_rName);
	const bool bFound = found != m_IndexByName.end();
	o_rValue = bFound ? m_Parameters[found->second].Value : 0.0;
	return bFound;
}

bool VStaticExpressionParser::IsNew(const std::string& i_rName, std::string& o_rError) const
{
	if (m_IndexByName.find(i_rName) == m_IndexByName.end())
		return true;
	o_rError = "Cannot add StaticParameter '" + i_rName + "', a StaticParameter with that name already exists.";
	return false;
}

VStaticExpressionParser::VParameter* VStaticExpressionParser::Find(const std::string& i_rName, std::string& o_rError)
{
	const auto found = m_IndexByName.find(i_rName);
	if (found != m_IndexByName.end())
		return &m_Parameters[found->second];
	o_rError = "SetStaticParameter call failed, '" + i_rName + "' could not be found.";
	return nullptr;
}

bool VStaticExpressionParser::Validate(
    const std::string& i_rName, const std::string& i_rExpression, double& o_rValue, std::string& o_rError) const
{
	VValueResult result;
	std::string diagnostic;
	if (!Parse(m_StaticParser, i_rExpression, result, diagnostic))
	{
		o_rError = "Validation of StaticParameter '" + i_rName + "' expression '" + i_rExpression + "' failed, "
		    + diagnostic + ".";
		return false;
	}
	o_rValue = result.m_Value;
	return true;
}

void VStaticExpressionParser::Add(VParameter i_Parameter)
{
	m_IndexByName.emplace(i_Parameter.Name, m_Parameters.size());
	m_StaticFactory.SetConstant(i_Parameter.Name, VSingleElementIVector(i_Parameter.Value));
	m_Parameters.push_back(std::move(i_Parameter));
	OnStaticParameterAdded(m_Parameters.back().Name, m_Parameters.back().Value);
}

void VStaticExpressionParser::Change(VParameter& io_rParameter, double i_Value)
{
	io_rParameter.Value = i_Value;
	m_StaticFactory.SetConstant(io_rParameter.Name, VSingleElementIVector(i_Value));
	OnStaticParameterChanged(io_rParameter.Name, i_Value);
}

void VStaticExpressionParser::EvaluateAgain()
{
	// Expressions look backwards only, so one pass is enough.
	for (VParameter& rParameter : m_Parameters)
	{
		if (!rParameter.bHasExpression)
			continue;
		VValueResult result;
		std::string diagnostic;
		Parse(m_StaticParser, rParameter.Expression, result, diagnostic);
		Change(rParameter, result.m_Value);
	}
}

template <typename TLinearFactory>
bool VDynamicExpressionParserBase<TLinearFactory>::Initialise(
    const VSubjectParametrised& i_rSubject, std::vector<std::string>& io_rErrors)
{
	std::vector<VStaticParameterFailure> failures;
	const bool bGood = Initialise(i_rSubject, failures);
	for (VStaticParameterFailure& rFailure : failures)
		io_rErrors.push_back(std::move(rFailure.m_Error));
	return bGood;
}

template <typename TLinearFactory>
bool VDynamicExpressionParserBase<TLinearFactory>::Initialise(
    const VSubjectParametrised& i_rSubject, std::vector<VStaticParameterFailure>& io_rFailures)
{
	Reset();
	bool bGood = true;
	for (std::size_t i = 0; i < i_rSubject.m_StaticParameters.size(); ++i)
	{
		const VSubjectParametrised::VStaticParameter& rParameter = i_rSubject.m_StaticParameters[i];
		using CoreOrlexTypes::c_NotSet;
		std::string error;
		bool bAdded = false;
		if (rParameter.m_UserValue != c_NotSet)
			bAdded = AddStaticParameter(rParameter.m_Name, rParameter.m_UserValue, error);
		else if (!rParameter.m_DefaultExpression.empty())
			bAdded = AddStaticParameter(rParameter.m_Name, rParameter.m_DefaultExpression, error);
		else
			bAdded =
			    AddStaticParameter(rParameter.m_Name, rParameter.m_Prior != c_NotSet ? rParameter.m_Prior : 0.0, error);
		if (bAdded)
			continue;
		double valueBefore = 0.0;
		const bool bNameTaken = GetStaticParameter(rParameter.m_Name, valueBefore);
		io_rFailures.push_back({i, std::move(error), bNameTaken});
		bGood = false;
	}
	for (const VSubjectParametrised::VDynamicParameter& rParameter : i_rSubject.m_DynamicParameters)
		SetVariable(rParameter.m_Name, rParameter.m_Value);
	return bGood;
}

template <typename TLinearFactory>
bool VDynamicExpressionParserBase<TLinearFactory>::EvaluateProduct(
    std::string_view i_Expression, double& o_rValue) const
{
	// Half of all: bounds, and turns that are none.
	if (i_Expression == "0")
	{
		o_rValue = 0.0;
		return true;
	}
	const char* const pEnd = i_Expression.data() + i_Expression.size();
	const char* const pDigits = i_Expression.data() + i_Expression.starts_with('-');
	if (pDigits == pEnd || !((*pDigits >= '0' && *pDigits <= '9') || *pDigits == '.'))
		return false;
	double number = 0.0;
	const auto result = std::from_chars(i_Expression.data(), pEnd, number, std::chars_format::fixed);
	if (result.ec != std::errc())
		return false;
	double factor = 1.0;
	if (result.ptr != pEnd)
	{
		if (*result.ptr != '*')
			return false;
		const std::string_view name(result.ptr + 1, pEnd);
		const std::vector<double>* pValue = m_LinearFactory.FindVariable(name);
		if (!pValue)
			pValue = m_LinearFactory.FindConstant(name);
		if (!pValue || !Math::IsIdentifier(name))
			return false;
		factor = pValue->front();
	}
	o_rValue = number * factor;
	return true;
}

template <typename TLinearFactory>
bool VDynamicExpressionParserBase<TLinearFactory>::Evaluate(
    std::string_view i_Expression, double& o_rValue, std::string& o_rError, EExpressionContext i_Context) const
{
	if (i_Context == EExpressionContext::ELinear && EvaluateProduct(i_Expression, o_rValue))
	{
		o_rError.clear();
		return true;
	}
	const Math::VMathParser& rParser = i_Context == EExpressionContext::EStatic ? StaticParser()
	    : i_Context == EExpressionContext::EFull                                ? m_FullParser
	                                                                            : m_LinearParser;
	VValueResult result;
	const bool bGood = Parse(rParser, i_Expression, result, o_rError);
	o_rValue = result.m_Value;
	return bGood;
}

template <typename TLinearFactory>
bool VDynamicExpressionParserBase<TLinearFactory>::EvaluateChecked(
    std::string_view i_Expression, std::set<std::string>& io_rNames, std::string& o_rError) const
{
	const VKeepExpressions keep(m_LinearFactory);
	VNamesResult result(io_rNames);
	return Parse(m_LinearParser, i_Expression, result, o_rError);
}

template <typename TLinearFactory>
bool VDynamicExpressionParserBase<TLinearFactory>::EvaluateFull(
    std::string_view i_Expression, std::set<std::string>& io_rNames) const
{
	const VKeepExpressions keep(m_FullFactory);
	VTextResult result;
	std::string error;
	if (!Parse(m_FullParser, i_Expression, result, error))
		return false;
	for (const VParameter& rParameter : Parameters())
		if (result.m_Text.find(rParameter.Name) != std::string::npos)
			io_rNames.insert(rParameter.Name);
	return true;
}

template <typename TLinearFactory>
bool VDynamicExpressionParserBase<TLinearFactory>::GetUsedParameters(
    const VSubjectParametrised& i_rSubject, std::set<std::string>& io_rNames) const
{
	bool bGood = true;
	const auto check = [&](const auto& i_rExpressions)
	{
		std::string error;
		for (const std::string& rExpression : i_rExpressions)
			bGood &= EvaluateChecked(rExpression, io_rNames, error);
	};
	for (const VSubjectParametrised::VSegment& rSegment : i_rSubject.m_Segments)
	{
		check(rSegment.m_PreRotation);
		check(rSegment.m_PreTranslation);
	}
	for (const VSubjectParametrised::VTarget& rTarget : i_rSubject.m_Targets)
		check(rTarget.m_StateExpressions);
	return bGood;
}

template class VDynamicExpressionParserBase<Math::VMathFactorySimpleLinear>;

} // namespace CoreOrlexTypesUtils
