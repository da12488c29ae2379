#include "ComputeSubjectFK/ComputeSubjectFK.h"

#include "ComputeSubjectFK/ComputeSegmentFK.h"
#include "ComputeSubjectFK/TargetFK.h"
#include "DebugServices/Assert.h"

#include <set>
#include <unordered_map>

namespace ComputeSubject
{

using CoreOrlexTypes::VSubject;
using Rotation::VVector3;

VComputeSubjectFK::VComputeSubjectFK(const VSubject& i_rSubject)
{
	m_SegmentTree = MakeSegmentTree(i_rSubject);
	if (m_SegmentTree.empty())
		return;
	for (const auto& rpSegment : m_SegmentTree)
		m_NumberOfStates += rpSegment->NumberOfStates();

	std::set<std::uint32_t> markers;
	std::set<std::uint32_t> rotations;
	m_Targets.reserve(i_rSubject.m_Targets.size());
	for (const VSubject::VTarget& rTarget : i_rSubject.m_Targets)
	{
		const auto* pFactory = TargetFKFactory(rTarget.m_Type);
		m_Targets.push_back(pFactory ? pFactory->Create(rTarget, m_SegmentTree) : nullptr);
		NVX_ASSERT(m_Targets.back());
		if (!m_Targets.back())
			continue;
		if (const auto& rpMarker = m_Targets.back()->SingleMarker())
			markers.insert(rpMarker->MarkerIdx());
		if (const auto& rpGroup = m_Targets.back()->MarkerGroup())
			markers.insert(rpGroup->MarkerIndices().begin(), rpGroup->MarkerIndices().end());
		if (const auto& rpRotation = m_Targets.back()->SingleRotationObservation())
			rotations.insert(rpRotation->RotationIdx());
	}
	m_NumberOfMarkers = markers.size();
	m_NumberOfRotations = rotations.size();
}

VComputeSubjectFK::VComputeSubjectFK(const VComputeSubjectFK& i_rOther)
    : m_NumberOfStates(i_rOther.m_NumberOfStates), m_NumberOfMarkers(i_rOther.m_NumberOfMarkers),
      m_NumberOfRotations(i_rOther.m_NumberOfRotations)
{
	std::unordered_map<const IComputeSegmentFK*, const IComputeSegmentFK*> OldToNewSegmentMap;
	m_SegmentTree.reserve(i_rOther.m_SegmentTree.size());
	for (const auto& rpOld : i_rOther.m_SegmentTree)
	{
		const IComputeSegmentFK* pParent = nullptr;
		if (rpOld->Parent())
		{
			const auto Found = OldToNewSegmentMap.find(rpOld->Parent());
			NVX_ASSERT(Found != OldToNewSegmentMap.end());
			if (Found == OldToNewSegmentMap.end())
				throw VConstructionException();
			pParent = Found->second;
		}
		m_SegmentTree.push_back(std::static_pointer_cast<VComputeSegmentFK>(rpOld->Clone(pParent)));
		OldToNewSegmentMap.emplace(rpOld.get(), m_SegmentTree.back().get());
	}
	m_Targets.reserve(i_rOther.m_Targets.size());
	for (const auto& rpTarget : i_rOther.m_Targets)
		m_Targets.push_back(rpTarget ? rpTarget->Clone(m_SegmentTree) : nullptr);
}

VComputeSubjectFK::~VComputeSubjectFK() = default;

std::size_t VComputeSubjectFK::NumberOfTargets() const
{
	return m_Targets.size();
}

const ITargetFK* VComputeSubjectFK::Target(std::size_t i_Index) const
{
	return m_Targets.at(i_Index).get();
}

ITargetFK* VComputeSubjectFK::Target(std::size_t i_Index)
{
	return m_Targets.at(i_Index).get();
}

std::size_t VComputeSubjectFK::NumberOfSegments() const
{
	return m_SegmentTree.size();
}

const IComputeSegmentFK& VComputeSubjectFK::Segment(std::size_t i_Index) const
{
	return *m_SegmentTree.at(i_Index);
}

IComputeSegmentFK& VComputeSubjectFK::Segment(std::size_t i_Index)
{
	return *m_SegmentTree.at(i_Index);
}

std::size_t VComputeSubjectFK::NumberOfStates() const
{
	return m_NumberOfStates;
}

std::size_t VComputeSubjectFK::NumberOfMarkers() const
{
	return m_NumberOfMarkers;
}

std::size_t VComputeSubjectFK::NumberOfRotations() const
{
	return m_NumberOfRotations;
}

bool VComputeSubjectFK::IsValid() const
{
	const auto inRange = [this](std::uint32_t i_Index) { return i_Index < m_NumberOfMarkers; };
	for (const auto& rTgt : m_Targets)
	{
		if (!rTgt)
			continue;
		if (rTgt->SingleMarker() && !inRange(rTgt->SingleMarker()->MarkerIdx()))
			return false;
		if (rTgt->MarkerGroup())
			for (const std::uint32_t index : rTgt->MarkerGroup()->MarkerIndices())
				if (!inRange(index))
					return false;
		if (rTgt->SingleRotationObservation() && !inRange(rTgt->SingleRotationObservation()->RotationIdx()))
			return false;
	}
	return true;
}

void VComputeSubjectFK::Update(const double* i_pState)
{
	for (const auto& rpSegment : m_SegmentTree)
		rpSegment->Move(i_pState);
	for (const auto& rpSegment : m_SegmentTree)
		rpSegment->Place();
	for (const auto& rTgt : m_Targets)
		if (rTgt)
			rTgt->ComputeTargetFK()->Update();
}

void VComputeSubjectFK::NormaliseState(double* io_pState) const
{
	for (const auto& rpSegment : m_SegmentTree)
		rpSegment->Joint().ComputeJointConstraints().NormaliseState(io_pState);
}

} // namespace ComputeSubject
