#include "AssimpReader.h"

#include <assimp/Importer.hpp>
#include <assimp/config.h>
#include <assimp/scene.h>

#include <gtest/gtest.h>

namespace
{

template <typename TKey>
const TKey& KeyAt(const TKey* i_pKeys, unsigned i_Count, std::size_t i_Frame)
{
	return i_pKeys[i_Count == 1 ? 0 : std::min(i_Frame, std::size_t(i_Count) - 1)];
}

/// Without scale; columns at right angles.
Rotation::VPose<double> PoseOf(const aiMatrix4x4& i_rMatrix)
{
	aiVector3D x(i_rMatrix.a1, i_rMatrix.b1, i_rMatrix.c1), y(i_rMatrix.a2, i_rMatrix.b2, i_rMatrix.c2);
	x.Normalize();
	y = (y - x * (x * y)).Normalize();
	const aiVector3D z = x ^ y;
	return {{x.x, y.x, z.x, x.y, y.y, z.y, x.z, y.z, z.z}, {i_rMatrix.a4, i_rMatrix.b4, i_rMatrix.c4}};
}

struct VWalk
{
	std::map<std::string, const aiNodeAnim*> m_Tracks;
	std::size_t m_Frame = 0;
	VNodePoses m_Poses;
	std::map<std::string, aiMatrix4x4> m_Globals;

	void Visit(const aiNode& i_rNode, const aiMatrix4x4& i_rParent)
	{
		aiMatrix4x4 local = i_rNode.mTransformation;
		if (const auto track = m_Tracks.find(i_rNode.mName.C_Str()); track != m_Tracks.end())
		{
			const aiNodeAnim& rTrack = *track->second;
			local = aiMatrix4x4(KeyAt(rTrack.mScalingKeys, rTrack.mNumScalingKeys, m_Frame).mValue,
			    KeyAt(rTrack.mRotationKeys, rTrack.mNumRotationKeys, m_Frame).mValue,
			    KeyAt(rTrack.mPositionKeys, rTrack.mNumPositionKeys, m_Frame).mValue);
		}
		const aiMatrix4x4 global = i_rParent * local;
		m_Poses[i_rNode.mName.C_Str()].push_back(PoseOf(global));
		m_Globals[i_rNode.mName.C_Str()] = global;
		for (unsigned i = 0; i < i_rNode.mNumChildren; ++i)
			Visit(*i_rNode.mChildren[i], global);
	}
};

} // namespace

std::vector<Rotation::VVector3> SkinnedPoints(const std::string& i_rBytes, const char* i_pForm)
{
	Assimp::Importer importer;
	const aiScene* const pScene = importer.ReadFileFromMemory(i_rBytes.data(), i_rBytes.size(), 0, i_pForm);
	std::vector<Rotation::VVector3> points;
	EXPECT_TRUE(pScene && pScene->mNumAnimations == 1) << importer.GetErrorString();
	if (!pScene || pScene->mNumAnimations == 0)
		return points;
	VWalk walk;
	for (unsigned k = 0; k < pScene->mAnimations[0]->mNumChannels; ++k)
		walk.m_Tracks[pScene->mAnimations[0]->mChannels[k]->mNodeName.C_Str()] = pScene->mAnimations[0]->mChannels[k];
	walk.Visit(*pScene->mRootNode, {});
	for (unsigned i = 0; i < pScene->mNumMeshes; ++i)
	{
		const aiMesh& rMesh = *pScene->mMeshes[i];
		std::vector<aiVector3D> moved(rMesh.mNumVertices);
		for (unsigned bone = 0; bone < rMesh.mNumBones; ++bone)
		{
			const aiBone& rBone = *rMesh.mBones[bone];
			const aiMatrix4x4 matrix = walk.m_Globals[rBone.mName.C_Str()] * rBone.mOffsetMatrix;
			for (unsigned k = 0; k < rBone.mNumWeights; ++k)
				moved[rBone.mWeights[k].mVertexId] +=
				    rBone.mWeights[k].mWeight * (matrix * rMesh.mVertices[rBone.mWeights[k].mVertexId]);
		}
		for (const aiVector3D& rPoint : moved)
			points.push_back({rPoint.x, rPoint.y, rPoint.z});
	}
	return points;
}

VNodePoses ReadByAssimp(
    const std::string& i_rBytes, const char* i_pForm, const std::string& i_rAnimation, std::size_t i_Frames)
{
	Assimp::Importer importer;
	importer.SetPropertyBool(AI_CONFIG_IMPORT_FBX_PRESERVE_PIVOTS, false);
	const aiScene* const pScene = importer.ReadFileFromMemory(i_rBytes.data(), i_rBytes.size(), 0, i_pForm);
	VWalk walk;
	EXPECT_TRUE(pScene) << importer.GetErrorString();
	for (unsigned i = 0; pScene && i < pScene->mNumAnimations; ++i)
		if (const aiAnimation& rAnimation = *pScene->mAnimations[i]; i_rAnimation == rAnimation.mName.C_Str())
			for (unsigned k = 0; k < rAnimation.mNumChannels; ++k)
				walk.m_Tracks[rAnimation.mChannels[k]->mNodeName.C_Str()] = rAnimation.mChannels[k];
	EXPECT_FALSE(walk.m_Tracks.empty());
	for (; !walk.m_Tracks.empty() && walk.m_Frame < i_Frames; ++walk.m_Frame)
	{
		const aiNode& rRoot = *pScene->mRootNode;
		// Several at the top hang on a node that no file has.
		if (walk.m_Tracks.contains(rRoot.mName.C_Str()))
			walk.Visit(rRoot, {});
		else
			for (unsigned i = 0; i < rRoot.mNumChildren; ++i)
				walk.Visit(*rRoot.mChildren[i], {});
	}
	return std::move(walk.m_Poses);
}
