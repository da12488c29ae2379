#pragma once

#include "NVX/SelectionItemVariant.h"

#include <QObject>
#include <QPointF>
#include <QString>
#include <QVariant>
#include <QVector3D>

namespace OrlexGraphics
{

/// A capture camera's label over the view, for QML.
class VCameraObject : public QObject
{
	Q_OBJECT
	Q_PROPERTY(int userId READ UserId NOTIFY UserIdChanged)
	/// From the view's centre, in item pixels, x to the right and y down.
	Q_PROPERTY(QPointF position READ Position NOTIFY PositionChanged)
	/// 0 at the near plane, 1 at the far one.
	Q_PROPERTY(qreal depth READ Depth NOTIFY PositionChanged)
	/// Where the camera is, seen from the centre: 0 below, 90 to the right.
	Q_PROPERTY(qreal rotationDegrees READ RotationDegrees NOTIFY PositionChanged)
	/// The position is on the view's edge, as the camera is beyond it.
	Q_PROPERTY(bool offscreen READ Offscreen NOTIFY PositionChanged)
	Q_PROPERTY(bool calibrated READ Calibrated NOTIFY CalibratedChanged)

public:
	using QObject::QObject;

	int UserId() const { return m_UserId; }
	QPointF Position() const { return m_Position; }
	qreal Depth() const { return m_Depth; }
	qreal RotationDegrees() const { return m_RotationDegrees; }
	bool Offscreen() const { return m_bOffscreen; }
	bool Calibrated() const { return m_bCalibrated; }

	void SetUserId(int i_UserId);
	void SetPlace(const QPointF& i_rPosition, qreal i_Depth, qreal i_RotationDegrees, bool i_bOffscreen);
	void SetCalibrated(bool i_bCalibrated);

signals:
	void PositionChanged();
	void UserIdChanged();
	void CalibratedChanged();

private:
	int m_UserId = 0;
	QPointF m_Position;
	qreal m_Depth = 0;
	qreal m_RotationDegrees = 0;
	bool m_bOffscreen = false;
	bool m_bCalibrated = false;
};

/// A subject's name over the view, for QML.
class VSubjectObject : public QObject
{
	Q_OBJECT
	/// From the view's centre, in item pixels, x to the right and y down; z is the depth, 0 at the near plane.
	Q_PROPERTY(QVector3D position READ Position NOTIFY PositionChanged)
	Q_PROPERTY(QString name READ Name NOTIFY NameChanged)
	Q_PROPERTY(QVariant selectionItem READ SelectionItem NOTIFY SelectionItemChanged)

public:
	using QObject::QObject;

	QVector3D Position() const { return m_Position; }
	const QString& Name() const { return m_Name; }
	QVariant SelectionItem() const { return QVariant::fromValue(m_Item); }

	void SetPosition(const QVector3D& i_rPosition);
	void SetName(const QString& i_rName);
	void SetSelectionItem(const NVX::ISelectionItem& i_rItem);

signals:
	void PositionChanged();
	void NameChanged();
	void SelectionItemChanged();

private:
	QVector3D m_Position;
	QString m_Name;
	NVX::ISelectionItem m_Item;
};

} // namespace OrlexGraphics
