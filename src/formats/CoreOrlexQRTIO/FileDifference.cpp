#include "CoreOrlexQRTIO/FileDifference.h"

#include "CoreOrlexTypes/Difference.h"

#include <algorithm>
#include <cmath>
#include <numeric>

namespace CoreOrlexQRTIO
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;

/// Radians; an axis keeps about 16 digits.
constexpr double c_OrientationTolerance = 1e-12;

void SortRotations(VSubjectParametrised& io_rSubject)
{
	std::vector<std::uint32_t> order(io_rSubject.m_Rotations.size());
	std::iota(order.begin(), order.end(), 0u);
	std::ranges::stable_sort(order, {}, [&](std::uint32_t i_Index) { return io_rSubject.m_Rotations[i_Index].m_Name; });
	std::vector<std::uint32_t> newIndices(order.size());
	std::vector<VSubjectParametrised::VRotation> sorted;
	for (const std::uint32_t index : order)
	{
		newIndices[index] = std::uint32_t(sorted.size());
		sorted.push_back(std::move(io_rSubject.m_Rotations[index]));
	}
	io_rSubject.m_Rotations = std::move(sorted);
	for (VSubjectParametrised::VTarget& rTarget : io_rSubject.m_Targets)
		for (std::uint32_t& rIndex : rTarget.m_RotationObservationIndices)
			if (rIndex < newIndices.size())
				rIndex = newIndices[rIndex];
}

void DropIds(VSubjectParametrised& io_rSubject)
{
	for (VSubjectParametrised::VMarker& rMarker : io_rSubject.m_Markers)
		rMarker.m_MarkerId = 0;
	for (VSubjectParametrised::VRotation& rRotation : io_rSubject.m_Rotations)
		rRotation.m_RotationId = 0;
}

void TakeOverRoundedOrientations(const VSubjectParametrised& i_rFrom, VSubjectParametrised& io_rTo)
{
	for (std::size_t i = 0; i < std::min(i_rFrom.m_Segments.size(), io_rTo.m_Segments.size()); ++i)
	{
		const auto& rFrom = i_rFrom.m_Segments[i].m_Joint.m_JointOrientation;
		auto& rTo = io_rTo.m_Segments[i].m_Joint.m_JointOrientation;
		if (std::ranges::equal(
		        rFrom, rTo, [](double i_A, double i_B) { return std::abs(i_A - i_B) <= c_OrientationTolerance; }))
			rTo = rFrom;
	}
}

} // namespace

std::string FileDifference(CoreOrlexTypes::VSubjectRecord i_Written, CoreOrlexTypes::VSubjectRecord i_Read)
{
	for (VSubjectParametrised* const pSubject : {&i_Written.m_SubjectParametrised, &i_Read.m_SubjectParametrised})
	{
		SortRotations(*pSubject);
		DropIds(*pSubject);
	}
	TakeOverRoundedOrientations(i_Written.m_SubjectParametrised, i_Read.m_SubjectParametrised);
	return CoreOrlexTypes::FirstDifference(i_Written, i_Read);
}

} // namespace CoreOrlexQRTIO
