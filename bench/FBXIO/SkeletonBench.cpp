// A character's FBX file, from the file on, to its skeleton and to that with meshes and skin: ours, and the import of
// assimp without any post-processing.
#include "../Ratios.h"
#include "Character.h"
#include "PeakMemory.h"

#include "../../tests/UtilsFileSystem/Folder.h"
#include "../../tests/fbxsdk/FbxFileBuilder.h"

#include "FBXIO/FBXReader.h"

#include <assimp/Importer.hpp>
#include <assimp/config.h>
#include <assimp/scene.h>

#include <list>

namespace
{

/// 0 if there are none.
std::size_t Bones(const std::string& i_rPath)
{
	FBXIO::FBXReader reader;
	return reader.LoadFile(i_rPath) && reader.HasSkeleton() ? reader.GetSkeleton()->size() : 0;
}

void CountPerBone(benchmark::State& io_rState, std::size_t i_Bones)
{
	io_rState.counters["per bone"] = benchmark::Counter(
	    double(i_Bones), benchmark::Counter::kIsIterationInvariantRate | benchmark::Counter::kInvert);
}

/// Without any post-processing, pivots not split.
bool ReadWithAssimp(Assimp::Importer& io_rImporter, const std::string& i_rPath)
{
	io_rImporter.SetPropertyBool(AI_CONFIG_IMPORT_FBX_PRESERVE_PIVOTS, false);
	return io_rImporter.ReadFile(i_rPath, 0) != nullptr;
}

bool ReadPlacedMeshes(const std::string& i_rPath)
{
	FBXIO::FBXReader reader;
	std::vector<FBXIO::VPlacedMesh> meshes;
	if (reader.LoadFile(i_rPath))
		reader.ReadPlacedMeshes(meshes);
	return !meshes.empty();
}

/// The skeleton, the meshes that are bound to it, and their weights.
bool ReadSkin(const std::string& i_rPath)
{
	FBXIO::FBXReader reader;
	FBXIO::VSkin skin;
	if (reader.LoadFile(i_rPath))
		reader.ReadSkin(skin);
	return !skin.m_Meshes.empty();
}

void Skeleton(benchmark::State& io_rState, const std::string& i_rPath)
{
	const std::size_t bones = Bones(i_rPath);
	for (auto _ : io_rState)
		if (bones == 0 || Bones(i_rPath) != bones)
			io_rState.SkipWithError("not loaded");
	CountPerBone(io_rState, bones);
}

void AssimpImport(benchmark::State& io_rState, const std::string& i_rPath)
{
	// Made once: what an importer costs without a file is not counted.
	Assimp::Importer importer;
	for (auto _ : io_rState)
	{
		if (!ReadWithAssimp(importer, i_rPath))
			io_rState.SkipWithError(importer.GetErrorString());
		importer.FreeScene();
	}
	CountPerBone(io_rState, Bones(i_rPath));
}

void PlacedMeshes(benchmark::State& io_rState, const std::string& i_rPath)
{
	for (auto _ : io_rState)
		if (!ReadPlacedMeshes(i_rPath))
			io_rState.SkipWithError("without mesh");
}

void Skin(benchmark::State& io_rState, const std::string& i_rPath)
{
	for (auto _ : io_rState)
		if (!ReadSkin(i_rPath))
			io_rState.SkipWithError("without skin");
}

void Work(const std::string& i_rWork, const std::string& i_rPath)
{
	if (i_rWork == "skeleton")
		Bones(i_rPath);
	else if (i_rWork == "skin")
		ReadSkin(i_rPath);
	else
	{
		Assimp::Importer importer;
		ReadWithAssimp(importer, i_rPath);
	}
}

/// Most memory beside assimp's.
void PrintPeaks(const std::string& i_rName, const std::string& i_rPath, bool i_bVerdict)
{
	const double peer = PeakMemory::Of("assimp", i_rPath);
	for (const char* pWork : {"skeleton", "skin"})
	{
		const double ours = PeakMemory::Of(pWork, i_rPath);
		std::printf("peak memory, %s of %s: %.1f MiB, assimp %.1f MiB%s\n", pWork, i_rName.c_str(), ours, peer,
		    ours < 0 || ours >= peer ? " EXCEEDED" : "");
		if (i_bVerdict)
			Verdict::Tell((std::string("peak memory, ") + pWork).c_str(), "assimp", i_rName,
			    ours < 0 ? std::vector<double>{} : std::vector{ours / peer}, 1.0);
	}
}

/// A chain of that many bones.
void Chain(benchmark::State& io_rState, const FbxTest::VTestForm& i_rForm)
{
	FbxTest::VTestScene scene;
	for (int i = 0; i < io_rState.range(0); ++i)
		scene.m_Nodes.push_back({"bone" + std::to_string(i), "LimbNode", i - 1,
		    {{"Lcl Translation", {10.5, 0.25, 0}}, {"Lcl Rotation", {10, 20, 30}}, {"PreRotation", {5, 6, 7}},
		        {"RotationActive", {1}}}});
	const VTestFolder folder;
	Put(folder / "chain.fbx", FbxTest::Write(i_rForm, scene));
	Skeleton(io_rState, (folder / "chain.fbx").string());
}

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	if (PeakMemory::WasAskedFor(i_Count, i_ppArguments, Work))
		return 0;
	static std::list<std::string> s_Names;
	std::vector<Ratios::VRatio> ratios;
	std::vector<std::pair<std::string, std::string>> files;
	const auto compare = [&](const std::string& i_rName, const std::string& i_rPath, bool i_bSkin)
	{
		files.emplace_back(i_rName, i_rPath);
		const std::string& rPeer = s_Names.emplace_back("Assimp:" + i_rName);
		benchmark::RegisterBenchmark(rPeer.c_str(), AssimpImport, i_rPath)->MeasureProcessCPUTime()->UseRealTime();
		const auto beside = [&](const char* i_pRow, auto i_Run, double i_Limit)
		{
			const std::string& rOurs = s_Names.emplace_back(i_pRow + (":" + i_rName));
			benchmark::RegisterBenchmark(rOurs.c_str(), i_Run, i_rPath)->MeasureProcessCPUTime()->UseRealTime();
			ratios.push_back({rOurs.c_str(), rPeer.c_str(), i_Limit});
		};
		beside("Skeleton", Skeleton, 0.1);
		if (!i_bSkin)
			return;
		beside("PlacedMeshes", PlacedMeshes, 0.25);
		beside("Skin", Skin, 0.25);
	};
	// assimp reads version 7.1 and later.
	for (const char* pFile : {"heaps_biped_zup_a7100", "kenney_medium_b7400", "own_game_zup_m_b7400",
	         "own_ns_yup_cm_a7400", "own_ns_yup_cm_b7400", "pab_arnaud_b7500"})
		compare(pFile, std::string(RETARGET_TEST_DATA "/fbx/") + pFile + ".fbx", true);
	compare("ufbx_maya_human_ik_7400_binary", RETARGET_TEST_DATA "/fbx/ufbx_maya_human_ik_7400_binary.fbx", false);
	const VTestFolder folder;
	Put(folder / "character.fbx", GeneratedCharacter());
	compare("character", (folder / "character.fbx").string(), true);
	for (const FbxTest::VTestForm& rForm : FbxTest::c_Forms)
	{
		auto* const pChain =
		    benchmark::RegisterBenchmark((std::string("Chain:") + rForm.m_pName).c_str(), Chain, rForm);
		for (const int bones : {30, 100, 300, 1000, 3000})
			pChain->Arg(bones);
	}
	const int status = Ratios::Main(i_Count, i_ppArguments, ratios);
	for (const auto& [name, path] : files)
		PrintPeaks(name, path, Verdict::WasAskedFor(i_Count, i_ppArguments));
	return status;
}
