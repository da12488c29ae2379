#include "CoreOrlexTypesUtils/observations/TargetPerMarker.h"

#include "CoreOrlexTypesUtils/Expectation.h"
#include "CoreOrlexTypesUtils/SubjectKind.h"

#include "DebugServices/GlobalLog.h"

#include <algorithm>
#include <map>

namespace CoreOrlexTypesUtils::SubjectParametrisedUtils
{

namespace
{

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;

template <typename TTarget>
bool IsPoint(const TTarget& i_rTarget)
{
	return i_rTarget.m_Type == TTarget::ELocalPointToWorldPoint
	    || i_rTarget.m_Type == TTarget::ELocalPointToWorldPointGaussian;
}

} // namespace

template <typename TSubject>
void MakeOneTargetPerMarker(TSubject& io_rSubject, VSubjectApplicationData& io_rAppData)
{
	constexpr const char* c_Category = VSubjectKind<TSubject>::c_LogCategory;
	io_rAppData.m_Targets.resize(io_rSubject.m_Targets.size());

	std::map<std::uint32_t, std::size_t> MarkerIndexToOldTargetIndex;
	std::vector<std::size_t> MarkerLessTargetIndex;
	for (std::size_t i = 0; i < io_rSubject.m_Targets.size(); ++i)
	{
		const auto& rTgt = io_rSubject.m_Targets[i];
		if (!IsPoint(rTgt))
		{
			NVX_LOG(c_Category, NVX::ELogWarning, "Subject %1% target %2%, labelers do not support non-point targets",
			    io_rSubject.m_Name, i);
			MarkerLessTargetIndex.push_back(i);
		}
		else if (!Expect(rTgt.m_MarkerIndices.size() == 1, "rTgt.m_MarkerIndices.size() == 1"))
			MarkerLessTargetIndex.push_back(i);
		else if (!MarkerIndexToOldTargetIndex.emplace(rTgt.m_MarkerIndices.front(), i).second)
			NVX_LOG(c_Category, NVX::ELogWarning,
			    "Subject %1% marker %2%, labelers do not support multiple targets per marker", io_rSubject.m_Name,
			    rTgt.m_MarkerIndices.front());
	}
	// This and the two below hold where no marker has a second target, as labelling wants it.
	Expect(MarkerIndexToOldTargetIndex.size() + MarkerLessTargetIndex.size() == io_rSubject.m_Targets.size(),
	    "MarkerIndexToOldTargetIndex.size() + MarkerLessTargetIndex.size() == io_rSubject.m_Targets.size()");

	std::vector<typename TSubject::VTarget> NewTargets;
	std::vector<VSubjectApplicationData::VTarget> NewTargetData;
	const auto take = [&](std::size_t i_OldIndex)
	{
		NewTargets.push_back(std::move(io_rSubject.m_Targets[i_OldIndex]));
		NewTargetData.push_back(std::move(io_rAppData.m_Targets[i_OldIndex]));
		std::string& rName = NewTargetData.back().m_Name;
		if (rName.empty())
			rName = std::string("Target_").append(std::to_string(NewTargets.size() - 1));
	};
	for (const auto& [marker, oldIndex] : MarkerIndexToOldTargetIndex)
		take(oldIndex);
	for (const std::size_t oldIndex : MarkerLessTargetIndex)
		take(oldIndex);
	Expect(io_rSubject.m_Targets.size() == NewTargets.size(), "io_rSubject.m_Targets.size() == NewTargets.size()");
	Expect(
	    io_rAppData.m_Targets.size() == NewTargetData.size(), "io_rAppData.m_Targets.size() == NewTargetData.size()");
	io_rSubject.m_Targets = std::move(NewTargets);
	io_rAppData.m_Targets = std::move(NewTargetData);
}

template <typename TSubject>
bool CheckCalibration(const TSubject& i_rSubject)
{
	constexpr const char* c_Category = VSubjectKind<TSubject>::c_LogCategory;
	std::vector<std::size_t> targetsOfMarkers(i_rSubject.m_Markers.size(), 0);
	bool bTypes = true;
	for (const auto& rTarget : i_rSubject.m_Targets)
	{
		bTypes &= IsPoint(rTarget);
		for (const std::uint32_t marker : rTarget.m_MarkerIndices)
			if (marker < targetsOfMarkers.size())
				++targetsOfMarkers[marker];
	}
	const bool bSeveral = std::any_of(
	    targetsOfMarkers.begin(), targetsOfMarkers.end(), [](std::size_t i_Targets) { return i_Targets > 1; });
	const bool bNone = std::find(targetsOfMarkers.begin(), targetsOfMarkers.end(), 0u) != targetsOfMarkers.end();
	if (bSeveral || bNone)
		NVX_LOG(c_Category, NVX::ELogError, "The calibrator can only use subjects with one target per marker.");
	if (bSeveral)
		NVX_LOG(c_Category, NVX::ELogError, "There cannot be more than one target per marker");
	if (bNone)
		NVX_LOG(c_Category, NVX::ELogError, "Cannot calibrate all the markers, some markers have no associated target");
	if (!bTypes)
		NVX_LOG(c_Category, NVX::ELogError, "Cannot calibrate target type");
	return !bSeveral && !bNone && bTypes;
}

template void MakeOneTargetPerMarker(VSubject& io_rSubject, VSubjectApplicationData& io_rAppData);
template void MakeOneTargetPerMarker(VSubjectParametrised& io_rSubject, VSubjectApplicationData& io_rAppData);
template bool CheckCalibration(const VSubject& i_rSubject);
template bool CheckCalibration(const VSubjectParametrised& i_rSubject);

} // namespace CoreOrlexTypesUtils::SubjectParametrisedUtils
