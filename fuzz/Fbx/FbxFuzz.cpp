#include "../../tests/FBXIO/SoundScene.h"
#include "../Require.h"
#include "DebugServices/GlobalLog.h"
#include "fbxsdk/container/Arrays.h"
#include "fbxsdk/container/FileKind.h"

#include <cstdint>
#include <string>

/// The whole road from a file to its bones, meshes and skin, and every array in it.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* i_pData, std::size_t i_Size)
{
	static const std::shared_ptr<void> s_pQuiet = NVX::GlobalLog::AddSink([](const auto&, int, const std::string&) {});
	const std::string bytes(reinterpret_cast<const char*>(i_pData), i_Size);
	FBXIO::FBXReader reader;
	const bool bLoaded = reader.LoadMemory(bytes, "memory.fbx");
	Require(bLoaded || (!reader.HasSkeleton() && !reader.IsComplete()));
	if (bLoaded)
		Require(FbxTest::WhatIsUnsound(reader).empty());

	FbxFormat::VElementTree tree;
	tree.Read(bytes, FbxFormat::DetectFileKind(bytes));
	FbxFormat::VDecodeBudget budget{16'000'000};
	for (FbxFormat::VElementIndex element = 0; element < tree.Size(); ++element)
	{
		FbxFormat::VArrayNumbers<float> reals;
		FbxFormat::ReadArray(tree, element, budget, reals);
		FbxFormat::VArrayNumbers<std::int32_t> integers;
		FbxFormat::ReadArray(tree, element, budget, integers);
	}
	return 0;
}
