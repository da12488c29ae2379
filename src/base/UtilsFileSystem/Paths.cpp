#include "UtilsFileSystem/Paths.h"

#include <boost/filesystem/operations.hpp>

#include <algorithm>

std::wstring UtilsFileSystem::AddLongPathPrefix(std::wstring i_Path, std::size_t i_Limit)
{
	if (i_Path.size() < i_Limit || i_Path.starts_with(L"\\\\?\\") || i_Path.starts_with(L"\\\\.\\"))
		return i_Path;
	// Behind the prefix the system takes the path as it stands.
	std::replace(i_Path.begin(), i_Path.end(), L'/', L'\\');
	if (i_Path.starts_with(L"\\\\"))
		return L"\\\\?\\UNC" + i_Path.substr(1);
	return L"\\\\?\\" + i_Path;
}

boost::filesystem::path UtilsFileSystem::Canonical(const boost::filesystem::path& i_rPath)
{
	boost::system::error_code error;
	const boost::filesystem::path canonical = boost::filesystem::canonical(i_rPath, error);
	return error ? i_rPath : canonical;
}
