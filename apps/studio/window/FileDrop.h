#pragma once

#include <QObject>
#include <QStringList>

#include <functional>

class QWidget;

namespace StudioHost
{

/// Files dropped anywhere on a window are the window's, whatever stands under the mouse.
class VFileDrop : public QObject
{
public:
	/// @param i_rWindow with the docks that float beside it; owns this.
	/// @param i_Mark shows what hangs over the window, in the order in which it is opened; nothing for an empty list.
	/// @param i_Open is run when the drop has been answered, so that a question holds up no other program. It is told
	/// whether the drop was on the widget of i_rOwn.
	/// @param i_rOwn opens files in a way of its own, which is not marked.
	VFileDrop(QWidget& i_rWindow, const QWidget& i_rOwn, std::function<void(const QStringList&)> i_Mark,
	    std::function<void(const QString&, bool)> i_Open);

	bool eventFilter(QObject* i_pReceiver, QEvent* io_pEvent) override;

private:
	/// Part of the window and of none of its dialogs.
	bool IsPart(const QWidget& i_rWidget) const;

	QWidget& m_rWindow;
	const QWidget& m_rOwn;
	const std::function<void(const QStringList&)> m_Mark;
	const std::function<void(const QString&, bool)> m_Open;
	/// The drag over the window is one of files.
	bool m_bOver = false;
};

} // namespace StudioHost
