#pragma once

#include <QObject>

#include <functional>

class QAction;

namespace StudioHost
{

/// Undoes what was typed in the text field that has the keyboard, or does it again.
/// @return false if there is no such field, or nothing in it to undo.
bool UndoTyping(bool i_bBack);

/// Brings the keys of some actions to the actions, which text fields would keep for themselves, and tells when the
/// operator has let go of mouse and keys.
class VEditKeys : public QObject
{
public:
	/// @param i_rActions they, and i_LetGo, must outlive this.
	VEditKeys(QObject& i_rParent, const QList<QAction*>& i_rActions, std::function<void()> i_LetGo);

	bool eventFilter(QObject* i_pWatched, QEvent* io_pEvent) override;

private:
	const QList<QAction*> m_Actions;
	const std::function<void()> m_LetGo;
};

} // namespace StudioHost
