#include "fbxsdk/container/FileBytes.h"

#include "fbxsdk/Limits.h"

#include <boost/filesystem.hpp>

#include <algorithm>
#include <cstdio>

bool FbxFile::VFileBytes::Read(const std::string& i_rPath, std::size_t i_Limit, std::string& o_rReason)
{
	boost::system::error_code error;
	if (!boost::filesystem::is_regular_file(i_rPath, error))
	{
		o_rReason = "File cannot be opened";
		return false;
	}
	const boost::uintmax_t size = boost::filesystem::file_size(i_rPath, error);
	if (error || size > Limits::c_FileBytes)
	{
		o_rReason = error ? "File cannot be opened" : "File is larger than 2 GiB";
		return false;
	}
	const std::unique_ptr<std::FILE, int (*)(std::FILE*)> pFile(std::fopen(i_rPath.c_str(), "rb"), &std::fclose);
	if (!pFile)
	{
		o_rReason = "File cannot be opened";
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
