#include "fbxsdk/scene/SceneBuilder.h"

#include "DebugServices/GlobalLog.h"
#include "fbxsdk/Limits.h"
#include "fbxsdk/container/Values.h"
#include "fbxsdk/document/OldDocument.h"
#include "fbxsdk/document/Properties.h"
#include "fbxsdk/scene/LegacyTextures.h"
#include "fbxsdk/scene/MaterialReader.h"
#include "fbxsdk/scene/ReadTransform.h"
#include "fbxsdk/sdk/Mesh.h"
#include "fbxsdk/sdk/NodeData.h"
#include "fbxsdk/sdk/SceneContent.h"

#include <algorithm>
#include <optional>
#include <set>

namespace
{

using namespace FbxFormat;

/// The first version in which what a node is stands in an object of its own.
constexpr std::uint32_t c_FirstVersionWithAttributes = 7000;

std::optional<fbxsdk::FbxSkeleton::EType> SkeletonType(std::string_view i_SubKind)
{
	using fbxsdk::FbxSkeleton;
	static constexpr std::pair<std::string_view, FbxSkeleton::EType> c_Types[]{{"LimbNode", FbxSkeleton::eLimbNode},
	    {"Limb", FbxSkeleton::eLimb}, {"Root", FbxSkeleton::eRoot}, {"Effector", FbxSkeleton::eEffector}};
	for (const auto& [name, type] : c_Types)
		if (i_SubKind == name)
			return type;
	return {};
}

/// Files that ask for a password say so in their head; the rest of them cannot be read.
bool IsEncrypted(const VElementTree& i_rTree)
{
	const VElementIndex header = i_rTree.Find(VElementTree::c_Root, "FBXHeaderExtension");
	const VElementIndex type = i_rTree.Find(header, "EncryptionType");
	return type != c_NoElement && ValueAt(i_rTree, type, 0).AsInteger() != 0;
}

} // namespace

FbxFormat::VImportResult FbxFormat::VSceneBuilder::Build(
    VFileBytes i_Bytes, const VFileKind& i_rKind, VProgress& io_rProgress)
{
	BuildEmpty();
	fbxsdk::FbxScene::VContent& rContent = *m_rScene.m_pContent;
	rContent.m_Bytes = std::move(i_Bytes);
	rContent.m_Budget = {Limits::DecodedBytes(rContent.m_Bytes.View().size())};
	VImportResult result;
	// Before version 6 the pose stands among what moves.
	const bool bAll = i_rKind.m_Version < c_FirstVersionWithObjects;
	rContent.m_Tree.Read(rContent.m_Bytes.View(), i_rKind, bAll ? EContent::All : EContent::WithoutMotion);
	if (IsEncrypted(rContent.m_Tree))
	{
		result.m_bEncrypted = true;
		return result;
	}
	if (!io_rProgress.Tell(90.0f, "Building the scene"))
		return result;
	VFileKind kind = i_rKind;
	if (kind.m_Version < c_FirstVersionWithObjects)
	{
		result.m_Error = rContent.m_Tree.Error();
		result.m_bBeyondLimit = rContent.m_Tree.IsBeyondLimit();
		const std::string written = WithObjects(rContent.m_Tree);
		std::ranges::copy(written, rContent.m_Bytes.Resize(written.size()));
		kind.m_Version = c_WrittenVersion;
		rContent.m_Tree = {};
		rContent.m_Tree.Read(rContent.m_Bytes.View(), kind);
	}
	rContent.m_pDocument = std::make_unique<VDocument>(rContent.m_Tree);
	if (rContent.m_pDocument->Nameless() > 0)
		NVX_LOG("FBXIO", NVX::ELogWarning, "Objects left out because they have neither number nor name: %1%",
		    rContent.m_pDocument->Nameless());
	BuildSettings();
	const std::string beyond = BuildObjects(kind.m_Version);
	Connect();
	TellUnreached();
	for (const auto& [rError, bBeyondLimit] :
	    {std::pair<const std::string&, bool>(rContent.m_Tree.Error(), rContent.m_Tree.IsBeyondLimit()),
	        {rContent.m_pDocument->Error(), rContent.m_pDocument->IsBeyondLimit()}, {beyond, true}})
		if (result.m_Error.empty() && !rError.empty())
		{
			result.m_Error = rError;
			result.m_bBeyondLimit = bBeyondLimit;
		}
	if (!io_rProgress.Tell(100.0f, "Building the scene"))
		BuildEmpty();
	return result;
}

void FbxFormat::VSceneBuilder::BuildEmpty()
{
	m_rScene.m_pContent = std::make_unique<fbxsdk::FbxScene::VContent>();
	m_rScene.m_GlobalSettings = {};
	m_rScene.m_pContent->m_Nodes.emplace_back(new fbxsdk::FbxNode("RootNode"));
}

