#pragma once

#include "CoreGraphics/MaterialMesh.h"
#include "CoreGraphics/RenderState.h"
#include "OrlexGraphics/frame/IRenderType.h"

#include <QMatrix4x4>

#include <memory>
#include <vector>

namespace CoreGraphics
{
class VShaderLibrary;
class VShaderProgram;
} // namespace CoreGraphics

namespace FBXIO
{
class FBXReader;
}

namespace OrlexGraphics
{

/// Draws the meshes of an FBX file where the file places them. Render thread; made with the context current.
class VRenderFBXScene : public IRenderType
{
public:
	struct VMesh
	{
		CoreGraphics::VMaterialMesh m_Mesh;
		QMatrix4x4 m_Transform;
	};

	explicit VRenderFBXScene(CoreGraphics::VShaderLibrary& io_rLibrary);

	/// The meshes of a file that was loaded. Any thread.
	static std::vector<VMesh> ReadMeshes(FBXIO::FBXReader& io_rReader);

	/// Draws these meshes from now on.
	void Set(std::vector<VMesh> i_Meshes) { m_Meshes = std::move(i_Meshes); }

	void Render(
	    CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass) override;

private:
	std::vector<VMesh> m_Meshes;
	const std::shared_ptr<CoreGraphics::VShaderProgram> m_pProgram;
	CoreGraphics::VUniform m_ModelTransform{"u_ModelTransform"};
	CoreGraphics::VMaterialUniforms m_Material;
	CoreGraphics::VRenderState m_State;
};

} // namespace OrlexGraphics
