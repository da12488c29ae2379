#include "Flow2Graphics/RenderSubjectData.h"

namespace Flow2Graphics
{

void VRenderSubjectData::Clear()
{
	m_PositionTargets.clear();
	m_RotationTargets.clear();
	m_Covariances.clear();
	m_MissingMarkers.clear();
	m_BoneSpheres.clear();
	m_Bones.clear();
	m_Axes.clear();
	m_Boxes.clear();
	m_Joints.clear();
	m_Id = {};
	m_bSkin = false;
}

void VRenderSubjectMarkerData::Clear()
{
	m_Markers.clear();
	m_Sticks.clear();
	m_SticksWithoutGaps = 0;
}

} // namespace Flow2Graphics
