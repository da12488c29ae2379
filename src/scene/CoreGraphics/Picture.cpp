#include "CoreGraphics/Picture.h"

#include <QBuffer>
#include <QImageReader>

#include <algorithm>
#include <png.h>

namespace
{

bool IsPng(std::string_view i_File)
{
	return i_File.starts_with("\x89PNG\r\n\x1a\n");
}

/// Drawn by commands, or with whole files of other formats inside.
bool IsUnbounded(const QByteArray& i_rFormat)
{
	constexpr const char* c_Formats[]{"svg", "svgz", "ico", "cur", "icns", "pdf"};
	return std::find(std::begin(c_Formats), std::end(c_Formats), i_rFormat) != std::end(c_Formats);
}

/// Null for a null image.
std::shared_ptr<FBXIO::VPicture> PictureOf(QImage i_Image)
{
	if (i_Image.isNull())
		return {};
	auto pPicture = std::make_shared<CoreGraphics::VDecodedPicture>();
	pPicture->m_Image = std::move(i_Image);
	return pPicture;
}

class VQtPicture final : public FBXIO::IPictureFile
{
public:
	VQtPicture(std::string_view i_Bytes, const QByteArray& i_rFormat)
	    : m_Bytes(QByteArray::fromRawData(i_Bytes.data(), int(i_Bytes.size()))), m_Buffer(&m_Bytes),
	      m_Reader(&m_Buffer, i_rFormat)
	{
	}
	bool ReadHead(int& o_rWidth, int& o_rHeight) override
	{
		const QSize size = IsUnbounded(m_Reader.format()) ? QSize() : m_Reader.size();
		o_rWidth = size.width();
		o_rHeight = size.height();
		return !size.isEmpty();
	}
	int PointBytes() override { return QImage::toPixelFormat(m_Reader.imageFormat()).bitsPerPixel() > 32 ? 8 : 4; }
	std::shared_ptr<FBXIO::VPicture> Read() override { return PictureOf(m_Reader.read()); }

private:
	QByteArray m_Bytes;
	QBuffer m_Buffer;
	QImageReader m_Reader;
};

/// Qt leaves it to libpng to print what is wrong with a PNG to the terminal; this way of reading does not.
class VPngPicture final : public FBXIO::IPictureFile
{
public:
	explicit VPngPicture(std::string_view i_Bytes)
	{
		m_Image.version = PNG_IMAGE_VERSION;
		m_bHead = png_image_begin_read_from_memory(&m_Image, i_Bytes.data(), i_Bytes.size()) != 0;
	}
	~VPngPicture() override { png_image_free(&m_Image); }
	bool ReadHead(int& o_rWidth, int& o_rHeight) override
	{
		o_rWidth = int(m_Image.width);
		o_rHeight = int(m_Image.height);
		return m_bHead;
	}
	int PointBytes() override { return (m_Image.format & PNG_FORMAT_FLAG_LINEAR) != 0 ? 8 : 4; }
	std::shared_ptr<FBXIO::VPicture> Read() override
	{
		QImage image(int(m_Image.width), int(m_Image.height), QImage::Format_RGBA8888);
		m_Image.format = PNG_FORMAT_RGBA;
		if (image.isNull()
		    || !png_image_finish_read(&m_Image, nullptr, image.bits(), int(image.bytesPerLine()), nullptr))
			return {};
		return PictureOf(std::move(image));
	}

private:
	png_image m_Image = {};
	bool m_bHead = false;
};

} // namespace

std::unique_ptr<FBXIO::IPictureFile> CoreGraphics::OpenPicture(std::string_view i_Bytes, const std::string& i_rFormat)
{
	if (IsPng(i_Bytes))
		return std::make_unique<VPngPicture>(i_Bytes);
	// What only claims to be a PNG must not get to Qt's reader of those.
	return std::make_unique<VQtPicture>(
	    i_Bytes, i_rFormat == "png" ? QByteArray() : QByteArray::fromStdString(i_rFormat));
}
