#include "CoreOrlexQRTIO/values/Evaluation.h"

namespace CoreOrlexQRTIO
{
namespace
{

Rotation::VVector3 AsVector(std::span<const double> i_Values)
{
	return i_Values.size() == 3 ? Rotation::VVector3{i_Values[0], i_Values[1], i_Values[2]} : Rotation::VVector3{};
}

} // namespace

Rotation::VVector3 EvaluateVector(
    CoreOrlexTypesUtils::VDynamicExpressionParserSimple& io_rParser, std::span<const std::string> i_Expressions)
{
	Rotation::VVector3 values{};
	std::string error;
	for (std::size_t i = 0; i < 3 && i < i_Expressions.size(); ++i)
		io_rParser.Evaluate(i_Expressions[i], values[i], error);
	return values;
}

std::optional<VJointPose> PostPose(
    CoreOrlexTypesUtils::VDynamicExpressionParserSimple& io_rParser, const VSubjectQRTExtras::VJoint& i_rExtras)
{
	if (i_rExtras.m_PostOrientation.empty() && i_rExtras.m_PostPosition.empty()
	    && i_rExtras.m_TemplatePostOrientation.empty() && i_rExtras.m_TemplatePostPosition.empty())
		return std::nullopt;
	return VJointPose{i_rExtras.m_PostOrientation.empty() ? AsVector(i_rExtras.m_TemplatePostOrientation)
	                                                      : EvaluateVector(io_rParser, i_rExtras.m_PostOrientation),
	    i_rExtras.m_PostPosition.empty() ? AsVector(i_rExtras.m_TemplatePostPosition)
	                                     : EvaluateVector(io_rParser, i_rExtras.m_PostPosition)};
}

} // namespace CoreOrlexQRTIO
