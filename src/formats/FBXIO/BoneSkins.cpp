#include "FBXIO/BoneSkins.h"

#include <algorithm>
#include <cmath>

namespace FBXIO
{
namespace
{

/// A row of a matrix for row vectors: an axis, or the translation.
Rotation::VVector3 Row(const FbxAMatrix& i_rMatrix, int i_Row)
{
	return {i_rMatrix.Get(i_Row, 0), i_rMatrix.Get(i_Row, 1), i_rMatrix.Get(i_Row, 2)};
}

double Inner(const Rotation::VVector3& i_rA, const Rotation::VVector3& i_rB)
{
	return i_rA[0] * i_rB[0] + i_rA[1] * i_rB[1] + i_rA[2] * i_rB[2];
}

} // namespace

void VBoneSkinSums::Add(FbxCluster& i_rCluster, FbxMesh& io_rMesh)
{
	FbxAMatrix place;
	FbxAMatrix link;
	i_rCluster.GetTransformMatrix(place);
	i_rCluster.GetTransformLinkMatrix(link);
	const Rotation::VVector3 origin = Row(link, 3);
	Rotation::VVector3 axes[3];
	Rotation::VVector3 mesh[4];
	for (int row = 0; row < 4; ++row)
		mesh[row] = Row(place, row);
	for (int axis = 0; axis < 3; ++axis)
	{
		axes[axis] = Row(link, axis);
		const double length = std::sqrt(Inner(axes[axis], axes[axis]));
		if (!(length > 0.0))
			return;
		for (double& rValue : axes[axis])
			rValue /= length;
	}
	const int* const pPoints = i_rCluster.GetControlPointIndices();
	const double* const pWeights = i_rCluster.GetControlPointWeights();
	const int points = io_rMesh.GetControlPointsCount();
	for (int i = 0, count = i_rCluster.GetControlPointIndicesCount(); i < count; ++i)
	{
		if (pPoints[i] < 0 || pPoints[i] >= points || !(pWeights[i] > 0.0))
			continue;
		const FbxVector4 point = io_rMesh.GetControlPointAt(pPoints[i]);
		Rotation::VVector3 from;
		for (std::size_t axis = 0; axis < 3; ++axis)
			from[axis] = mesh[3][axis] - origin[axis] + point[0] * mesh[0][axis] + point[1] * mesh[1][axis]
			    + point[2] * mesh[2][axis];
		const double square = Inner(from, from);
		if (!std::isfinite(square) || !std::isfinite(pWeights[i]))
			continue;
		m_Weight += pWeights[i];
		m_Squares += pWeights[i] * square;
		for (int axis = 0; axis < 3; ++axis)
			m_Places[axis] += pWeights[i] * Inner(from, axes[axis]);
	}
}

std::vector<VBoneSkin> BoneSkinsOf(const std::vector<VBoneSkinSums>& i_rSums, double i_UnitScale)
{
	double whole = 0.0;
	for (const VBoneSkinSums& rSums : i_rSums)
		whole += rSums.m_Weight;
	std::vector<VBoneSkin> skins;
	if (!(whole > 0.0) || !std::isfinite(whole))
		return skins;
	for (const VBoneSkinSums& rSums : i_rSums)
	{
		VBoneSkin& rSkin = skins.emplace_back();
		if (!(rSums.m_Weight > 0.0) || !std::isfinite(rSums.m_Squares))
			continue;
		rSkin.m_Share = rSums.m_Weight / whole;
		for (std::size_t axis = 0; axis < 3; ++axis)
			rSkin.m_Centre[axis] = rSums.m_Places[axis] / rSums.m_Weight;
		rSkin.m_Spread = i_UnitScale
		    * std::sqrt(std::max(0.0, rSums.m_Squares / rSums.m_Weight - Inner(rSkin.m_Centre, rSkin.m_Centre)));
		for (double& rValue : rSkin.m_Centre)
			rValue *= i_UnitScale;
	}
	return skins;
}

} // namespace FBXIO
