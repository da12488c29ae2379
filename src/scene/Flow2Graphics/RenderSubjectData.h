#pragma once

#include "CoreGraphics/SelectionId.h"
#include "CoreGraphics/SkinInstance.h"

#include <QMatrix4x4>
#include <QVector4D>

#include <cstddef>
#include <memory>
#include <vector>

namespace Flow2Graphics
{

/// All that is drawn of one subject in a frame. Filled by the frame update, then walked by each pass. Positions and
/// sizes are millimetres, colours go from 0 to 1.
struct VRenderSubjectData
{
	/// A place with an edge or a radius.
	struct VShape
	{
		QVector4D m_PositionAndSize;
		QVector4D m_Colour;
		CoreGraphics::VSelectionId m_Id;
	};

	struct VModel
	{
		QMatrix4x4 m_Matrix;
		QVector4D m_Colour;
		CoreGraphics::VSelectionId m_Id;
	};

	struct VRotationTarget
	{
		QMatrix4x4 m_Target;
		QMatrix4x4 m_Segment;
		CoreGraphics::VSelectionId m_Id;
	};

	/// Null without a skin.
	std::unique_ptr<CoreGraphics::VSkinInstance> m_pSkin;
	std::vector<CoreGraphics::VSkinInstance> m_ClusterSkins;
	std::vector<VShape> m_PositionTargets;
	std::vector<VRotationTarget> m_RotationTargets;
	std::vector<QMatrix4x4> m_Covariances;
	std::vector<VShape> m_MissingMarkers;
	std::vector<VShape> m_BoneSpheres;
	std::vector<VModel> m_Bones;
	std::vector<QMatrix4x4> m_Axes;
	std::vector<VModel> m_Boxes;
	std::vector<VShape> m_Joints;
	CoreGraphics::VSelectionId m_Id;
	/// A skin is to be drawn.
	bool m_bSkin = false;

	/// Keeps the skins, and what the arrays have room for.
	void Clear();
};

/// The markers of one subject and the lines between them.
struct VRenderSubjectMarkerData
{
	struct VStick
	{
		QMatrix4x4 m_Matrix;
		QVector4D m_ColourA;
		QVector4D m_ColourB;
	};

	std::vector<VRenderSubjectData::VShape> m_Markers;
	/// First those between markers that are there.
	std::vector<VStick> m_Sticks;
	/// From here on one of the markers is missing.
	std::size_t m_SticksWithoutGaps = 0;

	void Clear();
};

} // namespace Flow2Graphics
