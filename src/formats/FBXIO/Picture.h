#pragma once

#include "FBXIO/MeshRules.h"

#include <QByteArray>
#include <QImage>

#include <cstdint>

namespace FBXIO
{

struct VPicture
{
	/// Null if the file holds no picture, or one that is left out, and if only the head was asked for.
	QImage m_Image;
	/// What its head promises, as far as that was read.
	QSize m_Size;
	/// Everything that was asked for could be read.
	bool m_bSound = false;
	/// Left out for its size.
	bool m_bTooLarge = false;
};

/// Reads the file of a picture whose points, of four bytes or eight, are within c_ImageBytes and io_rBytesLeft, which
/// pays for them. Left out are also files that cost more than their head tells: SVG, icons, and JPEG of very many
/// scans.
/// @param i_rFormat the extension of the file, for formats that cannot be told from their first bytes; may be empty.
VPicture ReadPicture(QByteArray i_Bytes, const QByteArray& i_rFormat, EPictures i_What, std::uint64_t& io_rBytesLeft);

} // namespace FBXIO
