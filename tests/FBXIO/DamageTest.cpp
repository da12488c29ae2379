#include "FBXIO/FBXReader.h"

#include "MeshFile.h"
#include "TestFile.h"
#include "TestLog.h"

#include <gtest/gtest.h>

#include <cstring>

using namespace FBXIO;
using namespace FbxTest;

namespace
{

/// Sanitizers look at every byte; without them a fifth is enough.
#if defined(__has_feature)
#if __has_feature(address_sanitizer)
#define RETARGET_SANITIZED
#endif
#endif
#ifdef RETARGET_SANITIZED
constexpr std::size_t c_Step = 1;
#else
constexpr std::size_t c_Step = 5;
#endif

/// A triangle with everything that a mesh can have, on two bones.
std::string SmallCharacter(const VTestForm& i_rForm)
{
	const VTestScene scene{{{"hips", "LimbNode", -1, {}}, {"knee", "LimbNode", 0, {}}, {"body", "Mesh", -1, {}}},
	    {{"UpAxis", {2}}}, {}, {}};
	const VNumbers matrix{1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0, 5, 0, 1};
	return Write(i_rForm, scene,
	    {{2, {0, 0, 0, 1, 0, 0, 0, 1, 0, 1, 1, 0}, {0, 1, -3, 1, 3, -3},
	        {"ByVertice", "Direct", {0, 0, 1, 0, 0, 1, 0, 0, 1, 0, 0, 1}, {}},
	        {"ByPolygonVertex", "IndexToDirect", {0, 0, 1, 0, 0, 1, 1, 1}, {0, 1, 2, 1, 3, 2}},
	        {"ByPolygon", "IndexToDirect", {}, {0, 1}},
	        {{"phong", {{"DiffuseColor", {1, 0.5, 0}}}, "", ""}, {"lambert", {}, "", ""}},
	        {{0, {0, 1, 2}, {1, 0.5, 0.25}, matrix, matrix}, {1, {1, 2, 3}, {0.5, 0.75, 1}, matrix, matrix}}}});
}

template <typename TVertex>
void ExpectWhole(const VMesh<TVertex>& i_rMesh)
{
	for (const VMeshPart& rPart : i_rMesh.m_Parts)
	{
		ASSERT_EQ(rPart.m_Indices.size() % (3 * rPart.m_IndexSize), 0u);
		for (std::size_t at = 0; at < rPart.m_Indices.size(); at += rPart.m_IndexSize)
		{
			std::uint32_t index = 0;
			std::memcpy(&index, rPart.m_Indices.data() + at, rPart.m_IndexSize);
			ASSERT_LT(index, i_rMesh.m_Vertices.size());
		}
	}
}

/// Whatever comes of the bytes is whole.
/// @return whether all of it could be read.
bool ExpectSound(const std::string& i_rBytes)
{
	const VTestLog quiet;
	const VTestFile file(i_rBytes);
	FBXReader reader;
	const bool bLoaded = reader.LoadFile(file.Path());
	if (!bLoaded)
	{
		EXPECT_FALSE(reader.HasSkeleton());
		return false;
	}
	std::vector<VPlacedMesh> placed;
	reader.ReadPlacedMeshes(placed);
	for (const VPlacedMesh& rPlaced : placed)
		ExpectWhole(rPlaced.m_Mesh);
	VSkin skin;
	reader.ReadSkin(skin);
	for (const VSkinMesh& rMesh : skin.m_Meshes)
	{
		ExpectWhole(rMesh);
		for (const VSkinVertex& rVertex : rMesh.m_Vertices)
		{
			const auto& [a, b, c, d] = rVertex.m_BoneWeights;
			EXPECT_LE(a + b + c + d, 255);
		}
	}
	return reader.IsComplete();
}

class DamagedCharacter : public testing::TestWithParam<VTestForm>
{
};

TEST_P(DamagedCharacter, CutAnywhereLeavesWhatIsWhole)
{
	const std::string bytes = SmallCharacter(GetParam());
	EXPECT_TRUE(ExpectSound(bytes));
	const std::size_t end = GetParam().m_Form == EForm::Binary ? bytes.size() - 40 : bytes.size() - 1;
	for (std::size_t size = 0; size < end && !HasFailure(); size += c_Step)
		EXPECT_FALSE(ExpectSound(bytes.substr(0, size))) << size;
}

TEST_P(DamagedCharacter, FourPatchesOfEveryByte)
{
	const std::string bytes = SmallCharacter(GetParam());
	for (std::size_t at = 0; at < bytes.size() && !HasFailure(); at += c_Step)
		for (const char patch : {'\0', '\xff', char(bytes[at] ^ 1), char(bytes[at] ^ 0x80)})
		{
			SCOPED_TRACE(at);
			std::string patched = bytes;
			patched[at] = patch;
			ExpectSound(patched);
		}
}

INSTANTIATE_TEST_SUITE_P(
    Forms, DamagedCharacter, testing::ValuesIn(c_Forms), [](const auto& i_rInfo) { return i_rInfo.param.m_pName; });

} // namespace
