#include "CoreGraphics/MaterialMesh.h"

#include "CoreGraphics/Picture.h"
#include "CoreGraphics/QtForm.h"
#include "CoreGraphics/RenderContext.h"

namespace CoreGraphics
{

namespace
{

constexpr unsigned int c_DiffuseUnit = 0;

constexpr VTextureSampling c_DiffuseSampling{EMinificationLinearMipmapLinear, true};

/// A colour that lets light through counts as much as its factor says.
float AlphaOf(const FBXIO::VColourAndFactor& i_rTransparent)
{
	const auto [red, green, blue, factor] = i_rTransparent;
	return 1.0f - (red + green + blue) * factor * 0.33333334f;
}

} // namespace

VImageTexture::VImageTexture(const QImage& i_rImage)
    : m_Image(i_rImage.mirrored().convertToFormat(QImage::Format_RGBA8888))
{
}

void VImageTexture::Bind(VRenderContext& io_rContext, unsigned int i_Unit)
{
	if (!m_pTexture || !m_pTexture->IsUsable())
		m_pTexture = VTexture::FromImage(m_Image);
	if (m_pTexture)
		m_pTexture->Bind(io_rContext, i_Unit, c_DiffuseSampling);
}

std::shared_ptr<VImageTexture> VMaterialMeshMaker::Texture(const std::shared_ptr<const FBXIO::VPicture>& i_rpPicture)
{
	const auto* const pDecoded = dynamic_cast<const VDecodedPicture*>(i_rpPicture.get());
	if (!pDecoded)
		return {};
	std::shared_ptr<VImageTexture>& rpTexture = m_Textures[i_rpPicture];
	if (!rpTexture)
		rpTexture = std::make_shared<VImageTexture>(pDecoded->m_Image);
	return rpTexture;
}

template <typename TVertex>
VMaterialMesh VMaterialMeshMaker::MakeOf(const FBXIO::VMesh<TVertex>& i_rMesh, const VVertexFormat& i_rFormat)
{
	VMaterialMesh mesh{VVertexBuffer(i_rFormat, BytesOf(i_rMesh.m_Vertices)), {}};
	for (const FBXIO::VMeshPart& rPart : i_rMesh.m_Parts)
		if (!rPart.m_Indices.empty())
			mesh.m_Parts.push_back({VIndexBuffer(rPart.m_Indices, rPart.m_IndexSize), ToQt(rPart.m_Diffuse),
			    ToQt(rPart.m_Specular), ToQt(rPart.m_Emissive), rPart.m_Shininess, AlphaOf(rPart.m_Transparent),
			    Texture(rPart.m_pTexture)});
	return mesh;
}

template VMaterialMesh VMaterialMeshMaker::MakeOf(const FBXIO::VBasicMesh&, const VVertexFormat&);
template VMaterialMesh VMaterialMeshMaker::MakeOf(const FBXIO::VSkinMesh&, const VVertexFormat&);

void VMaterialUniforms::Begin(VRenderContext& io_rContext)
{
	io_rContext.SetUniform(m_Texture, static_cast<int>(c_DiffuseUnit));
}

void VMaterialUniforms::Set(VRenderContext& io_rContext, const VMaterialPart& i_rPart, float i_Alpha)
{
	io_rContext.SetUniform(m_TextureEnabled, i_rPart.m_pTexture ? 1 : 0);
	if (i_rPart.m_pTexture)
		i_rPart.m_pTexture->Bind(io_rContext, c_DiffuseUnit);
	else
		io_rContext.SetUniform(m_Diffuse, i_rPart.m_Diffuse);
	io_rContext.SetUniform(m_Specular, i_rPart.m_Specular);
	io_rContext.SetUniform(m_Emissive, i_rPart.m_Emissive);
	io_rContext.SetUniform(m_Shininess, i_rPart.m_Shininess);
	io_rContext.SetUniform(m_Alpha, i_Alpha);
}

} // namespace CoreGraphics
