#include "studio/window/PlainTexts.h"

#include "math/VisibleText.h"

#include <QApplication>
#include <QEvent>
#include <QFileInfo>
#include <QLabel>
#include <QStringList>
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

QString ShownText(const QString& i_rText)
{
	return QString::fromStdString(VisibleText::Of(i_rText.toStdString()));
}

QString ShownFileName(const QString& i_rPath)
{
	return ShownText(QFileInfo(i_rPath).fileName());
}

QString PlainToolTip(const QString& i_rText)
{
	QStringList lines = i_rText.split('\n');
	for (QString& rLine : lines)
		rLine = ShownText(rLine);
	return i_rText.isEmpty() ? i_rText : Qt::convertFromPlainText(lines.join('\n'));
}

} // namespace StudioHost

#include "moc_PlainTexts.cpp"
