#pragma once

#include "DebugServices/GlobalLog.h"
#include "FBXIO/Mesh.h"
#include "FBXIO/Seams.h"

#include <fbxsdk.h>

#include <cmath>
#include <cstring>

namespace FBXIO
{

/// As a float; 0, with o_rbSound false, for what is no number or too large for one.
inline float Finite(double i_Number, bool& o_rbSound)
{
	const float number = float(i_Number);
	const bool bFinite = std::isfinite(number);
	o_rbSound = o_rbSound && bFinite;
	return bFinite ? number : 0.0f;
}

inline float Finite(double i_Number)
{
	bool bSound = true;
	return Finite(i_Number, bSound);
}

/// Gives vertices their texture coordinates. Where these are given by polygon vertex the vertices become those of the
/// seams, and so do io_rIndices, the vertices of all polygons.
/// @param i_pSeams null if the mesh has none
/// @param i_pName the node's, for messages: meshes of some exporters have none. Null if nothing is to be told.
/// @return how many polygon vertices are moved to other control points
template <typename TVertex>
std::size_t ApplyTexCoords(FbxMesh& io_rFrom, VSeams* i_pSeams, const char* i_pName, std::vector<TVertex>& io_rVertices,
    std::vector<std::uint32_t>& io_rIndices)
{
	const FbxGeometryElementUV* const pUV = io_rFrom.GetElementUV(0);
	if (!pUV || (!i_pSeams && pUV->GetMappingMode() != FbxLayerElement::eByControlPoint))
		return 0;
	const auto& rDirect = pUV->GetDirectArray();
	std::size_t missing = 0;
	const auto setCoordinate = [&rDirect, &missing](TVertex& o_rVertex, int i_Entry)
	{
		const FbxVector2 coordinate = rDirect.GetAt(i_Entry);
		bool bSound = i_Entry >= 0;
		o_rVertex.m_TexCoord = {Finite(coordinate[0], bSound), Finite(coordinate[1], bSound)};
		missing += bSound ? 0 : 1;
	};
	std::size_t moved = 0;
	if (i_pSeams)
	{
		for (int polygon = 0, count = io_rFrom.GetPolygonCount(); polygon < count; ++polygon)
		{
			const int start = io_rFrom.GetPolygonVertexIndex(polygon);
			for (int i = start, end = start + io_rFrom.GetPolygonSize(polygon); i < end; ++i)
			{
				const std::uint32_t point = i_pSeams->m_Vertices[i_pSeams->m_Indices[i]].m_Point;
				moved +=
				    point != io_rIndices[i] && io_rVertices[point].m_Position != io_rVertices[io_rIndices[i]].m_Position
				    ? 1
				    : 0;
			}
		}
		std::vector<TVertex> vertices;
		vertices.reserve(i_pSeams->m_Vertices.size());
		for (const VSeams::VVertex& rVertex : i_pSeams->m_Vertices)
			setCoordinate(vertices.emplace_back(io_rVertices[rVertex.m_Point]), rVertex.m_Entry);
		io_rVertices = std::move(vertices);
		io_rIndices = std::move(i_pSeams->m_Indices);
	}
	else
		for (int i = 0; i < std::min(rDirect.GetCount(), int(io_rVertices.size())); ++i)
			setCoordinate(io_rVertices[i], i);
	if (moved > 0 && i_pName)
		NVX_LOG("FBXIO", NVX::ELogWarning,
		    "%1% polygon vertices of mesh %2% are moved to other control points that share their texture coordinate",
		    moved, i_pName);
	if (missing > 0 && i_pName)
		NVX_LOG("FBXIO", NVX::ELogWarning, "%1% vertices of mesh %2% have no texture coordinate", missing, i_pName);
	return moved;
}

/// Cuts polygons into fans of triangles, each for the part of its material.
/// @return how many polygons are left out because there is no part for them
template <typename TIndex>
std::size_t SplitIntoParts(
    FbxMesh& io_rFrom, const std::vector<std::uint32_t>& i_rIndices, std::vector<VMeshPart>& io_rParts)
{
	const int count = io_rFrom.GetPolygonCount();
	const bool bMaterial = io_rFrom.GetElementMaterialCount() > 0;
	const FbxLayerElementArrayTemplate<int>* const pList =
	    bMaterial ? &io_rFrom.GetElementMaterial()->GetIndexArray() : nullptr;
	const bool bList = pList && pList->GetCount() == count;
	std::size_t withoutPart = 0;
	/// Calls i_Visit(part, vertices, size) for each polygon that makes triangles.
	const auto forEachPolygon = [&](auto&& i_Visit)
	{
		for (int polygon = 0; polygon < count; ++polygon)
		{
			const std::size_t part = bList ? std::size_t(std::max(pList->GetAt(polygon), 0)) : 0;
			const int size = io_rFrom.GetPolygonSize(polygon);
			if (size < 3)
				continue;
			if (part < io_rParts.size())
				i_Visit(part, i_rIndices.data() + io_rFrom.GetPolygonVertexIndex(polygon), size);
			else
				++withoutPart;
		}
	};
	std::vector<std::size_t> triangles(io_rParts.size());
	forEachPolygon([&](std::size_t i_Part, const std::uint32_t*, int i_Size) { triangles[i_Part] += i_Size - 2; });
	const std::size_t leftOut = withoutPart;
	std::vector<std::uint8_t*> next(io_rParts.size());
	for (std::size_t i = 0; i < io_rParts.size(); ++i)
	{
		io_rParts[i].m_IndexSize = sizeof(TIndex);
		io_rParts[i].m_Indices.resize(triangles[i] * 3 * sizeof(TIndex));
		next[i] = io_rParts[i].m_Indices.data();
	}
	forEachPolygon(
	    [&](std::size_t i_Part, const std::uint32_t* i_pVertices, int i_Size)
	    {
		    std::uint8_t*& rpNext = next[i_Part];
		    TIndex triangle[3]{TIndex(i_pVertices[0]), TIndex(i_pVertices[1]), TIndex(i_pVertices[2])};
		    for (int i = 3;; ++i)
		    {
			    std::memcpy(rpNext, triangle, sizeof(triangle));
			    rpNext += sizeof(triangle);
			    if (i == i_Size)
				    break;
			    triangle[1] = triangle[2];
			    triangle[2] = TIndex(i_pVertices[i]);
		    }
	    });
	return leftOut;
}

} // namespace FBXIO