void FbxFormat::VSceneBuilder::BuildSettings()
{
	const VDocument& rDocument = *m_rScene.m_pContent->m_pDocument;
	fbxsdk::FbxGlobalSettings& rSettings = m_rScene.m_GlobalSettings;
	VisitProperties(rDocument.Tree(), rDocument.GlobalSettings(),
	    [&rSettings](std::string_view i_Name, VValueCursor& io_rCursor)
	    {
		    if (i_Name == "UnitScaleFactor")
		    {
			    const double factor = io_rCursor.Next().AsReal(rSettings.m_UnitScaleFactor);
			    // Ten times it must be a float, and not 0.
			    if (factor > 1e-30 && factor < 1e30)
				    rSettings.m_UnitScaleFactor = factor;
			    else
				    NVX_LOG("FBXIO", NVX::ELogWarning, "Unit of %1% centimetres is none; taking centimetres", factor);
		    }
		    else if (i_Name == "UpAxisSign")
			    rSettings.m_UpSign = io_rCursor.Next().AsInteger(1) < 0 ? -1 : 1;
		    else if (i_Name == "UpAxis")
		    {
			    const std::int64_t axis = io_rCursor.Next().AsInteger(1);
			    rSettings.m_UpVector =
			        axis >= 0 && axis <= 2 ? fbxsdk::FbxAxisSystem::EUpVector(axis + 1) : fbxsdk::FbxAxisSystem::eXAxis;
		    }
	    });
}

template <typename T>
T* FbxFormat::VSceneBuilder::AddPart(T* i_pPart)
{
	m_rScene.m_pContent->m_Parts.emplace_back(i_pPart);
	return i_pPart;
}

FbxFormat::VSceneBuilder::VBuilt FbxFormat::VSceneBuilder::BuildPart(
    const VObject& i_rObject, const VMaterialReader& i_rMaterials)
{
	fbxsdk::FbxScene::VContent& rContent = *m_rScene.m_pContent;
	const VArraySource record{&rContent.m_Tree, &rContent.m_Budget, i_rObject.m_Element};
	const auto name = [&] { return rContent.m_pDocument->Decoded(i_rObject.m_Name); };
	if (i_rObject.m_Kind == "NodeAttribute")
	{
		if (const auto type = SkeletonType(i_rObject.m_SubKind))
			return AddPart(new fbxsdk::FbxSkeleton(name(), *type));
	}
	else if (i_rObject.m_Kind == "Geometry" && i_rObject.m_SubKind == "Mesh")
		return AddPart(new fbxsdk::FbxMesh(name(), record));
	else if (i_rObject.m_Kind == "Deformer" && i_rObject.m_SubKind == "Skin")
	{
		auto* const pSkin = AddPart(new fbxsdk::FbxSkin(name()));
		rContent.m_Skins.push_back(pSkin);
		return pSkin;
	}
	else if (i_rObject.m_Kind == "Deformer" && i_rObject.m_SubKind == "Cluster")
		return AddPart(new fbxsdk::FbxCluster(name(), record, rContent.m_Skins));
	else if (i_rObject.m_Kind == "Material")
		return AddPart(i_rMaterials.ReadMaterial(i_rObject).release());
	else if (i_rObject.m_Kind == "Texture")
		return AddPart(i_rMaterials.ReadTexture(i_rObject).release());
	else if (i_rObject.m_Kind == "Video")
		return AddPart(i_rMaterials.ReadVideo(i_rObject, record.Child("Content")).release());
	return {};
}

