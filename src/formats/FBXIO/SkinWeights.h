#pragma once

#include <fbxsdk.h>

#include <array>
#include <cstdint>
#include <utility>
#include <vector>

namespace FBXIO
{

constexpr std::size_t c_MostInfluences = 4;

/// Bones and weights of a control point as a vertex has them.
struct VQuantised
{
	std::array<std::uint8_t, c_MostInfluences> m_Bones{};
	std::array<std::uint8_t, c_MostInfluences> m_Weights{};
};

struct VSkinWeights
{
	std::vector<VQuantised> m_Points;
	/// How many weights were left out, points have too many bones, and points have none.
	std::size_t m_Broken = 0;
	std::size_t m_OverFull = 0;
	std::size_t m_Unweighted = 0;
	float m_LargestDropped = 0.0f;
};

/// Clusters and the bones that they are bound to.
using VBoundClusters = std::vector<std::pair<FbxCluster*, std::int32_t>>;

/// For that many control points. Changes nothing and tells nothing, so that it can run beside other work, once the
/// clusters have been asked for their points.
VSkinWeights ReadSkinWeights(const VBoundClusters& i_rClusters, std::size_t i_Points);

/// What is wrong with them, to the log.
void TellSkinWeights(const VSkinWeights& i_rWeights, const char* i_pNode);

} // namespace FBXIO
