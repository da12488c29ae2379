#include "SetupReview/compare/SetupNames.h"

#include "CoreOrlexTypes/NameHash.h"
#include "RetargetSetupCore/RetargetTargets.h"

#include <algorithm>
#include <map>

namespace SetupReview
{
namespace
{

using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using VNames = VSetupNames::VNames;

VNames NamesInOrder(const auto& i_rElements)
{
	VNames names;
	for (const auto& rElement : i_rElements)
		names.push_back(rElement.m_Name);
	return Distinct(std::move(names));
}

std::string NameAt(const VNames& i_rNames, std::uint32_t i_Index)
{
	return i_Index < i_rNames.size() ? i_rNames[i_Index] : "#" + std::to_string(i_Index);
}

std::string ListText(const VNames& i_rNames, const std::vector<std::uint32_t>& i_rIndices)
{
	std::string text;
	for (const std::uint32_t index : i_rIndices)
		text += (text.empty() ? "" : ", ") + NameAt(i_rNames, index);
	return text;
}

std::size_t DepthOf(const VSubjectParametrised& i_rSubject, std::size_t i_Index)
{
	std::size_t depth = 0;
	const std::size_t count = i_rSubject.m_Segments.size();
	for (std::size_t at = i_rSubject.m_Segments[i_Index].m_ParentSegmentIndex; at < count && depth < count; ++depth)
		at = i_rSubject.m_Segments[at].m_ParentSegmentIndex;
	return depth;
}

std::string IdText(std::uint32_t i_Id, const std::string& i_rName, std::size_t i_Index)
{
	return i_Id == CoreOrlexTypes::HashName(i_rName) || i_Id == i_Index ? "by rule" : std::to_string(i_Id);
}

} // namespace

VNames Distinct(VNames i_Names)
{
	std::map<std::string, std::size_t> uses;
	for (std::string& rName : i_Names)
		if (const std::size_t use = ++uses[rName]; use > 1)
			rName += "#" + std::to_string(use);
	return i_Names;
}

const VNames& NamesOf(const VSetupNames& i_rNames, std::string_view i_Element)
{
	return i_Element == "segment" ? i_rNames.m_Segments
	    : i_Element == "marker"   ? i_rNames.m_Markers
	                              : i_rNames.m_Targets;
}

bool Stands(const VSetupNames& i_rNames, const std::string& i_rName, std::string_view i_Element)
{
	return std::ranges::find(NamesOf(i_rNames, i_Element), i_rName) != NamesOf(i_rNames, i_Element).end();
}

VSetupNames::VSetupNames(const VSetup& i_rSetup) : m_rSetup(i_rSetup)
{
	const VSubjectParametrised& rSubject = i_rSetup.m_Record.m_SubjectParametrised;
	m_Segments = NamesInOrder(rSubject.m_Segments);
	m_Markers = NamesInOrder(rSubject.m_Markers);
	m_Rotations = NamesInOrder(rSubject.m_Rotations);
	for (const VSubjectParametrised::VTarget& rTarget : rSubject.m_Targets)
	{
		const std::string markers = ListText(m_Markers, rTarget.m_MarkerIndices);
		const std::string rotations = ListText(m_Rotations, rTarget.m_RotationObservationIndices);
		std::string name = RetargetSetup::TargetKindName(rTarget.m_Type);
		name.append(" ").append(markers).append(markers.empty() || rotations.empty() ? "" : ", ").append(rotations);
		name.append(" > ").append(ListText(m_Segments, rTarget.m_SegmentIndices));
		m_Targets.push_back(std::move(name));
	}
	m_Targets = Distinct(std::move(m_Targets));
}

std::optional<std::string> VSetupNames::Reference(
    std::string_view i_Element, std::string_view i_Field, std::size_t i_Index) const
{
	const VSubjectParametrised& rSubject = m_rSetup.m_Record.m_SubjectParametrised;
	if (i_Element == "segment" && i_Index < rSubject.m_Segments.size())
	{
		const auto& rSegment = rSubject.m_Segments[i_Index];
		if (i_Field == "SegmentIndex")
			return rSegment.m_SegmentIndex == i_Index ? "its place" : std::to_string(rSegment.m_SegmentIndex);
		if (i_Field == "TreeDepth")
			return rSegment.m_TreeDepth == DepthOf(rSubject, i_Index) ? "its depth"
			                                                          : std::to_string(rSegment.m_TreeDepth);
		if (i_Field == "ParentSegmentIndex")
			return rSegment.m_ParentSegmentIndex == CoreOrlexTypes::c_NoParent
			    ? "nothing"
			    : NameAt(m_Segments, rSegment.m_ParentSegmentIndex);
	}
	if (i_Element == "marker" && i_Field == "MarkerId" && i_Index < rSubject.m_Markers.size())
		return IdText(rSubject.m_Markers[i_Index].m_MarkerId, rSubject.m_Markers[i_Index].m_Name, i_Index);
	if (i_Element == "rotation observation" && i_Field == "RotationId" && i_Index < rSubject.m_Rotations.size())
		return IdText(rSubject.m_Rotations[i_Index].m_RotationId, rSubject.m_Rotations[i_Index].m_Name, i_Index);
	if (i_Element == "target" && i_Index < rSubject.m_Targets.size())
	{
		const auto& rTarget = rSubject.m_Targets[i_Index];
		if (i_Field == "MarkerIndices")
			return ListText(m_Markers, rTarget.m_MarkerIndices);
		if (i_Field == "RotationObservationIndices")
			return ListText(m_Rotations, rTarget.m_RotationObservationIndices);
		if (i_Field == "SegmentIndices")
			return ListText(m_Segments, rTarget.m_SegmentIndices);
	}
	const auto& rSticks = m_rSetup.m_Record.m_SubjectApplicationData.m_Sticks;
	if (i_Element == "stick" && i_Index < rSticks.size())
	{
		if (i_Field == "MarkerIndexA")
			return NameAt(m_Markers, rSticks[i_Index].m_MarkerIndexA);
		if (i_Field == "MarkerIndexB")
			return NameAt(m_Markers, rSticks[i_Index].m_MarkerIndexB);
	}
	return std::nullopt;
}

} // namespace SetupReview
