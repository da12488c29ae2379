#include "fbxsdk/container/FileBytes.h"

#include "UtilsFileSystem/Files.h"
#include "UtilsFileSystem/Paths.h"
#include "fbxsdk/Limits.h"

#include <boost/filesystem/operations.hpp>

#include <algorithm>
#include <cstdio>
#include <limits>

namespace
{

/// What is read in one go: large enough to cost nothing, small enough to be ended soon.
constexpr std::size_t c_ChunkBytes = std::size_t(16) << 20;

} // namespace

char* FbxFormat::VFileBytes::Resize(std::size_t i_Size)
{
	// new char[] leaves the bytes as they are.
	m_pBytes.reset(new char[i_Size]);
	m_Size = i_Size;
	return m_pBytes.get();
}

bool FbxFormat::VFileBytes::Read(const std::string& i_rPath, std::size_t i_Limit, std::string& o_rReason)
{
	VProgress unwatched;
	return Read(i_rPath, i_Limit, unwatched, o_rReason);
}

bool FbxFormat::VFileBytes::Read(const std::string& i_rPath, VProgress& io_rProgress, std::string& o_rReason)
{
	return Read(i_rPath, std::numeric_limits<std::size_t>::max(), io_rProgress, o_rReason);
}

bool FbxFormat::VFileBytes::Read(
    const std::string& i_rPath, std::size_t i_Limit, VProgress& io_rProgress, std::string& o_rReason)
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
	// Large reads go past the stream's buffer.
	std::setvbuf(pFile.get(), nullptr, _IONBF, 0);
	const std::size_t wanted = std::min<std::size_t>(size, i_Limit);
	char* const pBytes = Resize(wanted);
	for (m_Size = 0; m_Size < wanted;)
	{
		const std::size_t chunk = std::min(wanted - m_Size, c_ChunkBytes);
		const std::size_t count = std::fread(pBytes + m_Size, 1, chunk, pFile.get());
		m_Size += count;
		if (count != chunk || !io_rProgress.Tell(float(80.0 * double(m_Size) / double(wanted)), "Reading the file"))
			break;
	}
	if (std::ferror(pFile.get()))
	{
		o_rReason = "File cannot be read";
		return false;
	}
	return true;
}
