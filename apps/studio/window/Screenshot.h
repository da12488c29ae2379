#pragma once

#include <QObject>
#include <QPixmap>
#include <QString>

class QQuickWidget;

namespace StudioHost
{

class VStudioWindow;

/// Saves one picture of a window when its panel has come to rest: its QML is loaded, no callback waits, no skin is
/// being read, no take is being read or solved, and it has been drawn like that.
class VScreenshot : public QObject
{
	Q_OBJECT

public:
	/// @param i_rWindow is shown and must outlive this.
	VScreenshot(VStudioWindow& i_rWindow, QQuickWidget& i_rPanel, QString i_Path);

signals:
	/// @param i_bSaved false if the file could not be written, which is told in the log.
	void done(bool i_bSaved);

private:
	void OnDrawn();
	bool AtRest() const;
	/// The window with the dialogs over it.
	QPixmap Picture() const;
	bool Save() const;

	VStudioWindow& m_rWindow;
	QQuickWidget& m_rPanel;
	const QString m_Path;
	int m_DrawnAtRest = 0;
	bool m_bDone = false;
};

} // namespace StudioHost
