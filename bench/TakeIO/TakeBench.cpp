// Takes: a BVH file from memory on, beside from_chars over its numbers alone; an FBX file with a long stack, beside the
// import of assimp without any post-processing; and the world poses of a frame.
#include "../Ratios.h"

#include "../../tests/UtilsFileSystem/Folder.h"

#include "FBXIO/FBXReader.h"
#include "MotionIO/PrintMotion.h"
#include "TakeIO/ReadTake.h"
#include "UtilsFileSystem/Files.h"

#include <assimp/Importer.hpp>
#include <assimp/config.h>
#include <assimp/scene.h>

#include <charconv>
#include <cmath>
#include <ctime>

namespace
{

/// A body of 31 joints with 96 channels as exporters print them: six digits behind the point.
std::string Bvh(std::int64_t i_Frames)
{
	std::string text = "HIERARCHY\nROOT joint\n{\nOFFSET 0 90 0\nCHANNELS 6 Xposition Yposition Zposition Zrotation "
	                   "Yrotation Xrotation\n";
	for (int i = 0; i < 30; ++i)
		text += "JOINT joint" + std::to_string(i) + "\n{\nOFFSET 0 -3 0\nCHANNELS 3 Zrotation Yrotation Xrotation\n";
	text += std::string(31, '}') + "\nMOTION\nFrames: " + std::to_string(i_Frames) + "\nFrame Time: .0083333\n";
	for (std::int64_t frame = 0; frame < i_Frames; ++frame)
		for (int channel = 0; channel < 96; ++channel)
			text += std::to_string(60.0 * std::sin(0.01 * double(frame * (channel + 3)))) + (channel < 95 ? ' ' : '\n');
	return text;
}

const TakeIO::VTakeSettings c_Settings{TakeIO::EUp::Y, 10.0, {}};

void ReadBvh(benchmark::State& io_rState)
{
	const std::string text = Bvh(io_rState.range(0));
	TakeIO::VTake take;
	std::string error;
	for (auto _ : io_rState)
		if (!TakeIO::ReadTakeFrom(text, c_Settings, take, error))
			io_rState.SkipWithError(error.c_str());
}

void FromChars(benchmark::State& io_rState)
{
	const std::string text = Bvh(io_rState.range(0));
	const char* const pEnd = text.data() + text.size();
	for (auto _ : io_rState)
	{
		std::vector<double> numbers;
		numbers.reserve(std::size_t(io_rState.range(0)) * 96);
		const char* p = text.data() + text.find(".0083333\n") + 9;
		for (double number; p < pEnd; ++p)
		{
			p = std::from_chars(p, pEnd, number).ptr;
			numbers.push_back(number);
		}
		benchmark::DoNotOptimize(numbers.data());
	}
}

void WorldPoses(benchmark::State& io_rState)
{
	TakeIO::VTake take;
	std::string error;
	TakeIO::ReadTakeFrom(Bvh(io_rState.range(0)), c_Settings, take, error);
	std::vector<TakeIO::VJointPose> poses;
	std::size_t frame = 0;
	for (auto _ : io_rState)
		TakeIO::WorldPoses(take, frame = (frame + 1) % take.m_Frames, poses);
}

/// A character's file whose bones all turn in each of so many frames, in one take or in several.
std::string Fbx(std::int64_t i_Frames, int i_Takes = 1)
{
	MotionIO::VCharacterFile character{RETARGET_TEST_DATA "/fbx/own_game_zup_m_b7400.fbx", {}};
	std::string error, bytes;
	TakeIO::VTake take, longer;
	UtilsFileSystem::ReadWholeFile(character.m_Path, 1 << 30, character.m_Bytes, error);
	TakeIO::ReadTakeFrom(character.m_Bytes, {}, take, error);
	longer = take;
	longer.m_Values.clear();
	longer.m_Frames = std::size_t(i_Frames);
	for (std::size_t frame = 0; frame < longer.m_Frames; ++frame)
		for (std::size_t i = 0; i < take.m_Channels; ++i)
			longer.m_Values.push_back(
			    take.Frame(0)[i] + (i % 6 < 3 ? 0.0 : 0.5 * std::sin(0.01 * double(frame * (i % 31 + 3)))));
	for (int i = 0; i < i_Takes; ++i, character.m_Bytes = std::move(bytes))
		MotionIO::PrintMotion(longer, MotionIO::EMotionForm::Fbx, &character, {"long", 1.0, {}}, bytes, error);
	return character.m_Bytes;
}

void ReadFbx(benchmark::State& io_rState)
{
	const std::string bytes = Fbx(io_rState.range(0));
	TakeIO::VTake take;
	std::string error;
	for (auto _ : io_rState)
		if (!TakeIO::ReadTakeFrom(bytes, {{}, {}, 24.0, "long"}, take, error))
			io_rState.SkipWithError(error.c_str());
}

void AssimpImport(benchmark::State& io_rState)
{
	const std::string bytes = Fbx(io_rState.range(0));
	Assimp::Importer importer;
	importer.SetPropertyBool(AI_CONFIG_IMPORT_FBX_PRESERVE_PIVOTS, false);
	for (auto _ : io_rState)
	{
		if (!importer.ReadFileFromMemory(bytes.data(), bytes.size(), 0, "fbx"))
			io_rState.SkipWithError(importer.GetErrorString());
		importer.FreeScene();
	}
}

/// The skeleton of a file of some 2.4 MB, nearly all of it ten takes that are passed over. In ms of the processor.
void TellSkeletonBesideTakes()
{
	const VTestFolder folder;
	Put(folder / "takes.fbx", Fbx(135, 10));
	std::vector<double> times;
	for (int i = 0; i < 100; ++i)
	{
		const std::clock_t begin = std::clock();
		FBXIO::FBXReader reader;
		// Without times it is told that nothing was measured.
		if (!reader.LoadFile((folder / "takes.fbx").string()) || !reader.HasSkeleton())
			break;
		times.push_back(double(std::clock() - begin) * 1e3 / CLOCKS_PER_SEC);
	}
	const std::string size = std::to_string(file_size(folder / "takes.fbx") / 1000) + " kB";
	Verdict::Tell("skeleton beside ten takes, ms", "", size, times, 1.3);
}

BENCHMARK(ReadFbx)->Arg(100)->Arg(2000);
BENCHMARK(AssimpImport)->Arg(100)->Arg(2000);
BENCHMARK(ReadBvh)->Arg(500)->Arg(5000);
BENCHMARK(FromChars)->Arg(500)->Arg(5000);
BENCHMARK(WorldPoses)->Arg(500);

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	const int status =
	    Ratios::Main(i_Count, i_ppArguments, {{"ReadBvh", "FromChars", 1.5}, {"ReadFbx", "AssimpImport", 1.0}});
	if (Verdict::WasAskedFor(i_Count, i_ppArguments))
		TellSkeletonBesideTakes();
	return status;
}
