#pragma once

#include "UtilsFileSystem/InputStreamSeekable.h"
#include "UtilsFileSystem/Platform.h"

#include <boost/filesystem/path.hpp>

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace UtilsFileSystem
{

/// A file of which one part is mapped at a time. A file that cannot be opened counts as empty and is told in the log.
/// While it is mapped, no other process may make the file shorter.
class VMemoryMappedFileBase
{
public:
	~VMemoryMappedFileBase();
	VMemoryMappedFileBase(const VMemoryMappedFileBase&) = delete;
	VMemoryMappedFileBase& operator=(const VMemoryMappedFileBase&) = delete;

	bool IsOpen() const { return m_bOpen; }
	std::uint64_t GetSize() const { return m_Mapped.m_Size; }

protected:
	VMemoryMappedFileBase(const boost::filesystem::path& i_rPath, bool i_bWrite, std::uint64_t i_Size);

	/// Replaces the part that is mapped by one that begins at or before i_Position, at the system's granularity, and is
	/// i_Length bytes long, or up to the end.
	/// @return false beyond the end, or if the system refuses; nothing is mapped then.
	bool Map(std::uint64_t i_Position, std::size_t i_Length);

	Platform::VMapped m_Mapped;
	bool m_bOpen = false;
	char* m_pView = nullptr;
	std::size_t m_ViewLength = 0;
	std::uint64_t m_ViewPosition = 0;
};

class VMemoryMappedInputFile final : public VMemoryMappedFileBase
{
public:
	/// @param i_WindowBytes what is mapped at a time, rounded up to the system's granularity.
	explicit VMemoryMappedInputFile(const boost::filesystem::path& i_rPath, std::size_t i_WindowBytes = 64u << 20);

	/// The bytes from a position to the end of the window that holds it; empty beyond the end or on failure. Valid
	/// until the next call. If another program cuts the file short, touching what is gone ends the process: where that
	/// may be, VMemoryMappedInputStreamVirtual reads.
	std::string_view View(std::uint64_t i_Position);

	/// How often the window was moved, the first time included.
	std::uint64_t GetSwaps() const { return m_Swaps; }
	/// Windows that the file consists of.
	std::uint64_t GetPages() const { return (GetSize() + m_WindowBytes - 1) / m_WindowBytes; }

private:
	std::size_t m_WindowBytes;
	std::uint64_t m_Swaps = 0;
};

/// A new file of a given size, mapped as a whole; an older file is overwritten.
class VMemoryMappedOutputFile final : public VMemoryMappedFileBase
{
public:
	VMemoryMappedOutputFile(const boost::filesystem::path& i_rPath, std::size_t i_Size);
	/// GetSize() bytes, zeros at first; null if there are none.
	char* GetData() { return m_pView; }
};

/// A file of any size through a sliding window. At its end the log tells how often the window was moved. If another
/// program cuts the file short, a read beyond what is left fails.
class VMemoryMappedInputStreamVirtual final : public NVX::IInputStreamSeekable
{
public:
	explicit VMemoryMappedInputStreamVirtual(
	    const boost::filesystem::path& i_rPath, std::size_t i_WindowBytes = 64u << 20);
	~VMemoryMappedInputStreamVirtual() override;

	bool IsGood() const override { return m_bGood; }
	std::uint64_t GetSize() const override { return m_File.GetSize(); }
	std::uint64_t GetPosition() const override { return m_Position; }
	bool Seek(std::uint64_t i_Position) override;
	std::size_t Read(void* o_pBytes, std::size_t i_Count) override;

private:
	VMemoryMappedInputFile m_File;
	bool m_bGood;
	std::uint64_t m_Position = 0;
};

} // namespace UtilsFileSystem
