#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"

#include "math/MathFactorySimple.h"
#include "math/MathParser.h"

#include <cstddef>
#include <set>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace CoreOrlexTypesUtils
{

/// What an expression may use. Static parameters are constants in all of them.
enum class EExpressionContext
{
	/// Powers and functions, no dynamic parameters: the default expressions of static parameters.
	EStatic,
	/// Dynamic parameters as variables, no powers and no functions: the geometry of segments and targets.
	ELinear,
	/// Dynamic parameters, powers and functions.
	EFull
};

/// The static parameters of a subject: named numbers, and named expressions over those declared before them, with
/// powers, sin, cos and tan. Nothing throws; results are a boolean and a text that tells what is wrong. Where a call
/// fails, nothing has changed. Used by one thread at a time.
class VStaticExpressionParser
{
public:
	/// One number as a vector of length one.
	class VSingleElementIVector final : public Math::IVector
	{
	public:
		explicit VSingleElementIVector(double i_Value = 0.0) : m_Value(i_Value) {}
		std::size_t Size() const override { return 1; }
		double Get(std::size_t) const override { return m_Value; }
		/// Any count but 1 is a failed assertion and assigns nothing.
		void Assign(const double* i_pValues, std::size_t i_Count) override;

	private:
		double m_Value;
	};

	VStaticExpressionParser();
	VStaticExpressionParser(const VStaticExpressionParser&) = delete;
	VStaticExpressionParser& operator=(const VStaticExpressionParser&) = delete;
	virtual ~VStaticExpressionParser();

	/// Forgets all parameters.
	virtual void Reset();

	bool AddStaticParameter(const std::string& i_rName, const std::string& i_rExpression, std::string& o_rError);
	bool AddStaticParameter(const std::string& i_rName, double i_Value, std::string& o_rError);

	/// All parameters with an expression are then evaluated again.
	bool SetStaticParameter(const std::string& i_rName, const std::string& i_rExpression, std::string& o_rError);
	bool SetStaticParameter(const std::string& i_rName, double i_Value, std::string& o_rError);

	/// False and 0 if there is no parameter of this name.
	bool GetStaticParameter(const std::string& i_rName, double& o_rValue) const;

protected:
	struct VParameter
	{
		std::string Name;
		std::string Expression;
		double Value = 0.0;
		bool bHasExpression = false;
	};

	const std::vector<VParameter>& Parameters() const { return m_Parameters; }
	const Math::VMathParser& StaticParser() const { return m_StaticParser; }

private:
	virtual void OnStaticParameterAdded(const std::string& i_rName, double i_Value);
	virtual void OnStaticParameterChanged(const std::string& i_rName, double i_Value);

	bool IsNew(const std::string& i_rName, std::string& o_rError) const;
	VParameter* Find(const std::string& i_rName, std::string& o_rError);
	bool Validate(
	    const std::string& i_rName, const std::string& i_rExpression, double& o_rValue, std::string& o_rError) const;
	void Add(VParameter i_Parameter);
	void Change(VParameter& io_rParameter, double i_Value);
	void EvaluateAgain();

	/// Indices into the list.
	std::unordered_map<std::string, std::size_t> m_IndexByName;
	std::vector<VParameter> m_Parameters;
	Math::VMathFactorySimple m_StaticFactory;
	Math::VMathParser m_StaticParser;
};

/// A static parameter of a subject that could not be loaded.
struct VStaticParameterFailure
{
	std::size_t m_Index = 0;
	std::string m_Error;
	/// One before it has its name.
	bool m_bNameTaken = false;
};

/// Adds the dynamic parameters as variables, and with them the linear and the full context.
template <typename TLinearFactory>
class VDynamicExpressionParserBase : public VStaticExpressionParser
{
public:
	VDynamicExpressionParserBase() : m_LinearParser(m_LinearFactory), m_FullParser(m_FullFactory)
	{
		m_LinearFactory.SetKeepsExpressions(false);
		m_FullFactory.SetKeepsExpressions(false);
	}

	void Reset() override
	{
		VStaticExpressionParser::Reset();
		for (Math::IMathFactory* pFactory :
		    {static_cast<Math::IMathFactory*>(&m_LinearFactory), static_cast<Math::IMathFactory*>(&m_FullFactory)})
		{
			pFactory->ClearVariables();
			pFactory->ClearConstants();
		}
	}

	/// Declares a dynamic parameter or gives it another value.
	void SetVariable(const std::string& i_rName, double i_Value)
	{
		m_LinearFactory.SetVariable(i_rName, VSingleElementIVector(i_Value));
		m_FullFactory.SetVariable(i_rName, VSingleElementIVector(i_Value));
	}

	/// Loads the static and dynamic parameters of a subject in place of those held. A static parameter has its user's
	/// value, or else the value of its default expression, or else its prior value, or 0; one that fails is left out
	/// and told.
	/// @return true if no parameter failed.
	bool Initialise(const CoreOrlexTypes::VSubjectParametrised& i_rSubject, std::vector<std::string>& io_rErrors);

	/// The same, telling which parameters failed.
	bool Initialise(
	    const CoreOrlexTypes::VSubjectParametrised& i_rSubject, std::vector<VStaticParameterFailure>& io_rFailures);

	/// An empty expression is 0, and so is the value of one that fails.
	bool Evaluate(std::string_view i_Expression, double& o_rValue, std::string& o_rError,
	    EExpressionContext i_Context = EExpressionContext::ELinear) const;

	/// Adds all variables and constants that an expression uses in the linear context.
	bool EvaluateChecked(std::string_view i_Expression, std::set<std::string>& io_rNames, std::string& o_rError) const;

	/// As EvaluateChecked in the full context, whose nodes tell no names: adds the static parameters whose name occurs
	/// anywhere in the readable text of the expression.
	bool EvaluateFull(std::string_view i_Expression, std::set<std::string>& io_rNames) const;

	/// Adds what EvaluateChecked finds in the pre poses of all segments and the states of all targets.
	/// @return true if all of them were understood.
	bool GetUsedParameters(
	    const CoreOrlexTypes::VSubjectParametrised& i_rSubject, std::set<std::string>& io_rNames) const;

private:
	void OnStaticParameterAdded(const std::string& i_rName, double i_Value) override { SetConstant(i_rName, i_Value); }
	void OnStaticParameterChanged(const std::string& i_rName, double i_Value) override
	{
		SetConstant(i_rName, i_Value);
	}
	void SetConstant(const std::string& i_rName, double i_Value)
	{
		m_LinearFactory.SetConstant(i_rName, VSingleElementIVector(i_Value));
		m_FullFactory.SetConstant(i_rName, VSingleElementIVector(i_Value));
	}

	/// The value in the linear context of a decimal number, or of one times a parameter, which is what nearly all
	/// expressions are. Leaves the others, those with an error among them, to the parser.
	bool EvaluateProduct(std::string_view i_Expression, double& o_rValue) const;

	// Told to keep expressions only while one is asked for its names or text.
	mutable TLinearFactory m_LinearFactory;
	Math::VMathParser m_LinearParser;
	mutable Math::VMathFactorySimple m_FullFactory;
	Math::VMathParser m_FullParser;
};

extern template class VDynamicExpressionParserBase<Math::VMathFactorySimpleLinear>;

class VDynamicExpressionParserSimple : public VDynamicExpressionParserBase<Math::VMathFactorySimpleLinear>
{
};

} // namespace CoreOrlexTypesUtils
