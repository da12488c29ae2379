#include "CoreOrlexQRTIO/read/ReadChecks.h"

#include "CoreOrlexQRTIO/values/Evaluation.h"
#include "CoreOrlexQRTIO/values/ExpressionList.h"
#include "CoreOrlexTypes/NameHash.h"

#include <boost/format.hpp>

#include <algorithm>
#include <cmath>
#include <set>

namespace CoreOrlexQRTIO
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using CoreOrlexTypesUtils::VDynamicExpressionParserSimple;
using VJoint = VSubjectParametrised::VJoint;
using VTexts = std::vector<std::string>;

/// What the file says of the direction of a joint's axes, by type.
struct VAxesTexts
{
	VJoint::EJointType m_Type;
	const char* m_pMissing;
	const char* m_pWrongCount;
	const char* m_pZeroLength;
	std::vector<double> m_Default;
};

const VAxesTexts* FindAxesTexts(VJoint::EJointType i_Type)
{
	static const VAxesTexts s_Texts[] = {
	    {VJoint::EHardySpicer, "Hardy-Spicer joint '%s' is missing AXIS-PAIR, using defaults",
	        "Hardy-Spicer joint '%s' has invalid AXIS-PAIR, expected 6 elements got %d",
	        "Hardy-Spicer joint '%s' has an AXIS-PAIR with an axis of length 0", {1, 0, 0, 0, 1, 0}},
	    {VJoint::EHinge, "Hinge joint '%s' is missing AXIS, using default",
	        "Hinge joint '%s' has invalid AXIS, expected 3 elements got %d", "Hinge joint '%s' has an AXIS of length 0",
	        {1, 0, 0}},
	    {VJoint::ESlider, "Slider joint '%s' is missing AXIS, using default",
	        "Slider joint '%s' has invalid AXIS, expected 3 elements got %d",
	        "Slider joint '%s' has an AXIS of length 0", {1, 0, 0}},
	};
	const auto* const pFound = std::ranges::find(s_Texts, i_Type, &VAxesTexts::m_Type);
	return pFound == std::ranges::end(s_Texts) ? nullptr : pFound;
}

/// Tells whether expressions evaluate. Most of a file are numbers, and numbers times one and the same parameter: what
/// stands behind the first number is parsed once.
class VExpressionCheck
{
public:
	explicit VExpressionCheck(VDynamicExpressionParserSimple& io_rParser) : m_rParser(io_rParser) {}

	bool IsFine(std::string_view i_Expression, std::string& o_rError)
	{
		if (i_Expression.empty() || IsPlainNumber(i_Expression))
			return true;
		const auto isOperator = [](char i_Byte)
		{ return i_Byte == '+' || i_Byte == '-' || i_Byte == '*' || i_Byte == '/'; };
		const auto operation = std::find_if(i_Expression.begin() + 1, i_Expression.end(), isOperator);
		const std::string_view number(i_Expression.begin(), operation);
		const std::string_view tail(operation, i_Expression.end());
		// Zero may make a term vanish that would be refused otherwise.
		const bool bKnowable = IsPlainNumber(number)
		    && std::ranges::any_of(number, [](char i_Byte) { return i_Byte >= '1' && i_Byte <= '9'; });
		if (bKnowable && m_FineTails.contains(tail))
			return true;
		double value = 0.0;
		const bool bFine = m_rParser.Evaluate(i_Expression, value, o_rError);
		if (bFine && bKnowable)
			m_FineTails.emplace(tail);
		return bFine;
	}

private:
	VDynamicExpressionParserSimple& m_rParser;
	std::set<std::string, std::less<>> m_FineTails;
};

/// Files up to 3.1 tell where the segment stands in the joint's frame.
void TakePostPose(VDynamicExpressionParserSimple& io_rParser, const VSubjectQRTExtras::VJoint& i_rExtras,
    VSubjectParametrised::VSegment& io_rSegment)
{
	const std::optional<VJointPose> post = PostPose(io_rParser, i_rExtras);
	if (!post)
		return;
	const VJointPose inverse = Inverse(*post);
	io_rSegment.m_InversePostRotation = inverse.m_Rotation;
	io_rSegment.m_InversePostTranslation = inverse.m_Translation;
}

void TakeAxes(VDynamicExpressionParserSimple& io_rParser, VSubjectQRTExtras::VJoint& io_rExtras,
    VSubjectParametrised::VSegment& io_rSegment, VTexts& io_rErrors, VTexts& io_rWarnings)
{
	VJoint& rJoint = io_rSegment.m_Joint;
	const VAxesTexts* const pTexts = FindAxesTexts(rJoint.m_JointType);
	if (!pTexts)
		return;
	if (io_rExtras.m_Axis.empty())
	{
		io_rWarnings.push_back((boost::format(pTexts->m_pMissing) % rJoint.m_Name).str());
		io_rExtras.m_Axis = pTexts->m_Default;
	}
	const VJointPose prePose{EvaluateVector(io_rParser, io_rSegment.m_PreRotation),
	    EvaluateVector(io_rParser, io_rSegment.m_PreTranslation)};
	switch (JointOrientation(rJoint.m_JointType, io_rExtras.m_Axis, prePose, rJoint.m_JointOrientation))
	{
	case EAxesResult::Fine: break;
	case EAxesResult::WrongCount:
		io_rErrors.push_back((boost::format(pTexts->m_pWrongCount) % rJoint.m_Name % io_rExtras.m_Axis.size()).str());
		break;
	case EAxesResult::ZeroLength:
		io_rErrors.push_back((boost::format(pTexts->m_pZeroLength) % rJoint.m_Name).str());
		break;
	case EAxesResult::NotOrthogonal:
		io_rErrors.push_back((boost::format("Hardy-Spicer joint '%s' has non orthogonal axes") % rJoint.m_Name).str());
		break;
	}
}

} // namespace

