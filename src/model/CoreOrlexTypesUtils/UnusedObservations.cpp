#include "CoreOrlexTypesUtils/UnusedObservations.h"

#include <algorithm>

namespace CoreOrlexTypesUtils
{

namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using VIndices = std::vector<std::uint32_t>;

/// Which elements of a list stay, and where.
class VRenumbering
{
public:
	/// @param i_pIndices the member of the targets that names elements of the list.
	VRenumbering(const std::vector<VSubjectParametrised::VTarget>& i_rTargets,
	    VIndices VSubjectParametrised::VTarget::*i_pIndices, std::size_t i_Count)
	    : m_NewIndices(i_Count, c_Dropped)
	{
		for (const auto& rTarget : i_rTargets)
			for (const std::uint32_t index : rTarget.*i_pIndices)
				if (index < i_Count)
					m_NewIndices[index] = 0;
		std::uint32_t next = 0;
		for (std::uint32_t& rIndex : m_NewIndices)
			if (rIndex != c_Dropped)
				rIndex = next++;
	}

	bool Drops(std::size_t i_Index) const
	{
		return i_Index < m_NewIndices.size() && m_NewIndices[i_Index] == c_Dropped;
	}

	void Renumber(std::uint32_t& io_rIndex) const
	{
		if (io_rIndex < m_NewIndices.size())
			io_rIndex = m_NewIndices[io_rIndex];
	}

	template <typename T>
	void Close(std::vector<T>& io_rList) const
	{
		std::size_t kept = 0;
		for (std::size_t i = 0; i < io_rList.size(); ++i)
		{
			if (Drops(i))
				continue;
			if (kept != i)
				io_rList[kept] = std::move(io_rList[i]);
			++kept;
		}
		io_rList.resize(kept);
	}

private:
	static constexpr std::uint32_t c_Dropped = 0xFFFFFFFFu;

	std::vector<std::uint32_t> m_NewIndices;
};

} // namespace

void RemoveUnusedMarkers(
    VSubjectParametrised& io_rSubject, CoreOrlexTypes::VSubjectApplicationData& io_rApplicationData)
{
	const VRenumbering renumbering(
	    io_rSubject.m_Targets, &VSubjectParametrised::VTarget::m_MarkerIndices, io_rSubject.m_Markers.size());
	for (auto& rTarget : io_rSubject.m_Targets)
		for (std::uint32_t& rIndex : rTarget.m_MarkerIndices)
			renumbering.Renumber(rIndex);
	renumbering.Close(io_rSubject.m_Markers);
	renumbering.Close(io_rApplicationData.m_Markers);
	std::erase_if(io_rApplicationData.m_Sticks,
	    [&](const auto& i_rStick)
	    { return renumbering.Drops(i_rStick.m_MarkerIndexA) || renumbering.Drops(i_rStick.m_MarkerIndexB); });
	for (auto& rStick : io_rApplicationData.m_Sticks)
	{
		renumbering.Renumber(rStick.m_MarkerIndexA);
		renumbering.Renumber(rStick.m_MarkerIndexB);
	}
}

void RemoveUnusedRotations(VSubjectParametrised& io_rSubject)
{
	const VRenumbering renumbering(io_rSubject.m_Targets, &VSubjectParametrised::VTarget::m_RotationObservationIndices,
	    io_rSubject.m_Rotations.size());
	for (auto& rTarget : io_rSubject.m_Targets)
		for (std::uint32_t& rIndex : rTarget.m_RotationObservationIndices)
			renumbering.Renumber(rIndex);
	renumbering.Close(io_rSubject.m_Rotations);
}

} // namespace CoreOrlexTypesUtils
