#include "FBXIO/FBXReader.h"

#include "DebugServices/GlobalLog.h"
#include "FBXIO/FBXMeshReader.h"
#include "FBXIO/Matrices.h"
#include "FBXIO/MemoryStream.h"
#include "UtilsFileSystem/Paths.h"

#include <boost/filesystem/operations.hpp>

#include <functional>
#include <map>
#include <set>
#include <vector>

class FBXIO::FBXReader::VImpl
{
public:
	~VImpl();

	bool LoadFile(const std::string& i_rPath);
	bool LoadMemory(std::string_view i_Bytes, const std::string& i_rPath);

	/// Calls i_rVisit with the node and all below it, in pre-order; true from it passes over what is below that node.
	/// While it runs, m_NodeScale is the product of the local X scalings down to the node.
	void ForEachNode(FbxNode* i_pRoot, const std::function<bool(FbxNode*)>& i_rVisit);

	/// Calls i_rVisit with each node that is a mesh; nothing if no file has been loaded.
	void ForEachMesh(const std::function<void(FbxNode&)>& i_rVisit, bool i_bTopOnly = false);

	/// The same, with the progress; ends where that says so.
	void ReadEachMesh(const std::function<void(FbxNode&)>& i_rRead);

	float m_UnitScale = 1.0f;
	float m_NodeScale = 1.0f;
	int m_UpAxis = 0;
	bool m_bComplete = false;
	std::string m_Error;
	FBXMeshReader m_MeshReader;
	std::shared_ptr<VSkinSkeleton> m_pSkeleton;
	VProgress m_Progress;

private:
	/// i_rInitialize makes the importer ready for what it is to read.
	bool Load(const std::string& i_rPath, std::uint64_t i_Bytes, const std::function<bool()>& i_rInitialize);
	void TellRefusal(const std::string& i_rPath);
	void Import();
	void ReadSettings();
	bool ProcessSkeletonNode(FbxNode* i_pNode);

	bool m_bLoaded = false;
	/// The last bone of each name.
	std::map<std::string, std::int64_t> m_BoneOfName;
	FbxManager* m_pManager = nullptr;
	FbxScene* m_pScene = nullptr;
	FbxImporter* m_pImporter = nullptr;
};

FBXIO::FBXReader::VImpl::~VImpl()
{
	if (m_pImporter)
		m_pImporter->Destroy(false);
	if (m_pScene)
		m_pScene->Destroy(false);
	if (m_pManager)
		m_pManager->Destroy();
}

bool FBXIO::FBXReader::VImpl::LoadFile(const std::string& i_rPath)
{
	boost::system::error_code error;
	const boost::filesystem::path path = UtilsFileSystem::PathFromUtf8(i_rPath);
	if (status(path, error).type() != boost::filesystem::regular_file)
	{
		NVX_LOG("FBXIO", NVX::ELogError, "File %1% not found", i_rPath);
		m_Error = "There is no such file";
		return false;
	}
	const boost::uintmax_t bytes = file_size(path, error);
	return Load(i_rPath, error ? 0 : bytes,
	    [&]
	    {
		    int format = -1;
		    FbxIOPluginRegistry* const pRegistry = m_pManager->GetIOPluginRegistry();
		    if (!pRegistry->DetectReaderFileFormat(i_rPath.c_str(), format))
			    format = pRegistry->GetNativeReaderFormat();
		    return m_pImporter->Initialize(i_rPath.c_str(), format, nullptr);
	    });
}

bool FBXIO::FBXReader::VImpl::LoadMemory(std::string_view i_Bytes, const std::string& i_rPath)
{
	return Load(i_rPath, i_Bytes.size(),
	    [&]
	    {
		    VMemoryStream stream(i_Bytes, m_pManager->GetIOPluginRegistry()->FindReaderIDByExtension("fbx"));
		    return m_pImporter->Initialize(&stream, nullptr, -1, nullptr);
	    });
}

bool FBXIO::FBXReader::VImpl::Load(
    const std::string& i_rPath, std::uint64_t i_Bytes, const std::function<bool()>& i_rInitialize)
{
	NVX_LOG("FBXIO", NVX::ELogInformation, "Loading file %1%", i_rPath);
	m_MeshReader.SetFile(i_rPath, i_Bytes);
	m_pManager = FbxManager::Create();
	if (!m_pManager)
		return false;
	m_pScene = FbxScene::Create(m_pManager, i_rPath.c_str());
	m_pImporter = FbxImporter::Create(m_pManager, i_rPath.c_str());
	if (!m_pScene || !m_pImporter)
		return false;
	if (!i_rInitialize())
	{
		TellRefusal(i_rPath);
		return false;
	}
	Import();
	ReadSettings();
	ForEachNode(m_pScene->GetRootNode(), [this](FbxNode* i_pNode) { return ProcessSkeletonNode(i_pNode); });
	m_MeshReader.SetSkeleton(m_pSkeleton);
	m_bLoaded = true;
	return true;
}

