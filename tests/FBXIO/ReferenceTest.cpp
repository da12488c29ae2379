#include "FBXIO/FBXReader.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <fstream>

using namespace FBXIO;

namespace
{

const std::string c_Folder = RETARGET_TEST_DATA "/fbx/";

nlohmann::json Reference(const std::string& i_rName)
{
	std::ifstream file(c_Folder + "reference/" + i_rName + ".json");
	return nlohmann::json::parse(file);
}

/// Rotations and scalings to 1e-4, translations to 0.01 mm or 1e-5 of their size.
void ExpectMatrix(const QMatrix4x4& i_rMatrix, const nlohmann::json& i_rExpected, const std::string& i_rWhat)
{
	for (int i = 0; i < 16; ++i)
	{
		const double expected = i_rExpected[i];
		EXPECT_NEAR(i_rMatrix(i / 4, i % 4), expected, i % 4 == 3 ? std::max(0.01, 1e-5 * std::abs(expected)) : 1e-4)
		    << i_rWhat << ' ' << i;
	}
}

class ReferenceFile : public testing::TestWithParam<const char*>
{
};

TEST_P(ReferenceFile, BonesAgree)
{
	const nlohmann::json reference = Reference(GetParam());
	FBXReader reader;
	ASSERT_TRUE(reader.LoadFile(c_Folder + GetParam() + ".fbx"));
	EXPECT_TRUE(reader.IsComplete());
	EXPECT_EQ(reader.GetUpAxis(), reference["upAxis"]);
	EXPECT_EQ(reader.GetUnitScale(), float(reference["unitScale"]));
	const nlohmann::json& rBones = reference["bones"];
	EXPECT_EQ(reader.HasSkeleton(), !rBones.empty());
	if (rBones.empty())
		return;
	const VSkinSkeleton& rSkeleton = *reader.GetSkeleton();
	ASSERT_EQ(rSkeleton.size(), rBones.size());
	for (std::size_t i = 0; i < rBones.size(); ++i)
	{
		const VSkinBone& rBone = rSkeleton[i];
		EXPECT_EQ(rBone.m_Name, rBones[i]["name"]);
		EXPECT_EQ(rBone.m_ParentIndex, rBones[i]["parent"]) << rBone.m_Name;
		EXPECT_NEAR(rBone.m_AccumulatedScale, double(rBones[i]["accumulatedScale"]), 1e-4) << rBone.m_Name;
		ExpectMatrix(rBone.m_PreRotation, rBones[i]["preRotation"], rBone.m_Name + " pre-rotation");
		ExpectMatrix(rBone.m_Local, rBones[i]["local"], rBone.m_Name + " local");
		ExpectMatrix(rBone.m_Global, rBones[i]["global"], rBone.m_Name + " global");
		EXPECT_TRUE(rBone.m_InverseBind.isIdentity());
	}
}

INSTANTIATE_TEST_SUITE_P(Files, ReferenceFile,
    testing::Values("heaps_biped_zup_a7100", "kenney_medium_b7400", "own_game_zup_m_b7400", "own_ns_yup_cm_a7400",
        "own_ns_yup_cm_b7400", "pab_arnaud_b7500", "ufbx_max_transformed_skin_zup_b6100",
        "ufbx_maya_human_ik_7400_binary", "ufbx_maya_pivot_offset_7700_ascii", "ufbx_maya_rotation_order_7500_ascii",
        "ufbx_maya_transformed_skin_a6100"),
    [](const auto& i_rInfo) { return std::string(i_rInfo.param); });

} // namespace
