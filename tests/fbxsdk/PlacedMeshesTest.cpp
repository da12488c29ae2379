#include "fbxsdk/container/Arrays.h"
#include "fbxsdk/container/FileBytes.h"
#include "fbxsdk/container/FileKind.h"
#include "fbxsdk/document/Document.h"

#include <fbxsdk.h>

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <array>
#include <fstream>
#include <limits>
#include <map>

namespace
{

const std::string c_Folder = RETARGET_TEST_DATA "/fbx/";

using VBounds = std::array<double, 6>;

/// The bounds of each mesh's control points, placed by its node's global transform, in millimetres; by node.
std::map<std::string, VBounds> PlacedBounds(const std::string& i_rPath)
{
	FbxManager* const pManager = FbxManager::Create();
	FbxScene* const pScene = FbxScene::Create(pManager, "");
	FbxImporter* const pImporter = FbxImporter::Create(pManager, "");
	EXPECT_TRUE(pImporter->Initialize(i_rPath.c_str()) && pImporter->Import(pScene));
	const double unit = 10.0 * pScene->GetGlobalSettings().GetSystemUnit().GetScaleFactor();
	std::map<std::string, FbxAMatrix> globals;
	std::vector<FbxNode*> open{pScene->GetRootNode()};
	while (!open.empty())
	{
		FbxNode* const pNode = open.back();
		open.pop_back();
		globals[pNode->GetName()] = pNode->EvaluateGlobalTransform();
		for (int i = 0; i < pNode->GetChildCount(); ++i)
			open.push_back(pNode->GetChild(i));
	}
	pManager->Destroy();

	using namespace FbxFormat;
	VFileBytes bytes;
	std::string reason;
	EXPECT_TRUE(bytes.Read(i_rPath, std::numeric_limits<std::size_t>::max(), reason)) << reason;
	VElementTree tree;
	EXPECT_TRUE(tree.Read(bytes.View(), DetectFileKind(bytes.View()))) << tree.Error();
	const VDocument document(tree);
	std::map<std::string, VBounds> bounds;
	VDecodeBudget budget;
	const auto place = [&](const VObject& i_rGeometry, const VObject& i_rModel)
	{
		const VElementIndex vertices = tree.Find(i_rGeometry.m_Element, "Vertices");
		if (vertices == c_NoElement)
			return;
		FbxFormat::VArrayNumbers<double> points;
		EXPECT_TRUE(ReadArray(tree, vertices, budget, points));
		const std::string name = document.Decoded(i_rModel.m_Name);
		const FbxAMatrix& rGlobal = globals.at(name);
		VBounds& rBounds = bounds[name];
		constexpr double inf = std::numeric_limits<double>::infinity();
		rBounds = {inf, inf, inf, -inf, -inf, -inf};
		for (std::size_t i = 0; i + 2 < points.size(); i += 3)
			for (int axis = 0; axis < 3; ++axis)
			{
				double value = rGlobal.Get(3, axis);
				for (int k = 0; k < 3; ++k)
					value += rGlobal.Get(k, axis) * points[i + k];
				rBounds[axis] = std::min(rBounds[axis], unit * value);
				rBounds[axis + 3] = std::max(rBounds[axis + 3], unit * value);
			}
	};
	// Before version 7 the control points stand in the model itself.
	for (const VObject& rObject : document.Objects())
		if (rObject.m_Kind == "Model")
			place(rObject, rObject);
	for (const VConnection& rConnection : document.Connections())
		if (rConnection.m_Child < c_SceneObject && rConnection.m_Parent < c_SceneObject)
			if (const VObject& rChild = document.Objects()[rConnection.m_Child]; rChild.m_Kind == "Geometry")
				if (const VObject& rParent = document.Objects()[rConnection.m_Parent]; rParent.m_Kind == "Model")
					place(rChild, rParent);
	return bounds;
}

class PlacedMeshes : public testing::TestWithParam<const char*>
{
};

/// Rotation orders and pivots of nodes without bones show in where their meshes are.
TEST_P(PlacedMeshes, AreInTheirPlaces)
{
	std::ifstream file(c_Folder + "reference/" + GetParam() + ".json");
	const nlohmann::json meshes = nlohmann::json::parse(file)["placedMeshes"];
	const std::map<std::string, VBounds> bounds = PlacedBounds(c_Folder + GetParam() + ".fbx");
	EXPECT_EQ(bounds.size(), meshes.size());
	for (const nlohmann::json& rMesh : meshes)
	{
		const auto found = bounds.find(rMesh["name"]);
		ASSERT_NE(found, bounds.end()) << rMesh["name"];
		for (int i = 0; i < 6; ++i)
		{
			const double expected = rMesh["bounds"][i];
			EXPECT_NEAR(found->second[i], expected, std::max(0.01, 1e-5 * std::abs(expected)))
			    << rMesh["name"] << ' ' << i;
		}
	}
}

INSTANTIATE_TEST_SUITE_P(Files, PlacedMeshes,
    testing::Values("heaps_biped_zup_a7100", "kenney_medium_b7400", "own_game_zup_m_b7400", "own_ns_yup_cm_a7400",
        "own_ns_yup_cm_b7400", "pab_arnaud_b7500", "ufbx_max_transformed_skin_zup_b6100",
        "ufbx_maya_human_ik_7400_binary", "ufbx_maya_pivot_offset_7700_ascii", "ufbx_maya_rotation_order_7500_ascii",
        "ufbx_maya_transformed_skin_a6100"),
    [](const auto& i_rInfo) { return std::string(i_rInfo.param); });

} // namespace