void FBXIO::FBXReader::VImpl::TellRefusal(const std::string& i_rPath)
{
	NVX_LOG("FBXIO", NVX::ELogError, "Call to KFbxImporter::Initialize() failed.");
	m_Error = m_pImporter->GetStatus().GetErrorString();
	NVX_LOG("FBXIO", NVX::ELogError, "Error returned: %1%", m_Error);
	int major = 0, minor = 0, revision = 0;
	m_pImporter->GetFileVersion(major, minor, revision);
	if (m_pImporter->GetStatus().GetCode() == FbxStatus::eInvalidFileVersion)
	{
		NVX_LOG("FBXIO", NVX::ELogError, "FBX file import error: File version is old or too new.\n");
		NVX_LOG("FBXIO", NVX::ELogError, "FBX version number for file %1% is %2%.%3%.%4%\n\n", i_rPath, major, minor,
		    revision);
		NVX_LOG("FBXIO", NVX::ELogError, "Current FBX version is %d.%d.%d\n", 2020, 0, 1);
	}
}

void FBXIO::FBXReader::VImpl::Import()
{
	if (m_Progress)
		m_pImporter->SetProgressCallback([](void* i_pProgress, float i_Percentage, const char*)
		    { return (*static_cast<const VProgress*>(i_pProgress))(i_Percentage / 100.0f); },
		    &m_Progress);
	m_bComplete = m_pImporter->Import(m_pScene, false);
	if (m_bComplete)
		return;
	m_Error = m_pImporter->GetStatus().GetErrorString();
	if (m_pImporter->GetStatus().GetCode() == FbxStatus::ePasswordError)
		NVX_LOG("FBXIO", NVX::ELogError, "FBX Importer: password Required");
	else
		NVX_LOG("FBXIO", NVX::ELogError, "Error returned: %1%", m_Error);
}

void FBXIO::FBXReader::VImpl::ReadSettings()
{
	const FbxSystemUnit unit = m_pScene->GetGlobalSettings().GetSystemUnit();
	m_UnitScale = float(unit.GetMultiplier() * unit.GetScaleFactor() * 10.0);
	m_MeshReader.SetUnitScale(m_UnitScale);
	int sign = 1;
	switch (m_pScene->GetGlobalSettings().GetAxisSystem().GetUpVector(sign))
	{
	case FbxAxisSystem::eYAxis: m_UpAxis = 1; break;
	case FbxAxisSystem::eZAxis: m_UpAxis = 2; break;
	default: m_UpAxis = 0; break;
	}
}

void FBXIO::FBXReader::VImpl::ForEachNode(FbxNode* i_pRoot, const std::function<bool(FbxNode*)>& i_rVisit)
{
	struct VLevel
	{
		FbxNode* m_pNode;
		int m_NextChild;
		float m_ScaleBefore;
	};
	std::vector<VLevel> open;
	const auto enter = [&](FbxNode* i_pNode)
	{
		const float before = m_NodeScale;
		m_NodeScale *= float(i_pNode->EvaluateLocalScaling()[0]);
		if (!i_rVisit(i_pNode))
			open.push_back({i_pNode, 0, before});
	};
	enter(i_pRoot);
	while (!open.empty())
	{
		VLevel& rLevel = open.back();
		if (rLevel.m_NextChild < rLevel.m_pNode->GetChildCount())
			enter(rLevel.m_pNode->GetChild(rLevel.m_NextChild++));
		else
		{
			m_NodeScale = rLevel.m_ScaleBefore;
			open.pop_back();
		}
	}
}

void FBXIO::FBXReader::VImpl::ForEachMesh(const std::function<void(FbxNode&)>& i_rVisit, bool i_bTopOnly)
{
	if (!m_bLoaded)
		return;
	ForEachNode(m_pScene->GetRootNode(),
	    [&](FbxNode* i_pNode)
	    {
		    const bool bMesh = FBXMeshReader::IsMesh(*i_pNode);
		    if (bMesh)
			    i_rVisit(*i_pNode);
		    return bMesh && i_bTopOnly;
	    });
}

void FBXIO::FBXReader::VImpl::ReadEachMesh(const std::function<void(FbxNode&)>& i_rRead)
{
	m_MeshReader.BeginMeshes();
	std::vector<FbxNode*> meshes;
	ForEachMesh([&meshes](FbxNode& i_rNode) { meshes.push_back(&i_rNode); });
	for (std::size_t i = 0; i < meshes.size(); ++i)
	{
		if (m_Progress && !m_Progress(float(i) / float(meshes.size())))
			break;
		i_rRead(*meshes[i]);
	}
	m_MeshReader.EndMeshes();
}

