#pragma once

#include "UtilsFileSystem/InputStreamSeekable.h"

#include <boost/filesystem/path.hpp>

#include <fstream>
#include <memory>

namespace UtilsFileSystem
{

/// A stream over a file. If the file cannot be opened the stream is in its failed state, and the log tells who holds
/// the file, if that is why. A directory is refused. A stream serves one thread.
class VFileInputStream : public std::ifstream
{
public:
	explicit VFileInputStream(
	    const boost::filesystem::path& i_rPath, std::ios_base::openmode i_Mode = std::ios_base::binary);
};

class VFileOutputStream : public std::ofstream
{
public:
	explicit VFileOutputStream(
	    const boost::filesystem::path& i_rPath, std::ios_base::openmode i_Mode = std::ios_base::binary);
};

/// A stream for what the mode names, opened as the above are; a mode with std::ios_base::out counts as output.
std::fstream OpenFileStream(const boost::filesystem::path& i_rPath, std::ios_base::openmode i_Mode);

/// A VFileInputStream that is read through the seekable interface.
class VFileInputStreamVirtual final : public NVX::IInputStreamSeekable
{
public:
	explicit VFileInputStreamVirtual(const boost::filesystem::path& i_rPath);
	/// Takes over a stream that is open or failed.
	explicit VFileInputStreamVirtual(std::unique_ptr<VFileInputStream> i_pStream);

	bool IsGood() const override { return m_bGood; }
	std::uint64_t GetSize() const override { return m_Size; }
	std::uint64_t GetPosition() const override { return m_Position; }
	bool Seek(std::uint64_t i_Position) override;
	std::size_t Read(void* o_pBytes, std::size_t i_Count) override;

private:
	std::unique_ptr<VFileInputStream> m_pStream;
	bool m_bGood = false;
	std::uint64_t m_Size = 0;
	std::uint64_t m_Position = 0;
};

} // namespace UtilsFileSystem
