#include "CoreOrlexQRTIO/format/EnumTables.h"
#include "CoreOrlexQRTIO/format/FormatFunctions.h"
#include "CoreOrlexQRTIO/format/JointElements.h"
#include "CoreOrlexQRTIO/read/AttributeReading.h"
#include "math/NumberText.h"

namespace CoreOrlexQRTIO
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using UtilsRapidXml::INode;
using UtilsRapidXml::ReadAttribute;
using UtilsRapidXml::ReadList;

/// What joint and template told. The template's word counts for the pose before the joint, the joint's for the one
/// behind it.
struct VTold
{
	bool m_bInverseOrientation = false;
	bool m_bInversePosition = false;
	bool m_bTemplateOrientation = false;
	bool m_bTemplatePosition = false;
};

/// The joint's numbers as expressions, which only hold until a template tells its own.
struct VOwnPre
{
	VOwnPre(INode& io_rNode, const Format::VAttribute& i_rAttribute)
	    : m_bGiven(ReadList(io_rNode, i_rAttribute, 3, m_Values.data()))
	{
	}

	void Take(bool i_bTemplate, std::array<std::string, 3>& o_rExpressions) const
	{
		if (m_bGiven && !i_bTemplate)
			std::ranges::transform(m_Values, o_rExpressions.begin(), NumberText::PrintG17);
	}

	std::array<double, 3> m_Values{};
	bool m_bGiven;
};

/// Three expressions, or an empty list if the attribute is not there.
void ReadExpressionTriple(
    INode& io_rNode, const Format::VAttribute& i_rAttribute, std::vector<std::string>& o_rExpressions)
{
	std::array<std::string, 3> expressions;
	if (ReadExpressions(io_rNode, i_rAttribute, expressions))
		o_rExpressions.assign(expressions.begin(), expressions.end());
}

void FormatJointTemplate(INode& io_rNode, VSegmentInHand& io_rSegment, VTold& io_rTold)
{
	namespace Table = Format::JointTemplate;
	VSubjectParametrised::VSegment& rSegment = io_rSegment.m_rSegment;
	VSubjectParametrised::VJoint& rJoint = rSegment.m_Joint;
	VSubjectQRTExtras::VJoint& rExtras = io_rSegment.m_rExtras.m_Joint;
	const std::size_t stateSize = CoreOrlexTypes::StateSize(rJoint.m_JointType);
	const std::size_t covarianceSize = CoreOrlexTypes::CovarianceSize(rJoint.m_JointType);

	ReadList(io_rNode, Table::c_Mean, stateSize, rJoint.m_TemplateMean);
	ReadList(io_rNode, Table::c_Covariance, covarianceSize, rJoint.m_TemplateCovariance);
	ReadList(io_rNode, Table::c_TPoseMean, stateSize, rJoint.m_TPoseMean);
	ReadList(io_rNode, Table::c_TPoseCovariance, covarianceSize, rJoint.m_TPoseCovariance);
	ReadList(io_rNode, Table::c_BindPose, stateSize, rJoint.m_BindPose);
	io_rTold.m_bTemplateOrientation = ReadExpressions(io_rNode, Table::c_PreOrientation, rSegment.m_PreRotation);
	io_rTold.m_bTemplatePosition = ReadExpressions(io_rNode, Table::c_PrePosition, rSegment.m_PreTranslation);
	if (ReadList(io_rNode, Table::c_InversePostOrientation, 3, rExtras.m_TemplateInversePostOrientation)
	    && !io_rTold.m_bInverseOrientation)
		std::ranges::copy(rExtras.m_TemplateInversePostOrientation, rSegment.m_InversePostRotation.begin());
	if (ReadList(io_rNode, Table::c_InversePostPosition, 3, rExtras.m_TemplateInversePostPosition)
	    && !io_rTold.m_bInversePosition)
		std::ranges::copy(rExtras.m_TemplateInversePostPosition, rSegment.m_InversePostTranslation.begin());
	ReadList(io_rNode, Table::c_PostOrientation, 3, rExtras.m_TemplatePostOrientation);
	ReadList(io_rNode, Table::c_PostPosition, 3, rExtras.m_TemplatePostPosition);
	ReadList(io_rNode, Table::c_RangeCentringState, stateSize, rJoint.m_TemplateRangeCentringState);
	ReadList(io_rNode, Table::c_RangeMatrix, covarianceSize, rJoint.m_TemplateRangeMatrix);
}

} // namespace

