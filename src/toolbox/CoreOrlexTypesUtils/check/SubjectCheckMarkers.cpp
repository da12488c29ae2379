#include "CoreOrlexTypesUtils/check/SubjectCheckRules.h"

#include <map>
#include <string_view>

namespace CoreOrlexTypesUtils::SubjectCheck
{

bool CheckMarkers(const std::vector<VSubject::VMarker>& i_rMarkers, IFindings& io_rFindings)
{
	std::map<std::uint32_t, std::size_t> firstOfId;
	std::map<std::string_view, std::size_t> firstOfName;
	bool bGood = true;
	for (std::size_t i = 0; i < i_rMarkers.size(); ++i)
	{
		const VSubject::VMarker& rMarker = i_rMarkers[i];
		const VReport report(io_rFindings, VSubjectFinding::EMarker, i, rMarker.m_Name);
		if (const auto [it, bNew] = firstOfId.emplace(rMarker.m_MarkerId, i); !bNew)
			bGood = report.Fail("Marker duplicate id: " + std::to_string(rMarker.m_MarkerId),
			    "Give it another MarkerId: marker #" + std::to_string(it->second) + " has this one.");
		if (const auto [it, bNew] = firstOfName.emplace(rMarker.m_Name, i); !bNew)
			bGood = report.Fail("Marker duplicate name: " + rMarker.m_Name,
			    "Give it another name: marker #" + std::to_string(it->second) + " has this one.");
	}
	return bGood;
}

} // namespace CoreOrlexTypesUtils::SubjectCheck
