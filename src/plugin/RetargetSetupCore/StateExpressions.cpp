#include "RetargetSetupCore/StateExpressions.h"

#include "CoreOrlexTypesUtils/convert/StaticExpressionParser.h"
#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/ParseNumber.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "math/NumberText.h"

#include <cmath>

using CoreOrlexTypes::VSubjectParametrised;
using VTarget = CoreOrlexTypes::VSubjectParametrised::VTarget;

namespace RetargetSetup
{

namespace
{

void StoreExpression(VTarget& io_rTarget, std::size_t i_Component, std::string i_Text)
{
	if (io_rTarget.m_StateExpressions.size() < 3)
		io_rTarget.m_StateExpressions.resize(3, "0");
	io_rTarget.m_StateExpressions[i_Component] = std::move(i_Text);
}

void TellNotStored(std::size_t i_TargetIndex, std::size_t i_Component, const std::string& i_rReason)
{
	NVX_LOG(c_LogCategory, NVX::ELogWarning, "State %1% of target %2% stays as it was: %3%", "XYZ"[i_Component],
	    i_TargetIndex, i_rReason);
}

/// Takes the scale out of a length, so that the offset stays true when the scale changes.
bool StoreLength(VSubjectParametrised& io_rSubject, double i_Length, std::size_t i_TargetIndex, std::size_t i_Component)
{
	const VSubjectParametrised::VDynamicParameter& rScale = io_rSubject.m_DynamicParameters.back();
	const double quotient = i_Length / rScale.m_Value;
	if (!std::isfinite(quotient))
	{
		TellNotStored(i_TargetIndex, i_Component,
		    NumberText::PrintG17(i_Length) + " over the scale " + NumberText::PrintG17(rScale.m_Value)
		        + " is not finite");
		return false;
	}
	StoreExpression(
	    io_rSubject.m_Targets[i_TargetIndex], i_Component, NumberText::PrintF(quotient) + "*" + rScale.m_Name);
	return true;
}

bool StoreAngle(VSubjectParametrised& io_rSubject, double i_Angle, std::size_t i_TargetIndex, std::size_t i_Component)
{
	if (!std::isfinite(i_Angle))
	{
		TellNotStored(i_TargetIndex, i_Component, "the rotation is not finite");
		return false;
	}
	StoreExpression(io_rSubject.m_Targets[i_TargetIndex], i_Component, NumberText::PrintG17(i_Angle));
	return true;
}

bool StoreAngleText(
    VSubjectParametrised& io_rSubject, const std::string& i_rText, std::size_t i_TargetIndex, std::size_t i_Component)
{
	CoreOrlexTypesUtils::VDynamicExpressionParserSimple parser;
	std::vector<std::string> otherErrors;
	parser.Initialise(io_rSubject, otherErrors);
	double value = 0.0;
	std::string error;
	if (!parser.Evaluate(i_rText, value, error))
	{
		TellNotStored(i_TargetIndex, i_Component, error);
		return false;
	}
	if (!std::isfinite(value))
	{
		TellNotStored(i_TargetIndex, i_Component, "'" + i_rText + "' has no finite value");
		return false;
	}
	std::string text = i_rText;
	// Files separate the expressions of a list by blanks.
	std::erase_if(text, [](char i_Byte) { return i_Byte == ' ' || (i_Byte >= '\t' && i_Byte <= '\r'); });
	double valueOfText = 0.0;
	if (!parser.Evaluate(text, valueOfText, error) || valueOfText != value)
	{
		TellNotStored(i_TargetIndex, i_Component, "'" + i_rText + "' means something else without its blanks");
		return false;
	}
	StoreExpression(io_rSubject.m_Targets[i_TargetIndex], i_Component, std::move(text));
	return true;
}

} // namespace

void TellNoDynamicParameter(const std::string& i_rConsequence)
{
	NVX_LOG(c_LogCategory, NVX::ELogWarning, "%1%: the target subject has no dynamic parameter to scale it by",
	    i_rConsequence);
}

void UpdateTargetState(
    VSubjectParametrised& io_rSubject, const Rotation::VPose<double>& i_rRelative, std::size_t i_TargetIndex)
{
	if (io_rSubject.m_DynamicParameters.empty())
		return;
	const VTarget::ETargetType type = io_rSubject.m_Targets[i_TargetIndex].m_Type;
	const Rotation::VVector3 state =
	    type == VTarget::ELocalPointToWorldPoint ? i_rRelative.t : Rotation::AngleAxisFromRotationMatrix(i_rRelative.R);
	for (std::size_t component = 0; component < 3; ++component)
	{
		if (type == VTarget::ELocalRotationToWorldRotation)
			StoreAngle(io_rSubject, state[component], i_TargetIndex, component);
		else if (type == VTarget::ELocalPointToWorldPoint || type == VTarget::ELocalPointToWorldPointGaussian)
			StoreLength(io_rSubject, state[component], i_TargetIndex, component);
	}
}

bool SetStateExpression(
    VSubjectParametrised& io_rSubject, std::string_view i_Text, std::size_t i_TargetIndex, std::size_t i_Component)
{
	if (i_TargetIndex >= io_rSubject.m_Targets.size() || i_Component >= 3)
		return false;
	const VTarget::ETargetType type = io_rSubject.m_Targets[i_TargetIndex].m_Type;
	const bool bLength = type == VTarget::ELocalPointToWorldPoint || type == VTarget::ELocalPointToWorldPointGaussian;
	if (!bLength && type != VTarget::ELocalRotationToWorldRotation)
		return false;
	if (io_rSubject.m_DynamicParameters.empty())
	{
		TellNoDynamicParameter("State of target " + std::to_string(i_TargetIndex) + " stays as it was");
		return false;
	}
	std::string text(i_Text);
	if (text.find_first_not_of(" \t\n\v\f\r") == std::string::npos)
		text = "0";
	if (!bLength)
		return StoreAngleText(io_rSubject, text, i_TargetIndex, i_Component);
	double length = 0.0;
	if (!ParseNumber(text, length))
	{
		TellNotStored(i_TargetIndex, i_Component, "'" + text + "' is not a number");
		return false;
	}
	return StoreLength(io_rSubject, length, i_TargetIndex, i_Component);
}

} // namespace RetargetSetup
