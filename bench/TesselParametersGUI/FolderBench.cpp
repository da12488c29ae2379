// A folder of many files: reading it again into the permitted values of a parameter, beside the plain list of its
// entries by Qt; and the update of the list model behind a control, which the user waits for with each choice.
#include "../Ratios.h"
#include "TesselParametersGUI/ParameterEnumFolderWatcher.h"
#include "TesselParametersGUI/ParameterGroupModel.h"

#include "InMemoryHost/Dispatcher.h"
#include "InMemoryHost/ParameterRegistry.h"
#include "TesselDataStore/DataStore.h"
#include "TesselParameters/ParameterGroup.h"

#include <QCoreApplication>
#include <QDir>
#include <QTemporaryDir>

#include <benchmark/benchmark.h>

#include <boost/filesystem/operations.hpp>

#include <fstream>

namespace
{

using namespace TesselParametersGUI;

struct VFolderBench
{
	explicit VFolderBench(benchmark::State& io_rState)
	{
		const boost::filesystem::path folder = m_Folder.path().toStdString();
		std::ofstream((folder / "0.qrs").c_str()).flush();
		for (int index = 1; index < io_rState.range(0); ++index)
			create_hard_link(folder / "0.qrs", folder / (std::to_string(index) + ".qrs"));
		m_pParameter = m_pGroup->AddNew<VParameterEnumFolderWatcher>(
		    "Source Skeleton", "", "SourceSkeleton", TesselParameters::CheckerOf<std::string>(), std::string(".qrs"));
		m_pParameter->AddFolder("User", folder, 1);
		m_pParameter->Refresh();
	}

	int m_Count = 1;
	char m_Name[6] = "bench";
	char* m_pName = m_Name;
	QCoreApplication m_Application{m_Count, &m_pName};
	QTemporaryDir m_Folder;
	std::shared_ptr<TesselParameters::VParameterGroup> m_pGroup = std::make_shared<TesselParameters::VParameterGroup>(
	    std::make_shared<TesselDataStore::VDataStore>(), "RetargetSetup", "Subject");
	std::shared_ptr<VParameterEnumFolderWatcher> m_pParameter;
};

void BM_Refresh(benchmark::State& io_rState)
{
	const VFolderBench bench(io_rState);
	for (auto _ : io_rState)
		bench.m_pParameter->Refresh();
}
BENCHMARK(BM_Refresh)->Arg(100)->Arg(5000)->Unit(benchmark::kMillisecond);

void BM_QtEntryList(benchmark::State& io_rState)
{
	const VFolderBench bench(io_rState);
	for (auto _ : io_rState)
		benchmark::DoNotOptimize(QDir(bench.m_Folder.path()).entryList({"*.qrs"}, QDir::Files, QDir::Name));
}
BENCHMARK(BM_QtEntryList)->Arg(100)->Arg(5000)->Unit(benchmark::kMillisecond);

void BM_ModelFollowsAChoice(benchmark::State& io_rState)
{
	const VFolderBench bench(io_rState);
	const auto pRegistry = std::make_shared<InMemoryHost::VParameterRegistry>();
	pRegistry->Register("RetargetSetup", bench.m_pGroup);
	const auto pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
	VParameterGroupModel model(pRegistry, pDispatcher, "RetargetSetup", "Subject");
	int index = 0;
	for (auto _ : io_rState)
	{
		model.setEnumIndex(0, ++index % int(io_rState.range(0)));
		pDispatcher->RunPending();
	}
}
BENCHMARK(BM_ModelFollowsAChoice)->Arg(100)->Arg(5000)->Unit(benchmark::kMillisecond);

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	return Ratios::Main(i_Count, i_ppArguments, {});
}
