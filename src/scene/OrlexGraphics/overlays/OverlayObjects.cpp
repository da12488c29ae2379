#include "OrlexGraphics/overlays/OverlayObjects.h"

namespace OrlexGraphics
{

void VCameraObject::SetUserId(int i_UserId)
{
	if (m_UserId == i_UserId)
		return;
	m_UserId = i_UserId;
	emit UserIdChanged();
}

void VCameraObject::SetPlace(const QPointF& i_rPosition, qreal i_Depth, qreal i_RotationDegrees, bool i_bOffscreen)
{
	if (m_Position == i_rPosition && m_Depth == i_Depth && m_RotationDegrees == i_RotationDegrees
	    && m_bOffscreen == i_bOffscreen)
		return;
	m_Position = i_rPosition;
	m_Depth = i_Depth;
	m_RotationDegrees = i_RotationDegrees;
	m_bOffscreen = i_bOffscreen;
	emit PositionChanged();
}

void VCameraObject::SetCalibrated(bool i_bCalibrated)
{
	if (m_bCalibrated == i_bCalibrated)
		return;
	m_bCalibrated = i_bCalibrated;
	emit CalibratedChanged();
}

void VSubjectObject::SetPosition(const QVector3D& i_rPosition)
{
	if (m_Position == i_rPosition)
		return;
	m_Position = i_rPosition;
	emit PositionChanged();
}

void VSubjectObject::SetName(const QString& i_rName)
{
	if (m_Name == i_rName)
		return;
	m_Name = i_rName;
	emit NameChanged();
}

void VSubjectObject::SetSelectionItem(const NVX::ISelectionItem& i_rItem)
{
	if (m_Item == i_rItem)
		return;
	m_Item = i_rItem;
	emit SelectionItemChanged();
}

} // namespace OrlexGraphics

#include "moc_OverlayObjects.cpp"
