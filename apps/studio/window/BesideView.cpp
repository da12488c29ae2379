#include "studio/window/BesideView.h"

#include <QWidget>

#include <algorithm>

namespace StudioHost
{
namespace
{

/// Of the window's width: what is narrower stands beside the view, what is wider below its middle.
constexpr double c_PanelShare = 0.4;
constexpr double c_HeightBelowView = 0.52;
constexpr int c_EdgeMargin = 8;

} // namespace

void StandBesideView(QWidget& io_rDialog)
{
	const QWidget* const pWindow = io_rDialog.parentWidget();
	if (!pWindow)
		return;
	const QRect window = pWindow->geometry();
	const bool bBeside = io_rDialog.width() <= c_PanelShare * window.width();
	const int most = bBeside ? window.height() - 4 * c_EdgeMargin : int(c_HeightBelowView * window.height());
	io_rDialog.resize(
	    std::min(io_rDialog.width(), window.width() - 2 * c_EdgeMargin), std::min(io_rDialog.height(), most));
	io_rDialog.move(window.left() + c_EdgeMargin, window.bottom() - c_EdgeMargin - io_rDialog.height());
}

} // namespace StudioHost
