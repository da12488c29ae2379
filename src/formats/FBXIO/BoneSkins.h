#pragma once

#include "FBXIO/BoneSkin.h"

#include <fbxsdk.h>

#include <vector>

namespace FBXIO
{

/// Sums over the control points that a bone moves, along the axes that it had when it was bound, in file units.
struct VBoneSkinSums
{
	double m_Weight = 0.0;
	Rotation::VVector3 m_Places{};
	double m_Squares = 0.0;

	/// Leaves out what is no number.
	void Add(FbxCluster& i_rCluster, FbxMesh& io_rMesh);
};

/// Empty if nothing is moved.
std::vector<VBoneSkin> BoneSkinsOf(const std::vector<VBoneSkinSums>& i_rSums, double i_UnitScale);

} // namespace FBXIO
