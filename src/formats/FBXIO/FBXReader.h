#pragma once

#include "FBXIO/Mesh.h"
#include "FBXIO/MeshRules.h"

#include <functional>
#include <memory>
#include <string>
#include <string_view>

namespace FBXIO
{

/// Imports one FBX file and holds its scene for as long as the reader lives. Findings go to the log category "FBXIO".
/// Belongs to one thread at a time.
class FBXReader
{
public:
	FBXReader();
	~FBXReader();
	FBXReader(const FBXReader&) = delete;
	FBXReader& operator=(const FBXReader&) = delete;

	/// The whole of the import; called once per reader. A file of which only a part could be read still gives true.
	bool LoadFile(const std::string& i_rPath);

	/// The same for the bytes of such a file. i_rPath stands for it in messages, and textures are looked for beside it.
	bool LoadMemory(std::string_view i_Bytes, const std::string& i_rPath);

	/// Called while a file is imported and before each mesh that is read, with how much of that is done, from 0 to 1;
	/// what returns false ends it. A cancelled import leaves an empty scene and is told like one that failed; cancelled
	/// meshes are left out.
	using VProgress = std::function<bool(float)>;
	void SetProgress(VProgress i_Progress);

	/// Opens the pictures of textures that are read from now on; by default their heads are read alone.
	void SetPictures(VOpenPicture i_pOpen);

	/// For the meshes that are read from now on.
	void SetMeshRules(const VMeshRules& i_rRules);

	/// False if the import broke off: what was read until then is there.
	bool IsComplete() const;

	/// Why the file was refused, or where the import broke off; empty if neither.
	const std::string& GetError() const;

	bool HasSkeleton() const;

	/// 0 for X, 1 for Y, 2 for Z.
	int GetUpAxis() const;

	/// File units to millimetres.
	float GetUnitScale() const;

	/// The full skeleton; empty pointer if the file has none.
	std::shared_ptr<const VSkinSkeleton> GetSkeleton() const;

	/// Every mesh of the scene with its place; none before LoadFile has given true.
	void ReadPlacedMeshes(std::vector<VPlacedMesh>& o_rMeshes);

	/// For a file with one model: the last mesh that has no mesh above it, without any transform of nodes.
	void ReadTopMesh(VBasicMesh& o_rMesh);

	/// The meshes that have a skin, and the bones that matter: those with weights, all above and all below them. Called
	/// at most once. Does nothing without a skeleton; the reader's own skeleton stays as it is.
	void ReadSkin(VSkin& o_rSkin);

	/// Finds what the bones of GetSkeleton move, without meshes being built and without a word. Before ReadSkin, if
	/// both are called.
	void ReadBoneSkins();

private:
	class VImpl;
	std::unique_ptr<VImpl> m_pImpl;
};

} // namespace FBXIO
