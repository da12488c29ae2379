#pragma once

#include "fbxsdk/sdk/AffineMatrix.h"
#include "fbxsdk/sdk/Object.h"
#include "fbxsdk/sdk/Time.h"

#include <memory>

namespace FbxFormat
{
class VSceneBuilder;
}

namespace fbxsdk
{

class FbxGeometry;
class FbxMesh;
class FbxSurfaceMaterial;

/// What a node is, beyond its place in the scene.
class FbxNodeAttribute : public FbxObject
{
public:
	enum EType
	{
		eUnknown,
		eNull,
		eMarker,
		eSkeleton,
		eMesh
	};

	virtual EType GetAttributeType() const = 0;

protected:
	using FbxObject::FbxObject;
};

class FbxSkeleton : public FbxNodeAttribute
{
public:
	enum EType
	{
		eRoot,
		eLimb,
		eLimbNode,
		eEffector
	};

	FbxNodeAttribute::EType GetAttributeType() const override { return FbxNodeAttribute::eSkeleton; }
	EType GetSkeletonType() const { return m_Type; }

	/// True if the file calls the bone a root, wherever it stands.
	bool IsSkeletonRoot() const { return m_Type == eRoot; }

private:
	friend class FbxFormat::VSceneBuilder;

	FbxSkeleton(std::string i_Name, EType i_Type) : FbxNodeAttribute(std::move(i_Name)), m_Type(i_Type) {}

	EType m_Type;
};

/// A node of a scene, which owns it. Transforms are those of the pose without animation, whatever the time; each is
/// computed once.
class FbxNode : public FbxObject
{
public:
	enum EPivotSet
	{
		eSourcePivot,
		eDestinationPivot
	};

	~FbxNode() override;

	/// Null for the root.
	FbxNode* GetParent();
	int GetChildCount(bool pRecursive = false) const;
	FbxNode* GetChild(int pIndex);

	/// Null if the node is no bone.
	FbxSkeleton* GetSkeleton();

	/// Bone and mesh, whichever the node has.
	int GetNodeAttributeCount() const;
	FbxNodeAttribute* GetNodeAttributeByIndex(int pIndex);

	/// Decodes the mesh. Null if the node has none, or if it is damaged.
	FbxMesh* GetMesh();

	/// Null if the node has none. Nothing of it is decoded.
	FbxGeometry* GetGeometry();

	int GetMaterialCount() const;
	FbxSurfaceMaterial* GetMaterial(int pIndex) const;

	/// In degrees, order XYZ; zero where the node's flags turn it off. Files have no destination pivots.
	FbxVector4 GetPreRotation(EPivotSet pPivotSet) const;

	/// Between the node and its mesh, in file units and degrees; no part of any transform that is evaluated.
	FbxVector4 GetGeometricTranslation(EPivotSet pPivotSet) const;
	FbxVector4 GetGeometricRotation(EPivotSet pPivotSet) const;
	FbxVector4 GetGeometricScaling(EPivotSet pPivotSet) const;

	/// Relative to the parent, in file units.
	FbxAMatrix& EvaluateLocalTransform(FbxTime pTime = FBXSDK_TIME_INFINITE, EPivotSet pPivotSet = eSourcePivot,
	    bool pApplyTarget = false, bool pForceEval = false);

	/// In the scene, in file units. Any depth of nodes is walked without recursion.
	FbxAMatrix& EvaluateGlobalTransform(FbxTime pTime = FBXSDK_TIME_INFINITE, EPivotSet pPivotSet = eSourcePivot,
	    bool pApplyTarget = false, bool pForceEval = false);

	FbxVector4& EvaluateLocalScaling(FbxTime pTime = FBXSDK_TIME_INFINITE, EPivotSet pPivotSet = eSourcePivot,
	    bool pApplyTarget = false, bool pForceEval = false);

private:
	friend class FbxFormat::VSceneBuilder;
	struct VData;

	explicit FbxNode(std::string i_Name);

	std::unique_ptr<VData> m_pData;
};

} // namespace fbxsdk
