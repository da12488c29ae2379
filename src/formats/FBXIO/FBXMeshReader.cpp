#include "FBXIO/FBXMeshReader.h"

#include "DebugServices/GlobalLog.h"
#include "FBXIO/Matrices.h"
#include "FBXIO/Polygons.h"
#include "FBXIO/SkinWeights.h"
#include "UtilsFileSystem/Paths.h"

#include <boost/filesystem/operations.hpp>

#include <algorithm>
#include <cmath>
#include <future>
#include <map>
#include <utility>

namespace
{

using namespace FBXIO;

/// The number of polygon vertices from which indices need four bytes.
constexpr std::size_t c_FirstLargeCount = 0x10000;

VColourAndFactor ColourAndFactor(const FbxPropertyT<FbxDouble3>& i_rColour, const FbxPropertyT<FbxDouble>& i_rFactor)
{
	const FbxDouble3 colour = i_rColour.Get();
	return {Finite(colour[0]), Finite(colour[1]), Finite(colour[2]), Finite(i_rFactor.Get())};
}

/// The picture that the file holds of a texture. The SDK writes such pictures beside the file when it imports.
template <typename TTexture>
std::string ContentOf(const TTexture& i_rTexture)
{
	if constexpr (requires { i_rTexture.GetEmbeddedContent(); })
		return i_rTexture.GetEmbeddedContent();
	else
		return {};
}

/// Of a material that is neither Phong nor Lambert; null if the file names none. The SDK knows its properties by the
/// names alone that its exporter gave them.
template <typename TMaterial>
const FbxPropertyT<FbxDouble3>* BaseColourOf(const TMaterial& i_rMaterial)
{
	if constexpr (requires { i_rMaterial.GetBaseColor(); })
		return i_rMaterial.GetBaseColor();
	else
		return nullptr;
}

FbxSkin* FindSkin(FbxNode& i_rNode)
{
	FbxGeometry* const pGeometry = FBXMeshReader::IsMesh(i_rNode) ? i_rNode.GetGeometry() : nullptr;
	return pGeometry ? FbxCast<FbxSkin>(pGeometry->GetDeformer(0, FbxDeformer::eSkin)) : nullptr;
}

/// Calls i_Visit for each cluster with a bone and control points.
template <typename TVisit>
void ForEachCluster(FbxSkin& i_rSkin, TVisit&& i_Visit)
{
	for (int i = 0; i < i_rSkin.GetClusterCount(); ++i)
		if (FbxCluster* const pCluster = i_rSkin.GetCluster(i);
		    pCluster && pCluster->GetLink() && pCluster->GetControlPointIndicesCount() > 0)
			i_Visit(*pCluster);
}

/// Millimetres, below which nobody sees a difference, and the same of a matrix's linear part.
constexpr float c_SeenDistance = 0.1f;
constexpr float c_SeenTurn = 1e-3f;

bool AreSeenToDiffer(const Rotation::VMatrix4& i_rA, const Rotation::VMatrix4& i_rB)
{
	for (int row = 0; row < 3; ++row)
		for (int column = 0; column < 4; ++column)
			if (std::abs(i_rA(row, column) - i_rB(row, column)) > (column < 3 ? c_SeenTurn : c_SeenDistance))
				return true;
	return false;
}

/// The number of control points from which a second thread is worth its start.
constexpr std::size_t c_PointsForTwo = 4000;

bool Exists(const boost::filesystem::path& i_rPath)
{
	boost::system::error_code error;
	return !i_rPath.empty() && exists(i_rPath, error) && !error;
}

} // namespace

void FBXIO::FBXMeshReader::SetFile(const std::string& i_rPath, std::uint64_t i_Bytes)
{
	m_Path = i_rPath;
	m_FileBytes = i_Bytes;
	m_Images.SetFileBytes(i_Bytes);
}

void FBXIO::FBXMeshReader::SetPictures(VOpenPicture i_pOpen)
{
	m_Images.SetOpener(i_pOpen);
}

void FBXIO::FBXMeshReader::SetRules(const VMeshRules& i_rRules)
{
	m_Rules = i_rRules;
	m_PartOfMaterial.clear();
}

void FBXIO::FBXMeshReader::SetSkeleton(std::shared_ptr<VSkinSkeleton> i_pSkeleton)
{
	m_pSkeleton = std::move(i_pSkeleton);
	m_BoneOfName.clear();
	m_BoundBones.clear();
	if (m_pSkeleton)
		for (std::size_t i = 0; i < m_pSkeleton->size(); ++i)
			m_BoneOfName.insert_or_assign((*m_pSkeleton)[i].m_Name, std::int64_t(i));
}

