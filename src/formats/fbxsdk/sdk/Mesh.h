#pragma once

#include "fbxsdk/sdk/Deformer.h"
#include "fbxsdk/sdk/Layer.h"
#include "fbxsdk/sdk/Node.h"
#include "fbxsdk/sdk/Status.h"

#include <map>

namespace fbxsdk
{

/// Control points and layer elements. Arrays are decoded when they are asked for.
class FbxGeometryBase : public FbxNodeAttribute
{
public:
	int GetControlPointsCount() const
	{
		Load();
		return int(m_Points.size() / 3);
	}

	/// Relative to the node, in file units. Zeros beyond the end.
	FbxVector4 GetControlPointAt(int pIndex) const
	{
		if (pIndex < 0 || pIndex >= GetControlPointsCount())
			return {};
		const double* const p = m_Points.data() + 3 * std::size_t(pIndex);
		return {p[0], p[1], p[2]};
	}

	/// The elements of a kind in the order of the file, but first that of the first layer; null if there are not so
	/// many.
	FbxGeometryElementNormal* GetElementNormal(int pIndex = 0);
	FbxGeometryElementUV* GetElementUV(
	    int pIndex = 0, FbxLayerElement::EType pTypeIdentifier = FbxLayerElement::eUnknown);
	FbxGeometryElementMaterial* GetElementMaterial(int pIndex = 0);
	int GetElementMaterialCount() const;

protected:
	FbxGeometryBase(std::string i_Name, const FbxFormat::VArraySource& i_rRecord)
	    : FbxNodeAttribute(std::move(i_Name)), m_Record(i_rRecord)
	{
	}
	void Load() const
	{
		if (!m_bLoaded)
			LoadArrays();
	}
	virtual void LoadArrays() const = 0;

	template <typename T>
	using VElements = std::map<int, std::unique_ptr<T>>;

	template <typename T>
	T* Element(VElements<T>& io_rElements, const char* i_pRecord, const char* i_pDirect, const char* i_pIndex,
	    int i_Place) const;
	/// The layer elements of that kind.
	const std::vector<FbxFormat::VElementIndex>& LayerRecords(std::string_view i_Name) const;

	FbxFormat::VArraySource m_Record;
	mutable bool m_bLoaded = false;
	/// Three for each point.
	mutable FbxFormat::VArrayNumbers<double> m_Points;
	VElements<FbxGeometryElementNormal> m_Normals;
	mutable VElements<FbxGeometryElementUV> m_UVs;
	VElements<FbxGeometryElementMaterial> m_Materials;

private:
	mutable std::map<std::string_view, std::vector<FbxFormat::VElementIndex>> m_LayerRecords;
};

class FbxGeometry : public FbxGeometryBase
{
public:
	/// Counted among those of the type; null if there are not so many. Only skins are kept of a file.
	FbxDeformer* GetDeformer(int pIndex, FbxDeformer::EDeformerType pDeformerType, FbxStatus* pStatus = nullptr) const;

protected:
	friend class FbxFormat::VSceneBuilder;
	using FbxGeometryBase::FbxGeometryBase;

	std::vector<FbxSkin*> m_Skins;
};

class FbxMesh : public FbxGeometry
{
public:
	FbxNodeAttribute::EType GetAttributeType() const override { return FbxNodeAttribute::eMesh; }

	int GetPolygonCount() const
	{
		Load();
		return int(m_PolygonStarts.size());
	}

	/// 0 for a polygon that names control points that do not exist; -1 if there is no such polygon.
	int GetPolygonSize(int pPolygonIndex) const
	{
		return pPolygonIndex >= 0 && pPolygonIndex < GetPolygonCount() ? m_PolygonSizes[pPolygonIndex] : -1;
	}

	/// The place of the polygon's first vertex in GetPolygonVertices; -1 if there is no such polygon.
	int GetPolygonVertexIndex(int pPolygonIndex) const
	{
		return pPolygonIndex >= 0 && pPolygonIndex < GetPolygonCount() ? m_PolygonStarts[pPolygonIndex] : -1;
	}

	/// The control points of all polygons, one behind the other. Those of polygons of size 0 may not exist.
	int* GetPolygonVertices() const;
	int GetPolygonVertexCount() const;

	/// Replaces the first normal element by one normal for each control point: the mean of its polygons' normals by
	/// area. Zero for points without polygons. False if nothing was done: there is one and it is not to be overwritten,
	/// or normals of another mapping are asked for.
	bool GenerateNormals(bool pOverwrite = false, bool pByCtrlPoint = false, bool pCW = false);

private:
	friend class FbxCluster;
	friend class FbxFormat::VSceneBuilder;
	friend class FbxNode;

	using FbxGeometry::FbxGeometry;

	/// False if control points or polygons are damaged.
	bool IsSound() const;
	void LoadArrays() const override;
	/// For decoding it together with others.
	void AddJobs(std::vector<FbxFormat::VDecodeJob>& io_rJobs) const;
	/// After them; they begin with those of this mesh.
	void EndJobs(std::span<const FbxFormat::VDecodeJob> i_Jobs) const;
	void CutPolygons() const;

	mutable bool m_bSound = false;
	mutable FbxFormat::VArrayNumbers<int> m_PolygonVertices;
	mutable std::vector<int> m_PolygonStarts;
	mutable std::vector<int> m_PolygonSizes;
};

} // namespace fbxsdk
