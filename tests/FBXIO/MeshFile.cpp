#include "MeshFile.h"

#include <boost/archive/iterators/base64_from_binary.hpp>
#include <boost/archive/iterators/transform_width.hpp>

#include <algorithm>

using namespace FbxTest;

namespace
{

std::string Base64(const std::string& i_rBytes)
{
	using namespace boost::archive::iterators;
	using VIterator = base64_from_binary<transform_width<std::string::const_iterator, 6, 8>>;
	std::string text(VIterator(i_rBytes.begin()), VIterator(i_rBytes.end()));
	return text.append((4 - text.size() % 4) % 4, '=');
}

VTestValue Integers(const VNumbers& i_rNumbers)
{
	return VIntegers(i_rNumbers.begin(), i_rNumbers.end());
}

/// Adds objects and their connections, by numbers or by names.
class VObjects
{
public:
	VObjects(const VTestForm& i_rForm, const VTestScene& i_rScene)
	    : m_bNew(i_rForm.m_Version >= 7000), m_Records(Records(i_rForm, i_rScene))
	{
	}

	std::vector<VTestRecord>& All() { return m_Records; }

	/// The record of a node.
	VTestRecord& Node(const VTestValue& i_rKey)
	{
		auto& rObjects = Top("Objects").m_Children;
		return *std::find_if(rObjects.begin(), rObjects.end(),
		    [&](const VTestRecord& i_rRecord)
		    { return i_rRecord.m_Name == "Model" && i_rRecord.m_Values[0] == i_rKey; });
	}

	/// @return what connections name the object by.
	VTestValue Add(
	    const char* i_pClass, const std::string& i_rName, const char* i_pKind, std::vector<VTestRecord> i_Children)
	{
		const std::string name = std::string(i_pClass) + "::" + i_rName;
		VTestRecord object = Record(i_pClass, {name, std::string(i_pKind)}, std::move(i_Children));
		const std::int64_t id = 2'000'000 + m_Count++;
		if (m_bNew)
			object.m_Values.insert(object.m_Values.begin(), id);
		Top("Objects").m_Children.push_back(std::move(object));
		return m_bNew ? VTestValue(id) : VTestValue(name);
	}

	void Connect(VTestValue i_Child, VTestValue i_Parent, const char* i_pProperty = nullptr)
	{
		VTestRecord connection = Record(m_bNew ? "C" : "Connect",
		    {std::string(i_pProperty ? "OP" : "OO"), std::move(i_Child), std::move(i_Parent)});
		if (i_pProperty)
			connection.m_Values.push_back(std::string(i_pProperty));
		Top("Connections").m_Children.push_back(std::move(connection));
	}

private:
	VTestRecord& Top(const char* i_pName)
	{
		return *std::find_if(m_Records.begin(), m_Records.end(),
		    [&](const VTestRecord& i_rRecord) { return i_rRecord.m_Name == i_pName; });
	}

	bool m_bNew;
	std::vector<VTestRecord> m_Records;
	std::int64_t m_Count = 0;
};

void AddLayer(std::vector<VTestRecord>& io_rGeometry, const char* i_pName, const char* i_pDirect, const char* i_pIndex,
    const VTestLayer& i_rLayer, int i_Number = 0)
{
	if (i_rLayer.m_Mapping.empty())
		return;
	VTestRecord layer = Record(i_pName, {std::int32_t(i_Number)},
	    {Record("MappingInformationType", {i_rLayer.m_Mapping}),
	        Record("ReferenceInformationType", {i_rLayer.m_Reference})});
	if (*i_pDirect)
		layer.m_Children.push_back(Record(i_pDirect, {i_rLayer.m_Direct}));
	if (!i_rLayer.m_Index.empty())
		layer.m_Children.push_back(Record(i_pIndex, {Integers(i_rLayer.m_Index)}));
	io_rGeometry.push_back(std::move(layer));
}

void AddMaterials(const VTestForm& i_rForm, const VTestValue& i_rNode, VObjects& io_rObjects, const VTestMesh& i_rMesh)
{
	for (std::size_t i = 0; i < i_rMesh.m_Materials.size(); ++i)
	{
		const VTestMaterial& rMaterial = i_rMesh.m_Materials[i];
		const std::string name = std::to_string(i_rMesh.m_Node) + '-' + std::to_string(i);
		const VTestValue key = io_rObjects.Add("Material", "material" + name, "",
		    {Record("ShadingModel", {rMaterial.m_ShadingModel}),
		        PropertyList(i_rForm.m_Version, rMaterial.m_Properties)});
		io_rObjects.Connect(key, i_rNode);
		if (rMaterial.m_FileName.empty() && rMaterial.m_RelativeName.empty())
			continue;
		const VTestValue texture = io_rObjects.Add("Texture", "texture" + name, "TextureVideoClip",
		    {Record("FileName", {rMaterial.m_FileName}), Record("RelativeFilename", {rMaterial.m_RelativeName})});
		if (!rMaterial.m_Content.empty())
		{
			// As text in two pieces.
			const std::string text = Base64(rMaterial.m_Content);
			VTestRecord content = Record("Content",
			    {VRaw{i_rForm.m_Form == EForm::Binary
			            ? Bytes('R', std::uint32_t(rMaterial.m_Content.size()), rMaterial.m_Content)
			            : '"' + text.substr(0, 8) + "\",\n\"" + text.substr(8) + '"'}});
			const std::string& rName =
			    rMaterial.m_RelativeName.empty() ? rMaterial.m_FileName : rMaterial.m_RelativeName;
			io_rObjects.Connect(
			    io_rObjects.Add("Video", "video" + name, "Clip", {Record("Filename", {rName}), std::move(content)}),
			    texture);
		}
		if (rMaterial.m_bSecondVideo)
			io_rObjects.Connect(io_rObjects.Add("Video", "second" + name, "Clip",
			                        {Record("Filename", {rMaterial.m_FileName}), Record("Content", {std::string()})}),
			    texture);
		if (i_rForm.m_Version >= 7000)
			io_rObjects.Connect(texture, key, rMaterial.m_Property.c_str());
		else
			io_rObjects.Connect(texture, i_rNode);
	}
}

} // namespace

