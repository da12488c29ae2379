#include "FBXIO/ImageCache.h"

#include "DebugServices/GlobalLog.h"
#include "FBXIO/Picture.h"

#include <QFileInfo>

#include <algorithm>

FBXIO::VCachedPicture FBXIO::ImageCache::Read(const QByteArray& i_rBytes, const QByteArray& i_rFormat,
    const std::string& i_rName, std::uint64_t& io_rBytesLeft) const
{
	VPicture picture = ReadPicture(i_rBytes, i_rFormat, m_What, io_rBytesLeft);
	if (picture.m_bSound)
		return {picture.m_Image.isNull() ? nullptr : std::make_shared<const QImage>(std::move(picture.m_Image)),
		    picture.m_Size};
	if (picture.m_bTooLarge)
		NVX_LOG("Import", NVX::ELogError,
		    "Failed to load %1%: its %2% by %3% points, or all pictures of the FBX file together, are too large",
		    i_rName, picture.m_Size.width(), picture.m_Size.height());
	else
		NVX_LOG("Import", NVX::ELogError, "Failed to load %1%", i_rName);
	return {};
}

FBXIO::VCachedPicture FBXIO::ImageCache::Get(const std::string& i_rPath)
{
	const auto [entry, bNew] = m_Images.try_emplace(i_rPath);
	if (!bNew)
		return entry->second;
	std::string path = i_rPath;
	std::replace(path.begin(), path.end(), '\\', '/');
	const QFileInfo info(QString::fromStdString(path));
	QByteArray bytes;
	// A file may name a device, whose reading would never end.
	if (QFile file(info.filePath());
	    info.isFile() && info.size() <= qint64(Limits::c_ImageBytes) && file.open(QIODevice::ReadOnly))
		bytes = file.readAll();
	return entry->second = Read(bytes, info.suffix().toLower().toLatin1(), i_rPath, m_BytesLeft);
}

FBXIO::VCachedPicture FBXIO::ImageCache::Get(const std::string& i_rName, const std::function<std::string()>& i_rRead)
{
	if (const auto found = m_Images.find(i_rName); found != m_Images.end())
		return found->second;
	const std::string content = i_rRead();
	// The next of that name may have one.
	if (content.empty() || content.size() > Limits::c_ImageBytes)
		return {};
	return m_Images[i_rName] =
	           Read(QByteArray::fromRawData(content.data(), int(content.size())), {}, i_rName, m_BytesLeftInFile);
}