std::string FbxFormat::VSceneBuilder::BuildObjects(std::uint32_t i_Version)
{
	fbxsdk::FbxScene::VContent& rContent = *m_rScene.m_pContent;
	const VDocument& rDocument = *rContent.m_pDocument;
	VNodeTransform defaults;
	ReadTransform(rDocument.Tree(), rDocument.Template("Model"), defaults);
	const VMaterialReader materials(rDocument);

	m_Built.resize(rDocument.Objects().size());
	std::size_t parts = 0, clusters = 0;
	const auto moreThan = [](std::size_t i_Limit, const char* i_pWhat)
	{ return "it has more than " + std::to_string(i_Limit) + ' ' + i_pWhat; };
	for (VObjectIndex object = 0; object < rDocument.Objects().size(); ++object)
	{
		const VObject& rObject = rDocument.Objects()[object];
		if (rObject.m_Kind != "Model")
		{
			m_Built[object] = BuildPart(rObject, materials);
			const bool bCluster = std::holds_alternative<fbxsdk::FbxCluster*>(m_Built[object]);
			clusters += bCluster ? 1 : 0;
			parts += !bCluster && rObject.m_Kind != "NodeAttribute" && m_Built[object].index() != 0 ? 1 : 0;
			if (parts > Limits::c_Parts)
				return moreThan(Limits::c_Parts, "materials, textures, pictures, meshes and skins");
			if (clusters > Limits::c_Clusters)
				return moreThan(Limits::c_Clusters, "clusters of skins");
			continue;
		}
		if (rContent.m_Nodes.size() > Limits::c_Nodes)
			return moreThan(Limits::c_Nodes, "nodes");
		auto* const pNode = new fbxsdk::FbxNode(rDocument.Decoded(rObject.m_Name));
		rContent.m_Nodes.emplace_back(pNode);
		m_Built[object] = pNode;
		pNode->m_pData->m_Properties = defaults;
		ReadTransform(rDocument.Tree(), rObject.m_Element, pNode->m_pData->m_Properties);
		if (i_Version >= c_FirstVersionWithAttributes)
			continue;
		// Bone and mesh stand in the node itself.
		if (const auto type = SkeletonType(rObject.m_SubKind))
			pNode->m_pData->m_pSkeleton = AddPart(new fbxsdk::FbxSkeleton(pNode->GetName(), *type));
		const VArraySource record{&rContent.m_Tree, &rContent.m_Budget, rObject.m_Element};
		if (rObject.m_SubKind == "Mesh" && record.Child("Vertices").m_Element != c_NoElement)
			pNode->m_pData->m_pMesh = AddPart(new fbxsdk::FbxMesh(pNode->GetName(), record));
	}
	return {};
}

void FbxFormat::VSceneBuilder::Connect()
{
	fbxsdk::FbxScene::VContent& rContent = *m_rScene.m_pContent;
	const VBuilt root = rContent.m_Nodes.front().get();
	// Repeated connections of parts count once.
	std::set<std::tuple<VObjectIndex, VObjectIndex, std::string_view>> seen;
	for (const VConnection& rConnection : rContent.m_pDocument->Connections())
	{
		if (rConnection.m_Child == c_SceneObject)
			continue;
		const VBuilt& rParent = rConnection.m_Parent == c_SceneObject ? root : m_Built[rConnection.m_Parent];
		const VBuilt& rChild = m_Built[rConnection.m_Child];
		auto* const* const pParent = std::get_if<fbxsdk::FbxNode*>(&rParent);
		auto* const* const pChild = std::get_if<fbxsdk::FbxNode*>(&rChild);
		if (pParent && pChild && rConnection.m_Property.empty())
			ConnectNodes(**pChild, **pParent);
		else if (rChild.index() != 0 && rParent.index() != 0
		    && seen.emplace(rConnection.m_Child, rConnection.m_Parent, rConnection.m_Property).second)
			ConnectParts(rChild, rParent, rConnection.m_Property);
	}
	FindContents();
	// In the order of the file: nodes may share materials. A mesh that nodes share has its textures in the first.
	std::set<const fbxsdk::FbxMesh*> looked;
	for (const auto& pNode : rContent.m_Nodes)
		if (const auto found = m_TexturesOfNodes.find(pNode.get()); found != m_TexturesOfNodes.end())
		{
			const fbxsdk::FbxNode::VData& rData = *pNode->m_pData;
			const bool bFirst = rData.m_pMesh && looked.insert(rData.m_pMesh).second;
			ConnectLegacyTextures(
			    bFirst ? rData.m_pMesh->m_Record : VArraySource(), pNode->GetName(), found->second, rData.m_Materials);
		}
	if (m_SecondParents > 0)
		NVX_LOG("FBXIO", NVX::ELogWarning,
		    "Connections left out because their node has another parent: %1%, such as that of %2%", m_SecondParents,
		    m_pSecondParent->GetName());
}

void FbxFormat::VSceneBuilder::FindContents()
{
	std::map<std::string_view, const fbxsdk::FbxVideo*> videos;
	for (const VBuilt& rBuilt : m_Built)
		if (auto* const* const pVideo = std::get_if<fbxsdk::FbxVideo*>(&rBuilt);
		    pVideo && (*pVideo)->m_bContent && !(*pVideo)->m_FileName.empty())
			videos.try_emplace((*pVideo)->m_FileName, *pVideo);
	for (const VBuilt& rBuilt : m_Built)
		if (auto* const* const pTexture = std::get_if<fbxsdk::FbxFileTexture*>(&rBuilt);
		    pTexture && !((*pTexture)->m_pVideo && (*pTexture)->m_pVideo->m_bContent))
			if (const auto found = videos.find((*pTexture)->m_FileName); found != videos.end())
				(*pTexture)->m_pVideo = found->second;
}

void FbxFormat::VSceneBuilder::ConnectNodes(fbxsdk::FbxNode& io_rChild, fbxsdk::FbxNode& io_rParent)
{
	if (!io_rChild.m_pData->m_pParent)
	{
		io_rChild.m_pData->m_pParent = &io_rParent;
		io_rParent.m_pData->m_Children.push_back(&io_rChild);
	}
	else if (io_rChild.m_pData->m_pParent != &io_rParent)
	{
		++m_SecondParents;
		m_pSecondParent = &io_rChild;
	}
}

