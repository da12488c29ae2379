#pragma once

#include <QSize>

#include <cstddef>
#include <cstdint>
#include <memory>

class QImage;

namespace CoreGraphics
{

class VRenderContext;

enum EMinification : std::uint32_t
{
	EMinificationNearestMipmapNearest,
	EMinificationLinearMipmapNearest,
	EMinificationLinearMipmapLinear,
	EMinificationNearest
};

/// How a texture is read.
struct VTextureSampling
{
	/// EMinification.
	std::uint32_t m_Minification = EMinificationNearestMipmapNearest;
	bool m_bMagnificationLinear = false;
	/// Outside of 0 to 1 the edge goes on; otherwise the texture is repeated.
	bool m_bClampS = false;
	bool m_bClampT = false;
	/// Beyond 1 surfaces seen at a slant stay sharp; at most what there is.
	float m_Anisotropy = 1.0f;

	bool operator==(const VTextureSampling&) const = default;
};

/// How the bytes of a picture stand for colours: the numbers of the host's picture formats.
enum class EPixelFormat : std::uint32_t
{
	/// 1 to 5 and 14 to 17 are one byte a pixel.
	Grey8 = 1,
	Rgb565 = 6,
	/// 7 and 8.
	Rgb24 = 7,
	/// 9 and 10.
	Rgba32 = 9,
	/// 11 to 13: two pixels in four bytes.
	PairOfPixels = 11
};

/// The form that a texture of a format has on desktop OpenGL.
struct VTextureForm
{
	/// GL_R8, GL_RGB565, GL_RGB8 or GL_RGBA8; GL_R32F for floats; 0 for an unknown format.
	std::uint32_t m_InternalFormat = 0;
	/// What a width in pixels is divided by.
	int m_WidthDivisor = 1;

	bool operator==(const VTextureForm&) const = default;
};
VTextureForm FormOf(EPixelFormat i_Format);

/// A picture in OpenGL, in the share group of the context that was current when it was made. Every method needs a
/// context of that group to be current; the destructor does not.
class VTexture
{
public:
	/// @param i_InternalFormat see VTextureForm
	/// @param i_Size in texels
	/// @param i_bMipmaps smaller copies are made at each upload
	VTexture(std::uint32_t i_InternalFormat, const QSize& i_Size, bool i_bMipmaps);
	~VTexture();
	VTexture(const VTexture&) = delete;
	VTexture& operator=(const VTexture&) = delete;

	/// Deletes the textures of the current share group whose owners let go of them without a context. Making a texture
	/// and VRenderContext::Initialise do it.
	static void DeleteReleased();

	/// Whether a context of its share group is current. A texture that is of another one has to be made again.
	bool IsUsable() const;

	/// With mipmaps, no larger than OpenGL takes it, first row at texture coordinate 0. Empty if the image is.
	static std::shared_ptr<VTexture> FromImage(const QImage& i_rImage);

	/// @param i_pTexels rows without padding, as many bytes as size and format ask for: three or four bytes, one byte,
	/// one float, or one 16-bit number a texel
	void Upload(const void* i_pTexels);

	/// As the texture of the unit, which is the active one afterwards.
	void Bind(VRenderContext& io_rContext, unsigned int i_Unit, const VTextureSampling& i_rSampling);

	const QSize& Size() const { return m_Size; }

private:
	struct VObject;
	std::unique_ptr<VObject> m_pObject;
	std::uint32_t m_InternalFormat;
	QSize m_Size;
	bool m_bMipmaps;
	VTextureSampling m_Sampling;
	bool m_bSampled = false;
};

} // namespace CoreGraphics
