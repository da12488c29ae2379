#include "UtilsFileSystem/LockingProcesses.h"

#include "UtilsFileSystem/Platform.h"

#include <boost/algorithm/string/join.hpp>

namespace UtilsFileSystem
{

bool GetLockingProcesses(const boost::filesystem::path& i_rPath, std::vector<std::string>& o_rNames)
{
	return GetLockingProcesses(*Platform::GetProcessTable(), i_rPath, o_rNames);
}

bool GetLockingProcesses(
    IProcessTable& i_rTable, const boost::filesystem::path& i_rPath, std::vector<std::string>& o_rNames)
{
	o_rNames.clear();
	std::vector<VLockHolder> holders;
	if (!i_rTable.FindHolders(i_rPath, holders) || holders.size() > c_MaximumHolders)
		return false;
	for (const VLockHolder& rHolder : holders)
	{
		const std::unique_ptr<IProcess> pProcess = i_rTable.Open(rHolder.m_ProcessId);
		if (!pProcess)
			continue;
		std::uint64_t startTime = 0;
		std::string image;
		const bool bKnown =
		    pProcess->GetStartTime(startTime) && startTime == rHolder.m_StartTime && pProcess->GetImagePath(image);
		o_rNames.push_back(bKnown ? image : "unknown process");
	}
	return true;
}

std::string JoinNames(const std::vector<std::string>& i_rNames)
{
	return boost::algorithm::join(i_rNames, "', '");
}

} // namespace UtilsFileSystem
