#include "fbxsdk/container/FileBytes.h"

#include "UtilsFileSystem/Files.h"
#include "UtilsFileSystem/Paths.h"
#include "fbxsdk/Limits.h"

#include <boost/filesystem/operations.hpp>

#include <algorithm>
#include <cstdio>

bool FbxFile::VFileBytes::Read(const std::string& i_rPath, std::size_t i_Limit, std::string& o_rReason)
{
	const boost::filesystem::path path = UtilsFileSystem::PathFromUtf8(i_rPath);
	boost::system::error_code error;
	const boost::uintmax_t size = boost::filesystem::file_size(path, error);
	const UtilsFileSystem::VFile pFile = error ? nullptr : UtilsFileSystem::OpenFile(path, "rb");
	if (!pFile)
	{
		o_rReason = "File cannot be opened";
		return false;
	}
	if (size > Limits::c_FileBytes)
	{
		o_rReason = "File is larger than 2 GiB";
		return false;
	}
	// One large read goes past the stream's buffer, and new char[] leaves the bytes as they are.
	std::setvbuf(pFile.get(), nullptr, _IONBF, 0);
	const std::size_t wanted = std::min<std::size_t>(size, i_Limit);
	m_pBytes.reset(new char[wanted]);
	m_Size = std::fread(m_pBytes.get(), 1, wanted, pFile.get());
	if (std::ferror(pFile.get()))
	{
		o_rReason = "File cannot be read";
		return false;
	}
	return true;
}
