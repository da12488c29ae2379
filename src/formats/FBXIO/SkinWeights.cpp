#include "FBXIO/SkinWeights.h"

#include "DebugServices/GlobalLog.h"

#include <algorithm>
#include <cmath>

namespace
{

using namespace FBXIO;

struct VInfluence
{
	std::int32_t m_Bone = 0;
	float m_Weight = 0.0f;

	bool IsBefore(const VInfluence& i_rOther) const
	{
		return m_Weight != i_rOther.m_Weight ? m_Weight > i_rOther.m_Weight : m_Bone < i_rOther.m_Bone;
	}
};

/// The largest influences on a point, in order.
struct VInfluences
{
	std::array<VInfluence, c_MostInfluences> m_Largest;
	/// One more than there can be if any was dropped.
	std::size_t m_Count = 0;

	/// @return the weight that is dropped for it; 0 if none is.
	float Add(const VInfluence& i_rInfluence)
	{
		float dropped = 0.0f;
		std::size_t at = m_Count++;
		if (at >= c_MostInfluences)
		{
			m_Count = c_MostInfluences + 1;
			at = c_MostInfluences - 1;
			dropped = std::min(m_Largest[at].m_Weight, i_rInfluence.m_Weight);
			if (!i_rInfluence.IsBefore(m_Largest[at]))
				return dropped;
		}
		for (; at > 0 && i_rInfluence.IsBefore(m_Largest[at - 1]); --at)
			m_Largest[at] = m_Largest[at - 1];
		m_Largest[at] = i_rInfluence;
		return dropped;
	}
};

/// Fractions are cut off: what is missing to 255 is lost.
/// @return false if the weights give nothing.
bool Quantise(const VInfluences& i_rInfluences, VQuantised& o_rQuantised)
{
	const std::size_t count = std::min(i_rInfluences.m_Count, c_MostInfluences);
	double sum = 0.0;
	for (std::size_t i = 0; i < count; ++i)
		sum += i_rInfluences.m_Largest[i].m_Weight;
	int remaining = 255;
	for (std::size_t i = 0; i < count; ++i)
	{
		o_rQuantised.m_Bones[i] = std::uint8_t(i_rInfluences.m_Largest[i].m_Bone);
		if (!(sum > 0.0))
			continue;
		const double part = i_rInfluences.m_Largest[i].m_Weight * 255.0 / sum;
		const int weight = int(std::clamp(part, 0.0, double(remaining)));
		o_rQuantised.m_Weights[i] = std::uint8_t(weight);
		remaining -= weight;
	}
	return sum > 0.0;
}

} // namespace

FBXIO::VSkinWeights FBXIO::ReadSkinWeights(const VBoundClusters& i_rClusters, std::size_t i_Points)
{
	VSkinWeights weights;
	std::vector<VInfluences> influences(i_Points);
	for (const auto& [pCluster, bone] : i_rClusters)
	{
		const int* const pPoints = pCluster->GetControlPointIndices();
		const double* const pWeights = pCluster->GetControlPointWeights();
		for (int i = 0, count = pCluster->GetControlPointIndicesCount(); i < count; ++i)
		{
			const float weight = float(pWeights[i]);
			if (pPoints[i] < 0 || std::size_t(pPoints[i]) >= i_Points || !std::isfinite(weight))
			{
				++weights.m_Broken;
				continue;
			}
			const float dropped = influences[pPoints[i]].Add({bone, weight});
			if (dropped > weights.m_LargestDropped)
				weights.m_LargestDropped = dropped;
		}
	}
	weights.m_Points.resize(i_Points);
	for (std::size_t point = 0; point < i_Points; ++point)
	{
		weights.m_OverFull += influences[point].m_Count > c_MostInfluences ? 1 : 0;
		weights.m_Unweighted += Quantise(influences[point], weights.m_Points[point]) ? 0 : 1;
	}
	return weights;
}

void FBXIO::TellSkinWeights(const VSkinWeights& i_rWeights, const char* i_pNode)
{
	if (i_rWeights.m_Broken > 0)
		NVX_LOG("FBXIO", NVX::ELogWarning,
		    "%1% weights of mesh %2% left out because they are no numbers or name control points that do not exist",
		    i_rWeights.m_Broken, i_pNode);
	if (i_rWeights.m_OverFull > 0)
		NVX_LOG("FBXIO", NVX::ELogDetail, "Too many bones on %1% vertices, with maximum contribution of %2%%%",
		    i_rWeights.m_OverFull, i_rWeights.m_LargestDropped * 100.0f);
	if (i_rWeights.m_Unweighted > 0)
		NVX_LOG("FBXIO", NVX::ELogWarning, "%1% unweighted vertices in mesh %2%", i_rWeights.m_Unweighted, i_pNode);
}
