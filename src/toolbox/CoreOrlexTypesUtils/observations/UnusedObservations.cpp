#include "CoreOrlexTypesUtils/observations/UnusedObservations.h"

#include "CoreOrlexTypes/Subject.h"

namespace CoreOrlexTypesUtils
{

namespace
{

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;

/// @param i_pIndices the member of the targets that names elements of the list.
template <typename TTarget>
VRenumbering NamedOnly(
    const std::vector<TTarget>& i_rTargets, std::vector<std::uint32_t> TTarget::*i_pIndices, std::size_t i_Count)
{
	std::vector<bool> keep(i_Count, false);
	for (const TTarget& rTarget : i_rTargets)
		for (const std::uint32_t index : rTarget.*i_pIndices)
			if (index < i_Count)
				keep[index] = true;
	return VRenumbering(keep);
}

} // namespace

template <typename TSubject>
VRenumbering NamedMarkers(const TSubject& i_rSubject)
{
	return NamedOnly(i_rSubject.m_Targets, &TSubject::VTarget::m_MarkerIndices, i_rSubject.m_Markers.size());
}

template <typename TSubject>
VRenumbering NamedRotations(const TSubject& i_rSubject)
{
	return NamedOnly(
	    i_rSubject.m_Targets, &TSubject::VTarget::m_RotationObservationIndices, i_rSubject.m_Rotations.size());
}

void RemoveUnusedMarkers(
    VSubjectParametrised& io_rSubject, CoreOrlexTypes::VSubjectApplicationData& io_rApplicationData)
{
	DropMarkers(io_rSubject, io_rApplicationData, NamedMarkers(io_rSubject));
}

void RemoveUnusedRotations(VSubjectParametrised& io_rSubject)
{
	DropRotations(io_rSubject, NamedRotations(io_rSubject));
}

template VRenumbering NamedMarkers(const VSubject&);
template VRenumbering NamedMarkers(const VSubjectParametrised&);
template VRenumbering NamedRotations(const VSubject&);
template VRenumbering NamedRotations(const VSubjectParametrised&);

} // namespace CoreOrlexTypesUtils
