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
	std::vector<Rotation::VVector3> m_Carried;
	Rotation::VVector3 m_BoundUp{};

	/// Leaves out what is no number.
	/// @param i_rTotals of the weights that all bones have, for each control point.
	/// @param i_UpAxis of the file, from 0 to 2.
	void Add(FbxCluster& i_rCluster, FbxMesh& io_rMesh, const std::vector<double>& i_rTotals, int i_UpAxis);
};

/// Adds what a bone weighs in each control point to what others do.
void AddWeights(FbxCluster& i_rCluster, std::vector<double>& io_rTotals);

/// Empty if nothing is moved.
std::vector<VBoneSkin> BoneSkinsOf(const std::vector<VBoneSkinSums>& i_rSums, double i_UnitScale);

} // namespace FBXIO
