#include "FBXIO/ImageCache.h"

#include "DebugServices/GlobalLog.h"
#include "FBXIO/Limits.h"

#include <QBuffer>
#include <QFileInfo>
#include <QImageReader>

#include <algorithm>

namespace
{

/// Empty if it is no picture, or one that is too large: some hundred bytes can hold gigabytes of one colour.
std::shared_ptr<const QImage> ReadImage(QImageReader& io_rReader)
{
	const QSize size = io_rReader.size();
	if (size.isValid() && std::uint64_t(size.width()) * std::uint64_t(size.height()) * 4 > FBXIO::Limits::c_ImageBytes)
		return {};
	auto pImage = std::make_shared<const QImage>(io_rReader.read());
	return pImage->isNull() ? nullptr : std::move(pImage);
}

} // namespace

std::shared_ptr<const QImage> FBXIO::ImageCache::Get(const std::string& i_rPath)
{
	const auto [entry, bNew] = m_Images.try_emplace(i_rPath);
	if (!bNew)
		return entry->second;
	std::string path = i_rPath;
	std::replace(path.begin(), path.end(), '\\', '/');
	const QString file = QString::fromStdString(path);
	// A file may name a device, whose reading would never end.
	if (QFileInfo(file).isFile())
	{
		QImageReader reader(file);
		entry->second = ReadImage(reader);
	}
	if (!entry->second)
		NVX_LOG("Import", NVX::ELogError, "Failed to load %1%", i_rPath);
	return entry->second;
}

std::shared_ptr<const QImage> FBXIO::ImageCache::Get(
    const std::string& i_rName, const std::function<std::string()>& i_rRead)
{
	const auto [entry, bNew] = m_Images.try_emplace(i_rName);
	if (!bNew)
		return entry->second;
	const std::string content = i_rRead();
	if (content.empty() || content.size() > Limits::c_ImageBytes)
		return entry->second;
	QByteArray bytes = QByteArray::fromRawData(content.data(), int(content.size()));
	QBuffer buffer(&bytes);
	QImageReader reader(&buffer);
	entry->second = ReadImage(reader);
	if (!entry->second)
		NVX_LOG("Import", NVX::ELogError, "Failed to load %1%", i_rName);
	return entry->second;
}
