#include "FBXIO/Seams.h"

#include <algorithm>

namespace
{

constexpr std::uint32_t c_NoVertex = 0xFFFFFFFFu;

/// The polygon vertices of a mesh that are sound, and the entries of their texture coordinates.
class VCorners
{
public:
	VCorners(FbxMesh& io_rFrom, const FbxGeometryElementUV& i_rUV)
	    : m_rMesh(io_rFrom), m_pPoints(io_rFrom.GetPolygonVertices()), m_Entries(i_rUV.GetDirectArray().GetCount()),
	      m_pIndex(i_rUV.GetReferenceMode() != FbxLayerElement::eDirect ? &i_rUV.GetIndexArray() : nullptr)
	{
	}

	template <typename TVisit>
	void ForEach(TVisit&& i_Visit) const
	{
		for (int polygon = 0, count = m_rMesh.GetPolygonCount(); polygon < count; ++polygon)
		{
			const int start = m_rMesh.GetPolygonVertexIndex(polygon);
			for (int i = start, end = start + m_rMesh.GetPolygonSize(polygon); i < end; ++i)
				i_Visit(std::uint32_t(i));
		}
	}

	std::size_t Count() const { return m_rMesh.GetPolygonVertexCount(); }
	std::uint32_t Point(std::uint32_t i_Corner) const { return m_pPoints[i_Corner]; }
	std::size_t Points() const { return m_rMesh.GetControlPointsCount(); }
	std::size_t Entries() const { return m_Entries; }
	std::int32_t Entry(std::uint32_t i_Corner) const
	{
		const int entry = !m_pIndex                ? int(i_Corner)
		    : int(i_Corner) < m_pIndex->GetCount() ? m_pIndex->GetAt(int(i_Corner))
		                                           : -1;
		return entry >= 0 && entry < m_Entries ? entry : -1;
	}

private:
	FbxMesh& m_rMesh;
	const int* m_pPoints;
	int m_Entries;
	const FbxLayerElementArrayTemplate<int>* m_pIndex;
};

/// For each corner the first one that has the same entry; one without an entry stands alone.
std::vector<std::uint32_t> FirstOfEntries(const VCorners& i_rCorners)
{
	std::vector<std::uint32_t> firstOfEntry(i_rCorners.Entries(), c_NoVertex);
	std::vector<std::uint32_t> firsts(i_rCorners.Count());
	i_rCorners.ForEach(
	    [&](std::uint32_t i_Corner)
	    {
		    const std::int32_t entry = i_rCorners.Entry(i_Corner);
		    if (entry >= 0 && firstOfEntry[entry] == c_NoVertex)
			    firstOfEntry[entry] = i_Corner;
		    firsts[i_Corner] = entry < 0 ? i_Corner : firstOfEntry[entry];
	    });
	return firsts;
}

/// For each corner the first one that has the same point and the same entry. The corners of each point are sorted: no
/// choice of points and entries makes that slow, as it could a table of hashes.
std::vector<std::uint32_t> FirstOfPairs(const VCorners& i_rCorners)
{
	std::vector<std::uint32_t> ends(i_rCorners.Points() + 1);
	i_rCorners.ForEach([&](std::uint32_t i_Corner) { ++ends[i_rCorners.Point(i_Corner) + 1]; });
	for (std::size_t point = 1; point < ends.size(); ++point)
		ends[point] += ends[point - 1];
	std::vector<std::uint32_t> sorted(ends.back());
	// Each beginning becomes the end.
	i_rCorners.ForEach([&](std::uint32_t i_Corner) { sorted[ends[i_rCorners.Point(i_Corner)]++] = i_Corner; });
	std::vector<std::uint32_t> firsts(i_rCorners.Count());
	auto begin = sorted.begin();
	for (std::size_t point = 0; point < i_rCorners.Points(); ++point)
	{
		const auto end = sorted.begin() + ends[point];
		std::sort(begin, end,
		    [&](std::uint32_t i_A, std::uint32_t i_B)
		    {
			    const std::int32_t a = i_rCorners.Entry(i_A);
			    const std::int32_t b = i_rCorners.Entry(i_B);
			    return a != b ? a < b : i_A < i_B;
		    });
		for (auto corner = begin; corner != end; ++corner)
		{
			const bool bSame = corner != begin && i_rCorners.Entry(*corner) == i_rCorners.Entry(corner[-1]);
			firsts[*corner] = bSame ? firsts[corner[-1]] : *corner;
		}
		begin = end;
	}
	return firsts;
}

} // namespace

std::optional<FBXIO::VSeams> FBXIO::FindSeams(FbxMesh& io_rFrom, EVertexKey i_Key)
{
	const FbxGeometryElementUV* const pUV = io_rFrom.GetElementUV(0);
	if (!pUV || pUV->GetMappingMode() != FbxLayerElement::eByPolygonVertex)
		return {};
	const VCorners corners(io_rFrom, *pUV);
	const std::vector<std::uint32_t> firsts =
	    i_Key == EVertexKey::UVIndex ? FirstOfEntries(corners) : FirstOfPairs(corners);
	VSeams seams;
	seams.m_Vertices.reserve(
	    i_Key == EVertexKey::UVIndex ? std::min(corners.Entries(), corners.Count()) : corners.Points());
	seams.m_Indices.resize(corners.Count());
	corners.ForEach(
	    [&](std::uint32_t i_Corner)
	    {
		    if (firsts[i_Corner] == i_Corner)
		    {
			    seams.m_Indices[i_Corner] = std::uint32_t(seams.m_Vertices.size());
			    seams.m_Vertices.push_back({corners.Point(i_Corner), corners.Entry(i_Corner)});
		    }
		    else
			    seams.m_Indices[i_Corner] = seams.m_Indices[firsts[i_Corner]];
	    });
	return seams;
}
