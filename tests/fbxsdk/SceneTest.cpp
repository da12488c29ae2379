#include "../UtilsFileSystem/Log.h"
#include "FbxFileBuilder.h"
#include "Imported.h"

#include <Eigen/Geometry>

using namespace FbxTest;
using namespace std::string_literals;

namespace
{

/// "a(b(c) d)", bones with a star.
std::string Outline(FbxNode* i_pNode)
{
	std::string outline = i_pNode->GetName();
	outline += i_pNode->GetSkeleton() ? "*" : "";
	for (int i = 0; i < i_pNode->GetChildCount(); ++i)
	{
		EXPECT_EQ(i_pNode->GetChild(i)->GetParent(), i_pNode);
		outline += i == 0 ? "(" : " ";
		outline += Outline(i_pNode->GetChild(i));
	}
	outline += i_pNode->GetChildCount() > 0 ? ")" : "";
	return outline;
}

TEST(Scene, TellsItsSettingsInEveryForm)
{
	const VTestScene scene{
	    {{"root", "Root", -1, {}}}, {{"UpAxis", {2}}, {"UpAxisSign", {-1}}, {"UnitScaleFactor", {2.54}}}, {}, {}};
	for (const VTestForm& rForm : c_Forms)
	{
		VImported file(Write(rForm, scene));
		const FbxGlobalSettings& rSettings = file.m_pScene->GetGlobalSettings();
		EXPECT_EQ(rSettings.GetSystemUnit().GetScaleFactor(), 2.54);
		int sign = 0;
		EXPECT_EQ(rSettings.GetAxisSystem().GetUpVector(sign), FbxAxisSystem::eZAxis);
		EXPECT_EQ(sign, -1);
		EXPECT_TRUE(file.Root()->GetChild(0)->GetSkeleton()->IsSkeletonRoot());
		int major = 0, minor = 0, revision = 0;
		file.m_pImporter->GetFileVersion(major, minor, revision);
		EXPECT_EQ(major * 1000 + minor * 100 + revision * 10, int(rForm.m_Version));
		for (const double none : {-1.0, 3.0})
		{
			VImported other(Write(rForm, VTestScene{{{"root", "Root", -1, {}}}, {{"UpAxis", {none}}}, {}, {}}));
			EXPECT_EQ(other.m_pScene->GetGlobalSettings().GetAxisSystem().GetUpVector(sign), FbxAxisSystem::eXAxis);
		}
	}
}

TEST(Scene, BrokenConnectionsAreLeftOutAndTold)
{
	for (const VTestForm& rForm : c_Forms)
	{
		VTestLog log("FBXIO");
		const VTestScene scene{{{"a", "LimbNode", -1, {}}, {"b", "LimbNode", 0, {}}, {"ring1", "Null", 3, {}},
		                           {"ring2", "Null", 2, {}}, {"below", "Null", 2, {}}, {"self", "Null", 5, {}}},
		    {}, {}, {{1, -1}, {1, 0}}};
		std::vector<VTestRecord> records = Records(rForm, scene);
		const bool bNew = rForm.m_Version >= 7000;
		const auto key = [bNew](std::int64_t i_Number, const char* i_pName)
		{ return bNew ? VTestValue(i_Number) : VTestValue("Model::"s + i_pName); };
		const VTestRecord unknown[]{{"C", {"OO"s, key(99, "nobody"), key(1, "a")}, {}},
		    {"C", {"OO"s, key(1, "a"), key(99, "nobody")}, {}}, {"C", {"OO"s}, {}}, {"C", {}, {}}};
		auto& rConnections = records.back().m_Children;
		rConnections.insert(rConnections.begin(), std::begin(unknown), std::end(unknown));
		// An object that no connection names.
		records[records.size() - 2].m_Children.push_back({"Model",
		    bNew ? std::vector<VTestValue>{std::int64_t(500), "Model::loose"s, "Null"s}
		         : std::vector<VTestValue>{"Model::loose"s, "Null"s},
		    {}});
		VImported file(Write(rForm, records));
		EXPECT_TRUE(file.m_bImported);
		EXPECT_EQ(Outline(file.Root()), "RootNode(a*(b*))") << rForm.m_pName;
		EXPECT_EQ(file.Root()->GetChildCount(true), 2);
		const std::vector<std::string> expected{
		    "3 Connections left out because their node has another parent: 1, such as that of b",
		    "4 Nodes left out because no connection leads to them: 1",
		    "3 Nodes left out because their connections lead round in a ring: 4"};
		EXPECT_EQ(log.Take(), expected) << rForm.m_pName;
	}
}

TEST(Scene, ImporterRefusesWhatItCannotDo)
{
	VImported file(Write(c_Forms[1], VTestScene()));
	EXPECT_TRUE(file.m_bImported);
	EXPECT_FALSE(file.m_pImporter->Import(file.m_pScene, true));
	EXPECT_FALSE(file.m_pImporter->Import(nullptr, false));
	EXPECT_FALSE(file.m_pImporter->Initialize(file.m_Path.c_str(), 2, nullptr));
	EXPECT_EQ(file.m_pImporter->GetStatus().GetCode(), FbxStatus::eInvalidParameter);
	EXPECT_FALSE(file.m_pImporter->Import(file.m_pScene, false));
	EXPECT_EQ(file.Root()->GetChild(0), nullptr);
	EXPECT_EQ(file.Root()->GetParent(), nullptr);
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
	const auto turn = [](int i_Axis, double i_Degrees)
	{ return Eigen::AngleAxisd(i_Degrees * double(EIGEN_PI) / 180.0, Eigen::Vector3d::Unit(i_Axis)); };
	const Eigen::Affine3d expected =
	    Eigen::Translation3d(1, 2, 3) * turn(2, 30) * turn(1, 20) * turn(0, 10) * Eigen::Scaling(1.0, 2.0, 3.0);
	EXPECT_TRUE(toEigen(a).isApprox(expected.matrix(), 1e-14));
	EXPECT_EQ(a[3][1], 2.0);
	EXPECT_TRUE(toEigen(a * b).isApprox(toEigen(a) * toEigen(b), 1e-14));
	EXPECT_TRUE(toEigen(a.Inverse()).isApprox(toEigen(a).inverse(), 1e-14));
	EXPECT_TRUE(toEigen(FbxAMatrix(FbxVector4(1, 2, 3), FbxVector4(), FbxVector4(0, 1, 1)).Inverse()).isIdentity());
	FbxAMatrix moved;
	moved.SetT(FbxVector4(1, 2, 3, 7));
	EXPECT_EQ(moved[3][2], 3.0);
	EXPECT_EQ(moved[3][3], 1.0);
}

} // namespace
