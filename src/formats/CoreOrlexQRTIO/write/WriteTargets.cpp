#include "CoreOrlexQRTIO/format/EnumTables.h"
#include "CoreOrlexQRTIO/format/TargetKinds.h"
#include "CoreOrlexQRTIO/values/JointGeometry.h"
#include "CoreOrlexQRTIO/write/AttributeWriting.h"
#include "CoreOrlexQRTIO/write/WriteSections.h"

#include <boost/format.hpp>

namespace CoreOrlexQRTIO
{
namespace
{

namespace Table = Format::Target;
using CoreOrlexTypes::VSubjectApplicationData;
using UtilsRapidXml::VWriterNode;
using VTarget = CoreOrlexTypes::VSubjectParametrised::VTarget;

void AddTargetError(VWriterNode& io_rNode, const std::string& i_rName, const char* i_pText)
{
	io_rNode.AddError((boost::format("Target '%1%' %2%") % i_rName % i_pText).str());
}

/// What a file of any version could not hold, or a reader not take back.
bool IsWritable(VWriterNode& io_rNode, const VTargetKind& i_rKind, const VTarget& i_rTarget, const std::string& i_rName)
{
	const std::size_t errors = io_rNode.GetGlobalInfo()->m_Errors.GetCount();
	const std::size_t markers = i_rKind.HasMarker() ? 0 : i_rTarget.m_MarkerIndices.size();
	if (i_rTarget.m_StateExpressions.size() != i_rKind.m_StateSize + 3 * markers)
		AddTargetError(io_rNode, i_rName, "has a state of another size than its type needs.");
	if (!i_rKind.HasMarker() && !i_rTarget.m_Covariance.empty()
	    && i_rTarget.m_Covariance.size() != i_rKind.m_CovarianceSize + 9 * markers)
		AddTargetError(io_rNode, i_rName, "has a covariance of another size than its type needs.");
	if (i_rKind.HasMarker() && i_rTarget.m_Type == i_rKind.m_GaussianType && i_rTarget.m_Covariance.empty())
		AddTargetError(io_rNode, i_rName, "is Gaussian and has no covariance.");
	if (i_rKind.HasMarker() && i_rTarget.m_MarkerIndices.empty())
		AddTargetError(io_rNode, i_rName, "has no marker.");
	if (i_rKind.HasObservation() && i_rTarget.m_RotationObservationIndices.empty())
		AddTargetError(io_rNode, i_rName, "has no rotation observation.");
	if (i_rTarget.m_SegmentIndices.empty())
		AddTargetError(io_rNode, i_rName, "has no segment.");
	return io_rNode.GetGlobalInfo()->m_Errors.GetCount() == errors;
}

void WriteState(
    VWriterNode& io_rNode, const Format::VAttribute& i_rAttribute, const VTarget& i_rTarget, std::size_t i_Offset)
{
	WriteExpressions(io_rNode, i_rAttribute, std::span(i_rTarget.m_StateExpressions).subspan(i_Offset, 3));
}

/// The axes as they were read, if they still yield the orientation that the target holds.
void WriteCalibrationAxes(VWriterNode& io_rNode, VWriting& io_rWriting, const VTarget& i_rTarget,
    const std::string& i_rName, const std::vector<double>& i_rAxisAsRead)
{
	const bool bHinge = i_rTarget.m_RotationCalibrationBehaviour == VTarget::EHingeLike;
	const bool bPair = i_rTarget.m_RotationCalibrationBehaviour == VTarget::EHardySpicerLike;
	const std::vector<double>& rHeld = i_rTarget.m_RotationTargetOrientation;
	if (!bHinge && !bPair)
	{
		if (!rHeld.empty() || i_rTarget.m_RotationCalibrationBehaviour != VTarget::EOther)
			io_rWriting.m_Warnings.push_back(
			    (boost::format("Target '%1%' loses its calibration behaviour: a file has no word for it.") % i_rName)
			        .str());
		return;
	}
	if (rHeld.size() != 3)
		return AddTargetError(io_rNode, i_rName, "has a calibration behaviour and no orientation for it.");
	const Rotation::VVector3 held{rHeld[0], rHeld[1], rHeld[2]};
	Rotation::VVector3 yielded{};
	const bool bAsRead = i_rAxisAsRead.size() == (bPair ? 6 : 3)
	    && TargetOrientation(i_rAxisAsRead, yielded) == EAxesResult::Fine && yielded == held;
	WriteReals(
	    io_rNode, bPair ? Table::c_AxisPair : Table::c_Axis, bAsRead ? i_rAxisAsRead : AxesOfOrientation(held, bPair));
}

void WriteRigidBodyMarker(VWriterNode& io_rNode, VWriting& io_rWriting, const VTargetKind& i_rKind,
    const VTarget& i_rTarget, std::size_t i_Index)
{
	namespace MarkerTable = Format::RigidBodyMarker;
	if (const std::string* const pName = NameOfMarker(io_rNode, io_rWriting, i_rTarget.m_MarkerIndices[i_Index]))
		WriteText(io_rNode, MarkerTable::c_Name, *pName);
	WriteState(io_rNode, MarkerTable::c_Position, i_rTarget, i_rKind.m_StateSize + 3 * i_Index);
	if (!i_rTarget.m_Covariance.empty())
		WriteReals(io_rNode, MarkerTable::c_Covariance,
		    std::span(i_rTarget.m_Covariance).subspan(i_rKind.m_CovarianceSize + 9 * i_Index, 9));
	if (i_Index < i_rTarget.m_ViewNormals.size())
		WriteReals(io_rNode, MarkerTable::c_ViewNormal, i_rTarget.m_ViewNormals[i_Index]);
}

void WriteTarget(VWriterNode& io_rNode, VWriting& io_rWriting, const VTargetKind& i_rKind, const VTarget& i_rTarget,
    const VSubjectApplicationData::VTarget& i_rApplicationData, const std::vector<double>& i_rAxisAsRead)
{
	const bool bPoint = i_rKind.m_Type == VTarget::ELocalPointToWorldPoint;
	const bool bRotation = i_rKind.m_Type == VTarget::ELocalRotationToWorldRotation;
	const bool bRigidBody = i_rKind.m_Type == VTarget::ERigidBody;
	const std::string& rName = i_rApplicationData.m_Name;
	if (!IsWritable(io_rNode, i_rKind, i_rTarget, rName))
		return;

	if (i_rKind.HasMarker())
		WriteReals(io_rNode, *i_rKind.m_pCovariance, i_rTarget.m_Covariance);
	if (bPoint)
		WriteReals(io_rNode, Table::c_PlacementCovariance, i_rTarget.m_PlacementCovariance);
	if (i_rKind.m_Type == VTarget::ELocalLineToWorldPoint)
		WriteState(io_rNode, Table::c_LineDirection, i_rTarget, 3);
	if (i_rKind.HasMarker())
	{
		WriteBool(io_rNode, Table::c_FillGaps, i_rApplicationData.m_FillGaps);
		WriteBool(io_rNode, Table::c_Gaussian, i_rTarget.m_Type == i_rKind.m_GaussianType);
	}
	WriteBool(io_rNode, Table::c_Hidden, !i_rApplicationData.m_Visible);
	WriteText(io_rNode, Table::c_Name, rName);
	if (i_rKind.m_Type == VTarget::ELocalPlaneToWorldPoint)
		WriteState(io_rNode, Table::c_Normal, i_rTarget, 3);
	if (i_rKind.HasMarker())
		if (const std::string* const pName = NameOfMarker(io_rNode, io_rWriting, i_rTarget.m_MarkerIndices[0]))
			WriteText(io_rNode, Table::c_Marker, *pName);
	WriteReal(io_rNode, Table::c_Opacity, i_rApplicationData.m_Colour.m_Alpha);
	if (i_rKind.HasMarker())
		WriteState(io_rNode, *i_rKind.m_pOrigin, i_rTarget, 0);
	if (bRigidBody)
	{
		WriteState(io_rNode, Table::c_RigidBodyPosition, i_rTarget, 0);
		WriteState(io_rNode, Table::c_RigidBodyOrientation, i_rTarget, 3);
		if (!i_rTarget.m_Covariance.empty())
			WriteReals(io_rNode, Table::c_RigidBodyCovariance,
			    std::span(i_rTarget.m_Covariance).first(i_rKind.m_CovarianceSize));
	}
	if (bPoint || bRotation)
		WriteReal(io_rNode, Table::c_CalibrationWeight, i_rTarget.m_CalibrationWeight);
	if (i_rKind.HasObservation())
	{
		WriteState(io_rNode, *i_rKind.m_pState, i_rTarget, 0);
		WriteReal(io_rNode, *i_rKind.m_pWeight, i_rTarget.m_Weight);
		const std::uint32_t observation = i_rTarget.m_RotationObservationIndices[0];
		if (observation < io_rWriting.m_rSubject.m_Rotations.size())
			WriteText(io_rNode, *i_rKind.m_pObservation, io_rWriting.m_rSubject.m_Rotations[observation].m_Name);
		else
			AddTargetError(io_rNode, rName, "refers to a rotation observation that does not exist.");
	}
	if (bRotation)
		WriteCalibrationAxes(io_rNode, io_rWriting, i_rTarget, rName, i_rAxisAsRead);
	WriteColourOrCount(io_rNode, io_rWriting, Table::c_Colour, i_rApplicationData.m_Colour);
	if (const std::string* const pName = NameOfSegment(io_rNode, io_rWriting, i_rTarget.m_SegmentIndices[0]))
		WriteText(io_rNode, Table::c_Segment, *pName);
	if (i_rKind.HasMarker())
	{
		WriteReal(io_rNode, Table::c_MarkerWeight, i_rTarget.m_Weight);
		if (!i_rTarget.m_ViewNormals.empty())
			WriteReals(io_rNode, Table::c_ViewNormal, i_rTarget.m_ViewNormals[0]);
	}
	if (i_rKind.HasMarker() || bRigidBody)
		WriteEnum(io_rNode, Table::c_DrawStyle, EnumTables::TargetDrawStyle(), i_rApplicationData.m_DrawStyle);

	if (i_rKind.HasMarker())
		WriteElement(io_rNode, *i_rKind.m_pTemplate,
		    [&](VWriterNode& io_rTemplate)
		    { WriteReals(io_rTemplate, *i_rKind.m_pTemplateCovariance, i_rTarget.m_TemplateCovariance); });
	else
		for (std::size_t i = 0; i < i_rTarget.m_MarkerIndices.size(); ++i)
			WriteElement(io_rNode, Table::c_RigidBodyMarker,
			    [&](VWriterNode& io_rMarker) { WriteRigidBodyMarker(io_rMarker, io_rWriting, i_rKind, i_rTarget, i); });
}

} // namespace

void WriteTargetSet(VWriterNode& io_rNode, VWriting& io_rWriting)
{
	const auto& rTargets = io_rWriting.m_rSubject.m_Targets;
	WriteElement(io_rNode, Format::TargetSet::c_Targets,
	    [&](VWriterNode& io_rSection)
	    {
		    VRecordsByName<VSubjectQRTExtras::VTarget> extras(io_rWriting.m_rExtras.m_Targets);
		    for (std::size_t i = 0; i < rTargets.size(); ++i)
		    {
			    const VTarget& rTarget = rTargets[i];
			    const VSubjectApplicationData::VTarget& rApplicationData =
			        RecordOrDefault(io_rWriting.m_rApplicationData.m_Targets, i);
			    const VTargetKind* const pKind =
			        FindTargetKind([&](const VTargetKind& i_rKind) { return i_rKind.Is(rTarget.m_Type); });
			    if (!pKind)
			    {
				    AddTargetError(io_rSection, rApplicationData.m_Name, "has a type that a file cannot hold.");
				    continue;
			    }
			    // Before its observation could be told, such a target would come back without one.
			    if (pKind->HasObservation() && !IsInVersion(io_rSection, *pKind->m_pObservation))
				    continue;
			    const VSubjectQRTExtras::VTarget* const pExtras = extras.Find(i, rApplicationData.m_Name);
			    WriteElement(io_rSection, pKind->m_rElement,
			        [&](VWriterNode& io_rTarget)
			        {
				        WriteTarget(io_rTarget, io_rWriting, *pKind, rTarget, rApplicationData,
				            pExtras ? pExtras->m_Axis : std::vector<double>());
			        });
		    }
	    });
}

} // namespace CoreOrlexQRTIO
