#include "FBXIO/Picture.h"

#include "FBXIO/Limits.h"

#include <QBuffer>
#include <QImageReader>
#include <QtEndian>

#include <algorithm>
#include <memory>
#include <png.h>

namespace
{

bool IsPng(const QByteArray& i_rFile)
{
	return i_rFile.startsWith("\x89PNG\r\n\x1a\n");
}

/// Each of a PNG's packed texts becomes many MB, which count nowhere and are no part of the picture.
void RemoveTexts(QByteArray& io_rFile)
{
	constexpr int c_HeadSize = 8;
	constexpr int c_ChunkSize = 12;
	if (!IsPng(io_rFile))
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

/// The head of a picture, and then the picture.
class IPictureFile
{
public:
	virtual ~IPictureFile() = default;
	/// Empty if it has none.
	virtual QSize Size() = 0;
	/// Bytes of one point, at most, while it is read.
	virtual int PointBytes() = 0;
	virtual QImage Read() = 0;
};

class VQtPicture final : public IPictureFile
{
public:
	VQtPicture(QByteArray& i_rBytes, const QByteArray& i_rFormat) : m_Buffer(&i_rBytes), m_Reader(&m_Buffer, i_rFormat)
	{
	}
	QSize Size() override { return IsUnbounded(m_Reader.format()) ? QSize() : m_Reader.size(); }
	int PointBytes() override { return QImage::toPixelFormat(m_Reader.imageFormat()).bitsPerPixel() > 32 ? 8 : 4; }
	QImage Read() override { return m_Reader.read(); }

private:
	QBuffer m_Buffer;
	QImageReader m_Reader;
};

/// Qt leaves it to libpng to print what is wrong with a PNG to the terminal; this way of reading does not.
class VPngPicture final : public IPictureFile
{
public:
	explicit VPngPicture(const QByteArray& i_rBytes)
	{
		m_Image.version = PNG_IMAGE_VERSION;
		m_bHead = png_image_begin_read_from_memory(&m_Image, i_rBytes.constData(), std::size_t(i_rBytes.size())) != 0;
	}
	~VPngPicture() override { png_image_free(&m_Image); }
	QSize Size() override { return m_bHead ? QSize(int(m_Image.width), int(m_Image.height)) : QSize(); }
	int PointBytes() override { return (m_Image.format & PNG_FORMAT_FLAG_LINEAR) != 0 ? 8 : 4; }
	QImage Read() override
	{
		QImage image(Size(), QImage::Format_RGBA8888);
		m_Image.format = PNG_FORMAT_RGBA;
		if (image.isNull()
		    || !png_image_finish_read(&m_Image, nullptr, image.bits(), int(image.bytesPerLine()), nullptr))
			return {};
		return image;
	}

private:
	png_image m_Image = {};
	bool m_bHead = false;
};

std::unique_ptr<IPictureFile> Open(QByteArray& i_rBytes, const QByteArray& i_rFormat)
{
	if (IsPng(i_rBytes))
		return std::make_unique<VPngPicture>(i_rBytes);
	// What only claims to be a PNG must not get to Qt's reader of those.
	return std::make_unique<VQtPicture>(i_rBytes, i_rFormat == "png" ? QByteArray() : i_rFormat);
}

} // namespace

FBXIO::VPicture FBXIO::ReadPicture(
    QByteArray i_Bytes, const QByteArray& i_rFormat, EPictures i_What, std::uint64_t& io_rBytesLeft)
{
	VPicture picture;
	if (HasTooManyScans(i_Bytes))
		return picture;
	RemoveTexts(i_Bytes);
	const std::unique_ptr<IPictureFile> pFile = Open(i_Bytes, i_rFormat);
	picture.m_Size = pFile->Size();
	if (picture.m_Size.isEmpty())
		return picture;
	// Some hundred bytes can hold gigabytes of one colour.
	const std::uint64_t bytes = std::uint64_t(picture.m_Size.width()) * std::uint64_t(picture.m_Size.height())
	    * std::uint64_t(pFile->PointBytes());
	picture.m_bTooLarge = bytes > std::min(Limits::c_ImageBytes, io_rBytesLeft);
	if (picture.m_bTooLarge)
		return picture;
	// Before it turns out to be damaged: a file may hold any number of such pictures.
	io_rBytesLeft -= bytes;
	if (i_What == EPictures::All)
		picture.m_Image = pFile->Read();
	picture.m_bSound = i_What == EPictures::Heads || !picture.m_Image.isNull();
	return picture;
}
