#include "CoreOrlexQRTIO/format/EnumTables.h"
#include "CoreOrlexQRTIO/format/FormatTable.h"
#include "CoreOrlexQRTIO/write/AttributeWriting.h"
#include "CoreOrlexQRTIO/write/WriteSections.h"

namespace CoreOrlexQRTIO
{
namespace
{

using CoreOrlexTypes::VSubjectApplicationData;
using UtilsRapidXml::VWriterNode;
using VMarker = CoreOrlexTypes::VSubjectParametrised::VMarker;
using VTarget = CoreOrlexTypes::VSubjectParametrised::VTarget;

/// For each marker the first point target that is its alone; null if there is none.
std::vector<const VTarget*> PointTargets(const VWriting& i_rWriting)
{
	std::vector<const VTarget*> targets(i_rWriting.m_rSubject.m_Markers.size());
	for (const VTarget& rTarget : i_rWriting.m_rSubject.m_Targets)
		if ((rTarget.m_Type == VTarget::ELocalPointToWorldPoint
		        || rTarget.m_Type == VTarget::ELocalPointToWorldPointGaussian)
		    && rTarget.m_MarkerIndices.size() == 1 && rTarget.m_MarkerIndices[0] < targets.size()
		    && rTarget.m_SegmentIndices.size() == 1 && rTarget.m_StateExpressions.size() == 3
		    && !targets[rTarget.m_MarkerIndices[0]])
			targets[rTarget.m_MarkerIndices[0]] = &rTarget;
	return targets;
}

void WriteMarker(VWriterNode& io_rNode, VWriting& io_rWriting, const VMarker& i_rMarker,
    const VSubjectApplicationData::VMarker& i_rApplicationData, const VSubjectQRTExtras::VMarker& i_rExtras,
    const VTarget* i_pTarget)
{
	namespace Table = Format::Marker;
	WriteText(io_rNode, Table::c_Name, i_rMarker.m_Name);
	std::vector<std::string> position;
	if (i_pTarget && IsInVersion(io_rNode, Table::c_Segment))
	{
		if (const std::string* const pName = NameOfSegment(io_rNode, io_rWriting, i_pTarget->m_SegmentIndices[0]))
			WriteText(io_rNode, Table::c_Segment, *pName);
		position = WritableExpressions(io_rWriting, i_pTarget->m_StateExpressions);
		// The marker's own position is what a reader holds where there is no template to tell the target's.
		const bool bAsRead = IsInVersion(io_rNode, Table::c_MarkerTemplate) && !i_rExtras.m_Position.empty()
		    && i_rExtras.m_TemplatePosition == i_pTarget->m_StateExpressions;
		WriteExpressions(io_rNode, Table::c_Position, bAsRead ? i_rExtras.m_Position : position);
		WriteReals(io_rNode, Table::c_Covariance, i_pTarget->m_Covariance);
	}
	WriteReal(io_rNode, Table::c_Radius, i_rMarker.m_Radius);
	WriteColourOrCount(io_rNode, io_rWriting, Table::c_Colour, i_rApplicationData.m_Colour);
	WriteText(io_rNode, Table::c_Descriptor, i_rExtras.m_Descriptor);
	WriteEnum(io_rNode, Table::c_Status, EnumTables::Status(),
	    static_cast<std::uint32_t>(i_rMarker.m_Status) | (i_rMarker.m_Missing ? EnumTables::c_StatusMissing : 0));
	if (i_pTarget && !i_pTarget->m_ViewNormals.empty())
		WriteReals(io_rNode, Table::c_ViewNormal, i_pTarget->m_ViewNormals[0]);
	WriteReal(io_rNode, Table::c_ViewAngle, i_rMarker.m_ViewAngle);
	if (i_pTarget)
		WriteElement(io_rNode, Table::c_MarkerTemplate,
		    [&](VWriterNode& io_rTemplate)
		    {
			    WriteExpressions(io_rTemplate, Format::MarkerTemplate::c_Position, position);
			    WriteReals(io_rTemplate, Format::MarkerTemplate::c_Covariance, i_pTarget->m_TemplateCovariance);
			    WriteText(io_rTemplate, Format::MarkerTemplate::c_PlacementCovariance,
			        i_rExtras.m_TemplatePlacementCovariance);
		    });
}

void WriteStick(VWriterNode& io_rNode, VWriting& io_rWriting, const VSubjectApplicationData::VStick& i_rStick)
{
	namespace Table = Format::Stick;
	const std::string* const pFirst = NameOfMarker(io_rNode, io_rWriting, i_rStick.m_MarkerIndexA);
	const std::string* const pSecond = NameOfMarker(io_rNode, io_rWriting, i_rStick.m_MarkerIndexB);
	if (!pFirst || !pSecond)
		return;
	WriteText(io_rNode, Table::c_Marker1, *pFirst);
	WriteText(io_rNode, Table::c_Marker2, *pSecond);
	WriteColour(io_rNode, Table::c_Colour, i_rStick.m_ColourA);
	WriteColour(io_rNode, Table::c_Colour1, i_rStick.m_ColourA);
	WriteColour(io_rNode, Table::c_Colour2, i_rStick.m_ColourB);
}

} // namespace

void WriteMarkerSet(VWriterNode& io_rNode, VWriting& io_rWriting)
{
	namespace Table = Format::MarkerSet;
	const auto& rMarkers = io_rWriting.m_rSubject.m_Markers;
	const VSubjectApplicationData& rApplicationData = io_rWriting.m_rApplicationData;
	WriteText(io_rNode, Table::c_Name, io_rWriting.m_rSubject.m_MarkerSetName);
	WriteElement(io_rNode, Table::c_Markers,
	    [&](VWriterNode& io_rSection)
	    {
		    const std::vector<const VTarget*> targets = PointTargets(io_rWriting);
		    VRecordsByName<VSubjectQRTExtras::VMarker> extras(io_rWriting.m_rExtras.m_Markers);
		    const VSubjectQRTExtras::VMarker none;
		    for (std::size_t i = 0; i < rMarkers.size(); ++i)
		    {
			    const VSubjectQRTExtras::VMarker* const pExtras = extras.Find(i, rMarkers[i].m_Name);
			    WriteElement(io_rSection, Table::c_Marker,
			        [&](VWriterNode& io_rMarker)
			        {
				        WriteMarker(io_rMarker, io_rWriting, rMarkers[i],
				            RecordOrDefault(rApplicationData.m_Markers, i), pExtras ? *pExtras : none, targets[i]);
			        });
		    }
	    });
	WriteElement(io_rNode, Table::c_Sticks,
	    [&](VWriterNode& io_rSection)
	    {
		    for (const VSubjectApplicationData::VStick& rStick : rApplicationData.m_Sticks)
			    WriteElement(io_rSection, Table::c_Stick,
			        [&](VWriterNode& io_rStick) { WriteStick(io_rStick, io_rWriting, rStick); });
	    });
}

} // namespace CoreOrlexQRTIO
