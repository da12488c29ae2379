#pragma once

#include "FBXIO/Limits.h"
#include "FBXIO/Picture.h"

#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <string>

namespace FBXIO
{

/// Pictures by the exact path that they were asked for with. Belongs to one thread at a time. Those beyond the limits
/// are left out, and so are files that cost more than their head tells: SVG, icons, and JPEG of very many scans. What
/// is left out or damaged is told in the category "Import".
class ImageCache
{
public:
	/// Of the FBX file: it tells how large the pictures in it may be together.
	void SetFileBytes(std::uint64_t i_Bytes) { m_BytesLeftInFile = Limits::ImagesBytes(i_Bytes); }

	/// Before the first picture.
	void SetOpener(VOpenPicture i_pOpen) { m_pOpen = i_pOpen; }

	/// Reads the file the first time. Null if it is no picture, which is told once.
	std::shared_ptr<const VPicture> Get(const std::string& i_rPath);

	/// The same of a picture that i_rRead gives the file of, under a name that is no path of a file.
	std::shared_ptr<const VPicture> Get(const std::string& i_rName, const std::function<std::string()>& i_rRead);

private:
	/// Takes from io_rBytesLeft, before a picture turns out to be damaged: a file may hold any number of such ones.
	std::shared_ptr<const VPicture> Read(std::string i_Bytes, const std::string& i_rFormat, const std::string& i_rName,
	    std::uint64_t& io_rBytesLeft) const;

	std::uint64_t m_BytesLeft = Limits::c_ImagesBytes;
	std::uint64_t m_BytesLeftInFile = 0;
	VOpenPicture m_pOpen = &OpenPictureHead;
	std::map<std::string, std::shared_ptr<const VPicture>> m_Images;
};

} // namespace FBXIO