std::vector<VTestRecord> FbxTest::Records(
    const VTestForm& i_rForm, const VTestScene& i_rScene, const std::vector<VTestMesh>& i_rMeshes)
{
	VObjects objects(i_rForm, i_rScene);
	for (const VTestMesh& rMesh : i_rMeshes)
	{
		const VTestValue node = NodeKey(i_rForm, i_rScene, rMesh.m_Node);
		const std::string& rName = i_rScene.m_Nodes[rMesh.m_Node].m_Name;
		std::vector<VTestRecord> geometry{
		    Record("Vertices", {rMesh.m_Points}), Record("PolygonVertexIndex", {Integers(rMesh.m_Polygons)})};
		AddLayer(geometry, "LayerElementNormal", "Normals", "NormalsIndex", rMesh.m_Normals);
		AddLayer(geometry, "LayerElementUV", "UV", "UVIndex", rMesh.m_SecondUV, 1);
		AddLayer(geometry, "LayerElementUV", "UV", "UVIndex", rMesh.m_UV);
		AddLayer(geometry, "LayerElementMaterial", "", "Materials", rMesh.m_MaterialLayer);
		AddLayer(geometry, "LayerElementTexture", "", "TextureId", rMesh.m_TextureLayer);
		AddLayer(geometry, "LayerElementEmissiveTextures", "", "TextureId", rMesh.m_EmissiveTextureLayer);
		VTestRecord layer = Record("Layer", {std::int32_t(0)});
		for (std::size_t i = 2; i < geometry.size(); ++i)
			if (geometry[i].m_Values[0] == VTestValue(std::int32_t(0)))
				layer.m_Children.push_back(Record("LayerElement", {},
				    {Record("Type", {geometry[i].m_Name}), Record("TypedIndex", {std::int32_t(0)})}));
		if (!layer.m_Children.empty())
			geometry.push_back(std::move(layer));
		VTestValue owner = node;
		if (i_rForm.m_Version >= 7000)
		{
			owner = objects.Add("Geometry", rName + "Shape", "Mesh", std::move(geometry));
			objects.Connect(owner, node);
		}
		else
		{
			auto& rChildren = objects.Node(node).m_Children;
			rChildren.insert(rChildren.end(), geometry.begin(), geometry.end());
		}
		AddMaterials(i_rForm, node, objects, rMesh);
		if (rMesh.m_Clusters.empty())
			continue;
		const VTestValue skin =
		    objects.Add("Deformer", "skin of " + rName, "Skin", {Record("Version", {std::int32_t(101)})});
		objects.Connect(skin, owner);
		for (std::size_t i = 0; i < rMesh.m_Clusters.size(); ++i)
		{
			const VTestCluster& rCluster = rMesh.m_Clusters[i];
			std::vector<VTestRecord> children;
			if (!rCluster.m_Points.empty())
				children = {Record("Indexes", {Integers(rCluster.m_Points)}), Record("Weights", {rCluster.m_Weights})};
			for (const auto& [pName, rMatrix] :
			    {std::pair<const char*, const VNumbers&>{"Transform", rCluster.m_Transform},
			        {"TransformLink", rCluster.m_Link}})
				if (!rMatrix.empty())
					children.push_back(Record(pName, {rMatrix}));
			const VTestValue cluster =
			    objects.Add("Deformer", rName + " cluster" + std::to_string(i), "Cluster", std::move(children));
			objects.Connect(cluster, skin);
			if (rCluster.m_Node >= 0)
				objects.Connect(NodeKey(i_rForm, i_rScene, rCluster.m_Node), cluster);
		}
	}
	return std::move(objects.All());
}
