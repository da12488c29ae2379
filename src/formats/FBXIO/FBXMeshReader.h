#pragma once

#include "FBXIO/BoneSkins.h"
#include "FBXIO/ImageCache.h"
#include "FBXIO/Limits.h"
#include "FBXIO/Mesh.h"
#include "FBXIO/MeshFindings.h"
#include "FBXIO/MeshRules.h"
#include "FBXIO/Seams.h"

#include <fbxsdk.h>

#include <set>
#include <unordered_map>

namespace FBXIO
{

/// Turns the meshes of an imported scene into vertices and indices that are drawn as they stand. FBXReader owns it and
/// walks the scene. Findings go to the log category "FBXIO".
class FBXMeshReader
{
public:
	/// The file, whose folder textures are looked for in and whose size tells how much it may become.
	void SetFile(const std::string& i_rPath, std::uint64_t i_Bytes);

	/// File units to millimetres.
	void SetUnitScale(float i_UnitScale) { m_UnitScale = i_UnitScale; }

	/// The skeleton whose bones clusters are found in; the last bone of each name.
	void SetSkeleton(std::shared_ptr<VSkinSkeleton> i_pSkeleton);

	void SetPictures(VOpenPicture i_pOpen);
	void SetRules(const VMeshRules& i_rRules);

	static bool IsMesh(FbxNode& i_rNode);

	/// Before all meshes of the scene are read once more: they count against the limit from here on.
	void BeginMeshes() { m_BytesLeft = Limits::MeshBytes(m_FileBytes); }

	/// After that: what is told of all of them together.
	void EndMeshes();

	/// In the node's own space. False if the mesh is damaged.
	bool ReadMesh(FbxNode& i_rNode, VBasicMesh& o_rMesh);

	void ReadPlacedMesh(FbxNode& i_rNode, std::vector<VPlacedMesh>& io_rMeshes);

	/// Adds the bones that the node's skin is bound to, with all their parents. A skin that several nodes share is
	/// looked at once.
	void FindUsedBones(FbxNode& i_rNode, std::set<std::int64_t>& io_rBones);

	/// Adds what the bones move of the node's mesh, one for each of the skeleton, unless its skin was seen before.
	/// Tells nothing.
	/// @param i_UpAxis of the file, from 0 to 2.
	void AddBoneSkins(FbxNode& i_rNode, std::vector<VBoneSkinSums>& io_rSums, std::set<const FbxObject*>& io_rSeen,
	    int i_UpAxis) const;

	/// Makes the skeleton of these bones and of all below them, and goes on with it.
	std::shared_ptr<const VSkinSkeleton> PruneSkeleton(std::set<std::int64_t> i_Bones);

	/// Adds the node's mesh if it has a skin. Fills the inverse bind matrices of the skeleton.
	void ReadSkinMesh(FbxNode& i_rNode, std::vector<VSkinMesh>& io_rMeshes);

private:
	template <typename TVertex>
	void Prepare(FbxNode& i_rNode, FbxMesh& io_rFrom, VMesh<TVertex>& o_rMesh);
	/// @param i_rPlace where the mesh stands in the scene
	template <typename TVertex>
	void Finish(
	    FbxNode& i_rNode, FbxMesh& io_rFrom, const FbxAMatrix& i_rPlace, VSeams* i_pSeams, VMesh<TVertex>& io_rMesh);
	/// How far a mesh would be moved that is drawn without its geometric transform.
	template <typename TVertex>
	void FindGeometric(FbxNode& i_rNode, const FbxAMatrix& i_rPlace, const VMesh<TVertex>& i_rMesh);
	/// False, and told, if the meshes are beyond the limit with so much more.
	bool Take(FbxNode& i_rNode, std::uint64_t i_Bytes);
	/// For a whole mesh with what it needs beyond vertices. Finds its seams, whose vertices are part of it.
	bool TakeMesh(FbxNode& i_rNode, FbxMesh& io_rFrom, std::size_t i_VertexSize, std::uint64_t i_MoreBytes,
	    std::optional<VSeams>& o_rSeams);
	/// Without indices. Read once: any number of nodes may share a material, and it any number of textures.
	const VMeshPart& PartOf(FbxSurfaceMaterial* i_pMaterial);
	void ReadMaterial(FbxSurfaceMaterial* i_pMaterial, VMeshPart& io_rPart);
	std::string FindTexture(const FbxFileTexture& i_rTexture) const;
	/// 0, and told, if the skeleton has no bone of the link's name.
	std::int64_t BindBone(FbxCluster& i_rCluster);
	/// -1, and told once for each cluster, if the skeleton has none.
	std::int64_t FindBone(FbxCluster& i_rCluster);

	ImageCache m_Images;
	std::string m_Path;
	std::uint64_t m_FileBytes = 0;
	std::unordered_map<const FbxSurfaceMaterial*, VMeshPart> m_PartOfMaterial;
	std::shared_ptr<VSkinSkeleton> m_pSkeleton;
	std::unordered_map<std::string, std::int64_t> m_BoneOfName;
	float m_UnitScale = 1.0f;
	std::uint64_t m_BytesLeft = 0;
	VMeshRules m_Rules;
	VMeshFindings m_Findings;
	/// Of the skeleton.
	std::set<std::int64_t> m_BoundBones;
	/// Nodes whose meshes' findings have been told.
	std::set<const FbxNode*> m_Told;
	/// Skins whose bones have been looked for, and clusters of which it was told that theirs is missing or damaged.
	std::set<const FbxObject*> m_Searched;
};

} // namespace FBXIO
