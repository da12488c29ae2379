#include "FBXIO/BoneSkins.h"

#include <algorithm>
#include <cmath>

namespace FBXIO
{
namespace
{

/// The share of a point's weights from which on a bone carries it.
constexpr double c_Carries = 0.5;
/// In mm: what is farther from its bone is damage.
constexpr double c_Farthest = 1e9;

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

void AddWeights(FbxCluster& i_rCluster, std::vector<double>& io_rTotals)
{
	const int* const pPoints = i_rCluster.GetControlPointIndices();
	const double* const pWeights = i_rCluster.GetControlPointWeights();
	for (int i = 0, count = i_rCluster.GetControlPointIndicesCount(); i < count; ++i)
		if (pPoints[i] >= 0 && std::size_t(pPoints[i]) < io_rTotals.size() && pWeights[i] > 0.0)
			io_rTotals[std::size_t(pPoints[i])] += pWeights[i];
}

void VBoneSkinSums::Add(FbxCluster& i_rCluster, FbxMesh& io_rMesh, const std::vector<double>& i_rTotals, int i_UpAxis)
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
	for (std::size_t axis = 0; axis < 3; ++axis)
		m_BoundUp[axis] = axes[axis][std::size_t(i_UpAxis)];
	const int* const pPoints = i_rCluster.GetControlPointIndices();
	const double* const pWeights = i_rCluster.GetControlPointWeights();
	for (int i = 0, count = i_rCluster.GetControlPointIndicesCount(); i < count; ++i)
	{
		if (pPoints[i] < 0 || std::size_t(pPoints[i]) >= i_rTotals.size() || !(pWeights[i] > 0.0))
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
		const Rotation::VVector3 along{Inner(from, axes[0]), Inner(from, axes[1]), Inner(from, axes[2])};
		for (std::size_t axis = 0; axis < 3; ++axis)
			m_Places[axis] += pWeights[i] * along[axis];
		if (pWeights[i] >= c_Carries * i_rTotals[std::size_t(pPoints[i])])
			m_Carried.push_back(along);
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
		rSkin.m_BoundUp = rSums.m_BoundUp;
		std::vector<std::array<float, 3>> carried;
		for (const Rotation::VVector3& rPlace : rSums.m_Carried)
			if (i_UnitScale * std::sqrt(Inner(rPlace, rPlace)) < c_Farthest)
				carried.push_back(
				    {float(i_UnitScale * rPlace[0]), float(i_UnitScale * rPlace[1]), float(i_UnitScale * rPlace[2])});
		if (!carried.empty())
			rSkin.m_pCarried = std::make_shared<const std::vector<std::array<float, 3>>>(std::move(carried));
	}
	return skins;
}

} // namespace FBXIO