bool FBXIO::FBXMeshReader::IsMesh(FbxNode& i_rNode)
{
	for (int i = 0; i < i_rNode.GetNodeAttributeCount(); ++i)
		if (i_rNode.GetNodeAttributeByIndex(i)->GetAttributeType() == FbxNodeAttribute::eMesh)
			return true;
	return false;
}

template <typename TVertex>
void FBXIO::FBXMeshReader::Prepare(FbxNode& i_rNode, FbxMesh& io_rFrom, VMesh<TVertex>& o_rMesh)
{
	const int count = io_rFrom.GetControlPointsCount();
	FbxGeometryElementNormal* pNormals = io_rFrom.GetElementNormal(0);
	if (!pNormals || pNormals->GetMappingMode() != FbxLayerElement::eByControlPoint
	    || pNormals->GetDirectArray().GetCount() < count)
	{
		io_rFrom.GenerateNormals(true, true, false);
		pNormals = io_rFrom.GetElementNormal(0);
	}
	o_rMesh.m_Parts.assign(std::max(i_rNode.GetMaterialCount(), 1), VMeshPart());
	for (int i = 0; i < i_rNode.GetMaterialCount(); ++i)
		o_rMesh.m_Parts[i] = PartOf(i_rNode.GetMaterial(i));

	o_rMesh.m_Vertices.assign(count, TVertex());
	const auto& rNormals = pNormals->GetDirectArray();
	std::size_t broken = 0;
	for (int i = 0; i < count; ++i)
	{
		TVertex& rVertex = o_rMesh.m_Vertices[i];
		const FbxVector4 point = io_rFrom.GetControlPointAt(i);
		const FbxVector4 normal = rNormals.GetAt(i);
		bool bSound = true;
		for (int axis = 0; axis < 3; ++axis)
		{
			rVertex.m_Position[axis] = Finite(point[axis] * m_UnitScale, bSound);
			rVertex.m_Normal[axis] = Finite(normal[axis], bSound);
		}
		broken += bSound ? 0 : 1;
	}
	if (broken > 0 && !m_Told.contains(&i_rNode))
		NVX_LOG("FBXIO", NVX::ELogWarning,
		    "%1% control points of mesh %2% have coordinates or normals that are no numbers; setting these to zero",
		    broken, i_rNode.GetName());
}

template <typename TVertex>
void FBXIO::FBXMeshReader::FindGeometric(FbxNode& i_rNode, const FbxAMatrix& i_rPlace, const VMesh<TVertex>& i_rMesh)
{
	Rotation::VMatrix4 moved = SystemMatrix(FbxAMatrix(i_rNode.GetGeometricTranslation(FbxNode::eSourcePivot),
	    i_rNode.GetGeometricRotation(FbxNode::eSourcePivot), i_rNode.GetGeometricScaling(FbxNode::eSourcePivot)));
	ScaleTranslation(moved, m_UnitScale);
	if (moved == Rotation::VMatrix4())
		return;
	const Rotation::VMatrix4 place = SystemMatrix(i_rPlace);
	float farthest = 0.0f;
	for (const TVertex& rVertex : i_rMesh.m_Vertices)
	{
		std::array<float, 3> way = moved.Map(rVertex.m_Position);
		for (int axis = 0; axis < 3; ++axis)
			way[axis] -= rVertex.m_Position[axis];
		const auto [x, y, z] = place.MapVector(way);
		farthest = std::max(farthest, std::hypot(x, y, z));
	}
	m_Findings.m_Geometric += farthest >= c_SeenDistance ? 1 : 0;
	m_Findings.m_GeometricDistance = std::max(m_Findings.m_GeometricDistance, farthest);
}

template <typename TVertex>
void FBXIO::FBXMeshReader::Finish(
    FbxNode& i_rNode, FbxMesh& io_rFrom, const FbxAMatrix& i_rPlace, VSeams* i_pSeams, VMesh<TVertex>& io_rMesh)
{
	// A mesh may be read placed and once more with its skin.
	const bool bTell = m_Told.insert(&i_rNode).second;
	const int* const pVertices = io_rFrom.GetPolygonVertices();
	std::vector<std::uint32_t> indices(pVertices, pVertices + io_rFrom.GetPolygonVertexCount());
	const std::size_t moved =
	    ApplyTexCoords(io_rFrom, i_pSeams, bTell ? i_rNode.GetName() : nullptr, io_rMesh.m_Vertices, indices);
	if (bTell)
		FindGeometric(i_rNode, i_rPlace, io_rMesh);
	if (bTell && io_rFrom.GetElementMaterialCount() == 0)
		NVX_LOG("FBXIO", NVX::ELogWarning, "Missing material for mesh %1%", io_rFrom.GetName());
	const std::size_t withoutPart = io_rMesh.m_Vertices.size() < c_FirstLargeCount
	    ? SplitIntoParts<std::uint16_t>(io_rFrom, indices, io_rMesh.m_Parts)
	    : SplitIntoParts<std::uint32_t>(io_rFrom, indices, io_rMesh.m_Parts);
	m_Findings.m_Moved += bTell ? moved : 0;
	m_Findings.m_WithoutPart += bTell ? withoutPart : 0;
}

