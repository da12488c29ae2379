#pragma once

#include <QObject>
#include <QString>

namespace StudioHost
{

/// As long as it lives, no label of the application, those of message boxes included, takes a text for markup unless it
/// was told to: texts hold names of files and segments, which may be anything.
class VPlainTexts : public QObject
{
	Q_OBJECT

public:
	explicit VPlainTexts(QObject* i_pParent);
	bool eventFilter(QObject* i_pObject, QEvent* i_pEvent) override;
};

/// What a widget is to be given as its tool tip, which has no such choice, so that it shows this text.
QString PlainToolTip(const QString& i_rText);

} // namespace StudioHost
