#pragma once

#include "CoreGraphics/RenderState.h"
#include "CoreGraphics/SelectableProgram.h"
#include "CoreGraphics/Shapes.h"
#include "CoreGraphics/Uniform.h"
#include "OrlexGraphics/frame/IRenderType.h"

#include <QMatrix4x4>
#include <QVector2D>
#include <QVector3D>

#include <memory>
#include <string>
#include <vector>

namespace CoreGraphics
{
class VShaderLibrary;
} // namespace CoreGraphics

namespace OrlexGraphics
{

class VSelectionRegistry;

/// A plate in the floor, and what presses on it. Everything but its own place is in the plate's frame.
struct VForcePlate
{
	std::string m_Name;
	/// Rotation and translation in millimetres: to the middle of its upper face, Z being its normal.
	QMatrix4x4 m_Transform;
	/// Millimetres.
	QVector2D m_Size{400.0f, 600.0f};
	/// Newtons. None for a plate on which nobody stands.
	QVector3D m_Force;
	/// Millimetres.
	QVector3D m_CentreOfPressure;
};

/// Draws force plates, with an arrow of a millimetre for each newton where the force acts. Render thread; made with the
/// context current.
class VRenderForcePlates : public IRenderType
{
public:
	VRenderForcePlates(CoreGraphics::VShaderLibrary& io_rLibrary, std::shared_ptr<VSelectionRegistry> i_pRegistry);

	/// Drawn once they have ids. May be null.
	void SetPlates(std::shared_ptr<const std::vector<VForcePlate>> i_pPlates)
	{
		m_pPlates = std::move(i_pPlates);
		m_Ids.clear();
	}
	/// Ids and places of the plates in the frame that is being made: in each frame update, after the registry's Reset.
	void AllocateIds();

	void Render(
	    CoreGraphics::VRenderContext& io_rContext, const VSceneOptions& i_rOptions, std::uint32_t i_Pass) override;

private:
	void RenderShape(CoreGraphics::VRenderContext& io_rContext, CoreGraphics::VSelectableProgram& io_rProgram,
	    CoreGraphics::VShape& io_rShape, bool i_bArrows);

	const std::shared_ptr<VSelectionRegistry> m_pRegistry;
	std::shared_ptr<const std::vector<VForcePlate>> m_pPlates;
	std::vector<CoreGraphics::VSelectionId> m_Ids;
	CoreGraphics::VSelectableProgram m_PlateProgram;
	CoreGraphics::VSelectableProgram m_ArrowProgram;
	CoreGraphics::VShape m_Plate;
	CoreGraphics::VShape m_Arrow;
	CoreGraphics::VRenderState m_State;
	CoreGraphics::VUniform m_Model{"u_ModelTransform"};
	CoreGraphics::VUniform m_Colour{"u_ModelColour"};
	CoreGraphics::VUniform m_Force{"u_Force"};
	CoreGraphics::VUniform m_CentreOfPressure{"u_CentreOfPressure"};
};

} // namespace OrlexGraphics
