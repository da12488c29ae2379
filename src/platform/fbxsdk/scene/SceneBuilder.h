#pragma once

#include "fbxsdk/container/FileBytes.h"
#include "fbxsdk/container/FileKind.h"

#include <string>
#include <vector>

namespace fbxsdk
{
class FbxNode;
class FbxScene;
class FbxSkeleton;
} // namespace fbxsdk

namespace FbxFile
{

/// How far an import got.
struct VImportResult
{
	/// The first thing that was broken, empty if nothing was.
	std::string m_Error;
	bool m_bEncrypted = false;
};

/// Fills a scene from a file's bytes, replacing what it held. What is broken in the file is left out. Nodes with
/// several parents keep the first; nodes that no chain of connections leads to are not under the root; both are told
/// in the log category "FBXIO".
class VSceneBuilder
{
public:
	explicit VSceneBuilder(fbxsdk::FbxScene& io_rScene) : m_rScene(io_rScene) {}

	VImportResult Build(VFileBytes i_Bytes, const VFileKind& i_rKind);

	/// A scene with nothing but its root.
	void BuildEmpty();

private:
	void BuildSettings();
	/// False if there are more than c_Nodes.
	bool BuildNodes(std::uint32_t i_Version);
	void Connect();
	void TellUnreached();

	/// What was made of an object: at most one of the two.
	struct VBuilt
	{
		fbxsdk::FbxNode* m_pNode = nullptr;
		fbxsdk::FbxSkeleton* m_pSkeleton = nullptr;
	};

	fbxsdk::FbxScene& m_rScene;
	/// By object.
	std::vector<VBuilt> m_Built;
};

} // namespace FbxFile
