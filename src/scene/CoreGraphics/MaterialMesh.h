#pragma once

#include "CoreGraphics/Buffers.h"
#include "CoreGraphics/Texture.h"
#include "CoreGraphics/Uniform.h"
#include "FBXIO/Mesh.h"

#include <QImage>
#include <QVector4D>

#include <map>
#include <memory>
#include <vector>

namespace CoreGraphics
{

/// An image of an FBX file as the texture of whichever share group is current, its last row at texture coordinate 0.
class VImageTexture
{
public:
	explicit VImageTexture(const QImage& i_rImage);

	/// As the texture of the unit. Render thread.
	void Bind(VRenderContext& io_rContext, unsigned int i_Unit);

private:
	const QImage m_Image;
	std::shared_ptr<VTexture> m_pTexture;
};

/// One material's share of a mesh. Colours have their factor in w.
struct VMaterialPart
{
	VIndexBuffer m_Indices;
	QVector4D m_Diffuse;
	QVector4D m_Specular;
	QVector4D m_Emissive;
	float m_Shininess;
	/// 1 where nothing shows through.
	float m_Alpha;
	/// Null for the diffuse colour.
	std::shared_ptr<VImageTexture> m_pTexture;
};

/// A mesh that is ready to be drawn, or made ready when it is drawn first: no member needs a context before.
struct VMaterialMesh
{
	VVertexBuffer m_Vertices;
	/// None of them is without triangles.
	std::vector<VMaterialPart> m_Parts;
};

/// Makes meshes whose parts share textures where they share pictures. A picture that was opened by another opener than
/// OpenPicture is not drawn. Any thread.
class VMaterialMeshMaker
{
public:
	VMaterialMesh Make(const FBXIO::VBasicMesh& i_rMesh) { return MakeOf(i_rMesh, VVertexFormat::Mesh()); }
	VMaterialMesh Make(const FBXIO::VSkinMesh& i_rMesh) { return MakeOf(i_rMesh, VVertexFormat::Skin()); }

private:
	template <typename TVertex>
	VMaterialMesh MakeOf(const FBXIO::VMesh<TVertex>& i_rMesh, const VVertexFormat& i_rFormat);
	std::shared_ptr<VImageTexture> Texture(const std::shared_ptr<const FBXIO::VPicture>& i_rpPicture);

	/// The pictures are kept, so that no other one gets the address of one of them.
	std::map<std::shared_ptr<const FBXIO::VPicture>, std::shared_ptr<VImageTexture>> m_Textures;
};

/// What the programs with a material ask for.
class VMaterialUniforms
{
public:
	/// Once for a program: where the texture is.
	void Begin(VRenderContext& io_rContext);
	/// For the draws that follow.
	void Set(VRenderContext& io_rContext, const VMaterialPart& i_rPart, float i_Alpha);

private:
	VUniform m_Diffuse{"u_DiffuseColour"};
	VUniform m_Texture{"t_DiffuseTexture"};
	VUniform m_TextureEnabled{"u_DiffuseTextureEnabled"};
	VUniform m_Specular{"u_SpecularColour"};
	VUniform m_Emissive{"u_EmissiveColour"};
	VUniform m_Shininess{"u_Shininess"};
	VUniform m_Alpha{"u_Alpha"};
};

} // namespace CoreGraphics
