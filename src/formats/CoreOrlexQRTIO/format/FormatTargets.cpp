#include "CoreOrlexQRTIO/format/EnumTables.h"
#include "CoreOrlexQRTIO/format/FormatFunctions.h"
#include "CoreOrlexQRTIO/format/TargetKinds.h"
#include "CoreOrlexQRTIO/read/AttributeReading.h"
#include "CoreOrlexQRTIO/values/JointGeometry.h"
#include "CoreOrlexTypes/NameHash.h"

#include <boost/format.hpp>

namespace CoreOrlexQRTIO
{
namespace
{

namespace Table = Format::Target;
using CoreOrlexTypes::VSubjectApplicationData;
using UtilsRapidXml::INode;
using UtilsRapidXml::ReadAttribute;
using UtilsRapidXml::ReadList;
using VTarget = CoreOrlexTypes::VSubjectParametrised::VTarget;

/// A target while its element is read.
struct VTargetInHand
{
	VTarget m_Target;
	VSubjectApplicationData::VTarget m_ApplicationData;
	std::vector<double> m_Axis;
};

/// Three expressions of the state from an offset on.
void ReadState(INode& io_rNode, const Format::VAttribute& i_rAttribute, VTarget& io_rTarget, std::size_t i_Offset)
{
	ReadExpressions(io_rNode, i_rAttribute, std::span(io_rTarget.m_StateExpressions).subspan(i_Offset, 3));
}

/// Reads a name and appends the index that it stands for.
void ReadReference(INode& io_rNode, const Format::VAttribute& i_rAttribute, const VIndexByName& i_rNames,
    const char* i_pUnknown, std::vector<std::uint32_t>& io_rIndices)
{
	std::string_view name;
	if (!ReadAttribute(io_rNode, i_rAttribute, name))
		return;
	const auto it = i_rNames.find(name);
	if (it != i_rNames.end())
		io_rIndices.push_back(it->second);
	else
		io_rNode.AddError((boost::format(i_pUnknown) % name).str());
}

void ReadObservation(INode& io_rNode, const VTargetKind& i_rKind, VReading& io_rReading, VTargetInHand& io_rInHand)
{
	std::string_view name;
	if (!ReadAttribute(io_rNode, *i_rKind.m_pObservation, name))
		return;
	std::vector<std::uint32_t>& rIndices = io_rInHand.m_Target.m_RotationObservationIndices;
	if (!rIndices.empty())
	{
		io_rNode.AddError(
		    (boost::format("Target %1% has multiple Rotation Observations") % io_rInHand.m_ApplicationData.m_Name)
		        .str());
		return;
	}
	auto& rRotations = io_rReading.m_rSubject.m_Rotations;
	const auto index = static_cast<std::uint32_t>(rRotations.size());
	const auto known = io_rReading.m_RotationsByName.find(name);
	if (known != io_rReading.m_RotationsByName.end())
	{
		rIndices.push_back(known->second);
		return;
	}
	const std::uint32_t id = io_rReading.m_bHashedIds ? CoreOrlexTypes::HashName(name) : index;
	if (!io_rReading.m_RotationIds.insert(id).second)
	{
		io_rNode.AddError(
		    (boost::format("Rotation observation %1% has encountered an ID hash collision") % name).str());
		return;
	}
	io_rReading.m_RotationsByName.emplace(name, index);
	rRotations.push_back({std::string(name), id});
	rIndices.push_back(index);
}

/// The axes of a rotation target, which tell how a calibration may turn it.
void ReadCalibrationAxes(INode& io_rNode, VTargetInHand& io_rInHand)
{
	VTarget& rTarget = io_rInHand.m_Target;
	std::vector<double> axis;
	std::vector<double> pair;
	const bool bAxis = ReadList(io_rNode, Table::c_Axis, 3, axis);
	const bool bPair = ReadList(io_rNode, Table::c_AxisPair, 6, pair);
	if (!bAxis && !bPair)
		return;
	const auto refuse = [&](const char* i_pFormat)
	{ io_rNode.AddError((boost::format(i_pFormat) % io_rInHand.m_ApplicationData.m_Name).str()); };
	if (bAxis && bPair)
		return refuse(" Target '%s' AXIS and AXIS-PAIR are mutually exclusive");

	io_rInHand.m_Axis = bAxis ? std::move(axis) : std::move(pair);
	Rotation::VVector3 orientation{};
	switch (TargetOrientation(io_rInHand.m_Axis, orientation))
	{
	case EAxesResult::Fine: break;
	case EAxesResult::ZeroLength: return refuse(" Target '%s' AXIS or AXIS-PAIR has a 0-magnitude vector");
	case EAxesResult::NotOrthogonal: return refuse(" Target '%s'AXIS-PAIR has non-orthogonal axes");
	default: return refuse(" Target '%s' has undefined calibration behaviour");
	}
	rTarget.m_RotationCalibrationBehaviour = bAxis ? VTarget::EHingeLike : VTarget::EHardySpicerLike;
	rTarget.m_RotationTargetOrientation.assign(orientation.begin(), orientation.end());
}

void FormatRigidBodyMarker(INode& io_rNode, const VReading& i_rReading, VTarget& io_rTarget)
{
	namespace MarkerTable = Format::RigidBodyMarker;
	ReadReference(io_rNode, MarkerTable::c_Name, i_rReading.m_MarkersByName,
	    "RigidBodyMarker refers to unknown marker %1%", io_rTarget.m_MarkerIndices);
	const std::size_t stateSize = io_rTarget.m_StateExpressions.size();
	io_rTarget.m_StateExpressions.resize(stateSize + 3, "0");
	ReadState(io_rNode, MarkerTable::c_Position, io_rTarget, stateSize);
	const std::size_t covarianceSize = io_rTarget.m_Covariance.size();
	io_rTarget.m_Covariance.resize(covarianceSize + 9);
	ReadList(io_rNode, MarkerTable::c_Covariance, 9, io_rTarget.m_Covariance.data() + covarianceSize);
	io_rTarget.m_ViewNormals.emplace_back();
	ReadList(io_rNode, MarkerTable::c_ViewNormal, 3, io_rTarget.m_ViewNormals.back().data());
}

void FormatTarget(INode& io_rNode, VReading& io_rReading)
{
	const VTargetKind* const pKind =
	    FindTargetKind([&](const VTargetKind& i_rKind) { return i_rKind.m_rElement.m_Name == io_rNode.GetName(); });
	if (!pKind)
		return;
	const VTargetKind& rKind = *pKind;
	const bool bLine = rKind.m_Type == VTarget::ELocalLineToWorldPoint;
	const bool bPlane = rKind.m_Type == VTarget::ELocalPlaneToWorldPoint;
	const bool bPoint = rKind.m_Type == VTarget::ELocalPointToWorldPoint;
	const bool bRigidBody = rKind.m_Type == VTarget::ERigidBody;
	const bool bRotation = rKind.m_Type == VTarget::ELocalRotationToWorldRotation;

	const std::size_t errors = io_rNode.GetErrorCount();
	VTargetInHand inHand;
	VTarget& rTarget = inHand.m_Target;
	VSubjectApplicationData::VTarget& rApplicationData = inHand.m_ApplicationData;
	rTarget.m_Type = rKind.m_Type;
	rTarget.m_StateExpressions.assign(rKind.m_StateSize, "0");
	rTarget.m_Covariance.assign(rKind.m_CovarianceSize, 0.0);

	if (rKind.HasMarker())
		ReadReals(io_rNode, *rKind.m_pCovariance, rTarget.m_Covariance);
	if (bPoint)
		ReadReals(io_rNode, Table::c_PlacementCovariance, rTarget.m_PlacementCovariance);
	if (bLine)
		ReadState(io_rNode, Table::c_LineDirection, rTarget, 3);
	if (rKind.HasMarker())
	{
		ReadAttribute(io_rNode, Table::c_FillGaps, rApplicationData.m_FillGaps);
		bool bGaussian = !rTarget.m_Covariance.empty();
		if (ReadAttribute(io_rNode, Table::c_Gaussian, bGaussian) && bGaussian && rTarget.m_Covariance.empty())
			io_rNode.AddError("Gaussian target did not supply a COVARIANCE");
		if (bGaussian)
			rTarget.m_Type = rKind.m_GaussianType;
	}
	ReadHidden(io_rNode, Table::c_Hidden, rApplicationData.m_Visible);
	ReadAttribute(io_rNode, Table::c_Name, rApplicationData.m_Name);
	if (bPlane)
		ReadState(io_rNode, Table::c_Normal, rTarget, 3);
	if (rKind.HasMarker())
		ReadReference(io_rNode, Table::c_Marker, io_rReading.m_MarkersByName, "Target is using unknown marker %1%",
		    rTarget.m_MarkerIndices);
	std::uint8_t opacity = 255;
	ReadOpacity(io_rNode, Table::c_Opacity, opacity);
	if (rKind.HasMarker())
		ReadState(io_rNode, *rKind.m_pOrigin, rTarget, 0);
	if (bRigidBody)
	{
		ReadState(io_rNode, Table::c_RigidBodyPosition, rTarget, 0);
		ReadState(io_rNode, Table::c_RigidBodyOrientation, rTarget, 3);
		ReadList(io_rNode, Table::c_RigidBodyCovariance, rKind.m_CovarianceSize, rTarget.m_Covariance.data());
	}
	if (bPoint || bRotation)
		ReadAttribute(io_rNode, Table::c_CalibrationWeight, rTarget.m_CalibrationWeight);
	if (rKind.HasObservation())
	{
		ReadState(io_rNode, *rKind.m_pState, rTarget, 0);
		ReadAttribute(io_rNode, *rKind.m_pWeight, rTarget.m_Weight);
		ReadObservation(io_rNode, rKind, io_rReading, inHand);
	}
	if (bRotation)
		ReadCalibrationAxes(io_rNode, inHand);
	ReadColour(io_rNode, Table::c_Colour, rApplicationData.m_Colour);
	rApplicationData.m_Colour.m_Alpha = opacity;
	ReadReference(io_rNode, Table::c_Segment, io_rReading.m_SegmentsByName, "Target is using unknown segment %1%",
	    rTarget.m_SegmentIndices);
	if (rKind.HasMarker())
	{
		ReadAttribute(io_rNode, Table::c_MarkerWeight, rTarget.m_Weight);
		rTarget.m_ViewNormals.emplace_back();
		ReadList(io_rNode, Table::c_ViewNormal, 3, rTarget.m_ViewNormals.back().data());
	}
	if (rKind.HasMarker() || bRigidBody)
		ReadAttribute(io_rNode, Table::c_DrawStyle, EnumTables::TargetDrawStyle(), rApplicationData.m_DrawStyle);

	if (rKind.HasMarker())
		Process(io_rNode, *rKind.m_pTemplate,
		    [&](INode& io_rTemplate)
		    { ReadReals(io_rTemplate, *rKind.m_pTemplateCovariance, rTarget.m_TemplateCovariance); });
	else
		Process(io_rNode, Table::c_RigidBodyMarker,
		    [&](INode& io_rMarker) { FormatRigidBodyMarker(io_rMarker, io_rReading, rTarget); });

	if (io_rNode.GetErrorCount() != errors)
		return;
	io_rReading.m_rExtras.m_Targets.push_back({rApplicationData.m_Name, std::move(inHand.m_Axis)});
	io_rReading.m_rSubject.m_Targets.push_back(std::move(rTarget));
	io_rReading.m_rApplicationData.m_Targets.push_back(std::move(rApplicationData));
}

} // namespace

void FormatTargetSet(INode& io_rNode, VReading& io_rReading)
{
	Process(io_rNode, Format::TargetSet::c_Targets,
	    [&](INode& io_rTargets)
	    {
		    for (const VTargetKind& rKind : c_TargetKinds)
			    Declare(io_rTargets, rKind.m_rElement);
		    io_rTargets.ProcessElements([&](INode& io_rTarget) { FormatTarget(io_rTarget, io_rReading); });
	    });
}

} // namespace CoreOrlexQRTIO
