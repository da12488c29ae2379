// FBX files whose records, connections and arrays are changed, and which are then written as files that are well
// formed: changes of bytes hardly ever come that far.
#include "../../tests/FBXIO/SmallFiles.h"
#include "../../tests/FBXIO/SoundScene.h"
#include "../Require.h"
#include "DebugServices/GlobalLog.h"

#include <fuzzer/FuzzedDataProvider.h>

/// Each number of the input is the seed of some changes.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* i_pData, std::size_t i_Size)
{
	static const std::shared_ptr<void> s_pQuiet = NVX::GlobalLog::AddSink([](const auto&, int, const std::string&) {});
	static constexpr std::size_t c_MostSeeds = 12;
	FuzzedDataProvider input(i_pData, i_Size);
	const FbxTest::VSmallFile& rFile = input.PickValueInArray(FbxTest::c_SmallFiles);
	const FbxTest::VSmallFile& rForm = input.ConsumeBool() ? input.PickValueInArray(FbxTest::c_SmallFiles) : rFile;
	std::vector<FbxTest::VTestRecord> records = FbxTest::SmallRecords(rFile);
	for (std::size_t seeds = 0; seeds < c_MostSeeds && input.remaining_bytes() > 0; ++seeds)
	{
		std::mt19937 random{input.ConsumeIntegral<std::uint16_t>()};
		records = FbxTest::MutateRecords(std::move(records), random);
	}
	FBXIO::FBXReader reader;
	const bool bLoaded = reader.LoadMemory(FbxTest::Write(rForm.m_Form, records), "memory.fbx");
	Require(bLoaded || (!reader.HasSkeleton() && !reader.IsComplete()));
	if (bLoaded)
		Require(FbxTest::WhatIsUnsound(reader).empty());
	return 0;
}
