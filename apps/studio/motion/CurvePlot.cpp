#include "studio/motion/CurvePlot.h"

#include <QEvent>
#include <QHBoxLayout>
#include <QMouseEvent>
#include <QTimer>

#include <qwt_legend.h>
#include <qwt_plot.h>
#include <qwt_plot_canvas.h>
#include <qwt_plot_curve.h>
#include <qwt_plot_grid.h>
#include <qwt_plot_marker.h>
#include <qwt_scale_widget.h>
#include <qwt_symbol.h>
#include <qwt_text.h>

#include <cmath>
#include <iterator>

namespace StudioHost
{
namespace
{

/// How near to a mark the mouse has to be, in pixels.
constexpr double c_Near = 8.0;

const QColor c_Colours[] = {QColor(0x6cb0f2), QColor(0xf2a65a), QColor(0x8fd175), QColor(0xe57fb1), QColor(0xc9a3f5),
    QColor(0xf0e06a), QColor(0x5fd3c8), QColor(0xe0776b)};

} // namespace

VCurvePlot::VCurvePlot(const QString& i_rBottom, const QString& i_rLeft, const QString& i_rRight, QWidget* i_pParent)
    : QWidget(i_pParent), m_pPlot(new QwtPlot(this))
{
	auto* const pLayout = new QHBoxLayout(this);
	pLayout->setContentsMargins(0, 0, 0, 0);
	pLayout->addWidget(m_pPlot);
	// Where there is little room the list beside it decides.
	m_pPlot->setMinimumSize(80, 40);

	auto* const pCanvas = new QwtPlotCanvas(m_pPlot);
	pCanvas->setFrameStyle(QFrame::NoFrame);
	pCanvas->setCursor(Qt::CrossCursor);
	pCanvas->setFocusPolicy(Qt::ClickFocus);
	pCanvas->installEventFilter(this);
	m_pPlot->setCanvas(pCanvas);
	m_pPlot->setCanvasBackground(palette().color(QPalette::Base));
	QwtText title;
	title.setFont(font());
	for (const int axis : {QwtPlot::xBottom, QwtPlot::yLeft, QwtPlot::yRight})
	{
		m_pPlot->setAxisFont(axis, font());
		m_pPlot->axisWidget(axis)->setMargin(2);
		title.setText(axis == QwtPlot::yLeft ? i_rLeft : axis == QwtPlot::yRight ? i_rRight : i_rBottom);
		m_pPlot->setAxisTitle(axis, title);
	}
	m_pPlot->insertLegend(new QwtLegend, QwtPlot::TopLegend);
	auto* const pGrid = new QwtPlotGrid;
	pGrid->setMajorPen(palette().color(QPalette::Mid), 0.0);
	pGrid->attach(m_pPlot);
	m_pCursor = new QWidget(pCanvas);
	m_pCursor->setAttribute(Qt::WA_TransparentForMouseEvents);
	m_pCursor->setAutoFillBackground(true);
	m_pCursor->setBackgroundRole(QPalette::Link);
	m_pCursor->hide();
}

QWidget* VCurvePlot::Canvas() const
{
	return m_pPlot->canvas();
}

int VCurvePlot::PlaceOf(double i_X) const
{
	return int(std::lround(m_pPlot->transform(QwtPlot::xBottom, i_X)));
}

void VCurvePlot::SetCursorAt(double i_X)
{
	m_CursorAt = i_X;
	m_pCursor->setVisible(i_X >= 0.0);
	m_pCursor->setGeometry(PlaceOf(i_X) - 1, 0, 2, Canvas()->height());
}

void VCurvePlot::SetCurves(const QVector<VCurve>& i_rCurves, double i_Last)
{
	m_pPlot->detachItems(QwtPlotItem::Rtti_PlotCurve);
	m_pPlot->detachItems(QwtPlotItem::Rtti_PlotMarker);
	m_Marks.clear();
	bool bLeft = false, bRight = false;
	for (const VCurve& rCurve : i_rCurves)
	{
		(rCurve.m_bRight ? bRight : bLeft) = true;
		const int axis = rCurve.m_bRight ? QwtPlot::yRight : QwtPlot::yLeft;
		const QColor colour = c_Colours[m_Marks.size() % int(std::size(c_Colours))];
		auto* const pCurve = new QwtPlotCurve(QwtText(rCurve.m_Name, QwtText::PlainText));
		pCurve->setPen(colour, 1.5, rCurve.m_bRight ? Qt::DashLine : Qt::SolidLine);
		pCurve->setSamples(rCurve.m_Points);
		pCurve->setYAxis(axis);
		pCurve->setLegendAttribute(QwtPlotCurve::LegendShowLine);
		pCurve->attach(m_pPlot);
		auto* const pMark = new QwtPlotMarker;
		pMark->setSymbol(new QwtSymbol(QwtSymbol::Ellipse, colour, QPen(Qt::white), QSize(7, 7)));
		pMark->setValue(rCurve.m_Mark);
		pMark->setYAxis(axis);
		pMark->attach(m_pPlot);
		m_Marks.push_back({rCurve.m_Mark, axis});
	}
	m_pPlot->setVisible(bLeft || bRight);
	m_pPlot->enableAxis(QwtPlot::yLeft, bLeft || !bRight);
	m_pPlot->enableAxis(QwtPlot::yRight, bRight);
	m_pPlot->setAxisScale(QwtPlot::xBottom, 0.0, i_Last);
	m_pPlot->replot();
	SetCursorAt(m_CursorAt);
}

bool VCurvePlot::eventFilter(QObject* i_pReceiver, QEvent* i_pEvent)
{
	// The axes follow the canvas.
	if (i_pEvent->type() == QEvent::Resize)
		QTimer::singleShot(0, this, [this] { SetCursorAt(m_CursorAt); });
	if (i_pEvent->type() != QEvent::MouseButtonPress && i_pEvent->type() != QEvent::MouseMove)
		return QWidget::eventFilter(i_pReceiver, i_pEvent);
	const auto& rMouse = static_cast<const QMouseEvent&>(*i_pEvent);
	if (!rMouse.buttons().testFlag(Qt::LeftButton))
		return false;
	double x = m_pPlot->invTransform(QwtPlot::xBottom, rMouse.pos().x());
	for (const VMark& rMark : m_Marks)
		if (std::hypot(m_pPlot->transform(QwtPlot::xBottom, rMark.m_Place.x()) - rMouse.pos().x(),
		        m_pPlot->transform(rMark.m_Axis, rMark.m_Place.y()) - rMouse.pos().y())
		    <= c_Near)
			x = rMark.m_Place.x();
	emit pressed(x);
	return false;
}

} // namespace StudioHost

#include "moc_CurvePlot.cpp"