void FbxFormat::VSceneBuilder::AddSkin(fbxsdk::FbxMesh& io_rMesh, fbxsdk::FbxSkin& io_rSkin)
{
	io_rMesh.m_Skins.push_back(&io_rSkin);
	if (!io_rSkin.m_pMesh)
		io_rSkin.m_pMesh = &io_rMesh;
}

void FbxFormat::VSceneBuilder::ConnectParts(
    const VBuilt& i_rChild, const VBuilt& i_rParent, std::string_view i_Property)
{
	using namespace fbxsdk;
	const auto child = [&]<typename T>(T*)
	{ return std::holds_alternative<T*>(i_rChild) ? std::get<T*>(i_rChild) : nullptr; };
	const auto parent = [&]<typename T>(T*)
	{ return std::holds_alternative<T*>(i_rParent) ? std::get<T*>(i_rParent) : nullptr; };
	constexpr FbxNode* c_pNode = nullptr;
	constexpr FbxMesh* c_pMesh = nullptr;
	constexpr FbxSkin* c_pSkin = nullptr;
	constexpr FbxCluster* c_pCluster = nullptr;
	constexpr FbxSurfaceMaterial* c_pMaterial = nullptr;
	constexpr FbxFileTexture* c_pTexture = nullptr;
	constexpr FbxVideo* c_pVideo = nullptr;
	if (!i_Property.empty())
	{
		if (child(c_pTexture) && parent(c_pMaterial))
			VMaterialReader::Connect(*child(c_pTexture), *parent(c_pMaterial), i_Property);
		return;
	}
	if (FbxNode* const pNode = parent(c_pNode))
	{
		FbxNode::VData& rData = *pNode->m_pData;
		if (FbxSkeleton* const pSkeleton = child(static_cast<FbxSkeleton*>(nullptr)); pSkeleton && !rData.m_pSkeleton)
			rData.m_pSkeleton = pSkeleton;
		else if (FbxMesh* const pMesh = child(c_pMesh); pMesh && !rData.m_pMesh)
		{
			rData.m_pMesh = pMesh;
			// Messages about it must name something that can be found.
			if (pMesh->m_Name.empty())
				pMesh->m_Name = pNode->m_Name;
		}
		else if (FbxSurfaceMaterial* const pMaterial = child(c_pMaterial))
			rData.m_Materials.push_back(pMaterial);
		else if (FbxSkin* const pSkin = child(c_pSkin); pSkin && rData.m_pMesh)
			AddSkin(*rData.m_pMesh, *pSkin);
		else if (FbxFileTexture* const pTexture = child(c_pTexture))
			m_TexturesOfNodes[pNode].push_back(pTexture);
	}
	else if (child(c_pVideo) && parent(c_pTexture))
	{
		const FbxVideo*& rpVideo = parent(c_pTexture)->m_pVideo;
		if (!rpVideo || child(c_pVideo)->m_bContent || !rpVideo->m_bContent)
			rpVideo = child(c_pVideo);
	}
	else if (child(c_pSkin) && parent(c_pMesh))
		AddSkin(*parent(c_pMesh), *child(c_pSkin));
	else if (child(c_pCluster) && parent(c_pSkin))
	{
		parent(c_pSkin)->m_Clusters.push_back(child(c_pCluster));
		if (!child(c_pCluster)->m_pSkin)
			child(c_pCluster)->m_pSkin = parent(c_pSkin);
	}
	else if (child(c_pNode) && parent(c_pCluster) && !parent(c_pCluster)->m_pLink)
		parent(c_pCluster)->m_pLink = child(c_pNode);
}

void FbxFormat::VSceneBuilder::TellUnreached()
{
	const auto& rNodes = m_rScene.m_pContent->m_Nodes;
	// Every node has one parent at most, so nothing below a node without parent can be in a ring.
	const auto countBelow = [](const fbxsdk::FbxNode& i_rTop) { return std::size_t(i_rTop.GetChildCount(true)) + 1; };
	const std::size_t reached = countBelow(*rNodes.front());
	if (reached == rNodes.size())
		return;
	std::size_t loose = 0;
	for (std::size_t i = 1; i < rNodes.size(); ++i)
		if (!rNodes[i]->m_pData->m_pParent)
			loose += countBelow(*rNodes[i]);
	if (loose > 0)
		NVX_LOG("FBXIO", NVX::ELogInformation, "Nodes left out because no connection leads to them: %1%", loose);
	if (const std::size_t ring = rNodes.size() - reached - loose; ring > 0)
		NVX_LOG("FBXIO", NVX::ELogWarning, "Nodes left out because their connections lead round in a ring: %1%", ring);
}
