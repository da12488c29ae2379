#include "fbxsdk/scene/NodeTransform.h"

#include <fbxsdk.h>

#include <Eigen/Geometry>
#include <gtest/gtest.h>

#include <random>

using namespace FbxFormat;
using Eigen::Affine3d;
using Eigen::Matrix3d;
using Eigen::Vector3d;

namespace
{

Vector3d ToEigen(const Rotation::VVector3& i_rVector)
{
	return {i_rVector[0], i_rVector[1], i_rVector[2]};
}

Matrix3d ToEigen(const Rotation::VMatrix3& i_rMatrix)
{
	return Eigen::Map<const Eigen::Matrix<double, 3, 3, Eigen::RowMajor>>(i_rMatrix.data());
}

/// The axes named by i_pOrder, the first one turned first.
Matrix3d Euler(const Rotation::VVector3& i_rDegrees, const char* i_pOrder)
{
	Matrix3d rotation = Matrix3d::Identity();
	for (const char* p = i_pOrder; *p; ++p)
		rotation = Eigen::AngleAxisd(i_rDegrees[*p - 'X'] * EIGEN_PI / 180.0, Vector3d::Unit(*p - 'X')) * rotation;
	return rotation;
}

/// The documented chain, factor by factor.
Affine3d Chain(const VNodeTransform& i_rNode, const char* i_pOrder)
{
	using Eigen::Translation3d;
	const Translation3d t(ToEigen(i_rNode.m_Translation)), roff(ToEigen(i_rNode.m_RotationOffset)),
	    rp(ToEigen(i_rNode.m_RotationPivot)), soff(ToEigen(i_rNode.m_ScalingOffset)),
	    sp(ToEigen(i_rNode.m_ScalingPivot));
	return t * roff * rp * Affine3d(Euler(i_rNode.m_PreRotation, "XYZ")) * Affine3d(Euler(i_rNode.m_Rotation, i_pOrder))
	    * Affine3d(Euler(i_rNode.m_PostRotation, "XYZ")).inverse() * rp.inverse() * soff * sp
	    * Eigen::Scaling(ToEigen(i_rNode.m_Scaling)) * sp.inverse();
}

VNodeTransform RandomNode(std::mt19937& io_rGenerator)
{
	std::uniform_real_distribution<double> any(-100.0, 100.0), scale(0.3, 2.0);
	VNodeTransform node;
	for (auto* const pVector : {&node.m_Translation, &node.m_Rotation, &node.m_RotationOffset, &node.m_RotationPivot,
	         &node.m_ScalingOffset, &node.m_ScalingPivot, &node.m_PreRotation, &node.m_PostRotation})
		for (double& rComponent : *pVector)
			rComponent = any(io_rGenerator);
	for (double& rComponent : node.m_Scaling)
		rComponent = scale(io_rGenerator);
	node.m_bRotationActive = true;
	return node;
}

constexpr const char* c_Orders[]{"XYZ", "XZY", "YZX", "YXZ", "ZXY", "ZYX"};

TEST(NodeTransform, FollowsTheChainInEveryRotationOrder)
{
	std::mt19937 generator(7);
	for (int order = 0; order < 6; ++order)
	{
		VNodeTransform node = RandomNode(generator);
		node.m_Order = ERotationOrder(order);
		const VAffine local = LocalTransform(node).m_Map;
		const Affine3d expected = Chain(node, c_Orders[order]);
		EXPECT_TRUE(ToEigen(local.L).isApprox(expected.linear(), 1e-12)) << c_Orders[order];
		EXPECT_TRUE(ToEigen(local.t).isApprox(expected.translation(), 1e-12)) << c_Orders[order];
	}
}

TEST(NodeTransform, InactiveRotationLeavesOutPreAndPostRotationAndOrder)
{
	std::mt19937 generator(8);
	VNodeTransform node = RandomNode(generator);
	node.m_Order = ERotationOrder::ZYX;
	node.m_bRotationActive = false;
	VNodeTransform plain = node;
	plain.m_PreRotation = plain.m_PostRotation = {};
	const Affine3d expected = Chain(plain, "XYZ");
	EXPECT_TRUE(ToEigen(LocalTransform(node).m_Map.L).isApprox(expected.linear(), 1e-12));
	EXPECT_TRUE(ToEigen(LocalTransform(node).m_Map.t).isApprox(expected.translation(), 1e-12));
}

/// Three generations under each inherit type, against the products of rotations and scalings written out.
TEST(NodeTransform, InheritTypesCombineRotationAndScaling)
{
	std::mt19937 generator(9);
	for (const EInheritType type : {EInheritType::RrSs, EInheritType::RSrs, EInheritType::Rrs})
	{
		const VNodeTransform nodes[]{RandomNode(generator), RandomNode(generator), RandomNode(generator)};
		VGlobalTransform global;
		Vector3d place = Vector3d::Zero();
		Matrix3d linear = Matrix3d::Identity();
		Matrix3d R[3], S[3];
		for (int i = 0; i < 3; ++i)
		{
			R[i] = Euler(nodes[i].m_PreRotation, "XYZ") * Euler(nodes[i].m_Rotation, "XYZ")
			    * Euler(nodes[i].m_PostRotation, "XYZ").transpose();
			S[i] = ToEigen(nodes[i].m_Scaling).asDiagonal();
			place += linear * Chain(nodes[i], "XYZ").translation();
			global = GlobalTransform(global, LocalTransform(nodes[i]), type);
			const Matrix3d expected[3][3]{{R[0] * S[0], R[0] * S[0], R[0] * S[0]},
			    {R[0] * R[1] * S[0] * S[1], R[0] * S[0] * R[1] * S[1], R[0] * R[1] * S[1]},
			    {R[0] * R[1] * R[2] * S[0] * S[1] * S[2], R[0] * S[0] * R[1] * S[1] * R[2] * S[2],
			        R[0] * R[1] * R[2] * S[2]}};
			linear = expected[i][int(type)];
			EXPECT_TRUE(ToEigen(global.m_Map.L).isApprox(linear, 1e-12)) << int(type) << ' ' << i;
			EXPECT_TRUE(ToEigen(global.m_Map.t).isApprox(place, 1e-12)) << int(type) << ' ' << i;
		}
	}
}

/// A type is each node's own: what Rrs leaves out of the parent is not what the parent left out.
TEST(NodeTransform, InheritTypesMix)
{
	std::mt19937 generator(10);
	VNodeTransform nodes[]{RandomNode(generator), RandomNode(generator), RandomNode(generator)};
	VGlobalTransform global;
	for (int i = 0; i < 3; ++i)
		global = GlobalTransform(global, LocalTransform(nodes[i]), i == 2 ? EInheritType::Rrs : EInheritType::RrSs);
	Matrix3d rotation = Matrix3d::Identity();
	for (const VNodeTransform& rNode : nodes)
		rotation = rotation * Euler(rNode.m_PreRotation, "XYZ") * Euler(rNode.m_Rotation, "XYZ")
		    * Euler(rNode.m_PostRotation, "XYZ").transpose();
	const Matrix3d expected =
	    rotation * ToEigen(nodes[0].m_Scaling).asDiagonal() * ToEigen(nodes[2].m_Scaling).asDiagonal();
	EXPECT_TRUE(ToEigen(global.m_Map.L).isApprox(expected, 1e-12));
}

TEST(AffineMatrix, IsStoredForRowVectorsAndMultipliesForColumnVectors)
{
	const FbxAMatrix a(FbxVector4(1, 2, 3), FbxVector4(10, 20, 30), FbxVector4(1, 2, 3));
	const FbxAMatrix b(FbxVector4(-4, 5, 6), FbxVector4(-40, 50, 60), FbxVector4(2, 0.5, 1));
	const auto toEigen = [](const FbxAMatrix& i_rMatrix)
	{
		Eigen::Matrix4d matrix;
		for (int row = 0; row < 4; ++row)
			for (int column = 0; column < 4; ++column)
				matrix(row, column) = i_rMatrix.Get(column, row);
		return matrix;
	};
	const Affine3d expected =
	    Eigen::Translation3d(1, 2, 3) * Affine3d(Euler({10, 20, 30}, "XYZ")) * Eigen::Scaling(1.0, 2.0, 3.0);
	EXPECT_TRUE(toEigen(a).isApprox(expected.matrix(), 1e-14));
	EXPECT_EQ(a[3][1], 2.0);
	EXPECT_TRUE(toEigen(a * b).isApprox(toEigen(a) * toEigen(b), 1e-14));
	EXPECT_TRUE(toEigen(a.Inverse()).isApprox(toEigen(a).inverse(), 1e-14));
	EXPECT_TRUE(toEigen(FbxAMatrix(FbxVector4(1, 2, 3), FbxVector4(), FbxVector4(0, 1, 1)).Inverse()).isIdentity());
}

} // namespace
