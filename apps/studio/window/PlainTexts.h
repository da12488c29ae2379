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

/// A name, a path or a sentence with such in it as a widget shows it: what is invisible in it, or turns the direction
/// of writing, stands as its number. What goes back as a name or a path must not come from here.
QString ShownText(const QString& i_rText);
/// Of a path.
QString ShownFileName(const QString& i_rPath);

/// What a widget is to be given as its tool tip, which has no such choice, so that it shows this text.
QString PlainToolTip(const QString& i_rText);

} // namespace StudioHost
