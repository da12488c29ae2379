#include "OrlexGraphics/skins/SkinRenderer.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "CoreGraphics/Skin.h"
#include "CoreGraphics/SkinInstance.h"
#include "DebugServices/GlobalLog.h"
#include "OrlexGraphics/frame/IRenderType.h"
#include "OrlexGraphics/frame/SceneOptions.h"

#include <QOpenGLContext>
#include <QOpenGLFunctions>

#include <algorithm>

#ifndef GL_MAX_VERTEX_UNIFORM_COMPONENTS
#define GL_MAX_VERTEX_UNIFORM_COMPONENTS 0x8B4A
#endif
#ifndef GL_MAX_VERTEX_UNIFORM_VECTORS
#define GL_MAX_VERTEX_UNIFORM_VECTORS 0x8DFB
#endif

namespace OrlexGraphics
{

namespace
{

/// The view, the camera, what is highlighted; a driver's own constants take some, too.
constexpr int c_OtherVectors = 16;
constexpr int c_NeededVectors = 4 * static_cast<int>(CoreGraphics::c_MaxSkinBones) + c_OtherVectors;

int UniformVectors()
{
	QOpenGLContext* const pContext = QOpenGLContext::currentContext();
	GLint count = 0;
	if (pContext->isOpenGLES())
		pContext->functions()->glGetIntegerv(GL_MAX_VERTEX_UNIFORM_VECTORS, &count);
	else
	{
		pContext->functions()->glGetIntegerv(GL_MAX_VERTEX_UNIFORM_COMPONENTS, &count);
		count /= 4;
	}
	return count;
}

} // namespace

bool HasRoomForSkins(int i_UniformVectors)
{
	return i_UniformVectors >= c_NeededVectors;
}

VSkinRenderer::VSkinRenderer(CoreGraphics::VShaderLibrary& io_rLibrary) : VSkinRenderer(io_rLibrary, UniformVectors())
{
}

VSkinRenderer::VSkinRenderer(CoreGraphics::VShaderLibrary& io_rLibrary, int i_UniformVectors)
{
	m_Opaque.m_bDepthTest = true;
	m_Opaque.m_Cull = CoreGraphics::ECullBack;
	m_Blended = m_Opaque;
	m_Blended.m_ColourBlend = CoreGraphics::EColourBlendAlpha;
	m_XRay = m_Opaque;
	m_XRay.m_ColourBlend = CoreGraphics::EColourBlendAdd;
	m_XRay.m_bDepthWrite = false;
	m_Selection = CoreGraphics::MakeSelectionState(m_Opaque);
	if (!HasRoomForSkins(i_UniformVectors))
	{
		// The bones are drawn all the same.
		NVX_LOG("CoreGraphics", NVX::ELogWarning,
		    "Skins are not shown: they take %1% uniform vectors of a vertex shader, and the graphics driver has %2%",
		    c_NeededVectors, i_UniformVectors);
		return;
	}
	m_Program = CoreGraphics::VSelectableProgram::Make(io_rLibrary, "FBXSkin", "FBXMaterial");
	m_pXRayProgram = io_rLibrary.GetProgram("FBXSkin", "XRay");
}

VSkinRenderer::EUse VSkinRenderer::UseOf(
    const CoreGraphics::VRenderContext& i_rContext, const VSubjectOptions& i_rOptions)
{
	if (i_rContext.m_Mode != CoreGraphics::ERenderNormal)
		return EUseSelection;
	return i_rOptions.m_bSkinXRay ? EUseXRay : EUseNormal;
}

bool VSkinRenderer::BeginRender(
    CoreGraphics::VRenderContext& io_rContext, const VSubjectOptions& i_rOptions, std::uint32_t i_Pass)
{
	if (!i_rOptions.m_bEnabled || !i_rOptions.m_bSkin || i_rOptions.m_bSkinXRay == (i_Pass == EPassOpaque))
		return false;
	const EUse use = UseOf(io_rContext, i_rOptions);
	// What is seen through is picked through.
	if (use == EUseSelection && i_rOptions.m_bSkinXRay)
		return false;
	if (!io_rContext.UseProgram(use == EUseXRay ? m_pXRayProgram : m_Program.Get(use == EUseSelection)))
		return false;
	if (use != EUseNormal)
		io_rContext.ApplyState(use == EUseXRay ? m_XRay : m_Selection);
	m_Tables[use].m_Material.Begin(io_rContext);
	io_rContext.SetUniform(m_Tables[use].m_HighlightMissing, i_rOptions.m_bMissingMarkers ? 1 : 0);
	return true;
}

void VSkinRenderer::Draw(const CoreGraphics::VSkinInstance& i_rInstance, CoreGraphics::VRenderContext& io_rContext,
    const VSubjectOptions& i_rOptions, const CoreGraphics::VSelectionId& i_rId)
{
	if (!i_rInstance.GetSkin())
		return;
	const EUse use = UseOf(io_rContext, i_rOptions);
	VTable& rTable = m_Tables[use];
	if (use == EUseSelection)
	{
		if (i_rId.m_Id == 0)
			return;
		m_Program.SetId(io_rContext, i_rId);
	}
	else if (use == EUseNormal)
	{
		io_rContext.SetUniform(rTable.m_UserColourA, i_rInstance.UserColourA());
		io_rContext.SetUniform(rTable.m_UserColourB, i_rInstance.UserColourB());
	}
	const auto bones = i_rInstance.BoneMatrices();
	if (bones.empty())
		return;
	io_rContext.SetUniform(
	    rTable.m_BoneTransforms, bones.front().data(), std::min(bones.size(), CoreGraphics::c_MaxSkinBones));

	for (CoreGraphics::VMaterialMesh& rMesh : i_rInstance.GetSkin()->Meshes())
	{
		io_rContext.BindVertices(rMesh.m_Vertices);
		for (CoreGraphics::VMaterialPart& rPart : rMesh.m_Parts)
		{
			if (use == EUseNormal)
				io_rContext.ApplyState(rPart.m_Alpha >= 1.0f ? m_Opaque : m_Blended);
			if (use != EUseSelection)
				rTable.m_Material.Set(io_rContext, rPart, rPart.m_Alpha);
			io_rContext.DrawElements(GL_TRIANGLES, rPart.m_Indices);
		}
	}
}

} // namespace OrlexGraphics
