#include "CoreOrlexTypesUtils/scale/Scaling.h"

#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypesUtils/convert/StaticExpressionParser.h"
#include "CoreOrlexTypesUtils/scale/ScaledExpression.h"
#include "CoreOrlexTypesUtils/scale/ScalingRules.h"

#include "math/MathFactorySymbolicLinear.h"

#include <map>

namespace CoreOrlexTypesUtils
{

namespace
{

using CoreOrlexTypes::c_NotSet;
using CoreOrlexTypes::VSubjectParametrised;

constexpr const char* c_Category = VSubjectKind<VSubjectParametrised>::c_LogCategory;

/// Notes every name that an expression uses, whatever it does with it.
class VNamesFactory final : public Math::VMathFactorySimple
{
public:
	Math::VMathNodePointer MakeVariable(std::string_view i_Name, const std::vector<double>& i_rValue) override
	{
		m_Names.emplace(i_Name);
		return VMathFactorySimple::MakeVariable(i_Name, i_rValue);
	}

	std::set<std::string> m_Names;
};

class VFormResult final : public Math::IMathResult
{
public:
	void Receive(const Math::VMathNodePointer& i_rpNode) override
	{
		if (const auto* const pForm = dynamic_cast<const Math::VMathNodeSymbolicLinear<1>*>(i_rpNode.get()))
			m_Constant = pForm->m_Constant[0];
	}

	double m_Constant = 0.0;
};

class VNoResult final : public Math::IMathResult
{
public:
	void Receive(const Math::VMathNodePointer&) override {}
};

/// What an expression is made of. One that cannot be evaluated counts as 0 and has no parts.
struct VAnalysis
{
	bool m_bEvaluates = false;
	double m_Value = 0.0;
	/// Names of static parameters.
	std::set<std::string> m_Parameters;
	bool m_bDynamic = false;
	/// Whether it is a sum of multiples of parameters and a constant.
	bool m_bLinear = false;
	double m_Constant = 0.0;
};

/// Texts of the findings about one kind of length.
struct VFindings
{
	const char* m_pConstant;
	const char* m_pShared;
};

constexpr VFindings c_TranslationFindings{"Non zero translation constant", "Shared rotation and translation parameter"};
constexpr VFindings c_MarkerFindings{"Non zero marker constant", "Shared rotation and marker parameter"};

class VSubjectScaling
{
public:
	VSubjectScaling(VSubjectParametrised& io_rSubject, double i_Factor) : m_rSubject(io_rSubject), m_Factor(i_Factor) {}

	bool Run()
	{
		if (!Initialise())
			return false;
		BlockRotations();
		GatherLengths();
		Settle();
		if (!MakeChanges())
			return false;
		for (auto& [pText, text] : m_Texts)
			*pText = std::move(text);
		for (const auto& [pValue, value] : m_Values)
			*pValue = value;
		return true;
	}

private:
	using VParameter = VSubjectParametrised::VStaticParameter;

	bool Initialise()
	{
		std::vector<std::string> errors;
		if (!m_Parser.Initialise(m_rSubject, errors))
		{
			NVX_LOG(c_Category, NVX::ELogError, "Error parsing subject static parameter expressions");
			for (const std::string& rError : errors)
				NVX_LOG(c_Category, NVX::ELogError, "%1%", rError);
			return false;
		}
		const VStaticExpressionParser::VSingleElementIVector one(1.0);
		const auto declare = [&](const std::string& i_rName)
		{
			m_NamesFactory.SetVariable(i_rName, one);
			m_FormFactory.SetVariable(i_rName, one);
		};
		for (VParameter& rParameter : m_rSubject.m_StaticParameters)
		{
			m_Parameters.emplace(rParameter.m_Name, &rParameter);
			declare(rParameter.m_Name);
		}
		for (const auto& rParameter : m_rSubject.m_DynamicParameters)
		{
			m_DynamicNames.insert(rParameter.m_Name);
			declare(rParameter.m_Name);
		}
		for (const auto& [name, pParameter] : m_Parameters)
			if (LivesByExpression(*pParameter))
				m_Expressions.emplace(name, Analyse(pParameter->m_DefaultExpression, EExpressionContext::EStatic));
		return true;
	}

