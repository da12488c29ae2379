#include "OrlexGraphics/item/CameraGrid.h"

#include <QMetaEnum>

namespace OrlexGraphics
{

int VCameraGrid::rowCount(const QModelIndex& /*i_rParent*/) const
{
	return 0;
}

QVariant VCameraGrid::data(const QModelIndex& /*i_rIndex*/, int /*i_Role*/) const
{
	return {};
}

QHash<int, QByteArray> VCameraGrid::roleNames() const
{
	QHash<int, QByteArray> names;
	const QMetaEnum roles = QMetaEnum::fromType<ERoles>();
	for (int i = 0; i < roles.keyCount(); ++i)
		names.insert(roles.value(i), roles.key(i));
	return names;
}

void VCameraGrid::SetAspectRatio(qreal i_AspectRatio)
{
	if (m_AspectRatio == i_AspectRatio)
		return;
	m_AspectRatio = i_AspectRatio;
	emit AspectRatioChanged();
}

void VCameraGrid::SetRotation(bool i_bShowRotated, bool i_bSnap90Degrees)
{
	m_bShowRotated = i_bShowRotated;
	m_bSnap90Degrees = i_bSnap90Degrees;
}

} // namespace OrlexGraphics

#include "moc_CameraGrid.cpp"
