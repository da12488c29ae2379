#include "fbxsdk/scene/SceneBuilder.h"

#include "DebugServices/GlobalLog.h"
#include "fbxsdk/Limits.h"
#include "fbxsdk/container/Values.h"
#include "fbxsdk/document/Properties.h"
#include "fbxsdk/sdk/NodeData.h"
#include "fbxsdk/sdk/SceneContent.h"

#include <optional>

namespace
{

using namespace FbxFile;

/// The first version in which what a node is stands in an object of its own.
constexpr std::uint32_t c_FirstVersionWithAttributes = 7000;

constexpr std::pair<std::string_view, Rotation::VVector3 VNodeTransform::*> c_Vectors[]{
    {"Lcl Translation", &VNodeTransform::m_Translation},
    {"Lcl Rotation", &VNodeTransform::m_Rotation},
    {"Lcl Scaling", &VNodeTransform::m_Scaling},
    {"RotationOffset", &VNodeTransform::m_RotationOffset},
    {"RotationPivot", &VNodeTransform::m_RotationPivot},
    {"ScalingOffset", &VNodeTransform::m_ScalingOffset},
    {"ScalingPivot", &VNodeTransform::m_ScalingPivot},
    {"PreRotation", &VNodeTransform::m_PreRotation},
    {"PostRotation", &VNodeTransform::m_PostRotation},
};

/// A number that no enumerator has leaves the default; "spheric" order, 6, turns as XYZ does.
template <typename TEnum>
void ReadEnum(VValueCursor& io_rCursor, TEnum i_Last, TEnum& io_rValue)
{
	const std::int64_t number = io_rCursor.Next().AsInteger(std::int64_t(io_rValue));
	io_rValue = number >= 0 && number <= std::int64_t(i_Last) ? TEnum(number) : TEnum(0);
}

/// What the record does not tell stays as it is.
void ReadTransform(const VElementTree& i_rTree, VElementIndex i_Object, VNodeTransform& io_rTransform)
{
	VisitProperties(i_rTree, i_Object,
	    [&io_rTransform](std::string_view i_Name, VValueCursor& io_rCursor)
	    {
		    for (const auto& [name, pMember] : c_Vectors)
			    if (i_Name == name)
			    {
				    for (double& rComponent : io_rTransform.*pMember)
					    rComponent = io_rCursor.Next().AsReal(rComponent);
				    return;
			    }
		    if (i_Name == "RotationOrder")
			    ReadEnum(io_rCursor, ERotationOrder::ZYX, io_rTransform.m_Order);
		    else if (i_Name == "InheritType")
			    ReadEnum(io_rCursor, EInheritType::Rrs, io_rTransform.m_InheritType);
		    else if (i_Name == "RotationActive")
			    io_rTransform.m_bRotationActive = io_rCursor.Next().AsInteger(io_rTransform.m_bRotationActive) != 0;
	    });
}

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

FbxFile::VImportResult FbxFile::VSceneBuilder::Build(VFileBytes i_Bytes, const VFileKind& i_rKind)
{
	BuildEmpty();
	fbxsdk::FbxScene::VContent& rContent = *m_rScene.m_pContent;
	rContent.m_Bytes = std::move(i_Bytes);
	VImportResult result;
	rContent.m_Tree.Read(rContent.m_Bytes.View(), i_rKind);
	if (IsEncrypted(rContent.m_Tree))
	{
		result.m_bEncrypted = true;
		return result;
	}
	rContent.m_pDocument = std::make_unique<VDocument>(rContent.m_Tree);
	BuildSettings();
	const bool bAllNodes = BuildNodes(i_rKind.m_Version);
	Connect();
	TellUnreached();
	for (const std::string& rError : {rContent.m_Tree.Error(), rContent.m_pDocument->Error(),
	         std::string(bAllNodes ? "" : "it has more nodes than are read")})
		if (result.m_Error.empty())
			result.m_Error = rError;
	return result;
}

void FbxFile::VSceneBuilder::BuildEmpty()
{
	m_rScene.m_pContent = std::make_unique<fbxsdk::FbxScene::VContent>();
	m_rScene.m_GlobalSettings = {};
	m_rScene.m_pContent->m_Nodes.emplace_back(new fbxsdk::FbxNode("RootNode"));
}

void FbxFile::VSceneBuilder::BuildSettings()
{
	const VDocument& rDocument = *m_rScene.m_pContent->m_pDocument;
	fbxsdk::FbxGlobalSettings& rSettings = m_rScene.m_GlobalSettings;
	VisitProperties(rDocument.Tree(), rDocument.GlobalSettings(),
	    [&rSettings](std::string_view i_Name, VValueCursor& io_rCursor)
	    {
		    if (i_Name == "UnitScaleFactor")
			    rSettings.m_UnitScaleFactor = io_rCursor.Next().AsReal(rSettings.m_UnitScaleFactor);
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

bool FbxFile::VSceneBuilder::BuildNodes(std::uint32_t i_Version)
{
	fbxsdk::FbxScene::VContent& rContent = *m_rScene.m_pContent;
	const VDocument& rDocument = *rContent.m_pDocument;
	VNodeTransform defaults;
	ReadTransform(rDocument.Tree(), rDocument.Template("Model"), defaults);

	const auto addSkeleton = [&](const VObject& i_rObject) -> fbxsdk::FbxSkeleton*
	{
		const auto type = SkeletonType(i_rObject.m_SubKind);
		if (!type)
			return nullptr;
		auto* const pSkeleton = new fbxsdk::FbxSkeleton(rDocument.Decoded(i_rObject.m_Name), *type);
		rContent.m_Attributes.emplace_back(pSkeleton);
		return pSkeleton;
	};

	m_Built.resize(rDocument.Objects().size());
	for (VObjectIndex object = 0; object < rDocument.Objects().size(); ++object)
	{
		const VObject& rObject = rDocument.Objects()[object];
		if (rObject.m_Kind == "Model")
		{
			if (rContent.m_Nodes.size() > Limits::c_Nodes)
				return false;
			auto* const pNode = new fbxsdk::FbxNode(rDocument.Decoded(rObject.m_Name));
			rContent.m_Nodes.emplace_back(pNode);
			m_Built[object].m_pNode = pNode;
			pNode->m_pData->m_Properties = defaults;
			ReadTransform(rDocument.Tree(), rObject.m_Element, pNode->m_pData->m_Properties);
			if (i_Version < c_FirstVersionWithAttributes)
				pNode->m_pData->m_pSkeleton = addSkeleton(rObject);
		}
		else if (rObject.m_Kind == "NodeAttribute")
			m_Built[object].m_pSkeleton = addSkeleton(rObject);
	}
	return true;
}

void FbxFile::VSceneBuilder::Connect()
{
	fbxsdk::FbxScene::VContent& rContent = *m_rScene.m_pContent;
	const fbxsdk::FbxNode* pSecondParent = nullptr;
	std::size_t secondParents = 0;
	for (const VConnection& rConnection : rContent.m_pDocument->Connections())
	{
		if (!rConnection.m_Property.empty() || rConnection.m_Child == c_SceneObject)
			continue;
		fbxsdk::FbxNode* const pParent = rConnection.m_Parent == c_SceneObject ? rContent.m_Nodes.front().get()
		                                                                       : m_Built[rConnection.m_Parent].m_pNode;
		const VBuilt& rChild = m_Built[rConnection.m_Child];
		if (!pParent)
			continue;
		if (rChild.m_pSkeleton && !pParent->m_pData->m_pSkeleton)
			pParent->m_pData->m_pSkeleton = rChild.m_pSkeleton;
		if (!rChild.m_pNode)
			continue;
		if (!rChild.m_pNode->m_pData->m_pParent)
		{
			rChild.m_pNode->m_pData->m_pParent = pParent;
			pParent->m_pData->m_Children.push_back(rChild.m_pNode);
		}
		else if (rChild.m_pNode->m_pData->m_pParent != pParent)
		{
			++secondParents;
			pSecondParent = rChild.m_pNode;
		}
	}
	if (secondParents > 0)
		NVX_LOG("FBXIO", NVX::ELogWarning,
		    "Connections left out because their node has another parent: %1%, such as that of %2%", secondParents,
		    pSecondParent->GetName());
}

void FbxFile::VSceneBuilder::TellUnreached()
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