	static bool LivesByExpression(const VParameter& i_rParameter)
	{
		return i_rParameter.m_UserValue == c_NotSet && !i_rParameter.m_DefaultExpression.empty();
	}

	/// @param o_pDiagnostic of the linear form.
	VAnalysis Analyse(const std::string& i_rText, EExpressionContext i_Context, std::string* o_pDiagnostic = nullptr)
	{
		VAnalysis analysis;
		std::string diagnostic;
		if (!i_rText.empty())
		{
			VFormResult form;
			analysis.m_bLinear = Math::VMathParser(m_FormFactory).Parse(i_rText, form, diagnostic);
			analysis.m_Constant = form.m_Constant;
		}
		if (o_pDiagnostic)
			*o_pDiagnostic = diagnostic;
		analysis.m_bEvaluates = !i_rText.empty() && m_Parser.Evaluate(i_rText, analysis.m_Value, diagnostic, i_Context);
		if (!analysis.m_bEvaluates)
			return analysis;

		VNoResult none;
		m_NamesFactory.m_Names.clear();
		Math::VMathParser(m_NamesFactory).Parse(i_rText, none, diagnostic);
		// A dynamic parameter hides a static one of its name, but static expressions know none.
		for (const std::string& rName : m_NamesFactory.m_Names)
			if (i_Context != EExpressionContext::EStatic && m_DynamicNames.count(rName))
				analysis.m_bDynamic = true;
			else
				analysis.m_Parameters.insert(rName);
		return analysis;
	}

	/// The value of a parameter must not change, and so must not those of all that its expression uses.
	/// @return whether that is news.
	bool Block(const std::set<std::string>& i_rNames)
	{
		bool bNews = false;
		std::vector<std::string> names(i_rNames.begin(), i_rNames.end());
		while (!names.empty())
		{
			const std::string name = std::move(names.back());
			names.pop_back();
			if (!m_Blocked.insert(name).second)
				continue;
			bNews = true;
			if (const auto found = m_Expressions.find(name); found != m_Expressions.end())
				names.insert(names.end(), found->second.m_Parameters.begin(), found->second.m_Parameters.end());
		}
		return bNews;
	}

	/// All uses of parameters that are no lengths.
	void BlockRotations()
	{
		const auto block = [this](const std::string& i_rText)
		{ Block(Analyse(i_rText, EExpressionContext::ELinear).m_Parameters); };
		for (const auto& rSegment : m_rSubject.m_Segments)
			for (const std::string& rText : rSegment.m_PreRotation)
				block(rText);
		for (const auto& rTarget : m_rSubject.m_Targets)
			for (std::size_t i = 0; i < rTarget.m_StateExpressions.size(); ++i)
				if (!IsLength(rTarget.m_Type, i))
					block(rTarget.m_StateExpressions[i]);
		m_OfRotations = m_Blocked;
		for (const auto& rSegment : m_rSubject.m_Segments)
			block(rSegment.m_MassExpression);
	}

	void GatherLengths()
	{
		for (auto& rSegment : m_rSubject.m_Segments)
		{
			for (std::string& rText : rSegment.m_PreTranslation)
				AddLength(rText, &c_TranslationFindings);
			for (auto* pTexts : {&rSegment.m_MassCentreExpressions, &rSegment.m_RadiusOfGyrationExpressions})
				for (std::string& rText : *pTexts)
					AddLength(rText, nullptr);
			for (std::string& rText : rSegment.m_Bounds)
				AddLength(rText, nullptr);
		}
		for (auto& rTarget : m_rSubject.m_Targets)
			for (std::size_t i = 0; i < rTarget.m_StateExpressions.size(); ++i)
				if (IsLength(rTarget.m_Type, i))
					AddLength(rTarget.m_StateExpressions[i], &c_MarkerFindings);
	}

