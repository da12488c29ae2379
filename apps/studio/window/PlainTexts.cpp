#include "studio/window/PlainTexts.h"

#include <QApplication>
#include <QEvent>
#include <QLabel>
#include <QTextDocument>

namespace StudioHost
{

VPlainTexts::VPlainTexts(QObject* i_pParent) : QObject(i_pParent)
{
	qApp->installEventFilter(this);
}

bool VPlainTexts::eventFilter(QObject* i_pObject, QEvent* i_pEvent)
{
	auto* const pLabel = i_pEvent->type() == QEvent::Polish ? qobject_cast<QLabel*>(i_pObject) : nullptr;
	if (pLabel && pLabel->textFormat() == Qt::AutoText && !pLabel->inherits("QTipLabel"))
		pLabel->setTextFormat(Qt::PlainText);
	return false;
}

QString PlainToolTip(const QString& i_rText)
{
	return i_rText.isEmpty() ? i_rText : Qt::convertFromPlainText(i_rText);
}

} // namespace StudioHost
