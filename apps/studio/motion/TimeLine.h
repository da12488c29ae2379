#pragma once

#include <QWidget>

#include <cstddef>

namespace StudioHost
{

class VTakePlayer;

/// The frames of a take in a row: the present one, the in and out points, how far the take is solved, and where the
/// solve did not converge. A press of the left button or a drag shows the frame under the mouse; the wheel steps.
class VTimeLine : public QWidget
{
	Q_OBJECT

public:
	explicit VTimeLine(VTakePlayer& i_rPlayer, QWidget* i_pParent = nullptr);

	/// Where a frame stands, in pixels from the left.
	int PlaceOf(std::size_t i_Frame) const;
	QSize sizeHint() const override { return {400, 34}; }
	QSize minimumSizeHint() const override { return {120, 34}; }

protected:
	void paintEvent(QPaintEvent* i_pEvent) override;
	void mousePressEvent(QMouseEvent* i_pEvent) override;
	void mouseMoveEvent(QMouseEvent* i_pEvent) override;
	void wheelEvent(QWheelEvent* i_pEvent) override;

private:
	void SeekTo(int i_X);

	VTakePlayer& m_rPlayer;
};

} // namespace StudioHost
