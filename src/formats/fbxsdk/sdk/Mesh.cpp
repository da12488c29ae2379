#include "fbxsdk/sdk/Mesh.h"

#include "DebugServices/GlobalLog.h"
#include "fbxsdk/container/Values.h"

#include <algorithm>
#include <cmath>

namespace
{

constexpr const char* c_pNormals = "LayerElementNormal";
constexpr const char* c_pUVs = "LayerElementUV";
constexpr const char* c_pMaterials = "LayerElementMaterial";

} // namespace

namespace
{

/// Calls i_Visit(name, number) for the elements that the first layer of a mesh has: number tells which of those of that
/// name.
template <typename TVisit>
void ForEachOfFirstLayer(const FbxFormat::VArraySource& i_rMesh, TVisit&& i_Visit)
{
	const FbxFormat::VElementTree& rTree = *i_rMesh.m_pTree;
	for (const FbxFormat::VElementIndex layer : rTree.Children(i_rMesh.m_Element))
	{
		if (rTree.Name(layer) != "Layer" || FbxFormat::ValueAt(rTree, layer, 0).AsInteger() != 0)
			continue;
		for (const FbxFormat::VElementIndex element : rTree.Children(layer))
		{
			const FbxFormat::VElementIndex type = rTree.Find(element, "Type");
			const FbxFormat::VElementIndex number = rTree.Find(element, "TypedIndex");
			if (type != FbxFormat::c_NoElement && number != FbxFormat::c_NoElement)
				i_Visit(FbxFormat::ValueAt(rTree, type, 0).m_Text, FbxFormat::ValueAt(rTree, number, 0).AsInteger());
		}
		return;
	}
}

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
		std::map<std::string_view, std::int64_t> first;
		ForEachOfFirstLayer(m_Record,
		    [&](std::string_view i_Type, std::int64_t i_Number)
		    {
			    if (m_LayerRecords.contains(i_Type))
				    first.try_emplace(i_Type, i_Number);
		    });
		for (const auto& [type, number] : first)
		{
			std::vector<FbxFormat::VElementIndex>& rRecords = m_LayerRecords[type];
			const auto record = std::find_if(rRecords.begin(), rRecords.end(),
			    [this, wanted = number](FbxFormat::VElementIndex i_Record)
			    { return FbxFormat::ValueAt(*m_Record.m_pTree, i_Record, 0).AsInteger(-1) == wanted; });
			if (record != rRecords.end())
				std::rotate(rRecords.begin(), record, record + 1);
		}
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
	std::vector<FbxFormat::VDecodeJob> jobs;
	AddJobs(jobs);
	FbxFormat::Decode(jobs);
	EndJobs(jobs);
}

void fbxsdk::FbxMesh::AddJobs(std::vector<FbxFormat::VDecodeJob>& io_rJobs) const
{
	io_rJobs.push_back({m_Record.Child("Vertices"), GetName(), &m_Points});
	io_rJobs.push_back({m_Record.Child("PolygonVertexIndex"), GetName(), &m_PolygonVertices});
	// Who reads a mesh asks for its texture coordinates next.
	if (const FbxGeometryElementUV* const pUV = Element(m_UVs, c_pUVs, "UV", "UVIndex", 0))
		pUV->AddJobs(io_rJobs);
}

void fbxsdk::FbxMesh::EndJobs(std::span<const FbxFormat::VDecodeJob> i_Jobs) const
{
	m_bLoaded = true;
	if (const FbxGeometryElementUV* const pUV = Element(m_UVs, c_pUVs, "UV", "UVIndex", 0))
		pUV->EndJobs();
	m_bSound = i_Jobs[0].m_bSound && i_Jobs[1].m_bSound;
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
	// Their places are larger than what the file has of them.
	if (!m_Record.m_pBudget->Take(polygons * 2 * sizeof(int)))
	{
		NVX_LOG("FBXIO", NVX::ELogWarning, "Mesh %1% left out because it has too many polygons", GetName());
		m_bSound = false;
		m_Points = {};
		m_PolygonVertices = {};
		return;
	}
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
	FbxFormat::VArrayNumbers<double> normals(3 * std::size_t(GetControlPointsCount()), 0.0);
	for (int polygon = 0; polygon < GetPolygonCount(); ++polygon)
	{
		const int size = m_PolygonSizes[polygon];
		const int* const pVertices = m_PolygonVertices.data() + m_PolygonStarts[polygon];
		// Twice the area vector: sum of the cross products of edges from the first vertex, so that the place of the
		// polygon costs no digits. Of two triangles it is that of the diagonals.
		double area[3]{};
		const auto add = [&](int i_A, int i_B, int i_C, int i_D)
		{
			const double* const a = m_Points.data() + 3 * std::size_t(pVertices[i_A]);
			const double* const b = m_Points.data() + 3 * std::size_t(pVertices[i_B]);
			const double* const c = m_Points.data() + 3 * std::size_t(pVertices[i_C]);
			const double* const d = m_Points.data() + 3 * std::size_t(pVertices[i_D]);
			const double first[3]{b[0] - a[0], b[1] - a[1], b[2] - a[2]};
			const double second[3]{d[0] - c[0], d[1] - c[1], d[2] - c[2]};
			area[0] += first[1] * second[2] - first[2] * second[1];
			area[1] += first[2] * second[0] - first[0] * second[2];
			area[2] += first[0] * second[1] - first[1] * second[0];
		};
		if (size == 4)
			add(0, 2, 1, 3);
		else
			for (int i = 1; i + 1 < size; ++i)
				add(0, i, 0, i + 1);
		const double sign = pCW ? -1.0 : 1.0;
		for (int i = 0; i < size; ++i)
		{
			double* const pNormal = normals.data() + 3 * std::size_t(pVertices[i]);
			for (int x = 0; x < 3; ++x)
				pNormal[x] += sign * area[x];
		}
	}
	for (std::size_t i = 0; i < normals.size(); i += 3)
	{
		double square = 0.0;
		for (int x = 0; x < 3; ++x)
			square += normals[i + x] * normals[i + x];
		const double scale = square > 0.0 && std::isfinite(square) ? 1.0 / std::sqrt(square) : 0.0;
		for (int x = 0; x < 3; ++x)
			normals[i + x] = scale > 0.0 ? normals[i + x] * scale : 0.0;
	}
	m_Normals[0].reset(new FbxGeometryElementNormal(std::move(normals)));
	return true;
}