	/// @param i_pFindings null for lengths that nothing is told about.
	void AddLength(std::string& io_rText, const VFindings* i_pFindings)
	{
		std::string diagnostic;
		m_Lengths.emplace_back(&io_rText, Analyse(io_rText, EExpressionContext::ELinear, &diagnostic));
		const VAnalysis& rAnalysis = m_Lengths.back().second;
		if (!i_pFindings || io_rText.empty())
			return;
		if (!rAnalysis.m_bLinear)
		{
			NVX_LOG("SubjectCalibrationAlgo", NVX::ELogWarning, "Math parser failed: %1%", diagnostic);
			return;
		}
		NVX_LOG("SubjectCalibrationAlgo", NVX::ELogDetail, "Math parser succeeded: ");
		// A plain number has no parameter that it could hinder.
		const bool bNumber = rAnalysis.m_Parameters.empty() && !rAnalysis.m_bDynamic;
		if (!(rAnalysis.m_Constant == 0.0))
			NVX_LOG(c_Category, bNumber ? NVX::ELogInformation : NVX::ELogWarning, i_pFindings->m_pConstant);
		for (const std::string& rName : rAnalysis.m_Parameters)
			if (m_OfRotations.count(rName))
				NVX_LOG(c_Category, NVX::ELogWarning, i_pFindings->m_pShared);
	}

	/// Whether a length scales with its parameters.
	bool Follows(const VAnalysis& i_rLength) const
	{
		return i_rLength.m_bLinear && i_rLength.m_Constant == 0.0 && !i_rLength.m_bDynamic
		    && std::none_of(i_rLength.m_Parameters.begin(), i_rLength.m_Parameters.end(),
		        [this](const std::string& i_rName) { return m_Blocked.count(i_rName) > 0; });
	}

	/// Finds the parameters to scale: all those of lengths that follow theirs, and none of the other lengths. Each
	/// round blocks parameters, which may hinder lengths that followed before, until all agree.
	void Settle()
	{
		bool bChanged = true;
		while (bChanged)
		{
			bChanged = false;
			m_Scaled.clear();
			std::vector<const VAnalysis*> demands;
			for (const auto& [pText, analysis] : m_Lengths)
				demands.push_back(&analysis);
			while (!demands.empty())
			{
				const VAnalysis& rLength = *demands.back();
				demands.pop_back();
				if (!Follows(rLength))
				{
					bChanged |= Block(rLength.m_Parameters);
					continue;
				}
				for (const std::string& rName : rLength.m_Parameters)
				{
					const auto found = m_Expressions.find(rName);
					if (m_Scaled.insert(rName).second && found != m_Expressions.end())
						demands.push_back(&found->second);
				}
			}
		}
	}

	bool MakeChanges()
	{
		bool bGood = true;
		for (auto& [pText, analysis] : m_Lengths)
			bGood &= ChangeLength(*pText, analysis, EExpressionContext::ELinear);
		for (const std::string& rName : m_Scaled)
		{
			VParameter& rParameter = *m_Parameters.at(rName);
			for (double* pValue : {&rParameter.m_Prior, &rParameter.m_UserValue})
				if (*pValue != c_NotSet)
				{
					m_Values.emplace_back(pValue, *pValue * m_Factor);
					bGood &= IsGood(m_Values.back().second, *pValue, rName);
				}
			if (const auto found = m_Expressions.find(rName); found != m_Expressions.end())
				bGood &= ChangeLength(rParameter.m_DefaultExpression, found->second, EExpressionContext::EStatic);
		}
		return bGood;
	}

	bool ChangeLength(std::string& io_rText, const VAnalysis& i_rAnalysis, EExpressionContext i_Context)
	{
		if (!i_rAnalysis.m_bEvaluates)
			return true;
		if (i_rAnalysis.m_Parameters.empty() && !i_rAnalysis.m_bDynamic)
		{
			if (i_rAnalysis.m_Value != 0.0)
				m_Texts.emplace_back(&io_rText, NumberText::PrintG17(i_rAnalysis.m_Value * m_Factor));
			return IsGood(i_rAnalysis.m_Value * m_Factor, i_rAnalysis.m_Value, io_rText);
		}
		if (Follows(i_rAnalysis))
			return true;
		std::string text = ScaledExpression(io_rText, m_Factor).value_or("");
		double value = 0.0;
		std::string error;
		m_Parser.Evaluate(text, value, error, i_Context);
		const double expected = i_rAnalysis.m_Value * m_Factor;
		const bool bGood = !text.empty() && error.empty() && IsGood(value, i_rAnalysis.m_Value, io_rText)
		    && !(std::abs(value - expected) > 1e-9 * std::abs(expected));
		if (!bGood)
			NVX_LOG(c_Category, NVX::ELogError, "Cannot scale the length '%1%'", io_rText);
		m_Texts.emplace_back(&io_rText, std::move(text));
		return bGood;
	}

