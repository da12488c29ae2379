#include "TakeSolve/TargetWords.h"

#include "TakeSolve/Vectors.h"

namespace TakeSolve
{

using CoreOrlexTypes::VSubject;

bool IsRotationTarget(const VSubject::VTarget& i_rTarget)
{
	return i_rTarget.m_Type == VSubject::VTarget::ELocalRotationToWorldRotation
	    || i_rTarget.m_Type == VSubject::VTarget::ELocalDirectionToWorldDirection;
}

const char* UnitOf(const VSubject::VTarget& i_rTarget)
{
	return IsRotationTarget(i_rTarget) ? "deg" : "mm";
}

double UnitFactor(const VSubject::VTarget& i_rTarget)
{
	return IsRotationTarget(i_rTarget) ? c_Degrees : 1.0;
}

std::string SourceOf(const VSubject& i_rSubject, const VSubject::VTarget& i_rTarget)
{
	std::string names;
	const auto append = [&](const std::vector<std::uint32_t>& i_rIndices, const auto& i_rNamed)
	{
		for (const std::uint32_t index : i_rIndices)
			if (index < i_rNamed.size())
				names += (names.empty() ? "" : ", ") + i_rNamed[index].m_Name;
	};
	append(i_rTarget.m_MarkerIndices, i_rSubject.m_Markers);
	if (names.empty())
		append(i_rTarget.m_RotationObservationIndices, i_rSubject.m_Rotations);
	return names;
}

std::string TargetOf(const VSubject& i_rSubject, const VSubject::VTarget& i_rTarget)
{
	return i_rTarget.m_SegmentIndices.empty() || i_rTarget.m_SegmentIndices.front() >= i_rSubject.m_Segments.size()
	    ? std::string()
	    : i_rSubject.m_Segments[i_rTarget.m_SegmentIndices.front()].m_Name;
}

} // namespace TakeSolve
