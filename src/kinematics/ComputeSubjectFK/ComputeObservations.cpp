// What the targets say about markers and rotation observations.
#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "ComputeSubjectFK/TargetFKInterfaces.h"
#include "DebugServices/Assert.h"

#include <algorithm>

namespace ComputeSubject
{
namespace
{

using Rotation::VVector3;

/// Calls i_rVisit(marker index, weight, world point) for each marker of each point and group target whose index is
/// in range of io_rPositions, which the visitor may change.
template <typename TVisitor>
void ForEachMarker(const std::vector<std::shared_ptr<ITargetFK>>& i_rTargets, std::vector<VVector3>& io_rPositions,
    const TVisitor& i_rVisit)
{
	for (const auto& rTgt : i_rTargets)
	{
		NVX_ASSERT(rTgt);
		if (!rTgt)
			continue;
		const double weight = rTgt->ComputeTargetFK()->Weight();
		const auto& rTgtToPoint = rTgt->SingleMarker();
		if (rTgtToPoint && rTgt->FromLocalPoint())
		{
			NVX_ASSERT(rTgtToPoint->MarkerIdx() < io_rPositions.size());
			if (rTgtToPoint->MarkerIdx() < io_rPositions.size())
				i_rVisit(rTgtToPoint->MarkerIdx(), weight, rTgt->FromLocalPoint()->WorldPoint());
		}
		if (rTgt->MarkerGroup() && rTgt->FromPointGroup())
		{
			std::size_t marker = 0;
			for (const std::uint32_t rIdx : rTgt->MarkerGroup()->MarkerIndices())
			{
				NVX_ASSERT(rIdx < io_rPositions.size());
				if (rIdx < io_rPositions.size())
					i_rVisit(rIdx, weight, rTgt->FromPointGroup()->WorldPoint(marker));
				++marker;
			}
		}
	}
}

bool AllSet(const std::vector<bool>& i_rFlags)
{
	return std::find(i_rFlags.begin(), i_rFlags.end(), false) == i_rFlags.end();
}

} // namespace

bool VComputeSubjectFK::ComputeMarkers(std::vector<VVector3>& io_rPositions) const
{
	std::vector<bool> valid;
	return ComputeMarkers(io_rPositions, valid);
}

bool VComputeSubjectFK::ComputeMarkers(std::vector<VVector3>& io_rPositions, std::vector<bool>& o_rValid) const
{
	io_rPositions.assign(m_NumberOfMarkers, VVector3{});
	std::vector<double> weights(m_NumberOfMarkers, 0.0);
	ForEachMarker(m_Targets, io_rPositions,
	    [&](std::uint32_t i_Index, double i_Weight, const VVector3&) { weights[i_Index] += i_Weight; });
	ForEachMarker(m_Targets, io_rPositions,
	    [&](std::uint32_t i_Index, double i_Weight, const VVector3& i_rPoint)
	    {
		    if (!(weights[i_Index] > 0.0))
			    return;
		    const double share = i_Weight / weights[i_Index];
		    for (int i = 0; i < 3; ++i)
			    io_rPositions[i_Index][i] += share * i_rPoint[i];
	    });
	o_rValid.resize(weights.size());
	std::transform(weights.begin(), weights.end(), o_rValid.begin(), [](double i_Weight) { return i_Weight > 0.0; });
	return AllSet(o_rValid);
}

bool VComputeSubjectFK::ComputeRotations(std::vector<Rotation::VMatrix3>& io_rRotations) const
{
	std::vector<bool> valid;
	return ComputeRotations(io_rRotations, valid);
}

bool VComputeSubjectFK::ComputeRotations(
    std::vector<Rotation::VMatrix3>& io_rRotations, std::vector<bool>& o_rValid) const
{
	io_rRotations.assign(m_NumberOfRotations, Rotation::c_Identity3);
	o_rValid.assign(m_NumberOfRotations, false);
	for (const auto& rTgt : m_Targets)
	{
		NVX_ASSERT(rTgt);
		if (!rTgt || !rTgt->SingleRotationObservation() || !rTgt->FromLocalRotation())
			continue;
		const std::uint32_t index = rTgt->SingleRotationObservation()->RotationIdx();
		if (index >= io_rRotations.size())
			continue;
		io_rRotations[index] = rTgt->FromLocalRotation()->WorldRotation();
		o_rValid[index] = true;
	}
	return AllSet(o_rValid);
}

} // namespace ComputeSubject
