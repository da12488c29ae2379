#pragma once

#include "FBXIO/MeshRules.h"

#include <fbxsdk.h>

#include <cstdint>
#include <optional>
#include <vector>

namespace FBXIO
{

/// The vertices that polygon vertices become where texture coordinates are given by polygon vertex.
struct VSeams
{
	struct VVertex
	{
		std::uint32_t m_Point;
		/// Of the coordinates; -1 if it has none.
		std::int32_t m_Entry;
	};
	/// In the order in which polygons use them.
	std::vector<VVertex> m_Vertices;
	/// For each polygon vertex its vertex; undefined for polygons of size 0.
	std::vector<std::uint32_t> m_Indices;
};

/// Empty if the mesh has no texture coordinates by polygon vertex.
std::optional<VSeams> FindSeams(FbxMesh& io_rFrom, EVertexKey i_Key);

} // namespace FBXIO
