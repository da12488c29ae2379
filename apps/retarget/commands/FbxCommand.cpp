#include "retarget/commands/Commands.h"
#include "retarget/text/InputFile.h"
#include "retarget/text/Output.h"

#include "FBXIO/FBXReader.h"

#include <algorithm>
#include <limits>

namespace CommandLine
{
namespace
{

struct VFbxSettings
{
	std::string m_File;
	bool m_bMeshes = false;
	bool m_bSkin = false;
};

VJson MatrixToJson(const Rotation::VMatrix4& i_rMatrix)
{
	VJson values = VJson::array();
	for (int row = 0; row < 4; ++row)
		for (int column = 0; column < 4; ++column)
			values.push_back(i_rMatrix(row, column));
	return values;
}

VJson BonesToJson(const FBXIO::VSkinSkeleton& i_rSkeleton)
{
	VJson bones = VJson::array();
	for (const FBXIO::VSkinBone& rBone : i_rSkeleton)
	{
		VJson bone = VJson::object();
		bone["name"] = rBone.m_Name;
		bone["parent"] = rBone.m_ParentIndex;
		bone["accumulatedScale"] = rBone.m_AccumulatedScale;
		bone["preRotation"] = MatrixToJson(rBone.m_PreRotation);
		bone["inverseBind"] = MatrixToJson(rBone.m_InverseBind);
		bone["local"] = MatrixToJson(rBone.m_Local);
		bone["global"] = MatrixToJson(rBone.m_Global);
		bones.push_back(std::move(bone));
	}
	return bones;
}

VJson PartToJson(const FBXIO::VMeshPart& i_rPart)
{
	VJson part = VJson::object();
	part["triangleCount"] = i_rPart.m_Indices.size() / (3 * i_rPart.m_IndexSize);
	part["indexSize"] = i_rPart.m_IndexSize;
	part["emissive"] = i_rPart.m_Emissive;
	part["ambient"] = i_rPart.m_Ambient;
	part["diffuse"] = i_rPart.m_Diffuse;
	part["specular"] = i_rPart.m_Specular;
	part["shininess"] = i_rPart.m_Shininess;
	part["transparent"] = i_rPart.m_Transparent;
	part["reflection"] = i_rPart.m_Reflection;
	part["texture"] = i_rPart.m_pTexture ? VJson(i_rPart.m_TexturePath) : VJson();
	return part;
}

/// Least x, y, z, then greatest, of the vertices in their place; null without vertices.
VJson BoundsToJson(const FBXIO::VPlacedMesh& i_rPlaced)
{
	if (i_rPlaced.m_Mesh.m_Vertices.empty())
		return {};
	constexpr float c_Infinity = std::numeric_limits<float>::infinity();
	std::array<float, 3> least{c_Infinity, c_Infinity, c_Infinity};
	std::array<float, 3> greatest{-c_Infinity, -c_Infinity, -c_Infinity};
	for (const FBXIO::VBasicVertex& rVertex : i_rPlaced.m_Mesh.m_Vertices)
	{
		const std::array<float, 3> point = i_rPlaced.m_Transform.Map(rVertex.m_Position);
		for (std::size_t axis = 0; axis < 3; ++axis)
		{
			least[axis] = std::min(least[axis], point[axis]);
			greatest[axis] = std::max(greatest[axis], point[axis]);
		}
	}
	return {least[0], least[1], least[2], greatest[0], greatest[1], greatest[2]};
}

VJson PlacedMeshesToJson(FBXIO::FBXReader& io_rReader)
{
	std::vector<FBXIO::VPlacedMesh> meshes;
	io_rReader.ReadPlacedMeshes(meshes);
	VJson list = VJson::array();
	for (const FBXIO::VPlacedMesh& rPlaced : meshes)
	{
		VJson mesh = VJson::object();
		mesh["name"] = rPlaced.m_Name;
		mesh["transform"] = MatrixToJson(rPlaced.m_Transform);
		mesh["vertexCount"] = rPlaced.m_Mesh.m_Vertices.size();
		mesh["bounds"] = BoundsToJson(rPlaced);
		mesh["parts"] = VJson::array();
		for (const FBXIO::VMeshPart& rPart : rPlaced.m_Mesh.m_Parts)
			mesh["parts"].push_back(PartToJson(rPart));
		list.push_back(std::move(mesh));
	}
	return list;
}

/// How many vertices have no weight, one, two, three and four.
std::array<std::size_t, 5> InfluencesOf(const FBXIO::VSkinMesh& i_rMesh)
{
	std::array<std::size_t, 5> vertices{};
	for (const FBXIO::VSkinVertex& rVertex : i_rMesh.m_Vertices)
		++vertices[4 - std::ranges::count(rVertex.m_BoneWeights, 0)];
	return vertices;
}

VJson SkinToJson(FBXIO::FBXReader& io_rReader)
{
	FBXIO::VSkin skin;
	io_rReader.ReadSkin(skin);
	VJson result = VJson::object();
	result["skeleton"] = skin.m_pSkeleton ? BonesToJson(*skin.m_pSkeleton) : VJson::array();
	result["meshes"] = VJson::array();
	for (const FBXIO::VSkinMesh& rMesh : skin.m_Meshes)
	{
		VJson mesh = VJson::object();
		mesh["vertexCount"] = rMesh.m_Vertices.size();
		mesh["partCount"] = rMesh.m_Parts.size();
		mesh["influences"] = InfluencesOf(rMesh);
		result["meshes"].push_back(std::move(mesh));
	}
	return result;
}

EExitStatus ShowFbx(const VFbxSettings& i_rSettings)
{
	FBXIO::FBXReader reader;
	reader.SetMeshRules(FBXIO::c_FaithfulMeshes);
	if (!reader.LoadFile(InputPath(i_rSettings.m_File).string()))
		throw VCommandError(EBadInput, "\"" + i_rSettings.m_File + "\" could not be read as FBX");
	VJson result = VJson::object();
	result["upAxis"] = reader.GetUpAxis();
	result["unitScale"] = reader.GetUnitScale();
	result["bones"] = reader.HasSkeleton() ? BonesToJson(*reader.GetSkeleton()) : VJson::array();
	if (i_rSettings.m_bMeshes)
		result["placedMeshes"] = PlacedMeshesToJson(reader);
	if (i_rSettings.m_bSkin)
		result["skin"] = SkinToJson(reader);
	PrintJson(result);
	if (!reader.IsComplete())
		throw VCommandError(EBadInput, "\"" + i_rSettings.m_File + "\" was read only in part; what was read is shown");
	return EFine;
}

} // namespace

VCommand AddFbxCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "fbx",
	    "Show what an FBX file holds as JSON: up axis (0 X, 1 Y, 2 Z), unit scale (file units to millimetres) and the "
	    "bones with their matrices (row by row, translations in millimetres); if asked for, its meshes and its skin",
	    {"fbx hero.fbx", "fbx hero.fbx --meshes | jq -c '.placedMeshes[] | [.name, .vertexCount]'",
	        "fbx hero.fbx --skin | jq '.skin.meshes'"});
	const auto pSettings = std::make_shared<VFbxSettings>();
	pApp->add_option("FILE", pSettings->m_File, "FBX file, binary or ASCII; - is standard input")->required();
	pApp->add_flag("--meshes", pSettings->m_bMeshes,
	    "The meshes as they are drawn, with their places, bounds (least and greatest, mm), materials and textures");
	pApp->add_flag("--skin", pSettings->m_bSkin,
	    "The bones that skins are bound to with all above and below them, and of each skinned mesh how many vertices "
	    "have no weight, one, two, three and four");
	return {pApp, [pSettings] { return ShowFbx(*pSettings); }};
}

} // namespace CommandLine
