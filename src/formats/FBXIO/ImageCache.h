#pragma once

#include "FBXIO/Limits.h"
#include "FBXIO/MeshRules.h"

#include <QImage>

#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <string>

namespace FBXIO
{

/// A picture that was looked for: both empty if there is none.
struct VCachedPicture
{
	/// Empty if only the head was read.
	std::shared_ptr<const QImage> m_pImage;
	QSize m_Size;
};

/// Images by the exact path that they were asked for with. Belongs to one thread at a time. What is beyond the limits
/// for pictures is left out, told in the category "Import".
class ImageCache
{
public:
	/// Of the FBX file: it tells how large the pictures in it may be together.
	void SetFileBytes(std::uint64_t i_Bytes) { m_BytesLeftInFile = Limits::ImagesBytes(i_Bytes); }

	/// Before the first picture.
	void SetPictures(EPictures i_What) { m_What = i_What; }

	/// Reads the file the first time. Empty if it is no image: told once in the category "Import".
	VCachedPicture Get(const std::string& i_rPath);

	/// The same of a picture that i_rRead gives the file of, under a name that is no path of a file.
	VCachedPicture Get(const std::string& i_rName, const std::function<std::string()>& i_rRead);

private:
	/// Takes from io_rBytesLeft.
	VCachedPicture Read(const QByteArray& i_rBytes, const QByteArray& i_rFormat, const std::string& i_rName,
	    std::uint64_t& io_rBytesLeft) const;

	std::uint64_t m_BytesLeft = Limits::c_ImagesBytes;
	std::uint64_t m_BytesLeftInFile = 0;
	EPictures m_What = EPictures::All;
	std::map<std::string, VCachedPicture> m_Images;
};

} // namespace FBXIO
