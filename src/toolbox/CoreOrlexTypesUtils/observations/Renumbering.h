#pragma once

#include "CoreOrlexTypes/SubjectApplicationData.h"

#include <cstddef>
#include <cstdint>
#include <utility>
#include <vector>

namespace CoreOrlexTypesUtils
{

/// Which elements of a list stay, and where. An index beyond the list stays as it is and so stays beyond.
class VRenumbering
{
public:
	/// @param i_rKeep one entry for each element of the list.
	explicit VRenumbering(const std::vector<bool>& i_rKeep) : m_NewIndices(i_rKeep.size(), c_Dropped)
	{
		std::uint32_t next = 0;
		for (std::size_t i = 0; i < i_rKeep.size(); ++i)
			if (i_rKeep[i])
				m_NewIndices[i] = next++;
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

	void Renumber(std::vector<std::uint32_t>& io_rIndices) const
	{
		for (std::uint32_t& rIndex : io_rIndices)
			Renumber(rIndex);
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

/// Drops markers that no target names; targets, sticks and the application data's markers follow. A stick that names a
/// dropped marker goes.
template <typename TSubject>
void DropMarkers(TSubject& io_rSubject, CoreOrlexTypes::VSubjectApplicationData& io_rApplicationData,
    const VRenumbering& i_rRenumbering)
{
	for (auto& rTarget : io_rSubject.m_Targets)
		i_rRenumbering.Renumber(rTarget.m_MarkerIndices);
	i_rRenumbering.Close(io_rSubject.m_Markers);
	i_rRenumbering.Close(io_rApplicationData.m_Markers);
	std::erase_if(io_rApplicationData.m_Sticks,
	    [&](const auto& i_rStick)
	    { return i_rRenumbering.Drops(i_rStick.m_MarkerIndexA) || i_rRenumbering.Drops(i_rStick.m_MarkerIndexB); });
	for (auto& rStick : io_rApplicationData.m_Sticks)
	{
		i_rRenumbering.Renumber(rStick.m_MarkerIndexA);
		i_rRenumbering.Renumber(rStick.m_MarkerIndexB);
	}
}

/// Drops rotation observations that no target names; targets follow.
template <typename TSubject>
void DropRotations(TSubject& io_rSubject, const VRenumbering& i_rRenumbering)
{
	for (auto& rTarget : io_rSubject.m_Targets)
		i_rRenumbering.Renumber(rTarget.m_RotationObservationIndices);
	i_rRenumbering.Close(io_rSubject.m_Rotations);
}

} // namespace CoreOrlexTypesUtils
