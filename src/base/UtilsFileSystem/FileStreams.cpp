#include "UtilsFileSystem/FileStreams.h"

#include "UtilsFileSystem/Files.h"
#include "UtilsFileSystem/Platform.h"

#include <boost/filesystem/operations.hpp>

#include <cerrno>

namespace UtilsFileSystem
{
namespace
{

/// Opens any of the standard streams; on failure logs and leaves it failed.
template <typename TStream>
void Open(TStream& io_rStream, const boost::filesystem::path& i_rPath, std::ios_base::openmode i_Mode)
{
	boost::system::error_code error;
	if (is_directory(status(i_rPath, error)))
	{
		errno = EISDIR;
		io_rStream.setstate(std::ios_base::failbit);
	}
	else
	{
		errno = 0;
		io_rStream.open(Platform::NativePath(i_rPath).c_str(), i_Mode);
	}
	if (io_rStream.fail())
		LogOpenFailure(i_rPath, errno,
		    i_Mode & std::ios_base::out ? "Failed to open output file stream %1% locked by processes '%2%'."
		                                : "Failed to open input file stream %1% locked by processes '%2%'.");
}

} // namespace

VFileInputStream::VFileInputStream(const boost::filesystem::path& i_rPath, std::ios_base::openmode i_Mode)
{
	Open(*this, i_rPath, i_Mode | std::ios_base::in);
}

VFileOutputStream::VFileOutputStream(const boost::filesystem::path& i_rPath, std::ios_base::openmode i_Mode)
{
	Open(*this, i_rPath, i_Mode | std::ios_base::out);
}

std::fstream OpenFileStream(const boost::filesystem::path& i_rPath, std::ios_base::openmode i_Mode)
{
	std::fstream stream;
	Open(stream, i_rPath, i_Mode);
	return stream;
}

VFileInputStreamVirtual::VFileInputStreamVirtual(const boost::filesystem::path& i_rPath)
    : VFileInputStreamVirtual(std::make_unique<VFileInputStream>(i_rPath))
{
}

VFileInputStreamVirtual::VFileInputStreamVirtual(std::unique_ptr<VFileInputStream> i_pStream)
    : m_pStream(std::move(i_pStream))
{
	if (!*m_pStream || !m_pStream->seekg(0, std::ios_base::end))
		return;
	const std::streamoff size = m_pStream->tellg();
	m_bGood = size >= 0 && m_pStream->seekg(0);
	m_Size = m_bGood ? std::uint64_t(size) : 0;
}

bool VFileInputStreamVirtual::Seek(std::uint64_t i_Position)
{
	if (!m_bGood || i_Position > m_Size)
		return false;
	m_pStream->clear();
	m_bGood = bool(m_pStream->seekg(std::streamoff(i_Position)));
	if (m_bGood)
		m_Position = i_Position;
	return m_bGood;
}

std::size_t VFileInputStreamVirtual::Read(void* o_pBytes, std::size_t i_Count)
{
	if (!m_bGood)
		return 0;
	m_pStream->read(static_cast<char*>(o_pBytes), std::streamsize(i_Count));
	const std::size_t read = std::size_t(m_pStream->gcount());
	m_bGood = !m_pStream->bad();
	m_pStream->clear();
	m_Position += read;
	return read;
}

} // namespace UtilsFileSystem
