// Skins and pictures all the way to what is drawn: an FBX file whose records are changed and that holds any picture
// becomes meshes, textures and the matrices of bones on any segments.
#include "../../tests/FBXIO/SmallFiles.h"
#include "../../tests/FBXIO/SoundScene.h"
#include "../Require.h"
#include "CoreGraphics/Picture.h"
#include "CoreGraphics/Skin.h"
#include "CoreGraphics/SkinInstance.h"
#include "DebugServices/GlobalLog.h"

#include <QLoggingCategory>
#include <fuzzer/FuzzedDataProvider.h>

namespace
{

constexpr const char* c_Names[] = {"hips", "knee", "Ns:HIPS", "nobody", "", "body"};
constexpr float c_Lengths[] = {0.0f, 1.0f, -5.0f, 0.1f, 3e38f};

void CheckTextures(const std::vector<CoreGraphics::VMaterialMesh>& i_rMeshes)
{
	for (const CoreGraphics::VMaterialMesh& rMesh : i_rMeshes)
		for (const CoreGraphics::VMaterialPart& rPart : rMesh.m_Parts)
			Require(!std::isnan(rPart.m_Alpha), "what shows through is a number");
}

void CheckBinding(const CoreGraphics::VSkinInstance& i_rInstance, std::size_t i_Segments)
{
	const std::size_t bones = i_rInstance.GetSkin()->Skeleton()->size();
	Require(i_rInstance.BoneMatrices().size() == bones, "a matrix for each bone");
	Require(i_rInstance.BoneScales().size() == bones, "a scale for each bone");
	Require(i_rInstance.SegmentToBone().size() == i_Segments, "each segment is asked for");
	for (const std::int64_t bone : i_rInstance.SegmentToBone())
		Require(bone >= -1 && bone < std::int64_t(bones), "a segment's bone is there");
	for (const std::size_t bone : i_rInstance.UnmappedBones())
		Require(bone < bones, "a bone without a segment is there");
}

} // namespace

/// From its end the input tells what is changed; the rest is the picture.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* i_pData, std::size_t i_Size)
{
	static const std::shared_ptr<void> s_pQuiet = NVX::GlobalLog::AddSink([](const auto&, int, const std::string&) {});
	// Qt's readers of pictures tell the terminal what is wrong.
	[[maybe_unused]] static const bool s_bQuiet = (qInstallMessageHandler([](auto, const auto&, const auto&) {}), true);
	FuzzedDataProvider input(i_pData, i_Size);
	const FbxTest::VSmallFile& rFile = input.PickValueInArray(FbxTest::c_SmallFiles);
	std::vector<std::uint16_t> seeds(input.ConsumeIntegralInRange<std::size_t>(0, 3));
	for (std::uint16_t& rSeed : seeds)
		rSeed = input.ConsumeIntegral<std::uint16_t>();
	std::vector<std::string> names(input.ConsumeIntegralInRange<std::size_t>(0, 4));
	std::vector<QVector3D> offsets(names.size());
	for (std::size_t i = 0; i < names.size(); ++i)
	{
		names[i] = input.PickValueInArray(c_Names);
		offsets[i] = {input.PickValueInArray(c_Lengths), input.PickValueInArray(c_Lengths), 0.0f};
	}
	std::string picture = input.ConsumeRemainingBytesAsString();
	constexpr std::size_t c_LeastPicture = 6;
	if (picture.size() < c_LeastPicture)
		picture.clear();
	std::vector<FbxTest::VTestRecord> records = FbxTest::SmallRecords(rFile, picture);
	for (const std::uint16_t seed : seeds)
	{
		std::mt19937 random{seed};
		records = FbxTest::MutateRecords(std::move(records), random);
	}

	FBXIO::FBXReader reader;
	reader.SetPictures(&CoreGraphics::OpenPicture);
	if (!reader.LoadMemory(FbxTest::Write(rFile.m_Form, records), "memory.fbx"))
		return 0;
	std::vector<FBXIO::VPlacedMesh> placed;
	FBXIO::VSkin data;
	Require(FbxTest::WhatIsUnsound(reader, placed, data).empty());
	CoreGraphics::VMaterialMeshMaker maker;
	std::vector<CoreGraphics::VMaterialMesh> meshes;
	for (const FBXIO::VPlacedMesh& rPlaced : placed)
		meshes.push_back(maker.Make(rPlaced.m_Mesh));
	CheckTextures(meshes);
	const auto pSkin = std::make_shared<CoreGraphics::VSkin>(data, "skin");
	CheckTextures(pSkin->Meshes());
	CoreGraphics::VSkinInstance instance;
	instance.Bind(pSkin, names, offsets);
	if (!instance.GetSkin())
		return 0;
	CheckBinding(instance, names.size());
	instance.SetHealth(1, 0.0f);
	// Fewer poses than segments, and more.
	for (const std::size_t poses : {std::size_t(1), names.size() + 1})
		instance.UpdatePose(std::vector<QMatrix4x4>(poses));
	CheckBinding(instance, names.size());
	return 0;
}
