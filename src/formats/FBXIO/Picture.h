#pragma once

#include <memory>
#include <string>
#include <string_view>

namespace FBXIO
{

/// A picture of a texture, as large as its head promises, in points. Whoever opens its file may know more of it, such
/// as its points.
struct VPicture
{
	virtual ~VPicture() = default;

	int m_Width = 0;
	int m_Height = 0;
};

/// The file of a picture: its head, and then the picture.
class IPictureFile
{
public:
	virtual ~IPictureFile() = default;

	/// False if it has none. Both are above 0 otherwise.
	virtual bool ReadHead(int& o_rWidth, int& o_rHeight) = 0;

	/// Bytes of one point, at most, while it is read.
	virtual int PointBytes() = 0;

	/// Null if it is damaged. Once, after its head.
	virtual std::shared_ptr<VPicture> Read() = 0;
};

/// Opens the bytes of a file, which must outlive what it returns; never null. Called on the thread of the reader, for
/// files within the limits.
/// @param i_rFormat the extension of the file in lower case, for formats that cannot be told from their first bytes;
/// may be empty.
using VOpenPicture = std::unique_ptr<IPictureFile> (*)(std::string_view i_Bytes, const std::string& i_rFormat);

/// Reads heads alone, of PNG, JPEG, GIF, BMP and PNM: that a picture is there, and how large it is.
std::unique_ptr<IPictureFile> OpenPictureHead(std::string_view i_Bytes, const std::string& i_rFormat);

} // namespace FBXIO