const FBXIO::VMeshPart& FBXIO::FBXMeshReader::PartOf(FbxSurfaceMaterial* i_pMaterial)
{
	const auto [entry, bNew] = m_PartOfMaterial.try_emplace(i_pMaterial);
	if (bNew)
		ReadMaterial(i_pMaterial, entry->second);
	return entry->second;
}

void FBXIO::FBXMeshReader::ReadMaterial(FbxSurfaceMaterial* i_pMaterial, VMeshPart& io_rPart)
{
	if (const auto* const pPhong = FbxCast<FbxSurfacePhong>(i_pMaterial))
	{
		io_rPart.m_Specular = ColourAndFactor(pPhong->Specular, pPhong->SpecularFactor);
		io_rPart.m_Shininess = Finite(pPhong->Shininess.Get());
		io_rPart.m_Reflection = ColourAndFactor(pPhong->Reflection, pPhong->ReflectionFactor);
	}
	const FbxPropertyT<FbxDouble3>* pColour = nullptr;
	if (const auto* const pLambert = FbxCast<FbxSurfaceLambert>(i_pMaterial))
	{
		io_rPart.m_Emissive = ColourAndFactor(pLambert->Emissive, pLambert->EmissiveFactor);
		io_rPart.m_Ambient = ColourAndFactor(pLambert->Ambient, pLambert->AmbientFactor);
		io_rPart.m_Diffuse = ColourAndFactor(pLambert->Diffuse, pLambert->DiffuseFactor);
		io_rPart.m_Transparent = ColourAndFactor(pLambert->TransparentColor, pLambert->TransparencyFactor);
		pColour = &pLambert->Diffuse;
	}
	else if (i_pMaterial)
	{
		++m_Findings.m_OtherMaterials;
		pColour = m_Rules.m_bBaseColours ? BaseColourOf(*i_pMaterial) : nullptr;
		m_Findings.m_BaseColours += pColour ? 1 : 0;
		if (pColour)
			io_rPart.m_Diffuse = ColourAndFactor(*pColour, FbxPropertyT<FbxDouble>(1.0));
	}
	if (!pColour || pColour->GetSrcObjectCount<FbxFileTexture>() == 0)
		return;
	const FbxFileTexture& rTexture = *pColour->GetSrcObject<FbxFileTexture>(0);
	io_rPart.m_TexturePath = rTexture.GetFileName();
	io_rPart.m_pTexture =
	    m_Images.Get(io_rPart.m_TexturePath + " (embedded)", [&rTexture] { return ContentOf(rTexture); });
	if (io_rPart.m_pTexture)
		return;
	io_rPart.m_TexturePath = FindTexture(rTexture);
	io_rPart.m_pTexture = m_Images.Get(io_rPart.m_TexturePath);
}

std::string FBXIO::FBXMeshReader::FindTexture(const FbxFileTexture& i_rTexture) const
{
	// Files from Windows have its separators.
	const auto path = [](std::string i_Text)
	{
		std::replace(i_Text.begin(), i_Text.end(), '\\', '/');
		return UtilsFileSystem::PathFromUtf8(i_Text);
	};
	const boost::filesystem::path name = path(i_rTexture.GetFileName());
	if (Exists(name))
		return i_rTexture.GetFileName();
	const boost::filesystem::path folder = UtilsFileSystem::PathFromUtf8(m_Path).parent_path();
	const boost::filesystem::path relative = path(i_rTexture.GetRelativeFileName());
	const bool bRelative = !relative.empty() && Exists(folder / relative);
	return (folder / (bRelative ? relative : name.filename())).string();
}

bool FBXIO::FBXMeshReader::ReadMesh(FbxNode& i_rNode, VBasicMesh& o_rMesh)
{
	FbxMesh* const pMesh = i_rNode.GetMesh();
	std::optional<VSeams> seams;
	if (!pMesh || !TakeMesh(i_rNode, *pMesh, sizeof(VBasicVertex), 0, seams))
		return false;
	Prepare(i_rNode, *pMesh, o_rMesh);
	Finish(i_rNode, *pMesh, i_rNode.EvaluateGlobalTransform(), seams ? &*seams : nullptr, o_rMesh);
	return true;
}

