#include "FBXIO/ImageCache.h"

#include "DebugServices/GlobalLog.h"

#include <QFileInfo>

#include <algorithm>

std::shared_ptr<const QImage> FBXIO::ImageCache::Get(const std::string& i_rPath)
{
	const auto [entry, bNew] = m_Images.try_emplace(i_rPath);
	if (!bNew)
		return entry->second;
	std::string path = i_rPath;
	std::replace(path.begin(), path.end(), '\\', '/');
	const QString file = QString::fromStdString(path);
	// A file may name a device, whose reading would never end.
	auto pImage = std::make_shared<const QImage>(QFileInfo(file).isFile() ? QImage(file) : QImage());
	if (pImage->isNull())
		NVX_LOG("Import", NVX::ELogError, "Failed to load %1%", i_rPath);
	else
		entry->second = std::move(pImage);
	return entry->second;
}