	/// A value may not leave the finite range, nor become the mark for a value that is not set.
	bool IsGood(double i_Scaled, double i_Before, const std::string& i_rWhat) const
	{
		if (!std::isfinite(i_Before) || (std::isfinite(i_Scaled) && i_Scaled != c_NotSet))
			return true;
		NVX_LOG(c_Category, NVX::ELogError, "Cannot scale '%1%': it would leave the range of numbers", i_rWhat);
		return false;
	}

	VSubjectParametrised& m_rSubject;
	const double m_Factor;
	VDynamicExpressionParserSimple m_Parser;
	VNamesFactory m_NamesFactory;
	Math::VMathFactorySymbolicLinear<1> m_FormFactory;

	std::map<std::string, VParameter*> m_Parameters;
	std::set<std::string> m_DynamicNames;
	/// The default expressions of the parameters that live by them.
	std::map<std::string, VAnalysis> m_Expressions;
	std::vector<std::pair<std::string*, VAnalysis>> m_Lengths;
	std::set<std::string> m_OfRotations;
	std::set<std::string> m_Blocked;
	std::set<std::string> m_Scaled;
	/// What to write where, once everything is known to go well.
	std::vector<std::pair<std::string*, std::string>> m_Texts;
	std::vector<std::pair<double*, double>> m_Values;
};

/// One value for each degree of freedom.
void ScaleTPoseConstraints(VSubjectParametrised& io_rSubject, double i_Factor)
{
	std::size_t size = 0;
	for (const auto& rSegment : io_rSubject.m_Segments)
		size += CoreOrlexTypes::StateSize(rSegment.m_Joint.m_JointType);
	std::vector<double>& rValues = io_rSubject.m_TPoseConstraints;
	if (rValues.size() != size)
	{
		if (!rValues.empty())
			NVX_LOG(c_Category, NVX::ELogWarning,
			    "The T-pose constraints of subject %1% do not fit its joints and are not scaled", io_rSubject.m_Name);
		return;
	}
	auto value = rValues.begin();
	for (const auto& rSegment : io_rSubject.m_Segments)
	{
		VSubjectParametrised::VJoint joint;
		joint.m_JointType = rSegment.m_Joint.m_JointType;
		const auto end = value + std::ptrdiff_t(CoreOrlexTypes::StateSize(joint.m_JointType));
		joint.m_TPoseMean.assign(value, end);
		if (value != end)
			SubjectParametrisedUtils::ScaleJoint(joint, i_Factor);
		value = std::copy(joint.m_TPoseMean.begin(), joint.m_TPoseMean.end(), value);
	}
}

} // namespace

bool SubjectParametrisedUtils::ScaleSubject(VSubjectParametrised& io_rSubject, double i_Factor)
{
	if (!IsUsableFactor(io_rSubject, i_Factor) || !VSubjectScaling(io_rSubject, i_Factor).Run())
		return false;
	for (VSubjectParametrised::VSegment& rSegment : io_rSubject.m_Segments)
	{
		for (double& rValue : rSegment.m_InversePostTranslation)
			rValue *= i_Factor;
		ScaleJoint(rSegment.m_Joint, i_Factor);
	}
	for (VSubjectParametrised::VTarget& rTarget : io_rSubject.m_Targets)
	{
		TellUnscalableState<VSubjectParametrised>(rTarget);
		ScaleTargetStatistics<VSubjectParametrised>(
		    rTarget, i_Factor, rTarget.m_Covariance, rTarget.m_TemplateCovariance, rTarget.m_PlacementCovariance);
	}
	ScaleTPoseConstraints(io_rSubject, i_Factor);
	return true;
}

} // namespace CoreOrlexTypesUtils
