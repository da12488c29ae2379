#include "CoreGraphics/SkinInstance.h"

#include "../Matrices.h"
#include "../UtilsFileSystem/Log.h"
#include "CoreGraphics/QtForm.h"
#include "CoreGraphics/Skin.h"

#include <gtest/gtest.h>

namespace
{

using CoreGraphics::ToQt;
using CoreGraphics::VSkin;
using CoreGraphics::VSkinInstance;
using FBXIO::VSkinSkeleton;

struct VBone
{
	const char* m_pName;
	std::int64_t m_Parent;
	QVector3D m_Offset;
	float m_AccumulatedScale = 1.0f;
};

VSkinSkeleton Skeleton(const std::vector<VBone>& i_rBones)
{
	VSkinSkeleton skeleton;
	for (const VBone& rBone : i_rBones)
	{
		FBXIO::VSkinBone& rAdded = skeleton.emplace_back();
		rAdded.m_Name = rBone.m_pName;
		rAdded.m_ParentIndex = rBone.m_Parent;
		Move(rAdded.m_Local, rBone.m_Offset.x(), rBone.m_Offset.y(), rBone.m_Offset.z());
		rAdded.m_AccumulatedScale = rBone.m_AccumulatedScale;
	}
	return skeleton;
}

/// A skin with a vertex on each bone.
std::shared_ptr<VSkin> Skin(const VSkinSkeleton& i_rSkeleton)
{
	FBXIO::VSkin data;
	data.m_pSkeleton = std::make_shared<const VSkinSkeleton>(i_rSkeleton);
	FBXIO::VSkinMesh& rMesh = data.m_Meshes.emplace_back();
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
	{
		FBXIO::VSkinVertex& rVertex = rMesh.m_Vertices.emplace_back();
		rVertex.m_BoneIndices[0] = static_cast<std::uint8_t>(i);
		rVertex.m_BoneWeights[0] = 255;
	}
	return std::make_shared<VSkin>(data, "Hero");
}

template <typename T, typename TSpan>
std::vector<T> Vector(const TSpan& i_rSpan)
{
	return {i_rSpan.begin(), i_rSpan.end()};
}

TEST(SkinInstance, BonesGoWithSegmentsOfTheirNames)
{
	const struct
	{
		const char* m_pWhat;
		std::vector<VBone> m_Bones;
		std::vector<std::string> m_Segments;
		std::vector<std::int64_t> m_Mapped;
		std::vector<std::size_t> m_Unmapped;
	} c_Rows[] = {
	    {"case and namespaces", {{"Ns:Hips", -1, {}}, {"a:b:SPINE", 0, {}}}, {"hips", "x:Spine"}, {0, 1}, {}},
	    {"a bone is taken once", {{"Hips", -1, {}}, {"Arm", 0, {}}}, {"arm", "ns:Arm", "hips"}, {1, -1, 0}, {}},
	    {"the others have none", {{"Root", -1, {}}, {"Hips", 0, {}}, {"Tail", 1, {}}}, {"Hips", "Head"}, {1, -1},
	        {0, 2}},
	    {"of one name the last", {{"A:Hips", -1, {}}, {"B:Hips", 0, {}}}, {"Hips", "Head"}, {1, -1}, {0}},
	    {"one of each, whatever their names", {{"Box", -1, {}}}, {"root"}, {0}, {}},
	    {"one bone, two segments", {{"Box", -1, {}}}, {"root", "lid"}, {-1, -1}, {0}},
	};
	for (const auto& rRow : c_Rows)
	{
		SCOPED_TRACE(rRow.m_pWhat);
		VSkinInstance instance;
		const auto pSkin = Skin(Skeleton(rRow.m_Bones));
		instance.Bind(pSkin, rRow.m_Segments, std::vector<QVector3D>(rRow.m_Segments.size()));
		EXPECT_EQ(Vector<std::int64_t>(instance.SegmentToBone()), rRow.m_Mapped);
		EXPECT_EQ(Vector<std::size_t>(instance.UnmappedBones()), rRow.m_Unmapped);

		// What does not fit changes nothing.
		instance.Bind(pSkin, {"hips", "spine"}, {{}});
		instance.Bind(std::make_shared<VSkin>(FBXIO::VSkin(), "no bones"), {"hips"}, {{}});
		EXPECT_EQ(Vector<std::int64_t>(instance.SegmentToBone()), rRow.m_Mapped);
		EXPECT_EQ(instance.GetSkin(), pSkin);
	}
}

TEST(SkinInstance, BonesAreScaledToTheSubject)
{
	const QVector3D one(1, 1, 1);
	const std::vector<VBone> bones{{"Hips", -1, {0, 0, 900}}, {"Spine", 0, {0, 0, 100}}, {"Arm", 1, {200, 0, 0}},
	    {"LeftFoot", 0, {0, 0, -50}}, {"Toe", 3, {0, 80, 0}}};
	std::vector<VBone> large = bones;
	for (VBone& rBone : large)
		rBone.m_AccumulatedScale = 10.0f;
	const std::vector<std::string> names{"hips", "spine", "arm", "leftfoot", "toe"};
	const struct
	{
		const char* m_pWhat;
		std::vector<VBone> m_Bones;
		std::vector<std::string> m_Segments;
		std::vector<QVector3D> m_Offsets;
		std::vector<QVector3D> m_Scales;
	} c_Rows[] = {
	    {"twice as large, the feet, too", bones, names, {{}, {0, 0, 200}, {400, 0, 0}, {0, 0, -100}, {0, 160, 0}},
	        std::vector<QVector3D>(5, 2.0f * one)},
	    {"all but the same: their middle", bones, names, {{}, {0, 0, 100.4f}, {200, 0, 0}, {0, 0, -50}, {0, 80, 0}},
	        std::vector<QVector3D>(5, 1.002f * one)},
	    {"of other proportions: bone 0 and feet stay, others by what the longest child has", bones, names,
	        {{}, {0, 0, 150}, {0, 300, 300}, {0, 0, -50}, {0, 240, 0}},
	        {one, {1, 2.1213203f, 2.1213203f}, one, one, one}},
	    {"a scaled skeleton", large, names, {{}, {0, 0, 1000}, {2000, 0, 0}, {0, 0, -500}, {0, 800, 0}},
	        std::vector<QVector3D>(5, one)},
	    {"two segments tell nothing", bones, {"hips", "spine"}, {{}, {0, 0, 200}}, std::vector<QVector3D>(5, one)},
	    {"no lengths, no scale", bones, names, std::vector<QVector3D>(5), std::vector<QVector3D>(5, one)},
	};
	for (const auto& rRow : c_Rows)
	{
		SCOPED_TRACE(rRow.m_pWhat);
		VSkinInstance instance;
		instance.Bind(Skin(Skeleton(rRow.m_Bones)), rRow.m_Segments, rRow.m_Offsets);
		ASSERT_EQ(instance.BoneScales().size(), rRow.m_Scales.size());
		for (std::size_t i = 0; i < rRow.m_Scales.size(); ++i)
			EXPECT_LT((instance.BoneScales()[i] - rRow.m_Scales[i]).length(), 1e-5f)
			    << i << " " << instance.BoneScales()[i].y();
	}
}

/// Every step of the way by itself: segment poses, scales, then what hangs on them, then the bind.
TEST(SkinInstance, BonesFollowThePose)
{
	VSkinSkeleton skeleton = Skeleton({{"World", -1, {0, 0, 10}}, {"Hips", 0, {0, 0, 900}, 2.0f},
	    {"Arm", 1, {200, 0, 0}, 2.0f}, {"Sleeve", 2, {30, 0, 0}}, {"Cuff", 3, {0, 20, 0}}, {"Leg", 1, {0, 0, -100}}});
	for (std::size_t i = 0; i < skeleton.size(); ++i)
	{
		Turn(skeleton[i].m_Local, 20.0f * static_cast<float>(i), 1, 2, 3);
		Turn(skeleton[i].m_InverseBind, 50.0f, 0, static_cast<float>(i), 1);
		Move(skeleton[i].m_InverseBind, 7, 8, 9);
	}
	VSkinInstance instance;
	instance.Bind(Skin(skeleton), {"Hips", "Head", "Arm", "Leg"}, {{}, {1, 0, 0}, {300, 300, 0}, {0, 0, -100}});
	std::vector<QMatrix4x4> poses(4);
	for (std::size_t i = 0; i < poses.size(); ++i)
	{
		poses[i].translate(static_cast<float>(i) * 100.0f, 5, 900);
		poses[i].rotate(33.0f, static_cast<float>(i), 1, 0);
	}
	instance.SetHealth(2, 0.25f);
	instance.SetHealth(4, 0.0f);
	instance.UpdatePose(poses);

	std::vector<QMatrix4x4> expected(skeleton.size());
	const std::size_t boneOfSegment[] = {1, 99, 2, 5};
	for (std::size_t segment : {0u, 2u, 3u})
	{
		const std::size_t bone = boneOfSegment[segment];
		expected[bone] = poses[segment];
		expected[bone].scale(skeleton[bone].m_AccumulatedScale);
		expected[bone].scale(instance.BoneScales()[bone]);
	}
	expected[0] = ToQt(skeleton[0].m_Local);
	expected[3] = expected[2] * ToQt(skeleton[3].m_Local);
	expected[4] = expected[3] * ToQt(skeleton[4].m_Local);
	EXPECT_NE(instance.BoneScales()[1], QVector3D(1, 1, 1));
	for (std::size_t bone = 0; bone < expected.size(); ++bone)
	{
		expected[bone] = expected[bone] * ToQt(skeleton[bone].m_InverseBind);
		expected[bone](3, 3) = bone == 2 ? 0.25f : 1.0f;
		for (std::size_t i = 0; i < 16; ++i)
			EXPECT_NEAR(instance.BoneMatrices()[bone][i], expected[bone].constData()[i], 1e-3f) << bone << " " << i;
	}
	// Segments that a pose does not have stay.
	instance.UpdatePose({poses.data(), 1});
	EXPECT_NEAR(instance.BoneMatrices()[5][12], expected[5](0, 3), 1e-3f);
}

TEST(SkinInstance, TellsWhatIsNotWhereTheSegmentsAre)
{
	VSkinSkeleton skeleton = Skeleton({{"Hips", -1, {}}, {"Arm", 0, {}}, {"Sleeve", 1, {}}, {"Cuff", 2, {}}});
	const auto warnings = [&](const std::vector<std::string>& i_rSegments)
	{
		VTestLog log("CoreGraphics");
		NVX::GlobalLog::Category("CoreGraphics").SetLevel(NVX::ELogWarning);
		const auto pSkin = Skin(skeleton);
		for (int i = 0; i < 2; ++i)
			VSkinInstance().Bind(pSkin, i_rSegments, std::vector<QVector3D>(i_rSegments.size()));
		return log.Take();
	};
	using VLines = std::vector<std::string>;
	EXPECT_EQ(warnings({"Hips", "Arm"}), VLines()) << "nothing is turned";
	EXPECT_EQ(warnings({"Pelvis", "Arms"}),
	    VLines{"3 No bone of the skin Hero has the name of a segment: it stays where it was made"});
	Turn(skeleton[2].m_PreRotation, 30, 0, 0, 1);
	EXPECT_EQ(warnings({"Hips", "Arm", "Sleeve"}), VLines()) << "a segment turns it back";
	EXPECT_EQ(warnings({"Hips", "Arm"}),
	    VLines{"3 The skin Hero may be shown twisted at bones that no segment drives and that have pre-rotations, or "
	           "hang on such: Sleeve, Cuff"})
	    << "once for both";
}

} // namespace
