#include "CoreOrlexQRTIO/format/EnumTables.h"
#include "CoreOrlexQRTIO/format/JointElements.h"
#include "CoreOrlexQRTIO/write/AttributeWriting.h"
#include "CoreOrlexQRTIO/write/WriteSections.h"

#include <boost/format.hpp>

namespace CoreOrlexQRTIO
{
namespace
{

using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using UtilsRapidXml::VWriterNode;
using VJoint = VSubjectParametrised::VJoint;

void WriteJointTemplate(
    VWriterNode& io_rNode, const VSubjectParametrised::VSegment& i_rSegment, const VSubjectQRTExtras::VJoint& i_rExtras)
{
	namespace Table = Format::JointTemplate;
	const VJoint& rJoint = i_rSegment.m_Joint;
	const auto asRead = [](const std::vector<double>& i_rRead, const std::array<double, 3>& i_rHeld)
	{ return i_rRead.size() == 3 ? std::span<const double>(i_rRead) : std::span<const double>(i_rHeld); };
	WriteReals(io_rNode, Table::c_Mean, rJoint.m_TemplateMean);
	WriteReals(io_rNode, Table::c_Covariance, rJoint.m_TemplateCovariance);
	WriteReals(io_rNode, Table::c_TPoseMean, rJoint.m_TPoseMean);
	WriteReals(io_rNode, Table::c_TPoseCovariance, rJoint.m_TPoseCovariance);
	WriteReals(io_rNode, Table::c_BindPose, rJoint.m_BindPose);
	WriteExpressions(io_rNode, Table::c_PreOrientation, i_rSegment.m_PreRotation);
	WriteExpressions(io_rNode, Table::c_PrePosition, i_rSegment.m_PreTranslation);
	WriteReals(io_rNode, Table::c_InversePostOrientation,
	    asRead(i_rExtras.m_TemplateInversePostOrientation, i_rSegment.m_InversePostRotation));
	WriteReals(io_rNode, Table::c_InversePostPosition,
	    asRead(i_rExtras.m_TemplateInversePostPosition, i_rSegment.m_InversePostTranslation));
	WriteReals(io_rNode, Table::c_PostOrientation, i_rExtras.m_TemplatePostOrientation);
	WriteReals(io_rNode, Table::c_PostPosition, i_rExtras.m_TemplatePostPosition);
	WriteReals(io_rNode, Table::c_RangeCentringState, rJoint.m_TemplateRangeCentringState);
	WriteReals(io_rNode, Table::c_RangeMatrix, rJoint.m_TemplateRangeMatrix);
}

void WriteJoint(VWriterNode& io_rNode, const VSubjectParametrised::VSegment& i_rSegment,
    const VSubjectApplicationData::VJoint& i_rApplicationData, const VPreparedSegment& i_rPrepared)
{
	namespace Table = Format::Joint;
	const VJoint& rJoint = i_rSegment.m_Joint;
	const VSubjectQRTExtras::VJoint& rExtras = i_rPrepared.Extras().m_Joint;
	WriteText(io_rNode, Table::c_Name, rJoint.m_Name);
	WriteReals(io_rNode, Table::c_PreOrientation, i_rPrepared.m_PrePose.m_Rotation);
	WriteReals(io_rNode, Table::c_PrePosition, i_rPrepared.m_PrePose.m_Translation);
	WriteExpressions(io_rNode, Table::c_PostOrientation, rExtras.m_PostOrientation);
	WriteExpressions(io_rNode, Table::c_PostPosition, rExtras.m_PostPosition);
	WriteReals(io_rNode, Table::c_InversePostOrientation, i_rSegment.m_InversePostRotation);
	WriteReals(io_rNode, Table::c_InversePostPosition, i_rSegment.m_InversePostTranslation);
	WriteText(io_rNode, Table::c_EditPoseMean, rExtras.m_EditPoseMean);
	WriteText(io_rNode, Table::c_TPose, rExtras.m_TPose);
	if (rJoint.m_JointType != VJoint::EDummy)
	{
		WriteText(io_rNode, Table::c_Bounds, rExtras.m_Bounds);
		WriteReals(io_rNode, Table::c_Mean, rJoint.m_Mean);
		WriteReals(io_rNode, Table::c_Covariance, rJoint.m_Covariance);
		WriteRealsWithPlaceholders(io_rNode, Table::c_T, i_rPrepared.m_T);
		WriteText(io_rNode, Table::c_Signs,
		    i_rApplicationData.m_Signs.empty() ? rExtras.m_Signs : i_rApplicationData.m_Signs);
		WriteText(io_rNode, Table::c_Labels,
		    i_rApplicationData.m_Labels.empty() ? rExtras.m_Labels : i_rApplicationData.m_Labels);
		WriteReals(io_rNode, Table::c_RangeCentringState, rJoint.m_RangeCentringState);
		WriteReals(io_rNode, Table::c_RangeMatrix, rJoint.m_RangeMatrix);
	}
	if (rJoint.m_JointType == VJoint::EFree || rJoint.m_JointType == VJoint::EBall)
	{
		if (i_rApplicationData.m_EulerOrder != VSubjectApplicationData::VJoint::ENone)
			WriteEnum(io_rNode, Table::c_EulerOrder, EnumTables::EulerOrder(), i_rApplicationData.m_EulerOrder);
	}
	else
		WriteReals(io_rNode, rJoint.m_JointType == VJoint::EHardySpicer ? Table::c_AxisPair : Table::c_Axis,
		    i_rPrepared.m_Axes);
	WriteElement(io_rNode, Table::c_JointTemplate,
	    [&](VWriterNode& io_rTemplate) { WriteJointTemplate(io_rTemplate, i_rSegment, rExtras); });
}

/// All of a segment but its children, in a frame of its own: a chain of segments is walked by recursion.
[[gnu::noinline]] void WriteSegmentItself(VWriterNode& io_rNode, VWriting& io_rWriting, std::uint32_t i_Index)
{
	namespace Table = Format::Segment;
	const VSubjectParametrised::VSegment& rSegment = io_rWriting.m_rSubject.m_Segments[i_Index];
	const VSubjectApplicationData::VSegment& rApplicationData =
	    RecordOrDefault(io_rWriting.m_rApplicationData.m_Segments, i_Index);
	const VPreparedSegment& rPrepared = io_rWriting.m_Segments[i_Index];

	WriteText(io_rNode, Table::c_Name, rSegment.m_Name);
	WriteReals(io_rNode, Table::c_Position, rPrepared.m_PrePose.m_Translation);
	WriteReal(io_rNode, Table::c_Opacity, rApplicationData.m_Colour.m_Alpha);
	WriteExpressions(io_rNode, Table::c_Orientation, WritableExpressions(io_rWriting, rSegment.m_PreRotation));
	WriteExpressions(io_rNode, Table::c_Bounds, WritableExpressions(io_rWriting, rSegment.m_Bounds));
	WriteText(io_rNode, Table::c_Mass, rSegment.m_MassExpression);
	WriteExpressions(io_rNode, Table::c_MassCentre, rSegment.m_MassCentreExpressions);
	WriteExpressions(io_rNode, Table::c_Inertia, rSegment.m_RadiusOfGyrationExpressions);
	WriteColourOrCount(io_rNode, io_rWriting, Table::c_Colour, rApplicationData.m_Colour);
	WriteText(io_rNode, Table::c_Context, rApplicationData.m_Context);
	WriteBool(io_rNode, Table::c_Hidden, !rApplicationData.m_Visible);
	WriteReal(io_rNode, Table::c_DrawEndRatio, rApplicationData.m_DrawEndRatio);
	WriteReal(io_rNode, Table::c_DrawHeight, rApplicationData.m_DrawHeight);
	WriteReal(io_rNode, Table::c_DrawTwist, rApplicationData.m_DrawTwist);
	WriteReal(io_rNode, Table::c_DrawWidth, rApplicationData.m_DrawWidth);
	WriteText(io_rNode, Table::c_Part, rApplicationData.m_Part);
	WriteText(io_rNode, Table::c_Covariance, rPrepared.Extras().m_Covariance);
	WriteText(io_rNode, Table::c_Size, rPrepared.Extras().m_Size);
	WriteEnum(io_rNode, Table::c_DrawStyle, EnumTables::DrawStyle(), rApplicationData.m_DrawStyle);
	WriteEnum(io_rNode, Table::c_DrawShading, EnumTables::DrawShading(), rApplicationData.m_DrawShading);

	const VJointElement* const pJoint = FindJointElement(
	    [&](const VJointElement& i_rElement) { return i_rElement.m_Type == rSegment.m_Joint.m_JointType; });
	if (pJoint)
		WriteElement(io_rNode, pJoint->m_rElement,
		    [&](VWriterNode& io_rJoint) { WriteJoint(io_rJoint, rSegment, rApplicationData.m_Joint, rPrepared); });
	else
		io_rNode.AddError(
		    (boost::format("Segment '%1%' has a joint of a type that a file cannot hold.") % rSegment.m_Name).str());
}

void WriteSegment(VWriterNode& io_rNode, VWriting& io_rWriting, std::uint32_t i_Index)
{
	WriteSegmentItself(io_rNode, io_rWriting, i_Index);
	for (const std::uint32_t child : io_rWriting.m_Segments[i_Index].m_Children)
		WriteElement(io_rNode, Format::Skeleton::c_Segment,
		    [&](VWriterNode& io_rChild) { WriteSegment(io_rChild, io_rWriting, child); });
}

} // namespace

void WriteSkeleton(VWriterNode& io_rNode, VWriting& io_rWriting)
{
	WriteColourOrCount(io_rNode, io_rWriting, Format::Skeleton::c_Colour, io_rWriting.m_rApplicationData.m_Colour);
	for (const std::uint32_t root : io_rWriting.m_Roots)
		WriteElement(io_rNode, Format::Skeleton::c_Segment,
		    [&](VWriterNode& io_rSegment) { WriteSegment(io_rSegment, io_rWriting, root); });
}

} // namespace CoreOrlexQRTIO
