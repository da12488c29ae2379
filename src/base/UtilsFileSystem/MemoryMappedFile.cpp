#include "UtilsFileSystem/MemoryMappedFile.h"

#include "DebugServices/GlobalLog.h"
#include "UtilsFileSystem/Files.h"

#include <algorithm>

namespace UtilsFileSystem
{

VMemoryMappedFileBase::VMemoryMappedFileBase(
    const boost::filesystem::path& i_rPath, bool i_bWrite, std::uint64_t i_Size)
{
	const int error = Platform::OpenMapped(i_rPath, i_bWrite, i_Size, m_Mapped);
	m_bOpen = error == 0;
	if (!m_bOpen)
		LogOpenFailure(i_rPath, error,
		    i_bWrite ? "Failed to open output file '%1%' locked by processes '%2%'."
		             : "Failed to open input file %1% locked by processes '%2%'.");
}

VMemoryMappedFileBase::~VMemoryMappedFileBase()
{
	if (m_pView)
		Platform::UnmapView(m_pView, m_ViewLength);
	if (m_bOpen)
		Platform::CloseMapped(m_Mapped);
}

bool VMemoryMappedFileBase::Map(std::uint64_t i_Position, std::size_t i_Length)
{
	if (m_pView)
		Platform::UnmapView(m_pView, m_ViewLength);
	m_pView = nullptr;
	m_ViewLength = 0;
	if (i_Position >= GetSize() || i_Length == 0)
		return false;
	m_ViewPosition = i_Position - i_Position % Platform::GetMappingGranularity();
	const std::size_t length = std::size_t(std::min<std::uint64_t>(i_Length, GetSize() - m_ViewPosition));
	m_pView = static_cast<char*>(Platform::MapView(m_Mapped, m_ViewPosition, length));
	if (m_pView)
		m_ViewLength = length;
	return m_pView != nullptr;
}

VMemoryMappedInputFile::VMemoryMappedInputFile(const boost::filesystem::path& i_rPath, std::size_t i_WindowBytes)
    : VMemoryMappedFileBase(i_rPath, false, 0)
{
	// At least one unit, so that a window that begins before a position always reaches it.
	const std::size_t unit = Platform::GetMappingGranularity();
	m_WindowBytes = std::max<std::size_t>(1, (i_WindowBytes + unit - 1) / unit) * unit;
}

std::string_view VMemoryMappedInputFile::View(std::uint64_t i_Position)
{
	if (i_Position >= GetSize())
		return {};
	if (i_Position < m_ViewPosition || i_Position >= m_ViewPosition + m_ViewLength)
	{
		++m_Swaps;
		if (!Map(i_Position, m_WindowBytes))
			return {};
	}
	const std::size_t offset = std::size_t(i_Position - m_ViewPosition);
	return {m_pView + offset, m_ViewLength - offset};
}

VMemoryMappedOutputFile::VMemoryMappedOutputFile(const boost::filesystem::path& i_rPath, std::size_t i_Size)
    : VMemoryMappedFileBase(i_rPath, true, i_Size)
{
	Map(0, i_Size);
}

VMemoryMappedInputStreamVirtual::VMemoryMappedInputStreamVirtual(
    const boost::filesystem::path& i_rPath, std::size_t i_WindowBytes)
    : m_File(i_rPath, i_WindowBytes), m_bGood(m_File.IsOpen())
{
}

VMemoryMappedInputStreamVirtual::~VMemoryMappedInputStreamVirtual()
{
	NVX_LOG("System", NVX::ELogDetail, "VMemoryMappedInputStream stats: %1% swaps, %2% pages in file.",
	    m_File.GetSwaps(), m_File.GetPages());
}

bool VMemoryMappedInputStreamVirtual::Seek(std::uint64_t i_Position)
{
	if (!m_bGood || i_Position > GetSize())
		return false;
	m_Position = i_Position;
	return true;
}

std::size_t VMemoryMappedInputStreamVirtual::Read(void* o_pBytes, std::size_t i_Count)
{
	std::size_t read = 0;
	while (m_bGood && read < i_Count && m_Position < GetSize())
	{
		const std::string_view view = m_File.View(m_Position);
		const std::size_t wanted = std::min(view.size(), i_Count - read);
		const std::size_t part = Platform::CopyFromView(view.data(), wanted, static_cast<char*>(o_pBytes) + read);
		m_bGood = part > 0 && part == wanted;
		read += part;
		m_Position += part;
	}
	return read;
}

} // namespace UtilsFileSystem
