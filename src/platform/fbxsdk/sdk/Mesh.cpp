#include "fbxsdk/sdk/Mesh.h"

#include "DebugServices/GlobalLog.h"

#include <cmath>

int fbxsdk::FbxGeometryBase::GetControlPointsCount() const
{
	Load();
	return int(m_Points.size() / 3);
}

fbxsdk::FbxVector4 fbxsdk::FbxGeometryBase::GetControlPointAt(int pIndex) const
{
	if (pIndex < 0 || pIndex >= GetControlPointsCount())
		return {};
	const double* const p = m_Points.data() + 3 * std::size_t(pIndex);
	return {p[0], p[1], p[2]};
}

template <typename T>
T* fbxsdk::FbxGeometryBase::Element(
    VElements<T>& io_rElements, const char* i_pRecord, const char* i_pDirect, const char* i_pIndex, int i_Place)
{
	if (const auto found = io_rElements.find(i_Place); found != io_rElements.end())
		return found->second.get();
	int place = 0;
	for (const FbxFile::VElementIndex child : m_Record.m_pTree->Children(m_Record.m_Element))
		if (m_Record.m_pTree->Name(child) == i_pRecord && place++ == i_Place)
		{
			const FbxFile::VArraySource record{m_Record.m_pTree, m_Record.m_pBudget, child};
			return io_rElements.emplace(i_Place, new T(record, i_pDirect, i_pIndex, GetName())).first->second.get();
		}
	return nullptr;
}

fbxsdk::FbxGeometryElementNormal* fbxsdk::FbxGeometryBase::GetElementNormal(int pIndex)
{
	return Element(m_Normals, "LayerElementNormal", "Normals", "NormalsIndex", pIndex);
}

fbxsdk::FbxGeometryElementUV* fbxsdk::FbxGeometryBase::GetElementUV(
    int pIndex, FbxLayerElement::EType /*pTypeIdentifier*/)
{
	return Element(m_UVs, "LayerElementUV", "UV", "UVIndex", pIndex);
}

fbxsdk::FbxGeometryElementMaterial* fbxsdk::FbxGeometryBase::GetElementMaterial(int pIndex)
{
	return Element(m_Materials, "LayerElementMaterial", "", "Materials", pIndex);
}

int fbxsdk::FbxGeometryBase::GetElementMaterialCount() const
{
	int count = 0;
	for (const FbxFile::VElementIndex child : m_Record.m_pTree->Children(m_Record.m_Element))
		count += m_Record.m_pTree->Name(child) == "LayerElementMaterial" ? 1 : 0;
	return count;
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

void fbxsdk::FbxMesh::Load() const
{
	if (m_bLoaded)
		return;
	m_bLoaded = true;
	m_bSound = FbxFile::Decode(m_Record.Child("Vertices"), GetName(), m_Points)
	    && FbxFile::Decode(m_Record.Child("PolygonVertexIndex"), GetName(), m_PolygonVertices);
	if (m_bSound)
		CutPolygons();
	else
		m_Points.clear();
}

void fbxsdk::FbxMesh::CutPolygons() const
{
	const int points = int(m_Points.size() / 3);
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
		const double length = std::hypot(normals[i], normals[i + 1], normals[i + 2]);
		for (int x = 0; x < 3; ++x)
			normals[i + x] = length > 0.0 && std::isfinite(length) ? normals[i + x] / length : 0.0;
	}
	m_Normals[0].reset(new FbxGeometryElementNormal(std::move(normals)));
	return true;
}
