#include "studio/motion/TimeLine.h"

#include "studio/motion/TakePlayer.h"
#include "studio/window/Named.h"

#include <QMouseEvent>
#include <QPainter>
#include <QWheelEvent>

#include <cmath>

namespace StudioHost
{
namespace
{

constexpr int c_Margin = 8;
constexpr int c_TrackTop = 6;
constexpr int c_TrackHeight = 10;
/// Between two numbers, at least.
constexpr int c_NumberDistance = 60;

/// The least of 1, 2 and 5 times a power of ten that is not less.
std::size_t RoundStep(double i_Least)
{
	std::size_t step = 1;
	for (int i = 0; double(step) < i_Least; ++i)
		step = i % 3 == 1 ? step / 2 * 5 : step * 2;
	return step;
}

} // namespace

VTimeLine::VTimeLine(VTakePlayer& i_rPlayer, QWidget* i_pParent) : QWidget(i_pParent), m_rPlayer(i_rPlayer)
{
	Named(this, "TimeLine", tr("Frames of the take"));
	setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Fixed);
	setFocusPolicy(Qt::ClickFocus);
	setToolTip(tr("Drag to look at a frame; the wheel steps"));
	for (const auto signal : {&VTakePlayer::takeChanged, &VTakePlayer::stateChanged, &VTakePlayer::frameChanged,
	         &VTakePlayer::solvedChanged})
		connect(&m_rPlayer, signal, this, qOverload<>(&QWidget::update));
}

int VTimeLine::PlaceOf(std::size_t i_Frame) const
{
	const double last = m_rPlayer.Frames() > 1 ? double(m_rPlayer.Frames() - 1) : 1.0;
	return c_Margin + int(std::lround(double(width() - 2 * c_Margin) * double(i_Frame) / last));
}

void VTimeLine::SeekTo(int i_X)
{
	if (m_rPlayer.Frames() == 0)
		return;
	const double part = double(i_X - c_Margin) / double(std::max(1, width() - 2 * c_Margin));
	m_rPlayer.Seek(std::llround(part * double(m_rPlayer.Frames() - 1)));
}

void VTimeLine::paintEvent(QPaintEvent* /*i_pEvent*/)
{
	QPainter painter(this);
	const QRect track(c_Margin, c_TrackTop, width() - 2 * c_Margin, c_TrackHeight);
	painter.fillRect(track, palette().color(QPalette::Base));
	const std::size_t frames = m_rPlayer.Frames();
	if (frames == 0)
		return;
	const auto fill = [&](std::size_t i_From, std::size_t i_To, int i_Top, int i_Height, const QColor& i_rColour)
	{
		const int from = PlaceOf(i_From);
		painter.fillRect(from, c_TrackTop + i_Top, std::max(2, PlaceOf(i_To) - from), i_Height, i_rColour);
	};
	fill(m_rPlayer.In(), m_rPlayer.Out(), 0, c_TrackHeight, palette().color(QPalette::Button));
	if (m_rPlayer.Solved() > 0)
		fill(0, std::size_t(m_rPlayer.Solved()) - 1, c_TrackHeight - 3, 3, palette().color(QPalette::Highlight));
	if (m_rPlayer.Judged())
		for (const std::size_t frame : m_rPlayer.Judged()->m_Report.m_NotConverged)
			painter.fillRect(PlaceOf(frame), c_TrackTop, 2, c_TrackHeight, QColor(224, 90, 75));

	painter.setPen(palette().color(QPalette::WindowText));
	const std::size_t step = RoundStep(double(frames) * c_NumberDistance / std::max(1, track.width()));
	for (std::size_t frame = 0; frame < frames; frame += step)
	{
		const int x = PlaceOf(frame);
		painter.drawLine(x, track.bottom() + 1, x, track.bottom() + 4);
		painter.drawText(
		    QRect(x - 40, track.bottom() + 4, 80, 14), Qt::AlignHCenter | Qt::AlignTop, QString::number(frame));
	}
	const int now = PlaceOf(m_rPlayer.Frame());
	const QColor cursor = palette().color(QPalette::Link);
	painter.fillRect(now - 1, 1, 3, c_TrackTop + c_TrackHeight + 2, m_rPlayer.IsShown() ? cursor : cursor.darker(200));
}

void VTimeLine::mousePressEvent(QMouseEvent* i_pEvent)
{
	if (i_pEvent->button() == Qt::LeftButton)
		SeekTo(i_pEvent->x());
}

void VTimeLine::mouseMoveEvent(QMouseEvent* i_pEvent)
{
	if (i_pEvent->buttons().testFlag(Qt::LeftButton))
		SeekTo(i_pEvent->x());
}

void VTimeLine::wheelEvent(QWheelEvent* i_pEvent)
{
	if (i_pEvent->angleDelta().y() != 0)
		m_rPlayer.Step(i_pEvent->angleDelta().y() > 0 ? -1 : 1);
}

} // namespace StudioHost

#include "moc_TimeLine.cpp"
