#include "studio/window/EditKeys.h"

#include <QAction>
#include <QGuiApplication>
#include <QKeyEvent>
#include <QLineEdit>

#include <algorithm>

namespace StudioHost
{

bool UndoTyping(bool i_bBack)
{
	QObject* const pField = QGuiApplication::focusObject();
	if (auto* const pLine = qobject_cast<QLineEdit*>(pField))
	{
		const bool bCan = i_bBack ? pLine->isUndoAvailable() : pLine->isRedoAvailable();
		if (bCan)
			i_bBack ? pLine->undo() : pLine->redo();
		return bCan;
	}
	// A field of a panel's QML.
	return pField && pField->property(i_bBack ? "canUndo" : "canRedo").toBool()
	    && QMetaObject::invokeMethod(pField, i_bBack ? "undo" : "redo");
}

VEditKeys::VEditKeys(QObject& i_rParent, const QList<QAction*>& i_rActions, std::function<void()> i_LetGo)
    : QObject(&i_rParent), m_Actions(i_rActions), m_LetGo(std::move(i_LetGo))
{
	QCoreApplication::instance()->installEventFilter(this);
}

bool VEditKeys::eventFilter(QObject* /*i_pWatched*/, QEvent* io_pEvent)
{
	switch (io_pEvent->type())
	{
	case QEvent::ShortcutOverride:
	{
		const auto* const pKey = static_cast<QKeyEvent*>(io_pEvent);
		const QKeySequence sequence(int(pKey->modifiers() & ~Qt::KeypadModifier) | pKey->key());
		const bool bOurs = std::ranges::any_of(
		    m_Actions, [&](const QAction* i_pAction) { return i_pAction->shortcuts().contains(sequence); });
		if (bOurs)
			io_pEvent->ignore();
		return bOurs;
	}
	case QEvent::KeyRelease:
	case QEvent::MouseButtonRelease:
		// A key that is let go of in the middle of a drag ends nothing.
		if (QGuiApplication::mouseButtons() == Qt::NoButton
		    && !(io_pEvent->type() == QEvent::KeyRelease && static_cast<QKeyEvent*>(io_pEvent)->isAutoRepeat()))
			QMetaObject::invokeMethod(
			    this, [this] { m_LetGo(); }, Qt::QueuedConnection);
		return false;
	default: return false;
	}
}

} // namespace StudioHost
