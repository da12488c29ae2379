#pragma once

#include "CoreGraphics/Buffers.h"
#include "CoreGraphics/RenderState.h"
#include "CoreGraphics/ShapeBatch.h"
#include "CoreGraphics/Shapes.h"

#include <QMatrix4x4>
#include <QRect>
#include <QVector3D>
#include <QVector4D>

#include <array>
#include <cstdint>
#include <memory>
#include <vector>

namespace CoreGraphics
{
class VRenderContext;
class VShaderLibrary;
class VShaderProgram;
} // namespace CoreGraphics

namespace OrlexGraphics
{

class VSelectionRegistry;

/// Draws every sphere of a scene as finely as its size on screen asks for; those of less than two pixels become points.
/// End draws all at once. Made with the context current.
class VSphereHelper
{
public:
	static constexpr std::uint32_t c_Levels = 4;

	VSphereHelper(CoreGraphics::VShaderLibrary& io_rLibrary, std::shared_ptr<const VSelectionRegistry> i_pRegistry);

	~VSphereHelper();

	/// Opens a walk over spheres with the matrices, the viewport and the mode of the context.
	void Begin(CoreGraphics::VRenderContext& io_rContext);
	/// @param i_rSphere centre and radius
	/// @param i_LevelCap the finest mesh to use, 0 to 3
	void Draw(CoreGraphics::VRenderContext& io_rContext, const QVector4D& i_rSphere,
	    const CoreGraphics::VSelectionId& i_rId, const QVector4D& i_rColour, std::uint32_t i_LevelCap);
	/// Draws what came since Begin.
	void End(CoreGraphics::VRenderContext& io_rContext);

	/// A place by which a rectangle finds something else that is drawn, too. Nothing unless a pick is drawn.
	void AddPickPoint(const CoreGraphics::VRenderContext& i_rContext, const QVector3D& i_rPlace,
	    const CoreGraphics::VSelectionId& i_rId);

	/// Begins a frame: forgets its points.
	void Clear();
	/// Adds the ids, without flags, of points that lie in a rectangle and were not found before: a point may have lost
	/// its pixel to another one.
	/// @param i_rRectangle in pixels of the viewport of the last pick
	bool PickRectangle(const QRect& i_rRectangle, const QSize& i_rViewport, std::vector<bool>& io_rFound,
	    std::vector<std::uint32_t>& io_rIds) const;

	/// The mesh for a sphere with this radius in pixels, 0 to the cap; -1 for a point.
	static int Level(float i_Pixels, std::uint32_t i_LevelCap);

private:
	struct VSplat
	{
		float m_Position[3];
		CoreGraphics::VColourBytes m_Colour;
	};
	static_assert(sizeof(VSplat) == 16);

	struct VPickPoint
	{
		float m_ClipX;
		float m_ClipY;
		float m_ClipW;
		std::uint32_t m_Id;
	};

	const std::shared_ptr<const VSelectionRegistry> m_pRegistry;
	std::array<CoreGraphics::VShape, c_Levels> m_Spheres;
	const std::shared_ptr<CoreGraphics::VShaderProgram> m_pProgram;
	const std::shared_ptr<CoreGraphics::VShaderProgram> m_pIdProgram;
	const std::shared_ptr<CoreGraphics::VShaderProgram> m_pPointProgram;
	CoreGraphics::VRenderState m_State;
	CoreGraphics::VRenderState m_SelectionState;
	std::vector<VSplat> m_Splats;
	CoreGraphics::VStreamBuffer m_SplatBuffer;
	std::vector<VPickPoint> m_PickPoints;
	/// The meshes of each walk of a frame, which are mostly those of the frame before.
	std::vector<CoreGraphics::VShapeBatch> m_Walks;
	std::size_t m_Walk = 0;
	CoreGraphics::VShapeBatch m_IdWalk;
	CoreGraphics::VShapeBatch* m_pBatch = nullptr;
	QMatrix4x4 m_ViewProjection;
	float m_PixelScale = 0.0f;
};

} // namespace OrlexGraphics
