#pragma once

#include "FBXIO/Picture.h"
#include "FBXIO/SkinSkeleton.h"

#include <array>
#include <cstdint>
#include <memory>
#include <string>
#include <vector>

namespace FBXIO
{

/// As it is uploaded: position in millimetres, normal, texture coordinate.
struct VBasicVertex
{
	std::array<float, 3> m_Position{};
	std::array<float, 3> m_Normal{};
	std::array<float, 2> m_TexCoord{};
};
static_assert(sizeof(VBasicVertex) == 32);

/// Weights are parts of 255. Their sum is at most 255, and less where fractions were cut off.
struct VSkinVertex : VBasicVertex
{
	std::array<std::uint8_t, 4> m_BoneIndices{};
	std::array<std::uint8_t, 4> m_BoneWeights{};
};
static_assert(sizeof(VSkinVertex) == 40);

/// Red, green and blue, then the factor that they count with.
using VColourAndFactor = std::array<float, 4>;

/// One material's share of a mesh.
struct VMeshPart
{
	VColourAndFactor m_Emissive{};
	VColourAndFactor m_Ambient{};
	VColourAndFactor m_Diffuse{1.0f, 0.8f, 0.8f, 1.0f};
	VColourAndFactor m_Specular{};
	float m_Shininess = 0.0f;
	VColourAndFactor m_Transparent{};
	VColourAndFactor m_Reflection{};
	/// Null if there is none, or none that could be read. What is known beyond its size is what the reader's opener of
	/// pictures has left in it.
	std::shared_ptr<const VPicture> m_pTexture;
	/// The file that the texture was looked for in; empty if the material names none.
	std::string m_TexturePath;
	/// Bytes of one index, 2 or 4.
	std::uint32_t m_IndexSize = 2;
	/// A list of triangles.
	std::vector<std::uint8_t> m_Indices;
};

template <typename TVertex>
struct VMesh
{
	std::vector<VMeshPart> m_Parts;
	std::vector<TVertex> m_Vertices;
};

using VBasicMesh = VMesh<VBasicVertex>;
using VSkinMesh = VMesh<VSkinVertex>;

struct VPlacedMesh
{
	VBasicMesh m_Mesh;
	/// Global transform for column vectors, translation in millimetres.
	Rotation::VMatrix4 m_Transform;
	/// The node's.
	std::string m_Name;
	/// Of the bone that it hangs on, or that it is itself; empty if there is none.
	std::string m_Bone;
	/// Whether bones move its vertices.
	bool m_bSkinned = false;
};

struct VSkin
{
	std::vector<VSkinMesh> m_Meshes;
	/// The bones that matter; indices in vertices are places in it.
	std::shared_ptr<const VSkinSkeleton> m_pSkeleton;
};

} // namespace FBXIO
