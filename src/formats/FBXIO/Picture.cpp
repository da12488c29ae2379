#include "FBXIO/Picture.h"

#include "FBXIO/Limits.h"

#include <QBuffer>
#include <QImageReader>
#include <QtEndian>

#include <algorithm>

namespace
{

/// Each of a PNG's packed texts becomes many MB, which count nowhere and are no part of the picture.
void RemoveTexts(QByteArray& io_rFile)
{
	constexpr int c_HeadSize = 8;
	constexpr int c_ChunkSize = 12;
	if (!io_rFile.startsWith("\x89PNG\r\n\x1a\n"))
		return;
	QByteArray kept = io_rFile.left(c_HeadSize);
	int at = c_HeadSize;
	while (io_rFile.size() - at >= c_ChunkSize)
	{
		const auto length = qFromBigEndian<quint32>(io_rFile.constData() + at);
		if (length > quint32(io_rFile.size() - at - c_ChunkSize))
			break;
		const QByteArray chunk = io_rFile.mid(at, c_ChunkSize + int(length));
		if (const QByteArray type = chunk.mid(4, 4); type != "zTXt" && type != "iTXt")
			kept += chunk;
		at += chunk.size();
	}
	io_rFile = kept + io_rFile.mid(at);
}

/// The whole picture is gone through for each of a JPEG's scans, which may have a hundred bytes.
bool HasTooManyScans(const QByteArray& i_rFile)
{
	return i_rFile.startsWith("\xff\xd8") && i_rFile.count("\xff\xda") > FBXIO::Limits::c_ImageScans;
}

/// Drawn by commands, or with whole files of other formats inside.
bool IsUnbounded(const QByteArray& i_rFormat)
{
	constexpr const char* c_Formats[]{"svg", "svgz", "ico", "cur", "icns", "pdf"};
	return std::find(std::begin(c_Formats), std::end(c_Formats), i_rFormat) != std::end(c_Formats);
}

} // namespace

FBXIO::VPicture FBXIO::ReadPicture(QByteArray i_Bytes, const QByteArray& i_rFormat, std::uint64_t& io_rBytesLeft)
{
	VPicture picture;
	if (HasTooManyScans(i_Bytes))
		return picture;
	RemoveTexts(i_Bytes);
	QBuffer buffer(&i_Bytes);
	QImageReader reader(&buffer, i_rFormat);
	if (IsUnbounded(reader.format()))
		return picture;
	picture.m_Size = reader.size();
	if (picture.m_Size.isEmpty())
		return picture;
	// Some hundred bytes can hold gigabytes of one colour.
	const int pointBytes = QImage::toPixelFormat(reader.imageFormat()).bitsPerPixel() > 32 ? 8 : 4;
	const std::uint64_t bytes =
	    std::uint64_t(picture.m_Size.width()) * std::uint64_t(picture.m_Size.height()) * std::uint64_t(pointBytes);
	picture.m_bTooLarge = bytes > std::min(Limits::c_ImageBytes, io_rBytesLeft);
	if (picture.m_bTooLarge)
		return picture;
	// Before it turns out to be damaged: a file may hold any number of such pictures.
	io_rBytesLeft -= bytes;
	picture.m_Image = reader.read();
	return picture;
}