void FBXIO::FBXMeshReader::ReadPlacedMesh(FbxNode& i_rNode, std::vector<VPlacedMesh>& io_rMeshes)
{
	VPlacedMesh placed;
	placed.m_Name = i_rNode.GetName();
	placed.m_Transform = SystemMatrix(i_rNode.EvaluateGlobalTransform());
	ScaleTranslation(placed.m_Transform, m_UnitScale);
	CheckTransform(placed.m_Transform, placed.m_Name);
	placed.m_Transform(3, 3) = 1.0f;
	placed.m_bSkinned = FindSkin(i_rNode) != nullptr;
	for (FbxNode* pNode = &i_rNode; pNode && placed.m_Bone.empty(); pNode = pNode->GetParent())
		placed.m_Bone = pNode->GetSkeleton() ? pNode->GetName() : "";
	if (ReadMesh(i_rNode, placed.m_Mesh))
		io_rMeshes.push_back(std::move(placed));
}

bool FBXIO::FBXMeshReader::Take(FbxNode& i_rNode, std::uint64_t i_Bytes)
{
	const bool bEnough = i_Bytes <= m_BytesLeft;
	if (bEnough)
		m_BytesLeft -= i_Bytes;
	else if (m_Told.insert(&i_rNode).second)
		NVX_LOG("FBXIO", NVX::ELogWarning, "Mesh %1% left out because the meshes of the file are too large",
		    i_rNode.GetName());
	return bEnough;
}

bool FBXIO::FBXMeshReader::TakeMesh(FbxNode& i_rNode, FbxMesh& io_rFrom, std::size_t i_VertexSize,
    std::uint64_t i_MoreBytes, std::optional<VSeams>& o_rSeams)
{
	if (!Take(i_rNode,
	        i_MoreBytes + io_rFrom.GetControlPointsCount() * (i_VertexSize + Limits::c_PointBytes)
	            + io_rFrom.GetPolygonVertexCount() * Limits::c_CornerBytes
	            + i_rNode.GetMaterialCount() * Limits::c_PartBytes))
		return false;
	o_rSeams = FindSeams(io_rFrom, m_Rules.m_VertexKey);
	return !o_rSeams || Take(i_rNode, o_rSeams->m_Vertices.size() * (i_VertexSize + sizeof(VSeams::VVertex)));
}

void FBXIO::FBXMeshReader::EndMeshes()
{
	Tell(std::exchange(m_Findings, {}), m_Path);
}

std::int64_t FBXIO::FBXMeshReader::FindBone(FbxCluster& i_rCluster)
{
	if (const auto found = m_BoneOfName.find(i_rCluster.GetLink()->GetName()); found != m_BoneOfName.end())
		return found->second;
	if (m_Searched.insert(&i_rCluster).second)
		NVX_LOG("FBXIO", NVX::ELogError, "Missing bone %1% for cluster %2%", i_rCluster.GetLink()->GetName(),
		    i_rCluster.GetName());
	return -1;
}

void FBXIO::FBXMeshReader::FindUsedBones(FbxNode& i_rNode, std::set<std::int64_t>& io_rBones)
{
	if (FbxSkin* const pSkin = FindSkin(i_rNode); pSkin && m_Searched.insert(pSkin).second)
		ForEachCluster(*pSkin,
		    [&](FbxCluster& i_rCluster)
		    {
			    // The parents of a bone that is known are known too.
			    for (std::int64_t bone = FindBone(i_rCluster); bone >= 0 && io_rBones.insert(bone).second;)
				    bone = (*m_pSkeleton)[bone].m_ParentIndex;
		    });
}

void FBXIO::FBXMeshReader::AddBoneSkins(
    FbxNode& i_rNode, std::vector<VBoneSkinSums>& io_rSums, std::set<const FbxObject*>& io_rSeen, int i_UpAxis) const
{
	FbxSkin* const pSkin = FindSkin(i_rNode);
	FbxMesh* const pMesh = pSkin && io_rSeen.insert(pSkin).second ? i_rNode.GetMesh() : nullptr;
	if (!pMesh)
		return;
	std::vector<double> totals(std::size_t(std::max(0, pMesh->GetControlPointsCount())));
	ForEachCluster(*pSkin, [&](FbxCluster& i_rCluster) { AddWeights(i_rCluster, totals); });
	ForEachCluster(*pSkin,
	    [&](FbxCluster& i_rCluster)
	    {
		    if (const auto found = m_BoneOfName.find(i_rCluster.GetLink()->GetName()); found != m_BoneOfName.end())
			    io_rSums[std::size_t(found->second)].Add(i_rCluster, *pMesh, totals, i_UpAxis);
	    });
}

