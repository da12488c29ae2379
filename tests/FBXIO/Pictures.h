#pragma once

#include <png.h>

#include <string>
#include <vector>

namespace FbxTest
{

/// A black picture of this size.
inline std::string PngOf(int i_Width, int i_Height)
{
	png_image image{};
	image.version = PNG_IMAGE_VERSION;
	image.width = png_uint_32(i_Width);
	image.height = png_uint_32(i_Height);
	image.format = PNG_FORMAT_RGB;
	const std::vector<unsigned char> points(PNG_IMAGE_SIZE(image));
	std::string file(PNG_IMAGE_PNG_SIZE_MAX(image), '\0');
	png_alloc_size_t size = file.size();
	png_image_write_to_memory(&image, file.data(), &size, 0, points.data(), 0, nullptr);
	file.resize(size);
	return file;
}

} // namespace FbxTest
