#include "OrlexGraphics/stage/RenderFBXScene.h"

#include "CoreGraphics/Picture.h"
#include "CoreGraphics/QtForm.h"
#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "FBXIO/FBXReader.h"
#include "OrlexGraphics/frame/SceneOptions.h"

#include <qopengl.h>

namespace OrlexGraphics
{

VRenderFBXScene::VRenderFBXScene(CoreGraphics::VShaderLibrary& io_rLibrary)
    : m_pProgram(io_rLibrary.GetProgram("FBXMesh", "FBXMaterial"))
{
	m_State.m_bDepthTest = true;
	m_State.m_Cull = CoreGraphics::ECullBack;
}

std::vector<VRenderFBXScene::VMesh> VRenderFBXScene::ReadMeshes(FBXIO::FBXReader& io_rReader)
{
	std::vector<FBXIO::VPlacedMesh> placed;
	io_rReader.SetPictures(&CoreGraphics::OpenPicture);
	io_rReader.ReadPlacedMeshes(placed);
	CoreGraphics::VMaterialMeshMaker maker;
	std::vector<VMesh> meshes;
	meshes.reserve(placed.size());
	for (const FBXIO::VPlacedMesh& rMesh : placed)
		meshes.push_back({maker.Make(rMesh.m_Mesh), CoreGraphics::ToQt(rMesh.m_Transform)});
	return meshes;
}

void VRenderFBXScene::Render(
    CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass)
{
	if (i_Pass != EPassOpaque || io_rContext.m_Mode != CoreGraphics::ERenderNormal || !i_rOptions.m_bFBXScene
	    || m_Meshes.empty() || !io_rContext.UseProgram(m_pProgram))
		return;
	io_rContext.ApplyState(m_State);
	m_Material.Begin(io_rContext);
	for (VMesh& rMesh : m_Meshes)
	{
		io_rContext.SetUniform(m_ModelTransform, rMesh.m_Transform);
		io_rContext.BindVertices(rMesh.m_Mesh.m_Vertices);
		for (CoreGraphics::VMaterialPart& rPart : rMesh.m_Mesh.m_Parts)
		{
			m_Material.Set(io_rContext, rPart, 1.0f);
			io_rContext.DrawElements(GL_TRIANGLES, rPart.m_Indices);
		}
	}
}

} // namespace OrlexGraphics
