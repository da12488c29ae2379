#include "CoreOrlexTypesUtils/observations/PruneToActive.h"

#include "CoreOrlexTypesUtils/Expectation.h"
#include "CoreOrlexTypesUtils/SubjectKind.h"
#include "CoreOrlexTypesUtils/observations/Renumbering.h"
#include "CoreOrlexTypesUtils/rigidbody/RigidBodyRefusal.h"

#include "DebugServices/GlobalLog.h"

#include <set>

namespace CoreOrlexTypesUtils::SubjectParametrisedUtils
{

namespace
{

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using VIndices = std::vector<std::uint32_t>;

/// Cuts the elements of i_Size values behind the first i_Begin; a list of another size is left alone.
template <typename T>
void Cut(std::vector<T>& io_rList, const std::vector<bool>& i_rKeep, std::size_t i_Begin, std::size_t i_Size)
{
	if (io_rList.size() != i_Begin + i_Size * i_rKeep.size())
		return;
	std::vector<bool> keep(i_Begin, true);
	for (const bool bKeep : i_rKeep)
		keep.insert(keep.end(), i_Size, bKeep);
	VRenumbering(keep).Close(io_rList);
}

void CutTemplates(VSubject::VTarget&, const std::vector<bool>&) {}

void CutTemplates(VSubjectParametrised::VTarget& io_rTarget, const std::vector<bool>& i_rKeep)
{
	Cut(io_rTarget.m_TemplateCovariance, i_rKeep, 36, 9);
}

/// @return whether the target has a use without the markers that are dropped.
template <typename TSubject>
bool LoseMarkers(typename TSubject::VTarget& io_rTarget, const VRenumbering& i_rRenumbering)
{
	std::vector<bool> keep;
	for (const std::uint32_t marker : io_rTarget.m_MarkerIndices)
		keep.push_back(!i_rRenumbering.Drops(marker));
	const std::size_t kept = std::size_t(std::count(keep.begin(), keep.end(), true));
	if (kept == keep.size())
		return true;
	Cut(io_rTarget.m_ViewNormals, keep, 0, 1);
	if (io_rTarget.m_Type == TSubject::VTarget::ERigidBody)
	{
		Cut(VSubjectKind<TSubject>::State(io_rTarget), keep, 6, 3);
		Cut(io_rTarget.m_Covariance, keep, 36, 9);
		CutTemplates(io_rTarget, keep);
	}
	Cut(io_rTarget.m_MarkerIndices, keep, 0, 1);
	return kept >= (io_rTarget.m_Type == TSubject::VTarget::ERigidBody ? RigidBodyUtils::c_MarkersOfBody : 1);
}

bool LoseRotations(VIndices& io_rIndices, const VRenumbering& i_rRenumbering)
{
	const bool bHadNone = io_rIndices.empty();
	std::erase_if(io_rIndices, [&](std::uint32_t i_Index) { return i_rRenumbering.Drops(i_Index); });
	return bHadNone || !io_rIndices.empty();
}

VRenumbering KeepOnly(const std::set<std::uint32_t>& i_rActive, std::size_t i_Count)
{
	std::vector<bool> keep(i_Count, false);
	for (const std::uint32_t index : i_rActive)
		keep[index] = true;
	return VRenumbering(keep);
}

std::set<std::uint32_t> InRange(const VIndices& i_rIndices, std::size_t i_Count)
{
	std::set<std::uint32_t> inRange;
	for (const std::uint32_t index : i_rIndices)
		if (index < i_Count)
			inRange.insert(index);
	return inRange;
}

} // namespace

template <typename TSubject>
bool PruneToActive(TSubject& io_rSubject, VSubjectApplicationData& io_rAppData, const VIndices& i_rActiveMarkers,
    const VIndices& i_rActiveRotations)
{
	if (io_rSubject.m_Segments.empty())
	{
		NVX_LOG(VSubjectKind<TSubject>::c_LogCategory, NVX::ELogError, "The input subject has no segments");
		return false;
	}
	const std::set<std::uint32_t> ActiveMarkerIdxs = InRange(i_rActiveMarkers, io_rSubject.m_Markers.size());
	const std::set<std::uint32_t> ActiveRotationIdxs = InRange(i_rActiveRotations, io_rSubject.m_Rotations.size());
	if (!io_rSubject.m_Markers.empty())
		Expect(ActiveMarkerIdxs.size() < io_rSubject.m_Markers.size(),
		    "ActiveMarkerIdxs.size()<i_rSubject.m_Markers.size()");
	if (!io_rSubject.m_Rotations.empty())
		Expect(ActiveRotationIdxs.size() < io_rSubject.m_Rotations.size(),
		    "ActiveRotationIdxs.size() < i_rSubject.m_Rotations.size()");
	const VRenumbering markers = KeepOnly(ActiveMarkerIdxs, io_rSubject.m_Markers.size());
	const VRenumbering rotations = KeepOnly(ActiveRotationIdxs, io_rSubject.m_Rotations.size());

	std::vector<bool> keep;
	for (auto& rTarget : io_rSubject.m_Targets)
	{
		const bool bMarkers = LoseMarkers<TSubject>(rTarget, markers);
		const bool bRotations = LoseRotations(rTarget.m_RotationObservationIndices, rotations);
		keep.push_back(bMarkers && bRotations);
	}
	const VRenumbering targets(keep);
	targets.Close(io_rSubject.m_Targets);
	targets.Close(io_rAppData.m_Targets);
	DropMarkers(io_rSubject, io_rAppData, markers);
	DropRotations(io_rSubject, rotations);
	return true;
}

template <typename TSubject>
bool PruneToActive(TSubject& io_rSubject, const VIndices& i_rActiveMarkers, const VIndices& i_rActiveRotations)
{
	VSubjectApplicationData none;
	return PruneToActive(io_rSubject, none, i_rActiveMarkers, i_rActiveRotations);
}

template bool PruneToActive(VSubject&, VSubjectApplicationData&, const VIndices&, const VIndices&);
template bool PruneToActive(VSubjectParametrised&, VSubjectApplicationData&, const VIndices&, const VIndices&);
template bool PruneToActive(VSubject&, const VIndices&, const VIndices&);
template bool PruneToActive(VSubjectParametrised&, const VIndices&, const VIndices&);

} // namespace CoreOrlexTypesUtils::SubjectParametrisedUtils
