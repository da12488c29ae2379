#include "fbxsdk/sdk/Mesh.h"

#include "DebugServices/GlobalLog.h"

#include <algorithm>
#include <cmath>

namespace
{

constexpr const char* c_pNormals = "LayerElementNormal";
constexpr const char* c_pUVs = "LayerElementUV";
constexpr const char* c_pMaterials = "LayerElementMaterial";

} // namespace

const std::vector<FbxFormat::VElementIndex>& fbxsdk::FbxGeometryBase::LayerRecords(std::string_view i_Name) const
{
	// Found once: a mesh may be placed many times, and have many records.
	if (m_LayerRecords.empty())
	{
		for (const char* pName : {c_pNormals, c_pUVs, c_pMaterials})
			m_LayerRecords[pName];
		for (const FbxFormat::VElementIndex child : m_Record.m_pTree->Children(m_Record.m_Element))
			if (const auto found = m_LayerRecords.find(m_Record.m_pTree->Name(child)); found != m_LayerRecords.end())
				found->second.push_back(child);
	}
	return m_LayerRecords.find(i_Name)->second;
}

template <typename T>
T* fbxsdk::FbxGeometryBase::Element(
    VElements<T>& io_rElements, const char* i_pRecord, const char* i_pDirect, const char* i_pIndex, int i_Place) const
{
	if (const auto found = io_rElements.find(i_Place); found != io_rElements.end())
		return found->second.get();
	const std::vector<FbxFormat::VElementIndex>& rRecords = LayerRecords(i_pRecord);
	if (i_Place < 0 || std::size_t(i_Place) >= rRecords.size())
		return nullptr;
	const FbxFormat::VArraySource record{m_Record.m_pTree, m_Record.m_pBudget, rRecords[i_Place]};
	return io_rElements.emplace(i_Place, new T(record, i_pDirect, i_pIndex, GetName())).first->second.get();
}

fbxsdk::FbxGeometryElementNormal* fbxsdk::FbxGeometryBase::GetElementNormal(int pIndex)
{
	return Element(m_Normals, c_pNormals, "Normals", "NormalsIndex", pIndex);
}

fbxsdk::FbxGeometryElementUV* fbxsdk::FbxGeometryBase::GetElementUV(
    int pIndex, FbxLayerElement::EType /*pTypeIdentifier*/)
{
	return Element(m_UVs, c_pUVs, "UV", "UVIndex", pIndex);
}

fbxsdk::FbxGeometryElementMaterial* fbxsdk::FbxGeometryBase::GetElementMaterial(int pIndex)
{
	return Element(m_Materials, c_pMaterials, "", "Materials", pIndex);
}

int fbxsdk::FbxGeometryBase::GetElementMaterialCount() const
{
	return int(LayerRecords(c_pMaterials).size());
}

fbxsdk::FbxDeformer* fbxsdk::FbxGeometry::GetDeformer(
    int pIndex, FbxDeformer::EDeformerType pDeformerType, FbxStatus* /*pStatus*/) const
{
	const bool bValid = pDeformerType == FbxDeformer::eSkin && pIndex >= 0 && std::size_t(pIndex) < m_Skins.size();
	return bValid ? m_Skins[pIndex] : nullptr;
}

bool fbxsdk::FbxMesh::IsSound() const
{
	Load();
	return m_bSound;
}

void fbxsdk::FbxMesh::LoadArrays() const
{
	m_bLoaded = true;
	std::vector<FbxFormat::VDecodeJob> jobs{{m_Record.Child("Vertices"), GetName(), &m_Points},
	    {m_Record.Child("PolygonVertexIndex"), GetName(), &m_PolygonVertices}};
	// Who reads a mesh asks for its texture coordinates next.
	const FbxGeometryElementUV* const pUV = Element(m_UVs, c_pUVs, "UV", "UVIndex", 0);
	if (pUV)
		pUV->AddJobs(jobs);
	FbxFormat::Decode(jobs);
	if (pUV)
		pUV->EndJobs();
	m_bSound = jobs[0].m_bSound && jobs[1].m_bSound;
	if (m_bSound)
		CutPolygons();
	else
		m_Points.clear();
}

