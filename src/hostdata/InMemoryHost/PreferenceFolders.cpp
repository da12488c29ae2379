#include "InMemoryHost/PreferenceFolders.h"

namespace InMemoryHost
{

boost::filesystem::path VPreferenceFolders::Folder(const std::string& i_rKey) const
{
	const auto found = m_Folders.find(i_rKey);
	return found == m_Folders.end() ? boost::filesystem::path() : found->second;
}

std::int32_t VPreferenceFolders::Number(const std::string& i_rKey, std::int32_t i_Default) const
{
	const auto found = m_Numbers.find(i_rKey);
	return found == m_Numbers.end() ? i_Default : found->second;
}

void VPreferenceFolders::SetFolder(const std::string& i_rKey, const boost::filesystem::path& i_rFolder)
{
	if (Folder(i_rKey) == i_rFolder)
		return;
	m_Folders[i_rKey] = i_rFolder;
	m_ChangedSignal.Fire(i_rKey);
}

void VPreferenceFolders::SetNumber(const std::string& i_rKey, std::int32_t i_Number)
{
	m_Numbers[i_rKey] = i_Number;
	m_ChangedSignal.Fire(i_rKey);
}

} // namespace InMemoryHost
