#pragma once

#include "FBXIO/FBXReader.h"

#include <algorithm>
#include <cmath>
#include <cstring>

/// What holds of every scene that is accepted, whatever was in the file.
namespace FbxTest
{

template <typename TNumbers>
bool AreFinite(const TNumbers& i_rNumbers)
{
	return std::all_of(
	    std::begin(i_rNumbers), std::end(i_rNumbers), [](float i_Number) { return std::isfinite(i_Number); });
}

inline bool IsFinite(const Rotation::VMatrix4& i_rMatrix)
{
	return std::all_of(i_rMatrix.data(), i_rMatrix.data() + 16, [](float i_Entry) { return std::isfinite(i_Entry); });
}

inline std::string UnsoundBone(const FBXIO::VSkinSkeleton& i_rSkeleton)
{
	for (const FBXIO::VSkinBone& rBone : i_rSkeleton)
	{
		if (rBone.m_ParentIndex < -1 || rBone.m_ParentIndex >= &rBone - i_rSkeleton.data())
			return "the parent of " + rBone.m_Name + " does not stand before it";
		for (const Rotation::VMatrix4* const pMatrix :
		    {&rBone.m_PreRotation, &rBone.m_InverseBind, &rBone.m_Local, &rBone.m_Global})
			if (!IsFinite(*pMatrix))
				return "a matrix of " + rBone.m_Name + " is not finite";
	}
	return {};
}

template <typename TVertex>
std::string UnsoundMesh(const FBXIO::VMesh<TVertex>& i_rMesh, std::size_t i_Bones)
{
	if (i_rMesh.m_Parts.empty())
		return "a mesh has no part";
	for (const FBXIO::VMeshPart& rPart : i_rMesh.m_Parts)
	{
		for (const FBXIO::VColourAndFactor& rColour : {rPart.m_Emissive, rPart.m_Ambient, rPart.m_Diffuse,
		         rPart.m_Specular, rPart.m_Transparent, rPart.m_Reflection, {rPart.m_Shininess}})
			if (!AreFinite(rColour))
				return "a colour is not finite";
		if (rPart.m_IndexSize != (i_rMesh.m_Vertices.size() < 65536 ? 2 : 4)
		    || rPart.m_Indices.size() % (3 * rPart.m_IndexSize) != 0)
			return "the size of the indices is wrong";
		for (std::size_t at = 0; at < rPart.m_Indices.size(); at += rPart.m_IndexSize)
		{
			std::uint32_t index = 0;
			std::memcpy(&index, rPart.m_Indices.data() + at, rPart.m_IndexSize);
			if (index >= i_rMesh.m_Vertices.size())
				return "an index names no vertex";
		}
	}
	for (const TVertex& rVertex : i_rMesh.m_Vertices)
	{
		if (!AreFinite(rVertex.m_Position) || !AreFinite(rVertex.m_Normal) || !AreFinite(rVertex.m_TexCoord))
			return "a vertex is not finite";
		if constexpr (std::is_same_v<TVertex, FBXIO::VSkinVertex>)
		{
			const auto& [a, b, c, d] = rVertex.m_BoneWeights;
			if (a + b + c + d > 255
			    || !std::is_sorted(std::rbegin(rVertex.m_BoneWeights), std::rend(rVertex.m_BoneWeights)))
				return "the weights of a vertex are too large, or not in order";
			for (const std::uint8_t bone : rVertex.m_BoneIndices)
				if (bone >= std::max<std::size_t>(i_Bones, 1))
					return "a vertex names no bone";
		}
	}
	return {};
}

/// Reads all that the file has; empty if everything is as it must be, else what is not.
inline std::string WhatIsUnsound(
    FBXIO::FBXReader& io_rReader, std::vector<FBXIO::VPlacedMesh>& o_rPlaced, FBXIO::VSkin& o_rSkin)
{
	std::string what = io_rReader.HasSkeleton() ? UnsoundBone(*io_rReader.GetSkeleton()) : std::string();
	if (!std::isfinite(io_rReader.GetUnitScale()) || io_rReader.GetUnitScale() <= 0.0f)
		what = "the unit is no length";
	io_rReader.ReadPlacedMeshes(o_rPlaced);
	for (const FBXIO::VPlacedMesh& rPlaced : o_rPlaced)
	{
		if (what.empty())
			what = UnsoundMesh(rPlaced.m_Mesh, 0);
		if (what.empty() && !IsFinite(rPlaced.m_Transform))
			what = "the place of " + rPlaced.m_Name + " is not finite";
	}
	io_rReader.SetMeshRules(FBXIO::c_FaithfulMeshes);
	io_rReader.ReadSkin(o_rSkin);
	if (what.empty() && o_rSkin.m_pSkeleton)
		what = UnsoundBone(*o_rSkin.m_pSkeleton);
	if (what.empty() && bool(o_rSkin.m_pSkeleton) != io_rReader.HasSkeleton())
		what = "the skin has no skeleton";
	for (const FBXIO::VSkinMesh& rMesh : o_rSkin.m_Meshes)
		if (what.empty())
			what = UnsoundMesh(rMesh, o_rSkin.m_pSkeleton->size());
	return what;
}

inline std::string WhatIsUnsound(FBXIO::FBXReader& io_rReader)
{
	std::vector<FBXIO::VPlacedMesh> placed;
	FBXIO::VSkin skin;
	return WhatIsUnsound(io_rReader, placed, skin);
}

} // namespace FbxTest
