#include "studio/window/DarkStyle.h"

#include <QApplication>
#include <QPalette>
#include <QStyleFactory>

namespace StudioHost
{
namespace
{

// The greys of the panels' theme, from the ground up.
const QColor c_Base(0x1b1d1f);
const QColor c_Dark(0x212427);
const QColor c_Window(0x2a2d30);
const QColor c_Mid(0x34383c);
const QColor c_Button(0x3f444a);
const QColor c_Border(0x555b62);
const QColor c_DisabledText(0x757b82);
const QColor c_WindowText(0xc3c7cb);
const QColor c_Text(0xd8dadd);
const QColor c_Chosen(75, 120, 170);
const QColor c_Active(231, 101, 0);

QPalette DarkPalette()
{
	QPalette palette(c_WindowText, c_Button, c_Border, c_Dark, c_Mid, c_Text, Qt::white, c_Base, c_Window);
	palette.setColor(QPalette::ButtonText, c_Text);
	palette.setColor(QPalette::AlternateBase, c_Dark);
	palette.setColor(QPalette::Midlight, c_Button);
	palette.setColor(QPalette::Shadow, Qt::black);
	palette.setColor(QPalette::Highlight, c_Chosen);
	palette.setColor(QPalette::HighlightedText, Qt::white);
	palette.setColor(QPalette::Link, c_Active);
	palette.setColor(QPalette::LinkVisited, c_Active);
	palette.setColor(QPalette::ToolTipBase, c_Dark);
	palette.setColor(QPalette::ToolTipText, c_Text);
	palette.setColor(QPalette::PlaceholderText, c_DisabledText);
	for (const QPalette::ColorRole role :
	    {QPalette::WindowText, QPalette::Text, QPalette::ButtonText, QPalette::HighlightedText})
		palette.setColor(QPalette::Disabled, role, c_DisabledText);
	palette.setColor(QPalette::Disabled, QPalette::Highlight, c_Button);
	return palette;
}

} // namespace

void ApplyDarkStyle(QApplication& io_rApplication)
{
	io_rApplication.setStyle(QStyleFactory::create(QStringLiteral("Fusion")));
	io_rApplication.setPalette(DarkPalette());
	io_rApplication.setStyleSheet(QStringLiteral(
	    "QToolTip { color: #d8dadd; background: #212427; border: 1px solid #555b62; padding: 3px; }"
	    "QDockWidget::title { background: #212427; padding: 5px; }"
	    "QTabWidget::pane { border: 1px solid #555b62; }"
	    "QTabBar::tab { color: #c3c7cb; background: #212427; padding: 6px 14px; border: 1px solid #555b62;"
	    " border-bottom: 2px solid #212427; }"
	    "QTabBar::tab:hover { background: #34383c; }"
	    "QTabBar::tab:selected { color: #ffffff; background: #2a2d30; border-bottom: 2px solid %1; }"
	    "QMainWindow::separator { background: #212427; width: 4px; height: 4px; }"
	    "QMainWindow::separator:hover { background: %1; }"
	    "QCheckBox::indicator:unchecked, QAbstractItemView::indicator:unchecked { width: 13px; height: 13px;"
	    " border: 1px solid #757b82; border-radius: 2px; background: #212427; }"
	    "QLineEdit:focus, QComboBox:focus { border: 1px solid %1; }")
	                                  .arg(c_Active.name()));
}

} // namespace StudioHost