std::shared_ptr<const VSkinSkeleton> FBXIO::FBXMeshReader::PruneSkeleton(std::set<std::int64_t> i_Bones)
{
	const std::shared_ptr<VSkinSkeleton> pFull = m_pSkeleton;
	for (std::size_t i = 0; i < pFull->size(); ++i)
		if (i_Bones.contains((*pFull)[i].m_ParentIndex))
			i_Bones.insert(std::int64_t(i));
	const auto pPruned = std::make_shared<VSkinSkeleton>();
	std::map<std::int64_t, std::int64_t> newIndex;
	for (const std::int64_t bone : i_Bones)
	{
		newIndex[bone] = std::int64_t(pPruned->size());
		pPruned->push_back((*pFull)[bone]);
		if (std::int64_t& rParent = pPruned->back().m_ParentIndex; rParent >= 0)
			rParent = newIndex.at(rParent);
	}
	m_Searched.clear();
	SetSkeleton(pPruned);
	return pPruned;
}

std::int64_t FBXIO::FBXMeshReader::BindBone(FbxCluster& i_rCluster)
{
	const std::int64_t bone = FindBone(i_rCluster);
	if (bone < 0)
		return 0;
	FbxAMatrix transform;
	FbxAMatrix link;
	i_rCluster.GetTransformMatrix(transform);
	i_rCluster.GetTransformLinkMatrix(link);
	for (FbxAMatrix* const pMatrix : {&transform, &link})
	{
		FbxVector4 translation = pMatrix->GetT();
		for (int axis = 0; axis < 3; ++axis)
			translation[axis] *= m_UnitScale;
		pMatrix->SetT(translation);
	}
	VSkinBone& rBone = (*m_pSkeleton)[bone];
	Rotation::VMatrix4 inverseBind = SystemMatrix(link.Inverse() * transform);
	CheckTransform(inverseBind, rBone.m_Name, m_Searched.insert(&i_rCluster).second);
	if (!m_BoundBones.insert(bone).second && AreSeenToDiffer(inverseBind, rBone.m_InverseBind))
		m_Findings.m_BoundDifferently.insert(bone);
	rBone.m_InverseBind = inverseBind;
	return bone;
}

void FBXIO::FBXMeshReader::ReadSkinMesh(FbxNode& i_rNode, std::vector<VSkinMesh>& io_rMeshes)
{
	FbxSkin* const pSkin = FindSkin(i_rNode);
	FbxMesh* const pMesh = pSkin && m_pSkeleton ? i_rNode.GetMesh() : nullptr;
	if (!pMesh)
		return;
	std::uint64_t bytes = 0;
	ForEachCluster(*pSkin,
	    [&bytes](FbxCluster& i_rCluster)
	    { bytes += Limits::c_ClusterBytes + i_rCluster.GetControlPointIndicesCount() * std::uint64_t(8); });
	std::optional<VSeams> seams;
	if (!TakeMesh(i_rNode, *pMesh, sizeof(VSkinVertex), bytes, seams))
		return;
	VBoundClusters clusters;
	ForEachCluster(*pSkin,
	    [&](FbxCluster& i_rCluster) { clusters.emplace_back(&i_rCluster, std::int32_t(BindBone(i_rCluster))); });
	const std::size_t points = pMesh->GetControlPointsCount();
	// Beside the vertices, which have nothing to do with weights; small meshes are not worth a thread. With both
	// policies it is one as long as the system has one to give.
	std::future<VSkinWeights> weights =
	    std::async(points < c_PointsForTwo ? std::launch::deferred : std::launch::async | std::launch::deferred,
	        [&] { return ReadSkinWeights(clusters, points); });
	VSkinMesh& rMesh = io_rMeshes.emplace_back();
	Prepare(i_rNode, *pMesh, rMesh);
	const VSkinWeights read = weights.get();
	for (std::size_t point = 0; point < points; ++point)
	{
		rMesh.m_Vertices[point].m_BoneIndices = read.m_Points[point].m_Bones;
		rMesh.m_Vertices[point].m_BoneWeights = read.m_Points[point].m_Weights;
	}
	TellSkinWeights(read, i_rNode.GetName());
	FbxAMatrix place = i_rNode.EvaluateGlobalTransform();
	if (!clusters.empty())
		clusters.front().first->GetTransformMatrix(place);
	Finish(i_rNode, *pMesh, place, seams ? &*seams : nullptr, rMesh);
}
