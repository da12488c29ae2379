#include "RetargetSetupCore/RetargetTargets.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypes/Fields.h"
#include "CoreOrlexTypes/NameHash.h"
#include "CoreOrlexTypesUtils/observations/UnusedObservations.h"
#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/StateExpressions.h"
#include "RetargetSetupCore/TargetConstruction.h"

#include <boost/algorithm/string/classification.hpp>
#include <boost/algorithm/string/erase.hpp>
#include <boost/algorithm/string/trim.hpp>

#include <algorithm>
#include <unordered_map>

using ComputeSubject::VComputeSubjectFK;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using VTarget = CoreOrlexTypes::VSubjectParametrised::VTarget;

namespace RetargetSetup
{

namespace
{

/// The name of the element that the first of the indices tells.
template <typename TElement>
const std::string* FirstName(const std::vector<std::uint32_t>& i_rIndices, const std::vector<TElement>& i_rElements)
{
	return i_rIndices.empty() || i_rIndices.front() >= i_rElements.size() ? nullptr
	                                                                      : &i_rElements[i_rIndices.front()].m_Name;
}

template <typename TElement>
std::uint32_t FindName(const std::vector<TElement>& i_rElements, const std::string& i_rName)
{
	const auto found = std::find_if(i_rElements.begin(), i_rElements.end(),
	    [&i_rName](const TElement& i_rElement) { return i_rElement.m_Name == i_rName; });
	return std::uint32_t(found - i_rElements.begin());
}

Rotation::VPose<double> SourceInTarget(const VComputeSubjectFK& i_rSourceFK, const VComputeSubjectFK& i_rTargetFK,
    std::size_t i_SourceSegmentIndex, std::size_t i_TargetSegmentIndex)
{
	return Rotation::Relative(i_rTargetFK.Segment(i_TargetSegmentIndex).SegmentPose(),
	    i_rSourceFK.Segment(i_SourceSegmentIndex).SegmentPose());
}

} // namespace

std::string TargetKindName(VTarget::ETargetType i_Type)
{
	std::string kind(CoreOrlexTypes::EnumeratorName(i_Type));
	if (kind.starts_with("Local"))
		kind.erase(0, 5);
	kind.erase(std::min(kind.find("To"), kind.size()));
	return kind == "Point" ? "Position" : kind;
}

const std::string* SourceName(const VSubjectParametrised& i_rSubject, const VTarget& i_rTarget)
{
	return i_rTarget.m_Type == VTarget::ELocalPointToWorldPoint
	    ? FirstName(i_rTarget.m_MarkerIndices, i_rSubject.m_Markers)
	    : FirstName(i_rTarget.m_RotationObservationIndices, i_rSubject.m_Rotations);
}

const std::string* TargetSegmentName(const VSubjectParametrised& i_rSubject, const VTarget& i_rTarget)
{
	return FirstName(i_rTarget.m_SegmentIndices, i_rSubject.m_Segments);
}

std::int32_t FindTargetPair(const VSubjectParametrised& i_rSubject, const std::string& i_rSourceName,
    std::size_t i_TargetSegmentIndex, bool i_bPosition)
{
	const auto type = i_bPosition ? VTarget::ELocalPointToWorldPoint : VTarget::ELocalRotationToWorldRotation;
	const auto isPair = [&](const VTarget& i_rTarget)
	{
		const std::string* const pSource = SourceName(i_rSubject, i_rTarget);
		return i_rTarget.m_Type == type && pSource && *pSource == i_rSourceName && !i_rTarget.m_SegmentIndices.empty()
		    && i_rTarget.m_SegmentIndices.front() == i_TargetSegmentIndex;
	};
	const auto found = std::find_if(i_rSubject.m_Targets.begin(), i_rSubject.m_Targets.end(), isPair);
	return found == i_rSubject.m_Targets.end() ? -1 : std::int32_t(found - i_rSubject.m_Targets.begin());
}

std::uint32_t FindOrAddMarker(
    VSubjectParametrised& io_rSubject, VSubjectApplicationData& io_rApplicationData, const std::string& i_rName)
{
	const std::uint32_t index = FindName(io_rSubject.m_Markers, i_rName);
	if (index < io_rSubject.m_Markers.size())
		return index;
	VSubjectParametrised::VMarker& rMarker = io_rSubject.m_Markers.emplace_back();
	rMarker.m_Name = i_rName;
	rMarker.m_MarkerId = CoreOrlexTypes::HashName(i_rName);
	io_rApplicationData.m_Markers.resize(io_rSubject.m_Markers.size());
	return index;
}

std::uint32_t FindOrAddRotation(VSubjectParametrised& io_rSubject, VSubjectApplicationData&, const std::string& i_rName)
{
	const std::uint32_t index = FindName(io_rSubject.m_Rotations, i_rName);
	if (index == io_rSubject.m_Rotations.size())
		io_rSubject.m_Rotations.push_back({i_rName, CoreOrlexTypes::HashName(i_rName)});
	return index;
}

void AddTargetPair(const VComputeSubjectFK& i_rSourceFK, const VComputeSubjectFK& i_rTargetFK,
    std::size_t i_SourceSegmentIndex, std::size_t i_TargetSegmentIndex, bool i_bPosition,
    const VSubjectParametrised& i_rSource, VSubjectParametrised& io_rTarget,
    VSubjectApplicationData& io_rApplicationData)
{
	const std::string& rSourceName = i_rSource.m_Segments[i_SourceSegmentIndex].m_Name;
	VTarget& rTarget = io_rTarget.m_Targets.emplace_back();
	rTarget.m_SegmentIndices = {std::uint32_t(i_TargetSegmentIndex)};
	rTarget.m_StateExpressions.assign(3, "0");
	if (i_bPosition)
	{
		rTarget.m_Type = VTarget::ELocalPointToWorldPoint;
		rTarget.m_MarkerIndices = {FindOrAddMarker(io_rTarget, io_rApplicationData, rSourceName)};
		rTarget.m_ViewNormals.resize(1);
	}
	else
	{
		rTarget.m_Type = VTarget::ELocalRotationToWorldRotation;
		rTarget.m_RotationObservationIndices = {FindOrAddRotation(io_rTarget, io_rApplicationData, rSourceName)};
	}
	io_rApplicationData.m_Targets.resize(io_rTarget.m_Targets.size());
	VSubjectApplicationData::VTarget& rData = io_rApplicationData.m_Targets.back();
	rData.m_Name = rSourceName + (i_bPosition ? ">" : "}") + io_rTarget.m_Segments[i_TargetSegmentIndex].m_Name;
	rData.m_Colour = c_MadeHereColour;

	if (io_rTarget.m_DynamicParameters.empty())
		TellNoDynamicParameter("The offset of target '" + rData.m_Name + "' stays 0");
	UpdateTargetState(io_rTarget, SourceInTarget(i_rSourceFK, i_rTargetFK, i_SourceSegmentIndex, i_TargetSegmentIndex),
	    io_rTarget.m_Targets.size() - 1);
}

void UpdateTargetStates(const VComputeSubjectFK& i_rSourceFK, const VComputeSubjectFK& i_rTargetFK,
    const VSubjectParametrised& i_rSource, VSubjectParametrised& io_rTarget)
{
	if (io_rTarget.m_DynamicParameters.empty() && !io_rTarget.m_Targets.empty())
		TellNoDynamicParameter("No offset was updated");
	std::unordered_map<std::string_view, std::size_t> sourceSegments;
	for (std::size_t i = 0; i < i_rSource.m_Segments.size(); ++i)
		sourceSegments.emplace(i_rSource.m_Segments[i].m_Name, i);
	for (std::size_t i = 0; i < io_rTarget.m_Targets.size(); ++i)
	{
		const VTarget& rTarget = io_rTarget.m_Targets[i];
		const std::string* const pSource = SourceName(io_rTarget, rTarget);
		if (!pSource || !TargetSegmentName(io_rTarget, rTarget))
		{
			NVX_LOG(c_LogCategory, NVX::ELogWarning,
			    "Target %1% keeps its offset: it names no source, or no segment, that is there", i);
			continue;
		}
		const auto found = sourceSegments.find(*pSource);
		if (found == sourceSegments.end())
		{
			NVX_LOG(c_LogCategory, NVX::ELogWarning,
			    "Target %1% keeps its offset: the source subject has no segment '%2%'", i, *pSource);
			continue;
		}
		UpdateTargetState(
		    io_rTarget, SourceInTarget(i_rSourceFK, i_rTargetFK, found->second, rTarget.m_SegmentIndices.front()), i);
	}
}

void RemoveTarget(
    VSubjectParametrised& io_rSubject, VSubjectApplicationData& io_rApplicationData, std::size_t i_TargetIndex)
{
	io_rSubject.m_Targets.erase(io_rSubject.m_Targets.begin() + std::ptrdiff_t(i_TargetIndex));
	if (i_TargetIndex < io_rApplicationData.m_Targets.size())
		io_rApplicationData.m_Targets.erase(io_rApplicationData.m_Targets.begin() + std::ptrdiff_t(i_TargetIndex));
	CoreOrlexTypesUtils::RemoveUnusedMarkers(io_rSubject, io_rApplicationData);
	CoreOrlexTypesUtils::RemoveUnusedRotations(io_rSubject);
}

std::string SideNeutralName(std::string i_Name)
{
	for (const char* const pSide : {"Left", "left", "Right", "right"})
		boost::algorithm::erase_all(i_Name, pSide);
	boost::algorithm::trim_if(i_Name, boost::algorithm::is_any_of("lLrR"));
	return i_Name;
}

std::int32_t FindMirrorSegment(const VSubjectParametrised& i_rSubject, std::size_t i_SegmentIndex)
{
	if (i_SegmentIndex >= i_rSubject.m_Segments.size())
		return -1;
	const std::string name = SideNeutralName(i_rSubject.m_Segments[i_SegmentIndex].m_Name);
	for (std::size_t i = 0; i < i_rSubject.m_Segments.size(); ++i)
		if (i != i_SegmentIndex && SideNeutralName(i_rSubject.m_Segments[i].m_Name) == name)
			return std::int32_t(i);
	return -1;
}

} // namespace RetargetSetup
