#include "CoreOrlexTypesUtils/UnusedObservations.h"

#include "CoreOrlexTypesUtils/Renumbering.h"

namespace CoreOrlexTypesUtils
{

namespace
{

using CoreOrlexTypes::VSubjectParametrised;

/// @param i_pIndices the member of the targets that names elements of the list.
VRenumbering NamedOnly(const std::vector<VSubjectParametrised::VTarget>& i_rTargets,
    std::vector<std::uint32_t> VSubjectParametrised::VTarget::*i_pIndices, std::size_t i_Count)
{
	std::vector<bool> keep(i_Count, false);
	for (const auto& rTarget : i_rTargets)
		for (const std::uint32_t index : rTarget.*i_pIndices)
			if (index < i_Count)
				keep[index] = true;
	return VRenumbering(keep);
}

} // namespace

void RemoveUnusedMarkers(
    VSubjectParametrised& io_rSubject, CoreOrlexTypes::VSubjectApplicationData& io_rApplicationData)
{
	DropMarkers(io_rSubject, io_rApplicationData,
	    NamedOnly(
	        io_rSubject.m_Targets, &VSubjectParametrised::VTarget::m_MarkerIndices, io_rSubject.m_Markers.size()));
}

void RemoveUnusedRotations(VSubjectParametrised& io_rSubject)
{
	DropRotations(io_rSubject,
	    NamedOnly(io_rSubject.m_Targets, &VSubjectParametrised::VTarget::m_RotationObservationIndices,
	        io_rSubject.m_Rotations.size()));
}

} // namespace CoreOrlexTypesUtils
