#pragma once

#include <QPolygonF>
#include <QString>
#include <QVector>
#include <QWidget>

class QwtPlot;

namespace StudioHost
{

/// Curves with an axis to the left and one to the right, a mark on each, and a cursor. Qwt draws it, whose headers are
/// not of this program's version of C++: only the one source file of this class sees them.
class VCurvePlot : public QWidget
{
	Q_OBJECT

public:
	struct VCurve
	{
		QString m_Name;
		QPolygonF m_Points;
		QPointF m_Mark;
		/// Its values stand at the right axis, and it is dashed.
		bool m_bRight = false;
	};

	VCurvePlot(const QString& i_rBottom, const QString& i_rLeft, const QString& i_rRight, QWidget* i_pParent = nullptr);

	/// @param i_Last where the axis at the bottom ends; it begins at 0.
	void SetCurves(const QVector<VCurve>& i_rCurves, double i_Last);
	/// Costs no drawing of curves. Below 0 for none.
	void SetCursorAt(double i_X);

	/// Where presses are taken, and a place of the axis at the bottom there.
	QWidget* Canvas() const;
	int PlaceOf(double i_X) const;

	QSize sizeHint() const override { return {480, 160}; }

signals:
	/// The left button went down there or is held; on a mark it is that of the mark.
	void pressed(double i_X);

protected:
	bool eventFilter(QObject* i_pReceiver, QEvent* i_pEvent) override;

private:
	struct VMark
	{
		QPointF m_Place;
		int m_Axis;
	};

	QwtPlot* const m_pPlot;
	QWidget* m_pCursor = nullptr;
	double m_CursorAt = -1.0;
	QVector<VMark> m_Marks;
};

} // namespace StudioHost
