#pragma once

#include "CoreGraphics/MaterialMesh.h"
#include "CoreGraphics/RenderState.h"
#include "CoreGraphics/SelectableProgram.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>

namespace CoreGraphics
{
class VShaderLibrary;
class VShaderProgram;
class VSkinInstance;
} // namespace CoreGraphics

namespace OrlexGraphics
{

struct VSubjectOptions;

/// Whether a shader with the bones of a skin fits into a graphics driver.
/// @param i_UniformVectors of four numbers each that a vertex shader may have
bool HasRoomForSkins(int i_UniformVectors);

/// Draws skins, opaque or as X-ray. Render thread; made with the context current. Allocates nothing in a frame.
class VSkinRenderer
{
public:
	/// Without room for skins none is drawn, and the log says so once.
	/// @param i_UniformVectors as for HasRoomForSkins
	VSkinRenderer(CoreGraphics::VShaderLibrary& io_rLibrary, int i_UniformVectors);
	/// With the room that the current context has.
	explicit VSkinRenderer(CoreGraphics::VShaderLibrary& io_rLibrary);

	/// Whether skins with these options are drawn in this pass, and then the program for it is in use.
	bool BeginRender(
	    CoreGraphics::VRenderContext& io_rContext, const VSubjectOptions& i_rOptions, std::uint32_t i_Pass);

	/// After BeginRender has given true, with the same options.
	/// @param i_rId of the subject; nothing is drawn to pick without one
	void Draw(const CoreGraphics::VSkinInstance& i_rInstance, CoreGraphics::VRenderContext& io_rContext,
	    const VSubjectOptions& i_rOptions, const CoreGraphics::VSelectionId& i_rId);

private:
	/// Places of uniforms in one program.
	struct VTable
	{
		CoreGraphics::VUniform m_BoneTransforms{"u_BoneTransforms"};
		CoreGraphics::VMaterialUniforms m_Material;
		CoreGraphics::VUniform m_HighlightMissing{"u_HighlightMissing"};
		CoreGraphics::VUniform m_UserColourA{"u_UserColourA"};
		CoreGraphics::VUniform m_UserColourB{"u_UserColourB"};
	};
	enum EUse : std::size_t
	{
		EUseNormal,
		EUseSelection,
		EUseXRay,
		EUseCount
	};
	static EUse UseOf(const CoreGraphics::VRenderContext& i_rContext, const VSubjectOptions& i_rOptions);

	CoreGraphics::VRenderState m_Opaque;
	CoreGraphics::VRenderState m_Blended;
	CoreGraphics::VRenderState m_XRay;
	CoreGraphics::VRenderState m_Selection;
	CoreGraphics::VSelectableProgram m_Program;
	std::shared_ptr<CoreGraphics::VShaderProgram> m_pXRayProgram;
	std::array<VTable, EUseCount> m_Tables;
};

} // namespace OrlexGraphics