bool CheckExpressions(
    VDynamicExpressionParserSimple& io_rParser, const VReading& i_rReading, VTexts& io_rErrors, VTexts& io_rWarnings)
{
	const VSubjectParametrised& rSubject = i_rReading.m_rSubject;
	VTexts parameterErrors;
	bool bFine = io_rParser.Initialise(rSubject, parameterErrors);
	if (!bFine)
		io_rErrors.push_back("Error parsing subject static parameter expressions");
	io_rErrors.insert(io_rErrors.end(), parameterErrors.begin(), parameterErrors.end());

	VExpressionCheck expressions(io_rParser);
	std::string error;
	for (std::size_t i = 0; i < rSubject.m_Segments.size(); ++i)
	{
		const VSubjectParametrised::VSegment& rSegment = rSubject.m_Segments[i];
		const VSubjectQRTExtras::VJoint& rExtras = i_rReading.m_rExtras.m_Segments[i].m_Joint;
		const auto check = [&](const std::string& i_rExpression)
		{
			if (expressions.IsFine(i_rExpression, error))
				return;
			bFine = false;
			io_rWarnings.push_back(
			    (boost::format("Segment '%1%' has the invalid expression '%2%'") % rSegment.m_Name % i_rExpression)
			        .str());
			io_rErrors.push_back(error);
		};
		std::ranges::for_each(rSegment.m_PreRotation, check);
		std::ranges::for_each(rSegment.m_PreTranslation, check);
		std::ranges::for_each(rSegment.m_Bounds, check);
		if (i_rReading.m_Version < Format::c_3_2)
		{
			std::ranges::for_each(rExtras.m_PostOrientation, check);
			std::ranges::for_each(rExtras.m_PostPosition, check);
		}
		check(rSegment.m_MassExpression);
		std::ranges::for_each(rSegment.m_MassCentreExpressions, check);
		std::ranges::for_each(rSegment.m_RadiusOfGyrationExpressions, check);
	}

	for (std::size_t i = 0; i < rSubject.m_Targets.size(); ++i)
		for (const std::string& rExpression : rSubject.m_Targets[i].m_StateExpressions)
			if (!expressions.IsFine(rExpression, error))
				io_rWarnings.push_back((boost::format("Target '%1%' has the invalid state expression '%2%': %3%")
				    % i_rReading.m_rApplicationData.m_Targets[i].m_Name % rExpression % error)
				                           .str());
	return bFine;
}

void FinishJointsAndTargets(
    VDynamicExpressionParserSimple& io_rParser, VReading& io_rReading, VTexts& io_rErrors, VTexts& io_rWarnings)
{
	VSubjectParametrised& rSubject = io_rReading.m_rSubject;
	for (std::size_t i = 0; i < rSubject.m_Segments.size(); ++i)
	{
		VSubjectParametrised::VSegment& rSegment = rSubject.m_Segments[i];
		VSubjectQRTExtras::VJoint& rExtras = io_rReading.m_rExtras.m_Segments[i].m_Joint;
		if (io_rReading.m_Version < Format::c_3_2)
			TakePostPose(io_rParser, rExtras, rSegment);
		TakeAxes(io_rParser, rExtras, rSegment, io_rErrors, io_rWarnings);
	}
	for (const VSubjectParametrised::VTarget& rTarget : rSubject.m_Targets)
	{
		if (rTarget.m_Type != VSubjectParametrised::VTarget::ELocalDirectionToWorldDirection)
			continue;
		const Rotation::VVector3 direction = EvaluateVector(io_rParser, rTarget.m_StateExpressions);
		const double square = direction[0] * direction[0] + direction[1] * direction[1] + direction[2] * direction[2];
		if (!(std::abs(square - 1.0) <= 0.001))
			io_rErrors.push_back("Direction target state has to be a unit vector");
	}
}

void IdentifySubspaces(VReading& io_rReading)
{
	std::string structure;
	for (const VSubjectParametrised::VSegment& rSegment : io_rReading.m_rSubject.m_Segments)
		structure += rSegment.m_Joint.m_Name + '\n' + std::to_string(rSegment.m_Joint.m_JointType) + '\n'
		    + std::to_string(rSegment.m_ParentSegmentIndex) + '\n';
	io_rReading.m_rExtras.m_SubspaceId = io_rReading.m_rSubject.m_SubjectId;
	io_rReading.m_rExtras.m_SubspaceHash = CoreOrlexTypes::HashName(structure);
}

} // namespace CoreOrlexQRTIO
