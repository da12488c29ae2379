#include "CoreOrlexQRTIO/format/EnumTables.h"
#include "CoreOrlexQRTIO/format/FormatFunctions.h"
#include "CoreOrlexQRTIO/format/FormatTable.h"
#include "CoreOrlexQRTIO/read/AttributeReading.h"
#include "CoreOrlexQRTIO/values/JointGeometry.h"
#include "CoreOrlexTypes/NameHash.h"

#include <boost/format.hpp>

namespace CoreOrlexQRTIO
{
namespace
{

using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using UtilsRapidXml::INode;
using UtilsRapidXml::ReadAttribute;
using UtilsRapidXml::ReadList;

inline constexpr std::uint32_t c_BadId = 0xFFFFFFFFu;

/// A normal shorter than this has no direction.
inline constexpr double c_ShortestNormal = 0.001;

/// A marker while its element is read. Up to 2.6 a marker stands on a segment, and is a point target too.
struct VMarkerInHand
{
	VSubjectParametrised::VMarker m_Marker;
	VSubjectApplicationData::VMarker m_ApplicationData;
	VSubjectQRTExtras::VMarker m_Extras;
	VSubjectParametrised::VTarget m_Target;
	bool m_bPosition = false;
};

void FormatMarkerTemplate(INode& io_rNode, VMarkerInHand& io_rMarker)
{
	namespace Table = Format::MarkerTemplate;
	std::array<std::string, 3> position;
	if (ReadExpressions(io_rNode, Table::c_Position, position))
	{
		if (io_rMarker.m_bPosition)
		{
			io_rMarker.m_Extras.m_Position = io_rMarker.m_Target.m_StateExpressions;
			io_rMarker.m_Extras.m_TemplatePosition.assign(position.begin(), position.end());
		}
		io_rMarker.m_Target.m_StateExpressions.assign(position.begin(), position.end());
	}
	ReadList(io_rNode, Table::c_Covariance, 9, io_rMarker.m_Target.m_TemplateCovariance);
	ReadAttribute(io_rNode, Table::c_PlacementCovariance, io_rMarker.m_Extras.m_TemplatePlacementCovariance);
}

void FormatMarker(INode& io_rNode, VReading& io_rReading)
{
	namespace Table = Format::Marker;
	const std::size_t errors = io_rNode.GetErrorCount();
	VMarkerInHand inHand;
	auto& [rMarker, rApplicationData, rExtras, rTarget, bPosition] = inHand;

	const auto index = static_cast<std::uint32_t>(io_rReading.m_rSubject.m_Markers.size());
	std::string_view name;
	const bool bNamed = ReadAttribute(io_rNode, Table::c_Name, name);
	rMarker.m_Name = name;
	rMarker.m_MarkerId = index;
	if (io_rReading.m_bHashedIds && bNamed)
	{
		rMarker.m_MarkerId = CoreOrlexTypes::HashName(rMarker.m_Name);
		if (io_rReading.m_MarkerIds.count(rMarker.m_MarkerId))
		{
			io_rNode.AddError(
			    (boost::format("Marker %1% has encountered an ID hash collision") % rMarker.m_Name).str());
			rMarker.m_MarkerId = c_BadId;
		}
	}

	std::string_view segment;
	const bool bOnSegment = ReadAttribute(io_rNode, Table::c_Segment, segment);
	if (bOnSegment)
	{
		const auto it = io_rReading.m_SegmentsByName.find(segment);
		if (it != io_rReading.m_SegmentsByName.end())
			rTarget.m_SegmentIndices.push_back(it->second);
		else
			io_rNode.AddError(
			    (boost::format("Marker %1% is using unknown segment %2%") % rMarker.m_Name % segment).str());
	}
	rTarget.m_StateExpressions.assign(3, "0");
	bPosition = ReadExpressions(io_rNode, Table::c_Position, rTarget.m_StateExpressions);
	ReadList(io_rNode, Table::c_Covariance, 9, rTarget.m_Covariance);
	ReadAttribute(io_rNode, Table::c_Radius, rMarker.m_Radius);
	ReadColour(io_rNode, Table::c_Colour, rApplicationData.m_Colour);
	ReadAttribute(io_rNode, Table::c_Descriptor, rExtras.m_Descriptor);
	Process(
	    io_rNode, Table::c_MarkerTemplate, [&](INode& io_rTemplate) { FormatMarkerTemplate(io_rTemplate, inHand); });
	std::uint32_t status = rMarker.m_Status;
	ReadAttribute(io_rNode, Table::c_Status, EnumTables::Status(), status);
	rMarker.m_Missing = (status & EnumTables::c_StatusMissing) != 0;
	rMarker.m_Status = static_cast<VSubjectParametrised::VMarker::EMarkerStatus>(status & ~EnumTables::c_StatusMissing);
	Rotation::VVector3 normal{};
	if (ReadList(io_rNode, Table::c_ViewNormal, 3, normal.data()) && Length(normal) >= c_ShortestNormal)
		normal = Normalised(normal);
	ReadAttribute(io_rNode, Table::c_ViewAngle, rMarker.m_ViewAngle);

	if (io_rNode.GetErrorCount() != errors)
		return;
	if (bOnSegment)
	{
		rTarget.m_Type = VSubjectParametrised::VTarget::ELocalPointToWorldPoint;
		rTarget.m_MarkerIndices.push_back(index);
		rTarget.m_ViewNormals.push_back(normal);
		VSubjectApplicationData::VTarget applicationData;
		applicationData.m_Name = rMarker.m_Name;
		applicationData.m_Colour = rApplicationData.m_Colour;
		io_rReading.m_rSubject.m_Targets.push_back(std::move(rTarget));
		io_rReading.m_rApplicationData.m_Targets.push_back(std::move(applicationData));
		io_rReading.m_rExtras.m_Targets.push_back({rMarker.m_Name, {}});
	}
	rExtras.m_Name = rMarker.m_Name;
	io_rReading.m_MarkersByName.emplace(name, index);
	if (io_rReading.m_bHashedIds)
		io_rReading.m_MarkerIds.insert(rMarker.m_MarkerId);
	io_rReading.m_rSubject.m_Markers.push_back(std::move(rMarker));
	io_rReading.m_rApplicationData.m_Markers.push_back(rApplicationData);
	io_rReading.m_rExtras.m_Markers.push_back(std::move(rExtras));
}

bool ReadStickMarker(INode& io_rNode, const Format::VAttribute& i_rAttribute, const VIndexByName& i_rMarkers,
    std::string_view& o_rName, std::uint32_t& o_rIndex)
{
	if (!ReadAttribute(io_rNode, i_rAttribute, o_rName))
		return false;
	const auto it = i_rMarkers.find(o_rName);
	if (it == i_rMarkers.end())
	{
		io_rNode.AddError((boost::format("Sticks is using unknown marker %1%") % o_rName).str());
		return false;
	}
	o_rIndex = it->second;
	return true;
}

void FormatStick(INode& io_rNode, VReading& io_rReading)
{
	namespace Table = Format::Stick;
	const std::size_t errors = io_rNode.GetErrorCount();
	VSubjectApplicationData::VStick stick;
	std::string_view name;
	const VIndexByName& rMarkers = io_rReading.m_MarkersByName;
	const bool bFirst = ReadStickMarker(io_rNode, Table::c_Marker1, rMarkers, name, stick.m_MarkerIndexA);
	const bool bSecond = ReadStickMarker(io_rNode, Table::c_Marker2, rMarkers, name, stick.m_MarkerIndexB);
	const bool bToItself = bFirst && bSecond && stick.m_MarkerIndexA == stick.m_MarkerIndexB;
	if (bToItself)
		io_rNode.AddWarning((boost::format("Skipped Stick using marker %1% for MARKER1 and MARKER2") % name).str());
	if (ReadColour(io_rNode, Table::c_Colour, stick.m_ColourA))
		stick.m_ColourB = stick.m_ColourA;
	ReadColour(io_rNode, Table::c_Colour1, stick.m_ColourA);
	ReadColour(io_rNode, Table::c_Colour2, stick.m_ColourB);
	if (io_rNode.GetErrorCount() == errors && !bToItself)
		io_rReading.m_rApplicationData.m_Sticks.push_back(stick);
}

} // namespace

void FormatMarkerSet(INode& io_rNode, VReading& io_rReading)
{
	namespace Table = Format::MarkerSet;
	ReadAttribute(io_rNode, Table::c_Name, io_rReading.m_rSubject.m_MarkerSetName);
	Process(io_rNode, Table::c_Markers,
	    [&](INode& io_rMarkers)
	    { Process(io_rMarkers, Table::c_Marker, [&](INode& io_rMarker) { FormatMarker(io_rMarker, io_rReading); }); });
	Process(io_rNode, Table::c_Sticks,
	    [&](INode& io_rSticks)
	    { Process(io_rSticks, Table::c_Stick, [&](INode& io_rStick) { FormatStick(io_rStick, io_rReading); }); });
}

} // namespace CoreOrlexQRTIO
