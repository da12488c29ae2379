#pragma once

#include "FBXIO/Picture.h"

#include <QImage>

namespace CoreGraphics
{

/// A picture of an FBX file with its points.
struct VDecodedPicture final : FBXIO::VPicture
{
	QImage m_Image;
};

/// Opens pictures to be drawn, for FBXIO::FBXReader::SetPictures: PNG, and what Qt reads. Formats that cost more than
/// their head tells, SVG and icons, have no size and are left out. Any thread.
std::unique_ptr<FBXIO::IPictureFile> OpenPicture(std::string_view i_Bytes, const std::string& i_rFormat);

} // namespace CoreGraphics