void fbxsdk::FbxMesh::CutPolygons() const
{
	const int points = int(m_Points.size() / 3);
	const auto polygons = std::size_t(
	    std::count_if(m_PolygonVertices.begin(), m_PolygonVertices.end(), [](int i_Vertex) { return i_Vertex < 0; }));
	m_PolygonStarts.reserve(polygons);
	m_PolygonSizes.reserve(polygons);
	int start = 0;
	int broken = 0;
	bool bSound = true;
	for (int i = 0; i < int(m_PolygonVertices.size()); ++i)
	{
		int& rVertex = m_PolygonVertices[i];
		// The last vertex of a polygon is written as its complement.
		const bool bLast = rVertex < 0;
		if (bLast)
			rVertex = ~rVertex;
		bSound = bSound && rVertex < points;
		if (!bLast)
			continue;
		m_PolygonStarts.push_back(start);
		m_PolygonSizes.push_back(bSound ? i + 1 - start : 0);
		broken += bSound ? 0 : 1;
		start = i + 1;
		bSound = true;
	}
	if (start != int(m_PolygonVertices.size()))
		++broken;
	if (broken > 0)
		NVX_LOG("FBXIO", NVX::ELogWarning,
		    "Polygons left out of mesh %1% because they have no end or name control points that do not exist: %2%",
		    GetName(), broken);
}

int* fbxsdk::FbxMesh::GetPolygonVertices() const
{
	Load();
	return m_PolygonVertices.data();
}

int fbxsdk::FbxMesh::GetPolygonVertexCount() const
{
	Load();
	return int(m_PolygonVertices.size());
}

bool fbxsdk::FbxMesh::GenerateNormals(bool pOverwrite, bool pByCtrlPoint, bool pCW)
{
	if (!pByCtrlPoint || (!pOverwrite && GetElementNormal()))
		return false;
	std::vector<double> normals(3 * std::size_t(GetControlPointsCount()), 0.0);
	for (int polygon = 0; polygon < GetPolygonCount(); ++polygon)
	{
		const int size = m_PolygonSizes[polygon];
		const int* const pVertices = m_PolygonVertices.data() + m_PolygonStarts[polygon];
		// Twice the area vector: sum of the cross products of edges from the first vertex, so that the place of the
		// polygon costs no digits.
		double area[3]{};
		for (int i = 1; i + 1 < size; ++i)
		{
			const double* const a = m_Points.data() + 3 * std::size_t(pVertices[0]);
			const double* const b = m_Points.data() + 3 * std::size_t(pVertices[i]);
			const double* const c = m_Points.data() + 3 * std::size_t(pVertices[i + 1]);
			for (int x = 0; x < 3; ++x)
			{
				const int y = (x + 1) % 3;
				const int z = (x + 2) % 3;
				area[x] += (b[y] - a[y]) * (c[z] - a[z]) - (b[z] - a[z]) * (c[y] - a[y]);
			}
		}
		for (int i = 0; i < size; ++i)
			for (int x = 0; x < 3; ++x)
				normals[3 * std::size_t(pVertices[i]) + x] += pCW ? -area[x] : area[x];
	}
	for (std::size_t i = 0; i < normals.size(); i += 3)
	{
		double square = 0.0;
		for (int x = 0; x < 3; ++x)
			square += normals[i + x] * normals[i + x];
		const double length = std::sqrt(square);
		for (int x = 0; x < 3; ++x)
			normals[i + x] = length > 0.0 && std::isfinite(length) ? normals[i + x] / length : 0.0;
	}
	m_Normals[0].reset(new FbxGeometryElementNormal(std::move(normals)));
	return true;
}