bool FBXIO::FBXReader::VImpl::ProcessSkeletonNode(FbxNode* i_pNode)
{
	FbxSkeleton* const pAttribute = i_pNode->GetSkeleton();
	if (!pAttribute)
		return false;
	if (!m_pSkeleton)
		m_pSkeleton = std::make_shared<VSkinSkeleton>();

	VSkinBone& rBone = m_pSkeleton->emplace_back();
	rBone.m_Name = i_pNode->GetName();
	rBone.m_AccumulatedScale = m_NodeScale;
	if (!pAttribute->IsSkeletonRoot() && i_pNode->GetParent())
		if (const auto found = m_BoneOfName.find(i_pNode->GetParent()->GetName()); found != m_BoneOfName.end())
			rBone.m_ParentIndex = found->second;
	m_BoneOfName.insert_or_assign(rBone.m_Name, std::int64_t(m_pSkeleton->size()) - 1);

	const FbxAMatrix preRotation(
	    FbxVector4(0.0, 0.0, 0.0, 1.0), i_pNode->GetPreRotation(FbxNode::eSourcePivot), FbxVector4(1.0, 1.0, 1.0, 1.0));
	rBone.m_PreRotation = SystemMatrix(preRotation);
	CheckTransform(rBone.m_PreRotation, rBone.m_Name);

	rBone.m_Local = SystemMatrix(i_pNode->EvaluateLocalTransform() * preRotation.Inverse());
	ScaleTranslation(rBone.m_Local, m_UnitScale);
	CheckTransform(rBone.m_Local, rBone.m_Name);

	rBone.m_Global = SystemMatrix(i_pNode->EvaluateGlobalTransform());
	ScaleTranslation(rBone.m_Global, m_UnitScale);
	CheckTransform(rBone.m_Global, rBone.m_Name);
	return false;
}

FBXIO::FBXReader::FBXReader() : m_pImpl(std::make_unique<VImpl>()) {}

FBXIO::FBXReader::~FBXReader() = default;

bool FBXIO::FBXReader::LoadFile(const std::string& i_rPath)
{
	return m_pImpl->LoadFile(i_rPath);
}

bool FBXIO::FBXReader::LoadMemory(std::string_view i_Bytes, const std::string& i_rPath)
{
	return m_pImpl->LoadMemory(i_Bytes, i_rPath);
}

void FBXIO::FBXReader::SetProgress(VProgress i_Progress)
{
	m_pImpl->m_Progress = std::move(i_Progress);
}

void FBXIO::FBXReader::SetPictures(VOpenPicture i_pOpen)
{
	m_pImpl->m_MeshReader.SetPictures(i_pOpen);
}

void FBXIO::FBXReader::SetMeshRules(const VMeshRules& i_rRules)
{
	m_pImpl->m_MeshReader.SetRules(i_rRules);
}

const std::string& FBXIO::FBXReader::GetError() const
{
	return m_pImpl->m_Error;
}

bool FBXIO::FBXReader::IsComplete() const
{
	return m_pImpl->m_bComplete;
}

bool FBXIO::FBXReader::HasSkeleton() const
{
	return m_pImpl->m_pSkeleton != nullptr;
}

int FBXIO::FBXReader::GetUpAxis() const
{
	return m_pImpl->m_UpAxis;
}

float FBXIO::FBXReader::GetUnitScale() const
{
	return m_pImpl->m_UnitScale;
}

std::shared_ptr<const FBXIO::VSkinSkeleton> FBXIO::FBXReader::GetSkeleton() const
{
	return m_pImpl->m_pSkeleton;
}

void FBXIO::FBXReader::ReadPlacedMeshes(std::vector<VPlacedMesh>& o_rMeshes)
{
	o_rMeshes.clear();
	m_pImpl->ReadEachMesh([&](FbxNode& i_rNode) { m_pImpl->m_MeshReader.ReadPlacedMesh(i_rNode, o_rMeshes); });
}

void FBXIO::FBXReader::ReadTopMesh(VBasicMesh& o_rMesh)
{
	m_pImpl->m_MeshReader.BeginMeshes();
	m_pImpl->ForEachMesh([&](FbxNode& i_rNode) { m_pImpl->m_MeshReader.ReadMesh(i_rNode, o_rMesh); }, true);
	m_pImpl->m_MeshReader.EndMeshes();
}

void FBXIO::FBXReader::ReadSkin(VSkin& o_rSkin)
{
	if (!HasSkeleton())
		return;
	std::set<std::int64_t> bones;
	m_pImpl->ForEachMesh([&](FbxNode& i_rNode) { m_pImpl->m_MeshReader.FindUsedBones(i_rNode, bones); });
	o_rSkin.m_pSkeleton = m_pImpl->m_MeshReader.PruneSkeleton(std::move(bones));
	m_pImpl->ReadEachMesh([&](FbxNode& i_rNode) { m_pImpl->m_MeshReader.ReadSkinMesh(i_rNode, o_rSkin.m_Meshes); });
}

void FBXIO::FBXReader::ReadBoneSkins()
{
	if (!HasSkeleton())
		return;
	VSkinSkeleton& rBones = *m_pImpl->m_pSkeleton;
	std::vector<VBoneSkinSums> sums(rBones.size());
	std::set<const FbxObject*> seen;
	m_pImpl->ForEachMesh(
	    [&](FbxNode& i_rNode) { m_pImpl->m_MeshReader.AddBoneSkins(i_rNode, sums, seen, m_pImpl->m_UpAxis); });
	const std::vector<VBoneSkin> skins = BoneSkinsOf(sums, m_pImpl->m_UnitScale);
	for (std::size_t i = 0; i < skins.size(); ++i)
		rBones[i].m_Skin = skins[i];
}
