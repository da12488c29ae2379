#include "FBXIO/ImageCache.h"

#include "DebugServices/GlobalLog.h"
#include "UtilsFileSystem/Files.h"
#include "UtilsFileSystem/Paths.h"

#include <boost/algorithm/string/case_conv.hpp>

#include <algorithm>
#include <locale>

namespace
{

using namespace FBXIO;

/// Each of a PNG's packed texts becomes many MB, which count nowhere and are no part of the picture.
void RemoveTexts(std::string& io_rFile)
{
	constexpr std::size_t c_HeadSize = 8;
	constexpr std::size_t c_ChunkSize = 12;
	if (!io_rFile.starts_with("\x89PNG\r\n\x1a\n"))
		return;
	std::size_t kept = c_HeadSize;
	std::size_t at = c_HeadSize;
	while (io_rFile.size() - at >= c_ChunkSize)
	{
		std::size_t length = 0;
		for (std::size_t i = at; i < at + 4; ++i)
			length = length << 8 | std::uint8_t(io_rFile[i]);
		if (length > io_rFile.size() - at - c_ChunkSize)
			break;
		length += c_ChunkSize;
		const std::string_view type(io_rFile.data() + at + 4, 4);
		const bool bText = type == "zTXt" || type == "iTXt";
		if (!bText)
		{
			std::copy_n(io_rFile.begin() + std::ptrdiff_t(at), length, io_rFile.begin() + std::ptrdiff_t(kept));
			kept += length;
		}
		at += length;
	}
	io_rFile.erase(kept, at - kept);
}

/// The whole picture is gone through for each of a JPEG's scans, which may have a hundred bytes.
bool HasTooManyScans(std::string_view i_File)
{
	if (!i_File.starts_with("\xff\xd8"))
		return false;
	int scans = 0;
	for (std::size_t at = 0; (at = i_File.find("\xff\xda", at)) != std::string_view::npos; at += 2)
		++scans;
	return scans > Limits::c_ImageScans;
}

} // namespace

std::shared_ptr<const FBXIO::VPicture> FBXIO::ImageCache::Read(
    std::string i_Bytes, const std::string& i_rFormat, const std::string& i_rName, std::uint64_t& io_rBytesLeft) const
{
	std::shared_ptr<VPicture> pPicture;
	int width = 0;
	int height = 0;
	bool bTooLarge = false;
	if (!HasTooManyScans(i_Bytes))
	{
		RemoveTexts(i_Bytes);
		const std::unique_ptr<IPictureFile> pFile = m_pOpen(i_Bytes, i_rFormat);
		if (pFile->ReadHead(width, height))
		{
			// Some hundred bytes can hold gigabytes of one colour.
			const std::uint64_t bytes =
			    std::uint64_t(width) * std::uint64_t(height) * std::uint64_t(pFile->PointBytes());
			bTooLarge = bytes > std::min(Limits::c_ImageBytes, io_rBytesLeft);
			if (!bTooLarge)
			{
				io_rBytesLeft -= bytes;
				pPicture = pFile->Read();
			}
		}
	}
	if (pPicture)
	{
		pPicture->m_Width = width;
		pPicture->m_Height = height;
	}
	else if (bTooLarge)
		NVX_LOG("Import", NVX::ELogError,
		    "Failed to load %1%: its %2% by %3% points, or all pictures of the FBX file together, are too large",
		    i_rName, width, height);
	else
		NVX_LOG("Import", NVX::ELogError, "Failed to load %1%", i_rName);
	return pPicture;
}

std::shared_ptr<const FBXIO::VPicture> FBXIO::ImageCache::Get(const std::string& i_rPath)
{
	const auto [entry, bNew] = m_Images.try_emplace(i_rPath);
	if (!bNew)
		return entry->second;
	std::string text = i_rPath;
	std::replace(text.begin(), text.end(), '\\', '/');
	const boost::filesystem::path path = UtilsFileSystem::PathFromUtf8(text);
	std::string bytes;
	// A file may name a device, whose reading would never end.
	std::string reason;
	UtilsFileSystem::ReadRegularFile(path, std::size_t(Limits::c_ImageBytes), bytes, reason);
	std::string format = UtilsFileSystem::ToUtf8(path.extension());
	boost::algorithm::to_lower(format, std::locale::classic());
	return entry->second = Read(std::move(bytes), format.empty() ? format : format.substr(1), i_rPath, m_BytesLeft);
}

std::shared_ptr<const FBXIO::VPicture> FBXIO::ImageCache::Get(
    const std::string& i_rName, const std::function<std::string()>& i_rRead)
{
	if (const auto found = m_Images.find(i_rName); found != m_Images.end())
		return found->second;
	std::string content = i_rRead();
	// The next of that name may have one.
	if (content.empty() || content.size() > Limits::c_ImageBytes)
		return {};
	return m_Images[i_rName] = Read(std::move(content), {}, i_rName, m_BytesLeftInFile);
}
