#pragma once

#include "fbxsdk/container/FileBytes.h"
#include "fbxsdk/container/FileKind.h"

#include <map>
#include <string>
#include <variant>
#include <vector>

namespace fbxsdk
{
class FbxCluster;
class FbxFileTexture;
class FbxMesh;
class FbxNode;
class FbxScene;
class FbxSkeleton;
class FbxSkin;
class FbxSurfaceMaterial;
class FbxVideo;
} // namespace fbxsdk

namespace FbxFormat
{

/// How far an import got.
struct VImportResult
{
	/// The first thing that was broken, empty if nothing was.
	std::string m_Error;
	/// That was no damage, but more than is read.
	bool m_bBeyondLimit = false;
	bool m_bEncrypted = false;
};

/// Fills a scene from a file's bytes, replacing what it held. What is broken in the file is left out. Nodes with
/// several parents keep the first; nodes that no chain of connections leads to are not under the root; both are told
/// in the log category "FBXIO".
class VSceneBuilder
{
public:
	explicit VSceneBuilder(fbxsdk::FbxScene& io_rScene) : m_rScene(io_rScene) {}

	/// Nothing is in the scene but its root if the progress is cancelled.
	VImportResult Build(VFileBytes i_Bytes, const VFileKind& i_rKind, VProgress& io_rProgress);

	/// A scene with nothing but its root.
	void BuildEmpty();

private:
	void BuildSettings();
	/// Empty, or what there is more of than is read.
	std::string BuildObjects(std::uint32_t i_Version);
	void Connect();
	/// Of several videos of one file only one may hold it: textures of that file get this one.
	void FindContents();
	void ConnectNodes(fbxsdk::FbxNode& io_rChild, fbxsdk::FbxNode& io_rParent);
	void TellUnreached();

	/// What was made of an object.
	using VBuilt = std::variant<std::monostate, fbxsdk::FbxNode*, fbxsdk::FbxSkeleton*, fbxsdk::FbxMesh*,
	    fbxsdk::FbxSkin*, fbxsdk::FbxCluster*, fbxsdk::FbxSurfaceMaterial*, fbxsdk::FbxFileTexture*, fbxsdk::FbxVideo*>;

	/// Keeps the part and gives it back.
	template <typename T>
	T* AddPart(T* i_pPart);
	VBuilt BuildPart(const struct VObject& i_rObject, const class VMaterialReader& i_rMaterials);
	static void AddSkin(fbxsdk::FbxMesh& io_rMesh, fbxsdk::FbxSkin& io_rSkin);
	void ConnectParts(const VBuilt& i_rChild, const VBuilt& i_rParent, std::string_view i_Property);

	fbxsdk::FbxScene& m_rScene;
	/// By object.
	std::vector<VBuilt> m_Built;
	/// Before version 7 textures are connected to nodes, whose materials may follow.
	std::map<const fbxsdk::FbxNode*, std::vector<fbxsdk::FbxFileTexture*>> m_TexturesOfNodes;
	const fbxsdk::FbxNode* m_pSecondParent = nullptr;
	std::size_t m_SecondParents = 0;
};

} // namespace FbxFormat
