#pragma once

#include "DebugServices/GlobalLog.h"
#include "FBXIO/Mesh.h"

#include <fbxsdk.h>

#include <cstring>

namespace FBXIO
{

/// Gives vertices their texture coordinates. Where these are given by polygon vertex the vertices become one for each
/// coordinate; io_rIndices, the vertices of all polygons, follow.
/// @param i_pName the node's, for messages: meshes of some exporters have none.
template <typename TVertex>
void ApplyTexCoords(
    FbxMesh& io_rFrom, const char* i_pName, std::vector<TVertex>& io_rVertices, std::vector<std::uint32_t>& io_rIndices)
{
	FbxGeometryElementUV* const pUV = io_rFrom.GetElementUV(0);
	if (!pUV)
		return;
	const auto mode = pUV->GetMappingMode();
	if (mode != FbxLayerElement::eByControlPoint && mode != FbxLayerElement::eByPolygonVertex)
		return;
	const auto& rDirect = pUV->GetDirectArray();
	const auto setCoordinate = [&rDirect](TVertex& o_rVertex, int i_Entry)
	{
		const FbxVector2 coordinate = rDirect.GetAt(i_Entry);
		o_rVertex.m_TexCoord = {float(coordinate[0]), float(coordinate[1])};
	};
	if (mode == FbxLayerElement::eByControlPoint)
	{
		for (int i = 0; i < std::min(rDirect.GetCount(), int(io_rVertices.size())); ++i)
			setCoordinate(io_rVertices[i], i);
		return;
	}
	const auto* const pIndex = pUV->GetReferenceMode() != FbxLayerElement::eDirect ? &pUV->GetIndexArray() : nullptr;
	const int entries = rDirect.GetCount();
	constexpr std::uint32_t c_None = 0xFFFFFFFFu;
	std::vector<std::uint32_t> vertexOfEntry(rDirect.GetCount(), c_None);
	std::vector<TVertex> vertices;
	vertices.reserve(rDirect.GetCount());
	std::size_t moved = 0;
	std::size_t missing = 0;
	for (int polygon = 0, count = io_rFrom.GetPolygonCount(); polygon < count; ++polygon)
	{
		const int start = io_rFrom.GetPolygonVertexIndex(polygon);
		const int end = start + io_rFrom.GetPolygonSize(polygon);
		for (int i = start; i < end; ++i)
		{
			const int entry = !pIndex ? i : i < pIndex->GetCount() ? pIndex->GetAt(i) : -1;
			const TVertex& rPoint = io_rVertices[io_rIndices[i]];
			if (entry < 0 || entry >= entries)
			{
				++missing;
				io_rIndices[i] = std::uint32_t(vertices.size());
				vertices.push_back(rPoint);
				continue;
			}
			std::uint32_t& rVertex = vertexOfEntry[entry];
			if (rVertex == c_None)
			{
				rVertex = std::uint32_t(vertices.size());
				vertices.push_back(rPoint);
				setCoordinate(vertices.back(), entry);
			}
			else if (vertices[rVertex].m_Position != rPoint.m_Position)
				++moved;
			io_rIndices[i] = rVertex;
		}
	}
	io_rVertices = std::move(vertices);
	if (moved > 0)
		NVX_LOG("FBXIO", NVX::ELogWarning,
		    "%1% polygon vertices of mesh %2% are moved to other control points that share their texture coordinate",
		    moved, i_pName);
	if (missing > 0)
		NVX_LOG(
		    "FBXIO", NVX::ELogWarning, "%1% polygon vertices of mesh %2% have no texture coordinate", missing, i_pName);
}

/// Cuts polygons into fans of triangles, each for the part of its material.
template <typename TIndex>
void SplitIntoParts(FbxMesh& io_rFrom, const std::vector<std::uint32_t>& i_rIndices, std::vector<VMeshPart>& io_rParts)
{
	const int count = io_rFrom.GetPolygonCount();
	const bool bMaterial = io_rFrom.GetElementMaterialCount() > 0;
	if (!bMaterial)
		NVX_LOG("FBXIO", NVX::ELogWarning, "Missing material for mesh %1%", io_rFrom.GetName());
	const FbxLayerElementArrayTemplate<int>* const pList =
	    bMaterial ? &io_rFrom.GetElementMaterial()->GetIndexArray() : nullptr;
	const bool bList = pList && pList->GetCount() == count;
	const auto partOf = [&](int i_Polygon) { return bList ? std::size_t(std::max(pList->GetAt(i_Polygon), 0)) : 0u; };
	std::vector<std::size_t> triangles(io_rParts.size());
	for (int polygon = 0; polygon < count; ++polygon)
		if (partOf(polygon) < triangles.size())
			triangles[partOf(polygon)] += std::max(io_rFrom.GetPolygonSize(polygon) - 2, 0);
	std::vector<std::uint8_t*> next(io_rParts.size());
	for (std::size_t i = 0; i < io_rParts.size(); ++i)
	{
		io_rParts[i].m_IndexSize = sizeof(TIndex);
		io_rParts[i].m_Indices.resize(triangles[i] * 3 * sizeof(TIndex));
		next[i] = io_rParts[i].m_Indices.data();
	}
	for (int polygon = 0; polygon < count; ++polygon)
	{
		const std::size_t part = partOf(polygon);
		if (part >= io_rParts.size())
			continue;
		const std::uint32_t* const p = i_rIndices.data() + io_rFrom.GetPolygonVertexIndex(polygon);
		for (int i = 1, size = io_rFrom.GetPolygonSize(polygon); i + 1 < size; ++i)
		{
			const TIndex triangle[3]{TIndex(p[0]), TIndex(p[i]), TIndex(p[i + 1])};
			std::memcpy(next[part], triangle, sizeof(triangle));
			next[part] += sizeof(triangle);
		}
	}
}

} // namespace FBXIO
