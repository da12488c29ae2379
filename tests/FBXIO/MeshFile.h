#pragma once

#include "../fbxsdk/FbxFileBuilder.h"

/// Writes small FBX files with one mesh for tests, in every form of the format.
namespace FbxTest
{

struct VTestLayer
{
	std::string m_Mapping;
	std::string m_Reference;
	VNumbers m_Direct;
	/// None is written if it is empty.
	VNumbers m_Index;
};

struct VTestMaterial
{
	std::string m_ShadingModel;
	std::vector<std::pair<std::string, VNumbers>> m_Properties;
	/// File name and relative file name of a texture; none if both are empty.
	std::string m_FileName;
	std::string m_RelativeName;
	/// Of the picture, which stands in the file.
	std::string m_Content{};
	/// There is a second video of that file, which has no picture.
	bool m_bSecondVideo = false;
	/// What the texture is connected to, since version 7.
	std::string m_Property = "DiffuseColor";
};

struct VTestCluster
{
	/// Of the scene's node; -1 for none.
	int m_Node = -1;
	VNumbers m_Points;
	VNumbers m_Weights;
	/// 16 numbers as the file has them; the identity if empty.
	VNumbers m_Transform;
	VNumbers m_Link;
};

struct VTestMesh
{
	/// Of the scene's node that holds it, whose kind has to be "Mesh".
	int m_Node = 0;
	/// Three numbers a point.
	VNumbers m_Points;
	/// As the file has them: the last vertex of each polygon as its complement.
	VNumbers m_Polygons;
	/// The layer elements of their names; those of no mapping are left out.
	VTestLayer m_Normals;
	VTestLayer m_UV;
	/// Its index holds a material for each polygon.
	VTestLayer m_MaterialLayer;
	std::vector<VTestMaterial> m_Materials;
	/// A skin if there are any.
	std::vector<VTestCluster> m_Clusters;
	/// Before version 7: its index holds a texture for each polygon.
	VTestLayer m_TextureLayer{};
	/// Of the second layer, though they stand before those of the first.
	VTestLayer m_SecondUV{};
	/// Before version 7: as the texture layer, for emissive textures.
	VTestLayer m_EmissiveTextureLayer{};
};

/// The records of the scene with its meshes as that version has them.
std::vector<VTestRecord> Records(
    const VTestForm& i_rForm, const VTestScene& i_rScene, const std::vector<VTestMesh>& i_rMeshes);

inline std::string Write(const VTestForm& i_rForm, const VTestScene& i_rScene, const std::vector<VTestMesh>& i_rMeshes)
{
	return Write(i_rForm, Records(i_rForm, i_rScene, i_rMeshes));
}

} // namespace FbxTest