void FormatJoint(INode& io_rNode, VSegmentInHand& io_rSegment)
{
	namespace Table = Format::Joint;
	const VJointElement* const pElement = FindJointElement(
	    [&](const VJointElement& i_rElement) { return i_rElement.m_rElement.m_Name == io_rNode.GetName(); });
	if (!pElement)
		return;
	using VJoint = VSubjectParametrised::VJoint;
	VSubjectParametrised::VSegment& rSegment = io_rSegment.m_rSegment;
	VJoint& rJoint = rSegment.m_Joint;
	VSubjectQRTExtras::VJoint& rExtras = io_rSegment.m_rExtras.m_Joint;
	const VJoint::EJointType type = rJoint.m_JointType = pElement->m_Type;
	const std::size_t stateSize = CoreOrlexTypes::StateSize(type);
	const std::size_t covarianceSize = CoreOrlexTypes::CovarianceSize(type);

	ReadAttribute(io_rNode, Table::c_Name, rJoint.m_Name);
	const VOwnPre orientation(io_rNode, Table::c_PreOrientation);
	const VOwnPre position(io_rNode, Table::c_PrePosition);
	VTold told;
	told.m_bInverseOrientation =
	    ReadList(io_rNode, Table::c_InversePostOrientation, 3, rSegment.m_InversePostRotation.data());
	told.m_bInversePosition =
	    ReadList(io_rNode, Table::c_InversePostPosition, 3, rSegment.m_InversePostTranslation.data());
	ReadExpressionTriple(io_rNode, Table::c_PostOrientation, rExtras.m_PostOrientation);
	ReadExpressionTriple(io_rNode, Table::c_PostPosition, rExtras.m_PostPosition);
	ReadAttribute(io_rNode, Table::c_EditPoseMean, rExtras.m_EditPoseMean);
	ReadAttribute(io_rNode, Table::c_TPose, rExtras.m_TPose);

	if (type != VJoint::EDummy)
	{
		ReadAttribute(io_rNode, Table::c_Bounds, rExtras.m_Bounds);
		if (!ReadList(io_rNode, Table::c_Mean, stateSize, rJoint.m_Mean))
			rJoint.m_Mean.assign(stateSize, 0.0);
		if (!ReadList(io_rNode, Table::c_Covariance, covarianceSize, rJoint.m_Covariance))
			rJoint.m_Covariance = CoreOrlexTypes::DefaultCovariance(type);
		std::vector<bool> placeholders;
		rExtras.m_bHasT =
		    UtilsRapidXml::ReadListWithPlaceholders(io_rNode, Table::c_T, stateSize, io_rSegment.m_T, placeholders);
		ReadAttribute(io_rNode, Table::c_Signs, rExtras.m_Signs);
		ReadAttribute(io_rNode, Table::c_Labels, rExtras.m_Labels);
		io_rSegment.m_rApplicationData.m_Joint.m_Signs = rExtras.m_Signs;
		io_rSegment.m_rApplicationData.m_Joint.m_Labels = rExtras.m_Labels;
		ReadList(io_rNode, Table::c_RangeCentringState, stateSize, rJoint.m_RangeCentringState);
		ReadList(io_rNode, Table::c_RangeMatrix, covarianceSize, rJoint.m_RangeMatrix);
	}

	Process(io_rNode, Table::c_JointTemplate,
	    [&](INode& io_rTemplate) { FormatJointTemplate(io_rTemplate, io_rSegment, told); });
	orientation.Take(told.m_bTemplateOrientation, rSegment.m_PreRotation);
	position.Take(told.m_bTemplatePosition, rSegment.m_PreTranslation);

	if (type == VJoint::EFree || type == VJoint::EBall)
		ReadAttribute(io_rNode, Table::c_EulerOrder, EnumTables::EulerOrder(),
		    io_rSegment.m_rApplicationData.m_Joint.m_EulerOrder);
	else if (type == VJoint::EHardySpicer)
		ReadReals(io_rNode, Table::c_AxisPair, rExtras.m_Axis);
	else if (type == VJoint::EHinge || type == VJoint::ESlider)
		ReadReals(io_rNode, Table::c_Axis, rExtras.m_Axis);
}

} // namespace CoreOrlexQRTIO
